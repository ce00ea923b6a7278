#pragma once

#include <vector>

#include "vorn/GeometryUtils.h"
#include "vorn/io/Export.h"

namespace Vorn::IO {

/// A place in the plane, in the units of the contour.
using XY = GeometryUtils::Point;

/// One piece of a contour with all that follows from its neighbours: a contour element alone does
/// not know where it starts.
struct Piece {
  /// A straight line or an arc of a circle.
  enum class Kind { Line, Arc };

  Kind kind = Kind::Line;  ///< which of the two it is
  XY start;                ///< where it begins
  XY end;                  ///< where it ends
  double length = 0.0;     ///< along the piece

  // The rest is of arcs only.
  XY center;                      ///< of the circle
  double radius = 0.0;            ///< above 0
  bool counterClockwise = false;  ///< the sense of travel, y pointing up
  double startAngle = 0.0;        ///< polar angle of the start from the centre, radians
  double endAngle = 0.0;          ///< the same of the end
  double sweep = 0.0;             ///< radians turned from start to end, never negative

  /// Whether it is an arc; else it is a line.
  bool IsArc() const { return kind == Kind::Arc; }
};

/// The pieces of a contour; its first element only places the start. An arc with equal angles has
/// no sweep.
/// @throws Failure (FailureKind::Internal) for an element that is neither segment nor arc.
VORN_IO_EXPORT std::vector<Piece> PiecesOf(std::vector<GeometryUtils::Elem> const& contour);

/// The point of the arc piece at `angle`, radians turned from its start.
VORN_IO_EXPORT XY PointOnArc(Piece const& arc, double angle);

/// Distance of (x, y) from the nearest place of the piece.
VORN_IO_EXPORT double DistanceTo(Piece const& piece, double x, double y);

/// The place of a piece that is nearest to a point.
struct Foot {
  XY at;               ///< the place
  double along = 0.0;  ///< length of the piece from its start to here
};

/// The place of the piece that is nearest to (x, y).
VORN_IO_EXPORT Foot FootOn(Piece const& piece, double x, double y);

/// The distance of two places.
VORN_IO_EXPORT double Distance(XY const& a, XY const& b);

/// The straight piece between two places.
VORN_IO_EXPORT Piece MakeLine(XY const& start, XY const& end);

/// The arc with these data; angles, sweep and length follow. Ends in the same direction from the
/// centre mean no sweep.
VORN_IO_EXPORT Piece MakeArc(XY const& start, XY const& end, XY const& center, double radius,
                             bool counterClockwise);

/// The whole circle as two halves, from `start` back to it.
VORN_IO_EXPORT std::vector<Piece> MakeCircle(XY const& start, XY const& center, double radius,
                                             bool counterClockwise);

/// The same piece run through from its end to its start.
VORN_IO_EXPORT Piece Reversed(Piece const& piece);

/// The box around the pieces, what arcs bulge out included. Needs at least one piece.
struct Extent {
  XY low;   ///< the least x and y
  XY high;  ///< the largest x and y
};
/// The box of at least one piece.
VORN_IO_EXPORT Extent ExtentOf(std::vector<Piece> const& pieces);

}  // namespace Vorn::IO
