// The centre of a cell sequence. It stands for the plain Cells::CentreOf over all copies.

#pragma once

#include <optional>

#include "geometry/cells/fast/CellLevel.h"
#include "geometry/cells/fast/Words.h"

namespace Vorn::Cells {

/// A centre without its exact rounding.
struct RoughCentre {
  Point at;
  /// How far from `at` the centre with its exact rounding may be.
  double error;
};

/// The centre of the sequence that a chain of words stands for, as CentreOf of all its triangles
/// one by one. `leaves` is the last level of the chain and must have triangles.
Point CentreOfSequence(WordChain const& chain, CellLevel const& leaves);

/// The centre without its exact rounding, which takes no sum over the copies. Nothing for a level
/// without a proper triangle, or with one of extreme size. O(number of distinct triangles).
std::optional<RoughCentre> RoughCentreOf(CellLevel const& leaves);

}  // namespace Vorn::Cells
