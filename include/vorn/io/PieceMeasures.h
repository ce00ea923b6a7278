#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Export.h"
#include "vorn/io/LeastSquares.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// What the points of one piece say by themselves. A fitted radius or direction is one of many that
/// the tolerances admit; what was measured is the one of least squares here.
struct VORN_IO_EXPORT PieceMeasure {
  std::size_t points = 0;                    ///< how many have this piece as their nearest
  std::optional<LeastSquaresLine> line;      ///< of a straight piece with two different points; its
                                             ///< direction is that of travel, in (-pi, pi]
  std::optional<LeastSquaresCircle> circle;  ///< of an arc with three points that have one
  /// Radians turned where the next piece begins, in (-pi, pi], to the left positive; 0 is
  /// tangential. Nothing at the end of an open contour.
  std::optional<double> turn;

  /// Of the line or the circle, whichever there is.
  Scatter const* ScatterOfPoints() const;
};

/// One for each piece, from the points whose deviation names it.
/// @param isClosed whether the first piece follows the last one
VORN_IO_EXPORT std::vector<PieceMeasure> MeasurePieces(
    std::vector<WPoint> const& points, std::vector<PointDeviation> const& deviations,
    std::vector<Piece> const& pieces, bool isClosed);

/// How many deviations lie in each of some ranges of equal width.
struct Histogram {
  double low = 0.0;                 ///< where the first range begins; the last ends at -low
  double width = 0.0;               ///< of each range
  std::vector<std::size_t> counts;  ///< a value between two ranges counts in the upper one
  std::size_t below = 0;            ///< less than `low`
  std::size_t above = 0;            ///< more than -low, or not a number
};

/// All deviations together. Deviations to the left of travel are positive.
struct DeviationSummary {
  double mean = 0.0;            ///< a length
  double rootMeanSquare = 0.0;  ///< a length
  std::size_t outside = 0;      ///< beyond the tolerance; 0 without tolerances
  bool isRelative = false;      ///< whether the histogram is of multiples of the tolerance
  Histogram histogram;          ///< from -1 to 1 if relative, else of lengths up to the largest
};

/// Sums up at least one deviation.
/// @param hasTolerances whether every point has a tolerance
VORN_IO_EXPORT DeviationSummary Summarise(std::vector<WPoint> const& points,
                                          std::vector<PointDeviation> const& deviations,
                                          bool hasTolerances);

}  // namespace Vorn::IO
