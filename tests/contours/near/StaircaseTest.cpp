// Leaving out neighbours: runs of boxes that form a staircase are not looked into, and nothing else
// gets lost.

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <set>
#include <utility>
#include <vector>

#include "geometry/contours/near/BoxTree.h"
#include "gtest/gtest.h"
#include "support/RandomGeometry.h"

namespace Vorn::Testing {
namespace {

using Contours::Box;
using Contours::BoxTree;
using Contours::Extent;
using Contours::Neighbours;
using Contours::Stairs;
using Pairs = std::set<std::pair<std::size_t, std::size_t>>;

Pairs TestedPairs(std::vector<Extent> const& extents) {
  Pairs pairs;
  auto const note = [&](std::size_t i, std::size_t k) {
    EXPECT_TRUE(pairs.insert({i, k}).second) << i << " and " << k << " again";
    return false;
  };
  EXPECT_FALSE(BoxTree(extents, 1e-9).AnyPair(note, Neighbours::LeftOut));
  return pairs;
}

/// Boxes on a small grid that mostly go on in one sense: many staircases, points and empty ones.
std::vector<Extent> DrawBoxes(RandomGeometry* random) {
  std::vector<Extent> extents;
  double x = 0.0;
  double y = 0.0;
  double sense = 1.0;
  for (std::int32_t i = random->Integer(1, 90); i > 0; --i) {
    if (random->Integer(0, 9) == 0) sense = -sense;
    double const nextX = x + sense * random->Integer(0, 2);
    double const nextY = y + random->Integer(0, 2);
    Box box;
    box.Include({x, x, y, y});
    box.Include({nextX, nextX, nextY, nextY});
    extents.push_back(random->Integer(0, 20) == 0 ? Extent{} : Extent{box, true, false});
    x = nextX;
    y = random->Integer(0, 12) == 0 ? 0.0 : nextY;
  }
  return extents;
}

TEST(Stairs, LoseNoPairButNeighbours) {
  RandomGeometry random(91);
  std::size_t overlapping = 0;
  for (int round = 0; round < 2000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 91, round " << round);
    std::vector<Extent> const extents = DrawBoxes(&random);
    Pairs const pairs = TestedPairs(extents);
    for (std::size_t i = 0; i < extents.size(); ++i) {
      for (std::size_t k = i + 2; k < extents.size(); ++k) {
        bool const areApart = extents[i].box.IsApartFrom(extents[k].box);
        EXPECT_EQ(pairs.count({i, k}), areApart ? 0U : 1U) << i << " and " << k;
        if (!areApart) ++overlapping;
      }
    }
  }
  EXPECT_GT(overlapping, 5000U);
}

TEST(Stairs, OfASmoothRingLeaveNextToNoPairs) {
  constexpr int kCount = 10000;
  std::vector<Extent> extents;
  for (int i = 0; i < kCount; ++i) {
    double const angle = 2.0 * std::acos(-1.0) * i / kCount;
    double const next = 2.0 * std::acos(-1.0) * (i + 1) / kCount;
    Box box;
    box.Include({std::cos(angle), std::cos(angle), std::sin(angle), std::sin(angle)});
    box.Include({std::cos(next), std::cos(next), std::sin(next), std::sin(next)});
    extents.push_back({box, true, true});
  }
  EXPECT_LT(TestedPairs(extents).size(), 100U);
}

TEST(Stairs, AreNotMadeOfPointsOrEmptyBoxes) {
  EXPECT_TRUE(Stairs::Of({0.0, 1.0, 2.0, 2.0}).AreMonotone());
  EXPECT_FALSE(Stairs::Of({1.0, 1.0, 2.0, 2.0}).AreMonotone());
  EXPECT_FALSE(Stairs::Of({}).AreMonotone());
}

TEST(Stairs, EndWhereTheSenseTurns) {
  Box const first{0.0, 1.0, 0.0, 1.0};
  auto const join = [&](Box const& second) {
    return Stairs::Join(Stairs::Of(first), first, Stairs::Of(second), second);
  };
  EXPECT_TRUE(join({1.0, 2.0, 1.0, 2.0}).AreMonotone());
  EXPECT_TRUE(join({1.0, 2.0, -3.0, 0.0}).AreMonotone());
  EXPECT_FALSE(join({0.5, 2.0, 1.0, 2.0}).AreMonotone());
  Box const second{1.0, 2.0, 1.0, 2.0};
  Box both = first;
  both.Include(second);
  Box const back{0.0, 1.0, 2.0, 3.0};
  EXPECT_FALSE(Stairs::Join(join(second), both, Stairs::Of(back), back).AreMonotone());
}

}  // namespace
}  // namespace Vorn::Testing
