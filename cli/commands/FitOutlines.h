#pragma once

#include <vector>

#include "cli/commands/Command.h"
#include "cli/commands/FitOptions.h"
#include "vorn/io/Points.h"

namespace Vorn::Cli {

/// Fits every outline by itself and writes all contours into each file. Prints a table for each and
/// one summary.
/// @throws Failure (FailureKind::BadArgument) when an option is for one outline only; as
/// FitContour.
ExitCode RunFitOutlines(FitOptions const& options, std::vector<PointFile> outlines,
                        Console const& console);

}  // namespace Vorn::Cli
