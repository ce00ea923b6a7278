#pragma once

#include <vector>

#include "vorn/io/FitReport.h"

namespace Vorn::IO {

/// Calls the fit of the core library and takes the time.
/// @param strategy one of those that run along the points, not the fewest pieces
/// @param progress may be null
FitAnswer Fit(std::vector<WPoint> const& points, Strategy strategy, ExecutionState* progress);

/// Whether the contour goes on to the last point. A fit may give up on the way and still answer
/// Ok with the pieces made so far; the end of such a contour lies nearer to an earlier point. The
/// single arc is one piece for all points, so its end says nothing, and the fewest pieces cover
/// every point.
bool ReachesLastPoint(std::vector<WPoint> const& points, std::vector<Piece> const& pieces,
                      Strategy strategy);

}  // namespace Vorn::IO
