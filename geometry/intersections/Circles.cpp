#include "geometry/intersections/Circles.h"

#include <cmath>

#include "geometry/elementary/Deviations.h"
#include "geometry/intersections/Lines.h"
#include "math/NumericConstants.h"

namespace Vorn::Intersections {

namespace {

/// The point of the line with a given x. The line must not be vertical.
Point AtX(ImplicitLine const& line, double x) {
  return {x, -(line.a / line.b) * x - line.c / line.b};
}

/// The point of the line with a given y. The line must not be horizontal.
Point AtY(ImplicitLine const& line, double y) {
  return {-(line.b / line.a) * y - line.c / line.a, y};
}

/// A stretch of the line around a foot that reaches as far to both sides, measured along the
/// coordinate in which the line changes faster; the other coordinate follows from the line itself.
Segment StretchAround(ImplicitLine const& line, Point const& foot, double reach) {
  if (std::fabs(line.a) > std::fabs(line.b)) {
    return {AtY(line, foot.y + reach), AtY(line, foot.y - reach)};
  }
  return {AtX(line, foot.x + reach), AtX(line, foot.x - reach)};
}

}  // namespace

CirclePoints CutCircleByLine(Circle const& circle, ImplicitLine const& line) {
  std::optional<double> const distance = Elementary::Deviation(line, circle.centre);
  if (!distance || *distance > circle.radius) return {};
  std::optional<Point> const foot = FootOn(line, circle.centre);
  if (!foot) return {};
  // Twice the radius is sure to hold the chord.
  return CutCircleBySegment(circle, StretchAround(line, *foot, 2.0 * circle.radius));
}

std::optional<Point> NearestOnCircle(Circle const& circle, Point const& p) {
  // Deliberate: the ray ends at twice the point's distance, so a point nearer to the centre than
  // half the radius has no projection.
  Point const& centre = circle.centre;
  Point const rayEnd{centre.x + 2.0 * (p.x - centre.x), centre.y + 2.0 * (p.y - centre.y)};
  CirclePoints const found = CutCircleBySegment(circle, {centre, rayEnd});
  if (found.count != 1) return std::nullopt;
  return found.pts[0];
}

}  // namespace Vorn::Intersections
