#pragma once

#include <string>
#include <vector>

#include "cli/base/Library.h"
#include "vorn/io/ContourArea.h"

namespace Vorn::Cli {

/// For people.
std::string ToText(ContourArea const& area);

/// The area of all outlines of one file.
std::string NetText(std::vector<ContourArea> const& areas);

}  // namespace Vorn::Cli
