#pragma once

#include <cstdint>

#include "geometry/fewest/Path.h"

/// Runs of so few points, so far apart, that any arc passes them.
namespace Vorn::Fewest {

/// The least radius of an arc that covers the points [first, end) where these are one or two in
/// wide gaps, see IsWideGap: from one to the other, or from one to the points beside it, the arc
/// turns by no more than 8 degrees and bulges by a fifty-seventh of the way. So the sides of a
/// polygon stay straight, and what curves between single points in fact still finds an arc. 0 for
/// other runs.
double LeastRadiusOfBareRun(Path const& path, std::int32_t first, std::int32_t end);

}  // namespace Vorn::Fewest
