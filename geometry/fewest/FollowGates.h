#pragma once

#include "geometry/fewest/BackwardPass.h"
#include "geometry/fewest/Path.h"

/// Chains along gates that are known.
namespace Vorn::Fewest {

/// The pieces for the gates of a chain: forwards the intervals, backwards the pieces of the
/// smallest largest ratio. Empty when the gates do not allow the share.
Chain FollowGates(Path const& path, double share, Chain const& known);

/// The same where gates may go back to others: from the first gate of `known` that no piece reaches
/// as few as possible of those before it, and the gate itself, are taken from `safe`. Both have as
/// many gates, and those of `known` lie between their neighbours of `safe`.
Chain FollowGatesOr(Path const& path, double share, Chain const& known, Chain const& safe);

}  // namespace Vorn::Fewest
