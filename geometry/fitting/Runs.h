#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn::Fitting {

/// Whether points[start] .. points[start + count - 1] all exist. An empty run at a valid start
/// does; sums are taken in 64 bits, so no count overflows.
inline bool HoldsRun(std::vector<WPoint> const& points, std::int32_t start, std::int32_t count) {
  return start >= 0 && count >= 0 &&
         static_cast<std::uint64_t>(start) + static_cast<std::uint64_t>(count) <= points.size();
}

/// The length of a run cut to the points there are, plus one: the shortest that is too long.
inline std::int32_t LongestRun(std::vector<WPoint> const& points, std::int32_t start,
                               std::int32_t count) {
  std::int64_t const available = static_cast<std::int64_t>(points.size()) - start;
  if (start < 0 || available < 0) return 0;
  return static_cast<std::int32_t>(std::min<std::int64_t>(count, available + 1));
}

inline WPoint const& At(std::vector<WPoint> const& points, std::int32_t index) {
  return points[static_cast<std::size_t>(index)];
}

inline GeometryUtils::Point ToPoint(WPoint const& p) { return {p.x, p.y}; }

/// An arc needs three points; fewer do not turn.
inline constexpr std::int32_t kFewestArcPoints = 3;

/// The bytes that the triangles of a cell may take before the cell is rebuilt from fewer points,
/// divided by what one triangle is weighed with: 8 for lines, 32 for arcs, whose unions grow
/// faster.
inline constexpr std::size_t kCellBudget = 625000;
inline constexpr std::size_t kLineCellWeight = 8;
inline constexpr std::size_t kArcCellWeight = 32;

constexpr bool IsOversized(std::size_t cellSize, std::size_t weight) {
  return cellSize * weight > kCellBudget;
}

}  // namespace Vorn::Fitting
