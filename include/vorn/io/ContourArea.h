#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Export.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// What a closed contour encloses.
struct ContourArea {
  ContourFile contour;         ///< as it was measured
  std::vector<Gap> gaps;       ///< bridged by straight lines
  bool crossesItself = false;  ///< where it only touches itself it still borders a region
  double signedArea = 0.0;     ///< positive counter-clockwise; every loop with its own sign
  double perimeter = 0.0;      ///< with the bridges
  std::optional<XY> centroid;  ///< of a contour that does not cross itself and encloses something
  Extent extent;               ///< the box around the contour
  std::size_t outline = 0;     ///< which one of its file, from 1; 0: the only one
  std::size_t depth = 0;       ///< in how many outlines of the file it lies

  /// Whether it takes away from the outline around it.
  bool IsHole() const { return depth % 2 == 1; }

  /// Whether the contour is the border of one region, so that its area is that of the region.
  bool IsSimple() const { return !crossesItself; }
};

/// Whether the contour says that it is closed or ends where it begins.
VORN_IO_EXPORT bool IsClosed(ContourFile const& contour);

/// With a line from the end to the start, unless the contour ends there anyway.
VORN_IO_EXPORT ContourFile Closed(ContourFile contour);

/// The area of a contour that is closed, positive counter-clockwise, gaps bridged by straight
/// lines. That of one that crosses itself is the sum of the areas of its loops, as often as each is
/// run round.
VORN_IO_EXPORT double SignedAreaOf(ContourFile const& contour);

/// Measures a contour that is closed. The area of one that crosses itself is the sum of the areas
/// of its loops, each positive where it runs counter-clockwise and counted as often as it is run
/// round.
VORN_IO_EXPORT ContourArea MeasureArea(ContourFile contour);

/// Measures each of the outlines of one file, all closed, and finds out which lie in which.
VORN_IO_EXPORT std::vector<ContourArea> MeasureOutlines(std::vector<ContourFile> outlines);

/// The areas of outlines without their senses, those of holes taken off.
VORN_IO_EXPORT double NetArea(std::vector<ContourArea> const& areas);

/// "counter-clockwise", "clockwise" or, of an area of zero, "none".
VORN_IO_EXPORT std::string SenseOf(ContourArea const& area);

/// Several as one JSON document; every digit.
VORN_IO_EXPORT std::string ToJson(std::vector<ContourArea> const& areas);

}  // namespace Vorn::IO
