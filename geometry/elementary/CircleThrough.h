// Circles through three points.
//
// The centre is equally far from all three points; subtracting the circle's equation of one point
// from that of another leaves the linear equation of their perpendicular bisector, and two pairs of
// points give a 2 x 2 system. Three forms stand side by side, since their results differ in the
// last bits: in which pairs are taken, where the radius is measured, and how the system is solved.

#pragma once

#include <optional>

#include "geometry/elementary/Points.h"
#include "geometry/elementary/Shapes.h"

namespace Vorn::Elementary {

/// The circle through three points, from the pairs (a, b) and (a, c); the radius is the mean of the
/// three distances. Nothing only when a.x = b.x = c.x exactly: the solver does not check its last
/// pivot, so that other collinear points have a huge or non-finite centre.
std::optional<Circle> CircleThrough(Point const& a, Point const& b, Point const& c);

/// The circle through three consecutive points, from the pairs (a, b) and (b, c); the radius is the
/// distance of a. Nothing when CircleThrough has none.
std::optional<Circle> CircleThroughNeighbours(Point const& a, Point const& b, Point const& c);

/// The centre of that circle by a system of four unknowns, of which the last two are forced to
/// zero. The padding is kept so that pivoting, failure test and rounding are those that recorded
/// cells were made with. Nothing when the solver meets a zero pivot column.
std::optional<Point> PaddedCircumcentre(Point const& a, Point const& b, Point const& c);

}  // namespace Vorn::Elementary
