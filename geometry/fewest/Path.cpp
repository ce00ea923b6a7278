#include "geometry/fewest/Path.h"

#include <algorithm>
#include <cmath>

#include "geometry/fewest/Gates.h"

namespace Vorn::Fewest {

namespace {

Place Direction(WPoint const& p, WPoint const& q) {
  double const dx = q.x - p.x;
  double const dy = q.y - p.y;
  double const length = std::sqrt(dx * dx + dy * dy);
  return length > 0.0 ? Place{dx / length, dy / length} : Place{0.0, 0.0};
}

Place LeftOf(Place const& direction) { return {-direction.y, direction.x}; }

}  // namespace

double DistanceBetween(WPoint const& p, WPoint const& q) {
  double const dx = q.x - p.x;
  double const dy = q.y - p.y;
  return std::sqrt(dx * dx + dy * dy);
}

Gate MiddleGate(Path const& path, std::int32_t split) {
  WPoint const& before = path.At(split - 1);
  WPoint const& behind = path.At(split);
  Place direction = Direction(before, behind);
  if (direction.x == 0.0 && direction.y == 0.0) direction = {1.0, 0.0};
  double const room = 0.5 * DistanceBetween(before, behind) + 2.0 * std::max(before.w, behind.w);
  return {split,
          {0.5 * (before.x + behind.x), 0.5 * (before.y + behind.y)},
          LeftOf(direction),
          -room,
          room};
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
