// A triangle prepared for overlaps, and where points lie with respect to it.

#pragma once

#include "geometry/triangles/Triangle.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Triangles {

using PointStatus = GeometryUtils::PointStatus;

/// A triangle with what every overlap asks of it.
struct PreparedTriangle {
  /// Prepares a triangle.
  explicit PreparedTriangle(Triangle const& from);

  /// Whether the boxes have no point in common. False when a coordinate is not a number.
  bool IsApartFrom(PreparedTriangle const& other) const {
    return box.xMin > other.box.xMax || other.box.xMin > box.xMax || box.yMin > other.box.yMax ||
           other.box.yMin > box.yMax;
  }

  /// Where a point lies with respect to the triangle, which may have either orientation.
  PointStatus StatusOf(Point const& p) const;

  /// Side i runs from vertex i to the next one.
  struct Side {
    double dx, dy;
    /// The part of the side in the area of the triangle that it forms with a point.
    double term;
    double xLow, yLow, xHigh, yHigh;
  };

  Triangle triangle;
  Side sides[3];
  Box box;
  /// Sign of the area.
  int sense;
  /// Whether all coordinates are numbers, so that boxes can be compared.
  bool isOrdered;

 private:
  /// The status of a point on the line of a side, or in a degenerate triangle.
  PointStatus StatusNearSides(Point const& p, double const* areas) const;
};

}  // namespace Vorn::Triangles
