#pragma once

#include <cstdint>
#include <vector>

#include "geometry/fewest/Path.h"

/// How points lie to their neighbours, for long runs at once.
namespace Vorn::Fewest {

/// What the points of a run have in common.
struct RunSpacing {
  double widest2 = 0.0;  ///< the square of the largest distance between neighbours
  double leastTolerance = 0.0;
  double lowX = 0.0;  ///< the box of the points
  double highX = 0.0;
  double lowY = 0.0;
  double highY = 0.0;
};

/// Answers for runs of one path. What it finds of blocks of points is kept, so that each point is
/// looked at about once however many runs are asked for.
class Spacing {
 public:
  /// Reads the path in place; its points must not change.
  explicit Spacing(Path const& path) : path_(path) {}

  /// Of the points [first, end), one at least. O(n / kBlock + kBlock) for n points, but for blocks
  /// that are new.
  RunSpacing Of(std::int32_t first, std::int32_t end);
  /// Only the square of the largest distance between neighbours; 0 for no points.
  double WidestGap2(std::int32_t first, std::int32_t end);

 private:
  static constexpr std::int32_t kBlock = 64;

  /// Of the points [first, end); the gap before the first one counts, unless it begins the run.
  RunSpacing Scan(std::int32_t first, std::int32_t end, bool isBeginning) const;
  /// Of a whole block with the gap before it.
  RunSpacing const& OfBlock(std::int32_t block);

  Path const& path_;
  std::vector<RunSpacing> blocks_;
};

}  // namespace Vorn::Fewest
