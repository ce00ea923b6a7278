#pragma once

#include <vector>

#include "io/drawing/Feet.h"

/// The strip beside the contour in which the points must lie.
namespace Vorn::IO::Svg {

/// A stretch of one piece with one tolerance.
struct BandSection {
  std::size_t piece = 0;
  double from = 0.0;  ///< lengths from the start of the piece
  double to = 0.0;
  double tolerance = 0.0;
};

/// The sections of the whole contour in order. Between the feet of neighbouring points the larger
/// of both tolerances holds, feet closer than `leastLength` count as one, and sections of equal
/// tolerance are joined. A piece without points takes over the tolerance of the one before.
std::vector<BandSection> BandSections(Drawing const& drawing, std::vector<Foot> const& feet,
                                      double leastLength);

}  // namespace Vorn::IO::Svg
