#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "geometry/fewest/promises/DrawnPiece.h"
#include "geometry/fewest/promises/Promises.h"

/// Which points belong to which piece.
namespace Vorn::Promises {

/// Consecutive points by running number, both ends included.
struct NumberRange {
  std::size_t first = 0;
  std::size_t last = 0;
};

/// A chain whose ranges follow each other without gaps. The running number of a point is its index;
/// on a closed contour numbers run on past the last point to the first one.
class Coverage {
 public:
  /// Nothing when the chain is not well formed.
  static std::optional<Coverage> Of(Chain const& chain);

  /// The chain as it was given.
  Chain const& GetChain() const { return chain_; }
  /// How many pieces there are, one at least.
  std::size_t PieceCount() const { return ranges_.size(); }
  /// Whether the contour runs back to its start.
  bool IsClosed() const { return chain_.isClosed; }

  /// The points of a piece, by running number.
  NumberRange const& RangeOf(std::size_t piece) const { return ranges_[piece]; }
  /// The index of a point by its running number.
  std::size_t IndexOf(std::size_t number) const { return number % chain_.points.size(); }
  /// The point of a running number.
  WPoint const& PointOf(std::size_t number) const { return chain_.points[IndexOf(number)]; }

  /// The neighbours of a piece; kNone beyond the ends of an open contour.
  std::size_t Previous(std::size_t piece) const;
  /// The piece after it, see Previous.
  std::size_t Next(std::size_t piece) const;

  /// The element of the contour that a piece is.
  GeometryUtils::Elem const& ElemOf(std::size_t piece) const { return chain_.contour[piece + 1]; }
  /// A piece as it is drawn from the end of the one before.
  DrawnPiece Drawn(std::size_t piece) const {
    return Draw(chain_.contour[piece].end, ElemOf(piece));
  }

 private:
  /// Of a chain whose pieces and points exist; NumberPoints has to follow.
  explicit Coverage(Chain const& chain) : chain_(chain) {}

  /// Gives the pieces their ranges by running number; false when a point is left out or covered
  /// twice.
  bool NumberPoints();

  Chain chain_;
  std::vector<NumberRange> ranges_;
};

}  // namespace Vorn::Promises
