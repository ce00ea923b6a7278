// A triangle with its box: what a cell keeps of each of its triangles.

#pragma once

#include "geometry/triangles/Triangle.h"

namespace Vorn::Cells {

using Elementary::Point;
using Triangles::Triangle;

/// A triangle with its box.
struct BoxedTriangle {
  /// The triangle and its box.
  explicit BoxedTriangle(Triangle const& from) : triangle(from), box(Triangles::BoxOf(from)) {}

  /// Whether a point is beyond the box. False when a coordinate is not a number.
  bool IsOutOfBox(Point const& p) const {
    return (box.xMin > p.x) | (p.x > box.xMax) | (box.yMin > p.y) | (p.y > box.yMax);
  }

  Triangle triangle;
  Triangles::Box box;
};

}  // namespace Vorn::Cells
