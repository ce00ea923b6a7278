#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "geometry/fewest/Circle.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Spacing.h"

/// The order of the points of a dense run along a circle, as far as their box and spacing tell it.
namespace Vorn::Fewest {

/// What is sure of all circles of some coefficients without a look at single points.
class DenseOrder {
 public:
  /// The circle in the local coordinates of a frame, the run in those of the path.
  DenseOrder(Circle const& circle, RunSpacing const& run, LocalFrame const& frame)
      : circle_(circle),
        least_(run.leastTolerance * frame.scale),
        widest_(std::sqrt(run.widest2) * frame.scale),
        low_(GradientAt(circle, frame.ToLocal(Place{run.lowX, run.lowY}))),
        high_(GradientAt(circle, frame.ToLocal(Place{run.highX, run.highY}))) {}

  /// Whether no point lies back along the circle by more than `noise` times the sum of its
  /// tolerance and that of the one before. An advance is at most the gradient times the distance.
  bool IsInOrder(double noise) const {
    double const x = std::max(std::fabs(low_.x), std::fabs(high_.x));
    double const y = std::max(std::fabs(low_.y), std::fabs(high_.y));
    return std::sqrt(x * x + y * y) * widest_ <= 2.0 * noise * least_;
  }

  /// Whether no step between neighbours along the circle has a sine of its half above a limit.
  /// Neighbours within their tolerances make no step; otherwise it is the largest where the
  /// gradient, the distance from the centre in radii, is least.
  bool HasSmallSteps(double sineOfHalf) const {
    double const x = low_.x * high_.x > 0.0 ? std::min(std::fabs(low_.x), std::fabs(high_.x)) : 0.0;
    double const y = low_.y * high_.y > 0.0 ? std::min(std::fabs(low_.y), std::fabs(high_.y)) : 0.0;
    return widest_ <= least_ ||
           std::fabs(circle_.a) * widest_ <= sineOfHalf * std::sqrt(x * x + y * y);
  }

  /// A number of neighbours within a quarter of a radian of the circle, at least 1.
  std::int32_t Stride() const {
    constexpr double kMost = 65536.0;
    double const angle = 2.0 * std::fabs(circle_.a) * widest_;
    return static_cast<std::int32_t>(std::clamp(0.25 / angle, 1.0, kMost));
  }

 private:
  Circle circle_;
  double least_;
  double widest_;
  // The gradient at two corners of the box: each component is linear in one of x and y.
  Place low_;
  Place high_;
};

}  // namespace Vorn::Fewest
