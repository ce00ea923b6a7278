#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {

/// How the points lie against a contour as it stands in the text of a file.
struct FileMeasure {
  double relative = 0.0;   ///< the largest relative deviation
  std::size_t point = 0;   ///< index of the point that has it; the first of several
  bool isWithin = false;   ///< every point is within its tolerance, see IsWithinTolerance
  std::string unreadable;  ///< why the text cannot be read back; empty: it was measured

  /// Whether the text was read and every point is within its tolerance.
  bool IsWithin() const { return unreadable.empty() && isWithin; }
};

/// Reads the text as anyone would and measures every point against what it says. The format is one
/// that holds a contour; a text that cannot be read is no failure but an answer.
VORN_IO_EXPORT FileMeasure MeasureText(std::string_view text, Format format,
                                       std::vector<WPoint> const& points);

/// The contour as the text of a file for these points. The digits of G-code, where they are not
/// given, follow from the smallest tolerance, and grow until every point is within its own as the
/// text stands, if the contour itself allows that. The chords of GeoJSON, where no distance is
/// given, leave the arcs by a hundredth of the smallest tolerance, and end where they would take a
/// point out.
/// @throws as ToText does.
VORN_IO_EXPORT std::string ToTextFor(std::vector<WPoint> const& points, ContourFile const& contour,
                                     Format format, WriteOptions options);

}  // namespace Vorn::IO
