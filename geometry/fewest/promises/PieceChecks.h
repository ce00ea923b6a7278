#pragma once

#include <cstddef>

#include "geometry/fewest/promises/Coverage.h"
#include "geometry/fewest/promises/Promises.h"

/// The promises that concern one piece, or one joint, and its points.
namespace Vorn::Promises {

/// Distances, order and steps of the points of a piece. O(points of the piece).
void CheckPoints(Coverage const& coverage, std::size_t piece, Report* report);

/// Of an arc: its numbers agree with its joints, and it stays below a full turn. O(1).
void CheckArc(Coverage const& coverage, std::size_t piece, Report* report);

/// Whether the joint behind a piece lies near the straight way between the points beside it. O(1).
void CheckJoint(Coverage const& coverage, std::size_t piece, Report* report);

/// Does a closed contour end where it begins? O(1).
void CheckClosing(Coverage const& coverage, Report* report);

}  // namespace Vorn::Promises
