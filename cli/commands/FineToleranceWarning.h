#pragma once

#include "cli/commands/Command.h"
#include "vorn/io/FitContour.h"

namespace Vorn::Cli {

/// The choice, which then tells on standard error before a fit that the tolerances are too fine for
/// its strategy. Fits on several threads may share it; the console must outlive it.
FitChoice WarningOfFineTolerances(FitChoice choice, Console const& console);

}  // namespace Vorn::Cli
