#include <gtest/gtest.h>

#include "io/FormatContours.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {
namespace {

using FormatContours::Refusal;

ContourFile Read(std::string const& text) { return ParseContour(text, "p.geojson"); }

std::string Complaint(std::string const& text) {
  return Refusal([&] { Read(text); });
}

TEST(ParseGeoJson, TakesLinesAndRings) {
  ContourFile const line = Read(R"({"type":"LineString","coordinates":[[0,0],[4,0],[4,3]]})");
  ASSERT_EQ(line.pieces.size(), 2u);
  EXPECT_EQ(line.pieces[1].length, 3.0);
  EXPECT_FALSE(line.isClosed);
  ContourFile const ring = Read(R"({"type":"Polygon","coordinates":[[[0,0],[4,0],[4,3],[0,0]]]})");
  ASSERT_EQ(ring.pieces.size(), 3u);
  EXPECT_TRUE(ring.isClosed);
}

TEST(ParseGeoJson, GoesThroughCollections) {
  ContourFile const contour = Read(R"({"type":"FeatureCollection","features":[
    {"type":"Feature","properties":{"units":"mm"},"geometry":
      {"type":"MultiLineString","coordinates":[[[0,0],[1,0]],[[5,0],[6,0]]]}},
    {"type":"Feature","properties":null,"geometry":null},
    {"type":"Feature","properties":{},"geometry":{"type":"GeometryCollection","geometries":[
      {"type":"Point","coordinates":[9,9]},
      {"type":"MultiPolygon","coordinates":[[[[0,0],[1,0],[1,1],[0,0]]]]}]}}]})");
  EXPECT_EQ(contour.pieces.size(), 5u);
  EXPECT_EQ(contour.units, "mm");
}

TEST(ParseGeoJson, LeavesHeightsOut) {
  EXPECT_EQ(Read(R"({"type":"LineString","coordinates":[[0,0,7],[4,0,8]]})").pieces[0].length, 4.0);
}

TEST(ParseGeoJson, AnyNameOfJsonDoes) {
  std::string const text = R"({"type":"LineString","coordinates":[[0,0],[4,0]]})";
  EXPECT_EQ(ParseContour(text, "p.json").pieces.size(), 1u);
  EXPECT_EQ(ParseContour(text, "standard input").pieces.size(), 1u);
}

TEST(ParseGeoJson, NamesWhatIsWrong) {
  EXPECT_EQ(Complaint(R"({"type":"LineString","coordinates":[[0,0],[4,"a"]]})"),
            "p.geojson:1:46: coordinates[1][1]: is not a number but '\"a\"'");
  EXPECT_EQ(Complaint(R"({"type":"LineString","coordinates":[[0,0]]})"),
            "p.geojson:1:36: coordinates: a line needs at least two points");
  EXPECT_EQ(Complaint(R"({"type":"LineString","coordinates":[[0,0],[4]]})"),
            "p.geojson:1:43: coordinates[1]: is no place but '[4]'");
  EXPECT_EQ(Complaint(R"({"type":"Polygon","coordinates":[[[0,0],[4,0],[4,3],[1,0]]]})"),
            "p.geojson:1:34: coordinates[0]: the last point of a ring is not its first one again");
  EXPECT_EQ(Complaint(R"({"type":"Polygon","coordinates":[[[0,0],[4,0],[0,0]]]})"),
            "p.geojson:1:34: coordinates[0]: a ring needs at least four points");
  EXPECT_EQ(Complaint(R"({"type":"Circle","coordinates":[]})"),
            "p.geojson:1:9: type: 'Circle' is no kind of GeoJSON");
  EXPECT_EQ(Complaint(R"({"type":"LineString"})"), "p.geojson:1:1: coordinates: is missing");
  EXPECT_EQ(Complaint("{\"type\":\"LineString\",\n\"coordinates\":[[0,0],[1"),
            "p.geojson:2:24: is not JSON to the end: the text stops early");
}

TEST(ParseGeoJson, NamesLineAndColumn) {
  EXPECT_EQ(
      Complaint("{\"type\": \"LineString\",\n \"coordinates\": [\n  [0, 0],\n  [1, true]\n]}"),
      "p.geojson:4:7: coordinates[1][1]: is not a number but 'true'");
}

TEST(ParseGeoJson, RefusesDeepNesting) {
  std::string text = R"({"type":"LineString","coordinates":)";
  for (int i = 0; i < 100000; ++i) text += '[';
  EXPECT_EQ(Complaint(text), "p.geojson:1:99: is nested deeper than 64 brackets");
}

TEST(ParseGeoJson, TellsOfDroppedHeights) {
  auto const hadHeights = [](std::string const& places) {
    return ParseContour(R"({"type":"LineString","coordinates":)" + places + "}", "p.geojson")
        .hadHeights;
  };
  EXPECT_TRUE(hadHeights("[[0,0,5],[1,0,5]]"));
  EXPECT_TRUE(hadHeights("[[0,0],[1,0,5]]"));
  EXPECT_FALSE(hadHeights("[[0,0],[1,0]]"));
}

}  // namespace
}  // namespace Vorn::IO
