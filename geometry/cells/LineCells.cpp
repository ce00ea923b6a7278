// Cells of admissible lines.
//
// A line that passes within the tolerances of two measured points lies between the four tangents of
// their tolerance circles. In the plane of line parameters those tangents are the corners of a
// convex quadrilateral, the line cell of the pair.
//
// Notation: P0 .. P3 the tangent points (P0 and P1 on the circle of the second point, P2 and P3 on
// that of the first), L1 .. L4 the lines P0P2, P1P2, P1P3, P0P3, each as A*x + B*y + D = 0.

#include <array>
#include <cmath>
#include <cstddef>

#include "geometry/triangles/Ring.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Numeric::IsZero;
using Numeric::IsZeroMagnitude;

namespace {

using Point = GeometryUtils::Point;

constexpr int kLines = 4;

/// The four lines through tangent points, coefficient by coefficient.
struct Bunch {
  double a[kLines];
  double b[kLines];
  double d[kLines];
};

Bunch BunchOfRect(double const* rect) {
  Point const p[4] = {
      {rect[0], rect[1]}, {rect[2], rect[3]}, {rect[4], rect[5]}, {rect[6], rect[7]}};
  constexpr int kFrom[kLines] = {0, 1, 1, 0};
  constexpr int kTo[kLines] = {2, 2, 3, 3};
  Bunch bunch;
  for (int i = 0; i < kLines; ++i) {
    Point const& u = p[kFrom[i]];
    Point const& v = p[kTo[i]];
    bunch.a[i] = v.y - u.y;
    bunch.b[i] = u.x - v.x;
    bunch.d[i] = v.x * u.y - u.x * v.y;
  }
  return bunch;
}

using Corners = std::array<Point, kLines>;

/// The corners of the cell in cyclic order: the parameter points of L2, L3, L4, L1.
Corners CellCorners(Bunch const& bunch, bool xOfY) {
  constexpr int kOrder[kLines] = {1, 2, 3, 0};
  Corners corners;
  for (std::size_t k = 0; k < kLines; ++k) {
    int const i = kOrder[k];
    corners[k] = xOfY ? Point{bunch.d[i] / bunch.a[i], bunch.b[i] / bunch.a[i]}
                      : Point{bunch.d[i] / bunch.b[i], bunch.a[i] / bunch.b[i]};
  }
  return corners;
}

/// Chooses the form of the line parameters, if that is still open, and writes the cell's corners.
/// A form that this call chose may be changed once; one that came from outside never is, since all
/// cells of a run must lie in one plane.
template <typename IsValidBunch>
ErrorCode CellOfBunch(Bunch const& bunch, bool* formFixed, bool* xOfY,
                      IsValidBunch const& isValidBunch, Corners* corners) {
  bool maySwitch = !*formFixed;
  if (maySwitch) {
    *formFixed = true;
    *xOfY = std::fabs(bunch.a[kLines - 1]) > std::fabs(bunch.b[kLines - 1]);
  }
  for (;;) {
    bool const isValid =
        *xOfY ? isValidBunch(bunch.a, bunch.b, kLines) : isValidBunch(bunch.b, bunch.a, kLines);
    if (isValid) break;
    if (!maySwitch) return ErrorCode::InvalidLineCell;
    maySwitch = false;
    *xOfY = !*xOfY;
  }
  *corners = CellCorners(bunch, *xOfY);
  return ErrorCode::Ok;
}

/// Replaces a cell by the triangles of its corners, which are used up.
void Divide(Corners* corners, std::vector<GeometryUtils::Triangle>* cell) {
  cell->clear();
  Cells::CutEars(corners->data(), kLines,
                 [cell](GeometryUtils::Triangle const& ear) { cell->push_back(ear); });
}

}  // namespace

bool GeometryUtils::GetPermissibleRect(WPoint a, WPoint b, double* rect) {
  double const sum = a.w + b.w;
  if (IsZero(sum)) {
    // Deliberate: here the first point comes first, the reverse of the general case.
    double const collapsed[8] = {a.x, a.y, a.x, a.y, b.x, b.y, b.x, b.y};
    for (int i = 0; i < 8; ++i) rect[i] = collapsed[i];
    return true;
  }
  double const dx = b.x - a.x;
  double const dy = b.y - a.y;
  double const length2 = dx * dx + dy * dy;
  double const sum2 = sum * sum;
  if (sum2 > length2) return false;

  double const t = std::sqrt(length2 / sum2 - 1.0);
  double const kb = b.w * sum / length2;
  double const ka = a.w * sum / length2;
  rect[0] = b.x - (t * dy + dx) * kb;
  rect[1] = b.y + (t * dx - dy) * kb;
  rect[2] = b.x + (t * dy - dx) * kb;
  rect[3] = b.y - (t * dx + dy) * kb;
  rect[4] = a.x + (dx + t * dy) * ka;
  rect[5] = a.y - (t * dx - dy) * ka;
  rect[6] = a.x + (dx - t * dy) * ka;
  rect[7] = a.y + (dy + t * dx) * ka;
  return true;
}

bool GeometryUtils::GetPermissibleRect(double x1, double y1, double x2, double y2, double r,
                                       double* rect) {
  if (IsZero(r * r)) {
    double const collapsed[8] = {x1, y1, x1, y1, x2, y2, x2, y2};
    for (int i = 0; i < 8; ++i) rect[i] = collapsed[i];
    return true;
  }
  double const dx = x2 - x1;
  double const dy = y2 - y1;
  double const length2 = dx * dx + dy * dy;
  double const diameter2 = 4.0 * (r * r);
  if (diameter2 > length2) return false;

  double const k = diameter2 / length2;
  double const t = std::sqrt(length2 / diameter2 - 1.0);
  double const hx = dx / 2.0;
  double const hy = dy / 2.0;
  double px0 = 0.0;
  double py0 = 0.0;
  double px1 = 0.0;
  double py1 = 0.0;
  // The second coordinate follows from the tangency, divided by the larger half difference.
  if (std::fabs(dx) >= std::fabs(dy)) {
    py0 = y2 - k * hy + k * hx * t;
    py1 = y2 - k * hy - k * hx * t;
    px0 = x2 - ((py0 - y2) * hy + r * r) / hx;
    px1 = x2 - ((py1 - y2) * hy + r * r) / hx;
  } else {
    px0 = x2 - k * hx - k * hy * t;
    px1 = x2 - k * hx + k * hy * t;
    py0 = y2 - ((px0 - x2) * hx + r * r) / hy;
    py1 = y2 - ((px1 - x2) * hx + r * r) / hy;
  }
  rect[0] = px0;
  rect[1] = py0;
  rect[2] = px1;
  rect[3] = py1;
  rect[4] = x1 + x2 - px0;
  rect[5] = y1 + y2 - py0;
  rect[6] = x1 + x2 - px1;
  rect[7] = y1 + y2 - py1;
  return true;
}

bool GeometryUtils::IsValidBunch(double const* den, double const* num, int n) {
  if (n < kLines) return false;
  double firstAngle = 0.0;
  double lastAngle = 0.0;
  for (int i = 0; i < n; ++i) {
    if (IsZeroMagnitude(den[i])) return false;
    if (i == 0) firstAngle = std::fabs(std::atan2(num[i], den[i]));
    if (i == kLines - 1) lastAngle = std::fabs(std::atan2(num[i], den[i]));
  }
  // Deliberate: only the two outer lines are compared.
  return (firstAngle < Numeric::kTruncatedHalfPi && lastAngle < Numeric::kTruncatedHalfPi) ||
         (firstAngle > Numeric::kTruncatedHalfPi && lastAngle > Numeric::kTruncatedHalfPi);
}

ErrorCode GeometryUtils::GetLinePolygon(WPoint a, WPoint b, bool* formFixed, bool* xOfY,
                                        Point2D<double>* const polygon) {
  double rect[8];
  if (!GetPermissibleRect(a, b, rect)) return ErrorCode::Failed;
  Corners corners;
  ErrorCode const code = CellOfBunch(BunchOfRect(rect), formFixed, xOfY, IsValidBunch, &corners);
  if (code != ErrorCode::Ok) return code;
  for (std::size_t i = 0; i < kLines; ++i) polygon[i] = {corners[i].x, corners[i].y};
  return ErrorCode::Ok;
}

ErrorCode GeometryUtils::GetLineTriangles(WPoint a, WPoint b, bool* formFixed, bool* xOfY,
                                          std::vector<Triangle>* cell) {
  double rect[8];
  if (!GetPermissibleRect(a, b, rect)) return ErrorCode::Failed;
  Corners corners;
  ErrorCode const code = CellOfBunch(BunchOfRect(rect), formFixed, xOfY, IsValidBunch, &corners);
  if (code == ErrorCode::Ok) Divide(&corners, cell);
  return code;
}

ErrorCode GeometryUtils::GetLineTriangles(double x1, double y1, double x2, double y2, double r,
                                          bool* formFixed, bool* xOfY,
                                          std::vector<Triangle>* cell) {
  double rect[8];
  if (!GetPermissibleRect(x1, y1, x2, y2, r, rect)) return ErrorCode::Failed;
  Corners corners;
  ErrorCode const code = CellOfBunch(BunchOfRect(rect), formFixed, xOfY, IsValidBunch, &corners);
  if (code == ErrorCode::Ok) Divide(&corners, cell);
  return code;
}

bool GeometryUtils::GetPermissibleHexagon(Point const& a, Point const& b, Point const& c, double r,
                                          double* /*out*/) {
  Point center;
  double radius = 0.0;
  return GetCircle(a, b, c, &center, &radius) && radius > r;
}

}  // namespace Vorn
