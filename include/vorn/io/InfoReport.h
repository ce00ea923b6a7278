#pragma once

#include <optional>
#include <string>
#include <vector>

#include "vorn/io/Export.h"
#include "vorn/io/Points.h"
#include "vorn/io/PointsInfo.h"

namespace Vorn::IO {

/// How the points stand to the tolerances that the user or the file states.
struct RuleCheck {
  std::string source;             ///< where the tolerances come from
  double smallest = 0.0;          ///< the smallest tolerance
  double largest = 0.0;           ///< the largest tolerance
  std::vector<ClosePair> broken;  ///< neighbours that are too close for theirs
};

/// What `contour info` tells about one file.
struct InfoReport {
  PointFile file;                 ///< the points
  PointsInfo info;                ///< what they say by themselves
  std::optional<RuleCheck> rule;  ///< nothing where nobody states a tolerance
};

/// Checks the tolerances that the points of the file carry.
VORN_IO_EXPORT RuleCheck CheckRule(std::vector<WPoint> const& points, Closure const& closure,
                                   std::string source);

/// For programs: the same facts whole, as a JSON document that ends with a line end. Points are
/// counted from 0, lines of the file from 1; what is not known is null.
VORN_IO_EXPORT std::string ToJson(InfoReport const& report);

}  // namespace Vorn::IO
