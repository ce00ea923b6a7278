// How far the formulas of an overlap can be off by rounding. From this bound the cutters know when
// a sign is certain.

#pragma once

#include <cmath>
#include <limits>
#include <span>

#include "geometry/triangles/Triangle.h"

namespace Vorn::Cells {

using Elementary::Point;
using Triangles::Triangle;

/// How large the coordinates of a set of triangles are.
struct Magnitude {
  /// The largest |x|.
  double x = 0.0;
  /// The largest |y|.
  double y = 0.0;
  /// Zero, or not a number as soon as a coordinate is not finite.
  double doubt = 0.0;

  /// Takes in a triangle.
  void Include(Triangle const& triangle) {
    for (Point const& p : triangle.pts) {
      double const absX = std::fabs(p.x);
      double const absY = std::fabs(p.y);
      x = absX > x ? absX : x;
      y = absY > y ? absY : y;
      doubt += 0.0 * (p.x + p.y);
    }
  }

  /// Takes in the triangles of a cell.
  void Include(std::span<Triangle const> triangles) {
    for (Triangle const& triangle : triangles) Include(triangle);
  }
};

/// One rounding, relative: half the distance of two neighbouring doubles at 1.
inline constexpr double kRounding = 0x1p-53;

// With coordinates up to X and Y, every formula below is a sum of products whose true size is a
// small multiple of X Y. The errors, in units of kRounding X Y, step by step:
//
// An offset (p.x - x) * dy - (p.y - y) * dx with dx and dy differences of coordinates. The scaled
// parameters and the determinant of two sides have the same form.
//   a product: at most 4 in size, three roundings (both differences, itself)    4 * 3 = 12
//   the other product                                                                   12
//   their difference: at most 8 in size, one rounding                                    8

/// The roundings of an offset, a scaled parameter or a determinant.
inline constexpr double kOffsetRoundings = 12.0 + 12.0 + 8.0;

// Twice the area of a triangle, a sum of three terms end.x * start.y - start.x * end.y. Halving it
// is exact.
//   a term: two products of size 1, their difference of at most 2        3 * (1 + 1 + 2) = 12
//   the sum of two terms, at most 4                                                       4
//   the sum of three, at most 6                                                           6

/// The roundings of twice an area.
inline constexpr double kAreaRoundings = 12.0 + 4.0 + 6.0;

/// The bound E of the error of each of these formulas, for coordinates of size 1. Twice what the
/// roundings add up to: the other half is for products of roundings (some 2^-100), for products
/// that underflow, and for coordinates of crossing points, which rounding may put beyond X or Y by
/// some 2^-50 of them.
inline constexpr double kErrorBound = 0x1p-47;

static_assert(kOffsetRoundings * kRounding <= kErrorBound / 2.0);
static_assert(kAreaRoundings * kRounding <= kErrorBound / 2.0);

/// Bounds E must lie above this, or products of coordinates may be subnormal, whose roundings are
/// absolute: some 2^-1074 each, nothing beside this.
inline constexpr double kLeastError = 1e-250;

/// Above this, products of three coordinates, as in a crossing point, may overflow.
inline constexpr double kLargestCoordinate = 1e100;

/// The bound of the errors where a triangle is overlapped with others, or infinity where rounding
/// is not the only thing to fear.
inline double ErrorBound(Triangle const& triangle, Magnitude const& ofOthers) {
  Magnitude whole = ofOthers;
  whole.Include(triangle);
  double const error = kErrorBound * whole.x * whole.y + whole.doubt;
  bool const isUsable =
      error > kLeastError && whole.x < kLargestCoordinate && whole.y < kLargestCoordinate;
  return isUsable ? error : std::numeric_limits<double>::infinity();
}

/// How many errors an offset must exceed to be clear. Its sign is then the true one, with every
/// formula for it.
inline constexpr double kClearance = 1024.0;

/// How many errors two offsets must differ by to differ in truth. Their difference is the
/// determinant of the side between the two points and the line. Each offset is off by E / 2 and the
/// subtraction by a rounding of at most 16 X Y, which is E / 4: the true determinant is above
/// (4 - 1 - 1/4) E, and the computed one above 2 E. So the two do not count as parallel.
inline constexpr double kSkewness = 4.0;

}  // namespace Vorn::Cells
