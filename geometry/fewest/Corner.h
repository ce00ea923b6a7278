#pragma once

#include <cstdint>

#include "geometry/fewest/Gates.h"
#include "geometry/fewest/Path.h"

/// Gates at the corners of the path.
namespace Vorn::Fewest {

/// The gate at the corner where the circle of the points before a gap crosses that of the points
/// behind it, along their bisector. A joint has to lie near that crossing, which may be far from
/// the points. Where the path of a dense scan turns back over itself the gate lies square to it,
/// through the point near the gap that is farthest along. False where the two run on smoothly,
/// cross elsewhere, or no such point is near.
bool CornerGate(Path const& path, std::int32_t split, PlacedCircle const& before,
                PlacedCircle const& behind, Gate* gate);

}  // namespace Vorn::Fewest
