#pragma once

#include <string>

#include "cli/base/Library.h"
#include "vorn/io/ContourArea.h"

namespace Vorn::Cli {

/// For people.
std::string ToText(ContourArea const& area);

}  // namespace Vorn::Cli
