// A first guess of a circle from points alone, and the tolerance that suits it.

#pragma once

#include <optional>
#include <vector>

#include "geometry/elementary/Shapes.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

/// A circle through three of the points.
struct CircleEstimate {
  /// The farthest pair of points, in index order; of equal ones the first.
  Point first;
  Point last;
  /// The point whose distances from the two differ least.
  Point middle;
  /// The circle through the three; its radius is the mean of their distances from its centre.
  Elementary::Circle circle;
  /// The least distance of any two points.
  double leastSpacing = 0.0;
};

/// The circle through the farthest pair of points and the point nearest to their perpendicular
/// bisector; tolerances are not used. Nothing for fewer than 3 points or when there is no such
/// circle. The cost is that of FindSpread.
std::optional<CircleEstimate> EstimateCircle(std::vector<WPoint> const& points);

/// How much deviation to allow for a circle through three points: the sagitta of the shorter half
/// chord, at most a quarter of the radius.
double AllowedDeviation(Point const& first, Point const& middle, Point const& last, double radius);

/// Points stay apart when the tolerance reaches at most this part of their distance.
inline constexpr double kSpacingShare = 3.0;

/// A common tolerance for fitting one circle to points.
struct ToleranceEstimate {
  double tolerance = 0.0;
  Elementary::Circle circle;
  /// The greatest tolerance at which all points stay far enough apart; above it some of them must
  /// be left out.
  double greatestForAll = 0.0;
};

/// The allowance of the estimated circle. Nothing without an estimate or when two points coincide.
std::optional<ToleranceEstimate> EstimateTolerance(std::vector<WPoint> const& points);

}  // namespace Vorn::Fitting
