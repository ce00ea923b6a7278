#include <cmath>
#include <limits>
#include <numbers>

#include "gtest/gtest.h"
#include "math/NumericConstants.h"
#include "support/Bits.h"

namespace Vorn::Testing {
namespace {

TEST(NumericConstants, PiIsCutAfterItsFourteenthDecimal) {
  EXPECT_SAME_BITS(Numeric::kTruncatedPi, 3.14159265358979);
  EXPECT_EQ(Bits(std::numbers::pi) - Bits(Numeric::kTruncatedPi), 7U);
}

TEST(NumericConstants, TwoPiAndHalfPiAreExactMultiplesOfTheCutPi) {
  EXPECT_SAME_BITS(Numeric::kTruncatedTwoPi, 6.28318530717958);
  EXPECT_SAME_BITS(Numeric::kTruncatedHalfPi, 1.570796326794895);
  EXPECT_EQ(Numeric::kTruncatedTwoPi, 2.0 * 3.14159265358979);
  EXPECT_EQ(Numeric::kTruncatedHalfPi * 2.0, 3.14159265358979);
}

TEST(NumericConstants, ArcSplitPiLiesOneUlpAboveTheCutPi) {
  EXPECT_SAME_BITS(Numeric::kArcSplitPi, 3.1415926535897905);
  EXPECT_SAME_BITS(Numeric::kArcSplitPi, Up(3.14159265358979));
  EXPECT_LT(Numeric::kArcSplitPi, std::numbers::pi);
}

TEST(NumericConstants, ZeroIsTheSmallestNormalDouble) {
  EXPECT_SAME_BITS(Numeric::kZero, 2.2250738585072014e-308);
  EXPECT_EQ(Bits(Numeric::kZero), 0x0010000000000000U);
}

TEST(NumericConstants, TangencyIsOneDoubleEpsilon) {
  EXPECT_SAME_BITS(Numeric::kTangency, 2.220446049250313e-16);
  EXPECT_SAME_BITS(Numeric::kTangency, Up(1.0) - 1.0);
}

TEST(IsZero, IncludesTheBoundAndEverythingBelow) {
  EXPECT_TRUE(Numeric::IsZero(0.0));
  EXPECT_TRUE(Numeric::IsZero(-0.0));
  EXPECT_TRUE(Numeric::IsZero(std::numeric_limits<double>::denorm_min()));
  EXPECT_TRUE(Numeric::IsZero(2.2250738585072014e-308));
  EXPECT_FALSE(Numeric::IsZero(Up(2.2250738585072014e-308)));
  EXPECT_TRUE(Numeric::IsZero(-1.0));
}

TEST(IsZero, IsFalseForNotANumber) { EXPECT_FALSE(Numeric::IsZero(kNaN)); }

TEST(IsZeroMagnitude, IncludesTheBoundOnBothSides) {
  for (double const sign : {1.0, -1.0}) {
    EXPECT_TRUE(Numeric::IsZeroMagnitude(sign * 0.0));
    EXPECT_TRUE(Numeric::IsZeroMagnitude(sign * 2.2250738585072014e-308));
    EXPECT_FALSE(Numeric::IsZeroMagnitude(sign * Up(2.2250738585072014e-308)));
    EXPECT_FALSE(Numeric::IsZeroMagnitude(sign * kInf));
  }
  EXPECT_FALSE(Numeric::IsZeroMagnitude(kNaN));
}

TEST(Sign, IsExactWithoutTolerance) {
  EXPECT_EQ(Numeric::Sign(0.0), 0);
  EXPECT_EQ(Numeric::Sign(-0.0), 0);
  EXPECT_EQ(Numeric::Sign(std::numeric_limits<double>::denorm_min()), 1);
  EXPECT_EQ(Numeric::Sign(-std::numeric_limits<double>::denorm_min()), -1);
  EXPECT_EQ(Numeric::Sign(kInf), 1);
  EXPECT_EQ(Numeric::Sign(-kInf), -1);
}

TEST(Sign, OfNotANumberIsPositive) {
  EXPECT_EQ(Numeric::Sign(kNaN), 1);
  EXPECT_EQ(Numeric::Sign(-kNaN), 1);
}

}  // namespace
}  // namespace Vorn::Testing
