// A hierarchy of bounds over the pieces of a contour, known as a strip tree, which finds the pairs
// of pieces that come near each other without looking at all pairs. It stands for the plain loop
// over all pairs.

#pragma once

#include <algorithm>
#include <cstddef>
#include <optional>
#include <vector>

#include "geometry/contours/near/Box.h"
#include "geometry/contours/near/Trapezium.h"

namespace Vorn::Contours {

/// Whether a search within one set of pieces looks at each piece and the one right after it.
enum class Neighbours { Tested, LeftOut };

/// A binary tree over pieces in the order of their contour. A node holds a run of consecutive
/// pieces, which lie near each other because the pieces form a chain, and is bounded twice: by an
/// axis-parallel box and by a trapezium whose long sides follow the outermost pieces of the run.
/// The trapezia keep bundles and fans of long slanted pieces apart, whose boxes all overlap; they
/// are formed when they are first asked for, which most contours do for few nodes.
///
/// A node whose boxes form a staircase is not looked into when neighbours are left out: the rest of
/// its pairs are apart. On a smooth outline that holds for all but the nodes around its extremes.
///
/// Memory is linear in the number of pieces. Empty extents are in no pair.
class BoxTree {
 public:
  /// Trapezia count as apart only when the gap exceeds margin; boxes need no gap. Pieces that are
  /// points are told apart by boxes only.
  BoxTree(std::vector<Extent> extents, double margin);

  /// Calls test(i, k) for pairs i < k until it answers true, and returns whether it did. Every pair
  /// is tested but for those of which some bounds are apart and, if they are to be left out, some
  /// or all pairs (i, i + 1). The order of the pairs is not defined.
  template <typename Test>
  bool AnyPair(Test const& test, Neighbours neighbours = Neighbours::Tested) {
    return !extents_.empty() && AnyPairWithin(Root(), neighbours, test);
  }

  /// The same for all pairs of a piece i of this tree and a piece k of the other.
  template <typename Test>
  bool AnyPair(BoxTree& other, Test const& test) {
    if (extents_.empty() || other.extents_.empty()) return false;
    return AnyPairBetween(Root(), other, other.Root(), test);
  }

 private:
  /// Level 0 holds the leaves; node j of a level has the children 2j and 2j + 1 one level below.
  struct Place {
    std::size_t level;
    std::size_t number;
  };

  struct Node {
    /// Of a single piece.
    explicit Node(Extent const& extent)
        : box(extent.box), stairs(Stairs::Of(extent.box)), hasPoint(extent.box.IsPoint()) {}

    /// Takes in the pieces that come right after its own.
    void Append(Node const& next) {
      stairs = Stairs::Join(stairs, box, next.stairs, next.box);
      box.Include(next.box);
      hasPoint = hasPoint || next.hasPoint;
    }

    Box box;
    Stairs stairs;
    bool hasPoint;
  };

  static constexpr std::size_t kPiecesPerLeaf = kMostParts;

  /// Nodes over kPiecesPerLeaf consecutive pieces each, the last one over the rest.
  std::vector<Node> MakeLeaves() const;
  /// Nodes over two children each, the last one over one where their number is odd.
  static std::vector<Node> MakeParents(std::vector<Node> const& children);

  /// Of a node whose box is not empty. Amortised O(1): each is formed once.
  Trapezium const& TrapeziumAt(Place const& place);
  /// The trapezium around the pieces of a leaf, or around the trapezia of both children.
  Trapezium FormTrapezium(Place const& place);

  /// Whether a bound says that no piece of my node meets one of theirs. Neighbours on the chain and
  /// nodes that hold a point are told apart by their boxes only.
  bool AreApart(Place const& mine, BoxTree& other, Place const& theirs);

  /// Where the whole tree begins; only for a tree that has pieces.
  Place Root() const { return {levels_.size() - 1, 0}; }
  /// The node at a place.
  Node const& NodeAt(Place const& place) const { return levels_[place.level][place.number]; }
  /// The child with the earlier pieces, which every node above the leaves has.
  static Place FirstChild(Place const& place) { return {place.level - 1, 2 * place.number}; }
  /// Whether a node above the leaves has a child with later pieces too.
  bool HasSecondChild(Place const& place) const {
    return 2 * place.number + 1 < levels_[place.level - 1].size();
  }
  /// The child with the later pieces.
  static Place SecondChild(Place const& place) { return {place.level - 1, 2 * place.number + 1}; }
  /// The number of the first piece of a leaf.
  static std::size_t FirstPiece(Place const& leaf) { return leaf.number * kPiecesPerLeaf; }
  /// One past the number of the last piece of a leaf.
  std::size_t EndOfPieces(Place const& leaf) const {
    return std::min(FirstPiece(leaf) + kPiecesPerLeaf, extents_.size());
  }

  /// Whether the test answers true for a pair of pieces below one node.
  template <typename Test>
  bool AnyPairWithin(Place const& place, Neighbours neighbours, Test const& test) {
    if (neighbours == Neighbours::LeftOut && NodeAt(place).stairs.AreMonotone()) return false;
    if (place.level == 0) return AnyPairOfLeaf(place, neighbours, test);
    if (AnyPairWithin(FirstChild(place), neighbours, test)) return true;
    if (!HasSecondChild(place)) return false;
    return AnyPairWithin(SecondChild(place), neighbours, test) ||
           AnyPairBetween(FirstChild(place), *this, SecondChild(place), test);
  }

  /// The same for a leaf: every pair whose boxes are not apart.
  template <typename Test>
  bool AnyPairOfLeaf(Place const& leaf, Neighbours neighbours, Test const& test) const {
    std::size_t const leastStep = neighbours == Neighbours::LeftOut ? 2 : 1;
    std::size_t const end = EndOfPieces(leaf);
    for (std::size_t i = FirstPiece(leaf); i < end; ++i) {
      for (std::size_t k = i + leastStep; k < end; ++k) {
        if (!extents_[i].box.IsApartFrom(extents_[k].box) && test(i, k)) return true;
      }
    }
    return false;
  }

  /// Whether the test answers true for a piece below my node and one below theirs.
  template <typename Test>
  bool AnyPairBetween(Place const& mine, BoxTree& other, Place const& theirs, Test const& test) {
    if (AreApart(mine, other, theirs)) return false;
    if (mine.level == 0 && theirs.level == 0) return AnyPairOfLeaves(mine, other, theirs, test);
    // The higher node is divided; of two nodes of one level both are.
    if (mine.level < theirs.level) return AnyPairWithChildren(mine, other, theirs, test);
    auto const search = [&](Place const& child) {
      return mine.level > theirs.level ? AnyPairBetween(child, other, theirs, test)
                                       : AnyPairWithChildren(child, other, theirs, test);
    };
    return search(FirstChild(mine)) || (HasSecondChild(mine) && search(SecondChild(mine)));
  }

  /// The same with their node divided.
  template <typename Test>
  bool AnyPairWithChildren(Place const& mine, BoxTree& other, Place const& theirs,
                           Test const& test) {
    return AnyPairBetween(mine, other, FirstChild(theirs), test) ||
           (other.HasSecondChild(theirs) && AnyPairBetween(mine, other, SecondChild(theirs), test));
  }

  /// The same for two leaves: every pair whose boxes are not apart.
  template <typename Test>
  bool AnyPairOfLeaves(Place const& mine, BoxTree& other, Place const& theirs, Test const& test) {
    std::size_t near[kPiecesPerLeaf];
    std::size_t* const nearEnd = CollectNear(mine, other, theirs, near);
    std::size_t const end = other.EndOfPieces(theirs);
    for (std::size_t const* i = near; i != nearEnd; ++i) {
      Box const& box = extents_[*i].box;
      for (std::size_t k = FirstPiece(theirs); k < end; ++k) {
        if (!box.IsApartFrom(other.extents_[k].box) && test(*i, k)) return true;
      }
    }
    return false;
  }

  /// Writes the numbers of my pieces that are not apart from all of their leaf; returns their end.
  std::size_t* CollectNear(Place const& mine, BoxTree& other, Place const& theirs,
                           std::size_t* near) const;

  std::vector<Extent> extents_;
  double margin_;
  std::vector<std::vector<Node>> levels_;
  std::vector<std::vector<std::optional<Trapezium>>> trapezia_;  ///< by level and number
};

}  // namespace Vorn::Contours
