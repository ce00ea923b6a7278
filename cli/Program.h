#pragma once

#include <iosfwd>

#include "cli/base/ExitCode.h"

namespace Vorn::Cli {

/// The whole program but for the process around it: points may come from `in`, results go to
/// `out`, messages to `err`, progress to the terminal, if any, on standard error.
ExitCode RunProgram(int argc, char const* const* argv, std::istream& in, std::ostream& out,
                    std::ostream& err);

}  // namespace Vorn::Cli
