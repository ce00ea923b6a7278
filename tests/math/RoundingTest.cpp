#include <cmath>
#include <cstdint>
#include <limits>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "vorn/MathUtils.h"

namespace Vorn::Testing {
namespace {

constexpr std::int32_t kLongMin = std::numeric_limits<std::int32_t>::min();
constexpr std::int32_t kLongMax = std::numeric_limits<std::int32_t>::max();

TEST(GetOutsideMax, IsTheSmallestWholeNumberNotBelow) {
  EXPECT_EQ(MathUtils::GetOutsideMax(0.0), 0);
  EXPECT_EQ(MathUtils::GetOutsideMax(-0.0), 0);
  EXPECT_EQ(MathUtils::GetOutsideMax(2.0), 2);
  EXPECT_EQ(MathUtils::GetOutsideMax(Up(2.0)), 3);
  EXPECT_EQ(MathUtils::GetOutsideMax(Down(2.0)), 2);
  EXPECT_EQ(MathUtils::GetOutsideMax(-2.0), -2);
  EXPECT_EQ(MathUtils::GetOutsideMax(Up(-2.0)), -1);
  EXPECT_EQ(MathUtils::GetOutsideMax(Down(-2.0)), -2);
  EXPECT_EQ(MathUtils::GetOutsideMax(-0.5), 0);
  EXPECT_EQ(MathUtils::GetOutsideMax(std::numeric_limits<double>::denorm_min()), 1);
  EXPECT_EQ(MathUtils::GetOutsideMax(-std::numeric_limits<double>::denorm_min()), 0);
}

TEST(GetOutsideMin, IsTheLargestWholeNumberNotAbove) {
  EXPECT_EQ(MathUtils::GetOutsideMin(0.0), 0);
  EXPECT_EQ(MathUtils::GetOutsideMin(-0.0), 0);
  EXPECT_EQ(MathUtils::GetOutsideMin(2.0), 2);
  EXPECT_EQ(MathUtils::GetOutsideMin(Up(2.0)), 2);
  EXPECT_EQ(MathUtils::GetOutsideMin(Down(2.0)), 1);
  EXPECT_EQ(MathUtils::GetOutsideMin(-2.0), -2);
  EXPECT_EQ(MathUtils::GetOutsideMin(Up(-2.0)), -2);
  EXPECT_EQ(MathUtils::GetOutsideMin(Down(-2.0)), -3);
  EXPECT_EQ(MathUtils::GetOutsideMin(0.5), 0);
  EXPECT_EQ(MathUtils::GetOutsideMin(std::numeric_limits<double>::denorm_min()), 0);
  EXPECT_EQ(MathUtils::GetOutsideMin(-std::numeric_limits<double>::denorm_min()), -1);
}

TEST(GetOutsideMax, ReachesBothEndsOfTheLongRange) {
  EXPECT_EQ(MathUtils::GetOutsideMax(2147483647.0), kLongMax);
  EXPECT_EQ(MathUtils::GetOutsideMax(2147483646.5), kLongMax);
  EXPECT_EQ(MathUtils::GetOutsideMax(Up(2147483647.0)), kLongMin);
  EXPECT_EQ(MathUtils::GetOutsideMax(-2147483647.5), -2147483647);
  EXPECT_EQ(MathUtils::GetOutsideMax(-2147483648.0), kLongMin);
  EXPECT_EQ(MathUtils::GetOutsideMax(-2147483648.5), kLongMin);
  EXPECT_EQ(MathUtils::GetOutsideMax(-2147483649.0), kLongMin);
}

TEST(GetOutsideMin, ReachesBothEndsOfTheLongRange) {
  EXPECT_EQ(MathUtils::GetOutsideMin(2147483647.0), kLongMax);
  EXPECT_EQ(MathUtils::GetOutsideMin(Down(2147483648.0)), kLongMax);
  EXPECT_EQ(MathUtils::GetOutsideMin(2147483648.0), kLongMin);
  EXPECT_EQ(MathUtils::GetOutsideMin(-2147483647.0), -2147483647);
  EXPECT_EQ(MathUtils::GetOutsideMin(-2147483647.5), kLongMin);
  EXPECT_EQ(MathUtils::GetOutsideMin(-2147483648.0), kLongMin);
  EXPECT_EQ(MathUtils::GetOutsideMin(Down(-2147483648.0)), kLongMin);
}

TEST(GetOutsideMaxAndMin, OutsideTheLongRangeGiveTheIntegerIndefiniteValue) {
  for (double const value : {kNaN, -kNaN, kInf, -kInf, 4294967296.0, -4294967296.0, 1e300, -1e300,
                             4294967297.0, 9223372036854775808.0, -9223372036854775808.0}) {
    EXPECT_EQ(MathUtils::GetOutsideMax(value), kLongMin) << value;
    EXPECT_EQ(MathUtils::GetOutsideMin(value), kLongMin) << value;
  }
}

TEST(GetOutsideMaxAndMin, AgreeWithWholeNumberArithmeticOnSixtyFourths) {
  constexpr std::uint64_t kSeed = 20240117;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 20000; ++i) {
    std::int64_t const whole = random.Integer(-2147483000, 2147483000);
    std::int64_t const part = random.Integer(0, 63);
    double const value = static_cast<double>(whole * 64 + part) / 64.0;
    ASSERT_EQ(MathUtils::GetOutsideMin(value), whole) << value;
    ASSERT_EQ(MathUtils::GetOutsideMax(value), whole + (part != 0 ? 1 : 0)) << value;
    ASSERT_EQ(MathUtils::GetOutsideMax(-value), -MathUtils::GetOutsideMin(value)) << value;
  }
}

}  // namespace
}  // namespace Vorn::Testing
