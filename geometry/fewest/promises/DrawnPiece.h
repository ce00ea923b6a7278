#pragma once

#include "vorn/GeometryUtils.h"

/// One piece of a contour as it is drawn, and where points lie to it.
namespace Vorn::Promises {

/// What one rounding may change, relative to the result.
inline constexpr double kUnitRoundoff = 0x1p-53;

/// A segment or an arc. Differences are taken from its start: they are small where the
/// coordinates of the part are large, and the centre of a flat arc is never measured from far away.
struct DrawnPiece {
  GeometryUtils::Point start;
  GeometryUtils::Point end;
  bool isArc = false;
  GeometryUtils::Point toEnd;     ///< end - start
  GeometryUtils::Point centre;    ///< of an arc only, as are all below but the length
  GeometryUtils::Point toCentre;  ///< centre - start
  double radius = 0.0;
  double sense = 0.0;  ///< +1 counter-clockwise, -1 clockwise
  double sweep = 0.0;  ///< in [0, 2 pi)
  double power = 0.0;  ///< PowerOf the start
  double length = 0.0;
};

/// The piece that an element makes from a point on.
DrawnPiece Draw(GeometryUtils::Point const& start, GeometryUtils::Elem const& elem);
/// The segment between two points.
DrawnPiece DrawSegment(GeometryUtils::Point const& start, GeometryUtils::Point const& end);

enum class Beside { Start, Piece, End };

/// Where a point lies to a piece.
struct Place {
  /// The part of the piece that the point is nearest to: a point counts as beside the piece only
  /// when rounding cannot put its foot beyond an end.
  Beside beside = Beside::Piece;
  double along = 0.0;     ///< of the nearest point of the piece, from its start, in [0, length]
  double distance = 0.0;  ///< from the nearest point of the piece
  double error = 0.0;     ///< by how much rounding may have changed distance
  double left = 0.0;      ///< deviation from the whole line or circle, positive on the left
};

/// Where p lies to a piece; of a piece without length beside its start.
Place PlaceOf(DrawnPiece const& piece, GeometryUtils::Point const& p);

/// |p - centre|^2 - radius^2 of an arc's circle, exact but for one rounding.
double PowerOf(DrawnPiece const& arc, GeometryUtils::Point const& p);

/// The point of the line or circle at a length from the start.
GeometryUtils::Point PointAt(DrawnPiece const& piece, double along);

/// How far rounding may have put computed points of the piece aside.
double RoundingOf(DrawnPiece const& piece);

/// Exactly: is p within w of the line, circle or end that it lies beside?
bool IsWithin(DrawnPiece const& piece, WPoint const& p, Beside beside);

}  // namespace Vorn::Promises
