#include "geometry/fitting/arc/CircleEstimate.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "geometry/elementary/CircleThrough.h"
#include "geometry/elementary/Points.h"
#include "geometry/fitting/arc/PointSpread.h"
#include "math/NumericConstants.h"

namespace Vorn::Fitting {

using Elementary::Distance;
using Elementary::SquaredDistance;

namespace {

/// A little below the limit, so that an allowance equal to it does not pass. Formed by a product:
/// a limit of zero equals its product and shows up as such.
constexpr double kGuardFactor = 0.99;

/// The index of the point whose distances from two others of the run differ least, of equal ones
/// the first. The run has three points at least.
std::int32_t NearestToBisector(Run const& run, std::int32_t i, std::int32_t j) {
  std::int32_t nearest = -1;
  double smallestOffset = 0.0;
  for (std::int32_t k = 0; k < run.count; ++k) {
    if (k == i || k == j) continue;
    double const offset = std::fabs(Distance(run.PointAt(k), run.PointAt(i)) -
                                    Distance(run.PointAt(k), run.PointAt(j)));
    if (nearest < 0 || offset < smallestOffset) {
      smallestOffset = offset;
      nearest = k;
    }
  }
  return nearest;
}

}  // namespace

std::optional<CircleEstimate> EstimateCircle(std::vector<WPoint> const& points) {
  Run const run = RunOverAll(points);
  if (run.count < kFewestArcPoints) return std::nullopt;
  PointSpread const spread = FindSpread(points);
  CircleEstimate estimate;
  estimate.first = run.PointAt(spread.i);
  estimate.middle = run.PointAt(NearestToBisector(run, spread.i, spread.j));
  estimate.last = run.PointAt(spread.j);
  std::optional<Elementary::Circle> const circle =
      Elementary::CircleThrough(estimate.first, estimate.middle, estimate.last);
  if (!circle) return std::nullopt;
  estimate.circle = *circle;
  estimate.leastSpacing = std::sqrt(spread.smallest2);
  return estimate;
}

double AllowedDeviation(Point const& first, Point const& middle, Point const& last, double radius) {
  double const shorterChord2 =
      std::min(SquaredDistance(middle, last), SquaredDistance(first, middle));
  return std::min(radius * 0.25, shorterChord2 / (radius * 4.0));
}

std::optional<ToleranceEstimate> EstimateTolerance(std::vector<WPoint> const& points) {
  std::optional<CircleEstimate> const estimate = EstimateCircle(points);
  if (!estimate) return std::nullopt;
  double const limit = estimate->leastSpacing / kSpacingShare;
  double const guard = limit * kGuardFactor;
  if (guard == limit || Numeric::IsZero(guard)) return std::nullopt;
  return ToleranceEstimate{
      AllowedDeviation(estimate->first, estimate->middle, estimate->last, estimate->circle.radius),
      estimate->circle, guard};
}

}  // namespace Vorn::Fitting
