#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <span>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Circuit.h"

/// The search of the chain from both ends of the path.
namespace Vorn::Fewest {

/// The path from its last point to its first; both ends have to be free.
Path Reversed(Path const& path);

/// A chain of a reversed path as a chain of the path itself, which has `count` points. Its own
/// inverse.
Chain Reversed(Chain const& chain, std::int32_t count);

/// The same for a circuit of a reversed path.
Circuit Reversed(Circuit const& circuit, std::int32_t count);

/// How many runs of the greedy cover it takes to cover so many points from the first on, which is
/// the least number of pieces for them.
std::size_t CountRuns(std::span<std::int32_t const> runStarts, std::int32_t points);

/// Searches a chain over an open path forwards and, where it has more pieces than the greedy cover
/// has runs, backwards: gates are laid from the end of the piece before, so that one direction may
/// find a joint that the other misses. The search backwards ends where the points that are left
/// need so many runs that no shorter chain can come of it. The shorter chain, the one found
/// forwards of equal ones; empty when none was found.
///
/// @param[in] runStarts the first point of each run of the greedy cover of the path, or of a path
///                      with tolerances at least as large
/// @param[in] tell      hears how many points are covered forwards
Chain FindChainBothWays(Path const& path, double share, std::span<std::int32_t const> runStarts,
                        std::function<void(std::int32_t)> const& tell);

}  // namespace Vorn::Fewest
