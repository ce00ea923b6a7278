// Sides that count as parallel: for them an overlap follows other rules than the signs of offsets.

#pragma once

#include <algorithm>

#include "geometry/triangles/PreparedTriangle.h"
#include "math/NumericConstants.h"

namespace Vorn::Cells {

/// Whether the boxes of two sides have no point in common.
inline bool AreBoxesApart(Triangles::PreparedTriangle::Side const& side,
                          Triangles::Segment const& other) {
  auto const& [start, end] = other;
  return std::max(start.x, end.x) < side.xLow || side.xHigh < std::min(start.x, end.x) ||
         std::max(start.y, end.y) < side.yLow || side.yHigh < std::min(start.y, end.y);
}

/// Whether two sides count as parallel and are not apart by their boxes. A side of no length is
/// along nothing: it is a point, and clearly on no line.
inline bool IsAlong(Triangles::PreparedTriangle::Side const& side,
                    Triangles::Segment const& other) {
  double const dx = other.end.x - other.start.x;
  double const dy = other.end.y - other.start.y;
  bool const isPoint = dx == 0.0 && dy == 0.0;
  return !isPoint && Numeric::IsZeroMagnitude(side.dy * dx - dy * side.dx) &&
         !AreBoxesApart(side, other);
}

}  // namespace Vorn::Cells
