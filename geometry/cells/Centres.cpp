// One representative point of a cell, free or on a line across the cell.

#include <algorithm>
#include <cmath>

#include "geometry/cells/FixedPoints.h"
#include "geometry/intersections/Circles.h"
#include "geometry/triangles/TriangleCentre.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"
#include "vorn/MathUtils.h"

namespace Vorn {

bool Cells::ChordAcross(double const* rect, double a, double b, double c,
                        GeometryUtils::Triangle* chord) {
  GeometryUtils::Point const middle{(rect[0] + rect[2]) * 0.5, (rect[1] + rect[3]) * 0.5};
  double const dx = rect[0] - middle.x;
  double const dy = rect[1] - middle.y;
  double const radius = std::sqrt(dy * dy + dx * dx);
  Intersections::CirclePoints const found =
      Intersections::CutCircleByLine({middle, radius}, {a, b, c});
  if (found.count == 0) return false;
  GeometryUtils::Point const& p1 = found.pts[0];
  GeometryUtils::Point const& p2 = found.pts[found.count - 1];
  *chord = {{p1, p2, p2}};
  return true;
}

bool Cells::FixedPoints::FindCandidate(double const* rect,
                                       GeometryUtils::Triangle* candidate) const {
  // The parameter (u, v) stands for v*x + y + u = 0, so the lines through one point form a line.
  auto const along = [this](GeometryUtils::Point const& p) { return swapped ? p.y : p.x; };
  auto const across = [this](GeometryUtils::Point const& p) { return swapped ? p.x : p.y; };
  if (!hasP1 || !hasP2) {
    GeometryUtils::Point const& p = hasP1 ? p1 : p2;
    return ChordAcross(rect, 1.0, along(p), across(p), candidate);
  }
  double matrix[4] = {1.0, along(p1),  //
                      1.0, along(p2)};
  double rhs[2] = {-across(p1), -across(p2)};
  double solution[2];
  if (!MathUtils::LinearEquationSystemSolve(2, matrix, rhs, solution)) return false;
  GeometryUtils::Point const only{solution[0], solution[1]};
  *candidate = {{only, only, only}};
  return true;
}

bool GeometryUtils::GetBoundingRect(std::vector<Triangle> const* cell, double* rect) {
  if (cell->empty()) return false;
  Point const& first = cell->front().pts[0];
  rect[0] = rect[2] = first.x;
  rect[1] = rect[3] = first.y;
  for (Triangle const& triangle : *cell) Cells::ExtendRect(triangle, rect);
  return true;
}

bool GeometryUtils::GetBoundingCircleAndLineIntersectionTriangle(std::vector<Triangle> const* cell,
                                                                 double a, double b, double c,
                                                                 Triangle* chord) {
  double rect[4];
  return GetBoundingRect(cell, rect) && Cells::ChordAcross(rect, a, b, c, chord);
}

bool GeometryUtils::GetCenter(std::vector<Triangle> const* cell, Point* center) {
  if (cell->empty()) return false;
  double totalArea = 0.0;
  Point weighted;
  Point degenerateSum;
  int degenerateCount = 0;
  for (Triangle const& triangle : *cell) {
    Cells::TriangleCentre const own(triangle);
    if (Numeric::IsZero(own.area)) {
      degenerateSum.x += own.center.x;
      degenerateSum.y += own.center.y;
      ++degenerateCount;
    } else {
      totalArea += own.area;
      weighted.x += own.center.x * own.area;
      weighted.y += own.center.y * own.area;
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
  Cells::FixedPoints const fixed{hasP1, p1, hasP2, p2, swapped};
  if (!fixed.IsAny()) return GetCenter(cell, center);
  double rect[4];
  Triangle candidate;
  if (!GetBoundingRect(cell, rect) || !fixed.FindCandidate(rect, &candidate)) return false;
  // Deliberate: what was collected counts here, not the status.
  std::vector<Triangle> overlap;
  GetOverlapping(candidate, cell, &overlap);
  return !overlap.empty() && GetCenter(&overlap, center);
}

}  // namespace Vorn
