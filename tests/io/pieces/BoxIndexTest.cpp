#include <gtest/gtest.h>

#include <random>

#include "io/pieces/BoxIndex.h"

namespace Vorn::IO {
namespace {

std::vector<std::size_t> Visited(BoxIndex const& index, Extent const& box) {
  std::vector<std::size_t> visited;
  index.Visit(box, [&](std::size_t i) { visited.push_back(i); });
  return visited;
}

TEST(BoxIndex, BordersBelongToTheBoxes) {
  BoxIndex const index({MakeLine({0, 0}, {2, 1})}, 0.0);
  EXPECT_EQ(Visited(index, {{2, 1}, {3, 3}}), std::vector<std::size_t>{0});
  EXPECT_EQ(Visited(index, {{-1, -1}, {0, 0}}), std::vector<std::size_t>{0});
  EXPECT_TRUE(Visited(index, {{2.5, 0}, {3, 1}}).empty());
}

TEST(BoxIndex, MarginWidensEverySide) {
  BoxIndex const index({MakeLine({0, 0}, {2, 1})}, 0.5);
  EXPECT_EQ(Visited(index, {{2.5, 0}, {3, 1}}).size(), 1u);
  EXPECT_EQ(Visited(index, {{0, -2}, {1, -0.5}}).size(), 1u);
  EXPECT_EQ(Visited(index, {{-0.5, 1.5}, {-0.5, 1.5}}).size(), 1u) << "the corner";
  EXPECT_TRUE(Visited(index, {{2.51, 0}, {3, 1}}).empty());
}

TEST(BoxIndex, TakesInTheBulgeOfArcs) {
  BoxIndex const index({MakeArc({1, 0}, {-1, 0}, {0, 0}, 1, true)}, 0.0);
  EXPECT_EQ(Visited(index, {{-0.1, 0.9}, {0.1, 0.95}}).size(), 1u);
  EXPECT_TRUE(Visited(index, {{-0.1, -0.9}, {0.1, -0.95 + 0.9}}).empty());
}

TEST(BoxIndex, VisitsWhatOneByOneWouldFindInAscendingOrder) {
  std::mt19937_64 engine(17);
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  for (std::size_t const count : {1u, 2u, 3u, 16u, 17u, 100u, 1000u}) {
    std::vector<Piece> pieces;
    XY at = {0, 0};
    for (std::size_t i = 0; i < count; ++i) {
      XY const to = {at.x + 4.0 * unit(engine) - 2.0, at.y + 4.0 * unit(engine) - 2.0};
      pieces.push_back(MakeLine(at, to));
      at = to;
    }
    BoxIndex const index(pieces, 0.125);
    std::size_t found = 0;
    for (int round = 0; round < 100; ++round) {
      XY const low = {60.0 * unit(engine) - 30.0, 60.0 * unit(engine) - 30.0};
      Extent const box = {low, {low.x + 8.0 * unit(engine), low.y + 8.0 * unit(engine)}};
      std::vector<std::size_t> expected;
      for (std::size_t i = 0; i < count; ++i) {
        Extent const own = ExtentOf({pieces[i]});
        bool const isApart = own.low.x - 0.125 > box.high.x || own.high.x + 0.125 < box.low.x ||
                             own.low.y - 0.125 > box.high.y || own.high.y + 0.125 < box.low.y;
        if (!isApart) expected.push_back(i);
      }
      EXPECT_EQ(Visited(index, box), expected) << count << " pieces, round " << round;
      found += expected.size();
    }
    if (count >= 100) {
      EXPECT_GT(found, 20u) << "boxes that meet nothing would say nothing";
    }
  }
}

}  // namespace
}  // namespace Vorn::IO
