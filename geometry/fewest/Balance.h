#pragma once

#include "geometry/fewest/Chain.h"

/// Gates moved to where neighbouring pieces meet by themselves.
namespace Vorn::Fewest {

/// Forwards every piece of a chain runs as far as it can, beyond the true joint. Each gate is moved
/// to the gap at which the circle of the points before it and that of the points behind deviate
/// equally, found by bisection, since the one deviates the more and the other the less the later
/// the gap. A gate stays where the two leave little room. The gates still await their offsets; each
/// piece has the circle of its points alone and the ratio of that, below which no joints bring it.
Chain Balance(Path const& path, Chain const& chain);

}  // namespace Vorn::Fewest
