#include "geometry/cells/fast/SightedOverlap.h"

#include <bit>
#include <cstddef>

#include "geometry/intersections/SegmentPair.h"
#include "geometry/triangles/BoundaryWalk.h"

namespace Vorn::Cells {

namespace {

using Triangles::CrossingPoints;
using Triangles::kNext;
using Triangles::Overlap;
using Triangles::OverlappingStatus;
using Triangles::PointStatus;
using Triangles::PreparedTriangle;
using Triangles::VertexStatuses;

/// The most frequent case by far: one cut, where the walk is always the same. False, and nothing
/// done, where a side ends before the other, by rounding.
bool FindOneCut(Triangle const& first, Triangle const& second, Sight const& sight,
                Overlap* overlap) {
  int const bit0 = std::countr_zero(sight.mayCross);
  int const bit1 = std::countr_zero(sight.mayCross & (sight.mayCross - 1));
  int const side0 = bit0 / 3;
  int const side1 = bit1 / 3;
  Triangles::Segment const cut = Triangles::SideOf(second, bit0 % 3);
  auto const cross = [&](int side, Point* p) {
    return Intersections::IntersectSegments({Triangles::SideOf(first, side), cut}, p) ==
           SegmentsRelPosition::Intersecting;
  };
  Point enter;
  Point leave;
  if (!cross(side0, &enter) || !cross(side1, &leave)) return false;

  // The walk crosses over at the first point. Where the first vertex is outside, it follows the
  // first triangle from there, and otherwise from the second point on.
  bool const isFirstInside = (sight.inside & 1U) != 0;
  int const next = kNext[isFirstInside ? side1 : side0];
  int const afterNext = kNext[next];
  bool const hasTwo = (sight.inside >> afterNext & 1U) != 0;
  Triangles::OverlapPolygon polygon;
  polygon.push_back(enter);
  if (isFirstInside) polygon.push_back(leave);
  polygon.push_back(first.pts[next]);
  if (hasTwo) polygon.push_back(first.pts[afterNext]);
  if (!isFirstInside) polygon.push_back(leave);
  Triangles::Divide(&polygon, overlap);
  return true;
}

/// Where the vertices lie, looked up where the sight does not tell.
VertexStatuses StatusesBy(Sight const& sight, Triangle const& first, Triangle const& second) {
  PreparedTriangle const prepared(first);
  VertexStatuses statuses;
  for (std::size_t v = 0; v < 3; ++v) {
    bool const isInside = (sight.inside >> v & 1U) != 0;
    statuses[0][v] = isInside ? PointStatus::Inside : PointStatus::Outside;
    bool const isOutside = (sight.outside >> v & 1U) != 0;
    statuses[1][v] = isOutside ? PointStatus::Outside : prepared.StatusOf(second.pts[v]);
  }
  return statuses;
}

}  // namespace

void FindSightedOverlap(BoxedTriangle const& first, PreparedTriangle const& second,
                        Sight const& sight, Overlap* overlap) {
  overlap->Reset(OverlappingStatus::NoOverlap);
  if (sight.IsOneCut() && FindOneCut(first.triangle, second.triangle, sight, overlap)) return;
  CrossingPoints crossings;
  Triangles::FindCrossingPoints(first.triangle, second.triangle, sight.mayCross, &crossings);
  if (crossings.empty() && sight.inside == 0 && sight.IsSecondOutside()) return;

  VertexStatuses const statuses = StatusesBy(sight, first.triangle, second.triangle);
  if (Triangles::HasUndefined(statuses)) {
    overlap->status = OverlappingStatus::OverlapFailed;
    return;
  }
  Triangles::FindCommonPart(first.triangle, second.triangle, statuses, crossings, overlap);
}

}  // namespace Vorn::Cells
