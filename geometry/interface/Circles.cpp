// Members for circles through three points and the sense in which three points turn.

#include <optional>

#include "geometry/elementary/CircleThrough.h"
#include "geometry/elementary/Sense.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Elementary::Circle;

ErrorCode GeometryUtils::GetCircle(double x1, double y1, double x2, double y2, double x3, double y3,
                                   double* cx, double* cy, double* r) {
  std::optional<Circle> const circle =
      Elementary::CircleThroughNeighbours({x1, y1}, {x2, y2}, {x3, y3});
  if (!circle) return ErrorCode::Failed;
  *cx = circle->centre.x;
  *cy = circle->centre.y;
  *r = circle->radius;
  return ErrorCode::Ok;
}

bool GeometryUtils::GetCircle(Point const& a, Point const& b, Point const& c, Point* center,
                              double* radius) {
  std::optional<Circle> const circle = Elementary::CircleThrough(a, b, c);
  if (!circle) return false;
  *radius = circle->radius;
  *center = circle->centre;
  return true;
}

ErrorCode GeometryUtils::IsCcw(Point const& a, Point const& b, Point const& c, bool* ccw) {
  std::optional<bool> const isCcw = Elementary::IsCounterClockwise(a, b, c);
  if (!isCcw) return ErrorCode::Failed;
  *ccw = *isCcw;
  return ErrorCode::Ok;
}

}  // namespace Vorn
