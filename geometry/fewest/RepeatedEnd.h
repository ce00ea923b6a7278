#pragma once

#include <cstdint>
#include <vector>

#include "vorn/FewestPieces.h"
#include "vorn/Types.h"

/// Closed contours whose last point repeats the first.
namespace Vorn::Fewest {

/// The points of a closed contour with one point in place of two at the seam, which a joint between
/// the two would only keep apart: that of the smaller tolerance stays.
class RepeatedEnd {
 public:
  /// The points have to outlive this.
  explicit RepeatedEnd(std::vector<WPoint> const& points);

  /// Whether the last point lies exactly where the first does.
  bool IsRepeated() const;
  /// The points without the one of the two that is left out.
  std::vector<WPoint> Distinct() const;
  /// Turns a result for the distinct points into one for all: the piece of the one point covers
  /// both.
  void Restore(FewestPieces::Result* result) const;

 private:
  bool LeavesFirstOut() const { return points_.back().w < points_.front().w; }
  std::int32_t Last() const { return static_cast<std::int32_t>(points_.size()) - 1; }

  std::vector<WPoint> const& points_;
};

}  // namespace Vorn::Fewest
