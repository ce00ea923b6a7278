// The steps of an overlap once it is known where the vertices lie and where the sides cross.
//
// The boundary of the overlap is walked side by side of the first triangle: at every crossing point
// the walk changes over to the other triangle and takes up that triangle's vertices for as long as
// they lie in the first. The order of the points, repeated ones included, decides the fan of
// triangles that comes out, and with it the weights of a cell's centre.

#pragma once

#include <array>

#include "geometry/triangles/CrossingPoints.h"
#include "geometry/triangles/Overlap.h"

namespace Vorn::Triangles {

/// Where each vertex of the two triangles lies with respect to the other triangle.
using VertexStatuses = std::array<std::array<PointStatus, 3>, 2>;

/// Whether one of the vertices has no defined status.
inline bool HasUndefined(VertexStatuses const& statuses) {
  for (auto const& ofTriangle : statuses) {
    for (PointStatus const status : ofTriangle) {
      if (status == PointStatus::Undefined) return true;
    }
  }
  return false;
}

/// The corners of an overlap: at most four points on each of three sides.
using OverlapPolygon = InlineVector<Point, kMostParts + 2>;

/// Appends the triangles of a polygon of three or more corners, which are overwritten.
void Divide(OverlapPolygon* polygon, Overlap* overlap);

/// The overlap of two triangles, of which `crossings` tells where their sides cross; none of the
/// statuses may be undefined. Appends to an overlap without parts.
void FindCommonPart(Triangle const& first, Triangle const& second, VertexStatuses const& statuses,
                    CrossingPoints const& crossings, Overlap* overlap);

}  // namespace Vorn::Triangles
