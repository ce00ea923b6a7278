#include "geometry/fewest/ClosedBound.h"

#include <algorithm>
#include <cstdint>
#include <vector>

#include "geometry/fewest/Growth.h"

namespace Vorn::Fewest {

namespace {

/// Walks around the contour after which the search for a shorter cover gives up.
constexpr int kMostWalks = 256;

/// Longest runs on a closed path, whose points come twice in a row so that runs may lead across the
/// end of the input.
class ClosedRuns {
 public:
  ClosedRuns(std::span<WPoint const> points, Limits const& limits, Cover const& open)
      : count_(static_cast<std::int32_t>(points.size())),
        twice_(Twice(points)),
        ends_(points.size(), kUnknown),
        run_(twice_, limits) {
    for (std::size_t k = 0; k + 1 < open.starts.size(); ++k) {
      ends_[static_cast<std::size_t>(open.starts[k])] = open.starts[k + 1];
    }
  }

  /// Where some longest runs one after the other end, the first of which starts at a point.
  std::int32_t Walk(std::int32_t start, std::size_t runs) {
    std::int32_t at = start;
    for (; runs > 0 && at < start + count_; --runs) at = EndOf(at);
    return at;
  }

 private:
  static constexpr std::int32_t kUnknown = -1;

  static std::vector<WPoint> Twice(std::span<WPoint const> points) {
    std::vector<WPoint> twice;
    twice.reserve(2 * points.size());
    for (int lap = 0; lap < 2; ++lap) twice.insert(twice.end(), points.begin(), points.end());
    return twice;
  }

  /// Of a start on the second lap the run is that on the first, one turn farther.
  std::int32_t EndOf(std::int32_t start) {
    std::int32_t const lap = start >= count_ ? count_ : 0;
    std::int32_t& end = ends_[static_cast<std::size_t>(start - lap)];
    if (end == kUnknown) {
      end = run_.FindEnd(start - lap, expected_);
      expected_ = end - (start - lap);
    }
    return end + lap;
  }

  std::int32_t count_;
  std::vector<WPoint> twice_;
  std::vector<std::int32_t> ends_;
  FreeRun run_;
  std::int32_t expected_ = 8;
};

/// The number of the shortest longest run of a cover; the last one may end where the input does.
std::size_t ShortestRun(Cover const& cover) {
  std::size_t shortest = 0;
  for (std::size_t k = 1; k + 1 < cover.starts.size(); ++k) {
    if (cover.starts[k + 1] - cover.starts[k] <
        cover.starts[shortest + 1] - cover.starts[shortest]) {
      shortest = k;
    }
  }
  return shortest;
}

}  // namespace

std::size_t LeastClosedCover(std::span<WPoint const> points, Limits const& limits,
                             Cover const& open) {
  std::size_t const runs = open.starts.size();
  if (runs <= kLeastClosedPieces) return kLeastClosedPieces;
  auto const turn = static_cast<std::int32_t>(points.size());
  std::size_t const k = ShortestRun(open);
  ClosedRuns closed(points, limits, open);
  std::int32_t start = open.starts[k + 1];
  for (int walk = 0; walk < kMostWalks; ++walk) {
    std::int32_t const end = closed.Walk(start, runs - 1);
    if (end >= start + turn) return runs - 1;
    start = std::min(start - 1, end - turn);
    if (start <= open.starts[k]) return runs;
  }
  return runs - 1;
}

}  // namespace Vorn::Fewest
