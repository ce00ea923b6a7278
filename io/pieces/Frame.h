#pragma once

#include <vector>

#include "vorn/io/Pieces.h"

/// Measuring near the origin what lies far from it: products of large coordinates take up the
/// digits that the shape needs.
namespace Vorn::IO {

/// What to take off coordinates so that they lie near the origin; for each axis 0 where they do.
///
/// The offset is the middle of the extent rounded to a multiple of the power of ten that is at
/// least 32 times the larger side, and at least 1. What lies within 16 times its size of the origin
/// stays where it is, bit by bit, and what was shifted from there by a multiple of that power, as
/// the offsets of maps and machines are, comes back to the very same coordinates.
///
/// Taking it off is exact for every coordinate in the extent: where not all are between half the
/// offset and twice the offset, the offset is 0. Sides that are not finite make it 0 as well.
XY OriginFor(Extent const& extent);

/// The pieces as seen from there. Lengths, radii and angles stay.
std::vector<Piece> SeenFrom(XY const& origin, std::vector<Piece> pieces);

}  // namespace Vorn::IO
