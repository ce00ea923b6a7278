#include <cmath>
#include <cstdint>
#include <limits>
#include <numbers>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Arc = GeometryUtils::Arc;
using Elem = GeometryUtils::Elem;
using Point = GeometryUtils::Point;

constexpr double kPi = 3.14159265358979;
constexpr double kTwoPi = 6.28318530717958;
constexpr double kHalfPi = 1.570796326794895;
constexpr double kSmallestNormal = 2.2250738585072014e-308;

Arc MakeArc(double startAngle, double endAngle, double direction, double radius) {
  Arc arc;
  arc.radius = radius;
  arc.direction = direction;
  arc.startAngle = startAngle;
  arc.endAngle = endAngle;
  return arc;
}

// --- GetNaturalAngle --------------------------------------------------------------------------

TEST(GetNaturalAngle, CountsADisplacementDownTheScreenAsNegative) {
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(1.0, 0.0), -std::numbers::pi / 2);
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(-1.0, 0.0), std::numbers::pi / 2);
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(-1.0, 1.0), std::numbers::pi / 4);
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(1.0, 1.0), -std::numbers::pi / 4);
}

TEST(GetNaturalAngle, NegatesTheSignOfAZeroDisplacement) {
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(0.0, 1.0), -0.0);
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(-0.0, 1.0), 0.0);
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(0.0, -1.0), -std::numbers::pi);
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(-0.0, -1.0), std::numbers::pi);
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(0.0, 0.0), -0.0);
}

TEST(GetNaturalAngle, PropagatesNotANumberAndTakesInfinities) {
  EXPECT_TRUE(std::isnan(GeometryUtils::GetNaturalAngle(kNaN, 1.0)));
  EXPECT_TRUE(std::isnan(GeometryUtils::GetNaturalAngle(1.0, kNaN)));
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(kInf, 1.0), -std::numbers::pi / 2);
  EXPECT_SAME_BITS(GeometryUtils::GetNaturalAngle(-kInf, kInf), std::numbers::pi / 4);
}

// --- NaturalAngleToAzimuthRad -----------------------------------------------------------------

TEST(NaturalAngleToAzimuthRad, MeasuresClockwiseFromNorth) {
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(0.0), kHalfPi);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(-0.0), kHalfPi);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(kHalfPi), 0.0);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(-kHalfPi), kPi);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(kPi), (kHalfPi - kPi) + kTwoPi);
}

TEST(NaturalAngleToAzimuthRad, WrapsOnlyBelowZero) {
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(Down(kHalfPi)), kHalfPi - Down(kHalfPi));
  // The smallest negative value is lost in the sum: a full turn comes back, not zero.
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(Up(kHalfPi)), kTwoPi);
}

TEST(NaturalAngleToAzimuthRad, MakesOneCorrectionOnly) {
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(-5.0), kHalfPi + 5.0);
  EXPECT_GT(GeometryUtils::NaturalAngleToAzimuthRad(-5.0), kTwoPi);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(8.0), (kHalfPi - 8.0) + kTwoPi);
  EXPECT_LT(GeometryUtils::NaturalAngleToAzimuthRad(8.0), 0.0);
}

TEST(NaturalAngleToAzimuthRad, PropagatesNotANumberAndInfinity) {
  EXPECT_TRUE(std::isnan(GeometryUtils::NaturalAngleToAzimuthRad(kNaN)));
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(kInf), -kInf);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToAzimuthRad(-kInf), kInf);
}

// --- NaturalAngleToTangentialAzimuthRad ---------------------------------------------------------

TEST(NaturalAngleToTangentialAzimuthRad, FlaggedFormIsNeverWrapped) {
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(0.5, true), kPi - 0.5);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(5.0, true), kPi - 5.0);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(-5.0, true), kPi + 5.0);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(kPi, true), 0.0);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(0.0, true), kPi);
}

TEST(NaturalAngleToTangentialAzimuthRad, UnflaggedFormWrapsPositiveAngles) {
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(0.5, false), kTwoPi - 0.5);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(-0.5, false), 0.5);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(7.0, false), kTwoPi - 7.0);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(
                       std::numeric_limits<double>::denorm_min(), false),
                   kTwoPi);
}

TEST(NaturalAngleToTangentialAzimuthRad, UnflaggedZeroChangesItsSign) {
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(0.0, false), -0.0);
  EXPECT_SAME_BITS(GeometryUtils::NaturalAngleToTangentialAzimuthRad(-0.0, false), 0.0);
}

TEST(NaturalAngleToTangentialAzimuthRad, PropagatesNotANumber) {
  EXPECT_TRUE(std::isnan(GeometryUtils::NaturalAngleToTangentialAzimuthRad(kNaN, true)));
  EXPECT_TRUE(std::isnan(GeometryUtils::NaturalAngleToTangentialAzimuthRad(kNaN, false)));
}

// --- SubtrAng ---------------------------------------------------------------------------------

TEST(SubtrAng, SwapsTheEndsOfItsRange) {
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(kPi, 0.0), -kPi);
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(0.0, kPi), kPi);
}

TEST(SubtrAng, LeavesDifferencesInsideTheRangeAlone) {
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(Down(kPi), 0.0), Down(kPi));
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(0.0, Down(kPi)), -Down(kPi));
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(1.25, 0.5), 0.75);
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(0.5, 0.5), 0.0);
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(-0.0, 0.0), -0.0);
}

TEST(SubtrAng, WrapsDifferencesOutsideTheRange) {
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(Up(kPi), 0.0), Up(kPi) - kTwoPi);
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(0.0, Up(kPi)), kTwoPi - Up(kPi));
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(3.0, -3.0), 6.0 - kTwoPi);
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(-3.0, 3.0), kTwoPi - 6.0);
}

TEST(SubtrAng, WrapsOnce) {
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(100.0, 0.0), 100.0 - kTwoPi);
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(0.0, 100.0), -100.0 + kTwoPi);
}

TEST(SubtrAng, PropagatesNotANumberAndInfinity) {
  EXPECT_TRUE(std::isnan(GeometryUtils::SubtrAng(kNaN, 0.0)));
  EXPECT_TRUE(std::isnan(GeometryUtils::SubtrAng(0.0, kNaN)));
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(kInf, 0.0), kInf);
  EXPECT_SAME_BITS(GeometryUtils::SubtrAng(0.0, kInf), -kInf);
}

TEST(SubtrAng, ChangesSignWhenItsArgumentsChangePlaces) {
  constexpr std::uint64_t kSeed = 1201;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 5000; ++i) {
    double const a = random.Uniform(-7.0, 7.0);
    double const b = random.Uniform(-7.0, 7.0);
    ASSERT_EQ(GeometryUtils::SubtrAng(a, b), -GeometryUtils::SubtrAng(b, a));
  }
}

// --- GetArcLength and GetArcAngleRad ----------------------------------------------------------

TEST(GetArcLength, CounterClockwiseAcrossTheSeamAddsOneTurn) {
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(3.0, -3.0, 1.0, 1.0)), kTwoPi - 6.0);
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(3.0, -3.0, 1.0, 4.0)), 4.0 * (kTwoPi - 6.0));
}

TEST(GetArcLength, ClockwiseAcrossTheSeamSubtractsOneTurn) {
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(-3.0, 3.0, -1.0, 1.0)), kTwoPi - 6.0);
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(-1.0, 2.0, -1.0, 0.5)),
                   0.5 * (-1.0 - (2.0 - kTwoPi)));
}

TEST(GetArcLength, NeedsNoWrapWhenAnglesRunInTheDirection) {
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(-0.5, 1.25, 1.0, 2.0)), 3.5);
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(1.25, -0.5, -1.0, 2.0)), 3.5);
}

TEST(GetArcLength, ReadsOnlyTheSignOfTheDirection) {
  double const tiny = std::numeric_limits<double>::denorm_min();
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(0.0, 1.0, tiny, 1.0)), 1.0);
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(0.0, 1.0, 1e300, 1.0)), 1.0);
  double const clockwise = 0.0 - (1.0 - kTwoPi);
  for (double const direction : {-tiny, -1e300, 0.0, -0.0, kNaN}) {
    EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(0.0, 1.0, direction, 1.0)), clockwise)
        << direction;
  }
}

TEST(GetArcLength, EqualAnglesGiveZeroInBothDirections) {
  for (double const direction : {1.0, -1.0, 0.0}) {
    EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(2.0, 2.0, direction, 5.0)), 0.0);
    EXPECT_EQ(GeometryUtils::GetArcLength(MakeArc(0.0, -0.0, direction, 5.0)), 0.0);
  }
}

TEST(GetArcLength, AHairBackwardsIsAlmostAFullTurn) {
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(1.0, Down(1.0), 1.0, 1.0)),
                   (Down(1.0) + kTwoPi) - 1.0);
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(1.0, Up(1.0), -1.0, 1.0)),
                   1.0 - (Up(1.0) - kTwoPi));
}

TEST(GetArcLength, TheLeastSweepsAcrossTheSeamComeOutNegative) {
  double const pi = std::numbers::pi;
  for (double const radius : {1.0, 8.0}) {
    double const counterClockwise = GeometryUtils::GetArcLength(MakeArc(pi, Up(-pi), 1.0, radius));
    EXPECT_SAME_BITS(counterClockwise, (Up(-pi) + kTwoPi - pi) * radius);
    EXPECT_LT(counterClockwise, 0.0);
    EXPECT_GT(counterClockwise, -7e-15 * radius);
    EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(Up(-pi), pi, -1.0, radius)),
                     counterClockwise);
  }
  EXPECT_GT(GeometryUtils::GetArcLength(MakeArc(pi, -pi + 7e-15, 1.0, 1.0)), 0.0);
}

TEST(GetArcLength, DoesNotCheckTheRadius) {
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(0.0, 1.0, 1.0, 0.0)), 0.0);
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(0.0, 1.0, 1.0, -2.0)), -2.0);
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(MakeArc(0.0, 1.0, 1.0, kInf)), kInf);
  EXPECT_TRUE(std::isnan(GeometryUtils::GetArcLength(MakeArc(0.0, 1.0, 1.0, kNaN))));
  EXPECT_TRUE(std::isnan(GeometryUtils::GetArcLength(MakeArc(kNaN, 1.0, 1.0, 1.0))));
}

TEST(GetArcLength, TakesAContourElement) {
  Elem elem;
  elem.type = GeometryUtils::ElemType::Arc;
  elem.radius = 2.0;
  elem.direction = 1.0;
  elem.startAngle = 0.25;
  elem.endAngle = 0.75;
  EXPECT_SAME_BITS(GeometryUtils::GetArcLength(elem), 1.0);
}

TEST(GetArcLength, ReversedArcHasTheSameLength) {
  constexpr std::uint64_t kSeed = 1202;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 2000; ++i) {
    double const start = random.Uniform(-3.14, 3.14);
    double const end = random.Uniform(-3.14, 3.14);
    double const radius = random.Uniform(0.1, 100.0);
    double const forward = GeometryUtils::GetArcLength(MakeArc(start, end, 1.0, radius));
    double const backward = GeometryUtils::GetArcLength(MakeArc(end, start, -1.0, radius));
    ASSERT_NEAR(forward, backward, 1e-13 * radius);
    ASSERT_GE(forward, 0.0);
    ASSERT_LT(forward, kTwoPi * radius);
  }
}

TEST(GetArcAngleRad, IsZeroForARadiusNotAboveTheSmallestNormal) {
  for (double const radius : {0.0, -0.0, -1.0, -kInf, kSmallestNormal, Down(kSmallestNormal)}) {
    EXPECT_SAME_BITS(GeometryUtils::GetArcAngleRad(MakeArc(0.0, 1.0, 1.0, radius)), 0.0) << radius;
  }
  EXPECT_SAME_BITS(GeometryUtils::GetArcAngleRad(MakeArc(0.0, 1.0, 1.0, Up(kSmallestNormal))), 1.0);
}

TEST(GetArcAngleRad, DividesTheLengthByTheRadius) {
  EXPECT_SAME_BITS(GeometryUtils::GetArcAngleRad(MakeArc(3.0, -3.0, 1.0, 1.0)), kTwoPi - 6.0);
  double const radius = 0.1;
  double const length = (0.7 - 0.3) * radius;
  EXPECT_SAME_BITS(GeometryUtils::GetArcAngleRad(MakeArc(0.3, 0.7, 1.0, radius)), length / radius);
}

TEST(GetArcAngleRad, EqualAnglesSweepNothing) {
  EXPECT_SAME_BITS(GeometryUtils::GetArcAngleRad(MakeArc(1.5, 1.5, 1.0, 3.0)), 0.0);
  EXPECT_SAME_BITS(GeometryUtils::GetArcAngleRad(MakeArc(1.5, 1.5, -1.0, 3.0)), 0.0);
}

TEST(GetArcAngleRad, PropagatesNotANumberAndInfinity) {
  EXPECT_TRUE(std::isnan(GeometryUtils::GetArcAngleRad(MakeArc(0.0, 1.0, 1.0, kNaN))));
  EXPECT_TRUE(std::isnan(GeometryUtils::GetArcAngleRad(MakeArc(0.0, kNaN, 1.0, 1.0))));
  EXPECT_TRUE(std::isnan(GeometryUtils::GetArcAngleRad(MakeArc(0.0, 1.0, 1.0, kInf))));
}

TEST(GetArcAngleRad, FollowsLengthOverRadiusBitForBit) {
  constexpr std::uint64_t kSeed = 1203;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 2000; ++i) {
    double const start = random.Uniform(-3.14, 3.14);
    double const end = random.Uniform(-3.14, 3.14);
    double const radius = random.Uniform(0.1, 100.0);
    double const to = start > end ? end + kTwoPi : end;
    ASSERT_EQ(GeometryUtils::GetArcAngleRad(MakeArc(start, end, 1.0, radius)),
              ((to - start) * radius) / radius);
    double const back = end > start ? end - kTwoPi : end;
    ASSERT_EQ(GeometryUtils::GetArcAngleRad(MakeArc(start, end, -1.0, radius)),
              ((start - back) * radius) / radius);
  }
}

}  // namespace
}  // namespace Vorn::Testing
