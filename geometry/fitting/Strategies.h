// The three ways of cutting measured points into the elements of a contour.

#pragma once

#include <optional>
#include <vector>

#include "geometry/fitting/runs/Deviations.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Fitting {

/// What every strategy is given.
struct CurveTask {
  /// The measured points: three at least, unless a strategy says what it does with fewer.
  std::vector<WPoint> const& points;
  /// Elements are appended as they are found; on a failure those found so far stay.
  std::vector<GeometryUtils::Elem>& contour;
  GeometryUtils::ProgressBase const& progress;
};

/// What a strategy answers.
struct CurveResult {
  ErrorCode code = ErrorCode::Failed;
  /// With Ok the largest deviation of a point from its element; the default one when no element was
  /// made or the strategy names no point. With another code nothing, but for SingleArc.
  std::optional<Deviation> deviation;
};

/// Mixed: from the current point both fitters say how far one element can reach. The longer reach
/// wins; on equal reach the arc, unless its deviation is larger. Always Ok: where neither can go
/// on, the contour ends early. Deviations are relative.
CurveResult FitMixed(CurveTask const& task);

/// MixedCells: the longest segments are looked for first, and the points passed over between two of
/// them are covered by arcs. The code is that of a step that failed. Deviations are relative.
CurveResult FitMixedCells(CurveTask const& task);

/// SingleArc: one arc through all points, estimated, fitted over cells, then refined by least
/// squares. It takes the place of whatever the contour holds. Failed for fewer than three points;
/// otherwise the code of a step that failed. The deviation is a distance. Once there is a circle to
/// refine, a failure leaves the deviation of that circle, with the position of the point that has
/// the largest one from the circle refined last, or -1.
CurveResult FitSingleArc(CurveTask const& task);

}  // namespace Vorn::Fitting
