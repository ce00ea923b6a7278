#pragma once

#include <vector>

#include "geometry/fewest/Assembly.h"
#include "geometry/fewest/Chain.h"
#include "geometry/fewest/LocalFrame.h"
#include "vorn/FewestPieces.h"
#include "vorn/GeometryUtils.h"

/// Chains in the coordinates of the caller.
namespace Vorn::Fewest {

/// A contour and the points that its pieces cover.
struct Answer {
  std::vector<GeometryUtils::Elem> contour;
  std::vector<FewestPieces::Range> ranges;
};

/// The pieces of a chain moved back to where the caller's points lie.
Answer Restore(Shift const& shift, Chain const& chain, std::vector<BuiltPiece> const& pieces);

/// Closes an open contour by a segment back to its start, which takes over the last point. Answers
/// false where the last piece covers no other point or ends where the contour starts.
bool AppendClosingSegment(Answer* answer);

/// Rounds the ends of a single segment to a millionth of the least tolerance; leaves other contours
/// as they are. Points exactly at their tolerances on both sides of a line leave no room for
/// rounding, and such a line is nearly always one of round numbers.
void RoundEnds(double leastTolerance, Answer* answer);

}  // namespace Vorn::Fewest
