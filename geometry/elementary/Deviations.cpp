// Implicit lines a*x + b*y + c = 0, distances of points from them, and the spacing test of
// measured points. Lines are never normalised: the raw coefficients decide exact comparisons
// elsewhere (parallel segments), and a division here would spoil them.

#include <algorithm>
#include <cmath>

#include "geometry/elementary/ImplicitLine.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Numeric::IsZero;
using Numeric::kZero;

namespace {

/// Neighbours must be farther apart than this many times the sum of their tolerances, or a line
/// cell between them could hold no inner tangents worth the name.
constexpr double kSpacingFactor = 1.5;

double Square(double value) { return value * value; }

}  // namespace

double GeometryUtils::GetDist2(Point const& p, Point const& q) {
  return Square(p.y - q.y) + Square(p.x - q.x);
}

bool GeometryUtils::GetLineParameters(double x1, double y1, double x2, double y2, double* a,
                                      double* b, double* c) {
  Lines::ImplicitLine line;
  if (!line.Through(x1, y1, x2, y2)) return false;
  *a = line.a;
  *b = line.b;
  *c = line.c;
  return true;
}

bool GeometryUtils::GetDeviation(double a, double b, double c, double x, double y, double* dev) {
  double const norm = std::sqrt(a * a + b * b);
  if (IsZero(norm)) return false;
  *dev = std::fabs(a * x + b * y + c) / norm;
  return true;
}

bool GeometryUtils::GetSignedDeviation(double a, double b, double c, double x, double y,
                                       double* dev) {
  // The origin never gets a positive deviation: positive means the side away from it.
  Lines::ImplicitLine const line{a, b, c};
  double const divisor = line.SignedNorm();
  if (Numeric::IsZeroMagnitude(divisor)) return false;
  *dev = line.At(x, y) / divisor;
  return true;
}

bool GeometryUtils::GetDeviation(double const* coords, double* dev) {
  Point const p1{coords[0], coords[1]};
  Point const p2{coords[2], coords[3]};
  Point const p3{coords[4], coords[5]};
  double const base2 = GetDist2(p1, p2);
  if (IsZero(base2)) return false;
  double const fromFirst2 = GetDist2(p1, p3);
  double const fromSecond2 = GetDist2(p2, p3);
  double const projection2 = Square(fromFirst2 + base2 - fromSecond2) / (4.0 * base2);
  if (fromFirst2 + projection2 < kZero ||
      std::fabs((fromFirst2 - projection2) / (projection2 + fromFirst2)) < kZero) {
    *dev = 0.0;
    return true;
  }
  // Deliberate: no clamp. A difference that rounding made negative gives a NaN, which the line
  // fitter takes for "too far".
  *dev = std::sqrt(fromFirst2 - projection2);
  return true;
}

void GeometryUtils::GetNormal(double a, double b, double c, Point const& p, double* na, double* nb,
                              double* nc) {
  Lines::ImplicitLine const normal = Lines::ImplicitLine{a, b, c}.NormalThrough(p.x, p.y);
  *na = normal.a;
  *nb = normal.b;
  *nc = normal.c;
}

void GeometryUtils::GetXyminXymax(double x1, double y1, double x2, double y2, double* box) {
  box[0] = std::min(x1, x2);
  box[1] = std::min(y1, y2);
  box[2] = std::max(x1, x2);
  box[3] = std::max(y1, y2);
}

bool GeometryUtils::IsPointValidToFit(WPoint const& a, WPoint const& b) {
  double const reach = (a.w + b.w) * kSpacingFactor;
  // Written as a negation so that a NaN passes here and is met by the fitters instead.
  return !(Square(reach) >= Square(b.x - a.x) + Square(b.y - a.y));
}

}  // namespace Vorn
