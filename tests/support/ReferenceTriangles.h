#pragma once

#include "support/ReferencePrimitives.h"

/// The plain second implementation of the operations on one and two triangles.
namespace Vorn::Testing::Reference {

using PointStatus = GeometryUtils::PointStatus;
using CrossingPoint = GeometryUtils::CrossingPoint;

/// Positive for clockwise vertices.
inline double Area(Triangle const& t) {
  Point const& p0 = t.pts[0];
  Point const& p1 = t.pts[1];
  Point const& p2 = t.pts[2];
  double const term0 = p1.x * p0.y - p0.x * p1.y;
  double const term1 = p2.x * p1.y - p1.x * p2.y;
  double const term2 = p0.x * p2.y - p2.x * p0.y;
  return 0.5 * (term0 + term1 + term2);
}

inline Point Midpoint(Point const& p, Point const& q) {
  return {(p.x + q.x) / 2.0, (p.y + q.y) / 2.0};
}

inline Point Center(Triangle const& t) {
  double const length2[3] = {SquaredDistance(t.pts[1], t.pts[0]),
                             SquaredDistance(t.pts[2], t.pts[1]),
                             SquaredDistance(t.pts[0], t.pts[2])};
  int shortest = 0;
  if (length2[1] < length2[shortest]) shortest = 1;
  if (length2[2] < length2[shortest]) shortest = 2;
  int const a = shortest == 0 ? 1 : 0;
  int const b = shortest == 2 ? 1 : 2;
  Point const ma = Midpoint(t.pts[a], t.pts[(a + 1) % 3]);
  Point const mb = Midpoint(t.pts[b], t.pts[(b + 1) % 3]);
  if (length2[shortest] > kSmallestNormal) {
    Point crossing;
    auto const relation = MeetSegments(ma, t.pts[(a + 2) % 3], mb, t.pts[(b + 2) % 3], &crossing);
    if (relation == SegmentsRelPosition::Collinear ||
        relation == SegmentsRelPosition::Intersecting) {
      return crossing;
    }
  }
  return Midpoint(ma, mb);
}

inline PointStatus StatusOf(Point const& p, Triangle const& t) {
  Point const* v = t.pts;
  if (v[0].x > p.x && v[1].x > p.x && v[2].x > p.x) return PointStatus::Outside;
  if (p.x > v[0].x && p.x > v[1].x && p.x > v[2].x) return PointStatus::Outside;
  if (v[0].y > p.y && v[1].y > p.y && v[2].y > p.y) return PointStatus::Outside;
  if (p.y > v[0].y && p.y > v[1].y && p.y > v[2].y) return PointStatus::Outside;

  int const own = SignOf(Area(t));
  int hits = 0;
  int differing = 0;
  for (int i = 0; i < 3; ++i) {
    Point const& start = v[i];
    Point const& end = v[(i + 1) % 3];
    int sign = SignOf(Area({{p, start, end}}));
    if (sign == 0) {
      if (InBoxOf(p, start, end)) {
        ++hits;
        continue;
      }
      sign = -own;
    }
    if (sign != own) ++differing;
  }
  if (own == 0) return hits == 0 ? PointStatus::Outside : PointStatus::OnDegenerate;
  if (hits == 3) return PointStatus::Undefined;
  if (hits == 2) return PointStatus::OnVertex;
  if (hits == 1) return PointStatus::OnSide;
  return differing > 0 ? PointStatus::Outside : PointStatus::Inside;
}

/// Appends both, the one nearer to `from` first; `p` first when they are equally far.
inline void AppendNearerFirst(Point const& from, Point const& p, Point const& q,
                              std::vector<Point>* points) {
  bool const swap = SquaredDistance(p, from) > SquaredDistance(q, from);
  points->push_back(swap ? q : p);
  points->push_back(swap ? p : q);
}

inline std::vector<Point> PlainCrossings(Triangle const& first, int startSide,
                                         Triangle const& second) {
  std::vector<Point> points;
  for (int step = 0; step < 3; ++step) {
    int const i = (startSide + step) % 3;
    Point const& start = first.pts[i];
    Point const& end = first.pts[(i + 1) % 3];
    std::vector<Point> held;
    for (int j = 0; j < 3; ++j) {
      Point q;
      auto const relation = MeetSegments(start, end, second.pts[j], second.pts[(j + 1) % 3], &q);
      if (relation != SegmentsRelPosition::Intersecting) continue;
      held.push_back(q);
      if (held.size() == 2) {
        AppendNearerFirst(start, held[0], held[1], &points);
        held.clear();
      }
    }
    points.insert(points.end(), held.begin(), held.end());
  }
  return points;
}

/// The middle two of four points sorted along an axis, equal ones left in their order.
inline std::array<Point, 2> CommonStretch(std::array<Point, 4> ends, bool alongX) {
  auto const coordinate = [alongX](Point const& p) { return alongX ? p.x : p.y; };
  for (int pass = 0; pass < 3; ++pass) {
    for (int k = 0; k < 3; ++k) {
      if (coordinate(ends[k]) > coordinate(ends[k + 1])) std::swap(ends[k], ends[k + 1]);
    }
  }
  return {ends[1], ends[2]};
}

/// Of more than two records on one side only the pair farthest apart stays.
inline std::vector<CrossingPoint> ExtremePair(std::vector<CrossingPoint> const& records, int side,
                                              Point const& from) {
  std::size_t bestM = 0;
  std::size_t bestN = 1;
  for (std::size_t m = 0; m < records.size(); ++m) {
    for (std::size_t n = m + 1; n < records.size(); ++n) {
      if (SquaredDistance(records[m].pt, records[n].pt) >
          SquaredDistance(records[bestM].pt, records[bestN].pt)) {
        bestM = m;
        bestN = n;
      }
    }
  }
  CrossingPoint m = records[bestM];
  CrossingPoint n = records[bestN];
  m.side1 = side;
  n.side2 = side;
  if (SquaredDistance(m.pt, from) > SquaredDistance(n.pt, from)) return {n, m};
  return {m, n};
}

inline std::vector<CrossingPoint> CrossingsOfSide(Triangle const& first, int i,
                                                  Triangle const& second) {
  Point const start = first.pts[i];
  Point const end = first.pts[(i + 1) % 3];
  std::vector<CrossingPoint> found;
  std::vector<CrossingPoint> held;
  auto const append = [&](CrossingPoint const& p, CrossingPoint const& q) {
    bool const swap = SquaredDistance(p.pt, start) > SquaredDistance(q.pt, start);
    found.push_back(swap ? q : p);
    found.push_back(swap ? p : q);
  };
  for (int j = 0; j < 3; ++j) {
    Point const u = second.pts[j];
    Point const v = second.pts[(j + 1) % 3];
    Point q;
    auto const relation = MeetSegments(start, end, u, v, &q);
    if (relation == SegmentsRelPosition::Intersecting) {
      held.push_back({q, i, j});
      if (held.size() == 2) {
        append(held[0], held[1]);
        held.clear();
      }
    } else if (relation == SegmentsRelPosition::Collinear) {
      bool const alongX = std::fabs(end.x - start.x) > std::fabs(end.y - start.y);
      double const s = alongX ? start.x : start.y;
      double const e = alongX ? end.x : end.y;
      double const cu = alongX ? u.x : u.y;
      double const cv = alongX ? v.x : v.y;
      double const low = std::min(s, e);
      double const high = std::max(s, e);
      if ((low > cu && low > cv) || (cu > high && cv > high)) continue;
      auto const middle = CommonStretch({start, end, u, v}, alongX);
      append({middle[0], i, j}, {middle[1], i, j});
      held.clear();
    }
  }
  found.insert(found.end(), held.begin(), held.end());
  if (found.size() >= 3) return ExtremePair(found, i, start);
  return found;
}

inline std::vector<CrossingPoint> Crossings(Triangle const& first, Triangle const& second) {
  std::vector<CrossingPoint> all;
  for (int i = 0; i < 3; ++i) {
    auto const ofSide = CrossingsOfSide(first, i, second);
    all.insert(all.end(), ofSide.begin(), ofSide.end());
  }
  return all;
}

}  // namespace Vorn::Testing::Reference
