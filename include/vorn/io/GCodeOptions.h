#pragma once

#include <optional>
#include <string>

#include "vorn/io/Export.h"

namespace Vorn::IO {

/// What the user can choose about a tool path. Lengths are in the units of the contour, feeds in
/// these units a minute.
struct GCodeOptions {
  /// The word that ends the program; None leaves it to the footer.
  enum class End { M2, M30, None };
  /// The plane of the path.
  enum class Plane { G17, G18 };  ///< of X and Y, or of X and Z

  std::optional<double> feed;        ///< without it no F is written, and a controller stops
  std::optional<int> decimals;       ///< digits after the point, 0 to 15; go before the tolerance
  std::optional<double> tolerance;   ///< what the digits follow from, see GCodeDecimals
  End end = End::M2;                 ///< how the program ends
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
/// last digit a hundredth of the tolerance or less, up to kMostGCodeDecimals. What is no tolerance,
/// negative or not a number, asks for none.
VORN_IO_EXPORT int GCodeDecimals(std::string const& units, std::optional<double> tolerance);

}  // namespace Vorn::IO
