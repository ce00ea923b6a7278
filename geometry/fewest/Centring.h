#pragma once

#include "geometry/fewest/Chain.h"

/// Deviations brought down while the number of pieces stays.
namespace Vorn::Fewest {

/// A chain of as many pieces whose deviations are smaller, each piece as far as its neighbours
/// allow; `chain` itself where its joints cannot be moved. A straight piece is taken wherever one
/// is within tolerance, and none is given up for a smaller deviation.
Chain Centre(Path const& path, Chain const& chain);

}  // namespace Vorn::Fewest
