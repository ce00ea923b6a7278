// Single triangles: signed area, an interior centre, and where a point lies.
//
// There is no tolerance anywhere: only an area of exactly 0.0 makes a triangle degenerate or puts a
// point on a side. Cells are cut again and again, and a tolerance would let the parts of a cell
// drift away from each other.

#include <algorithm>
#include <cmath>

#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

Point Middle(Point const& p, Point const& q) { return {(p.x + q.x) / 2.0, (p.y + q.y) / 2.0}; }

bool IsInBoxOf(Point const& p, Point const& end1, Point const& end2) {
  return std::min(end1.x, end2.x) <= p.x && p.x <= std::max(end1.x, end2.x) &&
         std::min(end1.y, end2.y) <= p.y && p.y <= std::max(end1.y, end2.y);
}

/// Whether one coordinate of a point lies beyond all three of a triangle.
bool IsBeyond(double v, double v0, double v1, double v2) {
  return (v0 > v && v1 > v && v2 > v) || (v > v0 && v > v1 && v > v2);
}

}  // namespace

double GeometryUtils::GetArea(Triangle const& triangle) {
  Point const& p0 = triangle.pts[0];
  Point const& p1 = triangle.pts[1];
  Point const& p2 = triangle.pts[2];
  return 0.5 *
         ((p1.x * p0.y - p0.x * p1.y) + (p2.x * p1.y - p1.x * p2.y) + (p0.x * p2.y - p2.x * p0.y));
}

bool GeometryUtils::IsValidTriangle(Triangle const& triangle) {
  return Numeric::Sign(GetArea(triangle)) != 0;
}

bool GeometryUtils::CalcCenter(Triangle const& triangle, Point* center) {
  Point const* const pts = triangle.pts;
  double const length2[3] = {GetDist2(pts[1], pts[0]), GetDist2(pts[2], pts[1]),
                             GetDist2(pts[0], pts[2])};
  int shortest = 0;
  if (length2[1] < length2[shortest]) shortest = 1;
  if (length2[2] < length2[shortest]) shortest = 2;

  // The medians of the two longer sides cross at the widest angle.
  int const a = shortest == 0 ? 1 : 0;
  int const b = shortest == 2 ? 1 : 2;
  Point const middleA = Middle(pts[a], pts[(a + 1) % 3]);
  Point const middleB = Middle(pts[b], pts[(b + 1) % 3]);
  if (length2[shortest] > Numeric::kZero) {
    Point const& oppositeA = pts[(a + 2) % 3];
    Point const& oppositeB = pts[(b + 2) % 3];
    SegmentsRelPosition const medians =
        GetLineSegmentsIntersection(middleA.x, middleA.y, oppositeA.x, oppositeA.y, middleB.x,
                                    middleB.y, oppositeB.x, oppositeB.y, &center->x, &center->y);
    if (medians == SegmentsRelPosition::Collinear || medians == SegmentsRelPosition::Intersecting) {
      return true;
    }
  }
  *center = Middle(middleA, middleB);
  return true;
}

GeometryUtils::PointStatus GeometryUtils::GetPointStatus(Point const& p, Triangle const& triangle) {
  Point const* const pts = triangle.pts;
  if (IsBeyond(p.x, pts[0].x, pts[1].x, pts[2].x) || IsBeyond(p.y, pts[0].y, pts[1].y, pts[2].y)) {
    return PointStatus::Outside;
  }
  int const sense = Numeric::Sign(GetArea(triangle));
  int hits = 0;
  bool isOutside = false;
  for (int i = 0; i < 3; ++i) {
    Point const& start = pts[i];
    Point const& end = pts[(i + 1) % 3];
    int const side = Numeric::Sign(GetArea(Triangle{{p, start, end}}));
    if (side == 0 && IsInBoxOf(p, start, end)) {
      ++hits;
    } else if (side == 0 || side != sense) {
      // On the line of a side but not on the side counts as beyond it.
      isOutside = true;
    }
  }
  if (sense == 0) return hits > 0 ? PointStatus::OnDegenerate : PointStatus::Outside;
  switch (hits) {
    case 0:
      return isOutside ? PointStatus::Outside : PointStatus::Inside;
    case 1:
      return PointStatus::OnSide;
    case 2:
      return PointStatus::OnVertex;
    default:
      return PointStatus::Undefined;
  }
}

}  // namespace Vorn
