#pragma once

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <optional>
#include <vector>

#include "vorn/GeometryUtils.h"

/// Finding the pairs of pieces that come near each other without looking at all pairs.
namespace Vorn::Contours {

/// An axis-parallel box, its sides included. Starts out empty: apart from every box.
struct Box {
  double xLow = std::numeric_limits<double>::infinity();
  double xHigh = -std::numeric_limits<double>::infinity();
  double yLow = std::numeric_limits<double>::infinity();
  double yHigh = -std::numeric_limits<double>::infinity();

  bool IsEmpty() const { return xLow > xHigh; }
  bool IsApartFrom(Box const& other) const {
    return xLow > other.xHigh || other.xLow > xHigh || yLow > other.yHigh || other.yLow > yHigh;
  }
  void Include(Box const& other);
};

/// The region that holds a piece: a segment, a box around a curved piece, or none (an empty box)
/// for a piece that the search is to pass over.
struct Extent {
  Box box;
  bool isRising = true;    ///< of a segment: does y grow with x?
  bool isSegment = false;  ///< the region is one diagonal of the box, not all of it
};

/// The region on the left of two sides that run in opposite senses, between their ends.
struct Trapezium {
  struct Side {
    GeometryUtils::Point from;
    GeometryUtils::Point to;
  };
  Side lower;
  Side upper;
};

/// A binary tree over pieces in the order of their contour. A node holds a run of consecutive
/// pieces, which lie near each other because the pieces form a chain, and is bounded twice: by an
/// axis-parallel box and by a trapezium whose long sides follow the outermost pieces of the run.
/// The trapezia keep bundles and fans of long slanted pieces apart, whose boxes all overlap; they
/// are formed when they are first asked for, which most contours do for few nodes.
///
/// Memory is linear in the number of pieces. Empty extents are in no pair.
class BoxTree {
 public:
  /// Trapezia count as apart only when the gap exceeds margin; boxes need no gap.
  BoxTree(std::vector<Extent> extents, double margin);

  /// Calls test(i, k) for pairs i < k until it answers true, and returns whether it did. Every pair
  /// is tested but for those of which some bounds are apart; the order of the pairs is not defined.
  template <typename Test>
  bool AnyPair(Test const& test) {
    return !extents_.empty() && AnyPairWithin(Root(), test);
  }

  /// The same for all pairs of a piece i of this tree and a piece k of the other.
  template <typename Test>
  bool AnyPair(BoxTree& other, Test const& test) {
    if (extents_.empty() || other.extents_.empty()) return false;
    return AnyPairBetween(Root(), other, other.Root(), test);
  }

 private:
  using Point = GeometryUtils::Point;

  /// Level 0 holds the leaves; node j of a level has the children 2j and 2j + 1 one level below.
  struct Place {
    std::size_t level;
    std::size_t number;
  };

  static constexpr std::size_t kPiecesPerLeaf = 6;

  static Trapezium TrapeziumOf(Extent const& extent);
  static Trapezium Around(Trapezium const* parts, std::size_t count);

  /// Of a node whose box is not empty.
  Trapezium const& TrapeziumAt(Place const& place);
  Trapezium FormTrapezium(Place const& place);

  bool AreApart(Place const& mine, BoxTree& other, Place const& theirs) {
    if (BoxAt(mine).IsApartFrom(other.BoxAt(theirs))) return true;
    // Next to each other on the chain means a common joint.
    bool const areNeighbours =
        this == &other && mine.level == theirs.level && mine.number + 1 == theirs.number;
    if (areNeighbours) return false;
    Trapezium const& a = TrapeziumAt(mine);
    Trapezium const& b = other.TrapeziumAt(theirs);
    return IsOutside(a, b) || IsOutside(b, a);
  }

  /// Is the second one beyond a long side of the first?
  bool IsOutside(Trapezium const& first, Trapezium const& second) const {
    return IsBeyond(first.lower, second) || IsBeyond(first.upper, second);
  }

  bool IsBeyond(Trapezium::Side const& side, Trapezium const& t) const {
    double const dx = side.to.x - side.from.x;
    double const dy = side.to.y - side.from.y;
    double const gap = margin_ * (std::fabs(dx) + std::fabs(dy));
    auto const isBeyond = [&](Point const& p) {
      return dy * (p.x - side.from.x) - dx * (p.y - side.from.y) > gap;
    };
    return isBeyond(t.lower.from) && isBeyond(t.lower.to) && isBeyond(t.upper.from) &&
           isBeyond(t.upper.to);
  }

  Place Root() const { return {boxes_.size() - 1, 0}; }
  Box const& BoxAt(Place const& place) const { return boxes_[place.level][place.number]; }
  static Place FirstChild(Place const& place) { return {place.level - 1, 2 * place.number}; }
  bool HasSecondChild(Place const& place) const {
    return 2 * place.number + 1 < boxes_[place.level - 1].size();
  }
  static Place SecondChild(Place const& place) { return {place.level - 1, 2 * place.number + 1}; }
  static std::size_t FirstPiece(Place const& leaf) { return leaf.number * kPiecesPerLeaf; }
  std::size_t EndOfPieces(Place const& leaf) const {
    return std::min(FirstPiece(leaf) + kPiecesPerLeaf, extents_.size());
  }

  template <typename Test>
  bool AnyPairWithin(Place const& place, Test const& test) {
    if (place.level == 0) return AnyPairOfLeaf(place, test);
    if (AnyPairWithin(FirstChild(place), test)) return true;
    if (!HasSecondChild(place)) return false;
    return AnyPairWithin(SecondChild(place), test) ||
           AnyPairBetween(FirstChild(place), *this, SecondChild(place), test);
  }

  template <typename Test>
  bool AnyPairOfLeaf(Place const& leaf, Test const& test) const {
    std::size_t const end = EndOfPieces(leaf);
    for (std::size_t i = FirstPiece(leaf); i < end; ++i) {
      for (std::size_t k = i + 1; k < end; ++k) {
        if (!extents_[i].box.IsApartFrom(extents_[k].box) && test(i, k)) return true;
      }
    }
    return false;
  }

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

  template <typename Test>
  bool AnyPairWithChildren(Place const& mine, BoxTree& other, Place const& theirs,
                           Test const& test) {
    return AnyPairBetween(mine, other, FirstChild(theirs), test) ||
           (other.HasSecondChild(theirs) && AnyPairBetween(mine, other, SecondChild(theirs), test));
  }

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
                           std::size_t* near) const {
    Box const& theirBox = other.BoxAt(theirs);
    std::size_t* end = near;
    for (std::size_t i = FirstPiece(mine); i < EndOfPieces(mine); ++i) {
      if (!extents_[i].box.IsApartFrom(theirBox)) *end++ = i;
    }
    // Single pieces at a joint are not worth a trapezium.
    constexpr std::ptrdiff_t kFew = 2;
    if (end - near <= kFew) return end;
    Trapezium const& trapezium = other.TrapeziumAt(theirs);
    return std::remove_if(
        near, end, [&](std::size_t i) { return IsOutside(trapezium, TrapeziumOf(extents_[i])); });
  }

  std::vector<Extent> extents_;
  double margin_;
  std::vector<std::vector<Box>> boxes_;  ///< by level and number
  std::vector<std::vector<std::optional<Trapezium>>> trapezia_;
};

}  // namespace Vorn::Contours
