#pragma once

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

}  // namespace Vorn::Fewest
