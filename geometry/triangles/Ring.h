#pragma once

#include "math/Assert.h"
#include "vorn/GeometryUtils.h"

/// Polygons as plain arrays of vertices, for callers that know they fit.
namespace Vorn::Cells {

/// Even-odd test of p against the closed polygon ring[begin] .. ring[end - 1]. The range must
/// exist.
bool IsInsideRing(GeometryUtils::Point const& p, GeometryUtils::Point const* ring, int begin,
                  int end);

/// Whether the `size` consecutive vertices from `start` of a ring of `count` contain none of the
/// others. The ring must hold `count` vertices and `start` must be one of them.
bool IsFreeOfOthers(GeometryUtils::Point const* ring, int start, int count, int size);

/// Cuts a ring of three or more vertices into count - 2 triangles, handed to `emit` one by one. The
/// vertices of the ring are overwritten. An ear is always found by position 2 at the latest: what
/// is tested there is a single vertex, which contains nothing; of four vertices, position 1 is
/// taken since the only other vertex is the one that a wrapped run passes over. O(count^2) for a
/// convex ring.
template <typename Emit>
void CutEars(GeometryUtils::Point* ring, int count, Emit const& emit) {
  for (int live = count; live >= 3; --live) {
    int i = 0;
    while (!IsFreeOfOthers(ring, i, live, 3)) {
      ++i;
      VORN_ASSERT(i + 3 <= live);
    }
    emit(GeometryUtils::Triangle{{ring[i], ring[i + 1], ring[i + 2]}});
    for (int j = i + 1; j + 1 < live; ++j) ring[j] = ring[j + 1];
  }
}

}  // namespace Vorn::Cells
