// Members for a circle from points: a first estimate, the radius for a centre, and the least
// squares that refine the centre.

#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/fitting/arc/CircleEstimate.h"
#include "geometry/fitting/arc/CircleRadius.h"
#include "geometry/fitting/arc/CircleShift.h"
#include "geometry/fitting/arc/ClosePoints.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

bool GeometryUtils::GetEstimatedCircle(std::vector<WPoint> const& points, Point* first,
                                       Point* middle, Point* last, Point* center, double* radius,
                                       double* minSpacing) {
  std::optional<Fitting::CircleEstimate> const estimate = Fitting::EstimateCircle(points);
  if (!estimate) return false;
  *first = estimate->first;
  *middle = estimate->middle;
  *last = estimate->last;
  *center = estimate->circle.centre;
  *radius = estimate->circle.radius;
  *minSpacing = estimate->leastSpacing;
  return true;
}

bool GeometryUtils::GetEstimatedMaxDeviationForCircle(Point const& first, Point const& middle,
                                                      Point const& last, double radius,
                                                      double* deviation) {
  *deviation = Fitting::AllowedDeviation(first, middle, last, radius);
  return true;
}

bool GeometryUtils::GetEstimatedDeviationForCircle(std::vector<WPoint> const& points,
                                                   double* tolerance,
                                                   std::vector<std::int32_t>* excluded,
                                                   Point* center, double* radius) {
  std::optional<Fitting::ToleranceEstimate> const estimate = Fitting::EstimateTolerance(points);
  if (!estimate) return false;
  excluded->clear();
  auto const closePoints = Fitting::FindClosePoints(points, *estimate);
  if (!closePoints) return false;
  *excluded = *closePoints;
  *tolerance = estimate->tolerance;
  *center = estimate->circle.centre;
  *radius = estimate->circle.radius;
  return true;
}

bool GeometryUtils::GetRadiusRange(std::vector<WPoint> const& points, std::int32_t first,
                                   std::int32_t count, double cx, double cy, double tolerance,
                                   double* minRadius, double* maxRadius) {
  // No point, no bound: both outputs stay as they are.
  if (count <= 0) return true;
  std::optional<Fitting::RadiusRange> const range =
      Fitting::FindRadiusRange({points, first, count}, {cx, cy}, tolerance);
  if (!range) return false;
  *minRadius = range->least;
  *maxRadius = range->greatest;
  return true;
}

bool GeometryUtils::CalcOptimalRadius(std::vector<WPoint> const& points, std::int32_t first,
                                      std::int32_t count, double cx, double cy, double tolerance,
                                      CircleRadiusFindingStrategy strategy, double* radius) {
  std::optional<double> const found =
      Fitting::FindRadius({points, first, count}, {cx, cy}, tolerance, strategy);
  if (found) *radius = *found;
  return found.has_value();
}

bool GeometryUtils::CalcDeviationCurve(std::vector<WPoint> const& points, std::int32_t first,
                                       std::int32_t count, Point const& center, double radius,
                                       std::vector<WPoint2>* curve) {
  return Fitting::AppendDeviationCurve({points, first, count}, {center, radius}, curve);
}

bool GeometryUtils::CalcCorrectionShiftForCircle(std::vector<WPoint2> const& curve, Point* shift) {
  std::optional<Point> const found = Fitting::FindCentreShift(curve);
  if (found) *shift = *found;
  return found.has_value();
}

double GeometryUtils::GetMaxObtainedDeviation(std::vector<WPoint> const& points, std::int32_t first,
                                              std::int32_t count, Point const& center,
                                              double radius, std::int32_t* index) {
  Fitting::Deviation const largest =
      Fitting::LargestDistance({points, first, count}, {center, radius});
  *index = largest.index;
  return largest.value;
}

}  // namespace Vorn
