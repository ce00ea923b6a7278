// Points of the plane: how far apart they are and what lies half way between them.

#pragma once

#include <cmath>

#include "vorn/GeometryUtils.h"

namespace Vorn::Elementary {

using Point = GeometryUtils::Point;

/// The squared distance of two points: the square of the difference in y plus that in x.
inline double SquaredDistance(Point const& p, Point const& q) {
  double const dx = p.x - q.x;
  double const dy = p.y - q.y;
  return dy * dy + dx * dx;
}

/// The distance of two points. Deliberate: the root of the squared distance and not std::hypot,
/// which rounds differently.
inline double Distance(Point const& p, Point const& q) { return std::sqrt(SquaredDistance(p, q)); }

/// The point half way between two points.
inline Point Middle(Point const& p, Point const& q) {
  return {(p.x + q.x) * 0.5, (p.y + q.y) * 0.5};
}

}  // namespace Vorn::Elementary
