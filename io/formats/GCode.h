#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "io/pieces/ContourFile.h"

namespace Vorn::IO {

/// What the user can choose about a tool path. Lengths are in the units of the contour, feeds in
/// these units a minute.
struct GCodeOptions {
  enum class End { M2, M30, None };
  enum class Plane { G17, G18 };  ///< of X and Y, or of X and Z

  std::optional<double> feed;       ///< without it no F is written, and a controller stops
  std::optional<int> decimals;      ///< digits after the point; goes before the tolerance
  std::optional<double> tolerance;  ///< what the digits follow from, see GCodeDecimals
  End end = End::M2;
  Plane plane = Plane::G17;          ///< G18: the y of the contour is the Z of a lathe
  bool useRadiusWords = false;       ///< R in place of I and J
  std::optional<double> safeHeight;  ///< Z of rapid moves; together with cutHeight, not in G18
  std::optional<double> cutHeight;   ///< Z of the cut
  std::optional<double> plungeFeed;  ///< from safeHeight to cutHeight; else `feed`
  std::string header;                ///< goes ahead of all; see FilledIn
  std::string footer;                ///< goes behind the path and ahead of the end of the program
};

/// Beyond, even a part of a millimetre has digits that a double does not hold.
inline constexpr int kMostGCodeDecimals = 15;

/// How many digits after the point a tool path of these units gets: 4 for millimetres and 5 for
/// inches, a tenth of the increment that machines commonly resolve, and as many more as make the
/// last digit a hundredth of the tolerance or less.
int GCodeDecimals(std::string const& units, std::optional<double> tolerance);

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
ContourFile ParseGCode(std::string_view text, std::string const& path);

}  // namespace Vorn::IO
