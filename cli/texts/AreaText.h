#pragma once

#include <string>

#include "cli/Library.h"
#include "io/measure/ContourArea.h"

namespace Vorn::Cli {

/// For people.
std::string ToText(ContourArea const& area);

}  // namespace Vorn::Cli
