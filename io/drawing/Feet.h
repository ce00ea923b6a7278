#pragma once

#include <vector>

#include "vorn/io/Drawing.h"

namespace Vorn::IO {

/// The place of the piece at this length from its start.
GeometryUtils::Point PlaceOn(Piece const& piece, double along);

/// The feet of all points, each on the piece that its deviation names.
std::vector<Foot> FeetOf(Drawing const& drawing);

/// The point moved away from its foot until it is `times` as far from it; itself for 1.
GeometryUtils::Point Magnified(WPoint const& point, Foot const& foot, double times);

/// Where each piece starts, as a length from the start of the contour; one more for the end.
std::vector<double> PieceStarts(std::vector<Piece> const& pieces);

}  // namespace Vorn::IO
