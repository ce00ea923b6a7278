#pragma once

#include <numbers>
#include <optional>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// Neighbours further apart, seen from the centre, could as well be the corners of a polygon.
inline constexpr double kLargestCircleStep = 30.0 / 180.0 * std::numbers::pi;

/// A closed contour that is one circle, as two half circles from the seam round to it again: an arc
/// cannot make a full turn.
///
/// The circle is the one of least squared relative distances. Nothing when a point lies outside
/// its tolerance, when the points do not go round exactly once, or when neighbours are more than
/// kLargestCircleStep apart.
///
/// @param points from the seam to the seam again
std::optional<std::vector<Piece>> FitFullCircle(std::vector<WPoint> const& points);

/// The same for the circle of the arc that turns most, if one of the pieces turns by more than half
/// a circle: that of least squares is not always the one that passes all points.
std::optional<std::vector<Piece>> FullCircleOf(std::vector<Piece> const& pieces,
                                               std::vector<WPoint> const& points);

}  // namespace Vorn::IO
