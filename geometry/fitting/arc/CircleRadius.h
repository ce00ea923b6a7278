// A radius for a given centre, and how far points lie from a circle.

#pragma once

#include <optional>

#include "geometry/elementary/Shapes.h"
#include "geometry/fitting/arc/RadiusRange.h"
#include "geometry/fitting/runs/Deviations.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

/// The radii at which a circle about a centre passes within tolerance of a run; a negative
/// tolerance stands for each point's own. Nothing for a run that is empty or does not exist, or
/// when no radius suits all points. O(count).
std::optional<RadiusRange> FindRadiusRange(Run const& run, Point const& centre, double tolerance);

/// One radius for a centre: the middle of the range, or the mean distance of the points, weighted
/// by their own tolerances when the common one is negative. Nothing without a range, for an unknown
/// strategy, and for weights whose sum is tiny. The mean is not held inside the range. O(count).
std::optional<double> FindRadius(Run const& run, Point const& centre, double tolerance,
                                 GeometryUtils::CircleRadiusFindingStrategy strategy);

/// The largest absolute distance of a run from a circle; the index is the position within the run.
/// The default deviation for a run that is empty or does not exist. O(count).
Deviation LargestDistance(Run const& run, Elementary::Circle const& circle);

}  // namespace Vorn::Fitting
