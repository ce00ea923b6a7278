#pragma once

#include <optional>
#include <string>
#include <vector>

#include "vorn/io/Pieces.h"

/// Making pieces from what files tell, and getting pieces ready for what files can hold.
namespace Vorn::IO {

/// Above this, squares of coordinates leave the range of doubles and nothing can be measured.
inline constexpr double kLargestCoordinate = 1e150;

/// Arcs that turn further are halved where a file tells an arc by its ends: the nearer these lie
/// to each other, the more a rounding of theirs moves the circle.
inline constexpr double kWidestArc = 5.497787143782138;  // 315 degrees

/// Whether the number can be a coordinate or a radius.
bool IsUsable(double value);

/// Whether both coordinates are the same numbers.
bool AreEqual(XY const& a, XY const& b);

/// The arc from `start` to `end` whose bulge is the tangent of a quarter of its sweep, positive
/// counter-clockwise. A line where that is nearer to the arc than its rounded circle would be.
Piece MakeBulge(XY const& start, XY const& end, double bulge);

/// The tangent of a quarter of the sweep, positive counter-clockwise; 0 for lines.
double BulgeOf(Piece const& piece);

/// The two halves of the arc.
std::vector<Piece> Halves(Piece const& arc);

/// The pieces with every arc beyond kWidestArc in two halves.
std::vector<Piece> WithoutWideArcs(std::vector<Piece> const& pieces);

/// The pieces cut into stretches without a gap wider than `tolerance`.
std::vector<std::vector<Piece>> ConnectedRuns(std::vector<Piece> const& pieces, double tolerance);

/// The pieces with every arc beyond `widest` radians in equal parts that are not.
std::vector<Piece> WithoutArcsBeyond(double widest, std::vector<Piece> const& pieces);

/// What is wrong with the arc, as far as a reader can tell: "the start is 0.3 off the circle".
/// Files with three good digits pass.
std::optional<std::string> FaultOf(Piece const& arc);

}  // namespace Vorn::IO
