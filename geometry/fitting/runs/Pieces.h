// The pieces that the fitters find: a segment or an arc along a run of measured points.

#pragma once

#include <cstdint>

#include "geometry/elementary/Shapes.h"
#include "geometry/fitting/runs/Deviations.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

/// What every piece has. All fields are defined in a piece that a fitter has handed out.
struct Piece {
  /// Where it begins: the fixed start if there is one.
  Point start;
  /// Where it ends: the fixed end if there is one.
  Point end;
  /// The number of points covered, the first and the last included.
  std::int32_t count = 0;
  /// The largest distance of a covered point from the piece's line or circle, divided by the
  /// point's tolerance; the index is that of the point among all measured points. A line through
  /// equal ends has the value 0.0 and the index -1.
  Deviation deviation;
};

/// A segment along a run.
struct FittedLine : Piece {
  /// Whether the run ends where it does because the points turn back there.
  bool hasTurnedBack = false;
};

/// An arc along a run.
struct FittedArc : Piece {
  Elementary::Circle circle;
  /// Whether it runs counter-clockwise.
  bool ccw = false;
};

}  // namespace Vorn::Fitting
