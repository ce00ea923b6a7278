#pragma once

#include <vector>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Path.h"
#include "vorn/GeometryUtils.h"

/// Chains become contours, and deviations are measured on what will be given out.
namespace Vorn::Fewest {

/// A piece with both of its ends.
struct BuiltPiece {
  GeometryUtils::Point start;
  GeometryUtils::Elem elem;
};

/// The segment between two points.
BuiltPiece BuildSegment(GeometryUtils::Point const& start, GeometryUtils::Point const& end);

/// The arc between two points about a centre; direction +1 is counter-clockwise, -1 clockwise.
BuiltPiece BuildArc(GeometryUtils::Point const& start, GeometryUtils::Point const& end,
                    GeometryUtils::Point const& centre, double direction);

/// The arc between two points about the place nearest to a centre that is as far from either: the
/// rounding of places far from the origin may have moved all three.
BuiltPiece BuildArcNear(GeometryUtils::Point const& start, GeometryUtils::Point const& end,
                        GeometryUtils::Point const& centre, double direction);

/// The arc between two points that lies along a circle; the segment when the circle is too flat to
/// have a centre. The centre is moved onto the bisector of the ends, so that both lie on the arc.
BuiltPiece BuildAlong(PlacedCircle const& circle, GeometryUtils::Point const& start,
                      GeometryUtils::Point const& end);

/// Distance of a point from a piece itself, its ends included.
double DistanceToPiece(BuiltPiece const& piece, WPoint const& p);

/// Largest distance of the points [first, end) from a piece in units of their tolerances.
struct PieceDeviation {
  double value = 0.0;
  std::int32_t index = -1;
};
/// The first of equal ones counts; index -1 for no points.
PieceDeviation MeasurePiece(Path const& path, BuiltPiece const& piece, std::int32_t first,
                            std::int32_t end);

/// The pieces of a chain: a segment where the chord holds every tolerance, otherwise an arc.
std::vector<BuiltPiece> BuildPieces(Path const& path, Chain const& chain);

}  // namespace Vorn::Fewest
