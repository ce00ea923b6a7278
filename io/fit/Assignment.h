#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "vorn/io/FitReport.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// Deals the points out to the pieces in the order of both, with the least sum of squared
/// relative distances; a point at a joint goes to the earlier piece when both are as near.
///
/// Nothing when points times pieces is beyond what is worth the time and memory.
std::optional<std::vector<PointRange>> AssignPoints(std::vector<WPoint> const& points,
                                                    std::vector<Piece> const& pieces);

}  // namespace Vorn::IO
