#pragma once

#include "vorn/GeometryUtils.h"

namespace Vorn::Intersections {

/// Up to two points of a circle, in the order in which they were found.
struct CirclePoints {
  GeometryUtils::Point pts[2];
  int count = 0;

  void Add(double x, double y) { pts[count++] = {x, y}; }

  /// Hands out what was found: the first point to (ax, ay), the second to (bx, by), nothing beyond
  /// the count. Returns the count.
  int Write(double* ax, double* ay, double* bx, double* by) const;
};

/// Where the segment (x1, y1)-(x2, y2), ends included, cuts the circle: the far root first. One
/// point when the line is tangent to the circle, none for a segment of zero length.
CirclePoints CutCircle(double x1, double y1, double x2, double y2, double cx, double cy, double r);

/// Where the line a*x + b*y + c = 0 cuts the circle.
CirclePoints CutCircleByLine(double a, double b, double c, double cx, double cy, double r);

}  // namespace Vorn::Intersections
