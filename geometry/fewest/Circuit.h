#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Circle.h"
#include "geometry/fewest/Gates.h"
#include "geometry/fewest/Path.h"

/// Once around a closed path, wherever that begins.
namespace Vorn::Fewest {

/// One piece of a circuit.
struct CircuitPiece {
  /// The gate at which it starts, as the piece before sees it. Its split is a point of the path.
  Gate gate;
  /// Offsets between which the piece before ends.
  double low = 0.0;
  double high = 0.0;
  /// A circle that covers the points up to the gate of the next piece.
  PlacedCircle circle;
  /// Where a chain of as many pieces ends at most, whatever gates it takes: one past its last
  /// point.
  std::int32_t farthest = 0;
};

/// Pieces one behind the other, the first one behind the last. Every piece reaches the gate of the
/// next; whether they meet at one place of each gate is left open.
using Circuit = std::vector<CircuitPiece>;

/// Searches a circuit of the fewest pieces: the search of a chain goes on behind the end of the
/// path from its start on, until it has reached as far as on the lap before. From there on it would
/// repeat itself, so that the levels between the two are a lap that depends on no seam. Mostly it
/// falls into step within a few pieces behind the end.
///
/// @param[in] goesOn asked after each piece, as in FindChainWhile(); points of the second lap count
///                   beyond those of the first
/// @return empty where the search falls into step nowhere on two laps, is not to go on, or one
///         piece leads all around
Circuit FindCircuit(Path const& path, double share, GoesOn const& goesOn);

/// The same searched backwards, where it may find joints that are missed forwards; empty also where
/// no circuit of fewer than `limit` pieces can come of it. The farthest ends are left out.
///
/// @param[in] runStarts the first point of each run of the greedy cover of the path as an open one,
///                      or of a path with tolerances at least as large
Circuit FindCircuitBackwards(Path const& path, double share,
                             std::span<std::int32_t const> runStarts, std::size_t limit);

}  // namespace Vorn::Fewest
