#pragma once

#include "cli/base/Library.h"
#include "vorn/io/Formats.h"

namespace Vorn::Cli {

class Command;
struct Console;

/// Adds the options that say how a contour is written, in DXF and in G-code.
void AddWriteOptions(Command& command, WriteOptions* options);

/// Says on standard error that a controller will not cut, if G-code is written without a feed.
void WarnOfMissingFeed(WriteOptions const& options, bool writesGCode, Console const& console);

}  // namespace Vorn::Cli
