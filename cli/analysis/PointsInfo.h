#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "cli/CsvReader.h"
#include "cli/analysis/Corners.h"
#include "cli/analysis/PathFacts.h"

namespace Vorn::Cli {

/// Neighbours that break the spacing rule.
struct BrokenPair {
  std::size_t second = 0;  ///< index of the later point
  double distance = 0.0;
  double needed = 0.0;  ///< the distance must be above this
};

/// Every pair of neighbours that is too close for its tolerances, in the order of the points.
std::vector<BrokenPair> FindBrokenPairs(std::vector<WPoint> const& points);

/// A tolerance that suits the points, and why.
struct Suggestion {
  enum class Way { Same, PerPoint, None };
  Way way = Way::None;
  double tolerance = 0.0;  ///< for all points, or the cap for each
  std::string reason;
};

/// All that can be said about measured points without a fit.
struct PointsInfo {
  PointsBox box;
  SpacingFacts spacing;
  std::vector<Duplicate> duplicates;
  double closingGap = 0.0;  ///< distance of the last point from the first
  bool isClosed = false;
  std::string closedReason;
  std::optional<double> largestTolerance;  ///< see LargestSingleTolerance
  std::vector<Corner> corners;
  std::optional<double> noise;  ///< see EstimateNoise
  Suggestion suggestion;
};

/// Looks at the points alone, not at their tolerances.
PointsInfo Analyse(std::vector<WPoint> const& points);

/// Five times the noise, or what the shape asks for where that is more: a ten-thousandth of the
/// size, of a flat profile at most a hundredth of its height. For all points where the spacing
/// rule allows it or not much less, else by the spacing of each.
Suggestion SuggestTolerance(PointsInfo const& info);

}  // namespace Vorn::Cli
