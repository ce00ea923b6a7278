#pragma once

#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// Joins the end of the last piece exactly to the start of the first, both moved to one common
/// point near the seam, if that keeps every point within its tolerance (or those that are outside
/// already no further out). Of the places tried (where both pieces cross, the measured seam, the
/// two ends, the middle between them) the one with the least deviation is taken; of arcs that no
/// longer fit the end, centre and radius follow from the new end, the old middle and the other
/// end.
///
/// @param points from the seam to the seam again
/// Where no such place keeps the tolerances, the contour gets one piece more: a line over the seam,
/// from between the two last points to between the two first ones or, if nothing longer fits, from
/// end to start. It stays within the tolerance of the seam.
///
/// @return whether the contour is closed exactly now; if not, the pieces are as they were
bool CloseExactly(std::vector<WPoint> const& points, std::vector<Piece>* pieces);

/// The distance from the end of the last piece to the start of the first.
double GapOf(std::vector<Piece> const& pieces);

}  // namespace Vorn::IO
