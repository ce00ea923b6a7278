#pragma once

#include <optional>
#include <string>

#include "cli/Library.h"
#include "io/fit/FitReport.h"

namespace Vorn::Cli {

/// The table of the pieces and the summary below it, for reading.
///
/// @param digits after the point of coordinates and lengths; nothing: a hundredth of the smallest
///        tolerance, as far as columns stay readable
/// @param readBack what was found when the files were read back; empty: nothing to say
std::string ToTable(Report const& report, std::optional<int> digits = {},
                    std::string const& readBack = "");

}  // namespace Vorn::Cli
