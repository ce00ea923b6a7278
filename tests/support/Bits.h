#pragma once

#include <bit>
#include <cmath>
#include <cstdint>
#include <iomanip>
#include <limits>
#include <vector>

#include "gtest/gtest.h"
#include "vorn/GeometryUtils.h"

/// Bit-for-bit comparison of results and the sentinels that outputs are preset to.
namespace Vorn::Testing {

inline constexpr double kInf = std::numeric_limits<double>::infinity();
inline constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

/// What outputs hold before a call. No operation computes these values, so an output that still
/// holds its sentinel was not written.
inline constexpr double kSentinel = -8.125e77;
inline constexpr std::int32_t kIntSentinel = -77077;
inline constexpr GeometryUtils::Point kPointSentinel{kSentinel, kSentinel};

inline std::uint64_t Bits(double value) { return std::bit_cast<std::uint64_t>(value); }

/// Equal bits, so that -0.0 differs from 0.0; all not-a-numbers are equal to each other, because
/// their sign and payload depend on the processor.
inline bool SameBits(double a, double b) {
  return (std::isnan(a) && std::isnan(b)) || Bits(a) == Bits(b);
}

inline bool SameBits(GeometryUtils::Point const& a, GeometryUtils::Point const& b) {
  return SameBits(a.x, b.x) && SameBits(a.y, b.y);
}

/// For oracles that compute with more digits than the library.
inline long double Extended(double value) { return static_cast<long double>(value); }

/// Next double above or below.
inline double Up(double value) { return std::nextafter(value, kInf); }
inline double Down(double value) { return std::nextafter(value, -kInf); }

/// For EXPECT_PRED_FORMAT2; use the macros below.
inline testing::AssertionResult DoubleBitsEqual(char const* leftText, char const* rightText,
                                                double left, double right) {
  if (SameBits(left, right)) return testing::AssertionSuccess();
  return testing::AssertionFailure()
         << leftText << " and " << rightText << " differ in bits: " << std::setprecision(17) << left
         << " (0x" << std::hex << Bits(left) << ") against " << right << " (0x" << Bits(right)
         << ")";
}

inline testing::AssertionResult PointBitsEqual(char const* leftText, char const* rightText,
                                               GeometryUtils::Point const& left,
                                               GeometryUtils::Point const& right) {
  if (SameBits(left, right)) return testing::AssertionSuccess();
  return testing::AssertionFailure()
         << leftText << " and " << rightText << " differ in bits: " << std::setprecision(17) << "("
         << left.x << ", " << left.y << ") against (" << right.x << ", " << right.y << ")";
}

}  // namespace Vorn::Testing

#define EXPECT_SAME_BITS(left, right) \
  EXPECT_PRED_FORMAT2(::Vorn::Testing::DoubleBitsEqual, left, right)
#define EXPECT_SAME_POINT(left, right) \
  EXPECT_PRED_FORMAT2(::Vorn::Testing::PointBitsEqual, left, right)
