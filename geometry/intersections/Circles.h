// A segment, a line or a point against a full circle.

#pragma once

#include <optional>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/elementary/Points.h"
#include "geometry/elementary/Shapes.h"
#include "math/Assert.h"

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
CirclePoints CutCircleBySegment(Circle const& circle, Segment const& segment);

/// Where a line cuts a circle: of two points first the one with the lesser x, or the lesser y when
/// |a| > |b|. None when the line is degenerate or farther from the centre than the radius.
CirclePoints CutCircleByLine(Circle const& circle, ImplicitLine const& line);

/// The point of a circle that is nearest to p; nothing when p is nearer to the centre than half the
/// radius, where its direction would say little.
std::optional<Point> NearestOnCircle(Circle const& circle, Point const& p);

}  // namespace Vorn::Intersections
