#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "io/FormatContours.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {
namespace {

using FormatContours::Refusal;
using std::numbers::pi;

std::string Page(std::string const& shapes, std::string const& attributes = "") {
  return "<svg xmlns=\"http://www.w3.org/2000/svg\"" + attributes + ">\n" + shapes + "</svg>\n";
}

ContourFile Read(std::string const& shapes, std::optional<double> flattening = {}) {
  return ParseContour(Page(shapes), "p.svg", ReadOptions{{}, flattening});
}

std::vector<Piece> Path(std::string const& data, std::optional<double> flattening = {}) {
  return Read("<path d=\"" + data + "\"/>\n", flattening).pieces;
}

std::string Complaint(std::string const& shapes) {
  return Refusal([&] { Read(shapes); });
}

std::string PathComplaint(std::string const& data) {
  return Refusal([&] { Path(data); });
}

void ExpectAt(XY const& at, double x, double y) {
  EXPECT_NEAR(at.x, x, 1e-12);
  EXPECT_NEAR(at.y, y, 1e-12);
}

TEST(ParseSvg, TurnsTheDrawingUp) {
  std::vector<Piece> const pieces = Path("M 1 2 L 4 6");
  ASSERT_EQ(pieces.size(), 1u);
  ExpectAt(pieces[0].start, 1, -2);
  ExpectAt(pieces[0].end, 4, -6);
}

TEST(ParseSvg, TakesEveryLineOfAPath) {
  // Absolute and relative, repeated, set apart by signs and points alone.
  std::vector<Piece> const pieces = Path("M1,1 5-1.5.5 8 L8 0H9h1V2v3m10,0l1 1 1 1z M0 0 1e1 0");
  ASSERT_EQ(pieces.size(), 11u);
  ExpectAt(pieces[0].end, 5, 1.5);
  ExpectAt(pieces[1].start, 5, 1.5);
  ExpectAt(pieces[1].end, 0.5, -8.0);
}

TEST(ParseSvg, RelativeMovesGoOnFromThePen) {
  std::vector<Piece> const pieces = Path("m 1 1 2 0 0 2 z m 10 0 h 1");
  ASSERT_EQ(pieces.size(), 4u);
  ExpectAt(pieces[2].end, 1, -1);
  ExpectAt(pieces[3].start, 11, -1);
  ExpectAt(pieces[3].end, 12, -1);
}

TEST(ParseSvg, ArcsOfCirclesStayArcs) {
  // A quarter with sweep 1 goes clockwise on the page, and so it does with y pointing up.
  std::vector<Piece> const pieces = Path("M 0 0 A 2 2 0 0 1 2 2 a 2 2 0 1 0 2,-2");
  ASSERT_EQ(pieces.size(), 2u);
  ASSERT_TRUE(pieces[0].IsArc());
  ExpectAt(pieces[0].center, 0, -2);
  EXPECT_FALSE(pieces[0].counterClockwise);
  EXPECT_NEAR(pieces[0].sweep, pi / 2, 1e-12);
  ASSERT_TRUE(pieces[1].IsArc());
  ExpectAt(pieces[1].center, 4, -2);
  EXPECT_TRUE(pieces[1].counterClockwise);
  EXPECT_NEAR(pieces[1].sweep, 1.5 * pi, 1e-12);
}

TEST(ParseSvg, FlagsNeedNothingBetweenThem) {
  std::vector<Piece> const pieces = Path("M0 0a2 2 0 012 2");
  ASSERT_EQ(pieces.size(), 1u);
  ExpectAt(pieces[0].center, 0, -2);
}

TEST(ParseSvg, ARadiusTooSmallBecomesHalfTheChord) {
  std::vector<Piece> const pieces = Path("M0 0 A 1 1 0 0 1 8 0");
  EXPECT_NEAR(pieces[0].radius, 4.0, 1e-12);
}

TEST(ParseSvg, CurvesAreRefusedUnlessFlattened) {
  EXPECT_EQ(PathComplaint("M0 0 C 0 1 1 1 1 0"),
            "p.svg:2:1: path: a curve that is no arc of a circle");
  EXPECT_EQ(PathComplaint("M0 0 A 2 1 0 0 1 1 1"),
            "p.svg:2:1: path: a curve that is no arc of a circle");
}

TEST(ParseSvg, ChordsFollowCubicsAndTheirSmoothSuccessors) {
  double const tolerance = 1e-3;
  std::vector<Piece> const pieces = Path("M0 0 C 0 1 1 1 1 0 S 2 -1 2 0 s 1 1 1 0", tolerance);
  // The curve is three arches of one shape, up, down and up; halfway each is 0.75 high.
  auto const nearest = [&](double x, double y) {
    double best = 1e9;
    for (Piece const& piece : pieces) best = std::min(best, DistanceTo(piece, x, y));
    return best;
  };
  EXPECT_LE(nearest(0.5, -0.75), tolerance);
  EXPECT_LE(nearest(1.5, 0.75), tolerance);
  EXPECT_LE(nearest(2.5, -0.75), tolerance);
  ExpectAt(pieces.back().end, 3, 0);
}

TEST(ParseSvg, ChordsFollowQuadraticsAndTheirSmoothSuccessors) {
  double const tolerance = 1e-3;
  std::vector<Piece> const pieces = Path("M0 0 Q 1 2 2 0 T 4 0 t 2 0", tolerance);
  auto const nearest = [&](double x, double y) {
    double best = 1e9;
    for (Piece const& piece : pieces) best = std::min(best, DistanceTo(piece, x, y));
    return best;
  };
  EXPECT_LE(nearest(1, -1), tolerance);
  EXPECT_LE(nearest(3, 1), tolerance);
  EXPECT_LE(nearest(5, -1), tolerance);
}

TEST(ParseSvg, ASmoothCurveBehindALineBeginsStraight) {
  // Without a curve before, the first control point is where the pen stands: the same curve.
  std::vector<Piece> const smooth = Path("M0 0 h1 S 2 1 2 0", 1e-3);
  std::vector<Piece> const plain = Path("M0 0 h1 C 1 0 2 1 2 0", 1e-3);
  ASSERT_EQ(smooth.size(), plain.size());
  for (std::size_t i = 0; i < smooth.size(); ++i) {
    ExpectAt(smooth[i].end, plain[i].end.x, plain[i].end.y);
  }
}

TEST(ParseSvg, ChordsFollowEllipses) {
  double const tolerance = 1e-4;
  std::vector<Piece> const pieces =
      Read("<ellipse cx='3' cy='1' rx='5' ry='2' transform='rotate(30 3 1)'/>", tolerance).pieces;
  ASSERT_GT(pieces.size(), 20u);
  double const c = std::cos(pi / 6);
  double const s = std::sin(pi / 6);
  for (Piece const& piece : pieces) {
    // Back into the frame of the ellipse, on the page.
    double const dx = piece.start.x - 3;
    double const dy = -piece.start.y - 1;
    double const u = (c * dx + s * dy) / 5;
    double const v = (-s * dx + c * dy) / 2;
    EXPECT_NEAR(std::hypot(u, v), 1.0, 1e-12);
  }
  ExpectAt(pieces.back().end, pieces.front().start.x, pieces.front().start.y);
}

TEST(ParseSvg, TurnedEllipticArcsEndWhereTheFileSays) {
  std::vector<Piece> const pieces = Path("M 1 1 A 5 2 30 1 0 4 3", 1e-3);
  ExpectAt(pieces.front().start, 1, -1);
  ExpectAt(pieces.back().end, 4, -3);
  double length = 0.0;
  for (Piece const& piece : pieces) length += piece.length;
  // The larger part of an ellipse with a circumference of about 23.
  EXPECT_GT(length, 11.5);
  EXPECT_LT(length, 23.1);
}

TEST(ParseSvg, TakesTheBasicShapes) {
  ContourFile const contour = Read(
      "<polyline points='0,0 1,0 1,1'/><polygon points='5 5 6 5 6 6'/>"
      "<line x1='1' y1='2' x2='3' y2='4'/><rect x='1' y='1' width='4' height='2'/>"
      "<circle cx='2' cy='3' r='1.5'/>");
  ASSERT_EQ(contour.pieces.size(), 2u + 3u + 1u + 4u + 2u);
  Piece const& half = contour.pieces.back();
  ExpectAt(half.center, 2, -3);
  EXPECT_EQ(half.radius, 1.5);
}

TEST(ParseSvg, CornersOfARectAreArcs) {
  std::vector<Piece> const pieces = Read("<rect width='10' height='6' rx='2'/>").pieces;
  ASSERT_EQ(pieces.size(), 8u);
  ExpectAt(pieces[1].center, 8, -2);
  EXPECT_NEAR(pieces[1].sweep, pi / 2, 1e-12);
  ExpectAt(pieces[7].end, 2, 0);
}

TEST(ParseSvg, TransformsWorkFromTheInsideOut) {
  std::vector<Piece> const pieces =
      Read(
          "<g transform='translate(10,20) scale(2)'><path transform='rotate(90)' d='M1 0 L2 0'/>"
          "</g>")
          .pieces;
  // (1, 0) turned by 90 degrees on the page is (0, 1), doubled (0, 2), moved (10, 22).
  ExpectAt(pieces[0].start, 10, -22);
  ExpectAt(pieces[0].end, 10, -24);
}

TEST(ParseSvg, KnowsEveryTransform) {
  auto const end = [](std::string const& transform) {
    return Read("<line x2='3' y2='4' transform='" + transform + "'/>").pieces[0].end;
  };
  ExpectAt(end("matrix(1 2 3 4 5 6)"), 1 * 3 + 3 * 4 + 5, -(2 * 3 + 4 * 4 + 6));
  ExpectAt(end("translate(5)"), 8, -4);
  ExpectAt(end("scale(2, -1)"), 6, 4);
  ExpectAt(end("skewX(45)"), 7, -4);
  ExpectAt(end("skewY(45)"), 3, -7);
  ExpectAt(end("rotate(180 3 0)"), 3, 4);
}

TEST(ParseSvg, AMirrorTurnsArcsRound) {
  std::vector<Piece> const pieces =
      Read("<path transform='scale(1 -1)' d='M 0 0 A 2 2 0 0 1 2 2'/>").pieces;
  EXPECT_TRUE(pieces[0].counterClockwise);
  ExpectAt(pieces[0].center, 0, 2);
}

TEST(ParseSvg, AStretchedCircleIsAnEllipse) {
  EXPECT_NE(Complaint("<circle r='2' transform='scale(2 1)'/>")
                .find("a curve that is no arc of a circle"),
            std::string::npos);
}

TEST(ParseSvg, ThePageGivesTheTrueSize) {
  auto const read = [](std::string const& attributes) {
    return ParseContour(Page("<line x2='96'/>", attributes), "p.svg");
  };
  EXPECT_EQ(read("").units, "");
  EXPECT_EQ(read("").pieces[0].length, 96.0);
  ContourFile const same = read(" width='200mm' height='100mm' viewBox='0 0 200 100'");
  EXPECT_EQ(same.units, "mm");
  EXPECT_EQ(same.pieces[0].end.x, 96.0);
  EXPECT_NEAR(read(" width='100mm' viewBox='0 0 200 100'").pieces[0].length, 48.0, 1e-12);
  EXPECT_NEAR(read(" width='20cm' viewBox='0 0 100 100'").pieces[0].length, 192.0, 1e-12);
  // Without a viewBox the numbers are pixels, 96 to the inch.
  EXPECT_NEAR(read(" width='100mm'").pieces[0].length, 25.4, 1e-12);
  ContourFile const inches = read(" width='2in' viewBox='0 0 96 96'");
  EXPECT_EQ(inches.units, "inch");
  EXPECT_NEAR(inches.pieces[0].length, 2.0, 1e-12);
  EXPECT_EQ(read(" width='100%' height='50px' viewBox='0 0 10 10'").units, "");
}

TEST(ParseSvg, PassesOverWhatIsNotDrawn) {
  ContourFile const contour = Read(
      "<defs><path d='M0 0 C 1 1 2 2 3 0'/></defs><text>A</text>"
      "<g display='none'><line x2='9'/></g><g style='stroke:red; display : none'><line x2='9'/></g>"
      "<path d=''/><line x2='5'/>");
  ASSERT_EQ(contour.pieces.size(), 1u);
  EXPECT_EQ(contour.pieces[0].length, 5.0);
}

TEST(ParseSvg, NamesPlaceAndElement) {
  EXPECT_EQ(PathComplaint("M 1 2 L 3 x"),
            "p.svg:2:1: path: 'x', character 11 of an attribute, is not a number");
  EXPECT_EQ(PathComplaint("M 1 2 L 3"), "p.svg:2:1: path: the text of an attribute stops early");
  EXPECT_EQ(PathComplaint("L 1 2"),
            "p.svg:2:1: path: '1', character 3 of an attribute, is drawn before the first move");
  EXPECT_EQ(PathComplaint("5 5"),
            "p.svg:2:1: path: '5', character 1 of an attribute, follows no command");
  EXPECT_EQ(PathComplaint("M 0 0 L 1e200 0"),
            "p.svg:2:1: path: '1e200', character 9 of an attribute, is too large");
  EXPECT_EQ(PathComplaint("M 0 0 A 1 1 0 2 0 1 1"),
            "p.svg:2:1: path: '2', character 15 of an attribute, is neither 0 nor 1");
  EXPECT_EQ(PathComplaint("M 0 0 A 1e-200 1 0 0 1 2 0"),
            "p.svg:2:1: path: an arc has a half axis that is too short");
  EXPECT_EQ(Complaint("<polyline points='0 0 1'/>"),
            "p.svg:2:1: polyline: the last of its points has no y");
  EXPECT_EQ(Complaint("<line x2='5mm'/>"),
            "p.svg:2:1: line: x2 '5mm' is no plain number: only these are lengths of the drawing");
  EXPECT_EQ(Complaint("<g transform='twist(3)'/>"),
            "p.svg:2:1: g: transform 'twist(3)' is not known");
  EXPECT_EQ(Complaint("<use href='#a'/>"),
            "p.svg:2:1: use: is not followed: put a copy in its place");
  EXPECT_EQ(
      Complaint("<g transform='scale(1e100)'><g transform='scale(1e100)'><line x2='1'/></g></g>"),
      "p.svg:2:57: line: a transformed coordinate is too large");
  EXPECT_EQ(Refusal([] { ParseContour("<html><body/></html>", "p.svg"); }),
            "p.svg:1:1: html: is no SVG drawing");
}

TEST(ParseSvg, RefusesWhatIsNotXml) {
  EXPECT_EQ(Complaint("<path d='M0 0'"),
            "p.svg:2:15: is not XML from here on: not well-formed (invalid token)");
  EXPECT_EQ(Refusal([] { ParseContour("<svg>", "p.svg"); }),
            "p.svg:1:6: is not XML from here on: no element found");
}

TEST(ParseSvg, RefusesDeepNesting) {
  std::string text;
  for (int i = 0; i < 100000; ++i) text += "<g>";
  EXPECT_EQ(Complaint(text), "p.svg:2:2998: g: is nested deeper than 1000 elements");
}

TEST(ParseSvg, EntitiesDoNotFillTheMemory) {
  std::string text = "<!DOCTYPE svg [<!ENTITY a0 'M0 0 1 1'>\n";
  for (int i = 1; i < 30; ++i) {
    std::string const before = "&a" + std::to_string(i - 1) + ";";
    std::string line = "<!ENTITY a" + std::to_string(i) + " '";
    for (int k = 0; k < 10; ++k) line += before;
    text += line + "'>\n";
  }
  text += "]><svg><path d='&a29;'/></svg>";
  std::string const complaint = Refusal([&] { ParseContour(text, "p.svg"); });
  EXPECT_NE(complaint.find("amplification"), std::string::npos) << complaint;
}

}  // namespace
}  // namespace Vorn::IO
