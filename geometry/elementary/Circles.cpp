// Circles through three points and the turning sense of three points.
//
// The centre is equally far from all three points; subtracting the circle's equation of one point
// from that of another leaves a linear equation, so two pairs give a 2 x 2 system. The right-hand
// sides are products of sums and differences, (x1 + x2)(x1 - x2), not differences of squares: less
// cancellation far from the origin.

#include <algorithm>
#include <cmath>

#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"
#include "vorn/MathUtils.h"

namespace Vorn {

namespace {

using Point = GeometryUtils::Point;

/// Rounds of moving the points by their tolerances along the radii of the last circle.
constexpr int kShiftRounds = 3;

double LargestDifference(double a, double b, double c) {
  return std::max({std::fabs(a - b), std::fabs(a - c), std::fabs(b - c)});
}

}  // namespace

ErrorCode GeometryUtils::GetCircle(double x1, double y1, double x2, double y2, double x3, double y3,
                                   double* cx, double* cy, double* r) {
  double matrix[4] = {2.0 * (x1 - x2), 2.0 * (y1 - y2),  //
                      2.0 * (x2 - x3), 2.0 * (y2 - y3)};
  double rhs[2] = {(x1 + x2) * (x1 - x2) + (y1 + y2) * (y1 - y2),
                   (x2 + x3) * (x2 - x3) + (y2 + y3) * (y2 - y3)};
  double solution[2];
  if (!MathUtils::LinearEquationSystemSolve(2, matrix, rhs, solution)) return ErrorCode::Failed;
  *cx = solution[0];
  *cy = solution[1];
  *r = std::sqrt(GetDist2({x1, y1}, {solution[0], solution[1]}));
  return ErrorCode::Ok;
}

bool GeometryUtils::GetCircle(Point const& a, Point const& b, Point const& c, Point* center,
                              double* radius) {
  double matrix[4] = {2.0 * (a.x - b.x), 2.0 * (a.y - b.y),  //
                      2.0 * (a.x - c.x), 2.0 * (a.y - c.y)};
  double rhs[2] = {(b.x + a.x) * (a.x - b.x) + (b.y + a.y) * (a.y - b.y),
                   (c.x + a.x) * (a.x - c.x) + (c.y + a.y) * (a.y - c.y)};
  double solution[2];
  if (!MathUtils::LinearEquationSystemSolve(2, matrix, rhs, solution)) return false;
  Point const found{solution[0], solution[1]};
  *radius = (std::sqrt(GetDist2(a, found)) + std::sqrt(GetDist2(b, found)) +
             std::sqrt(GetDist2(c, found))) /
            3.0;
  *center = found;
  return true;
}

ErrorCode GeometryUtils::IsCcw(Point const& a, Point const& b, Point const& c, bool* ccw) {
  double const area = GetArea(Triangle{{a, b, c}});
  if (area == 0.0) return ErrorCode::Failed;
  *ccw = area < 0.0;
  return ErrorCode::Ok;
}

bool GeometryUtils::GetCircle(WPoint const& a, WPoint const& b, WPoint const& c, WPoint* circle,
                              Point* pa, Point* pb, Point* pc, bool* ccw) {
  Point const measured[3] = {{a.x, a.y}, {b.x, b.y}, {c.x, c.y}};
  double tolerances[3] = {a.w, b.w, c.w};
  Point center;
  double radius = 0.0;
  if (Numeric::IsZero(LargestDifference(a.w, b.w, c.w))) {
    if (!GetCircle(measured[0], measured[1], measured[2], &center, &radius)) return false;
    *circle = {center.x, center.y, radius + a.w};
    // Deliberate: the sense is that of the caller's own three points, which stay as they are.
    return IsCcw(*pa, *pb, *pc, ccw) == ErrorCode::Ok;
  }

  // The point of the circle of radius |tolerance| around p that lies on the line from the centre
  // through p: beyond p for a tolerance >= 0, before it for a negative one.
  auto const shiftAlongRadius = [](Point const& from, Point const& p, double tolerance,
                                   Point* shifted) {
    double la = 0.0;
    double lb = 0.0;
    double lc = 0.0;
    if (!GetLineParameters(from.x, from.y, p.x, p.y, &la, &lb, &lc)) return false;
    Point first;
    Point second;
    if (GetLineAndCircleIntersection(la, lb, lc, p.x, p.y, std::fabs(tolerance), &first.x, &first.y,
                                     &second.x, &second.y) != 2) {
      return false;
    }
    double const first2 = GetDist2(first, from);
    double const second2 = GetDist2(second, from);
    bool const takeFirst = tolerance >= 0.0 ? !(second2 > first2) : first2 < second2;
    *shifted = takeFirst ? first : second;
    return true;
  };

  bool sense = false;
  if (!GetCircle(measured[0], measured[1], measured[2], &center, &radius)) return false;
  if (IsCcw(measured[0], measured[1], measured[2], &sense) != ErrorCode::Ok) return false;

  Point working[3] = {measured[0], measured[1], measured[2]};
  for (int round = 0; round < kShiftRounds; ++round) {
    if (!GetCircle(working[0], working[1], working[2], &center, &radius)) return false;
    for (int i = 0; i < 3; ++i) {
      if (!shiftAlongRadius(center, measured[i], tolerances[i], &working[i])) return false;
    }
    bool newSense = false;
    if (!GetCircle(working[0], working[1], working[2], &center, &radius)) return false;
    if (IsCcw(working[0], working[1], working[2], &newSense) != ErrorCode::Ok) return false;
    if (newSense != sense) {
      // The shift turned the triangle over: from now on outward is the other way.
      for (double& tolerance : tolerances) tolerance = -tolerance;
      sense = newSense;
    }
  }
  *circle = {center.x, center.y, radius};
  *pa = working[0];
  *pb = working[1];
  *pc = working[2];
  return IsCcw(*pa, *pb, *pc, ccw) == ErrorCode::Ok;
}

}  // namespace Vorn
