#include <cmath>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "support/ReferenceFitting.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;

constexpr Point kCenter{0, 0};

Point At(double degrees) {
  double const angle = degrees * std::acos(-1.0) / 180.0;
  return {std::cos(angle), std::sin(angle)};
}

bool IsBetween(bool ccw, double first, double middle, double last) {
  return GeometryUtils::IsValidArcOrder(kCenter, ccw, At(first), At(middle), At(last));
}

TEST(IsValidArcOrder, CounterClockwiseWithoutSeam) {
  EXPECT_TRUE(IsBetween(true, -30, 10, 60));
  EXPECT_FALSE(IsBetween(true, -30, 70, 60));
  EXPECT_FALSE(IsBetween(true, -30, -40, 60));
}

TEST(IsValidArcOrder, CounterClockwiseAcrossTheSeam) {
  EXPECT_TRUE(IsBetween(true, 150, 170, -150));
  EXPECT_TRUE(IsBetween(true, 150, -170, -150));
  EXPECT_FALSE(IsBetween(true, 150, 0, -150));
}

TEST(IsValidArcOrder, ClockwiseWithoutSeam) {
  EXPECT_TRUE(IsBetween(false, 60, 10, -30));
  EXPECT_FALSE(IsBetween(false, 60, 70, -30));
  EXPECT_FALSE(IsBetween(false, 60, -40, -30));
}

TEST(IsValidArcOrder, ClockwiseAcrossTheSeam) {
  EXPECT_TRUE(IsBetween(false, -150, -170, 150));
  EXPECT_TRUE(IsBetween(false, -150, 170, 150));
  EXPECT_FALSE(IsBetween(false, -150, 0, 150));
}

TEST(IsValidArcOrder, EndsBelongToTheArc) {
  for (bool ccw : {true, false}) {
    EXPECT_TRUE(IsBetween(ccw, 20, 20, 80));
    EXPECT_TRUE(IsBetween(ccw, 20, 80, 80));
    EXPECT_TRUE(IsBetween(ccw, 80, 20, 20));
    EXPECT_TRUE(IsBetween(ccw, 20, 20, 20));
  }
}

TEST(IsValidArcOrder, EqualEndsAreAWholeTurnCounterClockwiseAndNothingClockwise) {
  EXPECT_TRUE(IsBetween(true, 20, 100, 20));
  EXPECT_TRUE(IsBetween(true, 20, -100, 20));
  EXPECT_FALSE(IsBetween(false, 20, 100, 20));
  EXPECT_FALSE(IsBetween(false, 20, -100, 20));
}

TEST(IsValidArcOrder, TheSeamItselfIsTheUpperEnd) {
  Point const plus{-1, 0.0};    // angle +pi
  Point const minus{-1, -0.0};  // angle -pi
  EXPECT_TRUE(GeometryUtils::IsValidArcOrder(kCenter, true, At(150), plus, At(-150)));
  EXPECT_TRUE(GeometryUtils::IsValidArcOrder(kCenter, true, At(150), minus, At(-150)));
  EXPECT_TRUE(GeometryUtils::IsValidArcOrder(kCenter, true, At(90), At(170), plus));
  EXPECT_TRUE(GeometryUtils::IsValidArcOrder(kCenter, true, At(90), At(170), minus));
  EXPECT_FALSE(GeometryUtils::IsValidArcOrder(kCenter, false, At(90), At(170), minus));
}

bool IsContinued(bool ccw, double first, double middle, double last, bool skipFirstGap = false) {
  return GeometryUtils::IsValidArcOrder(kCenter, ccw, At(first), At(middle), At(last),
                                        skipFirstGap);
}

TEST(IsValidArcOrderWithGaps, NeedsTheOrderOfTheFiveArgumentForm) {
  EXPECT_TRUE(IsContinued(true, -30, 10, 60));
  EXPECT_FALSE(IsContinued(true, -30, 70, 60));
  EXPECT_TRUE(IsContinued(false, 60, 10, -30));
  EXPECT_FALSE(IsContinued(false, 60, -40, -30));
}

TEST(IsValidArcOrderWithGaps, EachGapStaysBelowARightAngle) {
  EXPECT_TRUE(IsContinued(true, 0, 89, 178));
  EXPECT_FALSE(IsContinued(true, 0, 91, 178));
  EXPECT_FALSE(IsContinued(true, 0, 60, 151));
  EXPECT_TRUE(IsContinued(false, 0, -89, -178));
  EXPECT_FALSE(IsContinued(false, 0, -91, -178));
  EXPECT_FALSE(IsContinued(false, 0, -60, -151));
}

/// atan2 of an exact right angle gives the true half pi, which is above the truncated literal.
TEST(IsValidArcOrderWithGaps, AnExactRightAngleIsTooWide) {
  EXPECT_FALSE(GeometryUtils::IsValidArcOrder(kCenter, true, {1, 0}, {1, 1}, {-1, 1.0}, false));
  EXPECT_FALSE(GeometryUtils::IsValidArcOrder(kCenter, true, {1, 0}, {0, 1}, {-0.1, 1}, false));
  EXPECT_FALSE(GeometryUtils::IsValidArcOrder(kCenter, false, {1, 0}, {0, -1}, {-0.1, -1}, false));
}

TEST(IsValidArcOrderWithGaps, TheFirstGapCanBeSkippedButNotTheSecond) {
  EXPECT_TRUE(IsContinued(true, 0, 150, 170, true));
  EXPECT_FALSE(IsContinued(true, 0, 150, 170, false));
  EXPECT_FALSE(IsContinued(true, 0, 20, 170, true));
  EXPECT_TRUE(IsContinued(false, 0, -150, -170, true));
  EXPECT_FALSE(IsContinued(false, 0, -150, -170, false));
}

TEST(IsValidArcOrderWithGaps, FoldsGapsAcrossTheSeam) {
  EXPECT_TRUE(IsContinued(true, 150, 170, -150));
  EXPECT_TRUE(IsContinued(true, 150, -170, -150));
  EXPECT_TRUE(IsContinued(false, -150, -170, 150));
  EXPECT_TRUE(IsContinued(false, -150, 170, 150));
  EXPECT_FALSE(IsContinued(true, 100, -165, -150));
  EXPECT_FALSE(IsContinued(false, -100, 165, 150));
}

TEST(IsValidArcOrderWithGaps, NearlyAWholeTurnIsTooWide) {
  EXPECT_FALSE(IsContinued(true, 20, 10, 15));
  EXPECT_FALSE(IsContinued(false, 10, 20, 15));
}

TEST(IsValidArcOrderWithGaps, MirroringTheArcTurnsItsDirection) {
  constexpr std::uint64_t kSeed = 5301;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 2000; ++i) {
    Point const p[3] = {random.PointIn(-3, 3), random.PointIn(-3, 3), random.PointIn(-3, 3)};
    bool const skip = random.Flip();
    bool const ccw = random.Flip();
    auto const mirror = [](Point const& q) { return Point{q.x, -q.y}; };
    EXPECT_EQ(GeometryUtils::IsValidArcOrder(kCenter, ccw, p[0], p[1], p[2], skip),
              GeometryUtils::IsValidArcOrder(kCenter, !ccw, mirror(p[0]), mirror(p[1]),
                                             mirror(p[2]), skip));
  }
}

TEST(IsValidArcOrderWithGaps, BothFormsAgreeWithTheReference) {
  constexpr std::uint64_t kSeed = 5302;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int valid = 0;
  for (int i = 0; i < 10000; ++i) {
    auto const point = [&random] {
      return random.Flip() ? random.GridPoint(2) : random.PointIn(-3, 3);
    };
    Point const center = point();
    Point const p[3] = {point(), point(), point()};
    bool const ccw = random.Flip();
    bool const skip = random.Flip();
    ASSERT_EQ(GeometryUtils::IsValidArcOrder(center, ccw, p[0], p[1], p[2]),
              ReferenceFitting::IsValidArcOrder(center, ccw, p[0], p[1], p[2]));
    bool const expected = ReferenceFitting::IsValidArcOrder(center, ccw, p[0], p[1], p[2], skip);
    valid += expected ? 1 : 0;
    ASSERT_EQ(GeometryUtils::IsValidArcOrder(center, ccw, p[0], p[1], p[2], skip), expected);
  }
  EXPECT_GT(valid, 500);
}

TEST(IsValidArcOrderWithGaps, BadCoordinatesDoNotCrash) {
  for (double bad : {kNaN, kInf, -kInf, 1e308}) {
    for (bool ccw : {true, false}) {
      Point const p{bad, bad};
      Point const q{1, 0};
      EXPECT_EQ(GeometryUtils::IsValidArcOrder(p, ccw, q, q, q),
                ReferenceFitting::IsValidArcOrder(p, ccw, q, q, q));
      EXPECT_EQ(GeometryUtils::IsValidArcOrder(q, ccw, p, q, {0, 1}),
                ReferenceFitting::IsValidArcOrder(q, ccw, p, q, {0, 1}));
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
