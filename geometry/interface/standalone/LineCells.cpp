// Standalone members: no other operation of the library uses them. The line cell as a polygon, the
// line cell of two points of one tolerance, and a test of a circle against a tolerance.

#include "geometry/cells/LineCells.h"

#include <cmath>
#include <optional>
#include <vector>

#include "geometry/elementary/CircleThrough.h"
#include "geometry/interface/LineCellArguments.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Cells::TangentPoints;
using Point = GeometryUtils::Point;

/// The tangent points of two circles of one radius, as Cells::FindTangentPoints up to the last
/// bits: here the second coordinate of a point follows from the tangency, divided by the larger
/// half difference.
std::optional<TangentPoints> TangentPointsOfEqualCircles(Point const& p1, Point const& p2,
                                                         double r) {
  if (Numeric::IsZero(r * r)) return TangentPoints{p1, p1, p2, p2};
  double const dx = p2.x - p1.x;
  double const dy = p2.y - p1.y;
  double const length2 = dx * dx + dy * dy;
  double const diameter2 = 4.0 * (r * r);
  if (diameter2 > length2) return std::nullopt;

  double const k = diameter2 / length2;
  double const t = std::sqrt(length2 / diameter2 - 1.0);
  double const hx = dx / 2.0;
  double const hy = dy / 2.0;
  Point first;
  Point second;
  if (std::fabs(dx) >= std::fabs(dy)) {
    first.y = p2.y - k * hy + k * hx * t;
    second.y = p2.y - k * hy - k * hx * t;
    first.x = p2.x - ((first.y - p2.y) * hy + r * r) / hx;
    second.x = p2.x - ((second.y - p2.y) * hy + r * r) / hx;
  } else {
    first.x = p2.x - k * hx - k * hy * t;
    second.x = p2.x - k * hx + k * hy * t;
    first.y = p2.y - ((first.x - p2.x) * hx + r * r) / hy;
    second.y = p2.y - ((second.x - p2.x) * hx + r * r) / hy;
  }
  auto const mirrored = [&](Point const& p) { return Point{p1.x + p2.x - p.x, p1.y + p2.y - p.y}; };
  return TangentPoints{first, second, mirrored(first), mirrored(second)};
}

/// The corners of a line cell in the form that the caller's flags hold; Failed, flags unchanged,
/// without tangent points.
ErrorCode FindCorners(std::optional<TangentPoints> const& tangentPoints, bool* formFixed,
                      bool* xOfY, Cells::LineCellCorners* corners) {
  if (!tangentPoints) return ErrorCode::Failed;
  Cells::LineForm form = Cells::ReadForm(formFixed, xOfY);
  ErrorCode const code = Cells::FindCorners(*tangentPoints, &form, corners);
  Cells::WriteForm(form, formFixed, xOfY);
  return code;
}

}  // namespace

bool GeometryUtils::GetPermissibleRect(double x1, double y1, double x2, double y2, double r,
                                       double* rect) {
  std::optional<TangentPoints> const found = TangentPointsOfEqualCircles({x1, y1}, {x2, y2}, r);
  if (!found) return false;
  Cells::WriteRect(*found, rect);
  return true;
}

ErrorCode GeometryUtils::GetLinePolygon(WPoint a, WPoint b, bool* formFixed, bool* xOfY,
                                        Point2D<double>* const polygon) {
  Cells::LineCellCorners corners;
  ErrorCode const code = FindCorners(Cells::FindTangentPoints(a, b), formFixed, xOfY, &corners);
  if (code != ErrorCode::Ok) return code;
  for (std::size_t i = 0; i < corners.size(); ++i) polygon[i] = {corners[i].x, corners[i].y};
  return ErrorCode::Ok;
}

ErrorCode GeometryUtils::GetLineTriangles(double x1, double y1, double x2, double y2, double r,
                                          bool* formFixed, bool* xOfY,
                                          std::vector<Triangle>* cell) {
  Cells::LineCellCorners corners;
  ErrorCode const code =
      FindCorners(TangentPointsOfEqualCircles({x1, y1}, {x2, y2}, r), formFixed, xOfY, &corners);
  if (code != ErrorCode::Ok) return code;
  Cells::LineCell const found = Cells::Divide(corners);
  cell->assign(found.begin(), found.end());
  return ErrorCode::Ok;
}

bool GeometryUtils::GetPermissibleHexagon(Point const& a, Point const& b, Point const& c, double r,
                                          double* /*out*/) {
  std::optional<Elementary::Circle> const circle = Elementary::CircleThrough(a, b, c);
  return circle && circle->radius > r;
}

}  // namespace Vorn
