// Bounding rectangles of cells, and the chords of the circles around them.

#pragma once

#include <optional>
#include <span>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/triangles/Triangle.h"

namespace Vorn::Cells {

using Elementary::Point;
using Triangles::Triangle;

/// A rectangle along the axes.
struct Rect {
  double xMin, yMin, xMax, yMax;

  /// The rectangle that holds a single point.
  static Rect Around(Point const& p) { return {p.x, p.y, p.x, p.y}; }

  /// Widens the rectangle to take in a triangle; only strict extremes replace what stands there.
  void Include(Triangle const& triangle) {
    for (Point const& p : triangle.pts) {
      if (p.x < xMin) xMin = p.x;
      if (p.y < yMin) yMin = p.y;
      if (p.x > xMax) xMax = p.x;
      if (p.y > yMax) yMax = p.y;
    }
  }
};

/// The bounding rectangle of a cell; nothing for an empty one. O(size of cell).
std::optional<Rect> BoundingRect(std::span<Triangle const> cell);

/// The part of a line inside the circle around a rectangle, as a degenerate triangle: (P1, P2, P2),
/// or (P1, P1, P1) where the line only touches. Nothing where it misses the circle.
std::optional<Triangle> ChordAcross(Rect const& rect, Elementary::ImplicitLine const& line);

}  // namespace Vorn::Cells
