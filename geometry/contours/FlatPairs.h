// The pieces of a flat polyline and what a pair of them says about its crossing itself: the one
// rule that the walk over all pairs and the search for near ones share.

#pragma once

#include <cstdint>

#include "geometry/contours/FlatLayout.h"
#include "geometry/elementary/Shapes.h"

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

/// What a pair says, the first piece being the earlier one. Straight pieces cross with exactly one
/// common point, so that overlaps are no crossing.
Verdict Judge(Data const& data, FlatPiece const& first, FlatPiece const& second);

}  // namespace Vorn::Flat
