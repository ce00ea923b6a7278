// A segment, a line or a point against a full circle. What the public members call with loose
// numbers is inline, so that the numbers need not go through memory.

#pragma once

#include <cmath>
#include <optional>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/elementary/Points.h"
#include "geometry/elementary/Shapes.h"
#include "math/Assert.h"
#include "math/NumericConstants.h"

namespace Vorn::Intersections {

using Elementary::Circle;
using Elementary::ImplicitLine;
using Elementary::Point;
using Elementary::Segment;

/// Up to two points of a circle, in the order in which they were found.
struct CirclePoints {
  Point pts[2];
  /// How many there are.
  int count = 0;

  /// Appends a point; there must be room.
  void Add(Point const& p) {
    VORN_ASSERT(count < 2);
    pts[count++] = p;
  }
};

/// Where a segment, ends included, cuts a circle: of two points the one nearer to its end first.
/// One point when the line is tangent to the circle (the discriminant is not above one double
/// epsilon), none for a segment of zero length.
///
/// Notation: D the direction of the segment, F its start seen from the centre, t the parameter
/// along it; the points on the circle solve A t^2 + B t + C = 0.
///
/// Always inline: GCC by itself calls it for arcs, and a segment against an arc takes 14 per cent
/// longer then.
[[gnu::always_inline]] inline CirclePoints CutCircleBySegment(Circle const& circle,
                                                              Segment const& segment) {
  Point const& start = segment.start;
  Point const& end = segment.end;
  double const dx = end.x - start.x;
  double const dy = end.y - start.y;
  double const fx = start.x - circle.centre.x;
  double const fy = start.y - circle.centre.y;
  double const a = dx * dx + dy * dy;
  double const b = 2.0 * (dx * fx + dy * fy);
  double const c = fx * fx + fy * fy - circle.radius * circle.radius;
  double const disc = b * b - 4.0 * a * c;
  CirclePoints found;
  if (disc < 0.0) return found;

  auto const takeIfOnSegment = [&](double t) {
    // A zero-length segment makes t infinite or a NaN, which is outside.
    if (0.0 <= t && t <= 1.0) found.Add({start.x + t * dx, start.y + t * dy});
  };
  double const root = std::sqrt(disc);
  takeIfOnSegment((root - b) / (2.0 * a));
  if (disc > Numeric::kTangency) takeIfOnSegment((-b - root) / (2.0 * a));
  return found;
}

/// Where a line cuts a circle: of two points first the one with the lesser x, or the lesser y when
/// |a| > |b|. None when the line is degenerate or farther from the centre than the radius.
CirclePoints CutCircleByLine(Circle const& circle, ImplicitLine const& line);

/// The point of a circle that is nearest to p; nothing when p is nearer to the centre than half the
/// radius, where its direction would say little.
std::optional<Point> NearestOnCircle(Circle const& circle, Point const& p);

}  // namespace Vorn::Intersections
