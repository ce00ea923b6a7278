#pragma once

#include <string>

#include "cli/base/Library.h"
#include "vorn/io/Failure.h"

namespace Vorn::Cli {

/// What a failure says, and by which option of the program it can be helped.
std::string WithAdvice(Failure const& failure);

}  // namespace Vorn::Cli
