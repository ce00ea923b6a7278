#pragma once

#include <vector>

#include "geometry/fewest/Answer.h"
#include "vorn/Types.h"

/// Segments from measured point to measured point.
namespace Vorn::Fewest {

/// The segments that run from point to point, each as far as the points that it passes by stay
/// within their tolerances and none of them is marked in `isJoint`, which has an entry for each
/// point. Far from the fewest, but there wherever the straight path itself keeps what is promised,
/// however different the tolerances are. With every point marked it is the straight path itself,
/// which breaks no promise (see Promise::NotCrossing). A closed one ends with a segment to the
/// first point, unless the last point repeats it. Without ranges when all points are equal.
Answer FollowPoints(std::vector<WPoint> const& points, bool isClosed,
                    std::vector<char> const& isJoint);

}  // namespace Vorn::Fewest
