#pragma once

#include <string>
#include <vector>

#include "cli/base/Library.h"
#include "cli/commands/CommandLine.h"
#include "vorn/io/ReportHead.h"

namespace Vorn::Cli {

/// Adds --field NAME=VALUE, which may be given several times.
void AddFieldOption(Command& command, std::vector<std::string>* texts);

/// The head of a report with these fields and the version of this program.
/// @throws Failure (FailureKind::BadArgument) for a text without a name or without "=", and for a
///         name that comes twice.
ReportHead HeadOf(std::vector<std::string> const& texts);

}  // namespace Vorn::Cli
