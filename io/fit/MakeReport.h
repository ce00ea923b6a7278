#pragma once

#include <optional>
#include <string>
#include <vector>

#include "vorn/io/FitReport.h"

namespace Vorn::IO {

/// Measures the contour of a fit that answered Ok with at least one piece, and judges it as open or
/// closed as it is.
FitReport MakeReport(PointFile file, std::string toleranceSource, Strategy strategy, FitAnswer fit,
                     Closure const& closure = {});

/// The same for a closed contour that was cut open: closes the pieces exactly if it can. Without
/// pieces in `fit` the contour is the full circle `circle`.
FitReport MakeClosedReport(PointFile file, std::string toleranceSource, Strategy strategy,
                           FitAnswer fit, Closure const& closure, Circuit const& circuit,
                           std::optional<std::vector<Piece>> circle);

}  // namespace Vorn::IO
