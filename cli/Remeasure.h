#pragma once

#include <cstddef>
#include <vector>

#include "cli/Pieces.h"
#include "vorn/Types.h"

namespace Vorn::Cli {

/// Where one measured point lies against the contour.
struct PointDeviation {
  double distance = 0.0;  ///< to the nearest place of any piece, its ends included
  double relative = 0.0;  ///< distance divided by the point's tolerance
  bool isLeft = false;    ///< to the left of the contour's sense of travel
  std::size_t piece = 0;  ///< the piece with that place; the first of several
};

/// What the program itself finds when it measures every point, without a word from the fit.
struct Remeasured {
  std::vector<PointDeviation> points;
  std::size_t worst = 0;  ///< index of the largest relative deviation; the first of several

  PointDeviation const& Worst() const { return points[worst]; }
};

/// Distance of (x, y) from the nearest place of the piece.
double DistanceTo(Piece const& piece, double x, double y);

/// Measures every point against every piece, as far as the answer is concerned: see PieceIndex.
/// Needs at least one of each.
Remeasured Remeasure(std::vector<WPoint> const& points, std::vector<Piece> const& pieces);

}  // namespace Vorn::Cli
