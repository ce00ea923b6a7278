#pragma once

#include <vector>

#include "Errors.h"
#include "Progress.h"
#include "vorn/Types.h"
#include "vorn/io/FitContour.h"

namespace Vorn::Python {

/// What there is to say of points that have no contour: in words what happened, and at which point.
///
/// A single arc is held against the circle of least squares. Of the strategies with cells the
/// shortest beginning of the points without a contour is looked for by bisection, which takes up to
/// log2(n) fits of such beginnings.
///
/// @param problem what the library says, in full for the fewest pieces
/// Needs no interpreter lock, but for what `progress` asks of it.
Problem ExplainNoFit(Problem problem, std::vector<WPoint> const& points,
                     IO::FitChoice const& choice, Progress* progress);

}  // namespace Vorn::Python
