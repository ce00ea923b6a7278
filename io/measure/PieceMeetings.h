#pragma once

#include <optional>
#include <vector>

#include "io/pieces/Shapes.h"

namespace Vorn::IO {

/// A place that two pieces have in common: a point, or a stretch along both.
struct Meeting {
  XY at;
  std::optional<XY> until;  ///< the other end of a stretch
  bool isTangent = false;   ///< both run in one direction or in opposite ones there
};

/// All places that two pieces have in common, their ends included. Ends that lie within `tolerance`
/// of the other piece are on it, and circles and lines that miss each other by no more touch.
///
/// The library serves for the crossing of two lines; its functions for arcs are not public.
std::vector<Meeting> MeetingsOf(Piece const& a, Piece const& b, double tolerance);

/// How far along the piece the point lies, as a length from its start; 0 to its length.
double PositionOn(Piece const& piece, XY const& point);

/// The direction of travel at that place of the piece, of length 1.
XY DirectionAt(Piece const& piece, double position);

}  // namespace Vorn::IO
