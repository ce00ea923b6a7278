#pragma once

#include <vector>

#include "vorn/io/Export.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// How far one contour leaves the other: the largest distance from the ends and from seven places
/// between the ends of each piece of either contour to the nearest place of the other.
VORN_IO_EXPORT double DepartureOf(std::vector<Piece> const& a, std::vector<Piece> const& b);

}  // namespace Vorn::IO
