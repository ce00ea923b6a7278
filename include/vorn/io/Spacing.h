#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

/// Two neighbours too close to each other for their tolerances.
struct ClosePair {
  std::size_t first = 0;   ///< index of the earlier point
  std::size_t second = 0;  ///< of a closed contour this may be the first point of the file
  double distance = 0.0;   ///< between the two
  double needed = 0.0;     ///< the distance must be above this
};

/// The distance of two points.
VORN_IO_EXPORT double Distance(WPoint const& a, WPoint const& b);

/// What the distance of two neighbours must be above: 1.5 times the sum of their tolerances.
VORN_IO_EXPORT double NeededDistance(WPoint const& a, WPoint const& b);

/// Whether two neighbours are not further apart than that; see FindClosePair.
VORN_IO_EXPORT bool AreTooClose(WPoint const& a, WPoint const& b);

/// The first pair of neighbours that is not further apart than 1.5 times the sum of its
/// tolerances. The test is made on squares, as the library makes it, so both agree to the last
/// bit.
VORN_IO_EXPORT std::optional<ClosePair> FindClosePair(std::vector<WPoint> const& points);

/// The largest tolerance, of six digits at most, with which every pair passes when all points
/// have it; nothing when neighbours coincide.
VORN_IO_EXPORT std::optional<double> LargestSingleTolerance(std::vector<WPoint> const& points);

/// What the user needs to know about the pair, in two lines; the file is not named.
///
/// @param largest what LargestSingleTolerance says of the same points
VORN_IO_EXPORT std::string DescribeClosePair(PointFile const& file, ClosePair const& pair,
                                             std::optional<double> largest);

}  // namespace Vorn::IO
