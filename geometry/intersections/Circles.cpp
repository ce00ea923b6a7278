// A segment, a line or a point against a full circle.
//
// Notation: D the direction of the segment, F its start seen from the centre, t the parameter along
// it; the points on the circle solve A t^2 + B t + C = 0.

#include <cmath>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/intersections/CirclePoints.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Intersections::CirclePoints;

Intersections::CirclePoints Intersections::CutCircle(double x1, double y1, double x2, double y2,
                                                     double cx, double cy, double r) {
  double const dx = x2 - x1;
  double const dy = y2 - y1;
  double const fx = x1 - cx;
  double const fy = y1 - cy;
  double const a = dx * dx + dy * dy;
  double const b = 2.0 * (dx * fx + dy * fy);
  double const c = fx * fx + fy * fy - r * r;
  double const disc = b * b - 4.0 * a * c;
  CirclePoints found;
  if (disc < 0.0) return found;

  auto const takeIfOnSegment = [&](double t) {
    // A zero-length segment makes t infinite or a NaN, which is outside.
    if (0.0 <= t && t <= 1.0) found.Add(x1 + t * dx, y1 + t * dy);
  };
  double const root = std::sqrt(disc);
  takeIfOnSegment((root - b) / (2.0 * a));
  if (disc > Numeric::kTangency) takeIfOnSegment((-b - root) / (2.0 * a));
  return found;
}

int Intersections::CirclePoints::Write(double* ax, double* ay, double* bx, double* by) const {
  if (count > 0) {
    *ax = pts[0].x;
    *ay = pts[0].y;
  }
  if (count > 1) {
    *bx = pts[1].x;
    *by = pts[1].y;
  }
  return count;
}

int GeometryUtils::GetLineSegmentAndCircleIntersection(double x1, double y1, double x2, double y2,
                                                       double cx, double cy, double r, double* ax,
                                                       double* ay, double* bx, double* by) {
  return Intersections::CutCircle(x1, y1, x2, y2, cx, cy, r).Write(ax, ay, bx, by);
}

CirclePoints Intersections::CutCircleByLine(double a, double b, double c, double cx, double cy,
                                            double r) {
  double distance = 0.0;
  if (!GeometryUtils::GetDeviation(a, b, c, cx, cy, &distance) || distance > r) return {};
  Lines::ImplicitLine const line{a, b, c};
  double footX = 0.0;
  double footY = 0.0;
  if (Lines::Cross(line, line.NormalThrough(cx, cy), &footX, &footY) !=
      SegmentsRelPosition::Intersecting) {
    return {};
  }
  // A stretch of the line that is sure to hold the chord, measured along the coordinate in which
  // the line changes faster; the other coordinate follows from the line itself.
  double const reach = 2.0 * r;
  if (std::fabs(a) > std::fabs(b)) {
    double const y1 = footY + reach;
    double const y2 = footY - reach;
    return CutCircle(-(b / a) * y1 - c / a, y1, -(b / a) * y2 - c / a, y2, cx, cy, r);
  }
  double const x1 = footX + reach;
  double const x2 = footX - reach;
  return CutCircle(x1, -(a / b) * x1 - c / b, x2, -(a / b) * x2 - c / b, cx, cy, r);
}

int GeometryUtils::GetLineAndCircleIntersection(double a, double b, double c, double cx, double cy,
                                                double r, double* ax, double* ay, double* bx,
                                                double* by) {
  return Intersections::CutCircleByLine(a, b, c, cx, cy, r).Write(ax, ay, bx, by);
}

bool GeometryUtils::GetNearestPointOnCircle(Point const& center, double radius, Point const& p,
                                            Point* nearest) {
  // Deliberate: the ray ends at twice the point's distance, so a point nearer to the centre than
  // half the radius has no projection.
  CirclePoints const found =
      Intersections::CutCircle(center.x, center.y, center.x + 2.0 * (p.x - center.x),
                               center.y + 2.0 * (p.y - center.y), center.x, center.y, radius);
  if (found.count != 1) return false;
  *nearest = found.pts[0];
  return true;
}

}  // namespace Vorn
