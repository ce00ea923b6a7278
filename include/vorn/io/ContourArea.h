#pragma once

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

/// "counter-clockwise", "clockwise" or, of an area of zero, "none".
VORN_IO_EXPORT std::string SenseOf(ContourArea const& area);

/// Several as one JSON document; every digit.
VORN_IO_EXPORT std::string ToJson(std::vector<ContourArea> const& areas);

}  // namespace Vorn::IO
