#include "geometry/contours/PairRule.h"

#include <optional>

#include "geometry/intersections/Arcs.h"

namespace Vorn::Contours {

namespace {

using Intersections::ArcRange;
using Intersections::CirclePoints;

PairResult JudgeTouch(int count, bool isAccepted) {
  if (count == 0 || (count == 1 && isAccepted)) return PairResult::Clear;
  return PairResult::Crossing;
}

PairResult JudgeSegmentArc(Piece const& segment, ArcRange const& arc, PairPlace const& place) {
  if (arc.range.IsUndefined()) return PairResult::Invalid;
  return JudgeTouch(Intersections::CutArcBySegment(arc, segment.AsSegment()).count,
                    place.isClosing);
}

PairResult JudgeArcSegment(ArcRange const& arc, Piece const& segment, PairPlace const& place) {
  // Deliberate: unlike as a candidate, an arc of equal angles passes here for free of crossings.
  if (arc.range.IsUndefined()) return PairResult::Clear;
  return JudgeTouch(Intersections::CutArcBySegment(arc, segment.AsSegment()).count,
                    place.isFirstCandidate || place.isClosing);
}

PairResult JudgeArcs(Arc const& first, Arc const& second, PairPlace const& place) {
  std::optional<CirclePoints> const common = Intersections::CutArcByArc(first, second);
  if (!common) return PairResult::Invalid;
  bool const isAccepted = place.isNeighbour || place.isClosing;
  // Deliberate: an accepted touch of two arcs ends the scan of the first; the elements after the
  // second are not looked at.
  if (common->count == 1 && isAccepted) return PairResult::EndOfScan;
  return JudgeTouch(common->count, isAccepted);
}

}  // namespace

PairResult JudgeWithArc(Piece const& first, Piece const& second, PairPlace const& place) {
  if (first.IsSegment()) return JudgeSegmentArc(first, *second.arc, place);
  if (second.IsSegment()) return JudgeArcSegment(*first.arc, second, place);
  return JudgeArcs(*first.arc, *second.arc, place);
}

}  // namespace Vorn::Contours
