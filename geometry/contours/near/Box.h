// Axis-parallel boxes around pieces of a contour, and how consecutive ones follow on each other.

#pragma once

#include <algorithm>
#include <cstdint>
#include <limits>

namespace Vorn::Contours {

/// An axis-parallel box, its sides included. Starts out empty: apart from every box.
struct Box {
  double xLow = std::numeric_limits<double>::infinity();
  double xHigh = -std::numeric_limits<double>::infinity();
  double yLow = std::numeric_limits<double>::infinity();
  double yHigh = -std::numeric_limits<double>::infinity();

  /// Whether nothing was included.
  bool IsEmpty() const { return xLow > xHigh; }

  /// Whether the box is a single point.
  bool IsPoint() const { return xLow == xHigh && yLow == yHigh; }

  /// Whether the two have no point in common.
  bool IsApartFrom(Box const& other) const {
    return xLow > other.xHigh || other.xLow > xHigh || yLow > other.yHigh || other.yLow > yHigh;
  }

  /// Grows until it holds the other one as well.
  void Include(Box const& other) {
    xLow = std::min(xLow, other.xLow);
    xHigh = std::max(xHigh, other.xHigh);
    yLow = std::min(yLow, other.yLow);
    yHigh = std::max(yHigh, other.yHigh);
  }
};

/// The region that holds a piece: a segment, a box around a curved piece, or none (an empty box)
/// for a piece that the search is to pass over.
struct Extent {
  Box box;
  bool isRising = true;    ///< of a segment: does y grow with x?
  bool isSegment = false;  ///< the region is one diagonal of the box, not all of it
};

/// How the boxes of consecutive pieces follow on each other. Where each begins, along x and along
/// y, no earlier than the one before ends, they form a staircase, and two of them with another one
/// in between are apart: the one in between has a width or a height, unless it is a point.
class Stairs {
 public:
  /// Of one box: a staircase in every sense, but for a point or an empty box, which is in none.
  static Stairs Of(Box const& box) {
    return Stairs(box.IsEmpty() || box.IsPoint() ? kNone : kEverySense);
  }

  /// Of the boxes of two consecutive runs of pieces, followed by each other.
  static Stairs Join(Stairs first, Box const& firstBox, Stairs second, Box const& secondBox) {
    unsigned senses = first.senses_ & second.senses_;
    if (senses == kNone) return Stairs(kNone);
    if (!(firstBox.xHigh <= secondBox.xLow)) senses &= ~kRightward;
    if (!(secondBox.xHigh <= firstBox.xLow)) senses &= ~kLeftward;
    if (!(firstBox.yHigh <= secondBox.yLow)) senses &= ~kUpward;
    if (!(secondBox.yHigh <= firstBox.yLow)) senses &= ~kDownward;
    return Stairs(senses);
  }

  /// Whether the boxes are a staircase, so that only consecutive ones can have points in common.
  bool AreMonotone() const {
    return (senses_ & (kRightward | kLeftward)) != 0 && (senses_ & (kUpward | kDownward)) != 0;
  }

 private:
  static constexpr unsigned kNone = 0;
  static constexpr unsigned kRightward = 1;
  static constexpr unsigned kLeftward = 2;
  static constexpr unsigned kUpward = 4;
  static constexpr unsigned kDownward = 8;
  static constexpr unsigned kEverySense = kRightward | kLeftward | kUpward | kDownward;

  /// Of the senses in which the boxes are a staircase, a sum of the bits above.
  explicit Stairs(unsigned senses) : senses_(static_cast<std::uint8_t>(senses)) {}

  std::uint8_t senses_;
};

}  // namespace Vorn::Contours
