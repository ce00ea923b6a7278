#include "geometry/fewest/BareRun.h"

#include <algorithm>

#include "geometry/fewest/JointRoom.h"

namespace Vorn::Fewest {

namespace {

/// Sine of half the greatest turn, of 4 degrees. With less, measured contours take a piece or two
/// more here and there; with more, the sides of polygons begin to bulge.
constexpr double kSineOfHalfTurn = 0.0697564737441253;

}  // namespace

double LeastRadiusOfBareRun(Path const& path, std::int32_t first, std::int32_t end) {
  bool const isOne = end - first == 1;
  if (!isOne && end - first != 2) return 0.0;
  std::int32_t const from = isOne ? std::max(first, 1) : first + 1;
  std::int32_t const to = isOne ? std::min(end, path.Count() - 1) : first + 1;
  double widest = 0.0;
  for (std::int32_t split = from; split <= to; ++split) {
    if (!IsWideGap(path, split)) return 0.0;
    widest = std::max(widest, DistanceBetween(path.At(split - 1), path.At(split)));
  }
  // The chord of a turn of angle s on a radius r is 2 r sin(s / 2).
  return 0.5 * widest / kSineOfHalfTurn;
}

}  // namespace Vorn::Fewest
