#pragma once

#include <array>
#include <cstdint>

#include "geometry/fewest/Columns.h"
#include "geometry/fewest/Programme.h"

/// Partial pricing: the rows that are likely to be broken next.
namespace Vorn::Fewest {

/// Point rows that circles broke on the way to an optimum. The circles that follow mostly break one
/// of them again, so that all rows of a long run need to be looked at only when these are met.
class Candidates {
 public:
  /// Whether a programme has so many rows that candidates pay.
  static bool ArePaying(Programme const& programme) {
    return programme.last - programme.first >= kLongRun;
  }

  /// Forgets all candidates.
  void Clear() { count_ = 0; }
  /// The candidate that a circle breaks most; index -1 when there is none. O(1).
  Columns::Worst FindWorst(Programme const& programme, Circle const& circle) const;
  /// The row of all points that a circle breaks most. The worst of each of several parts of the run
  /// become candidates where they exceed a limit. O(n).
  Columns::Worst FindWorstOfAll(Programme const& programme, Circle const& circle, double limit);

 private:
  static constexpr std::int32_t kLongRun = 512;
  static constexpr std::int32_t kParts = 16;
  static constexpr std::int32_t kMost = 2 * kParts;

  /// Takes a row in, in place of the oldest when there is no room.
  void Add(std::int32_t index);

  std::int32_t count_ = 0;
  std::int32_t next_ = 0;
  std::array<std::int32_t, kMost> indices_;
};

}  // namespace Vorn::Fewest
