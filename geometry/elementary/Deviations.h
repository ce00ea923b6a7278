// Distances of points from lines, and the spacing test of measured points.

#pragma once

#include <optional>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/elementary/Points.h"

namespace Vorn::Elementary {

/// The distance of a point from a line; nothing when the line's (a, b) has no length.
std::optional<double> Deviation(ImplicitLine const& line, Point const& p);

/// The distance of a point from a line, positive on the side away from the origin; nothing when the
/// line's (a, b) has no length.
std::optional<double> SignedDeviation(ImplicitLine const& line, Point const& p);

/// The distance of p from the line through two points, from squared lengths alone; nothing where
/// the two coincide. Not a number where rounding makes the square of the distance negative: callers
/// take that for "too far". Its bits differ from those of Deviation for the line through the
/// points.
std::optional<double> DeviationBySquares(Point const& lineStart, Point const& lineEnd,
                                         Point const& p);

/// Whether two measured points are strictly farther apart than 1.5 times the sum of their
/// tolerances. True when a not-a-number is involved: the fitters meet it.
bool AreFarEnoughApart(WPoint const& a, WPoint const& b);

}  // namespace Vorn::Elementary
