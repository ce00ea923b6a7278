#pragma once

#include <optional>
#include <string>
#include <vector>

#include "vorn/io/FitReport.h"

namespace Vorn::IO {

/// What a fit begins with.
struct FitInput {
  PointFile file;               ///< the points, each with its tolerance
  std::string toleranceSource;  ///< in words, where the tolerances came from
  Closure closure;              ///< whether the contour runs back to its start
};

/// Measures the contour of a fit that answered Ok with at least one piece, and judges it as open or
/// closed as it is.
FitReport MakeReport(FitInput input, Strategy strategy, FitAnswer fit);

/// The same for a closed contour that was cut open: closes the pieces exactly if it can. Without
/// pieces in `fit` the contour is the full circle `circle`.
FitReport MakeClosedReport(FitInput input, Strategy strategy, FitAnswer fit, Circuit const& circuit,
                           std::optional<std::vector<Piece>> circle);

}  // namespace Vorn::IO
