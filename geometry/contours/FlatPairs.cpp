#include "geometry/contours/FlatPairs.h"

#include <optional>

#include "geometry/intersections/Arcs.h"
#include "geometry/intersections/SegmentPair.h"

namespace Vorn::Flat {

namespace {

using Elementary::Segment;
using Intersections::CirclePoints;

constexpr Verdict Invalid(ErrorCode code) { return {code, false}; }
constexpr Verdict CrossingIf(bool isCrossing) { return {ErrorCode::Ok, isCrossing}; }

/// Deliberate: one common point is no crossing here, but it is one in the opposite order.
Verdict JudgeStraightArc(Segment const& straight, Arc const& arc) {
  std::optional<CirclePoints> const common = Intersections::CutArcBySegment(arc, straight);
  return common ? CrossingIf(common->count == 2) : Invalid(ErrorCode::Failed);
}

Verdict JudgeArcStraight(Arc const& arc, Segment const& straight) {
  std::optional<CirclePoints> const common = Intersections::CutArcBySegment(arc, straight);
  return common ? CrossingIf(common->count > 0) : Invalid(ErrorCode::Failed);
}

/// One common point is accepted as the joint of consecutive records.
Verdict JudgeArcs(Arc const& first, Arc const& second, bool areConsecutive) {
  std::optional<CirclePoints> const common = Intersections::CutArcByArc(first, second);
  if (!common) return Invalid(ErrorCode::InvalidArcRadius);
  return CrossingIf(common->count == 2 || (common->count == 1 && !areConsecutive));
}

}  // namespace

Verdict Judge(Data const& data, FlatPiece const& first, FlatPiece const& second) {
  if (!IsInside(data, first) || !IsInside(data, second)) return Invalid(ErrorCode::Failed);
  if (first.kind == kVertexRun) {
    Segment const straight = StraightAt(data, first.offset);
    if (second.kind != kVertexRun) return JudgeStraightArc(straight, data.ArcAt(second.offset));
    return CrossingIf(Intersections::HaveOneCommonPoint(straight, StraightAt(data, second.offset)));
  }
  Arc const arc = data.ArcAt(first.offset);
  if (second.kind == kVertexRun) return JudgeArcStraight(arc, StraightAt(data, second.offset));
  bool const areConsecutive = second.offset == first.offset + kRecordStride;
  return JudgeArcs(arc, data.ArcAt(second.offset), areConsecutive);
}

}  // namespace Vorn::Flat
