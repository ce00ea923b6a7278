#pragma once

#include <vector>

#include "vorn/io/FitReport.h"

/// Fitting near the origin what lies far from it.
///
/// The thresholds of the core do not follow the size of the numbers, and its lines are told by
/// a x + b y + c = 0: far from the origin c takes up the digits that the shape needs. Map and
/// machine coordinates are like that. So an offset is taken off before the fit and put back after.
namespace Vorn::IO {

/// What to take off the points so that they lie near the origin, as OriginFor says; 0 where a
/// coordinate is not finite.
XY LocalOrigin(std::vector<WPoint> const& points);

/// The points in the local frame.
std::vector<WPoint> TakenOff(std::vector<WPoint> points, XY const& origin);

/// Gives the points, the elements and the pieces of a report their place in the plane again.
/// Lengths, radii and angles stay, and so do the deviations, which are those of the local frame;
/// coordinates of pieces are rounded to what a double holds there.
void PutBack(XY const& origin, FitReport* report);

}  // namespace Vorn::IO
