// One representative point of a cell, free or on a line across the cell.

#include <algorithm>
#include <cmath>

#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"
#include "vorn/MathUtils.h"

namespace Vorn {

bool GeometryUtils::GetBoundingRect(std::vector<Triangle> const* cell, double* rect) {
  if (cell->empty()) return false;
  Point const& first = cell->front().pts[0];
  rect[0] = rect[2] = first.x;
  rect[1] = rect[3] = first.y;
  for (Triangle const& triangle : *cell) {
    for (Point const& p : triangle.pts) {
      if (p.x < rect[0]) rect[0] = p.x;
      if (p.y < rect[1]) rect[1] = p.y;
      if (p.x > rect[2]) rect[2] = p.x;
      if (p.y > rect[3]) rect[3] = p.y;
    }
  }
  return true;
}

bool GeometryUtils::GetBoundingCircleAndLineIntersectionTriangle(std::vector<Triangle> const* cell,
                                                                 double a, double b, double c,
                                                                 Triangle* chord) {
  double rect[4];
  if (!GetBoundingRect(cell, rect)) return false;
  Point const middle{(rect[0] + rect[2]) * 0.5, (rect[1] + rect[3]) * 0.5};
  double const radius = std::sqrt(GetDist2({rect[0], rect[1]}, middle));
  Point p1;
  Point p2;
  int const count =
      GetLineAndCircleIntersection(a, b, c, middle.x, middle.y, radius, &p1.x, &p1.y, &p2.x, &p2.y);
  if (count != 1 && count != 2) return false;
  *chord = count == 1 ? Triangle{{p1, p1, p1}} : Triangle{{p1, p2, p2}};
  return true;
}

bool GeometryUtils::GetCenter(std::vector<Triangle> const* cell, Point* center) {
  if (cell->empty()) return false;
  double totalArea = 0.0;
  Point weighted;
  Point degenerateSum;
  int degenerateCount = 0;
  for (Triangle const& triangle : *cell) {
    double const area = std::fabs(GetArea(triangle));
    Point own;
    if (!CalcCenter(triangle, &own)) return false;
    if (Numeric::IsZero(area)) {
      degenerateSum.x += own.x;
      degenerateSum.y += own.y;
      ++degenerateCount;
    } else {
      totalArea += area;
      weighted.x += own.x * area;
      weighted.y += own.y * area;
    }
  }
  // Deliberate: degenerate triangles count only where there are no others, which leaves chords and
  // single points with a centre.
  if (totalArea >= Numeric::kZero) {
    *center = {weighted.x / totalArea, weighted.y / totalArea};
  } else if (degenerateCount > 0) {
    *center = {degenerateSum.x / degenerateCount, degenerateSum.y / degenerateCount};
  } else {
    *center = weighted;
  }
  return true;
}

bool GeometryUtils::GetCenterForCircle(Point const& p1, Point const& p2,
                                       std::vector<Triangle> const* cell, Point* center) {
  double a = 0.0;
  double b = 0.0;
  double c = 0.0;
  if (!GetLineParameters(p1.x, p1.y, p2.x, p2.y, &a, &b, &c)) return false;
  Point const middle{(p1.x + p2.x) * 0.5, (p1.y + p2.y) * 0.5};
  double bisectorA = 0.0;
  double bisectorB = 0.0;
  double bisectorC = 0.0;
  GetNormal(a, b, c, middle, &bisectorA, &bisectorB, &bisectorC);
  Triangle chord;
  if (!GetBoundingCircleAndLineIntersectionTriangle(cell, bisectorA, bisectorB, bisectorC,
                                                    &chord)) {
    return false;
  }
  std::vector<Triangle> overlap;
  if (GetOverlapping(chord, cell, &overlap) != OverlappingStatus::Overlap) return false;
  return GetCenter(&overlap, center);
}

bool GeometryUtils::GetCenterForLine(bool hasP1, Point const& p1, bool hasP2, Point const& p2,
                                     bool swapped, std::vector<Triangle> const* cell,
                                     Point* center) {
  if (!hasP1 && !hasP2) return GetCenter(cell, center);

  // The parameter (u, v) stands for v*x + y + u = 0, so the lines through one point form a line.
  auto const along = [swapped](Point const& p) { return swapped ? p.y : p.x; };
  auto const across = [swapped](Point const& p) { return swapped ? p.x : p.y; };
  Triangle candidate;
  if (hasP1 && hasP2) {
    double matrix[4] = {1.0, along(p1),  //
                        1.0, along(p2)};
    double rhs[2] = {-across(p1), -across(p2)};
    double solution[2];
    if (!MathUtils::LinearEquationSystemSolve(2, matrix, rhs, solution)) return false;
    Point const only{solution[0], solution[1]};
    candidate = {{only, only, only}};
  } else {
    Point const& p = hasP1 ? p1 : p2;
    if (!GetBoundingCircleAndLineIntersectionTriangle(cell, 1.0, along(p), across(p), &candidate)) {
      return false;
    }
  }
  // Deliberate: what was collected counts here, not the status.
  std::vector<Triangle> overlap;
  GetOverlapping(candidate, cell, &overlap);
  return !overlap.empty() && GetCenter(&overlap, center);
}

}  // namespace Vorn
