#include "geometry/fewest/RepeatedEnd.h"

namespace Vorn::Fewest {

RepeatedEnd::RepeatedEnd(std::vector<WPoint> const& points) : points_(points) {}

bool RepeatedEnd::IsRepeated() const {
  WPoint const& first = points_.front();
  WPoint const& last = points_.back();
  return points_.size() > 2 && first.x == last.x && first.y == last.y;
}

std::vector<WPoint> RepeatedEnd::Distinct() const {
  return LeavesFirstOut() ? std::vector<WPoint>(points_.begin() + 1, points_.end())
                          : std::vector<WPoint>(points_.begin(), points_.end() - 1);
}

void RepeatedEnd::Restore(FewestPieces::Result* result) const {
  std::int32_t const moved = LeavesFirstOut() ? 1 : 0;
  result->largestDeviationIndex += moved;
  for (FewestPieces::Range& range : result->ranges) {
    range.first += moved;
    range.last += moved;
    if (LeavesFirstOut() && range.last == Last()) range.last = 0;
    if (!LeavesFirstOut() && range.first == 0) range.first = Last();
  }
}

}  // namespace Vorn::Fewest
