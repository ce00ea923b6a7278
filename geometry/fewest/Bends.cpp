#include "geometry/fewest/Bends.h"

#include <algorithm>

namespace Vorn::Fewest {

namespace {

/// Share by which rounding may change what is compared; of coordinates that tell tolerances apart
/// it changes far less.
constexpr double kBeyondRounding = 1.001;

}  // namespace

bool IsBent(std::span<WPoint const> points, std::int32_t first, std::int32_t end) {
  WPoint const& a = points[static_cast<std::size_t>(first)];
  WPoint const& b = points[static_cast<std::size_t>(end - 1)];
  std::int32_t const middle = first + (end - first) / 2;
  WPoint const& m = points[static_cast<std::size_t>(middle)];
  double const dx = b.x - a.x;
  double const dy = b.y - a.y;
  double const along = dx * (m.x - a.x) + dy * (m.y - a.y);
  double const length2 = dx * dx + dy * dy;
  if (!(along >= 0.0 && along <= length2)) return false;
  // A line that covers all three passes the middle one within its tolerance and the chord beside it
  // within the larger of the other two, both measured square to the line. It is turned from the
  // chord by no more than the two allow over its length, so that square to the chord the middle is
  // within the sum divided by the cosine of that turn.
  double const across = dx * (m.y - a.y) - dy * (m.x - a.x);
  double const reach = kBeyondRounding * (a.w + b.w + m.w);
  double const turned2 = (a.w + b.w) * (a.w + b.w);
  return length2 > turned2 &&
         across * across * (length2 - turned2) > reach * reach * length2 * length2;
}

std::size_t CountBentRuns(std::span<WPoint const> points, std::size_t enough) {
  auto const count = static_cast<std::int32_t>(points.size());
  std::size_t runs = 1;
  std::int32_t first = 0;
  std::int32_t length = 3;
  while (first + length <= count && runs < enough) {
    if (IsBent(points, first, first + length)) {
      // The runs of one cover have at least one end within these points.
      ++runs;
      first += length;
      length = 3;
    } else {
      length *= 2;
    }
  }
  return runs;
}

}  // namespace Vorn::Fewest
