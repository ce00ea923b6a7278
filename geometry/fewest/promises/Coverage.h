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

  Chain const& GetChain() const { return chain_; }
  std::size_t PieceCount() const { return ranges_.size(); }
  bool IsClosed() const { return chain_.isClosed; }

  /// The points of a piece, by running number.
  NumberRange const& RangeOf(std::size_t piece) const { return ranges_[piece]; }
  std::size_t IndexOf(std::size_t number) const { return number % chain_.points.size(); }
  WPoint const& PointOf(std::size_t number) const { return chain_.points[IndexOf(number)]; }

  /// The neighbours of a piece; kNone beyond the ends of an open contour.
  std::size_t Previous(std::size_t piece) const;
  std::size_t Next(std::size_t piece) const;

  GeometryUtils::Elem const& ElemOf(std::size_t piece) const { return chain_.contour[piece + 1]; }
  DrawnPiece Drawn(std::size_t piece) const {
    return Draw(chain_.contour[piece].end, ElemOf(piece));
  }

 private:
  explicit Coverage(Chain const& chain) : chain_(chain) {}

  bool NumberPoints();

  Chain chain_;
  std::vector<NumberRange> ranges_;
};

}  // namespace Vorn::Promises
