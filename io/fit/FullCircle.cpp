#include "io/fit/FullCircle.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "io/pieces/Shapes.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/FitReport.h"

namespace Vorn::IO {

namespace {

using std::numbers::pi;

constexpr int kMostSteps = 20;
constexpr double kSettled = 1e-15;

struct Circle {
  XY center;
  double radius = 0.0;
};

/// The mean of the points without the repeated seam, and their mean distance from it: near enough
/// for points all around.
Circle FirstGuess(std::vector<WPoint> const& points) {
  Circle circle;
  auto const count = static_cast<double>(points.size() - 1);
  for (std::size_t i = 1; i < points.size(); ++i) {
    circle.center.x += points[i].x / count;
    circle.center.y += points[i].y / count;
  }
  for (std::size_t i = 1; i < points.size(); ++i) {
    circle.radius +=
        std::hypot(points[i].x - circle.center.x, points[i].y - circle.center.y) / count;
  }
  return circle;
}

double Determinant(double const (&m)[3][3]) {
  return m[0][0] * (m[1][1] * m[2][2] - m[1][2] * m[2][1]) -
         m[0][1] * (m[1][0] * m[2][2] - m[1][2] * m[2][0]) +
         m[0][2] * (m[1][0] * m[2][1] - m[1][1] * m[2][0]);
}

/// Normal equations of one Gauss-Newton step for centre and radius; three unknowns, so Cramer's
/// rule does.
struct Normal {
  double matrix[3][3] = {};
  double right[3] = {};

  void Add(double const (&row)[3], double value) {
    for (int i = 0; i < 3; ++i) {
      for (int k = 0; k < 3; ++k) matrix[i][k] += row[i] * row[k];
      right[i] += row[i] * value;
    }
  }

  double Solve(int unknown) const {
    double replaced[3][3];
    for (int i = 0; i < 3; ++i) {
      for (int k = 0; k < 3; ++k) replaced[i][k] = k == unknown ? right[i] : matrix[i][k];
    }
    return Determinant(replaced) / Determinant(matrix);
  }
};

Circle LeastSquares(std::vector<WPoint> const& points) {
  Circle circle = FirstGuess(points);
  for (int step = 0; step < kMostSteps; ++step) {
    Normal normal;
    for (std::size_t i = 1; i < points.size(); ++i) {
      double const x = points[i].x - circle.center.x;
      double const y = points[i].y - circle.center.y;
      double const r = std::hypot(x, y);
      double const weight = circle.radius / points[i].w;
      normal.Add({weight * x / r, weight * y / r, weight}, weight * (r - circle.radius));
    }
    double const dx = normal.Solve(0);
    double const dy = normal.Solve(1);
    double const dr = normal.Solve(2);
    circle.center.x += dx;
    circle.center.y += dy;
    circle.radius += dr;
    if (std::hypot(dx, dy, dr) <= kSettled * circle.radius) break;
  }
  return circle;
}

double TurnFrom(XY const& center, WPoint const& a, WPoint const& b) {
  double const ax = a.x - center.x;
  double const ay = a.y - center.y;
  double const bx = b.x - center.x;
  double const by = b.y - center.y;
  return std::atan2(ax * by - ay * bx, ax * bx + ay * by);
}

/// +1 or -1 for points that go round the centre once in steps that are small enough; 0 otherwise.
int RoundsAbout(XY const& center, std::vector<WPoint> const& points) {
  double turned = 0.0;
  for (std::size_t i = 1; i < points.size(); ++i) {
    double const step = TurnFrom(center, points[i - 1], points[i]);
    if (!(std::fabs(step) <= kLargestCircleStep)) return 0;
    turned += step;
  }
  return static_cast<int>(std::lround(turned / (2.0 * pi)));
}

std::vector<Piece> HalfCircles(Circle const& circle, WPoint const& seam, bool counterClockwise) {
  double const x = seam.x - circle.center.x;
  double const y = seam.y - circle.center.y;
  double const scale = circle.radius / std::hypot(x, y);
  XY const start = {circle.center.x + scale * x, circle.center.y + scale * y};
  return MakeCircle(start, circle.center, circle.radius, counterClockwise);
}

std::optional<std::vector<Piece>> Checked(Circle const& circle, std::vector<WPoint> const& points) {
  int const rounds = RoundsAbout(circle.center, points);
  if (std::abs(rounds) != 1) return {};
  std::vector<Piece> const arcs = HalfCircles(circle, points.front(), rounds > 0);
  if (!(Remeasure(points, arcs).Worst().relative <= kLargestRelative)) return {};
  return arcs;
}

}  // namespace

std::optional<std::vector<Piece>> FitFullCircle(std::vector<WPoint> const& points) {
  // Most contours are no circle, and seen from their middle it shows.
  if (RoundsAbout(FirstGuess(points).center, points) == 0) return {};
  return Checked(LeastSquares(points), points);
}

std::optional<std::vector<Piece>> FullCircleOf(std::vector<Piece> const& pieces,
                                               std::vector<WPoint> const& points) {
  auto const widest =
      std::max_element(pieces.begin(), pieces.end(),
                       [](Piece const& a, Piece const& b) { return a.sweep < b.sweep; });
  if (!(widest->sweep > pi)) return {};
  return Checked({widest->center, widest->radius}, points);
}

}  // namespace Vorn::IO
