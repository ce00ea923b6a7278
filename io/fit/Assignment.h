#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "io/pieces/Pieces.h"
#include "vorn/Types.h"

namespace Vorn::IO {

/// The stretch of points that one piece stands for. The fit does not tell, so it is found again.
/// On a closed contour it may run past the last point and on from the first.
struct PointRange {
  std::size_t first = 0;
  std::size_t count = 0;
};

/// Deals the points out to the pieces in the order of both, with the least sum of squared
/// relative distances; a point at a joint goes to the earlier piece when both are as near.
///
/// Nothing when points times pieces is beyond what is worth the time and memory.
std::optional<std::vector<PointRange>> AssignPoints(std::vector<WPoint> const& points,
                                                    std::vector<Piece> const& pieces);

}  // namespace Vorn::IO
