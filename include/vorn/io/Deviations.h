#pragma once

#include <cstddef>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// Where one measured point lies against the contour.
struct PointDeviation {
  double distance = 0.0;  ///< to the nearest place of any piece, its ends included
  double relative = 0.0;  ///< distance divided by the point's tolerance
  bool isLeft = false;    ///< to the left of the contour's sense of travel
  std::size_t piece = 0;  ///< the piece with that place; the first of several
};

/// A relative deviation counts as within tolerance up to here: a millionth of the tolerance more
/// than all of it. A piece may touch the tolerance of a point exactly, and another formula then
/// ends above 1 by the rounding of coordinates and radii, which are up to 1e9 times the tolerance
/// (2^-53 * 1e9 = 1.1e-7). Every judgement uses this one bound: that of a fit, of a check, of a
/// drawing and of the files written.
inline constexpr double kLargestRelative = 1.0 + 1e-6;

/// What is found when it measures every point, without a word from the fit.
struct Remeasured {
  std::vector<PointDeviation> points;  ///< one for each point
  std::size_t worst = 0;  ///< index of the largest relative deviation; the first of several

  /// The one with the largest relative deviation; needs a point.
  PointDeviation const& Worst() const { return points[worst]; }
};

/// Whether a deviation measured at a point is within the tolerance of the point: up to
/// kLargestRelative, and some last places of the coordinates more, because far from the origin the
/// pieces of a contour are rounded to these. What is not a number is outside.
VORN_IO_EXPORT bool IsWithinTolerance(PointDeviation const& deviation, WPoint const& point);

/// Whether that holds for every point that was measured.
VORN_IO_EXPORT bool AreWithinTolerance(Remeasured const& measured,
                                       std::vector<WPoint> const& points);

/// Measures every point against every piece, as far as the answer is concerned: see PieceIndex.
/// Needs at least one of each.
VORN_IO_EXPORT Remeasured Remeasure(std::vector<WPoint> const& points,
                                    std::vector<Piece> const& pieces);

}  // namespace Vorn::IO
