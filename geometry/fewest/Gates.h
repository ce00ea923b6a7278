#pragma once

#include <cstdint>

#include "geometry/fewest/Circle.h"

/// Gates: short lines across the path on which two pieces may meet.
namespace Vorn::Fewest {

/// A line across the path. Points before `split` belong to the piece before it, the others to the
/// piece behind. In the shifted coordinates of the whole path.
struct Gate {
  std::int32_t split = 0;
  /// Where offset 0 lies.
  Place origin;
  /// Unit vector in the direction of growing offsets, to the left of the path.
  Place across;
  /// Least and greatest offset at which the joint may lie.
  double least = 0.0;
  double greatest = 0.0;
  /// Whether the path turns back here: the piece behind crosses the gate the other way.
  bool isCusp = false;
};

/// The gate as the piece behind it sees it: at a cusp its offsets change their sign. Its own
/// inverse.
inline Gate SeenFromBehind(Gate const& gate) {
  if (!gate.isCusp) return gate;
  Gate behind = gate;
  behind.across = {-gate.across.x, -gate.across.y};
  behind.least = -gate.greatest;
  behind.greatest = -gate.least;
  return behind;
}

/// The place on a gate at an offset.
inline Place PlaceOn(Gate const& gate, double offset) {
  return {gate.origin.x + offset * gate.across.x, gate.origin.y + offset * gate.across.y};
}

/// Offset at which a circle crosses a gate, in the coordinates of both; false when it does not.
bool FindCrossing(Circle const& circle, Gate const& gate, double* offset);

/// The same for a circle of the path.
bool FindCrossing(PlacedCircle const& circle, Gate const& gate, double* offset);

/// A gate with the offsets at which the piece before can end.
struct Opening {
  Gate gate;
  double low = 0.0;
  double high = 0.0;
  /// No gate at all: the chain begins, or ends, at the end of the path.
  bool isFree = true;

  /// The first point of a piece that starts here.
  std::int32_t First() const { return isFree ? 0 : gate.split; }
};

/// The one offset of a gate at which the piece before it ends.
inline Opening EndAt(Gate const& gate, double offset) { return {gate, offset, offset, false}; }

/// The same as the piece behind it starts there.
inline Opening StartAt(Gate const& gate, double offset) {
  double const seen = gate.isCusp ? -offset : offset;
  return {SeenFromBehind(gate), seen, seen, false};
}

}  // namespace Vorn::Fewest
