#pragma once

#include <cstdint>
#include <functional>
#include <vector>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Path.h"

/// Closed contours: the places at which the chain may begin and end.
namespace Vorn::Fewest {

/// A closed path cut open on a gate: `path` begins with point `rotation` of the whole.
struct CutPath {
  Path path;
  std::int32_t rotation = 0;
  /// The gate as the end of the path sees it, and an offset on it that an open chain took.
  Gate gate;
  double offset = 0.0;
};

/// The closed path cut at joints of a chain that was found as if it were open, the sharpest corners
/// first: where the path turns sharply every chain has a joint nearby. With a chain of one piece it
/// is cut where the input ends.
std::vector<CutPath> CutAtJoints(Path const& path, Chain const& open, std::size_t most);

/// The shortest chain that begins and ends at one place of the gate of a cut path. Afterwards the
/// path begins and ends there. Empty when there is none.
Chain CloseChain(CutPath* cut, double share, std::function<void(std::int32_t)> const& tell);

}  // namespace Vorn::Fewest
