#pragma once

#include <cstddef>
#include <optional>

#include "vorn/GeometryUtils.h"
#include "vorn/io/Closure.h"
#include "vorn/io/Export.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/Points.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::IO {

/// How measured points become a contour.
struct FitChoice {
  ToleranceChoice tolerance;  ///< where the tolerances come from
  /// Which of the fits of the core.
  GeometryUtils::FittingStrategy strategy = GeometryUtils::FittingStrategy::Mixed;
  ClosedChoice closed = ClosedChoice::Auto;  ///< whether the contour runs back to its start
  std::optional<std::size_t> start;  ///< the seam of a closed contour, as counted in the file
};

/// Finds out whether the points are closed, gives them their tolerances, fits and measures them.
///
/// A closed contour is cut open at the point asked for or else at its sharpest corner, fitted all
/// the way round, and closed again. One without a corner is fitted twice, from its first point and
/// from the first joint found so; the one of fewer pieces counts. One that is a circle comes out as
/// two half circles.
///
/// Far from the origin the fit is done in a local frame, an offset being taken off exactly and put
/// back: pieces keep their shape there, and only their coordinates are rounded to what a double
/// holds.
///
/// @param progress may be null
/// @throws Failure (FailureKind::PointsTooClose) naming the pair and the ways out, (NoFit) when the
///         library finds no contour, (Usage) when there is no tolerance, `start` does not fit the
///         points, or a contour said to be closed has less than three points.
VORN_IO_EXPORT FitReport FitContour(PointFile file, FitChoice const& choice,
                                    ExecutionState* progress);

}  // namespace Vorn::IO
