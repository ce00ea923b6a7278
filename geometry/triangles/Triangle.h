// Single triangles: sides, signed area and box.
//
// There is no tolerance anywhere: only an area of exactly 0.0 makes a triangle degenerate or puts a
// point on a side. Cells are cut again and again, and a tolerance would let the parts of a cell
// drift away from each other.

#pragma once

#include "geometry/elementary/Points.h"
#include "geometry/elementary/Sense.h"
#include "geometry/elementary/Shapes.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Triangles {

using Elementary::Point;
using Elementary::Segment;
using Triangle = GeometryUtils::Triangle;

/// The vertex or side of a triangle that follows each of them.
inline constexpr int kNext[3] = {1, 2, 0};

/// Side i of a triangle, from vertex i to the next one.
inline Segment SideOf(Triangle const& triangle, int i) {
  return {triangle.pts[i], triangle.pts[kNext[i]]};
}

/// The signed area: positive for vertices that run clockwise in a y-up frame.
inline double SignedArea(Triangle const& triangle) {
  return Elementary::SignedArea(triangle.pts[0], triangle.pts[1], triangle.pts[2]);
}

/// The bounding box of a triangle.
struct Box {
  double xMin, yMin, xMax, yMax;
};

/// The box of a triangle; without bounds along an axis on which a coordinate is not a number, so
/// that nothing is ever found to lie beyond it.
Box BoxOf(Triangle const& triangle);

}  // namespace Vorn::Triangles
