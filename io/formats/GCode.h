#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "io/pieces/ContourFile.h"

namespace Vorn::IO {

struct GCodeOptions {
  std::optional<double> feed;   ///< units a minute; without it no F is written
  std::optional<int> decimals;  ///< digits after the point; see DefaultGCodeDecimals
};

/// 4 for millimetres and 5 for inches, a tenth of the increment that machines commonly resolve, so
/// that rounding is no part of the machine's error.
int DefaultGCodeDecimals(std::string const& units);

/// The contour as a tool path in the plane: G0 to the start and over gaps, G1 for lines, G2 and G3
/// with incremental I and J for arcs. Everything is worked out from the rounded numbers as the
/// machine will read them: pieces shorter than the last digit go away, arcs flatter than half of it
/// become lines, arcs of more than 315 degrees become two halves, and the centre is chosen so that
/// both ends are equally far from it.
/// @throws Failure (FailureKind::BadArgument) for units that a machine does not know, coordinates
/// with more
///         digits than a double holds, and a number of decimals too coarse for the radii at the
///         ends of an arc to agree.
std::string ToGCode(ContourFile const& contour, GCodeOptions const& options = {});

/// Reads G0 to G3 (I and J absolute or incremental, or R; G90, G91, G90.1, G91.1, G20, G21), with
/// or without blanks, line numbers and comments. The first move places the start; G0 elsewhere
/// leaves a gap. Feed, speed, tool, M words and moves of Z alone are passed over. The contour is
/// closed when it ends exactly where it starts.
/// @throws Failure (FailureKind::File) naming file, line and word.
ContourFile ParseGCode(std::string_view text, std::string const& path);

}  // namespace Vorn::IO
