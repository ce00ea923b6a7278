#pragma once

#include <cmath>

#include "geometry/fewest/promises/DrawnPiece.h"
#include "geometry/fewest/promises/Expansion.h"
#include "vorn/GeometryUtils.h"

/// On which side of a line a point lies, exactly, and whether two straight edges meet.
namespace Vorn::Promises {

/// Orientation without the short cut: the sign of the exact cross product.
inline int ExactOrientation(GeometryUtils::Point const& a, GeometryUtils::Point const& b,
                            GeometryUtils::Point const& c) {
  Expansion cross;
  cross.AddProduct(Expansion::Difference(b.x, a.x), Expansion::Difference(c.y, a.y), 1.0);
  cross.AddProduct(Expansion::Difference(b.y, a.y), Expansion::Difference(c.x, a.x), -1.0);
  return cross.Sign();
}

/// +1 when c lies on the left of the line from a to b, -1 on the right, 0 on it. Computed plainly
/// where rounding, 4 * 2^-53 of either product, cannot matter.
inline int Orientation(GeometryUtils::Point const& a, GeometryUtils::Point const& b,
                       GeometryUtils::Point const& c) {
  double const left = (b.x - a.x) * (c.y - a.y);
  double const right = (b.y - a.y) * (c.x - a.x);
  double const cross = left - right;
  double const rounding = 4.0 * kUnitRoundoff * (std::fabs(left) + std::fabs(right));
  if (cross > rounding) return 1;
  if (cross < -rounding) return -1;
  return ExactOrientation(a, b, c);
}

/// Whether the stretches from a to b and from c to d, ends included, have a number in common.
inline bool DoOverlap(double a, double b, double c, double d) {
  return std::fmin(a, b) <= std::fmax(c, d) && std::fmin(c, d) <= std::fmax(a, b);
}

/// Whether the edges a-b and c-d, ends included, have a common point.
inline bool DoEdgesMeet(GeometryUtils::Point const& a, GeometryUtils::Point const& b,
                        GeometryUtils::Point const& c, GeometryUtils::Point const& d) {
  return DoOverlap(a.x, b.x, c.x, d.x) && DoOverlap(a.y, b.y, c.y, d.y) &&
         Orientation(a, b, c) * Orientation(a, b, d) <= 0 &&
         Orientation(c, d, a) * Orientation(c, d, b) <= 0;
}

}  // namespace Vorn::Promises
