#pragma once

#include <string>

#include "cli/Library.h"
#include "io/points/InfoReport.h"

namespace Vorn::Cli {

/// For people: one fact a line, of long lists the first few.
std::string ToText(InfoReport const& report);

}  // namespace Vorn::Cli
