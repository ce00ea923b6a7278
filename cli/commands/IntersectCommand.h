#pragma once

#include "cli/commands/Command.h"

namespace Vorn::Cli {

class CommandLine;

/// Adds `contour intersect`; when the command line asks for it, *action becomes what it does.
void AddIntersectCommand(CommandLine& program, Action* action);

}  // namespace Vorn::Cli
