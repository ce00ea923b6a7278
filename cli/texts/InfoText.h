#pragma once

#include <string>

#include "cli/base/Library.h"
#include "vorn/io/InfoReport.h"

namespace Vorn::Cli {

/// For people: one fact a line, of long lists the first few.
std::string ToText(InfoReport const& report);

}  // namespace Vorn::Cli
