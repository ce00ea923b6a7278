#include "geometry/triangles/Overlap.h"

#include "geometry/triangles/BoundaryWalk.h"
#include "geometry/triangles/CrossingPoints.h"

namespace Vorn::Triangles {

void FindOverlap(PreparedTriangle const& first, PreparedTriangle const& second, Overlap* overlap) {
  overlap->Reset(OverlappingStatus::NoOverlap);
  // Apart by their boxes: every vertex is outside and no side crosses another.
  if (first.IsApartFrom(second)) return;

  VertexStatuses statuses;
  for (std::size_t v = 0; v < 3; ++v) {
    statuses[0][v] = second.StatusOf(first.triangle.pts[v]);
    statuses[1][v] = first.StatusOf(second.triangle.pts[v]);
  }
  if (HasUndefined(statuses)) {
    overlap->status = OverlappingStatus::OverlapFailed;
    return;
  }
  CrossingPoints crossings;
  FindCrossingPoints(first.triangle, second.triangle, PairsThatMayMeet(first, second), &crossings);
  FindCommonPart(first.triangle, second.triangle, statuses, crossings, overlap);
}

void AppendOverlaps(Triangle const& first, std::span<Triangle const> cell,
                    std::vector<Triangle>* result) {
  PreparedTriangle const prepared(first);
  Overlap overlap;
  for (Triangle const& triangle : cell) {
    FindOverlap(prepared, PreparedTriangle(triangle), &overlap);
    result->insert(result->end(), overlap.parts.begin(), overlap.parts.end());
  }
}

}  // namespace Vorn::Triangles
