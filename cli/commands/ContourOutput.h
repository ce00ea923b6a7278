#pragma once

#include <optional>
#include <string>

#include "cli/Library.h"
#include "io/formats/Format.h"

namespace Vorn::Cli {

class Command;

/// Adds the options that say how a contour is written: --dxf-entities, --feed, --gcode-decimals.
void AddWriteOptions(Command& command, WriteOptions* options);

/// The format of a file to write: by its ending, else `otherwise`.
/// @param option what to give when neither tells, for the message
/// @throws Failure (FailureKind::BadArgument) when neither tells.
Format OutputFormat(std::string const& path, std::optional<Format> otherwise,
                    std::string const& option);

}  // namespace Vorn::Cli
