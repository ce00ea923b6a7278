#include <gtest/gtest.h>

#include <numbers>

#include "io/FormatContours.h"
#include "io/formats/Wkt.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;
using std::numbers::pi;

std::string Complaint(std::string const& text) {
  return Refusal([&] { ParseWkt(text, "p.wkt"); });
}

ContourFile Of(std::vector<Piece> pieces) {
  ContourFile contour;
  contour.pieces = std::move(pieces);
  return contour;
}

TEST(ToWkt, LinesAreALinestring) {
  EXPECT_EQ(ToWkt(Of({MakeLine({0, 0}, {1, 0.5}), MakeLine({1, 0.5}, {2, 0})})),
            "LINESTRING (0 0, 1 0.5, 2 0)\n");
}

TEST(ToWkt, ArcsAreACircularstringThroughTheirMiddles) {
  EXPECT_EQ(ToWkt(Of({MakeArc({0, 0}, {2, 0}, {1, 0}, 1, false)})),
            "CIRCULARSTRING (0 0, 1 1, 2 0)\n");
}

TEST(ToWkt, BothAreACompoundcurve) {
  EXPECT_EQ(ToWkt(Of({MakeLine({-1, 0}, {0, 0}), MakeArc({0, 0}, {2, 0}, {1, 0}, 1, false),
                      MakeLine({2, 0}, {2, -1}), MakeLine({2, -1}, {3, -1})})),
            "COMPOUNDCURVE ((-1 0, 0 0), CIRCULARSTRING (0 0, 1 1, 2 0), (2 0, 2 -1, 3 -1))\n");
}

TEST(ToWkt, GapsMakeAMulticurve) {
  EXPECT_EQ(ToWkt(WithGap()), "MULTICURVE (LINESTRING (0 0, 1 0), LINESTRING (1.5 0, 2 3))\n");
}

TEST(ToWkt, ClosedCurvesEndExactlyWhereTheyStart) {
  ContourFile contour = Wedge();
  contour.pieces[2].end = {1e-10, -1e-10};
  std::vector<Piece> const read = ParseWkt(ToWkt(contour), "p.wkt").pieces;
  EXPECT_TRUE(AreEqual(read.back().end, read.front().start));
}

TEST(ParseWkt, ThreePointsGiveTheCircle) {
  Piece const arc = ParseWkt("CIRCULARSTRING(1 0, 0 1, 0 -1)", "p.wkt").pieces.at(0);
  EXPECT_NEAR(arc.center.x, 0.0, 1e-15);
  EXPECT_NEAR(arc.center.y, 0.0, 1e-15);
  EXPECT_NEAR(arc.radius, 1.0, 1e-15);
  EXPECT_NEAR(arc.sweep, 1.5 * pi, 1e-15);
  EXPECT_TRUE(arc.counterClockwise);
}

TEST(ParseWkt, ThreePointsInARowAreALine) {
  EXPECT_FALSE(ParseWkt("CIRCULARSTRING(0 0, 1 1, 2 2)", "p.wkt").pieces.at(0).IsArc());
}

TEST(ParseWkt, AnArcThatEndsWhereItStartsIsAFullCircle) {
  std::vector<Piece> const halves = ParseWkt("CIRCULARSTRING(0 0, 2 0, 0 0)", "p.wkt").pieces;
  ASSERT_EQ(halves.size(), 2u);
  EXPECT_EQ(halves[0].center.x, 1.0);
  EXPECT_EQ(halves[0].radius, 1.0);
  EXPECT_NEAR(halves[0].sweep + halves[1].sweep, 2.0 * pi, 1e-15);
}

TEST(ParseWkt, TakesPolygonsOfOneRing) {
  for (char const* text : {"POLYGON((0 0,1 0,0 1,0 0))", "curvepolygon ( ( 0 0,1 0, 0 1,0 0 ) )",
                           "SRID=25832;CURVEPOLYGON(LINESTRING(0 0,1 0,0 1,0 0)) ;",
                           "CURVEPOLYGON(COMPOUNDCURVE((0 0,1 0),(1 0,0 1,0 0)))",
                           "MULTILINESTRING((0 0,1 0),(1 0,0 1,0 0))"}) {
    ContourFile const contour = ParseWkt(text, "p.wkt");
    EXPECT_EQ(contour.pieces.size(), 3u) << text;
    EXPECT_TRUE(contour.isClosed) << text;
  }
}

TEST(ParseWkt, TakesEveryRingOfPolygons) {
  std::string const outer = "(0 0, 9 0, 0 9, 0 0)";
  std::string const hole = "(1 1, 2 2, 2 1, 1 1)";
  EXPECT_EQ(ParseWkt("POLYGON (" + outer + ", " + hole + ")", "p.wkt").pieces.size(), 6u);
  std::string const two = "((" + outer + ", " + hole + "), ((20 0, 21 0, 20 1, 20 0)))";
  ContourFile const contour = ParseWkt("MULTIPOLYGON " + two, "p.wkt");
  ASSERT_EQ(contour.pieces.size(), 9u);
  EXPECT_EQ(contour.pieces[6].start.x, 20.0);
  EXPECT_FALSE(contour.isClosed);
}

TEST(ParseWkt, NamesLineColumnAndText) {
  EXPECT_EQ(Complaint("LINESTRING (0 0,\n1 one)"), "p.wkt:2:3: 'one' is not a number");
  EXPECT_EQ(Complaint("LINESTRING (0 0, 1 nan)"),
            "p.wkt:1:20: 'nan' is not a finite number of usable size");
  EXPECT_EQ(Complaint("LINESTRING (0 0, 1e200 1)"),
            "p.wkt:1:18: '1e200' is not a finite number of usable size");
  EXPECT_EQ(Complaint("LINESTRING (0 0, 1 1"), "p.wkt:1:21: the text stops early");
  EXPECT_EQ(Complaint("LINESTRING (0 0 0 0 7, 1 1 1 1 7)"),
            "p.wkt:1:21: '7' is more than the four coordinates that a point may have");
  EXPECT_EQ(Complaint("LINESTRING (0 0 z, 1 1 1)"), "p.wkt:1:17: 'z' is not a number");
  EXPECT_EQ(Complaint("LINESTRING Q (0 0 0, 1 1 1)"),
            "p.wkt:1:12: 'Q' stands where a '(' should be");
  EXPECT_EQ(Complaint("LINESTRING EMPTY"), "p.wkt:1:12: 'EMPTY' stands where a '(' should be");
  EXPECT_EQ(Complaint("POINT (0 0)"), "p.wkt:1:1: 'POINT' is no curve that holds a contour");
  EXPECT_EQ(Complaint("LINESTRING (0 0, 1 1) LINESTRING"),
            "p.wkt:1:23: 'LINESTRING' does not belong here");
  EXPECT_EQ(Complaint("LINESTRING (0 0)"), "p.wkt:1:17: a line needs at least two points");
  EXPECT_EQ(Complaint("CIRCULARSTRING (0 0, 1 1, 2 0, 3 1)"),
            "p.wkt:1:36: arcs need an odd number of points, at least three, and here are 4");
  EXPECT_EQ(Complaint("CIRCULARSTRING (1 1, 1 1, 1 1)"),
            "p.wkt:1:31: the three points of an arc are one");
  EXPECT_EQ(Complaint("CIRCULARSTRING (0 0, 3 3, 2 2)"),
            "p.wkt:1:31: the middle point of an arc lies in a row with its ends, but not between "
            "them");
  EXPECT_EQ(Complaint("COMPOUNDCURVE (COMPOUNDCURVE ((0 0, 1 1)))"),
            "p.wkt:1:16: 'COMPOUNDCURVE' cannot be part of a compound curve");
}

TEST(ParseWkt, DropsHeightsAndMeasuresAndSaysSo) {
  ContourFile const plane = ParseWkt("LINESTRING (1 2, 3 4, 5 7)", "p.wkt");
  EXPECT_FALSE(plane.hadHeights);
  for (char const* text :
       {"LINESTRING Z (1 2 9, 3 4 9, 5 7 9)", "LINESTRING M (1 2 9, 3 4 9, 5 7 9)",
        "LINESTRING ZM (1 2 9 8, 3 4 9 8, 5 7 9 8)", "linestringz(1 2 9,3 4 9,5 7 9)",
        "LINESTRING (1 2 9, 3 4 9, 5 7 9)", "MULTILINESTRING Z ((1 2 9, 3 4 9), (3 4 9, 5 7 9))",
        "COMPOUNDCURVE Z ((1 2 9, 3 4 9), LINESTRING Z (3 4 9, 5 7 9))"}) {
    ContourFile const contour = ParseWkt(text, "p.wkt");
    EXPECT_TRUE(contour.hadHeights) << text;
    ASSERT_EQ(contour.pieces.size(), 2u) << text;
    EXPECT_EQ(contour.pieces[1].start.y, plane.pieces[1].start.y) << text;
    EXPECT_EQ(contour.pieces[1].end.x, plane.pieces[1].end.x) << text;
  }
  ContourFile const arc = ParseWkt("CIRCULARSTRING Z (0 0 1, 1 1 1, 2 0 1)", "p.wkt");
  ASSERT_EQ(arc.pieces.size(), 1u);
  EXPECT_EQ(arc.pieces[0].radius, 1.0);
}

}  // namespace
}  // namespace Vorn::IO
