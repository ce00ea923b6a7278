#pragma once

#include <optional>
#include <string>

#include "cli/base/Library.h"
#include "vorn/io/FitReport.h"

namespace Vorn::Cli {

/// The table of the pieces and the summary below it, for reading.
///
/// @param digits after the point of coordinates and lengths; nothing: a hundredth of the smallest
///        tolerance, as far as columns stay readable
/// @param readBack what was found when the files were read back; empty: nothing to say
std::string ToTable(FitReport const& report, std::optional<int> digits = {},
                    std::string const& readBack = "");

}  // namespace Vorn::Cli
