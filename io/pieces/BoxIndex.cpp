#include "io/pieces/BoxIndex.h"

#include <algorithm>
#include <limits>

namespace Vorn::IO {

namespace {

constexpr double kFar = std::numeric_limits<double>::infinity();

Extent Joined(Extent const& a, Extent const& b) {
  return {{std::min(a.low.x, b.low.x), std::min(a.low.y, b.low.y)},
          {std::max(a.high.x, b.high.x), std::max(a.high.y, b.high.y)}};
}

bool DoMeet(Extent const& a, Extent const& b) {
  return a.low.x <= b.high.x && b.low.x <= a.high.x && a.low.y <= b.high.y && b.low.y <= a.high.y;
}

}  // namespace

BoxIndex::BoxIndex(std::vector<Piece> const& pieces, double margin) {
  while (firstLeaf_ < pieces.size()) firstLeaf_ *= 2;
  boxes_.resize(2 * firstLeaf_, Extent{{kFar, kFar}, {-kFar, -kFar}});
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    Extent const box = ExtentOf({pieces[i]});
    boxes_[firstLeaf_ + i] = {{box.low.x - margin, box.low.y - margin},
                              {box.high.x + margin, box.high.y + margin}};
  }
  for (std::size_t node = firstLeaf_ - 1; node > 0; --node) {
    boxes_[node] = Joined(boxes_[2 * node], boxes_[2 * node + 1]);
  }
}

void BoxIndex::Visit(Extent const& box, std::function<void(std::size_t)> const& visit) const {
  Search(1, box, visit);
}

void BoxIndex::Search(std::size_t node, Extent const& box,
                      std::function<void(std::size_t)> const& visit) const {
  if (!DoMeet(boxes_[node], box)) return;
  if (node >= firstLeaf_) return visit(node - firstLeaf_);
  Search(2 * node, box, visit);
  Search(2 * node + 1, box, visit);
}

}  // namespace Vorn::IO
