#pragma once

#include "io/pieces/Pieces.h"

namespace Vorn::IO {

/// Distance of (x, y) from the nearest place of the piece.
double DistanceTo(Piece const& piece, double x, double y);

}  // namespace Vorn::IO
