#pragma once

#include <optional>
#include <vector>

#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// Points in coordinates that computing is at ease with: taken from their mean, in units of the
/// largest coordinate then left. Sums of squares neither overflow nor lose digits to an offset.
struct Normalised {
  XY mean;             ///< in the coordinates of the contour
  double size = 0.0;   ///< what is 1 in the new ones; above 0 and finite
  std::vector<XY> at;  ///< the points in the new ones
};

/// Nothing without two different points or when a difference of coordinates is not finite.
std::optional<Normalised> Normalise(std::vector<XY> const& points);

}  // namespace Vorn::IO
