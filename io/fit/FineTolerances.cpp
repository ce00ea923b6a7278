#include "vorn/io/FineTolerances.h"

#include <algorithm>

namespace Vorn::IO {

namespace {

/// The distance between the least and the greatest coordinate.
double ExtentAlong(std::vector<WPoint> const& points, double WPoint::*coordinate) {
  auto const [least, greatest] = std::minmax_element(
      points.begin(), points.end(),
      [&](WPoint const& a, WPoint const& b) { return a.*coordinate < b.*coordinate; });
  return (*greatest).*coordinate - (*least).*coordinate;
}

}  // namespace

bool SuffersFromFineTolerances(Strategy strategy) {
  return strategy == Strategy::Mixed || strategy == Strategy::Cells;
}

std::optional<FineTolerance> FindFineTolerance(std::vector<WPoint> const& points) {
  if (points.empty()) return std::nullopt;
  double const extent = std::max(ExtentAlong(points, &WPoint::x), ExtentAlong(points, &WPoint::y));
  auto const finest = std::min_element(points.begin(), points.end(),
                                       [](WPoint const& a, WPoint const& b) { return a.w < b.w; });
  if (!(finest->w < kFineTolerance * extent)) return std::nullopt;
  return FineTolerance{static_cast<std::size_t>(finest - points.begin()), extent};
}

}  // namespace Vorn::IO
