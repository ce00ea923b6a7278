#pragma once

#include <cmath>
#include <cstdint>
#include <span>
#include <vector>

#include "geometry/fewest/Circle.h"
#include "geometry/fewest/Columns.h"
#include "vorn/GeometryUtils.h"
#include "vorn/Types.h"

/// Coordinates near a part of the path: the origin on it, the unit about its length.
namespace Vorn::Fewest {

/// A shift and a scaling by a power of two, so that the scaling is exact and the shift is wherever
/// a point and the origin lie within a factor of two.
struct LocalFrame {
  double originX = 0.0;
  double originY = 0.0;
  double scale = 1.0;

  /// A point of the path with its tolerance, in local coordinates.
  Sample ToLocal(WPoint const& p) const {
    return {(p.x - originX) * scale, (p.y - originY) * scale, p.w * scale};
  }
  /// A place in local coordinates.
  Place ToLocal(Place const& p) const { return {(p.x - originX) * scale, (p.y - originY) * scale}; }
  /// A place in the coordinates of the path.
  Place FromLocal(Place const& p) const { return {p.x / scale + originX, p.y / scale + originY}; }
  /// A normalised circle in local coordinates.
  Circle ToLocal(PlacedCircle const& placed) const {
    // With p / scale + shift for a place p, f scale is the value in local units.
    Circle const& c = placed.about;
    double const shiftX = (originX - placed.origin.x) * scale;
    double const shiftY = (originY - placed.origin.y) * scale;
    Circle moved;
    moved.a = c.a / scale;
    moved.bx = c.bx + 2.0 * moved.a * shiftX;
    moved.by = c.by + 2.0 * moved.a * shiftY;
    moved.d =
        c.d * scale + c.bx * shiftX + c.by * shiftY + moved.a * (shiftX * shiftX + shiftY * shiftY);
    return moved;
  }
  /// A normalised local circle in the coordinates of the path. Exact.
  PlacedCircle FromLocal(Circle const& c) const {
    return {{c.a * scale, c.bx, c.by, c.d / scale}, {originX, originY}};
  }
};

/// The largest factor that lengths are scaled by: a hundredth of the range of doubles is left to
/// the squares of coordinates.
inline constexpr double kLargestScale = 0x1p1000;

/// The power of two by which a length has to be multiplied to lie in [0.5, 1), up to
/// kLargestScale; 1 for a length of 0.
inline double ScaleOf(double length) {
  if (!(length > 0.0)) return 1.0;
  int exponent = 0;
  std::frexp(length, &exponent);
  return std::fmin(kLargestScale, std::ldexp(1.0, -exponent));
}

/// Moves a whole path near the origin and to a size of about 1.
struct Shift {
  double originX = 0.0;
  double originY = 0.0;
  double scale = 1.0;

  /// The points moved. They are scaled first, which is exact and keeps huge ones from overflowing.
  std::vector<WPoint> Apply(std::span<WPoint const> points) const {
    std::vector<WPoint> moved;
    moved.reserve(points.size());
    for (WPoint const& p : points) {
      moved.push_back({p.x * scale - originX * scale, p.y * scale - originY * scale, p.w * scale});
    }
    return moved;
  }
  /// A point moved back.
  GeometryUtils::Point Restore(GeometryUtils::Point const& p) const {
    return {p.x / scale + originX, p.y / scale + originY};
  }
};

/// The larger of the extents of points in x and in y from the first of them.
inline double ExtentOf(std::span<WPoint const> points) {
  double extent = 0.0;
  for (WPoint const& p : points) {
    double const dx = std::fabs(p.x - points.front().x);
    double const dy = std::fabs(p.y - points.front().y);
    extent = dx > extent ? dx : extent;
    extent = dy > extent ? dy : extent;
  }
  return extent;
}

/// The shift of the first point to the origin.
inline Shift ShiftFor(std::span<WPoint const> points) {
  Shift shift{points.front().x, points.front().y, 1.0};
  double extent = 0.0;
  for (WPoint const& p : points) {
    extent = std::fmax(extent, std::fabs(0.5 * p.x - 0.5 * shift.originX));
    extent = std::fmax(extent, std::fabs(0.5 * p.y - 0.5 * shift.originY));
  }
  shift.scale = 0.5 * ScaleOf(extent);
  return shift;
}

}  // namespace Vorn::Fewest
