#include <gtest/gtest.h>

#include "io/FormatContours.h"
#include "vorn/io/PointOutlines.h"

namespace Vorn::IO {
namespace {

using FormatContours::Refusal;

std::vector<PointFile> Parse(std::string const& text, std::string const& path,
                             PointReading const& reading = {}) {
  return ParsePointOutlines(text, path, reading);
}

void ExpectPoints(PointFile const& file, std::vector<XY> const& expected) {
  ASSERT_EQ(file.points.size(), expected.size()) << file.path;
  for (std::size_t i = 0; i < expected.size(); ++i) {
    EXPECT_EQ(file.points[i].x, expected[i].x) << file.path << " point " << i;
    EXPECT_EQ(file.points[i].y, expected[i].y) << file.path << " point " << i;
    EXPECT_EQ(file.points[i].w, 0.0);
  }
}

std::string Dxf(std::string text) {
  text = "0 SECTION 2 ENTITIES " + text + " 0 ENDSEC 0 EOF ";
  for (char& c : text) {
    if (c == ' ') c = '\n';
  }
  return text;
}

TEST(ParsePointOutlines, ATableIsOneRun) {
  std::vector<PointFile> const files = Parse("x,y,w\n0,0,.1\n5,0,.1\n", "p.csv",
                                             {{ToleranceColumn::Use::IfPresent, "w"}, {}, {}, {}});
  ASSERT_EQ(files.size(), 1u);
  EXPECT_TRUE(files[0].hasTolerances);
  EXPECT_EQ(files[0].NameOf(1), "point 1 (line 3)");
}

TEST(ParsePointOutlines, TakesVerticesOfEveryFormat) {
  std::vector<XY> const corner = {{0, 0}, {4, 0}, {4, 3}};
  ExpectPoints(Parse("LINESTRING (0 0, 4 0, 4 3)", "p.wkt").at(0), corner);
  ExpectPoints(Parse("G21\nG0 X0 Y0\nG1 X4\nG1 Y3\nM2\n", "p.nc").at(0), corner);
  ExpectPoints(Parse(R"({"type":"LineString","coordinates":[[0,0],[4,0],[4,3]]})", "p.json").at(0),
               corner);
  ExpectPoints(Parse("<svg><path d='M0 0H4V-3'/></svg>", "p.svg").at(0), corner);
  ExpectPoints(
      Parse(Dxf("0 LWPOLYLINE 8 0 90 3 70 0 10 0 20 0 10 4 20 0 10 4 20 3"), "p.dxf").at(0),
      corner);
  ExpectPoints(Parse(Dxf("0 POLYLINE 8 0 66 1 70 0 0 VERTEX 8 0 10 0 20 0 0 VERTEX 8 0 10 4 20 0 "
                         "0 VERTEX 8 0 10 4 20 3 0 SEQEND 8 0"),
                     "p.dxf")
                   .at(0),
               corner);
}

TEST(ParsePointOutlines, ChainsLinesInAnyOrder) {
  std::vector<PointFile> const files =
      Parse(Dxf("0 LINE 8 0 10 4 20 3 11 4 21 0 0 LINE 8 0 10 9 20 9 11 4 21 3 "
                "0 LINE 8 0 10 0 20 0 11 4 21 0"),
            "p.dxf");
  ASSERT_EQ(files.size(), 1u);
  EXPECT_EQ(files[0].points.size(), 4u);
  EXPECT_EQ(files[0].path, "p.dxf");
  EXPECT_EQ(files[0].outline, 0u);
}

TEST(ParsePointOutlines, AClosedRunRepeatsItsFirstPoint) {
  ExpectPoints(Parse("POLYGON ((0 0, 4 0, 4 3, 0 0))", "p.wkt").at(0),
               {{0, 0}, {4, 0}, {4, 3}, {0, 0}});
  ExpectPoints(
      Parse(Dxf("0 LWPOLYLINE 8 0 90 3 70 1 10 0 20 0 10 4 20 0 10 4 20 3"), "p.dxf").at(0),
      {{0, 0}, {4, 0}, {4, 3}, {0, 0}});
}

TEST(ParsePointOutlines, SeveralRunsAreSeveralOutlines) {
  std::vector<PointFile> const files =
      Parse("POLYGON ((0 0, 9 0, 9 9, 0 0), (5 1, 6 1, 6 2, 5 1))", "p.wkt");
  ASSERT_EQ(files.size(), 2u);
  EXPECT_EQ(files[0].path, "p.wkt, outline 1");
  EXPECT_EQ(files[1].outline, 2u);
  EXPECT_EQ(files[1].NameOf(1), "point 1 at (6, 1)");
}

TEST(ParsePointOutlines, OutlinesThatBeginInOnePlaceStayApart) {
  std::vector<PointFile> const files =
      Parse("MULTILINESTRING ((0 0, 9 0, 9 9, 0 0), (0 0, -1 0, -1 -2, 0 0))", "p.wkt");
  ASSERT_EQ(files.size(), 2u);
  EXPECT_EQ(files[0].points.size(), 4u);
  EXPECT_EQ(files[1].points.size(), 4u);
}

TEST(ParsePointOutlines, DensePointsOfAPolylineStayInOrder) {
  // Steps far below the tolerance of chaining, which is 1e-6 of the size.
  std::string text = "LINESTRING (1000 0, 0 0";
  for (int i = 1; i <= 1000; ++i) text += ", 0 " + std::to_string(i * 1e-4);
  std::vector<PointFile> const files = Parse(text + ")", "p.wkt");
  ASSERT_EQ(files.size(), 1u);
  ASSERT_EQ(files[0].points.size(), 1002u);
  for (std::size_t i = 3; i < files[0].points.size(); ++i) {
    EXPECT_GT(files[0].points[i].y, files[0].points[i - 1].y);
  }
}

TEST(ParsePointOutlines, EveryFormatNamesThePlaceOfAnArc) {
  auto const complaint = [](std::string const& text, std::string const& path) {
    return Refusal([&] { Parse(text, path); });
  };
  EXPECT_EQ(complaint("G21\nG0 X1 Y0\nG1 X4\nG3 X2 Y2 I-2 J0\n", "p.nc"),
            "p.nc:4: an arc from (4, 0) to (2, 2)");
  EXPECT_EQ(complaint("G21\nG0 X1 Y0\nG3 I-1\n", "p.nc"), "p.nc:3: an arc from (1, 0) to (-1, 0)")
      << "a full circle";
  EXPECT_EQ(
      complaint(Dxf("0 LINE 8 0 10 0 20 0 11 4 21 0 0 ARC 8 0 10 0 20 0 40 2 50 0 51 90"), "p.dxf"),
      "p.dxf:17: entity 2 (ARC): an arc from (2, 0) to (0, 2)");
  EXPECT_EQ(
      complaint(Dxf("0 LWPOLYLINE 8 0 90 3 70 0 10 0 20 0 10 4 20 0 42 1 10 4 20 2"), "p.dxf"),
      "p.dxf:5: entity 1 (LWPOLYLINE): an arc from (4, 0) to (4, 2)");
  EXPECT_EQ(complaint("COMPOUNDCURVE ((0 0, 1 0),\n  CIRCULARSTRING (1 0, 2 1, 3 0))", "p.wkt"),
            "p.wkt:2:33: an arc from (1, 0) to (3, 0)");
  EXPECT_EQ(complaint("<svg>\n <path d='M0 0H1A1 1 0 0 1 3 0'/></svg>", "p.svg"),
            "p.svg:2:2: path: an arc from (1, 0) to (3, 0)");
  EXPECT_EQ(complaint("{\"schemaVersion\": 1, \"elements\": [\n"
                      " {\"kind\": \"line\", \"start\": {\"x\": 0, \"y\": 0}, "
                      "\"end\": {\"x\": 1, \"y\": 0}},\n"
                      " {\"kind\": \"arc\", \"start\": {\"x\": 1, \"y\": 0}, "
                      "\"end\": {\"x\": 3, \"y\": 0}, \"center\": {\"x\": 2, \"y\": 0}, "
                      "\"radius\": 1, \"direction\": \"ccw\"}]}",
                      "p.json"),
            "p.json:3:2: elements[1]: an arc from (1, 0) to (3, 0)");
}

TEST(ParsePointOutlines, ArcsAreRefusedUnlessFlattened) {
  std::string const text = "CIRCULARSTRING (1 0, 0 1, -1 0)";
  EXPECT_EQ(Refusal([&] { Parse(text, "p.wkt"); }), "p.wkt:1:32: an arc from (1, 0) to (-1, 0)");
  PointReading reading;
  reading.flattening = 0.01;
  std::vector<PointFile> const files = Parse(text, "p.wkt", reading);
  ASSERT_EQ(files.size(), 1u);
  for (WPoint const& point : files[0].points) {
    EXPECT_NEAR(std::hypot(point.x, point.y), 1.0, 1e-15);
  }
  reading.flattening = 1e-15;
  EXPECT_EQ(Refusal([&] { Parse(text, "p.wkt", reading); }),
            "p.wkt: arcs flattened so finely have more than 2000000 chords");
}

TEST(ParsePointOutlines, TheContentTellsWhereTheNameDoesNot) {
  EXPECT_EQ(Parse("LINESTRING (0 0, 4 0, 4 3)", "-").at(0).points.size(), 3u);
  EXPECT_EQ(Parse("<svg><path d='M0 0H4'/></svg>", "part.txt").at(0).points.size(), 2u);
  // A table whose preamble reads as words of G-code.
  EXPECT_TRUE(IsPointTable("g1 probe\nx,y\n0,0\n4,0\n", "part.txt", {}));
}

TEST(ParsePointOutlines, WhatIsSaidGoesBeforeTheName) {
  PointReading reading;
  reading.format = Format::Csv;
  EXPECT_EQ(Parse("0,0\n4,0\n", "part.nc", reading).at(0).points.size(), 2u);
  reading.format = Format::GCode;
  EXPECT_EQ(Parse("G0 X0 Y0\nG1 X4\n", "part.txt", reading).at(0).points.size(), 2u);
}

TEST(ParsePointOutlines, ColumnsBelongToTables) {
  PointReading reading;
  reading.columns = {"1", "2", ""};
  EXPECT_EQ(
      Refusal([&] { Parse("LINESTRING (0 0, 1 1)", "p.wkt", reading); }, FailureKind::BadArgument),
      "p.wkt: is no table that has columns");
}

TEST(ParsePointOutlines, AnEmptyFileIsRefused) {
  EXPECT_EQ(Refusal([] { Parse("<svg/>", "p.svg"); }),
            "p.svg: holds no contour: there are no pieces");
  EXPECT_EQ(Refusal([] { Parse("", "p.dxf"); }), "p.dxf: is empty");
}

}  // namespace
}  // namespace Vorn::IO
