#include "geometry/elementary/CircleThrough.h"

#include "vorn/MathUtils.h"

namespace Vorn::Elementary {

namespace {

/// The perpendicular bisector of two points as x * centre.x + y * centre.y = rhs.
struct BisectorEquation {
  /// The right side is a product of sums and differences, not a difference of squares: less
  /// cancellation far from the origin.
  BisectorEquation(Point const& p, Point const& q)
      : x(2.0 * (p.x - q.x)),
        y(2.0 * (p.y - q.y)),
        rhs((p.x + q.x) * (p.x - q.x) + (p.y + q.y) * (p.y - q.y)) {}

  double x;
  double y;
  double rhs;
};

/// The crossing of two bisectors; nothing when both lie along the x axis.
std::optional<Point> Solve(BisectorEquation const& first, BisectorEquation const& second) {
  double matrix[4] = {first.x, first.y,  //
                      second.x, second.y};
  double rhs[2] = {first.rhs, second.rhs};
  double solution[2];
  if (!MathUtils::LinearEquationSystemSolve(2, matrix, rhs, solution)) return std::nullopt;
  return Point{solution[0], solution[1]};
}

}  // namespace

std::optional<Circle> CircleThrough(Point const& a, Point const& b, Point const& c) {
  std::optional<Point> const centre = Solve({a, b}, {a, c});
  if (!centre) return std::nullopt;
  double const radius = (Distance(a, *centre) + Distance(b, *centre) + Distance(c, *centre)) / 3.0;
  return Circle{*centre, radius};
}

std::optional<Circle> CircleThroughNeighbours(Point const& a, Point const& b, Point const& c) {
  std::optional<Point> const centre = Solve({a, b}, {b, c});
  if (!centre) return std::nullopt;
  return Circle{*centre, Distance(a, *centre)};
}

std::optional<Point> PaddedCircumcentre(Point const& a, Point const& b, Point const& c) {
  BisectorEquation const first(a, b);
  BisectorEquation const second(b, c);
  double matrix[16] = {first.x,  first.y,  first.x,  first.y,   //
                       second.x, second.y, second.x, second.y,  //
                       0.0,      0.0,      1.0,      0.0,       //
                       0.0,      0.0,      0.0,      1.0};
  double rhs[4] = {first.rhs, second.rhs, 0.0, 0.0};
  double solution[4];
  if (!MathUtils::LinearEquationSystemSolve(4, matrix, rhs, solution)) return std::nullopt;
  return Point{solution[0], solution[1]};
}

}  // namespace Vorn::Elementary
