// How large the cell of a run may grow before it is rebuilt from fewer points.

#pragma once

#include <cstddef>

namespace Vorn::Fitting {

/// What the triangles of a cell may weigh together. Results depend on the value: it decides which
/// points a long run is rebuilt from.
inline constexpr std::size_t kCellBudget = 625000;

/// The weight of one triangle of a line cell: 78125 of them use the budget up.
inline constexpr std::size_t kLineCellWeight = 8;

/// The weight of one triangle of an arc cell, whose overlaps grow faster: 19531 triangles are
/// within the budget.
inline constexpr std::size_t kArcCellWeight = 32;

/// Whether a cell of so many triangles, each of a weight, exceeds the budget.
constexpr bool IsOversized(std::size_t cellSize, std::size_t weight) {
  return cellSize * weight > kCellBudget;
}

}  // namespace Vorn::Fitting
