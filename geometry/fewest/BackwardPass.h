#pragma once

#include <cstdint>
#include <vector>

#include "geometry/fewest/Path.h"
#include "geometry/fewest/PieceSearch.h"

/// The backward half of the search: the pieces, once it is known where each may start.
namespace Vorn::Fewest {

/// One piece of a finished chain, in the coordinates of the path.
struct ChainPiece {
  /// The points that it covers: [first, end).
  std::int32_t first = 0;
  std::int32_t end = 0;
  /// A normalised circle through both joints.
  PlacedCircle circle;
  /// Largest deviation in units of the tolerance, over the circle.
  double ratio = 0.0;
};

/// A chain: the gate between piece k and piece k + 1 is gates[k], crossed at offsets[k].
struct Chain {
  std::vector<ChainPiece> pieces;
  std::vector<Gate> gates;
  std::vector<double> offsets;
};

/// Where a piece may start.
struct Link {
  Opening opening;
  /// A circle that covers the points of the piece.
  PlacedCircle guess;
  /// The pieces before it that end at the ends of the opening.
  PlacedCircle atLow;
  PlacedCircle atHigh;
};

/// A ratio that counts as 1: the tolerances of the search are smaller than the true ones by more.
inline constexpr double kWholeTolerance = 1.0 + 2e-7;

/// The pieces from the last to the first, each of the smallest largest ratio that ends where the
/// piece behind begins. Empty when a piece cannot end where it has to.
Chain PlacePieces(Path const& path, std::vector<Link> links, PieceSearch* search);

}  // namespace Vorn::Fewest
