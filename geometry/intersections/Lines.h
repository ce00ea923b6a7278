// Where lines cross each other.

#pragma once

#include <cmath>
#include <optional>

#include "geometry/elementary/ImplicitLine.h"
#include "math/NumericConstants.h"

namespace Vorn::Intersections {

using Elementary::ImplicitLine;
using Elementary::Point;

/// Where two lines cross; nothing for parallel ones, also for one line given twice.
inline std::optional<Point> CrossLines(ImplicitLine const& line1, ImplicitLine const& line2) {
  auto const& [a1, b1, c1] = line1;
  auto const& [a2, b2, c2] = line2;
  double const det = a1 * b2 - b1 * a2;
  // Strict here and nowhere else: a determinant of exactly the smallest normal double is divided.
  if (std::fabs(det) < Numeric::kZero) return std::nullopt;
  return Point{(b1 * c2 - c1 * b2) / det, (c1 * a2 - a1 * c2) / det};
}

/// The foot of the perpendicular from a point on a line; nothing when a*a + b*b counts as zero.
inline std::optional<Point> FootOn(ImplicitLine const& line, Point const& p) {
  return CrossLines(line, line.NormalThrough(p));
}

}  // namespace Vorn::Intersections
