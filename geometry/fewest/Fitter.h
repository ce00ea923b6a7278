#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fewest/Answer.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Path.h"
#include "geometry/fewest/Progress.h"
#include "geometry/fewest/promises/Promises.h"
#include "vorn/FewestPieces.h"
#include "vorn/Types.h"

/// From chains to a contour that keeps every promise.
namespace Vorn::Fewest {

/// Percent of the progress that is done after the bound, and after the search of the open contour.
inline constexpr std::int32_t kCovered = 20;
inline constexpr std::int32_t kSearched = 80;

/// What to fit. The references have to outlive the fit.
struct FitTask {
  std::vector<WPoint> const& points;
  FewestPieces::Options const& options;
  /// From the points to those of the path.
  Shift const& shift;
  /// The points moved near the origin, with the limits of the options.
  Path path;
  /// The first point of each run of the greedy cover: no chain that need not close has fewer
  /// pieces.
  std::vector<std::int32_t> const& runStarts;
  /// A number of pieces below which nothing can go that is asked for.
  std::size_t bound = 1;
  Progress& progress;
};

/// The first contour found that keeps every promise, with what was measured on it; false when there
/// is none. `covering` is a circle that covers all points, along which pieces are then tried
/// first; null for none.
bool FindContour(FitTask task, PlacedCircle const* covering, Answer* answer,
                 Promises::Report* report);

}  // namespace Vorn::Fewest
