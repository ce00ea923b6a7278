#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "vorn/io/Closure.h"
#include "vorn/io/Corners.h"
#include "vorn/io/Export.h"
#include "vorn/io/PathFacts.h"
#include "vorn/io/Spacing.h"

namespace Vorn::IO {

/// Every pair of neighbours that is too close for its tolerances, in the order of the points. Of a
/// closed contour that does not repeat its first point, the last and the first are neighbours.
VORN_IO_EXPORT std::vector<ClosePair> FindClosePairs(std::vector<WPoint> const& points,
                                                     Closure const& closure);

/// A tolerance that suits the points, and why.
struct Suggestion {
  /// One tolerance for all points and strategies, one that the spacing denies the strategies with
  /// cells, or none that would do.
  enum class Way { Same, Fewest, None };
  Way way = Way::None;     ///< which of these
  double tolerance = 0.0;  ///< for all points
  std::string reason;      ///< why, in words
};

/// All that can be said about measured points without a fit.
struct PointsInfo {
  PointsBox box;                           ///< the box around the points
  SpacingFacts spacing;                    ///< distances of neighbours
  std::vector<Duplicate> duplicates;       ///< points that repeat an earlier one
  Closure closure;                         ///< whether they run once around
  std::optional<double> largestTolerance;  ///< see LargestSingleTolerance
  std::vector<Corner> corners;             ///< where the path turns sharply
  std::optional<double> noise;             ///< see EstimateNoise
  Suggestion suggestion;                   ///< a tolerance to begin with
};

/// Looks at the points alone, not at their tolerances.
VORN_IO_EXPORT PointsInfo Analyse(std::vector<WPoint> const& points, ClosedChoice closed);

/// Five times the noise, or what the shape asks for where that is more: a ten-thousandth of the
/// size, of a flat profile at most a hundredth of its height. Where the spacing rule allows only
/// less, it is one for the fewest pieces, which have no such rule.
VORN_IO_EXPORT Suggestion SuggestTolerance(PointsInfo const& info);

}  // namespace Vorn::IO
