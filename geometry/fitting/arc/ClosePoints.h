// Points that lie too close together for a common tolerance.

#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/fitting/arc/CircleEstimate.h"

namespace Vorn::Fitting {

/// The indices of the points to leave out, ascending, for kept neighbours to stay apart at the
/// estimated tolerance; empty when all points do. The first point is kept. The last one is kept
/// when it stays apart, when no other point is left out (the one before it then goes), and when it
/// is close to its neighbour but not to the point that is measured in its place. Nothing when
/// fewer than 3 points would be left. O(n).
std::optional<std::vector<std::int32_t>> FindClosePoints(std::vector<WPoint> const& points,
                                                         ToleranceEstimate const& estimate);

}  // namespace Vorn::Fitting
