#pragma once

#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn::IO {

/// One piece of a contour with all that follows from its neighbours: a contour element alone does
/// not know where it starts.
struct Piece {
  enum class Kind { Line, Arc };

  Kind kind = Kind::Line;
  GeometryUtils::Point start;
  GeometryUtils::Point end;
  double length = 0.0;

  // Of arcs only.
  GeometryUtils::Point center;
  double radius = 0.0;
  bool counterClockwise = false;
  double startAngle = 0.0;
  double endAngle = 0.0;
  double sweep = 0.0;  ///< radians turned from start to end, never negative

  bool IsArc() const { return kind == Kind::Arc; }
};

/// The pieces of a contour; its first element only places the start. An arc with equal angles has
/// no sweep.
/// @throws Failure (FailureKind::Internal) for an element that is neither segment nor arc.
std::vector<Piece> PiecesOf(std::vector<GeometryUtils::Elem> const& contour);

/// The point of the arc piece at `angle`, radians turned from its start.
GeometryUtils::Point PointOnArc(Piece const& arc, double angle);

}  // namespace Vorn::IO
