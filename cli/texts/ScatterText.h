#pragma once

#include <string>

#include "cli/base/Library.h"
#include "vorn/io/PieceMeasures.h"

namespace Vorn::Cli {

/// "root mean square 0.0031 mm, mean -2e-05 mm".
std::string ScatterText(DeviationSummary const& summary, std::string const& units);

/// "none of 120 points", "3 of 120 points".
std::string OutsideText(std::size_t outside, std::size_t points);

}  // namespace Vorn::Cli
