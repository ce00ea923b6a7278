#pragma once

#include <optional>
#include <string>
#include <vector>

#include "cli/Pieces.h"

/// Making pieces from what files tell, and getting pieces ready for what files can hold.
namespace Vorn::Cli {

using Point = GeometryUtils::Point;

/// Above this, squares of coordinates leave the range of doubles and nothing can be measured.
inline constexpr double kLargestCoordinate = 1e150;

/// Arcs that turn further are halved where a file tells an arc by its ends: the nearer these lie
/// to each other, the more a rounding of theirs moves the circle.
inline constexpr double kWidestArc = 5.497787143782138;  // 315 degrees

/// Whether the number can be a coordinate or a radius.
bool IsUsable(double value);

double Distance(Point const& a, Point const& b);

bool AreEqual(Point const& a, Point const& b);

Piece MakeLine(Point const& start, Point const& end);

/// The arc with these data; angles, sweep and length follow. Ends in the same direction from the
/// centre mean no sweep.
Piece MakeArc(Point const& start, Point const& end, Point const& center, double radius,
              bool counterClockwise);

/// The arc from `start` to `end` whose bulge is the tangent of a quarter of its sweep, positive
/// counter-clockwise. A line where that is nearer to the arc than its rounded circle would be.
Piece MakeBulge(Point const& start, Point const& end, double bulge);

/// The tangent of a quarter of the sweep, positive counter-clockwise; 0 for lines.
double BulgeOf(Piece const& piece);

/// The whole circle as two halves, from `start` back to it.
std::vector<Piece> MakeCircle(Point const& start, Point const& center, double radius,
                              bool counterClockwise);

Piece Reversed(Piece const& piece);

/// The two halves of the arc.
std::vector<Piece> Halves(Piece const& arc);

/// The pieces with every arc beyond kWidestArc in two halves.
std::vector<Piece> WithoutWideArcs(std::vector<Piece> const& pieces);

/// The pieces cut into stretches without a gap wider than `tolerance`.
std::vector<std::vector<Piece>> ConnectedRuns(std::vector<Piece> const& pieces, double tolerance);

/// What is wrong with the arc, as far as a reader can tell: "the start is 0.3 off the circle".
/// Files with three good digits pass.
std::optional<std::string> FaultOf(Piece const& arc);

/// Whether the pieces end exactly where they start.
bool EndsAtStart(std::vector<Piece> const& pieces);

/// The box around the pieces, what arcs bulge out included. Needs at least one piece.
struct Extent {
  Point low;
  Point high;
};
Extent ExtentOf(std::vector<Piece> const& pieces);

}  // namespace Vorn::Cli
