#pragma once

#include "cli/commands/Command.h"

namespace CLI {
class App;
}

namespace Vorn::Cli {

/// Adds `contour intersect`; when the command line asks for it, *action becomes what it does.
void AddIntersectCommand(CLI::App& program, Action* action);

}  // namespace Vorn::Cli
