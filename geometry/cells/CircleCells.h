// Cells of admissible circle centres.
//
// Every measured point is moved along its radius by its tolerance, inward and outward. The extreme
// circles pass through an inner or outer point of each of the three measured points; their centres
// are the corners of the cell.

#pragma once

#include <cstddef>

#include "geometry/triangles/InlineVector.h"
#include "geometry/triangles/Triangle.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Cells {

using Elementary::Point;
using Triangles::Triangle;

/// Three measured points in the order in which an arc passes them.
struct ArcTriple {
  WPoint first;
  WPoint middle;
  WPoint last;
  /// Whether the circle passes exactly through the first point, whose tolerance is then ignored.
  bool firstFixed = false;
  /// Likewise for the last point.
  bool lastFixed = false;
  /// Wanted sign of the triangle area of each extreme triple: +1 clockwise, -1 counter-clockwise;
  /// others are skipped. 0 takes the sign of the first triple and asks it of all. Looked at only
  /// when neither end is fixed; otherwise as 0.
  int orientation = 0;

  /// Whether neither end is fixed.
  bool AreEndsFree() const { return !firstFixed && !lastFixed; }
};

/// The most corners a circle cell can have.
inline constexpr std::size_t kMostCircleCellCorners = 6;

/// The corners of a circle cell in cyclic order.
using CircleCellCorners = Triangles::InlineVector<Point, kMostCircleCellCorners>;

/// The triangles of a circle cell.
using CircleCell = Triangles::InlineVector<Triangle, kMostCircleCellCorners - 2>;

/// The corners of the circle cell of three measured points: three to six with both ends free, four
/// with one end fixed, three with both fixed, of which two are equal. Failed when the points are
/// collinear, the circumradius is tiny or an extreme circle does not exist; OrientationMismatch
/// when the triples do not all turn the same way or fewer than three turn the wanted way. Corners
/// are written for Ok only.
ErrorCode FindCorners(ArcTriple const& triple, CircleCellCorners* corners);

/// The triangles of the circle cell of three measured points. The code of FindCorners; the cell is
/// written for Ok only.
ErrorCode FindCircleCell(ArcTriple const& triple, CircleCell* cell);

}  // namespace Vorn::Cells
