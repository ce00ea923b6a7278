#pragma once

#include <cmath>
#include <cstdlib>
#include <vector>

#include "vorn/GeometryUtils.h"

/// Areas by clipping against half-planes in extended precision, as a check on overlaps that knows
/// nothing of vertex states and crossing points.
namespace Vorn::Testing {

struct LongPoint {
  long double x = 0.0L;
  long double y = 0.0L;
};

using LongPolygon = std::vector<LongPoint>;

inline long double Cross(LongPoint const& o, LongPoint const& p, LongPoint const& q) {
  return (p.x - o.x) * (q.y - o.y) - (p.y - o.y) * (q.x - o.x);
}

/// Shoelace area, positive for counter-clockwise vertices.
inline long double SignedArea(LongPolygon const& polygon) {
  long double sum = 0.0L;
  for (std::size_t i = 0; i < polygon.size(); ++i) {
    auto const& p = polygon[i];
    auto const& q = polygon[(i + 1) % polygon.size()];
    sum += p.x * q.y - q.x * p.y;
  }
  return sum / 2.0L;
}

inline LongPolygon ToLong(GeometryUtils::Triangle const& t) {
  LongPolygon polygon;
  for (auto const& p : t.pts) polygon.push_back({p.x, p.y});
  if (SignedArea(polygon) < 0.0L) std::swap(polygon[0], polygon[2]);
  return polygon;
}

/// The part of a convex polygon on the left of the line from u to v.
inline LongPolygon ClipLeft(LongPolygon const& polygon, LongPoint const& u, LongPoint const& v) {
  LongPolygon kept;
  for (std::size_t i = 0; i < polygon.size(); ++i) {
    auto const& p = polygon[i];
    auto const& q = polygon[(i + 1) % polygon.size()];
    long double const sp = Cross(u, v, p);
    long double const sq = Cross(u, v, q);
    if (sp >= 0.0L) kept.push_back(p);
    if ((sp > 0.0L && sq < 0.0L) || (sp < 0.0L && sq > 0.0L)) {
      long double const t = sp / (sp - sq);
      kept.push_back({p.x + (q.x - p.x) * t, p.y + (q.y - p.y) * t});
    }
  }
  return kept;
}

/// The common part of two triangles of any orientation, counter-clockwise.
inline LongPolygon ClipTriangles(GeometryUtils::Triangle const& first,
                                 GeometryUtils::Triangle const& second) {
  LongPolygon const window = ToLong(second);
  LongPolygon polygon = ToLong(first);
  for (std::size_t i = 0; i < 3; ++i) {
    polygon = ClipLeft(polygon, window[i], window[(i + 1) % 3]);
  }
  return polygon;
}

inline long double TotalArea(std::vector<GeometryUtils::Triangle> const& cell) {
  long double total = 0.0L;
  for (auto const& t : cell) total += std::fabs(SignedArea(ToLong(t)));
  return total;
}

}  // namespace Vorn::Testing
