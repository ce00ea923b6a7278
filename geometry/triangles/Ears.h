// Triangulation of a polygon by cutting ears. A convex polygon gives the fan from its first vertex.
//   G. H. Meisters, "Polygons have ears", American Mathematical Monthly 82, 1975.
//
// Polygons are plain arrays of vertices here, for callers that know they fit.

#pragma once

#include "geometry/triangles/Triangle.h"
#include "math/Assert.h"

namespace Vorn::Triangles {

/// Even-odd test of p against the closed polygon ring[begin] .. ring[end - 1]. The range must
/// exist and hold a vertex. O(end - begin).
bool IsInsideRing(Point const& p, Point const* ring, int begin, int end);

/// Consecutive vertices of a ring.
struct RingRun {
  /// The first vertex of the run, one of the ring's.
  int start;
  /// The number of vertices of the run.
  int size;
};

/// Whether a run of a ring of `count` vertices contains none of the others. O(count * size).
bool IsFreeOfOthers(Point const* ring, int count, RingRun const& run);

/// Cuts a ring of three or more vertices into count - 2 triangles, handed to `emit` one by one. The
/// vertices of the ring are overwritten. An ear is always found by position 2 at the latest: what
/// is tested there is a single vertex, which contains nothing; of four vertices, position 1 is
/// taken since the only other vertex is the one that a wrapped run passes over. O(count^2) for a
/// convex ring.
template <typename Emit>
void CutEars(Point* ring, int count, Emit const& emit) {
  VORN_ASSERT(count >= 3);
  for (int live = count; live >= 3; --live) {
    int i = 0;
    while (!IsFreeOfOthers(ring, live, {i, 3})) {
      ++i;
      VORN_ASSERT(i + 3 <= live);
    }
    emit(Triangle{{ring[i], ring[i + 1], ring[i + 2]}});
    for (int j = i + 1; j + 1 < live; ++j) ring[j] = ring[j + 1];
  }
}

}  // namespace Vorn::Triangles
