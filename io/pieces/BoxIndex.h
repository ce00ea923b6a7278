#pragma once

#include <cstddef>
#include <functional>
#include <vector>

#include "io/pieces/ArrayTree.h"
#include "vorn/io/Pieces.h"

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
  /// Visits what lies below the node and meets the box.
  void Search(std::size_t node, Extent const& box,
              std::function<void(std::size_t)> const& visit) const;

  ArrayTree<Extent> tree_;
};

}  // namespace Vorn::IO
