#pragma once

#include "cli/commands/Command.h"

namespace CLI {
class App;
}

namespace Vorn::Cli {

/// Adds `contour area`; when the command line asks for it, *action becomes what it does.
void AddAreaCommand(CLI::App& program, Action* action);

}  // namespace Vorn::Cli
