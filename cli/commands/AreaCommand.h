#pragma once

#include "cli/commands/Command.h"

namespace Vorn::Cli {

class CommandLine;

/// Adds `contour area`; when the command line asks for it, *action becomes what it does.
void AddAreaCommand(CommandLine& program, Action* action);

}  // namespace Vorn::Cli
