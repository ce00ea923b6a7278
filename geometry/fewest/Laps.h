#pragma once

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Path.h"

/// Paths that run along one circle for more than a turn.
namespace Vorn::Fewest {

/// A chain with the places where it begins and ends: free ones of an open path.
struct Laps {
  Chain chain;
  Opening start;
  Opening finish;
};

/// Arcs of equal turns, as few as stay below a full one, for a path of which `covering` passes all
/// points within tolerance. Those of an open path wind outwards by a small share of what the
/// tolerances leave, so that no lap meets another; those of a closed one lie on one circle. Empty
/// where the path turns by less than about a full turn; what the chain promises has to be measured.
Laps WindLaps(Path const& path, PlacedCircle const& covering, bool isClosed);

}  // namespace Vorn::Fewest
