#pragma once

#include "cli/commands/Command.h"

namespace CLI {
class App;
}

namespace Vorn::Cli {

/// Adds `contour simplify`; when the command line asks for it, *action becomes what it does.
void AddSimplifyCommand(CLI::App& program, Action* action);

}  // namespace Vorn::Cli
