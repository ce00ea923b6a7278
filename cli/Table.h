#pragma once

#include <string>

#include "cli/Report.h"

namespace Vorn::Cli {

/// The table of the pieces and the summary below it, for reading.
std::string ToTable(Report const& report);

}  // namespace Vorn::Cli
