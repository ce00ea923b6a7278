// The pieces of a flat polyline and what a pair of them says about its crossing itself: the one
// rule that the walk over all pairs and the search for near ones share.

#pragma once

#include <cstdint>

#include "geometry/contours/FlatLayout.h"
#include "geometry/elementary/Shapes.h"
#include "geometry/intersections/SegmentPair.h"

namespace Vorn::Flat {

/// A straight piece to the next vertex, or the arc of a record.
struct FlatPiece {
  std::int64_t offset;
  std::int32_t kind;
};

/// What a pair of pieces, or all pairs up to now, say.
struct Verdict {
  ErrorCode code = ErrorCode::Ok;
  bool isCrossing = false;

  /// Whether nothing that comes later changes it.
  bool IsFinal() const { return isCrossing || code != ErrorCode::Ok; }
};

/// Whether the data holds all that describes a piece.
inline bool IsInside(Data const& data, FlatPiece const& piece) {
  std::int64_t const last =
      piece.kind == kVertexRun ? piece.offset + kVertexStride + 1 : piece.offset + kRecordEndAngle;
  return data.Holds(piece.offset, last);
}

/// A straight piece that the data holds.
inline Elementary::Segment StraightAt(Data const& data, std::int64_t offset) {
  return {data.PointAt(offset), data.PointAt(offset + kVertexStride)};
}

/// What a pair of which one piece is an arc says.
Verdict JudgeWithArc(Data const& data, FlatPiece const& first, FlatPiece const& second);

/// What a pair says, the first piece being the earlier one; Failed where a piece is not inside the
/// data. Straight pieces cross with exactly one common point, so that overlaps are no crossing.
/// Inline, since most pairs of straight pieces are settled by the first comparisons.
inline Verdict Judge(Data const& data, FlatPiece const& first, FlatPiece const& second) {
  if (!IsInside(data, first) || !IsInside(data, second)) return {ErrorCode::Failed, false};
  if (first.kind != kVertexRun || second.kind != kVertexRun) {
    return JudgeWithArc(data, first, second);
  }
  return {ErrorCode::Ok, Intersections::HaveOneCommonPoint(StraightAt(data, first.offset),
                                                           StraightAt(data, second.offset))};
}

}  // namespace Vorn::Flat
