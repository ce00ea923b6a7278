#pragma once

#include "geometry/fewest/promises/Coverage.h"
#include "geometry/fewest/promises/Promises.h"

/// The promise that no piece crosses another.
namespace Vorn::Promises {

/// Reports one violation for each pair of pieces that cross where the path through the points does
/// not. Time O(k log k) for k pieces and O(1) for each pair that comes near, apart from the points
/// that have to be looked at.
void CheckCrossings(Coverage const& coverage, Report* report);

}  // namespace Vorn::Promises
