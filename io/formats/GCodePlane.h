#pragma once

#include <array>
#include <cstddef>
#include <iterator>
#include <optional>

/// Axes and planes of a machine.
namespace Vorn::IO {

/// The axes of a machine, as its words name them.
inline constexpr char kAxes[] = {'X', 'Y', 'Z'};

/// One coordinate for each axis; nothing where it is not known.
using MachinePlace = std::array<std::optional<double>, std::size(kAxes)>;

/// The axes that the first and the second coordinate of a contour are, the words for their ways to
/// the centre of an arc, and the axis across.
struct MachinePlane {
  std::size_t first = 0;
  std::size_t second = 1;
  char firstOffset = 'I';
  char secondOffset = 'J';
  std::size_t across = 2;
  bool isMirrored = false;  ///< G2 and G3 are told from the side where the two are exchanged
};

/// G17.
inline constexpr MachinePlane kPlaneXY = {};
/// G18, where the second axis is that of the height.
inline constexpr MachinePlane kPlaneXZ = {0, 2, 'I', 'K', 1, true};

}  // namespace Vorn::IO
