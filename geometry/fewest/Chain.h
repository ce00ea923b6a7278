#pragma once

#include <cstdint>
#include <functional>
#include <vector>

#include "geometry/fewest/PieceSearch.h"

/// The chain of the fewest pieces: forwards the offsets that can be reached on gates, backwards the
/// pieces.
namespace Vorn::Fewest {

/// One piece of a finished chain, in the coordinates of the path.
struct ChainPiece {
  /// The points that it covers: [first, end).
  std::int32_t first = 0;
  std::int32_t end = 0;
  /// A normalised circle through both joints.
  Circle circle;
  /// Largest deviation in units of the tolerance, over the circle.
  double ratio = 0.0;
};

/// A chain: the gate between piece k and piece k + 1 is gates[k], crossed at offsets[k].
struct Chain {
  std::vector<ChainPiece> pieces;
  std::vector<Gate> gates;
  std::vector<double> offsets;
};

/// Searches a chain over the whole path; empty when none was found. `tell` hears how many points
/// are covered.
Chain FindChain(Path const& path, double share, std::function<void(std::int32_t)> const& tell);

/// The pieces for given gates: forwards the intervals, backwards the pieces of the smallest largest
/// ratio. Empty when the gates do not allow the share.
Chain FollowGates(Path const& path, double share, Chain const& known);

}  // namespace Vorn::Fewest
