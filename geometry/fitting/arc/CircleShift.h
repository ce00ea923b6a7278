// Weighted linear least squares for a circle: the deviations of points from a trial circle, and the
// shift of its centre that explains them best (one Gauss-Newton step of the geometric circle fit).

#pragma once

#include <optional>
#include <vector>

#include "geometry/elementary/Shapes.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

/// Appends one sample for each point of a run: its offset from the trial centre, its distance from
/// the trial circle (positive outside) and its tolerance as weight. Then the weights of all
/// samples, earlier ones included, are divided by the run's mean tolerance. False, nothing
/// appended, for a run that is empty or does not exist; false, the weights left as they are, when
/// the tolerances sum up to no more than a tiny amount. O(size of curve).
bool AppendDeviationCurve(Run const& run, Elementary::Circle const& trial,
                          std::vector<WPoint2>* curve);

/// The shift of the centre that explains the deviations best, together with a change of the radius.
/// Nothing for fewer than 3 samples, a sample at the centre or a singular system. O(size of curve).
std::optional<Point> FindCentreShift(std::vector<WPoint2> const& curve);

}  // namespace Vorn::Fitting
