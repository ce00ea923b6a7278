#include "geometry/fitting/arc/CircleRadius.h"

#include <cmath>

#include "geometry/elementary/Points.h"
#include "math/NumericConstants.h"

namespace Vorn::Fitting {

using Elementary::Distance;
using Strategy = GeometryUtils::CircleRadiusFindingStrategy;

namespace {

std::optional<double> MeanDistance(Run const& run, Point const& centre, bool isWeighted) {
  double sum = 0.0;
  double weights = 0.0;
  for (std::int32_t i = 0; i < run.count; ++i) {
    double const distance = Distance(run.PointAt(i), centre);
    sum += isWeighted ? distance * run[i].w : distance;
    weights += run[i].w;
  }
  if (isWeighted && Numeric::IsZero(weights)) return std::nullopt;
  return sum / (isWeighted ? weights : run.count);
}

}  // namespace

std::optional<RadiusRange> FindRadiusRange(Run const& run, Point const& centre, double tolerance) {
  if (run.count < 1 || !run.Exists()) return std::nullopt;
  return CommonRange(run.count, [&](std::int32_t i) {
    return RadiusRange::Of(Distance(run.PointAt(i), centre), ToleranceOf(run[i], tolerance));
  });
}

std::optional<double> FindRadius(Run const& run, Point const& centre, double tolerance,
                                 Strategy strategy) {
  std::optional<RadiusRange> const range = FindRadiusRange(run, centre, tolerance);
  if (!range) return std::nullopt;
  if (strategy == Strategy::MidRange) return range->Middle();
  if (strategy != Strategy::MeanDistance) return std::nullopt;
  return MeanDistance(run, centre, tolerance < 0.0);
}

Deviation LargestDistance(Run const& run, Elementary::Circle const& circle) {
  if (!run.Exists()) return {};
  return FindLargest(run.count, [&](std::int32_t i) {
    return std::fabs(circle.radius - Distance(run.PointAt(i), circle.centre));
  });
}

}  // namespace Vorn::Fitting
