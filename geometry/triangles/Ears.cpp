#include "geometry/triangles/Ears.h"

namespace Vorn::Triangles {

bool IsInsideRing(Point const& p, Point const* ring, int begin, int end) {
  VORN_ASSERT(begin < end);
  bool inside = false;
  Point prev = ring[end - 1];
  for (int j = begin; j < end; ++j) {
    Point const& cur = ring[j];
    bool const isCurAbove = cur.y >= p.y;
    bool const isPrevAbove = prev.y >= p.y;
    if (isCurAbove != isPrevAbove &&
        ((cur.y - p.y) * (prev.x - cur.x) >= (prev.y - cur.y) * (cur.x - p.x)) == isCurAbove) {
      inside = !inside;
    }
    prev = cur;
  }
  return inside;
}

bool IsFreeOfOthers(Point const* ring, int count, RingRun const& run) {
  auto const& [start, size] = run;
  VORN_ASSERT(0 <= start && start < count);
  if (size == count) return true;
  // Deliberate: start and size bound the tested polygon as begin and end.
  auto const containsAny = [ring, begin = start, end = size](int from, int to) {
    for (int j = from; j < to; ++j) {
      if (begin < end && IsInsideRing(ring[j], ring, begin, end)) return true;
    }
    return false;
  };
  if (start + size < count) {
    return !containsAny(start + size, count) && !containsAny(0, start);
  }
  // Deliberate: a run that wraps passes over the vertex right behind it.
  return !containsAny(size + 1 + start - count, start);
}

}  // namespace Vorn::Triangles
