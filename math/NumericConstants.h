#pragma once

#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>

/// The library's numeric literals, each once and with its reason, and the tests built on them.
namespace Vorn::Numeric {

/// Pi cut after the 14th decimal, 7 ulp below the double nearest to pi. Results depend on these
/// very bits: angle wraps, sweeps and areas are compared with recorded contours, so
/// std::numbers::pi must not take its place.
inline constexpr double kTruncatedPi = 3.14159265358979;

/// Twice kTruncatedPi, exactly: one wrap of an angle is two half wraps.
inline constexpr double kTruncatedTwoPi = 6.28318530717958;

/// Half of kTruncatedPi, exactly: right angles in azimuths, order tests and gimbal lock.
inline constexpr double kTruncatedHalfPi = 1.570796326794895;

/// Where the angular range of an arc is split at the seam of atan2. It lies one ulp above
/// kTruncatedPi, so the split never cuts off an angle that a wrap by kTruncatedTwoPi produced.
inline constexpr double kArcSplitPi = 3.1415926535897905;

/// The smallest normal double: lengths, areas, norms and denominators count as zero when they are
/// not above it. Absolute on purpose: a tolerance scaled by the data would make the answer depend
/// on where the part lies.
inline constexpr double kZero = 2.2250738585072014e-308;

/// One double epsilon, absolute: a discriminant, a half chord or a cosine not above it is tangency
/// (one touching point) or gimbal lock.
inline constexpr double kTangency = 2.220446049250313e-16;

static_assert(kTruncatedTwoPi == 2.0 * kTruncatedPi);
static_assert(kTruncatedHalfPi == 0.5 * kTruncatedPi);
static_assert(std::bit_cast<std::uint64_t>(kArcSplitPi) ==
              std::bit_cast<std::uint64_t>(kTruncatedPi) + 1);
static_assert(kZero == std::numeric_limits<double>::min());
static_assert(kTangency == std::numeric_limits<double>::epsilon());

/// For values that cannot be negative (squares, norms, areas): not above zero. False for a NaN.
constexpr bool IsZero(double value) { return value <= kZero; }

/// For values of either sign. False for a NaN.
inline bool IsZeroMagnitude(double value) { return std::fabs(value) <= kZero; }

/// -1, 0 or +1 by the exact sign; a NaN counts as positive, so it never passes for "on the line".
constexpr int Sign(double value) { return value == 0.0 ? 0 : (value < 0.0 ? -1 : 1); }

}  // namespace Vorn::Numeric
