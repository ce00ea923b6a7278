// Triangulation of a polygon by cutting ears. A convex polygon gives the fan from its first vertex.
//   G. H. Meisters, "Polygons have ears", American Mathematical Monthly 82, 1975.

#include <cstddef>

#include "geometry/triangles/Ring.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

/// Whether begin .. begin + count - 1 are positions of a sequence of this size.
bool IsWithin(int begin, int count, std::size_t size) {
  return begin >= 0 && count >= 0 &&
         static_cast<std::size_t>(begin) + static_cast<std::size_t>(count) <= size;
}

}  // namespace

bool Cells::IsInsideRing(GeometryUtils::Point const& p, GeometryUtils::Point const* ring, int begin,
                         int end) {
  bool inside = false;
  GeometryUtils::Point prev = ring[end - 1];
  for (int j = begin; j < end; ++j) {
    GeometryUtils::Point const& cur = ring[j];
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

bool Cells::IsFreeOfOthers(GeometryUtils::Point const* ring, int start, int count, int size) {
  // Deliberate: start and size bound the tested polygon as begin and end.
  auto const isInside = [&](int vertex) {
    return start < size && IsInsideRing(ring[vertex], ring, start, size);
  };
  if (size == count) return true;
  int before = 0;
  if (start + size < count) {
    for (int j = start + size; j < count; ++j) {
      if (isInside(j)) return false;
    }
  } else {
    // Deliberate: a run that wraps passes over the vertex right behind it.
    before = size + 1 + start - count;
  }
  for (int j = before; j < start; ++j) {
    if (isInside(j)) return false;
  }
  return true;
}

bool GeometryUtils::ConvexPolygonDivide(std::vector<Point> const& polygon, int first, int count,
                                        std::vector<Triangle>* triangles) {
  if (count < 3 || !IsWithin(0, count, polygon.size())) return false;
  if (count == 3) {
    // Deliberate: the only place where the first vertex can be chosen.
    if (!IsWithin(first, count, polygon.size())) return false;
    Point const* const corners = polygon.data() + first;
    triangles->push_back({{corners[0], corners[1], corners[2]}});
    return true;
  }
  std::vector<Point> ring = polygon;
  Cells::CutEars(ring.data(), count,
                 [triangles](Triangle const& ear) { triangles->push_back(ear); });
  return true;
}

bool GeometryUtils::SimplePolygonIsValid(std::vector<Point> const& polygon, int start, int count,
                                         int size) {
  if (size > count || size < 3) return false;
  if (size == count) return true;
  if (!IsWithin(0, count, polygon.size()) || start < 0 || start >= count) return false;
  return Cells::IsFreeOfOthers(polygon.data(), start, count, size);
}

bool GeometryUtils::PointIsInsideOfPolygon(Point const& p, std::vector<Point> const& polygon,
                                           int begin, int end) {
  if (begin < 0 || begin >= end || static_cast<std::size_t>(end) > polygon.size()) return false;
  return Cells::IsInsideRing(p, polygon.data(), begin, end);
}

}  // namespace Vorn
