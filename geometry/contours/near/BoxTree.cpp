// Bounds are formed from those of the children: a parent's trapezium goes around those of its two
// children, so that every node costs the same.

#include "geometry/contours/near/BoxTree.h"

#include <utility>

namespace Vorn::Contours {

BoxTree::BoxTree(std::vector<Extent> extents, double margin)
    : extents_(std::move(extents)), margin_(margin) {
  if (extents_.empty()) return;
  levels_.push_back(MakeLeaves());
  while (levels_.back().size() > 1) levels_.push_back(MakeParents(levels_.back()));
  trapezia_.resize(levels_.size());
}

std::vector<BoxTree::Node> BoxTree::MakeLeaves() const {
  std::vector<Node> leaves;
  leaves.reserve((extents_.size() + kPiecesPerLeaf - 1) / kPiecesPerLeaf);
  for (std::size_t first = 0; first < extents_.size(); first += kPiecesPerLeaf) {
    Node leaf(extents_[first]);
    std::size_t const end = std::min(first + kPiecesPerLeaf, extents_.size());
    for (std::size_t i = first + 1; i < end; ++i) leaf.Append(Node(extents_[i]));
    leaves.push_back(leaf);
  }
  return leaves;
}

std::vector<BoxTree::Node> BoxTree::MakeParents(std::vector<Node> const& children) {
  std::vector<Node> parents;
  parents.reserve((children.size() + 1) / 2);
  for (std::size_t j = 0; j < children.size(); j += 2) {
    parents.push_back(children[j]);
    if (j + 1 < children.size()) parents.back().Append(children[j + 1]);
  }
  return parents;
}

Trapezium const& BoxTree::TrapeziumAt(Place const& place) {
  std::vector<std::optional<Trapezium>>& level = trapezia_[place.level];
  if (level.empty()) level.resize(levels_[place.level].size());
  std::optional<Trapezium>& trapezium = level[place.number];
  if (!trapezium) trapezium = FormTrapezium(place);
  return *trapezium;
}

Trapezium BoxTree::FormTrapezium(Place const& place) {
  Trapezium parts[kPiecesPerLeaf];
  std::size_t count = 0;
  if (place.level == 0) {
    for (std::size_t i = FirstPiece(place); i < EndOfPieces(place); ++i) {
      if (!extents_[i].box.IsEmpty()) parts[count++] = TrapeziumOf(extents_[i]);
    }
    return Around(parts, count);
  }
  auto const take = [&](Place const& child) {
    if (!NodeAt(child).box.IsEmpty()) parts[count++] = TrapeziumAt(child);
  };
  take(FirstChild(place));
  if (HasSecondChild(place)) take(SecondChild(place));
  return Around(parts, count);
}

bool BoxTree::AreApart(Place const& mine, BoxTree& other, Place const& theirs) {
  Node const& a = NodeAt(mine);
  Node const& b = other.NodeAt(theirs);
  if (a.box.IsApartFrom(b.box)) return true;
  // Next to each other on the chain means a common joint.
  bool const areNeighbours =
      this == &other && mine.level == theirs.level && mine.number + 1 == theirs.number;
  if (areNeighbours || a.hasPoint || b.hasPoint) return false;
  Trapezium const& first = TrapeziumAt(mine);
  Trapezium const& second = other.TrapeziumAt(theirs);
  return IsOutside(first, second, margin_) || IsOutside(second, first, margin_);
}

std::size_t* BoxTree::CollectNear(Place const& mine, BoxTree& other, Place const& theirs,
                                  std::size_t* near) const {
  Node const& theirNode = other.NodeAt(theirs);
  std::size_t* end = near;
  for (std::size_t i = FirstPiece(mine); i < EndOfPieces(mine); ++i) {
    if (!extents_[i].box.IsApartFrom(theirNode.box)) *end++ = i;
  }
  // Single pieces at a joint are not worth a trapezium.
  constexpr std::ptrdiff_t kFew = 2;
  if (end - near <= kFew || theirNode.hasPoint) return end;
  Trapezium const& trapezium = other.TrapeziumAt(theirs);
  return std::remove_if(near, end, [&](std::size_t i) {
    return !extents_[i].box.IsPoint() && IsOutside(trapezium, TrapeziumOf(extents_[i]), margin_);
  });
}

}  // namespace Vorn::Contours
