// What two pieces of a contour say about its crossing itself: the one rule that the walk over all
// pairs and the search for near ones share.

#pragma once

#include "geometry/contours/near/PieceExtents.h"
#include "geometry/intersections/SegmentPair.h"

namespace Vorn::Contours {

/// What a pair says: nothing, that the later elements need not be compared with the first of it,
/// that the contour crosses or touches itself, or that it cannot be told.
enum class PairResult { Clear, EndOfScan, Crossing, Invalid };

/// Where a pair (i, k) stands in the contour, by which some touches are accepted. By default
/// nothing is.
struct PairPlace {
  bool isClosing = false;         ///< i is the first element and k the last of the contour
  bool isFirstCandidate = false;  ///< k is the first element that i is tested against
  bool isNeighbour = false;       ///< k comes physically right after i
};

/// What a pair says of which one piece is an arc.
PairResult JudgeWithArc(Piece const& first, Piece const& second, PairPlace const& place);

/// What a pair says, the first piece being the earlier one. Only a single common point of two
/// segments is a crossing: parallel and overlapping ones are not. The end points of arcs never
/// count. Inline, since most pairs of segments are settled by the first comparisons.
inline PairResult Judge(Piece const& first, Piece const& second, PairPlace const& place) {
  if (!first.IsSegment() || !second.IsSegment()) return JudgeWithArc(first, second, place);
  if (place.isClosing) return PairResult::EndOfScan;
  return Intersections::HaveOneCommonPoint(first.AsSegment(), second.AsSegment())
             ? PairResult::Crossing
             : PairResult::Clear;
}

}  // namespace Vorn::Contours
