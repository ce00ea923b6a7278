// Standalone members: no other operation of the library uses them. The bounding box of two points
// and two intersections of straight lines, with rules of their own.

#include <algorithm>
#include <cmath>
#include <optional>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/intersections/Lines.h"
#include "geometry/intersections/SegmentPair.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Intersections::SegmentPair;

void GeometryUtils::GetXyminXymax(double x1, double y1, double x2, double y2, double* box) {
  box[0] = std::min(x1, x2);
  box[1] = std::min(y1, y2);
  box[2] = std::max(x1, x2);
  box[3] = std::max(y1, y2);
}

bool GeometryUtils::GetLineAndSegmentIntersection(double a, double b, double c, double x1,
                                                  double y1, double x2, double y2, double* x,
                                                  double* y) {
  std::optional<Elementary::ImplicitLine> const segment =
      Elementary::LineThrough({x1, y1}, {x2, y2});
  if (!segment) return false;
  std::optional<Point> const crossing = Intersections::CrossLines({a, b, c}, *segment);
  if (!crossing || !Intersections::IsInBox(*crossing, {{x1, y1}, {x2, y2}})) return false;
  *x = crossing->x;
  *y = crossing->y;
  return true;
}

bool GeometryUtils::AreLineSegmentsIntersect(double x1, double y1, double x2, double y2, double x3,
                                             double y3, double x4, double y4) {
  SegmentPair const pair({{x1, y1}, {x2, y2}}, {{x3, y3}, {x4, y4}});
  if (pair.AreBoxesApart()) return false;
  double const det = pair.Determinant();
  // Deliberate: a wider threshold than where segments are classified, and overlaps along one line
  // do not count.
  if (std::fabs(det) <= Numeric::kTangency) return false;
  return Intersections::AreParametersInRange(pair.ScaledParameter1(), pair.ScaledParameter2(), det);
}

}  // namespace Vorn
