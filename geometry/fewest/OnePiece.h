#pragma once

#include <vector>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Path.h"

/// Paths for which one circle is enough.
namespace Vorn::Fewest {

/// A circle with the sign with which the points of a path run along it.
PlacedCircle AlongPath(Path const& path, PlacedCircle const& circle);

/// Chains of one piece for an open path that `covering` passes within tolerance, the one of the
/// smallest largest ratio first. The whole tolerances count, so that points exactly at theirs are
/// covered; what the chains promise has to be measured.
std::vector<Chain> MakeOnePiece(Path const& path, PlacedCircle const& covering);

}  // namespace Vorn::Fewest
