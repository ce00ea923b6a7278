// Radii for a given centre, deviations of points from a circle, and the shift of the centre that
// explains them best.

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"
#include "vorn/MathUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::ToPoint;

namespace {

/// A negative tolerance stands for each point's own.
double ToleranceOf(WPoint const& p, double tolerance) { return tolerance < 0.0 ? p.w : tolerance; }

}  // namespace

bool GeometryUtils::GetRadiusRange(std::vector<WPoint> const& points, std::int32_t first,
                                   std::int32_t count, double cx, double cy, double tolerance,
                                   double* minRadius, double* maxRadius) {
  // No point, no bound: both outputs stay as they are.
  if (count <= 0) return true;
  if (!Fitting::HoldsRun(points, first, count)) return false;
  double lower = 0.0;
  double upper = 0.0;
  for (std::int32_t i = 0; i < count; ++i) {
    WPoint const& p = At(points, first + i);
    double const distance = std::sqrt(GetDist2(ToPoint(p), {cx, cy}));
    double const half = ToleranceOf(p, tolerance);
    lower = i == 0 ? distance - half : std::max(lower, distance - half);
    upper = i == 0 ? distance + half : std::min(upper, distance + half);
    if (lower > upper) return false;
  }
  *minRadius = lower;
  *maxRadius = upper;
  return true;
}

bool GeometryUtils::CalcOptimalRadius(std::vector<WPoint> const& points, std::int32_t first,
                                      std::int32_t count, double cx, double cy, double tolerance,
                                      CircleRadiusFindingStrategy strategy, double* radius) {
  if (count < 1) return false;
  if (strategy != CircleRadiusFindingStrategy::MidRange &&
      strategy != CircleRadiusFindingStrategy::MeanDistance) {
    return false;
  }
  double minRadius = 0.0;
  double maxRadius = 0.0;
  if (!GetRadiusRange(points, first, count, cx, cy, tolerance, &minRadius, &maxRadius)) {
    return false;
  }
  if (strategy == CircleRadiusFindingStrategy::MidRange) {
    *radius = (minRadius + maxRadius) * 0.5;
    return true;
  }
  bool const isWeighted = tolerance < 0.0;
  double sum = 0.0;
  double weights = 0.0;
  for (std::int32_t i = 0; i < count; ++i) {
    WPoint const& p = At(points, first + i);
    double const distance = std::sqrt(GetDist2(ToPoint(p), {cx, cy}));
    sum += isWeighted ? distance * p.w : distance;
    weights += p.w;
  }
  if (isWeighted && Numeric::IsZero(weights)) return false;
  *radius = sum / (isWeighted ? weights : count);
  return true;
}

bool GeometryUtils::CalcDeviationCurve(std::vector<WPoint> const& points, std::int32_t first,
                                       std::int32_t count, Point const& center, double radius,
                                       std::vector<WPoint2>* curve) {
  if (count < 1 || !Fitting::HoldsRun(points, first, count)) return false;
  double sum = 0.0;
  for (std::int32_t i = 0; i < count; ++i) {
    WPoint const& p = At(points, first + i);
    double const distance = std::sqrt(GetDist2(ToPoint(p), center));
    curve->push_back({p.x - center.x, p.y - center.y, distance - radius, p.w});
    sum += p.w;
  }
  if (Numeric::IsZero(sum)) return false;
  double const mean = sum / count;
  for (WPoint2& sample : *curve) sample.weight /= mean;
  return true;
}

bool GeometryUtils::CalcCorrectionShiftForCircle(std::vector<WPoint2> const& curve, Point* shift) {
  if (curve.size() < 3) return false;
  // Weighted least squares of dev = dr + sy * uy + sx * ux. Sums are named after their factors: g
  // the weight, u the unit direction, dev the deviation.
  double gUy = 0.0;
  double gUx = 0.0;
  double gUyUy = 0.0;
  double gUxUy = 0.0;
  double gUxUx = 0.0;
  double gDev = 0.0;
  double gUyDev = 0.0;
  double gUxDev = 0.0;
  for (WPoint2 const& sample : curve) {
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
  }
  // The first entry is the plain count: weights average 1.
  double matrix[9] = {static_cast<double>(curve.size()),
                      gUy,
                      gUx,  //
                      gUy,
                      gUyUy,
                      gUxUy,  //
                      gUx,
                      gUxUy,
                      gUxUx};
  double rhs[3] = {gDev, gUyDev, gUxDev};
  double solution[3];
  if (!MathUtils::LinearEquationSystemSolve(3, matrix, rhs, solution)) return false;
  double const sy = solution[1];
  double const sx = solution[2];
  // Deliberate: by way of length and angle, though it only gives back (sx, sy): the rounding of
  // this route is part of every fitted circle.
  double const length = std::sqrt(sx * sx + sy * sy);
  double const angle = -std::atan2(sx, sy) + Numeric::kTruncatedHalfPi;
  *shift = {std::cos(angle) * length, std::sin(angle) * length};
  return true;
}

double GeometryUtils::GetMaxObtainedDeviation(std::vector<WPoint> const& points, std::int32_t first,
                                              std::int32_t count, Point const& center,
                                              double radius, std::int32_t* index) {
  *index = -1;
  double largest = -1.0;
  if (!Fitting::HoldsRun(points, first, count)) return largest;
  for (std::int32_t i = 0; i < count; ++i) {
    double const deviation =
        std::fabs(radius - std::sqrt(GetDist2(ToPoint(At(points, first + i)), center)));
    if (i == 0 || deviation > largest) {
      largest = deviation;
      *index = i;
    }
  }
  return largest;
}

bool GeometryUtils::GetMaxObtainedDeviation(std::vector<WPoint> const& points, std::int32_t first,
                                            std::int32_t count, Point const& center, double radius,
                                            double* minSigned, double* maxSigned) {
  double smallest = -1.0;
  double largest = -1.0;
  if (Fitting::HoldsRun(points, first, count)) {
    for (std::int32_t i = 0; i < count; ++i) {
      double const deviation = radius - std::sqrt(GetDist2(ToPoint(At(points, first + i)), center));
      if (i == 0 || deviation < smallest) smallest = deviation;
      if (i == 0 || deviation > largest) largest = deviation;
    }
  }
  *minSigned = smallest;
  *maxSigned = largest;
  return true;
}

}  // namespace Vorn
