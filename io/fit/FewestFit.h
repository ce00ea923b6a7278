#pragma once

#include <string>

#include "vorn/io/FitContour.h"

namespace Vorn::IO {

/// Fits the fewest pieces and measures them. A closed contour needs no seam here: the service takes
/// it as closed and says where it begins.
/// @throws Failure (FailureKind::BadArgument) for a `start`, (NoFit) with the reason.
FitReport FitFewest(PointFile file, std::string toleranceSource, Closure const& closure,
                    FitChoice const& choice, ExecutionState* progress);

}  // namespace Vorn::IO
