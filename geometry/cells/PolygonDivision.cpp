// Triangulation of a polygon by cutting ears. A convex polygon gives the fan from its first vertex.
//   G. H. Meisters, "Polygons have ears", American Mathematical Monthly 82, 1975.

#include <cstddef>

#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

/// Whether begin .. begin + count - 1 are positions of a sequence of this size.
bool IsWithin(int begin, int count, std::size_t size) {
  return begin >= 0 && count >= 0 &&
         static_cast<std::size_t>(begin) + static_cast<std::size_t>(count) <= size;
}

}  // namespace

bool GeometryUtils::ConvexPolygonDivide(std::vector<Point> const& polygon, int first, int count,
                                        std::vector<Triangle>* triangles) {
  if (count < 3 || !IsWithin(0, count, polygon.size())) return false;
  std::vector<Point> ring = polygon;
  if (count == 3) {
    // Deliberate: the only place where the first vertex can be chosen.
    if (!IsWithin(first, count, polygon.size())) return false;
    auto const begin = static_cast<std::size_t>(first);
    triangles->push_back({{ring[begin], ring[begin + 1], ring[begin + 2]}});
    return true;
  }
  int live = count;
  int i = 0;
  while (live >= 3) {
    if (!SimplePolygonIsValid(ring, i, live, 3)) {
      ++i;
      if (i >= live) return false;
      continue;
    }
    // An ear that starts at one of the last two vertices, which only a polygon that touches itself
    // brings about, goes on at the beginning of the ring: that is where its sides lead.
    auto const corner = static_cast<std::size_t>((i + 1) % live);
    triangles->push_back({{ring[static_cast<std::size_t>(i)], ring[corner],
                           ring[static_cast<std::size_t>((i + 2) % live)]}});
    --live;
    if (live < 3) return true;
    ring.erase(ring.begin() + static_cast<std::ptrdiff_t>(corner));
    i = 0;
  }
  return true;
}

bool GeometryUtils::SimplePolygonIsValid(std::vector<Point> const& polygon, int start, int count,
                                         int size) {
  if (size > count || size < 3) return false;
  if (size == count) return true;
  if (!IsWithin(0, count, polygon.size()) || start < 0 || start >= count) return false;
  auto const isInside = [&](int vertex) {
    // Deliberate: start and size bound the tested polygon as begin and end.
    return PointIsInsideOfPolygon(polygon[static_cast<std::size_t>(vertex)], polygon, start, size);
  };
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

bool GeometryUtils::PointIsInsideOfPolygon(Point const& p, std::vector<Point> const& polygon,
                                           int begin, int end) {
  if (begin >= end || !IsWithin(begin, end - begin, polygon.size())) return false;
  bool inside = false;
  Point prev = polygon[static_cast<std::size_t>(end - 1)];
  for (int j = begin; j < end; ++j) {
    Point const& cur = polygon[static_cast<std::size_t>(j)];
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

}  // namespace Vorn
