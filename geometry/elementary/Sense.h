// The signed area of three points and the sense in which they turn. There is no tolerance: only an
// area of exactly 0.0 counts as none.

#pragma once

#include <optional>

#include "geometry/elementary/Points.h"

namespace Vorn::Elementary {

/// What the way from one point to another adds to twice the signed area of a polygon. The term of
/// the way back is this one negated, down to the last bit.
inline double AreaTerm(Point const& start, Point const& end) {
  return end.x * start.y - start.x * end.y;
}

/// The signed area of a triangle from the terms of its sides. Halved only at the end: an area that
/// the halving turns into zero counts as zero.
inline double AreaOfTerms(double term0, double term1, double term2) {
  return 0.5 * (term0 + term1 + term2);
}

/// The signed area of the triangle a, b, c: positive for vertices that run clockwise in a y-up
/// frame.
inline double SignedArea(Point const& a, Point const& b, Point const& c) {
  return AreaOfTerms(AreaTerm(a, b), AreaTerm(b, c), AreaTerm(c, a));
}

/// Whether a, b and c turn counter-clockwise; nothing when their area is exactly 0.0.
inline std::optional<bool> IsCounterClockwise(Point const& a, Point const& b, Point const& c) {
  double const area = SignedArea(a, b, c);
  if (area == 0.0) return std::nullopt;
  return area < 0.0;
}

}  // namespace Vorn::Elementary
