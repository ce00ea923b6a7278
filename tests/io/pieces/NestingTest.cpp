#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <random>

#include "io/pieces/Nesting.h"

namespace Vorn::IO {
namespace {

using Indices = std::vector<std::size_t>;

ContourFile Outline(std::vector<Piece> pieces, bool isClosed = true) {
  ContourFile outline;
  outline.pieces = std::move(pieces);
  outline.isClosed = isClosed;
  return outline;
}

ContourFile Square(double x, double y, double half) {
  std::vector<XY> const corners = {
      {x - half, y - half}, {x + half, y - half}, {x + half, y + half}, {x - half, y + half}};
  std::vector<Piece> pieces;
  for (std::size_t i = 0; i < 4; ++i) pieces.push_back(MakeLine(corners[i], corners[(i + 1) % 4]));
  return Outline(pieces);
}

ContourFile Circle(double x, double y, double radius) {
  return Outline(MakeCircle({x + radius, y}, {x, y}, radius, true));
}

TEST(ContainersOf, NothingHasNone) { EXPECT_TRUE(ContainersOf({}).empty()); }

TEST(ContainersOf, ListsAllAroundInTheirOrder) {
  auto const containers =
      ContainersOf({Circle(0, 0, 1), Square(0, 0, 9), Circle(0, 0, 4), Square(30, 0, 2)});
  EXPECT_EQ(containers[0], (Indices{1, 2}));
  EXPECT_EQ(containers[1], Indices{});
  EXPECT_EQ(containers[2], Indices{1});
  EXPECT_EQ(containers[3], Indices{});
}

TEST(ContainersOf, AmongManySquaresFindsThoseAroundEachCorner) {
  struct Place {
    double x, y, half;
  };
  std::mt19937 random(7);
  std::uniform_real_distribution<double> at(-10.0, 10.0);
  std::uniform_real_distribution<double> half(0.1, 5.0);
  std::vector<Place> places;
  std::vector<ContourFile> squares;
  for (int i = 0; i < 200; ++i) {
    places.push_back({at(random), at(random), half(random)});
    squares.push_back(Square(places.back().x, places.back().y, places.back().half));
  }
  auto const containers = ContainersOf(squares);
  for (std::size_t i = 0; i < places.size(); ++i) {
    Indices around;
    for (std::size_t k = 0; k < places.size(); ++k) {
      double const x = places[i].x - places[i].half - places[k].x;
      double const y = places[i].y - places[i].half - places[k].y;
      bool const isInside = std::fabs(x) < places[k].half && std::fabs(y) < places[k].half;
      if (k != i && isInside) around.push_back(k);
    }
    EXPECT_EQ(containers[i], around) << i;
  }
}

TEST(ContainersOf, ManySideBySideAreNotComparedWithEachOther) {
  std::vector<ContourFile> squares;
  for (int i = 0; i < 100'000; ++i) squares.push_back(Square(3.0 * i, 0.0, 1.0));
  auto const begin = std::chrono::steady_clock::now();
  EXPECT_EQ(ContainersOf(squares)[77'777], Indices{});
  // Pair by pair 20,000 take two seconds, and the time grows with the square.
  EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(10));
}

TEST(ContainersOf, OpenOnesLieInNothingAndHoldNothing) {
  ContourFile open = Square(0, 0, 9);
  open.isClosed = false;
  ContourFile way = Outline({MakeLine({0, 0}, {1, 0})}, false);
  auto const containers = ContainersOf({open, Circle(0, 0, 1), way, Square(0, 0, 20)});
  EXPECT_EQ(containers[0], Indices{});
  EXPECT_EQ(containers[1], Indices{3});
  EXPECT_EQ(containers[2], Indices{});
}

TEST(ContainersOf, TheBulgeOfAnArcBelongsToTheInside) {
  // A half disc above y = 0: (0, 0.9) is beyond its chord and below its arc.
  ContourFile const half =
      Outline({MakeLine({-1, 0}, {1, 0}), MakeArc({1, 0}, {-1, 0}, {0, 0}, 1, true)});
  auto const containers = ContainersOf({half, Circle(0, 0.9, 0.01), Circle(0.9, 0.9, 0.01)});
  EXPECT_EQ(containers[1], Indices{0});
  EXPECT_EQ(containers[2], Indices{});
}

TEST(ContainersOf, InTheBoxIsNotInTheOutline) {
  // A thin L around the other square's box.
  std::vector<XY> const corners = {{0, 0}, {10, 0}, {10, 1}, {1, 1}, {1, 10}, {0, 10}};
  std::vector<Piece> pieces;
  for (std::size_t i = 0; i < 6; ++i) pieces.push_back(MakeLine(corners[i], corners[(i + 1) % 6]));
  auto const containers = ContainersOf({Outline(pieces), Square(6, 6, 2), Square(0.5, 5, 0.2)});
  EXPECT_EQ(containers[1], Indices{});
  EXPECT_EQ(containers[2], Indices{0});
}

TEST(FacesOf, HolesBelongToTheOutlineJustAround) {
  // A plate with a hole, an island in the hole, a hole in the island; and another plate.
  auto const faces = FacesOf({Square(0, 0, 20), Square(0, 0, 15), Square(0, 0, 10), Circle(3, 3, 2),
                              Square(100, 0, 5), Circle(100, 0, 1), Circle(-5, -5, 2)});
  ASSERT_EQ(faces.size(), 3u);
  EXPECT_EQ(faces[0].outer, 0u);
  EXPECT_EQ(faces[0].holes, Indices{1});
  EXPECT_EQ(faces[1].outer, 2u);
  EXPECT_EQ(faces[1].holes, (Indices{3, 6}));
  EXPECT_EQ(faces[2].outer, 4u);
  EXPECT_EQ(faces[2].holes, Indices{5});
}

TEST(FacesOf, OpenOutlinesAreNone) {
  ContourFile open = Circle(0, 0, 3);
  open.isClosed = false;
  EXPECT_TRUE(FacesOf({open}).empty());
  EXPECT_EQ(FacesOf({open, Square(0, 0, 1)}).size(), 1u);
}

TEST(FacesOf, ConcentricRingsInAnyOrderPairUp) {
  for (std::uint64_t seed = 1; seed <= 30; ++seed) {
    SCOPED_TRACE(seed);
    std::mt19937_64 engine(seed);
    std::size_t const count = 1 + engine() % 9;
    Indices rank(count);
    for (std::size_t i = 0; i < count; ++i) rank[i] = i;
    std::shuffle(rank.begin(), rank.end(), engine);
    std::vector<ContourFile> outlines;
    for (std::size_t const r : rank) {
      // The corners of a square are 1.14 sizes away, so those of double size lie around it.
      double const size = std::ldexp(1.0, static_cast<int>(r));
      outlines.push_back(engine() % 2 == 0 ? Circle(0, 0, size) : Square(0, 0, 0.8 * size));
    }
    // With as many around it as have a higher rank, every second one from outside is an outer.
    std::vector<Face> const faces = FacesOf(outlines);
    EXPECT_EQ(faces.size(), (count + 1) / 2);
    std::size_t holes = 0;
    for (Face const& face : faces) {
      EXPECT_EQ((count - 1 - rank[face.outer]) % 2, 0u);
      for (std::size_t const hole : face.holes) {
        EXPECT_EQ(rank[hole] + 1, rank[face.outer]);
        ++holes;
      }
    }
    EXPECT_EQ(holes, count / 2);
  }
}

}  // namespace
}  // namespace Vorn::IO
