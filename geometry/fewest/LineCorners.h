#pragma once

#include <vector>

#include "geometry/fewest/Assembly.h"
#include "geometry/fewest/BackwardPass.h"
#include "geometry/fewest/Path.h"

/// Corners between segments.
namespace Vorn::Fewest {

/// Moves the joints between neighbouring segments to where the regression lines of their points
/// cross, or to a point beside the joint, wherever the points then deviate less: the corners of a
/// part that was measured, or drawn, exactly come out exactly. No point deviates more than the
/// worst one of the two segments did. The first and the last piece of a closed path share a joint
/// too. O(n).
void SharpenCorners(Path const& path, Chain const& chain, std::vector<BuiltPiece>* pieces);

}  // namespace Vorn::Fewest
