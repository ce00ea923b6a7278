#include "geometry/fewest/Polyline.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>

#include "geometry/fewest/Assembly.h"

namespace Vorn::Fewest {

namespace {

/// Share of a tolerance that is left to the rounding of what is measured.
constexpr double kTolerance = 1.0 - 1e-6;

class Follower {
 public:
  Follower(std::vector<WPoint> const& points, std::vector<char> const& isJoint)
      : points_(points), isJoint_(isJoint) {}

  /// The point at which the segment from a point ends; the number of points where there is none.
  std::int32_t FindEnd(std::int32_t from) const {
    auto const count = static_cast<std::int32_t>(points_.size());
    std::int32_t good = from + 1;
    while (good < count && !IsCovered(from, good)) ++good;
    if (good == count) return count;
    for (std::int32_t step = 1; step > 0;) {
      bool const isFarther = good + step < count && IsCovered(from, good + step);
      if (isFarther) good += step;
      step = isFarther ? 2 * step : step / 2;
    }
    return good;
  }

  GeometryUtils::Point At(std::int32_t i) const {
    WPoint const& p = points_[static_cast<std::size_t>(i)];
    return {p.x, p.y};
  }

 private:
  /// Whether a segment passes the points between its ends within their tolerances and in order.
  bool IsCovered(std::int32_t from, std::int32_t to) const {
    GeometryUtils::Point const start = At(from);
    GeometryUtils::Point const end = At(to);
    double const dx = end.x - start.x;
    double const dy = end.y - start.y;
    if (dx == 0.0 && dy == 0.0) return false;
    BuiltPiece const segment = BuildSegment(start, end);
    double farthest = 0.0;
    for (std::int32_t i = from + 1; i < to; ++i) {
      WPoint const& p = points_[static_cast<std::size_t>(i)];
      double const along = (p.x - start.x) * dx + (p.y - start.y) * dy;
      bool const isStart = p.x == start.x && p.y == start.y;
      if (isJoint_[static_cast<std::size_t>(i)] != 0 && !isStart) return false;
      if (along < farthest || !(DistanceToPiece(segment, p) <= kTolerance * p.w)) return false;
      farthest = along;
    }
    return farthest <= dx * dx + dy * dy;
  }

  std::vector<WPoint> const& points_;
  std::vector<char> const& isJoint_;
};

}  // namespace

Answer FollowPoints(std::vector<WPoint> const& points, bool isClosed,
                    std::vector<char> const& isJoint) {
  Follower const follower(points, isJoint);
  auto const count = static_cast<std::int32_t>(points.size());
  Answer answer;
  answer.contour.push_back(BuildSegment({}, follower.At(0)).elem);
  std::int32_t from = 0;
  for (std::int32_t to = follower.FindEnd(0); to < count; to = follower.FindEnd(from)) {
    answer.contour.push_back(BuildSegment(follower.At(from), follower.At(to)).elem);
    answer.ranges.push_back({from, to - 1});
    from = to;
  }
  // The points that repeat the end of the last segment belong to it.
  if (answer.ranges.empty()) return answer;
  answer.ranges.back().last = count - 1;
  if (isClosed) AppendClosingSegment(&answer);
  return answer;
}

}  // namespace Vorn::Fewest
