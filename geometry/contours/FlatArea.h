// Signed area and orientation of flat polylines.

#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/contours/FlatLayout.h"

namespace Vorn::Flat {

/// The area: positive for a polyline that runs clockwise with y up. Nothing when a run reaches
/// beyond the data. O(n).
std::optional<double> SignedArea(Data const& data, std::vector<std::int32_t> const& indices);

/// The sense in which the polyline turns at its lowest vertex, which is how it runs as a whole.
/// OrientationUnknown without runs and when a run reaches beyond the data. O(n).
PolyOrientation Orientation(Data const& data, std::vector<std::int32_t> const& indices);

}  // namespace Vorn::Flat
