#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "support/ReferenceFitting.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;

bool IsInOrder(Point const& first, Point const& middle, Point const& last) {
  return GeometryUtils::IsValidLineOrder(first, middle, last);
}

TEST(IsValidLineOrder, HoldsWhileTheRunMovesAway) {
  EXPECT_TRUE(IsInOrder({0, 0}, {1, 0}, {2, 0}));
  EXPECT_TRUE(IsInOrder({0, 0}, {1, 0}, {1.1, 5}));
  EXPECT_TRUE(IsInOrder({0, 0}, {1, 0}, {Up(1.0), 0}));
}

TEST(IsValidLineOrder, FailsForAPointNearerToTheFirstThanItsPredecessor) {
  EXPECT_FALSE(IsInOrder({0, 0}, {2, 0}, {1, 0}));
  EXPECT_FALSE(IsInOrder({0, 0}, {2, 0}, {-1, 0}));
}

TEST(IsValidLineOrder, FailsAtEqualDistance) {
  EXPECT_FALSE(IsInOrder({0, 0}, {3, 4}, {5, 0}));
  EXPECT_FALSE(IsInOrder({0, 0}, {2, 0}, {-2, 0}));
}

TEST(IsValidLineOrder, NeedsAnObtuseAngleAtTheMiddle) {
  EXPECT_FALSE(IsInOrder({0, 0}, {1, 0}, {1, 5}));     // exactly a right angle
  EXPECT_FALSE(IsInOrder({0, 0}, {1, 0}, {0.5, 5}));   // farther, but turning back
  EXPECT_FALSE(IsInOrder({0, 0}, {1, 0}, {-40, 0}));   // farther, on the other side
  EXPECT_TRUE(IsInOrder({0, 0}, {1, 0}, {1.001, 5}));  // just obtuse
}

TEST(IsValidLineOrder, FailsForCoincidingPoints) {
  EXPECT_FALSE(IsInOrder({1, 1}, {1, 1}, {1, 1}));
  EXPECT_FALSE(IsInOrder({0, 0}, {1, 0}, {1, 0}));
  EXPECT_FALSE(IsInOrder({0, 0}, {0, 0}, {1, 0}));  // no angle at the first point
}

TEST(IsValidLineOrder, FailsForNotANumberAndOverflow) {
  EXPECT_FALSE(IsInOrder({kNaN, 0}, {1, 0}, {2, 0}));
  EXPECT_FALSE(IsInOrder({0, 0}, {1, kNaN}, {2, 0}));
  EXPECT_FALSE(IsInOrder({0, 0}, {1, 0}, {kNaN, 0}));
  EXPECT_FALSE(IsInOrder({0, 0}, {1, 0}, {kInf, 0}));         // infinity less infinity
  EXPECT_FALSE(IsInOrder({0, 0}, {1e200, 0}, {2e200, 0}));    // squares overflow
  EXPECT_FALSE(IsInOrder({0, 0}, {1e-170, 0}, {2e-170, 0}));  // squares underflow to zero
}

TEST(IsValidLineOrder, IsTheSignOfTheDotProductOnWholeNumbers) {
  constexpr std::uint64_t kSeed = 5202;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 5000; ++i) {
    Point const a = random.GridPoint(6);
    Point const b = random.GridPoint(6);
    Point const c = random.GridPoint(6);
    double const dot = (b.x - a.x) * (c.x - b.x) + (b.y - a.y) * (c.y - b.y);
    ASSERT_EQ(IsInOrder(a, b, c), dot > 0)
        << a.x << ' ' << a.y << ' ' << b.x << ' ' << b.y << ' ' << c.x << ' ' << c.y;
  }
}

TEST(IsValidLineOrder, AgreesWithTheReferenceOnAnyDoubles) {
  constexpr std::uint64_t kSeed = 5203;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int inOrder = 0;
  for (int i = 0; i < 5000; ++i) {
    auto const coordinate = [&random] { return random.Wide(-40, 40); };
    Point const a{coordinate(), coordinate()};
    Point const b{coordinate(), coordinate()};
    Point const c{coordinate(), coordinate()};
    bool const expected = ReferenceFitting::IsValidLineOrder(a, b, c);
    inOrder += expected ? 1 : 0;
    ASSERT_EQ(IsInOrder(a, b, c), expected);
  }
  EXPECT_GT(inOrder, 500);
}

}  // namespace
}  // namespace Vorn::Testing
