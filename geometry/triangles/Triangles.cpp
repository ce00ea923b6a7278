// Single triangles: signed area, an interior centre, and where a point lies.
//
// There is no tolerance anywhere: only an area of exactly 0.0 makes a triangle degenerate or puts a
// point on a side. Cells are cut again and again, and a tolerance would let the parts of a cell
// drift away from each other.

#include <algorithm>
#include <cmath>
#include <limits>

#include "geometry/intersections/SegmentPair.h"
#include "geometry/triangles/TriangleCentre.h"
#include "geometry/triangles/TriangleOverlap.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Point = GeometryUtils::Point;
using PointStatus = GeometryUtils::PointStatus;
using Triangle = GeometryUtils::Triangle;

Point Middle(Point const& p, Point const& q) { return {(p.x + q.x) / 2.0, (p.y + q.y) / 2.0}; }

double SideTerm(Point const& start, Point const& end) { return end.x * start.y - start.x * end.y; }

/// Twice halved only at the end: an area that the halving turns into zero counts as zero.
double AreaOfTerms(double term0, double term1, double term2) {
  return 0.5 * (term0 + term1 + term2);
}

/// The interval that three values span; without bounds when one of them is not a number, so that
/// nothing is ever found to lie beyond it.
void Span(double v0, double v1, double v2, double* low, double* high) {
  *low = std::min({v0, v1, v2});
  *high = std::max({v0, v1, v2});
  if (std::isnan(v0) || std::isnan(v1) || std::isnan(v2)) {
    *low = -std::numeric_limits<double>::infinity();
    *high = std::numeric_limits<double>::infinity();
  }
}

double SignedArea(Triangle const& triangle) {
  Point const* const pts = triangle.pts;
  return AreaOfTerms(SideTerm(pts[0], pts[1]), SideTerm(pts[1], pts[2]), SideTerm(pts[2], pts[0]));
}

double SquaredDistance(Point const& p, Point const& q) {
  double const dx = p.x - q.x;
  double const dy = p.y - q.y;
  return dy * dy + dx * dx;
}

/// The crossing of the medians of the two longer sides, which meet at the widest angle; where they
/// do not meet, the middle between the middles of those sides.
Point InnerPoint(Triangle const& triangle) {
  Point const* const pts = triangle.pts;
  double const length2[3] = {SquaredDistance(pts[1], pts[0]), SquaredDistance(pts[2], pts[1]),
                             SquaredDistance(pts[0], pts[2])};
  int shortest = 0;
  if (length2[1] < length2[shortest]) shortest = 1;
  if (length2[2] < length2[shortest]) shortest = 2;
  int const a = shortest == 0 ? 1 : 0;
  int const b = shortest == 2 ? 1 : 2;
  Point const middleA = Middle(pts[a], pts[(a + 1) % 3]);
  Point const middleB = Middle(pts[b], pts[(b + 1) % 3]);
  if (length2[shortest] > Numeric::kZero) {
    Point const& oppositeA = pts[(a + 2) % 3];
    Point const& oppositeB = pts[(b + 2) % 3];
    Point crossing;
    SegmentsRelPosition const medians =
        Intersections::IntersectSegments({{middleA, oppositeA}, {middleB, oppositeB}}, &crossing);
    if (medians == SegmentsRelPosition::Collinear || medians == SegmentsRelPosition::Intersecting) {
      return crossing;
    }
  }
  return Middle(middleA, middleB);
}

}  // namespace

Cells::Shape::Shape(Triangle const& from) : triangle(from) {
  for (int i = 0; i < 3; ++i) {
    Point const& start = from.pts[i];
    Point const& end = from.pts[(i + 1) % 3];
    sides[i] = {end.x - start.x,          end.y - start.y,          SideTerm(start, end),
                std::min(start.x, end.x), std::min(start.y, end.y), std::max(start.x, end.x),
                std::max(start.y, end.y)};
  }
  sense = Numeric::Sign(AreaOfTerms(sides[0].term, sides[1].term, sides[2].term));
  Span(from.pts[0].x, from.pts[1].x, from.pts[2].x, &xMin, &xMax);
  Span(from.pts[0].y, from.pts[1].y, from.pts[2].y, &yMin, &yMax);
  double const sum =
      from.pts[0].x + from.pts[1].x + from.pts[2].x + from.pts[0].y + from.pts[1].y + from.pts[2].y;
  isOrdered = !std::isnan(sum);
}

Cells::BoxedTriangle::BoxedTriangle(Triangle const& from) : triangle(from) {
  Span(from.pts[0].x, from.pts[1].x, from.pts[2].x, &xMin, &xMax);
  Span(from.pts[0].y, from.pts[1].y, from.pts[2].y, &yMin, &yMax);
}

PointStatus Cells::Shape::StatusOf(Point const& p) const {
  if (xMin > p.x || p.x > xMax || yMin > p.y || p.y > yMax) return PointStatus::Outside;
  double fromVertex[3];
  for (int i = 0; i < 3; ++i) fromVertex[i] = SideTerm(p, triangle.pts[i]);
  // The term of the way back to p is that of the way from p, negated, down to the last bit.
  double const areas[3] = {AreaOfTerms(fromVertex[0], sides[0].term, -fromVertex[1]),
                           AreaOfTerms(fromVertex[1], sides[1].term, -fromVertex[2]),
                           AreaOfTerms(fromVertex[2], sides[2].term, -fromVertex[0])};
  bool const isNearSide = (areas[0] == 0.0) | (areas[1] == 0.0) | (areas[2] == 0.0);
  if (isNearSide || sense == 0) return StatusNearSides(p, areas);
  bool const isNegative = sense < 0;
  bool const isInside = ((areas[0] < 0.0) == isNegative) & ((areas[1] < 0.0) == isNegative) &
                        ((areas[2] < 0.0) == isNegative);
  return isInside ? PointStatus::Inside : PointStatus::Outside;
}

/// The status of a point on the line of a side, or in a degenerate triangle.
PointStatus Cells::Shape::StatusNearSides(Point const& p, double const* areas) const {
  int hits = 0;
  bool isOutside = false;
  for (int i = 0; i < 3; ++i) {
    Point const& start = triangle.pts[i];
    Point const& end = triangle.pts[(i + 1) % 3];
    int const side = Numeric::Sign(areas[i]);
    if (side == 0 && Intersections::IsWithin(p.x, start.x, end.x) &&
        Intersections::IsWithin(p.y, start.y, end.y)) {
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

Cells::TriangleCentre::TriangleCentre(Triangle const& triangle)
    : area(std::fabs(SignedArea(triangle))), center(InnerPoint(triangle)) {}

double GeometryUtils::GetArea(Triangle const& triangle) { return SignedArea(triangle); }

bool GeometryUtils::IsValidTriangle(Triangle const& triangle) {
  return Numeric::Sign(GetArea(triangle)) != 0;
}

bool GeometryUtils::CalcCenter(Triangle const& triangle, Point* center) {
  *center = Cells::TriangleCentre(triangle).center;
  return true;
}

PointStatus GeometryUtils::GetPointStatus(Point const& p, Triangle const& triangle) {
  return Cells::Shape(triangle).StatusOf(p);
}

}  // namespace Vorn
