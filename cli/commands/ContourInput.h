#pragma once

#include <optional>
#include <string>

#include "cli/commands/Command.h"
#include "vorn/io/Formats.h"

namespace Vorn::Cli {

/// Reads the contour that a command works on and says on the standard error what was left out.
/// @param from the format when the user names it
/// @throws Failure as ReadContour does.
ContourFile ReadContourInput(std::string const& path, std::optional<Format> from,
                             Console const& console);

/// Says on the standard error where pieces do not meet.
void ReportGaps(ContourFile const& contour, Console const& console);

}  // namespace Vorn::Cli
