#pragma once

#include <cstddef>
#include <vector>

#include "io/pieces/ArrayTree.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// Finds the piece nearest to a point without measuring against every piece, with the very answer
/// that measuring against every piece gives: a piece is only passed over when a box around it is
/// further away than a piece that was measured, rounding included.
class PieceIndex {
 public:
  /// The nearest piece, the first of several, and its distance as DistanceTo measures it.
  struct Nearest {
    std::size_t piece = 0;
    double distance = 0.0;
  };

  /// Needs at least one piece; they must outlive the index.
  explicit PieceIndex(std::vector<Piece> const& pieces);

  /// @param hint a piece that is likely near, for example that of the point before
  Nearest Find(double x, double y, std::size_t hint) const;

 private:
  struct Box {
    double lowX = 0.0;
    double highX = 0.0;
    double lowY = 0.0;
    double highY = 0.0;
    double slack = 0.0;  ///< how far distances to the pieces inside may be rounded
  };

  /// The box around a piece.
  static Box BoxOf(Piece const& piece);
  /// The box around both.
  static Box Joined(Box const& a, Box const& b);
  /// How near a point of the box can be to (x, y).
  static double LeastDistance(Box const& box, double x, double y);
  /// Looks for a nearer piece below the node.
  void Search(std::size_t node, double x, double y, Nearest* nearest) const;

  using Tree = ArrayTree<Box>;

  std::vector<Piece> const& pieces_;
  Tree tree_;
};

}  // namespace Vorn::IO
