#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <span>

#include "geometry/fewest/Answer.h"
#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Path.h"
#include "geometry/fewest/Seam.h"
#include "geometry/fewest/promises/Promises.h"

/// The search of closed contours.
namespace Vorn::Fewest {

/// What to close, and who measures it. The references have to outlive the search.
struct ClosingTask {
  /// The points of the path; its ends are free.
  Path const& path;
  /// By what tolerances are multiplied.
  double share = 1.0;
  /// A number of pieces below which no closed chain goes.
  std::size_t bound = 0;
  /// The first point of each run of the greedy cover of the path as an open one.
  std::span<std::int32_t const> runStarts;
  /// Hears how many points are covered.
  std::function<void(std::int32_t)> const& tell;
  /// Whether the contour of a closed chain keeps every promise.
  std::function<bool(CutPath const&, Chain const&, Answer*, Promises::Report*)> const& keeps;
};

/// A closed contour.
struct ClosedContour {
  /// Without ranges where no closed chain was found.
  Answer answer;
  Promises::Report report;
  bool isKept = false;  ///< whether it keeps every promise
  /// No contour of fewer pieces is likely: it is the shortest circuit that was found.
  bool isShort = false;
};

/// The contour of the fewest pieces among those that begin and end at a joint of a circuit: first
/// along its gates, then searched anew. The circuit is searched forwards, and backwards where that
/// may save a piece.
ClosedContour CloseAnywhere(ClosingTask const& task);

/// The same among those that begin and end at a joint of an open chain, but for better than `best`.
void CloseAtJoints(ClosingTask const& task, Chain const& open, ClosedContour* best);

}  // namespace Vorn::Fewest
