#include <gtest/gtest.h>

#include <numbers>

#include "io/FormatContours.h"
#include "io/formats/Dxf.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;
using std::numbers::pi;

/// "0 LINE 8 0": codes and values divided by blanks become lines.
std::string OnLines(std::string text) {
  for (char& c : text) {
    if (c == ' ') c = '\n';
  }
  return text + "\n";
}

std::string Drawing(std::string const& entities) {
  return OnLines("0 SECTION 2 ENTITIES " + entities + " 0 ENDSEC 0 EOF");
}

ContourFile Read(std::string const& entities) { return ParseDxf(Drawing(entities), "p.dxf"); }

std::string Complaint(std::string const& entities) {
  return Refusal([&] { Read(entities); });
}

std::string const kLineToRight = "0 LINE 8 0 10 0 20 0 11 4 21 0";

TEST(ToDxf, IsOnePolylineWithBulges) {
  std::string const text = ToDxf(Wedge());
  std::string const quarter = std::to_string(-std::tan(pi / 8)).substr(0, 8);
  EXPECT_NE(text.find(OnLines("9 $ACADVER 1 AC1009")), std::string::npos);
  EXPECT_NE(text.find("999\nunits mm\n"), std::string::npos);
  EXPECT_NE(text.find(OnLines("9 $EXTMIN 10 0.0 20 -1.0 30 0.0 9 $EXTMAX 10 5.0 20 0.0 30 0.0")),
            std::string::npos);
  EXPECT_NE(text.find(OnLines("0 POLYLINE 8 CONTOUR 66 1 10 0.0 20 0.0 30 0.0 70 1 "
                              "0 VERTEX 8 CONTOUR 10 0.0 20 0.0 30 0.0 "
                              "0 VERTEX 8 CONTOUR 10 4.0 20 0.0 30 0.0") +
                      "42\n" + quarter),
            std::string::npos);
  EXPECT_TRUE(text.ends_with(OnLines("0 SEQEND 8 CONTOUR 0 ENDSEC 0 EOF")));
}

TEST(ToDxf, EntitiesAreLinesAndCounterClockwiseArcs) {
  std::string const text = ToDxf(Wedge(), DxfStyle::Entities);
  EXPECT_NE(text.find(OnLines("0 LINE 8 CONTOUR_LINES 10 0.0 20 0.0 30 0.0 11 4.0 21 0.0 31 0.0 "
                              "0 ARC 8 CONTOUR_ARCS 10 4.0 20 -1.0 30 0.0 40 1.0 50 0.0 51 90.0")),
            std::string::npos)
      << text;
}

TEST(ToDxf, AGapBeginsAnotherPolyline) {
  std::string const text = ToDxf(WithGap());
  std::size_t const first = text.find("POLYLINE");
  EXPECT_NE(text.find("POLYLINE", first + 1), std::string::npos);
}

TEST(ToDxf, WritesNoExponents) {
  ContourFile contour = WithGap();
  contour.pieces = {MakeLine({1e-7, 1e22}, {3e-300, 0})};
  std::string const text = ToDxf(contour);
  EXPECT_NE(text.find("\n0.0000001\n"), std::string::npos);
  EXPECT_NE(text.find("\n10000000000000000000000.0\n"), std::string::npos);
  ContourFile const read = ParseDxf(text, "p.dxf");
  EXPECT_TRUE(SameBits(read.pieces.at(0), contour.pieces[0]));
}

TEST(ToDxf, ALineBreakInTheUnitsBreaksNothing) {
  ContourFile contour = WithGap();
  contour.units = "mm\n0\nEOF";
  EXPECT_EQ(ParseDxf(ToDxf(contour), "p.dxf").units, "mm 0 EOF");
}

TEST(ParseDxf, ChainsEntitiesThatRunTheOtherWay) {
  // Back from (4, 0), a counter-clockwise arc to be turned, and the closing line.
  ContourFile const contour = Read(
      "0 LINE 10 4 20 0 11 0 21 0 "
      "0 ARC 10 4 20 -1 40 1 50 0 51 90 "
      "0 LINE 10 0 20 0 11 5 21 -1");
  ASSERT_EQ(contour.pieces.size(), 3u);
  EXPECT_TRUE(contour.isClosed);
  EXPECT_TRUE(FindGaps(contour).empty());
  EXPECT_FALSE(contour.pieces[1].counterClockwise);
  EXPECT_LE(Apart(contour.pieces, Wedge().pieces), 1e-15);
}

TEST(ParseDxf, GapsAreKeptAndLinesNotTurnedForThem) {
  ContourFile const contour = Read(kLineToRight + " 0 LINE 10 9 20 0 11 4.5 21 0");
  ASSERT_EQ(FindGaps(contour).size(), 1u);
  EXPECT_EQ(FindGaps(contour)[0].size, 5.0);
}

TEST(ParseDxf, ACircleIsTwoHalves) {
  ContourFile const contour = Read("0 CIRCLE 10 1 20 2 40 3");
  ASSERT_EQ(contour.pieces.size(), 2u);
  EXPECT_TRUE(contour.isClosed);
  EXPECT_EQ(contour.pieces[0].end.x, -2.0);
  EXPECT_EQ(Read("0 ARC 10 1 20 2 40 3 50 0 51 360").pieces.size(), 2u);
}

TEST(ParseDxf, ReadsLightPolylines) {
  ContourFile const contour = Read(
      "0 LWPOLYLINE 8 0 90 3 70 1 38 7.5 10 0 20 0 10 4 20 0 42 -0.41421356237309503 10 5 20 -1");
  ASSERT_EQ(contour.pieces.size(), 3u);
  EXPECT_TRUE(contour.isClosed);
  EXPECT_LE(Apart(contour.pieces, Wedge().pieces), 1e-15);
}

TEST(ParseDxf, ReadsWhatIsDrawnOnTheBackOfThePlane) {
  Piece const arc = Read("0 ARC 10 1 20 0 40 1 50 0 51 90 210 0 220 0 230 -1").pieces.at(0);
  EXPECT_FALSE(arc.counterClockwise);
  EXPECT_TRUE(AreEqual(arc.center, {-1, 0}));
  EXPECT_NEAR(arc.start.x, -2.0, 1e-15);
  EXPECT_NEAR(arc.sweep, pi / 2, 1e-15);
  EXPECT_EQ(Complaint("0 ARC 10 1 20 0 40 1 50 0 51 90 210 1 220 0 230 0"),
            "p.dxf:5: entity 1 (ARC): is not in the plane of x and y");
}

TEST(ParseDxf, TakesUnitsFromTheHeaderWhenNoCommentSays) {
  std::string const header = "0 SECTION 2 HEADER 9 $INSUNITS 70 4 0 ENDSEC ";
  std::string const rest = "0 SECTION 2 ENTITIES " + kLineToRight + " 0 ENDSEC 0 EOF";
  EXPECT_EQ(ParseDxf(OnLines(header + rest), "p.dxf").units, "mm");
  EXPECT_EQ(ParseDxf("999\nunits inch\n" + OnLines(header + rest), "p.dxf").units, "inch");
  EXPECT_EQ(ParseDxf(OnLines(rest), "p.dxf").units, "");
}

TEST(ParseDxf, PassesOverAnnotationsBlocksAndPaperSpace) {
  std::string const text = OnLines(
      "0 SECTION 2 BLOCKS 0 SPLINE 10 0 0 ENDSEC 0 SECTION 2 ENTITIES 0 TEXT 10 0 20 0 1 x " +
      kLineToRight + " 0 POINT 10 7 20 7 0 CIRCLE 67 1 10 0 20 0 40 1 0 ENDSEC 0 EOF");
  EXPECT_EQ(ParseDxf(text, "p.dxf").pieces.size(), 1u);
}

TEST(ParseDxf, NamesLineAndEntity) {
  EXPECT_EQ(Complaint(kLineToRight + " 0 SOLID 70 8"),
            "p.dxf:17: entity 2 (SOLID): is none of LINE, ARC, CIRCLE, LWPOLYLINE, POLYLINE, "
            "ELLIPSE and SPLINE");
  EXPECT_EQ(Complaint("0 LINE 10 0 20 zero 11 4 21 0"),
            "p.dxf:10: entity 1 (LINE): group 20 'zero' is not a number");
  EXPECT_EQ(Complaint("0 LINE 10 0 20 1e999 11 4 21 0"),
            "p.dxf:10: entity 1 (LINE): group 20 '1e999' is not finite");
  EXPECT_EQ(Complaint("0 LINE 10 0 20 0 11 4"), "p.dxf:5: entity 1 (LINE): group 21 is missing");
  EXPECT_EQ(Complaint("0 CIRCLE 10 0 20 0 40 0"),
            "p.dxf:5: entity 1 (CIRCLE): radius 0 is not above 0");
  EXPECT_EQ(Complaint("0 LINE 10 0 20 0 30 1 11 4 21 0 31 2"),
            "p.dxf:5: entity 1 (LINE): is not flat in z");
  EXPECT_EQ(Complaint(kLineToRight + " 0 CIRCLE 10 0 20 0 30 1 40 1"),
            "p.dxf:17: entity 2 (CIRCLE): z is 1, but 0 before");
  EXPECT_EQ(Complaint("0 LWPOLYLINE 90 3 10 0 20 0 10 1 20 0"),
            "p.dxf:5: entity 1 (LWPOLYLINE): has 2 vertices and says 3");
  EXPECT_EQ(Complaint("0 LWPOLYLINE 90 1 10 0 20 0"),
            "p.dxf:5: entity 1 (LWPOLYLINE): has fewer than two vertices");
  EXPECT_EQ(Complaint("0 POLYLINE 66 1 70 64 0 SEQEND"), "p.dxf:5: entity 1 (POLYLINE): is a mesh");
  EXPECT_EQ(Complaint("0 POLYLINE 66 1 0 VERTEX 10 0 20 0"),
            "p.dxf:9: entity 1 (VERTEX): the sequence of vertices has no SEQEND");
}

TEST(ParseDxf, SaysWhereTheFileIsNotBuiltAsDxf) {
  auto const complaint = [](std::string const& text) {
    return Refusal([&] { ParseDxf(text, "p.dxf"); });
  };
  EXPECT_EQ(complaint("0\nSECTION\n2\nENTITIES\n0\n"),
            "p.dxf:5: the file stops after group code '0'");
  EXPECT_EQ(complaint("0\nSECTION\n2\nENTITIES\n"), "p.dxf:4: the file stops without EOF");
  EXPECT_EQ(complaint("0\nSECTION\nHEADER\n2\n"), "p.dxf:3: 'HEADER' is not a group code");
  EXPECT_EQ(complaint("123456\nx\n"), "p.dxf:1: '123456' is not a group code");
}

}  // namespace
}  // namespace Vorn::IO
