#pragma once

#include <string>
#include <string_view>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {

/// One piece a line under the header
/// `type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction`; `type` is line or arc,
/// `direction` ccw or cw (y up), and a line leaves the last four empty. Units and the closed flag
/// stand in comments ahead of it, `# units mm` and `# closed yes`. Doubles read back as the same
/// bits, and gaps are kept.
std::string ToCsv(ContourFile const& contour);

/// Reads what ToCsv writes. Columns are found by name, in any order and beside others; `centre_x`
/// and `centre_y` are taken as well. Separators are commas, semicolons or tabs. An arc that ends
/// where it starts is a full circle and becomes two halves.
/// @throws Failure (FailureKind::File) naming file, line and offending text.
ContourFile ParseCsvPieces(std::string_view text, std::string const& path,
                           ArcUse arcs = ArcUse::Keep);

}  // namespace Vorn::IO
