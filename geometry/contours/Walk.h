// The walk over the elements of a contour and the pass of one element over those after it.

#pragma once

#include <cstddef>

#include "geometry/contours/Elements.h"
#include "geometry/contours/PairRule.h"

namespace Vorn::Contours {

/// Which pass: that of the first element of the contour has rules of its own.
enum class Pass { First, Later };

/// Steps over the elements of a contour, which must stay.
class Walk {
 public:
  /// Over a contour that has an element.
  explicit Walk(Contour const& contour) : end_(contour.data() + contour.size()) {}

  /// The next element that does not end where this one ends; null when there is none before the end
  /// of the contour or before an element of an unknown kind. O(1) but for elements of no length.
  Elem const* Next(Elem const* elem) const {
    if (!IsKnown(*elem)) return nullptr;
    for (Elem const* next = elem + 1; next != end_ && IsKnown(*next); ++next) {
      if (!IsSamePlace(elem->end, next->end)) return next;
    }
    return nullptr;
  }

  /// Whether it is the last element of the contour, of any length.
  bool IsLast(Elem const* elem) const { return elem + 1 == end_; }

  /// At most so many elements come after this one.
  std::size_t CountAfter(Elem const* elem) const {
    return static_cast<std::size_t>(end_ - elem) - 1;
  }

  /// An element that is not the first one, as a piece.
  static Piece PieceOf(Elem const* elem) {
    return {(elem - 1)->end, elem->end, IsSegment(*elem) ? nullptr : elem};
  }

  /// Compares an element with those after it until a pair ends that. Failed when a pair is invalid
  /// and, in the first pass, when the last element is not reached. O(n).
  ErrorCode Scan(Elem const* elem, Pass pass) const;

 private:
  /// The first element that this one is tested against; null when there is none.
  Elem const* FirstCandidate(Elem const* elem) const;

  Elem const* end_;
};

}  // namespace Vorn::Contours
