#include <gtest/gtest.h>

#include <cmath>
#include <nlohmann/json.hpp>

#include "io/FormatContours.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;
using Json = nlohmann::json;

ContourFile Of(std::vector<Piece> pieces, bool isClosed = false) {
  ContourFile contour;
  contour.path = "p.json";
  contour.pieces = std::move(pieces);
  contour.isClosed = isClosed;
  return contour;
}

void AddSquare(double low, double side, bool isLeft, std::vector<Piece>* pieces) {
  std::vector<XY> corners = {
      {low, low}, {low + side, low}, {low + side, low + side}, {low, low + side}};
  if (!isLeft) std::swap(corners[1], corners[3]);
  for (std::size_t i = 0; i < 4; ++i) pieces->push_back(MakeLine(corners[i], corners[(i + 1) % 4]));
}

Json Written(ContourFile const& contour, std::optional<double> chords = {}) {
  WriteOptions options;
  options.chords = chords;
  return Json::parse(ToText(contour, Format::GeoJson, options));
}

double TwiceArea(Json const& ring) {
  double sum = 0.0;
  for (std::size_t i = 1; i < ring.size(); ++i) {
    sum += ring[i - 1][0].get<double>() * ring[i][1].get<double>() -
           ring[i][0].get<double>() * ring[i - 1][1].get<double>();
  }
  return sum;
}

TEST(ToGeoJson, AnOpenWayIsALineString) {
  Json const json = Written(Of({MakeLine({0, 0}, {1, 2}), MakeLine({1, 2}, {3, 4})}));
  EXPECT_EQ(json.at("type"), "FeatureCollection");
  ASSERT_EQ(json.at("features").size(), 1u);
  Json const& geometry = json.at("features")[0].at("geometry");
  EXPECT_EQ(geometry.at("type"), "LineString");
  EXPECT_EQ(geometry.at("coordinates"), Json({{0.0, 0.0}, {1.0, 2.0}, {3.0, 4.0}}));
  EXPECT_EQ(json.at("features")[0].at("properties"), Json::object());
}

TEST(ToGeoJson, RingsRunLeftOutsideAndRightInsideWhateverTheContourDoes) {
  for (bool const isOuterLeft : {false, true}) {
    for (bool const isHoleLeft : {false, true}) {
      std::vector<Piece> pieces;
      AddSquare(0, 10, isOuterLeft, &pieces);
      AddSquare(2, 3, isHoleLeft, &pieces);
      Json const json = Written(Of(pieces));
      ASSERT_EQ(json.at("features").size(), 1u);
      Json const& rings = json.at("features")[0].at("geometry").at("coordinates");
      ASSERT_EQ(rings.size(), 2u);
      EXPECT_EQ(TwiceArea(rings[0]), 200.0);
      EXPECT_EQ(TwiceArea(rings[1]), -18.0);
      for (Json const& ring : rings) EXPECT_EQ(ring.front(), ring.back());
    }
  }
}

TEST(ToGeoJson, AnIslandInAHoleIsAPolygonOfItsOwn) {
  std::vector<Piece> pieces;
  AddSquare(0, 10, true, &pieces);
  AddSquare(1, 8, true, &pieces);
  AddSquare(3, 2, true, &pieces);
  Json const json = Written(Of(pieces));
  ASSERT_EQ(json.at("features").size(), 2u);
  EXPECT_EQ(json.at("features")[0].at("geometry").at("coordinates").size(), 2u);
  EXPECT_EQ(json.at("features")[1].at("geometry").at("coordinates").size(), 1u);
}

TEST(ToGeoJson, ClosedAndOpenOutlinesKeepTheirOrder) {
  std::vector<Piece> pieces = {MakeLine({50, 0}, {51, 0})};
  AddSquare(0, 10, true, &pieces);
  pieces.push_back(MakeLine({60, 0}, {61, 0}));
  Json const json = Written(Of(pieces));
  std::vector<std::string> types;
  for (Json const& feature : json.at("features")) {
    types.push_back(feature.at("geometry").at("type"));
  }
  EXPECT_EQ(types, (std::vector<std::string>{"LineString", "Polygon", "LineString"}));
}

TEST(ToGeoJson, UnitsAndChordsAreProperties) {
  Json const json = Written(Wedge(), 0.01);
  Json const& properties = json.at("features")[0].at("properties");
  EXPECT_EQ(properties.at("units"), "mm");
  EXPECT_EQ(properties.at("chordTolerance"), 0.01);
  EXPECT_FALSE(
      Written(WithGap(), 0.01).at("features")[0].at("properties").contains("chordTolerance"))
      << "there are no arcs";
}

TEST(ToGeoJson, ChordsAreWithinTheirDistanceOfTheArcAndNotFarBelow) {
  for (double const chords : {1.0, 0.1, 0.001, 1e-6}) {
    double const radius = 10.0;
    Json const json = Written(Of({MakeArc({10, 0}, {-10, 0}, {0, 0}, radius, true)}), chords);
    Json const& places = json.at("features")[0].at("geometry").at("coordinates");
    double deepest = 0.0;
    for (std::size_t i = 1; i < places.size(); ++i) {
      double const x = 0.5 * (places[i - 1][0].get<double>() + places[i][0].get<double>());
      double const y = 0.5 * (places[i - 1][1].get<double>() + places[i][1].get<double>());
      deepest = std::max(deepest, radius - std::hypot(x, y));
    }
    EXPECT_LE(deepest, chords * (1 + 1e-6) + 1e-14);
    EXPECT_GT(deepest, 0.2 * chords) << "one chord less would be too far";
  }
}

TEST(ToGeoJson, ArcsNeedChords) {
  try {
    Written(Wedge());
    ADD_FAILURE() << "arcs without chords";
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::BadArgument);
    EXPECT_EQ(failure.Help(), Remedy::GiveChords);
  }
}

TEST(ToGeoJson, ChordsThatWouldFillTheMemoryAreRefused) {
  for (double const chords : {1e-15, 1e-300, 0.0, -1.0, std::nan("")}) {
    EXPECT_NE(Refusal([&] { Written(Wedge(), chords); }, FailureKind::BadArgument), "") << chords;
  }
}

TEST(ToGeoJson, CoordinatesReadBackAsTheSameBits) {
  for (std::uint64_t seed = 0; seed < 50; ++seed) {
    ContourFile contour = RandomContour(seed);
    std::erase_if(contour.pieces, [](Piece const& piece) { return piece.IsArc(); });
    ContourFile const read = ParseContour(ToText(contour, Format::GeoJson, {}), "p.geojson");
    ASSERT_EQ(read.pieces.size(), contour.pieces.size()) << seed;
    for (std::size_t i = 0; i < read.pieces.size(); ++i) {
      EXPECT_TRUE(SameBits(read.pieces[i].start, contour.pieces[i].start)) << seed;
      EXPECT_TRUE(SameBits(read.pieces[i].end, contour.pieces[i].end)) << seed;
    }
  }
}

}  // namespace
}  // namespace Vorn::IO
