// Whether a flat polyline crosses or touches itself.

#pragma once

#include <cstddef>
#include <vector>

#include "geometry/contours/FlatPairs.h"

namespace Vorn::Flat {

/// Whether any pair of pieces crosses, or the code of the first pair that is invalid. Up to
/// plainSize pieces all pairs are compared, O(n^2) without storage; beyond it only those that come
/// near each other. The answer is the same.
Verdict CheckRuns(Data const& data, std::vector<Run> const& runs, std::size_t plainSize);

}  // namespace Vorn::Flat
