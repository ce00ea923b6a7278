// The library's main service: measured points become a contour.

#pragma once

#include "geometry/fitting/Strategies.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Fitting {

/// Fits a contour by a strategy. Two points give a segment between them, whatever the strategy, but
/// for SingleArc, which fails. Failed for fewer points and for an unknown strategy; PointsTooClose
/// when two neighbours are not far enough apart, which SingleArc does not ask for.
CurveResult FitContour(CurveTask const& task, GeometryUtils::FittingStrategy strategy);

}  // namespace Vorn::Fitting
