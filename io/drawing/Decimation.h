#pragma once

#include <vector>

#include "io/drawing/Layout.h"

/// Fewer marks, the same picture: what falls on the same place of the page is drawn once.
namespace Vorn::IO::Svg {

/// More marks than this are merged by cells; fewer keep their exact places.
inline constexpr std::size_t kMostExactDots = 5000;

/// A column of neighbouring cells that all hold a mark.
struct Streak {
  Pixel top;
  double height = 0.0;  ///< from the middle of the first cell to the middle of the last
};

/// The first mark of each square cell of the page, in the order given; marks at infinity and such
/// are left out.
std::vector<std::size_t> OnePerCell(std::vector<Pixel> const& at, double cell);

/// The cells that hold a mark, as columns from left to right.
std::vector<Streak> StreaksOf(std::vector<Pixel> const& at, double cell);

}  // namespace Vorn::IO::Svg
