#include "geometry/contours/FlatPairs.h"

#include <optional>

#include "geometry/intersections/Arcs.h"

namespace Vorn::Flat {

namespace {

using Elementary::Segment;
using Intersections::ArcRange;
using Intersections::CirclePoints;

constexpr Verdict Invalid(ErrorCode code) { return {code, false}; }
constexpr Verdict CrossingIf(bool isCrossing) { return {ErrorCode::Ok, isCrossing}; }

/// Deliberate: one common point is no crossing here, but it is one in the opposite order.
Verdict JudgeStraightArc(Segment const& straight, ArcRange const& arc) {
  if (arc.range.IsUndefined()) return Invalid(ErrorCode::Failed);
  return CrossingIf(Intersections::CutArcBySegment(arc, straight).count == 2);
}

Verdict JudgeArcStraight(ArcRange const& arc, Segment const& straight) {
  if (arc.range.IsUndefined()) return Invalid(ErrorCode::Failed);
  return CrossingIf(Intersections::CutArcBySegment(arc, straight).count > 0);
}

/// One common point is accepted as the joint of consecutive records.
Verdict JudgeArcs(Arc const& first, Arc const& second, bool areConsecutive) {
  std::optional<CirclePoints> const common = Intersections::CutArcByArc(first, second);
  if (!common) return Invalid(ErrorCode::InvalidArcRadius);
  return CrossingIf(common->count == 2 || (common->count == 1 && !areConsecutive));
}

}  // namespace

Verdict JudgeWithArc(Data const& data, FlatPiece const& first, FlatPiece const& second) {
  if (first.kind == kVertexRun) {
    return JudgeStraightArc(StraightAt(data, first.offset), data.ArcAt(second.offset));
  }
  Arc const arc = data.ArcAt(first.offset);
  if (second.kind == kVertexRun) return JudgeArcStraight(arc, StraightAt(data, second.offset));
  bool const areConsecutive = second.offset == first.offset + kRecordStride;
  return JudgeArcs(arc, data.ArcAt(second.offset), areConsecutive);
}

}  // namespace Vorn::Flat
