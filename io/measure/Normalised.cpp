#include "io/measure/Normalised.h"

#include <algorithm>
#include <cmath>

namespace Vorn::IO {

namespace {

/// The differences from the first point are exact or nearly so; the points themselves may be so far
/// from the origin that their sum has no digits left for them.
XY MeanOf(std::vector<XY> const& points) {
  XY const& first = points.front();
  auto const count = static_cast<double>(points.size());
  XY sum;
  for (XY const& point : points) {
    sum.x += (point.x - first.x) / count;
    sum.y += (point.y - first.y) / count;
  }
  return {first.x + sum.x, first.y + sum.y};
}

}  // namespace

std::optional<Normalised> Normalise(std::vector<XY> const& points) {
  if (points.empty()) return {};
  Normalised normalised;
  normalised.mean = MeanOf(points);
  for (XY const& point : points) {
    XY const at{point.x - normalised.mean.x, point.y - normalised.mean.y};
    if (!std::isfinite(at.x) || !std::isfinite(at.y)) return {};
    normalised.size = std::max({normalised.size, std::fabs(at.x), std::fabs(at.y)});
    normalised.at.push_back(at);
  }
  if (!(normalised.size > 0.0)) return {};
  for (XY& at : normalised.at) at = {at.x / normalised.size, at.y / normalised.size};
  return normalised;
}

}  // namespace Vorn::IO
