#pragma once

#include <cstddef>
#include <vector>

namespace Vorn::IO {

/// Boxes around items in their order, and boxes around neighbouring boxes up to one around all: a
/// binary tree in an array, where the children of node n are 2 n and 2 n + 1. It lives on items
/// that follow each other lying close together, as the pieces of a contour do.
template <typename Box>
class ArrayTree {
 public:
  static constexpr std::size_t kRoot = 1;

  /// @param count at least 1
  /// @param boxOf gives the box of the item with an index
  /// @param join gives the box around two boxes
  template <typename BoxOf, typename Join>
  ArrayTree(std::size_t count, BoxOf const& boxOf, Join const& join) {
    while (firstLeaf_ < count) firstLeaf_ *= 2;
    boxes_.resize(firstLeaf_ + count);
    for (std::size_t i = 0; i < count; ++i) boxes_[firstLeaf_ + i] = boxOf(i);
    for (std::size_t node = firstLeaf_ - 1; node >= kRoot; --node) {
      if (!Has(2 * node)) continue;
      boxes_[node] = boxes_[2 * node];
      if (Has(2 * node + 1)) boxes_[node] = join(boxes_[node], boxes_[2 * node + 1]);
    }
  }

  /// Whether there is such a node; an inner node without children stands for no item either.
  bool Has(std::size_t node) const { return node < boxes_.size(); }

  /// Whether the node holds a piece and no other nodes.
  bool IsLeaf(std::size_t node) const { return node >= firstLeaf_; }

  /// The index of the item that the leaf stands for.
  std::size_t ItemOf(std::size_t leaf) const { return leaf - firstLeaf_; }

  /// The box of the node.
  Box const& operator[](std::size_t node) const { return boxes_[node]; }

 private:
  std::vector<Box> boxes_;
  std::size_t firstLeaf_ = 1;
};

}  // namespace Vorn::IO
