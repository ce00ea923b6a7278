// Notation: a sample has the weight g, the unit direction (ux, uy) from the centre and the
// deviation dev. To first order, a change dr of the radius and a shift (sx, sy) of the centre
// explain dev = dr + sy * uy + sx * ux; the normal equations of that are solved.

#include "geometry/fitting/arc/CircleShift.h"

#include <cmath>
#include <cstddef>

#include "geometry/elementary/Points.h"
#include "math/NumericConstants.h"
#include "vorn/MathUtils.h"

namespace Vorn::Fitting {

namespace {

constexpr std::size_t kUnknowns = 3;

/// The sums of the normal equations, named after their factors.
struct NormalSums {
  double gUy = 0.0;
  double gUx = 0.0;
  double gUyUy = 0.0;
  double gUxUy = 0.0;
  double gUxUx = 0.0;
  double gDev = 0.0;
  double gUyDev = 0.0;
  double gUxDev = 0.0;

  /// False for a sample at the centre, which has no direction.
  bool Add(WPoint2 const& sample) {
    double const dx = sample.dx;
    double const dy = sample.dy;
    double const g = sample.weight;
    double const distance2 = dx * dx + dy * dy;
    if (Numeric::IsZero(distance2)) return false;
    double const distance = std::sqrt(distance2);
    double const ux = dx / distance;
    double const uy = dy / distance;
    gUy += g * uy;
    gUx += g * ux;
    gUyUy += g * (dy * dy) / distance2;
    gUxUy += g * dx * dy / distance2;
    gUxUx += g * (dx * dx) / distance2;
    gDev += g * sample.dev;
    gUyDev += g * uy * sample.dev;
    gUxDev += g * ux * sample.dev;
    return true;
  }

  /// The shift (sx, sy) over so many samples; nothing for a singular system.
  std::optional<Point> Solve(std::size_t sampleCount) const {
    // The first entry is the plain count: weights average 1.
    double matrix[kUnknowns * kUnknowns] = {static_cast<double>(sampleCount),
                                            gUy,
                                            gUx,  //
                                            gUy,
                                            gUyUy,
                                            gUxUy,  //
                                            gUx,
                                            gUxUy,
                                            gUxUx};
    double rhs[kUnknowns] = {gDev, gUyDev, gUxDev};
    double solution[kUnknowns];
    if (!MathUtils::LinearEquationSystemSolve(kUnknowns, matrix, rhs, solution)) {
      return std::nullopt;
    }
    return Point{solution[2], solution[1]};
  }
};

/// Deliberate: a shift by way of length and angle, though it only gives back the same: the rounding
/// of this route is part of every fitted circle.
Point ThroughPolarForm(Point const& shift) {
  double const length = std::sqrt(shift.x * shift.x + shift.y * shift.y);
  double const angle = -std::atan2(shift.x, shift.y) + Numeric::kTruncatedHalfPi;
  return {std::cos(angle) * length, std::sin(angle) * length};
}

}  // namespace

bool AppendDeviationCurve(Run const& run, Elementary::Circle const& trial,
                          std::vector<WPoint2>* curve) {
  if (run.count < 1 || !run.Exists()) return false;
  double sum = 0.0;
  for (std::int32_t i = 0; i < run.count; ++i) {
    WPoint const& p = run[i];
    double const distance = Elementary::Distance(ToPoint(p), trial.centre);
    curve->push_back({p.x - trial.centre.x, p.y - trial.centre.y, distance - trial.radius, p.w});
    sum += p.w;
  }
  if (Numeric::IsZero(sum)) return false;
  double const mean = sum / run.count;
  for (WPoint2& sample : *curve) sample.weight /= mean;
  return true;
}

std::optional<Point> FindCentreShift(std::vector<WPoint2> const& curve) {
  if (curve.size() < kUnknowns) return std::nullopt;
  NormalSums sums;
  for (WPoint2 const& sample : curve) {
    if (!sums.Add(sample)) return std::nullopt;
  }
  std::optional<Point> const shift = sums.Solve(curve.size());
  if (!shift) return std::nullopt;
  return ThroughPolarForm(*shift);
}

}  // namespace Vorn::Fitting
