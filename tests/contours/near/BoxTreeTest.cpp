#include <cmath>
#include <cstddef>
#include <set>
#include <utility>
#include <vector>

#include "geometry/contours/near/BoxTree.h"
#include "gtest/gtest.h"
#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

// What the search rests on: no pair of pieces that meet is left out, and few others are not.

namespace Vorn::Testing {
namespace {

using Contours::Box;
using Contours::BoxTree;
using Contours::Extent;
using Point = GeometryUtils::Point;
using Pairs = std::set<std::pair<std::size_t, std::size_t>>;

constexpr double kMargin = 1e-9;

struct Segment {
  Point a;
  Point b;
};

Box BoxOf(Segment const& s) {
  return {std::fmin(s.a.x, s.b.x), std::fmax(s.a.x, s.b.x), std::fmin(s.a.y, s.b.y),
          std::fmax(s.a.y, s.b.y)};
}

Extent ExtentOf(Segment const& s) {
  return {BoxOf(s), (s.b.x - s.a.x) * (s.b.y - s.a.y) >= 0.0, true};
}

std::vector<Extent> ExtentsOf(std::vector<Segment> const& segments) {
  std::vector<Extent> extents;
  for (Segment const& segment : segments) extents.push_back(ExtentOf(segment));
  return extents;
}

std::vector<Segment> ChainOf(std::vector<Point> const& points) {
  std::vector<Segment> chain;
  for (std::size_t i = 0; i + 1 < points.size(); ++i) chain.push_back({points[i], points[i + 1]});
  return chain;
}

double Cross(Point const& o, Point const& p, Point const& q) {
  return (p.x - o.x) * (q.y - o.y) - (p.y - o.y) * (q.x - o.x);
}

bool DoMeet(Segment const& s, Segment const& t) {
  return Cross(s.a, s.b, t.a) * Cross(s.a, s.b, t.b) <= 0.0 &&
         Cross(t.a, t.b, s.a) * Cross(t.a, t.b, s.b) <= 0.0 && !BoxOf(s).IsApartFrom(BoxOf(t));
}

Pairs PairsOf(BoxTree tree) {
  Pairs pairs;
  bool const isFound = tree.AnyPair([&](std::size_t i, std::size_t k) {
    EXPECT_LT(i, k);
    EXPECT_TRUE(pairs.insert({i, k}).second) << i << " and " << k << " again";
    return false;
  });
  EXPECT_FALSE(isFound);
  return pairs;
}

std::size_t CountTests(std::vector<Segment> const& chain) {
  return PairsOf(BoxTree(ExtentsOf(chain), kMargin)).size();
}

std::vector<Segment> RandomChain(RandomGeometry& random, std::int32_t size, double reach) {
  std::vector<Point> points{{0, 0}};
  for (std::int32_t i = 0; i < size; ++i) {
    Point const step =
        random.Integer(0, 5) == 0 ? random.PointIn(-9, 9) : random.PointIn(-reach, reach);
    points.push_back({points.back().x + step.x, points.back().y + step.y});
  }
  return ChainOf(points);
}

TEST(Around, LiesAlongTheLongestPartWhereverThatStands) {
  // Steep parts: an outline along the x axis would be about as wide as they are.
  Contours::Trapezium const small = TrapeziumOf(ExtentOf({{0.0, 0.0}, {0.125, 0.0}}));
  Contours::Trapezium const large = TrapeziumOf(ExtentOf({{0.0, 0.0}, {5.0, 10.0}}));
  for (bool const isLargeFirst : {true, false}) {
    Contours::Trapezium const parts[] = {isLargeFirst ? large : small,
                                         isLargeFirst ? small : large};
    auto const [lower, upper] = Contours::Around(parts, 2);
    // Twice the area, by the diagonals.
    double const area2 = std::fabs((upper.from.x - lower.from.x) * (upper.to.y - lower.to.y) -
                                   (upper.to.x - lower.to.x) * (upper.from.y - lower.from.y));
    EXPECT_LT(area2, 3.0);
  }
}

TEST(BoxTree, WithoutPiecesHasNoPairs) {
  EXPECT_TRUE(PairsOf(BoxTree({}, kMargin)).empty());
  EXPECT_TRUE(PairsOf(BoxTree({ExtentOf({{0, 0}, {1, 1}})}, kMargin)).empty());
  BoxTree empty({}, kMargin);
  BoxTree one({ExtentOf({{0, 0}, {1, 1}})}, kMargin);
  auto const always = [](std::size_t, std::size_t) { return true; };
  EXPECT_FALSE(empty.AnyPair(one, always));
  EXPECT_FALSE(one.AnyPair(empty, always));
  EXPECT_TRUE(one.AnyPair(one, always));
}

TEST(BoxTree, TestsEveryPairThatMeetsOnce) {
  RandomGeometry random(81);
  std::size_t meeting = 0;
  for (int round = 0; round < 600; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 81, round " << round);
    auto const chain = RandomChain(random, random.Integer(2, 120), random.Uniform(0.01, 3));
    Pairs const pairs = PairsOf(BoxTree(ExtentsOf(chain), kMargin));
    for (std::size_t i = 0; i < chain.size(); ++i) {
      for (std::size_t k = i + 1; k < chain.size(); ++k) {
        if (!DoMeet(chain[i], chain[k])) continue;
        ++meeting;
        EXPECT_TRUE(pairs.count({i, k}) == 1) << i << " and " << k;
      }
    }
  }
  EXPECT_GT(meeting, 10000U);
}

TEST(BoxTree, TestsEveryPairOfBoxesThatOverlap) {
  RandomGeometry random(82);
  std::size_t overlapping = 0;
  for (int round = 0; round < 600; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 82, round " << round);
    std::vector<Extent> extents;
    for (std::int32_t i = random.Integer(1, 90); i > 0; --i) {
      Point const low = random.GridPoint(20);
      Box const box{low.x, low.x + random.Integer(0, 4), low.y, low.y + random.Integer(0, 4)};
      extents.push_back(random.Integer(0, 6) == 0 ? Extent{} : Extent{box, true, false});
    }
    Pairs const pairs = PairsOf(BoxTree(extents, kMargin));
    Pairs expected;
    for (std::size_t i = 0; i < extents.size(); ++i) {
      for (std::size_t k = i + 1; k < extents.size(); ++k) {
        if (!extents[i].box.IsApartFrom(extents[k].box)) expected.insert({i, k});
      }
    }
    EXPECT_EQ(pairs, expected);
    overlapping += expected.size();
  }
  EXPECT_GT(overlapping, 5000U);
}

TEST(BoxTree, TestsEveryPairOfTwoTreesThatMeetsOnce) {
  RandomGeometry random(83);
  std::size_t meeting = 0;
  for (int round = 0; round < 600; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 83, round " << round);
    // One tree is often much higher than the other.
    auto const first = RandomChain(random, random.Integer(1, round % 2 == 0 ? 9 : 150), 1.0);
    auto const second = RandomChain(random, random.Integer(1, round % 3 == 0 ? 9 : 150), 0.3);
    Pairs pairs;
    BoxTree tree(ExtentsOf(first), kMargin);
    BoxTree other(ExtentsOf(second), kMargin);
    tree.AnyPair(other, [&](std::size_t i, std::size_t k) {
      EXPECT_TRUE(pairs.insert({i, k}).second) << i << " and " << k << " again";
      return false;
    });
    for (std::size_t i = 0; i < first.size(); ++i) {
      for (std::size_t k = 0; k < second.size(); ++k) {
        if (!DoMeet(first[i], second[k])) continue;
        ++meeting;
        EXPECT_TRUE(pairs.count({i, k}) == 1) << i << " and " << k;
      }
    }
  }
  EXPECT_GT(meeting, 1000U);
}

TEST(BoxTree, StopsAtTheFirstYes) {
  std::vector<Segment> const star(20, {{-1, -1}, {1, 1}});
  int calls = 0;
  EXPECT_TRUE(BoxTree(ExtentsOf(star), kMargin).AnyPair([&](std::size_t, std::size_t) {
    return ++calls == 7;
  }));
  EXPECT_EQ(calls, 7);
}

TEST(BoxTree, TestsFewPairsOfASmoothRing) {
  constexpr int kCount = 10000;
  std::vector<Point> points;
  for (int i = 0; i <= kCount; ++i) {
    double const angle = 2.0 * std::acos(-1.0) * i / kCount;
    points.push_back({std::cos(angle), std::sin(angle)});
  }
  EXPECT_LT(CountTests(ChainOf(points)), 2U * kCount);
}

TEST(BoxTree, TestsFewPairsOfNeedlesAtAnySlope) {
  constexpr int kCount = 10000;
  for (double const slope : {0.0, 0.1, 0.5, 0.7853981633974483, 1.2, 1.5707963267948966, 2.5}) {
    std::vector<Point> points;
    for (int i = 0; i <= kCount; ++i) {
      double const x = 100.0 * i / kCount;
      double const y = i % 2 == 0 ? 0.0 : 100.0;
      points.push_back(
          {x * std::cos(slope) - y * std::sin(slope), x * std::sin(slope) + y * std::cos(slope)});
    }
    EXPECT_LT(CountTests(ChainOf(points)), 30U * kCount) << "slope " << slope;
  }
}

TEST(BoxTree, TestsFewPairsOfNeedlesWithRoundTips) {
  // The box of a tip says nothing about the slope of the needles.
  constexpr int kCount = 10000;
  for (double const slope : {0.1, 0.5, 0.7853981633974483, 1.2, 2.5}) {
    std::vector<Extent> extents;
    Point from{0, 0};
    for (int i = 1; i <= kCount; ++i) {
      double const x = 100.0 * i / kCount;
      double const y = i % 2 == 0 ? 0.0 : 100.0;
      Point const to{x * std::cos(slope) - y * std::sin(slope),
                     x * std::sin(slope) + y * std::cos(slope)};
      constexpr double kTip = 0.3 * 100.0 / kCount;
      extents.push_back(ExtentOf({from, to}));
      extents.push_back({{to.x - kTip, to.x + kTip, to.y - 0.7 * kTip, to.y + kTip}, true, false});
      from = to;
    }
    EXPECT_LT(PairsOf(BoxTree(extents, kMargin)).size(), 60U * kCount) << "slope " << slope;
  }
}

TEST(BoxTree, TestsFewPairsOfNeedlesAroundACentre) {
  constexpr int kCount = 10000;
  for (double const inner : {0.01, 0.1, 0.5, 0.9}) {
    std::vector<Point> points;
    for (int i = 0; i <= kCount; ++i) {
      double const angle = 2.0 * std::acos(-1.0) * i / kCount;
      double const radius = i % 2 == 0 ? inner : 1.0;
      points.push_back({radius * std::cos(angle), radius * std::sin(angle)});
    }
    EXPECT_LT(CountTests(ChainOf(points)), 30U * kCount) << "inner radius " << inner;
  }
}

}  // namespace
}  // namespace Vorn::Testing
