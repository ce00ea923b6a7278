#include "io/pieces/BoxIndex.h"

#include <algorithm>

namespace Vorn::IO {

namespace {

Extent Joined(Extent const& a, Extent const& b) {
  return {{std::min(a.low.x, b.low.x), std::min(a.low.y, b.low.y)},
          {std::max(a.high.x, b.high.x), std::max(a.high.y, b.high.y)}};
}

Extent Widened(Extent const& box, double margin) {
  return {{box.low.x - margin, box.low.y - margin}, {box.high.x + margin, box.high.y + margin}};
}

bool DoMeet(Extent const& a, Extent const& b) {
  return a.low.x <= b.high.x && b.low.x <= a.high.x && a.low.y <= b.high.y && b.low.y <= a.high.y;
}

}  // namespace

BoxIndex::BoxIndex(std::vector<Piece> const& pieces, double margin)
    : tree_(
          pieces.size(), [&](std::size_t i) { return Widened(ExtentOf({pieces[i]}), margin); },
          Joined) {}

void BoxIndex::Visit(Extent const& box, std::function<void(std::size_t)> const& visit) const {
  Search(ArrayTree<Extent>::kRoot, box, visit);
}

void BoxIndex::Search(std::size_t node, Extent const& box,
                      std::function<void(std::size_t)> const& visit) const {
  if (!tree_.Has(node) || !DoMeet(tree_[node], box)) return;
  if (tree_.IsLeaf(node)) return visit(tree_.ItemOf(node));
  Search(2 * node, box, visit);
  Search(2 * node + 1, box, visit);
}

}  // namespace Vorn::IO
