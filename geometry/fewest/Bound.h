#pragma once

#include <cstdint>
#include <functional>
#include <span>
#include <vector>

#include "geometry/fewest/Circle.h"
#include "geometry/fewest/Limits.h"
#include "vorn/Types.h"

/// How few circles and lines can cover the points, joined or not.
namespace Vorn::Fewest {

/// The greedy cover: each run is the longest that one circle or line covers. Leaving points out of
/// a run never makes it harder to cover, so no other cover by runs has fewer.
struct Cover {
  /// The first point of each run.
  std::vector<std::int32_t> starts;
  /// A normalised circle or line that covers the last run, unless this has three points or fewer.
  PlacedCircle last;
};

/// Covers the points one run after the other; each end is proven. `tell` hears how many points are
/// covered. O(n log n) where runs are long because they follow one arc.
Cover CoverGreedily(std::span<WPoint const> points, Limits const& limits,
                    std::function<void(std::int32_t)> const& tell);

/// The same where no more than `most` runs are enough; no starts where they are not.
Cover CoverWithin(std::size_t most, std::span<WPoint const> points, Limits const& limits);

}  // namespace Vorn::Fewest
