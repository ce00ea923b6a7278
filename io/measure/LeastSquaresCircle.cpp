// The circle A (x^2 + y^2) + B x + C y + D = 0 with B^2 + C^2 - 4 A D = 1, which is a line for
// A = 0. Its radius is 1 / (2 |A|). With P the value of the left side at a point, the signed
// distance of the point is d = 2 P / (1 + sqrt(1 + 4 A P)), which is as good for a line as for a
// small circle because nothing is taken from anything nearly as large; and P = d + A d^2.
//
// Unknowns of the steps are A, the direction t of (B, C) = E (cos t, sin t), and D, where
// E = sqrt(1 + 4 A D). The origin lies on the first guess, so that D is about 0 and E about 1.
#include <Eigen/Dense>
#include <algorithm>
#include <cmath>
#include <limits>

#include "io/measure/Normalised.h"
#include "vorn/io/LeastSquares.h"

namespace Vorn::IO {

namespace {

constexpr double kParameters = 3.0;

constexpr int kMostSteps = 100;
constexpr double kFirstDamping = 1e-3;
constexpr double kMostDamping = 1e12;
constexpr double kDampingStep = 10.0;
/// A step this small leaves an error far below the rounding of the points, which are of size 1.
constexpr double kSettled = 1e-12;
/// Below this a step is taken though rounding may hide that it leads down.
constexpr double kNearlySettled = 1e-7;

/// A curve of this A leaves its tangent by less than the rounding of points of size 1.
constexpr double kStraight = 4.0 * std::numeric_limits<double>::epsilon();

/// The first guess, about the mean of the points.
struct Guess {
  double a = 0.0;
  double normal = 0.0;  ///< direction of (B, C)
  XY origin;            ///< the place of the circle nearest to the mean
};

/// The unknowns.
struct Curve {
  double a = 0.0;
  double normal = 0.0;
  double d = 0.0;

  double NormalLength2() const { return 1.0 + 4.0 * a * d; }
};

/// The normal equations of a step, with the sum of squares that it starts from.
struct Equations {
  Eigen::Matrix3d matrix = Eigen::Matrix3d::Zero();
  Eigen::Vector3d right = Eigen::Vector3d::Zero();
  double squares = 0.0;
  double least = 0.0;  ///< signed distances of the outermost points
  double most = 0.0;
};

/// Taubin's fit: the least mean square of P where that of its gradient is 1, the eigenvector of
/// the smallest eigenvalue of the moments of ((z - m) / (2 sqrt m), x, y), where z = x^2 + y^2 and
/// m is its mean.
Guess GuessOf(std::vector<XY> const& points) {
  double mean = 0.0;
  for (XY const& at : points) {
    mean += (at.x * at.x + at.y * at.y) / static_cast<double>(points.size());
  }
  Eigen::Matrix3d moments = Eigen::Matrix3d::Zero();
  for (XY const& at : points) {
    double const z = at.x * at.x + at.y * at.y;
    Eigen::Vector3d const row(0.5 * (z - mean) / std::sqrt(mean), at.x, at.y);
    moments += row * row.transpose();
  }
  Eigen::SelfAdjointEigenSolver<Eigen::Matrix3d> const solver(moments);
  Eigen::Vector3d const least = solver.eigenvectors().col(0);
  double const a = 0.5 * least(0) / std::sqrt(mean);
  double const d = -a * mean;
  // The eigenvector has the length 1, and with it B^2 + C^2 - 4 A D is 1.
  Guess guess;
  guess.a = a;
  guess.normal = std::atan2(least(2), least(1));
  double const toMean = 2.0 * d / (1.0 + std::hypot(least(1), least(2)));
  guess.origin = {-toMean * std::cos(guess.normal), -toMean * std::sin(guess.normal)};
  return guess;
}

Equations EquationsAt(Curve const& curve, std::vector<XY> const& points) {
  double const length = std::sqrt(std::max(0.0, curve.NormalLength2()));
  double const cosine = std::cos(curve.normal);
  double const sine = std::sin(curve.normal);
  Equations equations;
  for (XY const& at : points) {
    double const z = at.x * at.x + at.y * at.y;
    double const outward = cosine * at.x + sine * at.y;
    double const aside = cosine * at.y - sine * at.x;
    double const p = curve.a * z + length * outward + curve.d;
    double const root = std::sqrt(std::max(0.0, 1.0 + 4.0 * curve.a * p));
    double const distance = 2.0 * p / (1.0 + root);
    equations.squares += distance * distance;
    equations.least = std::min(equations.least, distance);
    equations.most = std::max(equations.most, distance);
    // From P = d + A d^2. At the centre itself, where `root` is 0, no direction leads away.
    if (!(root > 0.0) || !(length > 0.0)) continue;
    Eigen::Vector3d const row(z + 2.0 * curve.d * outward / length - distance * distance,
                              length * aside, 1.0 + 2.0 * curve.a * outward / length);
    equations.matrix += row * row.transpose() / (root * root);
    equations.right -= row * (distance / root);
  }
  return equations;
}

Curve Moved(Curve const& curve, Eigen::Vector3d const& step) {
  return {curve.a + step(0), curve.normal + step(1), curve.d + step(2)};
}

/// Goes down from the first guess until nothing moves any more.
struct Descent {
  Curve curve;
  Equations equations;
};

Descent Descend(double curvature, double normal, std::vector<XY> const& points) {
  Descent best{{curvature, normal, 0.0}, {}};
  best.equations = EquationsAt(best.curve, points);
  double damping = kFirstDamping;
  for (int i = 0; i < kMostSteps && damping < kMostDamping; ++i) {
    Eigen::Matrix3d damped = best.equations.matrix;
    damped.diagonal() *= 1.0 + damping;
    Eigen::Vector3d const step = damped.ldlt().solve(best.equations.right);
    if (!step.allFinite()) break;
    Descent next{Moved(best.curve, step), {}};
    next.equations = EquationsAt(next.curve, points);
    double const size = step.lpNorm<Eigen::Infinity>();
    if (next.equations.squares < best.equations.squares || size < kNearlySettled) {
      best = next;
      damping /= kDampingStep;
      if (size < kSettled) break;
    } else {
      damping *= kDampingStep;
    }
  }
  return best;
}

/// What is left of it in the coordinates of the contour.
std::optional<LeastSquaresCircle> CircleOf(Descent const& descent, XY const& origin,
                                           Normalised const& normalised) {
  Curve const& curve = descent.curve;
  double const size = normalised.size;
  LeastSquaresCircle circle;
  circle.radius = 0.5 * size / std::fabs(curve.a);
  if (std::fabs(curve.a) < kStraight || !std::isfinite(circle.radius)) return {};
  double const toCenter = -0.5 * std::sqrt(std::max(0.0, curve.NormalLength2())) / curve.a;
  circle.center = {normalised.mean.x + size * (origin.x + toCenter * std::cos(curve.normal)),
                   normalised.mean.y + size * (origin.y + toCenter * std::sin(curve.normal))};
  circle.scatter.formError = size * (descent.equations.most - descent.equations.least);
  auto const count = static_cast<double>(normalised.at.size());
  if (count <= kParameters) return circle;
  double const variance = descent.equations.squares / (count - kParameters);
  circle.scatter.standardDeviation = size * std::sqrt(variance);
  // The radius follows from A, whose variance is the first of the inverted normal equations.
  Eigen::Vector3d const first =
      descent.equations.matrix.ldlt().solve(Eigen::Vector3d(Eigen::Vector3d::UnitX()));
  circle.radiusDeviation =
      circle.radius * std::sqrt(variance * std::max(0.0, first(0))) / std::fabs(curve.a);
  return circle;
}

bool IsSame(XY const& a, XY const& b) { return a.x == b.x && a.y == b.y; }

/// Through two places run many circles.
bool AreThreePlaces(std::vector<XY> const& points) {
  if (points.empty()) return false;
  XY const& first = points.front();
  auto const second =
      std::find_if(points.begin(), points.end(), [&](XY const& at) { return !IsSame(at, first); });
  return std::any_of(second, points.end(),
                     [&](XY const& at) { return !IsSame(at, first) && !IsSame(at, *second); });
}

}  // namespace

std::optional<LeastSquaresCircle> FitCircle(std::vector<XY> const& points) {
  if (!AreThreePlaces(points)) return {};
  std::optional<Normalised> normalised = Normalise(points);
  if (!normalised) return {};
  Guess const guess = GuessOf(normalised->at);
  for (XY& at : normalised->at) at = {at.x - guess.origin.x, at.y - guess.origin.y};
  std::optional<LeastSquaresCircle> circle =
      CircleOf(Descend(guess.a, guess.normal, normalised->at), guess.origin, *normalised);
  // In units of the points it is above zero, but theirs may be the smallest double there is.
  if (circle && !(circle->radius > 0.0)) return {};
  return circle;
}

}  // namespace Vorn::IO
