#include "vorn/io/PathFacts.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <tuple>

#include "vorn/io/Spacing.h"

namespace Vorn::IO {

namespace {

double MedianOf(std::vector<double> values) {
  auto const middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
  std::nth_element(values.begin(), middle, values.end());
  if (values.size() % 2 != 0) return *middle;
  double const below = *std::max_element(values.begin(), middle);
  return below + (*middle - below) / 2.0;
}

bool AreInOnePlace(WPoint const& a, WPoint const& b) { return a.x == b.x && a.y == b.y; }

/// The indices of the points, those in one place side by side and in their own order.
std::vector<std::size_t> SortedByPlace(std::vector<WPoint> const& points) {
  std::vector<std::size_t> order(points.size());
  std::iota(order.begin(), order.end(), std::size_t{0});
  std::sort(order.begin(), order.end(), [&](std::size_t a, std::size_t b) {
    return std::tie(points[a].x, points[a].y, a) < std::tie(points[b].x, points[b].y, b);
  });
  return order;
}

}  // namespace

double PointsBox::Diagonal() const { return std::hypot(Width(), Height()); }

PointsBox BoxOf(std::vector<WPoint> const& points) {
  auto const [left, right] = std::minmax_element(
      points.begin(), points.end(), [](WPoint const& a, WPoint const& b) { return a.x < b.x; });
  auto const [bottom, top] = std::minmax_element(
      points.begin(), points.end(), [](WPoint const& a, WPoint const& b) { return a.y < b.y; });
  return {left->x, right->x, bottom->y, top->y};
}

SpacingFacts SpacingOf(std::vector<WPoint> const& points) {
  std::vector<double> distances;
  distances.reserve(points.size() - 1);
  for (std::size_t i = 1; i < points.size(); ++i) {
    distances.push_back(Distance(points[i - 1], points[i]));
  }
  // Of several extremes the first: minmax_element would answer with the last greatest one.
  auto const least = std::min_element(distances.begin(), distances.end());
  auto const most = std::max_element(distances.begin(), distances.end());
  SpacingFacts facts;
  facts.least = *least;
  facts.leastSecond = static_cast<std::size_t>(least - distances.begin()) + 1;
  facts.most = *most;
  facts.mostSecond = static_cast<std::size_t>(most - distances.begin()) + 1;
  facts.length = std::accumulate(distances.begin(), distances.end(), 0.0);
  facts.median = MedianOf(std::move(distances));
  return facts;
}

std::vector<Duplicate> FindDuplicates(std::vector<WPoint> const& points) {
  std::vector<Duplicate> duplicates;
  std::vector<std::size_t> const order = SortedByPlace(points);
  std::size_t first = 0;
  for (std::size_t k = 1; k < order.size(); ++k) {
    if (!AreInOnePlace(points[order[first]], points[order[k]])) {
      first = k;
      continue;
    }
    duplicates.push_back({order[first], order[k], order[k - 1] + 1 == order[k]});
  }
  std::sort(duplicates.begin(), duplicates.end(),
            [](Duplicate const& a, Duplicate const& b) { return a.later < b.later; });
  return duplicates;
}

}  // namespace Vorn::IO
