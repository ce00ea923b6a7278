#pragma once

#include <optional>
#include <vector>

#include "vorn/Types.h"

namespace Vorn::IO {

/// The standard deviation of the noise across the path: of what differs from point to point, not of
/// a ripple that many neighbours share. Nothing when there are too few points to tell.
///
/// For normal noise, the same in all directions, and a path that is smooth over four points, the
/// answer is within 15 % of the truth for 2000 points with noise of up to a tenth of the spacing,
/// and within 30 % for noise of up to a third. Corners, jumps and outliers do not count as long as
/// they are few. O(n).
std::optional<double> EstimateNoise(std::vector<WPoint> const& points);

}  // namespace Vorn::IO
