#pragma once

#include "io/fit/MakeReport.h"
#include "vorn/io/FitContour.h"

namespace Vorn::IO {

/// Fits the fewest pieces and measures them. A closed contour needs no seam here: the service takes
/// it as closed and says where it begins.
/// @throws Failure (FailureKind::BadArgument) for a `start`, (NoFit) with the reason.
FitReport FitFewest(FitInput input, FitChoice const& choice, ExecutionState* progress);

}  // namespace Vorn::IO
