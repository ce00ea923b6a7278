#pragma once

#include <cstdint>
#include <vector>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Path.h"

/// Closed contours: the places at which the chain may begin and end.
namespace Vorn::Fewest {

/// A closed path cut open: `path` begins with point `rotation` of the whole.
struct CutPath {
  Path path;
  std::int32_t rotation = 0;
};

/// The closed path cut at joints of a chain that was found as if it were open, the sharpest corners
/// first: where the path turns sharply every chain has a joint nearby. With a chain of one piece it
/// is cut where the input ends.
std::vector<CutPath> CutAtJoints(Path const& path, Chain const& open, std::size_t most);

}  // namespace Vorn::Fewest
