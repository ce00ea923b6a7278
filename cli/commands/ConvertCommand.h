#pragma once

#include "cli/commands/Command.h"

namespace Vorn::Cli {

class CommandLine;

/// Adds the subcommand; when the command line asks for it, *action becomes what it does.
void AddConvertCommand(CommandLine& program, Action* action);

}  // namespace Vorn::Cli
