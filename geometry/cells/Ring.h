#pragma once

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

/// Cuts the ring, of which it makes a shambles, into triangles: at most count - 2 of them, handed
/// to `emit` one by one. False when no ear is left before the ring is used up; what was cut until
/// then has been emitted.
template <typename Emit>
bool CutEars(GeometryUtils::Point* ring, int count, Emit const& emit) {
  int live = count;
  int i = 0;
  while (live >= 3) {
    if (!IsFreeOfOthers(ring, i, live, 3)) {
      ++i;
      if (i >= live) return false;
      continue;
    }
    // An ear that starts at one of the last two vertices, which only a polygon that touches itself
    // brings about, goes on at the beginning of the ring: that is where its sides lead.
    int const corner = (i + 1) % live;
    emit(GeometryUtils::Triangle{{ring[i], ring[corner], ring[(i + 2) % live]}});
    --live;
    for (int j = corner; j < live; ++j) ring[j] = ring[j + 1];
    i = 0;
  }
  return true;
}

}  // namespace Vorn::Cells
