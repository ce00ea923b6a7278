#include <gtest/gtest.h>

#include <numbers>

#include "io/FormatContours.h"
#include "io/formats/GCode.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;
using std::numbers::pi;

std::string Complaint(std::string const& text) {
  return Refusal([&] { ParseGCode(text, "p.nc"); });
}

std::vector<Piece> Pieces(std::string const& text) { return ParseGCode(text, "p.nc").pieces; }

ContourFile Of(std::vector<Piece> pieces, std::string units = "mm") {
  ContourFile contour;
  contour.path = "p.json";
  contour.pieces = std::move(pieces);
  contour.units = std::move(units);
  return contour;
}

std::string Path(std::vector<Piece> const& pieces) {
  std::string const text = ToGCode(Of(pieces));
  std::string const head = "G21\nG17 G90 G91.1\n";
  std::string const end = "M2\n";
  EXPECT_TRUE(text.starts_with(head));
  EXPECT_TRUE(text.ends_with(end));
  return text.substr(head.size(), text.size() - head.size() - end.size());
}

TEST(ToGCode, WritesMovesLinesAndArcs) {
  EXPECT_EQ(Path(Wedge().pieces),
            "G0 X0.0000 Y0.0000\n"
            "G1 X4.0000 Y0.0000\n"
            "G2 X5.0000 Y-1.0000 I0.0000 J-1.0000\n"
            "G1 X0.0000 Y0.0000\n");
}

TEST(ToGCode, MovesOverGapsWithoutCutting) {
  EXPECT_EQ(Path(WithGap().pieces),
            "G0 X0.0000 Y0.0000\n"
            "G1 X1.0000 Y0.0000\n"
            "G0 X1.5000 Y0.0000\n"
            "G1 X2.0000 Y3.0000\n");
}

TEST(ToGCode, UnitsChooseTheWordAndTheDigits) {
  std::vector<Piece> const line = {MakeLine({0, 0}, {1, 0})};
  EXPECT_EQ(ToGCode(Of(line, "inch")),
            "G20\nG17 G90 G91.1\nG0 X0.00000 Y0.00000\nG1 X1.00000 Y0.00000\nM2\n");
  EXPECT_TRUE(ToGCode(Of(line, "")).starts_with("(units not known: neither G20 nor G21)\n"));
  EXPECT_EQ(Refusal([&] { ToGCode(Of(line, "m")); }, FailureKind::BadArgument),
            "p.json: G-code is in mm or inch, and the contour is in 'm'");
}

TEST(ToGCode, FeedStandsOnTheFirstCut) {
  GCodeOptions options = WithDecimals(1);
  options.feed = 600.0;
  std::string const text = ToGCode(Wedge(), options);
  EXPECT_EQ(text,
            "G21\nG17 G90 G91.1\n"
            "G0 X0.0 Y0.0\nG1 X4.0 Y0.0 F600\nG2 X5.0 Y-1.0 I0.0 J-1.0\nG1 X0.0 Y0.0\nM2\n");
}

TEST(ToGCode, SplitsWhatIsNearlyAFullCircle) {
  double const sweep = 2.0 * pi - 1e-7;
  Piece const arc = MakeArc({1, 0}, {std::cos(sweep), std::sin(sweep)}, {0, 0}, 1, true);
  EXPECT_EQ(Path({arc}),
            "G0 X1.0000 Y0.0000\n"
            "G3 X-1.0000 Y0.0000 I-1.0000 J0.0000\n"
            "G3 X1.0000 Y0.0000 I1.0000 J0.0000\n");
}

TEST(ToGCode, DropsWhatIsSmallerThanTheLastDigit) {
  EXPECT_EQ(Path({MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {1.00001, 0}),
                  MakeArc({1.00001, 0}, {1.00003, 0}, {1.00002, 0}, 0.00001, true),
                  MakeLine({1.00003, 0}, {2, 0})}),
            "G0 X0.0000 Y0.0000\nG1 X1.0000 Y0.0000\nG1 X2.0000 Y0.0000\n");
  EXPECT_EQ(Refusal(
                [] {
                  ToGCode(Of({MakeLine({0, 0}, {1e-6, 0})}));
                },
                FailureKind::BadArgument),
            "p.json: is smaller than the last digit of the G-code");
}

TEST(ToGCode, AnArcFlatterThanTheLastDigitIsALine) {
  EXPECT_EQ(Path({MakeBulge({0, 0}, {1, 0}, 1e-5)}), "G0 X0.0000 Y0.0000\nG1 X1.0000 Y0.0000\n");
}

/// Arcs of a few units of the last digit, where rounding is all there is.
TEST(ToGCode, TinyArcsNeverGoRoundTheOtherWay) {
  Testing::RandomGeometry random(3);
  int arcs = 0;
  for (int i = 0; i < 5000; ++i) {
    XY const start = random.PointIn(-10.0, 10.0);
    double const radius = std::pow(10.0, random.Uniform(-5.0, -3.0));
    double const sweep = random.Uniform(0.01, 6.2);
    Piece const arc = RandomArc(start, radius, sweep, &random);
    std::vector<Piece> const pieces = {MakeLine({-20, 0}, arc.start), arc};
    for (Piece const& read : Pieces(ToGCode(Of(pieces)))) {
      if (!read.IsArc()) continue;
      ++arcs;
      EXPECT_LE(read.sweep, sweep + pi) << "arc " << i;
      EXPECT_LE(read.length, arc.length + 0.001) << "arc " << i;
      EXPECT_FALSE(AreEqual(read.start, read.end)) << "arc " << i;
    }
  }
  EXPECT_GT(arcs, 1000);
}

TEST(ToGCode, RefusesDigitsTooCoarseForTheMachine) {
  double const radius = std::hypot(0.3, 0.27);
  XY const end = {0.3 + radius * std::cos(1.4), -0.27 + radius * std::sin(1.4)};
  ContourFile const contour = Of({MakeArc({0, 0}, end, {0.3, -0.27}, radius, false)});
  EXPECT_TRUE(Refusal([&] { ToGCode(contour, WithDecimals(1)); }, FailureKind::BadArgument)
                  .starts_with("p.json: G-code with 1 decimal is too coarse for piece 1: the radii "
                               "at its ends would differ by 0.0"));
  EXPECT_NO_THROW(ToGCode(contour, WithDecimals(4)));
}

TEST(ToGCode, RefusesNumbersBeyondExactRounding) {
  EXPECT_EQ(Refusal(
                [] {
                  ToGCode(Of({MakeLine({0, 0}, {1e12, 0})}));
                },
                FailureKind::BadArgument),
            "p.json: G-code with 4 decimals cannot hold 1e+12");
}

TEST(ParseGCode, ReadsWordsWithoutBlanksInAnyCase) {
  ContourFile const contour = ParseGCode(
      "%\nO0001 (wedge)\nN10g21G90g17 ; all modal\nN20G0X0Y0Z5.\nN30 G1 Z-1 F100\n"
      "N40 X4.\nG02X5Y-1I0J-1\nG1 X 0 Y+0\nG0 Z5\nX99 Y99\nM30\n%\n",
      "p.nc");
  EXPECT_TRUE(SameBits(contour, Wedge()));
}

TEST(ParseGCode, ReadsIncrementalMovesAndAbsoluteCentres) {
  EXPECT_TRUE(SameBits(ParseGCode("G21 G91\nG1 X4\nG2 X1 Y-1 J-1\nG1 X-5 Y1\n", "p.nc"), Wedge()));
  EXPECT_TRUE(SameBits(
      ParseGCode("G21 G90.1\nG0 X0 Y0\nG1 X4\nG2 X5 Y-1 I4 J-1\nG1 X0 Y0\n", "p.nc"), Wedge()));
}

TEST(ParseGCode, RadiusGivesTheShorterArcAndNegativeTheLonger) {
  Piece const shorter = Pieces("G0 X1 Y0\nG3 X0 Y1 R1").at(0);
  EXPECT_NEAR(shorter.center.x, 0.0, 1e-15);
  EXPECT_NEAR(shorter.sweep, pi / 2, 1e-15);
  Piece const longer = Pieces("G0 X1 Y0\nG3 X0 Y1 R-1").at(0);
  EXPECT_NEAR(longer.center.x, 1.0, 1e-15);
  EXPECT_NEAR(longer.sweep, 1.5 * pi, 1e-15);
  Piece const clockwise = Pieces("G0 X1 Y0\nG2 X0 Y1 R1").at(0);
  EXPECT_NEAR(clockwise.center.y, 1.0, 1e-15);
  EXPECT_NEAR(clockwise.sweep, pi / 2, 1e-15);
  Piece const half = Pieces("G0 X1 Y0\nG3 X-1 Y0 R0.9999").at(0);  // rounded too short
  EXPECT_NEAR(half.sweep, pi, 1e-7);
}

TEST(ParseGCode, AnArcWithoutEndIsAFullCircle) {
  std::vector<Piece> const halves = Pieces("G0 X1 Y0\nG2 I-1\n");
  ASSERT_EQ(halves.size(), 2u);
  EXPECT_FALSE(halves[0].counterClockwise);
  EXPECT_NEAR(halves[0].sweep + halves[1].sweep, 2.0 * pi, 1e-15);
}

TEST(ParseGCode, TheFirstMovePlacesTheStart) {
  std::vector<Piece> const pieces = Pieces("G1 X1 Y1\nX2\n");
  ASSERT_EQ(pieces.size(), 1u);
  EXPECT_TRUE(AreEqual(pieces[0].start, {1, 1}));
}

TEST(ParseGCode, InchesAreKept) {
  ContourFile const contour = ParseGCode("G20\nG0 X0 Y0\nG1 X1\n", "p.nc");
  EXPECT_EQ(contour.units, "inch");
  EXPECT_EQ(contour.pieces.at(0).end.x, 1.0);
}

TEST(ParseGCode, NamesLineAndWord) {
  EXPECT_EQ(Complaint("G21\nG41 X1"), "p.nc:2: 'G41' is not supported");
  EXPECT_EQ(Complaint("G19"), "p.nc:1: 'G19' is not supported");
  EXPECT_EQ(Complaint("G1.5 X1"), "p.nc:1: 'G1.5' is not supported");
  EXPECT_EQ(Complaint("G-1 X1"), "p.nc:1: 'G-1' is not supported");
  EXPECT_EQ(Complaint("M98 P1"), "p.nc:1: 'M98' is not supported");
  EXPECT_EQ(Complaint("G1 X1 A90"), "p.nc:1: 'A90' is not supported");
  EXPECT_EQ(Complaint("G0 X0 Y0\nG1 X1 K2"), "p.nc:2: I, J, K and R belong to G2 and G3 only");
  EXPECT_EQ(Complaint("G1 X#1"), "p.nc:1: 'X#1' is no word of G-code");
  EXPECT_EQ(Complaint("G1 Xnan"), "p.nc:1: 'Xnan' is no word of G-code");
  EXPECT_EQ(Complaint("G1 X1.2.3"), "p.nc:1: 'X1.2.3' is no word of G-code");
  EXPECT_EQ(Complaint("G1 X1 X2"), "p.nc:1: 'X2' is the second such word in its line");
  EXPECT_EQ(Complaint("(no end"), "p.nc:1: '(no end' is a comment without end");
  EXPECT_EQ(Complaint("X1 Y2"), "p.nc:1: a move before any of G0 to G3");
  EXPECT_EQ(Complaint("G2 X1 Y2 I1"), "p.nc:1: an arc before the place of the tool is known");
  EXPECT_EQ(Complaint("G0 X0 Y0\nG2 X1 Y1"), "p.nc:2: an arc has neither R nor I and J");
  EXPECT_EQ(Complaint("G0 X0 Y0\nG2 X1 Y1 R1 I1"), "p.nc:2: an arc has both R and I or J");
  EXPECT_EQ(Complaint("G0 X0 Y0\nG2 X1 Y1 I0 J0"), "p.nc:2: an arc has no radius");
  EXPECT_EQ(Complaint("G0 X0 Y0\nG2 X1 Y1 I1 J0.5"),
            "p.nc:2: the radius of an arc is 1.11803 at its start and 0.5 at its end");
  EXPECT_EQ(Complaint("G0 X0 Y0\nG2 X3 Y0 R1"),
            "p.nc:2: an arc by R with the radius 1 cannot span 3");
  EXPECT_EQ(Complaint("G0 X0 Y0\nG2 X0 Y0 R1"), "p.nc:2: an arc by R ends where it starts");
  EXPECT_EQ(Complaint("G0 X0 Y0 Z0\nG1 X1 Z-1"),
            "p.nc:2: a cut that leaves the plane: z changes with x and y");
  EXPECT_EQ(Complaint("G0 X0 Y0\nG1 X1 I1"), "p.nc:2: I, J, K and R belong to G2 and G3 only");
  EXPECT_EQ(Complaint("G21\nG0 X0 Y0\nG1 X1\nG20"), "p.nc:4: the units change within the contour");
  EXPECT_EQ(Complaint("G90.1\nG0 X0 Y0\nG2 X2 I1"),
            "p.nc:3: an absolute centre (G90.1) needs both I and J");
  EXPECT_EQ(Complaint("G0 X" + std::string(200, '9')),
            "p.nc:1: 'X999999999999999999999999999999999999999...' is too large");
}

TEST(ParseGCode, PassesOverDwell) { EXPECT_EQ(Pieces("G0 X0 Y0\nG4 P0.5\nG1 X1\n").size(), 1u); }

}  // namespace
}  // namespace Vorn::IO
