#pragma once

#include <functional>
#include <iosfwd>

#include "cli/base/ExitCode.h"

namespace Vorn::Cli {

/// Where a command reads and writes: results go to `out`, messages to `err`.
struct Console {
  std::istream& in;
  std::ostream& out;
  std::ostream& err;
};

/// What a command does once the command line has been read.
using Action = std::function<ExitCode(Console const&)>;

}  // namespace Vorn::Cli
