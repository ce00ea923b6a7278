// The radii at which a circle about a given centre passes within the tolerances of points.

#pragma once

#include <algorithm>
#include <cstdint>
#include <optional>

#include "math/Assert.h"
#include "vorn/Types.h"

namespace Vorn::Fitting {

/// The tolerance of a point where a common one may be given; a negative one stands for each point's
/// own.
inline double ToleranceOf(WPoint const& p, double tolerance) {
  return tolerance < 0.0 ? p.w : tolerance;
}

/// A range of radii; empty when the least one is above the greatest.
struct RadiusRange {
  double least = 0.0;
  double greatest = 0.0;

  /// The radii within tolerance of one point.
  static RadiusRange Of(double distance, double tolerance) {
    return {distance - tolerance, distance + tolerance};
  }

  /// Whether there is no radius in it. False when a limit is not a number.
  bool IsEmpty() const { return least > greatest; }

  /// Keeps what is in another range as well. A limit of the other that is not a number changes
  /// nothing; one of this range stays.
  void NarrowBy(RadiusRange const& other) {
    least = std::max(least, other.least);
    greatest = std::min(greatest, other.greatest);
  }

  /// The radius half way between the limits.
  double Middle() const { return (least + greatest) * 0.5; }
};

/// What the ranges at the positions 0 .. count - 1 have in common, count being 1 at least; nothing
/// when that is empty. O(count).
template <typename RangeAt>
std::optional<RadiusRange> CommonRange(std::int32_t count, RangeAt const& rangeAt) {
  VORN_ASSERT(count >= 1);
  RadiusRange common = rangeAt(0);
  for (std::int32_t i = 1; i < count && !common.IsEmpty(); ++i) common.NarrowBy(rangeAt(i));
  if (common.IsEmpty()) return std::nullopt;
  return common;
}

}  // namespace Vorn::Fitting
