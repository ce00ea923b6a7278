#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "cli/base/Library.h"
#include "vorn/io/CheckReport.h"

namespace Vorn::Cli {

/// For people: a summary, then a table of the first `rows` of the points in this order.
std::string ToText(CheckReport const& report, std::vector<std::size_t> const& order,
                   std::size_t rows);

}  // namespace Vorn::Cli
