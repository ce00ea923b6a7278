// Angles in radians. Polar angles are those of atan2, in (-pi, pi].
//
// An angle is wrapped at most once and always by the truncated constants: callers feed it angles
// of atan2 or differences of two of them, for which one wrap is enough, and further wraps would
// change results that are compared bit for bit.

#pragma once

#include <cmath>

#include "geometry/elementary/Points.h"
#include "math/NumericConstants.h"

namespace Vorn::Elementary {

/// The polar angle of a point as seen from a centre, in (-pi, pi]; 0 for the centre itself.
inline double AngleAbout(Point const& centre, Point const& p) {
  return std::atan2(p.y - centre.y, p.x - centre.x);
}

/// The length of an arc: its sweep, wrapped once, times the radius; 0 for equal angles. A direction
/// that is not above zero is clockwise.
inline double ArcLength(GeometryUtils::Arc const& arc) {
  double start = arc.startAngle;
  double end = arc.endAngle;
  if (arc.direction > 0.0) {
    if (start > end) end += Numeric::kTruncatedTwoPi;
    return (end - start) * arc.radius;
  }
  if (end > start) end -= Numeric::kTruncatedTwoPi;
  return (start - end) * arc.radius;
}

/// The sweep of an arc: its length divided by the radius, 0.0 when that is not above zero.
/// Deliberate: not the difference of the angles, which has other last bits.
inline double ArcSweep(GeometryUtils::Arc const& arc) {
  return Numeric::IsZero(arc.radius) ? 0.0 : ArcLength(arc) / arc.radius;
}

}  // namespace Vorn::Elementary
