#pragma once

#include <string>

#include "cli/base/Library.h"

namespace Vorn::Cli {

/// A deviation over its tolerance with six digits after the point, or as many more as keep it from
/// reading as 1 unless it is 1; a huge one, as a tolerance far below any deviation makes it, with
/// an exponent.
std::string RelativeText(double relative);

}  // namespace Vorn::Cli
