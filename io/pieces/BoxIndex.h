#pragma once

#include <cstddef>
#include <functional>
#include <vector>

#include "io/pieces/Shapes.h"

namespace Vorn::IO {

/// Finds the pieces whose boxes a box meets without looking at every piece. It lives on pieces that
/// follow each other lying close together, as those of a contour do.
class BoxIndex {
 public:
  /// Boxes are `margin` larger than the pieces on every side. Needs at least one piece.
  BoxIndex(std::vector<Piece> const& pieces, double margin);

  /// Calls `visit` with the index of every piece whose box meets this one, in ascending order.
  void Visit(Extent const& box, std::function<void(std::size_t)> const& visit) const;

 private:
  void Search(std::size_t node, Extent const& box,
              std::function<void(std::size_t)> const& visit) const;

  /// A binary tree in an array: the children of node n are 2 n and 2 n + 1, the leaves are the
  /// pieces in order, from firstLeaf_ on.
  std::vector<Extent> boxes_;
  std::size_t firstLeaf_ = 1;
};

}  // namespace Vorn::IO
