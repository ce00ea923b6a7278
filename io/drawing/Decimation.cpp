#include "io/drawing/Decimation.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <unordered_set>

namespace Vorn::IO::Svg {

namespace {

/// Farther out nothing is on the page, and the numbers of the cells would not fit.
constexpr double kFarthest = 1e6;

struct Cell {
  int column = 0;
  int row = 0;

  bool operator==(Cell const&) const = default;
};

struct CellHash {
  std::size_t operator()(Cell const& cell) const {
    constexpr std::size_t kSpread = 0x9E3779B97F4A7C15u;
    return static_cast<std::size_t>(cell.column) * kSpread + static_cast<std::size_t>(cell.row);
  }
};

std::optional<Cell> CellOf(Pixel const& at, double size) {
  bool const isNear = std::fabs(at.x) < kFarthest && std::fabs(at.y) < kFarthest;
  if (!isNear) return {};
  return Cell{static_cast<int>(std::floor(at.x / size)), static_cast<int>(std::floor(at.y / size))};
}

std::vector<Cell> OccupiedCells(std::vector<Pixel> const& at, double size) {
  std::vector<Cell> cells;
  for (Pixel const& pixel : at) {
    if (std::optional<Cell> const cell = CellOf(pixel, size)) cells.push_back(*cell);
  }
  std::sort(cells.begin(), cells.end(), [](Cell const& a, Cell const& b) {
    return a.column != b.column ? a.column < b.column : a.row < b.row;
  });
  cells.erase(std::unique(cells.begin(), cells.end()), cells.end());
  return cells;
}

}  // namespace

std::vector<std::size_t> OnePerCell(std::vector<Pixel> const& at, double cell) {
  std::unordered_set<Cell, CellHash> taken;
  std::vector<std::size_t> kept;
  for (std::size_t i = 0; i < at.size(); ++i) {
    std::optional<Cell> const place = CellOf(at[i], cell);
    if (place && taken.insert(*place).second) kept.push_back(i);
  }
  return kept;
}

std::vector<Streak> StreaksOf(std::vector<Pixel> const& at, double cell) {
  std::vector<Streak> streaks;
  std::vector<Cell> const cells = OccupiedCells(at, cell);
  for (std::size_t first = 0; first < cells.size();) {
    std::size_t last = first;
    while (last + 1 < cells.size() && cells[last + 1].column == cells[first].column &&
           cells[last + 1].row == cells[last].row + 1) {
      ++last;
    }
    streaks.push_back({{(cells[first].column + 0.5) * cell, (cells[first].row + 0.5) * cell},
                       static_cast<double>(last - first) * cell});
    first = last + 1;
  }
  return streaks;
}

}  // namespace Vorn::IO::Svg
