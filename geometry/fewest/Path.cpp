#include "geometry/fewest/Path.h"

#include <algorithm>
#include <cmath>

#include "geometry/fewest/Gates.h"
#include "geometry/fewest/JointRoom.h"

namespace Vorn::Fewest {

namespace {

Place Direction(WPoint const& p, WPoint const& q) {
  double const dx = q.x - p.x;
  double const dy = q.y - p.y;
  double const length = std::sqrt(dx * dx + dy * dy);
  return length > 0.0 ? Place{dx / length, dy / length} : Place{0.0, 0.0};
}

Place LeftOf(Place const& direction) { return {-direction.y, direction.x}; }

/// Points farther apart than this many times the sum of their tolerances lie in order.
constexpr double kClearlyAhead = 1.5;

}  // namespace

void Wrap(Path* path) {
  path->before = {};
  path->behind = {};
  for (std::int32_t i = 0; i < std::min(2, path->Count()); ++i) {
    path->before.Add(path->At(path->Count() - 1 - i));
    path->behind.Add(path->At(i));
  }
}

double DistanceBetween(WPoint const& p, WPoint const& q) {
  double const dx = q.x - p.x;
  double const dy = q.y - p.y;
  return std::sqrt(dx * dx + dy * dy);
}

WPoint const& Tightest(std::vector<WPoint> const& points) {
  return *std::min_element(points.begin(), points.end(),
                           [](WPoint const& p, WPoint const& q) { return p.w < q.w; });
}

double AdvanceAlong(Path const& path, PlacedCircle const& circle, std::int32_t first,
                    std::int32_t last, std::int32_t step) {
  double advance = 0.0;
  for (std::int32_t i = first; i + 1 < last; i += step) {
    WPoint const& p = path.At(i);
    WPoint const& q = path.At(std::min(i + step, last - 1));
    Place const gradient = GradientAt(circle, {p.x, p.y});
    advance += gradient.y * (q.x - p.x) - gradient.x * (q.y - p.y);
  }
  return advance;
}

std::int32_t StrideFrom(Path const& path, std::int32_t point) {
  WPoint const& from = path.At(point);
  std::int32_t const count = path.Count();
  std::int32_t i = point + 1;
  while (i < count &&
         DistanceBetween(from, path.At(i)) <= kClearlyAhead * (from.w + path.At(i).w)) {
    ++i;
  }
  return i - point;
}

namespace {

/// The mean of as many points before a split as behind it, up to a quarter of a stride each.
Place MeanAround(Path const& path, std::int32_t split) {
  std::int32_t const quarter = std::max(1, StrideFrom(path, split) / 4);
  std::int32_t const reach = std::min({quarter, split, path.Count() - split});
  WPoint const& origin = path.At(split);
  Place sum;
  for (std::int32_t i = split - reach; i < split + reach; ++i) {
    sum.x += path.At(i).x - origin.x;
    sum.y += path.At(i).y - origin.y;
  }
  double const share = 0.5 / reach;
  return {origin.x + share * sum.x, origin.y + share * sum.y};
}

}  // namespace

Gate MiddleGate(Path const& path, std::int32_t split, PlacedCircle const& before) {
  WPoint const& last = path.At(split - 1);
  WPoint const& first = path.At(split);
  Gate gate;
  gate.split = split;
  gate.origin = {0.5 * (last.x + first.x), 0.5 * (last.y + first.y)};
  double const gap = DistanceBetween(last, first);
  double const half = path.limits.jointRoom * 0.5 * gap + 2.0 * std::max(last.w, first.w);
  JointRoom const room = RoomForJoint(path, split);
  gate.greatest = std::min(half, room.left);
  gate.least = -std::min(half, room.right);
  if (gap > kClearlyAhead * (last.w + first.w)) {
    gate.across = LeftNormal(last, first);
  } else {
    gate.origin = MeanAround(path, split);
    Place const normal = GradientAt(before, gate.origin);
    gate.across = BisectorGate(gate.origin, normal, normal).across;
  }
  return gate;
}

Gate BisectorGate(Place const& place, Place const& normalIn, Place const& normalOut) {
  // Beyond 120 degrees the bisector runs nearly along the path, and the bisector of the outer angle
  // takes its place.
  bool const isCusp = normalIn.x * normalOut.x + normalIn.y * normalOut.y < -0.5;
  double const sign = isCusp ? -1.0 : 1.0;
  Place across{normalIn.x + sign * normalOut.x, normalIn.y + sign * normalOut.y};
  double const length = std::sqrt(across.x * across.x + across.y * across.y);
  across = length > 0.0 ? Place{across.x / length, across.y / length} : Place{0.0, 1.0};
  Gate gate;
  gate.origin = place;
  gate.across = across;
  gate.isCusp = isCusp;
  return gate;
}

Place LeftNormal(WPoint const& from, WPoint const& to) { return LeftOf(Direction(from, to)); }

}  // namespace Vorn::Fewest
