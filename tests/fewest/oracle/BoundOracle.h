#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "fewest/oracle/CoverOracle.h"

/// The least number of runs, each covered by one circle or line, that hold all points: over all
/// ways to divide the points, with no use made of the fact that parts of a run are coverable when
/// the run is. O(n^2) covers of O(n^4) each; for some 30 points.
namespace Vorn::Testing {

inline std::int32_t LeastNumberOfRuns(std::vector<WPoint> const& points,
                                      long double factor = 1.0L) {
  std::vector<std::int32_t> least(points.size() + 1, 0);
  for (std::size_t end = 1; end <= points.size(); ++end) {
    least[end] = least[end - 1] + 1;
    for (std::size_t begin = 0; begin < end; ++begin) {
      if (least[begin] + 1 >= least[end]) continue;
      std::vector<WPoint> const run(points.begin() + static_cast<std::ptrdiff_t>(begin),
                                    points.begin() + static_cast<std::ptrdiff_t>(end));
      if (IsCoverable(run, factor)) least[end] = least[begin] + 1;
    }
  }
  return least.back();
}

}  // namespace Vorn::Testing
