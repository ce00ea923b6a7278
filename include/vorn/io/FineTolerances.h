#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"
#include "vorn/io/Strategy.h"

namespace Vorn::IO {

/// A tolerance below this part of the points' extent is fine. The strategies with cells solve for
/// lines and circles in doubles, which leaves some eight digits for the place of a piece: below,
/// even exactly straight points fall apart into pieces of a few points, each of them tried at every
/// length. 1,000 points 1 apart on a line take 0.03 ms a point with a tolerance of 1e-4 and 30 ms
/// with one of 1e-9.
inline constexpr double kFineTolerance = 1e-8;

/// A tolerance that is fine for the extent of the points.
struct FineTolerance {
  std::size_t point =
      0;                ///< index of the point with the smallest tolerance, the first of equal ones
  double extent = 0.0;  ///< the longer side of the points' bounding box
};

/// Whether a strategy becomes slow, and its contours fall apart, where tolerances are fine. The
/// fewest pieces and the single arc do not.
VORN_IO_EXPORT bool SuffersFromFineTolerances(Strategy strategy);

/// The smallest tolerance, if it is less than kFineTolerance times the extent of the points.
/// Nothing without points and where a coordinate or a tolerance is not a number. O(n).
VORN_IO_EXPORT std::optional<FineTolerance> FindFineTolerance(std::vector<WPoint> const& points);

}  // namespace Vorn::IO
