#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "vorn/io/ContourArea.h"
#include "vorn/io/Intersections.h"

namespace Vorn::IO {
namespace {

using Json = nlohmann::json;

ContourFile Way(std::string path, std::vector<Piece> pieces, bool isClosed = false) {
  ContourFile contour;
  contour.path = std::move(path);
  contour.pieces = std::move(pieces);
  contour.isClosed = isClosed;
  return contour;
}

ContourFile Axis() { return Way("a.json", {MakeLine({0, 0}, {4, 0}), MakeLine({4, 0}, {10, 0})}); }

/// Crosses the axis at 2, runs along it from 6 to 8, and ends on it at 9.
ContourFile Other() {
  return Way("b.json",
             {MakeLine({2, 1}, {2, -1}), MakeLine({6, 0}, {8, 0}), MakeLine({9, 5}, {9, 0})});
}

TEST(IntersectionsToCsv, HasALineForEachPlace) {
  ContourFile const a = Axis();
  ContourFile const b = Other();
  EXPECT_EQ(ToCsv(IntersectionsOf(a, b), a, &b),
            "kind,x,y,to_x,to_y,piece_a,kind_a,position_a,piece_b,kind_b,position_b\n"
            "crossing,2,0,2,0,1,line,2,1,line,1\n"
            "overlap,6,0,8,0,2,line,6,2,line,2\n"
            "touching,9,0,9,0,2,line,9,3,line,9\n");
}

TEST(IntersectionsToJson, HoldsPlacesPiecesAndPositions) {
  ContourFile const a = Axis();
  ContourFile const b = Other();
  Json const json = Json::parse(ToJson(IntersectionsOf(a, b), a, &b));
  EXPECT_EQ(json.at("a"), "a.json");
  EXPECT_EQ(json.at("b"), "b.json");
  ASSERT_EQ(json.at("intersections").size(), 3u);
  Json const& overlap = json.at("intersections")[1];
  EXPECT_EQ(overlap.at("kind"), "overlap");
  EXPECT_EQ(overlap.at("at"), Json({{"x", 6.0}, {"y", 0.0}}));
  EXPECT_EQ(overlap.at("until"), Json({{"x", 8.0}, {"y", 0.0}}));
  EXPECT_EQ(overlap.at("a"), Json({{"piece", 2}, {"kind", "line"}, {"position", 6.0}}));
  EXPECT_TRUE(json.at("intersections")[0].at("until").is_null());
}

TEST(IntersectionsToJson, OfOneContourWithItselfHasNoSecondName) {
  ContourFile const bow = Way(
      "bow.json", {MakeLine({0, 0}, {2, 2}), MakeLine({2, 2}, {2, 0}), MakeLine({2, 0}, {0, 2})});
  std::vector<Intersection> const found = SelfIntersectionsOf(bow);
  ASSERT_EQ(found.size(), 1u);
  Json const json = Json::parse(ToJson(found, bow, nullptr));
  EXPECT_TRUE(json.at("b").is_null());
  EXPECT_EQ(json.at("intersections")[0].at("a").at("piece"), 1);
  EXPECT_EQ(json.at("intersections")[0].at("b").at("piece"), 3);
}

TEST(IntersectionsToJson, NoneIsAnEmptyList) {
  ContourFile const a = Axis();
  EXPECT_EQ(Json::parse(ToJson({}, a, nullptr)).at("intersections"), Json::array());
  EXPECT_EQ(ToCsv({}, a, nullptr),
            "kind,x,y,to_x,to_y,piece_a,kind_a,position_a,piece_b,kind_b,position_b\n");
}

TEST(Tally, CountsEachKind) {
  IntersectionTally const tally = Tally(IntersectionsOf(Axis(), Other()));
  EXPECT_EQ(tally.crossings, 1u);
  EXPECT_EQ(tally.touches, 1u);
  EXPECT_EQ(tally.overlaps, 1u);
  EXPECT_EQ(Describe(tally), "1 crossing, 1 touching, 1 overlap");
  EXPECT_EQ(Describe(IntersectionTally{0, 2, 3}), "0 crossings, 2 touching, 3 overlaps");
  EXPECT_EQ(Describe(Tally({})), "0 crossings, 0 touching, 0 overlaps");
}

TEST(IntersectionsOf, IsTheSameSeenFromTheOther) {
  std::vector<Intersection> const there = IntersectionsOf(Axis(), Other());
  std::vector<Intersection> const back = IntersectionsOf(Other(), Axis());
  ASSERT_EQ(back.size(), there.size());
  for (std::size_t i = 0; i < there.size(); ++i) {
    EXPECT_EQ(back[i].kind, there[i].kind);
    EXPECT_EQ(back[i].at.x, there[i].at.x);
    EXPECT_EQ(back[i].a.piece, there[i].b.piece);
    EXPECT_EQ(back[i].b.position, there[i].a.position);
  }
}

ContourFile Square(double side, std::string path, bool isLeft = true) {
  std::vector<XY> corners = {{0, 0}, {side, 0}, {side, side}, {0, side}};
  if (!isLeft) std::swap(corners[1], corners[3]);
  std::vector<Piece> pieces;
  for (std::size_t i = 0; i < 4; ++i) pieces.push_back(MakeLine(corners[i], corners[(i + 1) % 4]));
  return Way(std::move(path), pieces, true);
}

ContourFile SquareAround(double half, std::string path) {
  ContourFile square = Square(2 * half, std::move(path));
  for (Piece& piece : square.pieces) {
    piece = MakeLine({piece.start.x - half, piece.start.y - half},
                     {piece.end.x - half, piece.end.y - half});
  }
  return square;
}

TEST(AreaToJson, HoldsEveryFactAndTheNetArea) {
  std::vector<ContourArea> const areas =
      MeasureOutlines({SquareAround(5, "p"), SquareAround(1, "p"), SquareAround(2, "p")});
  Json const json = Json::parse(ToJson(areas));
  // 100, less the hole of 16, and the island of 4 in it.
  EXPECT_EQ(json.at("netArea"), 88.0);
  Json const& hole = json.at("contours")[2];
  EXPECT_EQ(hole.at("area"), 16.0);
  EXPECT_EQ(hole.at("isHole"), true);
  EXPECT_EQ(hole.at("outline"), 3);
  EXPECT_EQ(hole.at("perimeter"), 16.0);
  EXPECT_EQ(hole.at("sense"), "counter-clockwise");
  EXPECT_EQ(hole.at("centroid"), Json({{"x", 0.0}, {"y", 0.0}}));
  EXPECT_EQ(hole.at("box").at("high"), Json({{"x", 2.0}, {"y", 2.0}}));
  EXPECT_TRUE(hole.at("units").is_null());
  EXPECT_EQ(json.at("contours")[1].at("isHole"), false) << "it lies in two";
}

TEST(AreaToJson, OfOneAloneNamesNoOutline) {
  Json const json = Json::parse(ToJson({MeasureArea(Square(3, "q", false))}));
  EXPECT_TRUE(json.at("contours")[0].at("outline").is_null());
  EXPECT_EQ(json.at("contours")[0].at("signedArea"), -9.0);
  EXPECT_EQ(json.at("contours")[0].at("sense"), "clockwise");
  EXPECT_EQ(json.at("netArea"), 9.0);
}

TEST(NetArea, OfNothingIsZero) { EXPECT_EQ(NetArea({}), 0.0); }

}  // namespace
}  // namespace Vorn::IO
