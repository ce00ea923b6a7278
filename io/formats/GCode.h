#pragma once

#include <string>
#include <string_view>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Formats.h"
#include "vorn/io/GCodeOptions.h"

namespace Vorn::IO {

/// The contour as a tool path in the plane: G0 to the start and over gaps, G1 for lines, G2 and G3
/// with incremental I and J (K in the plane of X and Z) or with R for arcs. It says plane, absolute
/// mode and, where they are known, units, and ends the program. Everything is worked out from the
/// rounded numbers as the machine will read them: pieces shorter than the last digit go away, arcs
/// flatter than half of it become lines, arcs of more than 315 degrees (of more than 120 with R)
/// are divided, and the centre is chosen so that both ends are equally far from it.
/// @throws Failure (FailureKind::BadArgument) for units that a machine does not know, coordinates
///         with more digits than a double holds, a number of decimals too coarse for the radii at
///         the ends of an arc to agree, and an unknown field of header or footer.
std::string ToGCode(ContourFile const& contour, GCodeOptions const& options = {});

/// Reads G0 to G3 (I, J, K absolute or incremental, or R; G90, G91, G90.1, G91.1, G20, G21, the
/// planes G17 and G18), with or without blanks, line numbers and comments. The first move places
/// the start; G0 elsewhere leaves a gap. Feed, speed, tool, offsets, M words and moves across the
/// plane alone are passed over. What follows M2 or M30 is not read. The contour is closed when it
/// ends exactly where it starts.
/// @throws Failure (FailureKind::File) naming file, line and word.
ContourFile ParseGCode(std::string_view text, std::string const& path, ArcUse arcs = ArcUse::Keep);

}  // namespace Vorn::IO
