#pragma once

#include <cstddef>
#include <functional>
#include <optional>

#include "vorn/FewestPieces.h"
#include "vorn/Types.h"
#include "vorn/io/Closure.h"
#include "vorn/io/Export.h"
#include "vorn/io/FineTolerances.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/Points.h"
#include "vorn/io/Strategy.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::IO {

/// How measured points become a contour.
struct FitChoice {
  ToleranceChoice tolerance;                 ///< where the tolerances come from
  Strategy strategy = kUsualStrategy;        ///< how the contour is found
  ClosedChoice closed = ClosedChoice::Auto;  ///< whether the contour runs back to its start
  /// The seam of a closed contour, as counted in the file. Not for the fewest pieces, the usual
  /// strategy, which find their own.
  std::optional<std::size_t> start;
  /// What the fewest pieces are asked for; `closed` follows from the points.
  FewestPieces::Options fewest;
  /// Told before a fit by a strategy that suffers from the fine tolerance of these points: it may
  /// take minutes, and the contour fall apart. May be empty.
  std::function<void(PointFile const& file, FineTolerance const& fine)> warnOfFineTolerance;
};

/// Finds out whether the points are closed, gives them their tolerances, fits and measures them.
///
/// A closed contour is cut open at the point asked for or else at its sharpest corner, fitted all
/// the way round, and closed again. One without a corner is fitted twice, from its first point and
/// from the first joint found so; the one of fewer pieces counts. One that is a circle comes out as
/// two half circles.
///
/// The fewest pieces may begin anywhere on a closed contour and close by themselves.
///
/// Far from the origin the fit is done in a local frame, an offset being taken off exactly and put
/// back: pieces keep their shape there, and only their coordinates are rounded to what a double
/// holds.
///
/// @param progress may be null
/// @throws SpacingFailure naming a pair that is too close; Failure (FailureKind::NoFit) when the
///         library finds no contour, (BadArgument) when there is no tolerance, `start` does not fit
///         the points, or a contour said to be closed has less than three points.
VORN_IO_EXPORT FitReport FitContour(PointFile file, FitChoice const& choice,
                                    ExecutionState* progress);

}  // namespace Vorn::IO
