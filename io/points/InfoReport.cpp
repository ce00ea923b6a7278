#include "vorn/io/InfoReport.h"

#include <algorithm>
#include <utility>

namespace Vorn::IO {

RuleCheck CheckRule(std::vector<WPoint> const& points, Closure const& closure, std::string source) {
  if (points.empty()) return {std::move(source), 0.0, 0.0, {}};
  auto const [smallest, largest] = std::minmax_element(
      points.begin(), points.end(), [](WPoint const& a, WPoint const& b) { return a.w < b.w; });
  return {std::move(source), smallest->w, largest->w, FindClosePairs(points, closure)};
}

}  // namespace Vorn::IO
