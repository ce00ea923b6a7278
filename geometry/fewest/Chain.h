#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>

#include "geometry/fewest/BackwardPass.h"
#include "geometry/fewest/Path.h"

/// The chain of the fewest pieces: forwards the offsets that can be reached on gates, backwards the
/// pieces.
namespace Vorn::Fewest {

/// Searches a chain over the whole path; empty when none was found. `tell` hears how many points
/// are covered.
Chain FindChain(Path const& path, double share, std::function<void(std::int32_t)> const& tell);

/// Whether a search goes on: asked after each piece with the number of pieces so far and of the
/// points from the first on that they cover.
using GoesOn = std::function<bool(std::size_t pieces, std::int32_t covered)>;

/// As FindChain(), but empty as soon as the search is not to go on.
Chain FindChainWhile(Path const& path, double share, GoesOn const& goesOn);

}  // namespace Vorn::Fewest
