// Members for distances, implicit lines, deviations and the spacing of measured points.

#include <optional>

#include "geometry/elementary/Deviations.h"
#include "geometry/elementary/ImplicitLine.h"
#include "geometry/elementary/Points.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

double GeometryUtils::GetDist2(Point const& p, Point const& q) {
  return Elementary::SquaredDistance(p, q);
}

bool GeometryUtils::GetLineParameters(double x1, double y1, double x2, double y2, double* a,
                                      double* b, double* c) {
  std::optional<Elementary::ImplicitLine> const line = Elementary::LineThrough({x1, y1}, {x2, y2});
  if (!line) return false;
  *a = line->a;
  *b = line->b;
  *c = line->c;
  return true;
}

bool GeometryUtils::GetDeviation(double a, double b, double c, double x, double y, double* dev) {
  std::optional<double> const deviation = Elementary::Deviation({a, b, c}, {x, y});
  if (!deviation) return false;
  *dev = *deviation;
  return true;
}

bool GeometryUtils::GetSignedDeviation(double a, double b, double c, double x, double y,
                                       double* dev) {
  std::optional<double> const deviation = Elementary::SignedDeviation({a, b, c}, {x, y});
  if (!deviation) return false;
  *dev = *deviation;
  return true;
}

bool GeometryUtils::GetDeviation(double const* coords, double* dev) {
  std::optional<double> const deviation = Elementary::DeviationBySquares(
      {coords[0], coords[1]}, {coords[2], coords[3]}, {coords[4], coords[5]});
  if (!deviation) return false;
  *dev = *deviation;
  return true;
}

void GeometryUtils::GetNormal(double a, double b, double c, Point const& p, double* na, double* nb,
                              double* nc) {
  Elementary::ImplicitLine const normal = Elementary::ImplicitLine{a, b, c}.NormalThrough(p);
  *na = normal.a;
  *nb = normal.b;
  *nc = normal.c;
}

bool GeometryUtils::IsPointValidToFit(WPoint const& a, WPoint const& b) {
  return Elementary::AreFarEnoughApart(a, b);
}

}  // namespace Vorn
