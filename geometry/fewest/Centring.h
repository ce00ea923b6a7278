#pragma once

#include "geometry/fewest/Chain.h"

/// Deviations brought down while the number of pieces stays.
namespace Vorn::Fewest {

/// Shrinks all tolerances by one factor as far as the gates of the chain allow, found by bisection.
/// Answers the chain of the smallest factor; `chain` itself where none is smaller.
Chain Centre(Path const& path, Chain const& chain);

}  // namespace Vorn::Fewest
