// The segment that a point of a line cell stands for.

#pragma once

#include <optional>

#include "geometry/cells/FixedPoints.h"
#include "geometry/elementary/Shapes.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

/// The fixed ends of a line as points that it must pass through, in a form of its parameters.
Cells::FixedPoints PointsOfLine(Ends const& ends, bool xOfY);

/// The segment along the line of a parameter point: from the fixed start to the fixed end, with the
/// feet of the ends of `near` in the place of free ones. Nothing when such a foot cannot be found.
std::optional<Elementary::Segment> CutLine(Point const& parameters, Cells::FixedPoints const& fixed,
                                           Elementary::Segment const& near);

}  // namespace Vorn::Fitting
