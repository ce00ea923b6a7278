#pragma once

#include <vector>

#include "vorn/io/FitReport.h"

/// Fitting near the origin what lies far from it.
///
/// The thresholds of the core do not follow the size of the numbers, and its lines are told by
/// a x + b y + c = 0: far from the origin c takes up the digits that the shape needs. Map and
/// machine coordinates are like that. So an offset is taken off before the fit and put back after.
namespace Vorn::IO {

/// What to take off the points so that they lie near the origin; for each axis 0 where they do.
///
/// The offset is the middle of the points rounded to a multiple of the power of ten that is at
/// least 32 times their larger extent, and at least 1. Contours within 16 times their size of the
/// origin stay where they are, bit by bit, and those shifted from there by a multiple of that
/// power, as the offsets of maps and machines are, come back to the very same coordinates.
///
/// p - offset is exact for every point: where not every coordinate is between half the offset and
/// twice the offset, the offset is 0. Coordinates that are not finite make it 0 as well.
XY LocalOrigin(std::vector<WPoint> const& points);

/// The points in the local frame.
std::vector<WPoint> TakenOff(std::vector<WPoint> points, XY const& origin);

/// Gives the points, the elements and the pieces of a report their place in the plane again.
/// Lengths, radii and angles stay, and so do the deviations, which are those of the local frame;
/// coordinates of pieces are rounded to what a double holds there.
void PutBack(XY const& origin, FitReport* report);

}  // namespace Vorn::IO
