// A run grows by the circle found last: as long as it holds, the run reaches as far as the circle.
// Where it fails, the run is tried twice as long; what cannot be covered narrows the search. Only
// the last failure, one point beyond the run, is proven.

#include "geometry/fewest/Bound.h"

#include <algorithm>

#include "geometry/fewest/Growth.h"

namespace Vorn::Fewest {

namespace {

/// Covers the points until `goesOn`, which hears how many are covered, says no.
Cover CoverWhile(std::span<WPoint const> points, Limits const& limits,
                 std::function<bool(Cover const&, std::int32_t)> const& goesOn) {
  Cover cover;
  auto const count = static_cast<std::int32_t>(points.size());
  FreeRun run(points, limits);
  std::int32_t expected = 8;
  for (std::int32_t start = 0; start < count && goesOn(cover, start);) {
    cover.starts.push_back(start);
    std::int32_t const end = run.FindEnd(start, expected);
    expected = end - start;
    start = end;
  }
  cover.last = run.Covering();
  return cover;
}

}  // namespace

Cover CoverGreedily(std::span<WPoint const> points, Limits const& limits,
                    std::function<void(std::int32_t)> const& tell) {
  Cover cover = CoverWhile(points, limits, [&](Cover const&, std::int32_t covered) {
    if (covered > 0) tell(covered);
    return true;
  });
  tell(static_cast<std::int32_t>(points.size()));
  return cover;
}

Cover CoverWithin(std::size_t most, std::span<WPoint const> points, Limits const& limits) {
  bool isEnough = true;
  Cover cover = CoverWhile(points, limits, [&](Cover const& runs, std::int32_t) {
    isEnough = runs.starts.size() < most;
    return isEnough;
  });
  if (!isEnough) cover.starts.clear();
  return cover;
}

}  // namespace Vorn::Fewest
