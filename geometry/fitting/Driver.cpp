// The library's main service: measured points become a contour.

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "geometry/fitting/Strategies.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

ErrorCode GeometryUtils::CreateFittingCurve(std::vector<WPoint> const& points,
                                            FittingStrategy strategy, std::vector<Elem>* contour,
                                            double* maxDeviation, std::int32_t* maxDeviationIndex,
                                            ExecutionState* executionState,
                                            std::int32_t maxPercent) {
  if (contour == nullptr || points.size() < 2) return ErrorCode::Failed;
  ProgressBase const progress{executionState, maxPercent, static_cast<std::int32_t>(points.size())};

  // A single arc is found by least squares as well, which bears points close together.
  if (strategy == FittingStrategy::SingleArc) {
    return SingleArcFit(points, contour, progress).Run(maxDeviation, maxDeviationIndex);
  }
  for (std::size_t i = 1; i < points.size(); ++i) {
    if (!IsPointValidToFit(points[i - 1], points[i])) return ErrorCode::PointsTooClose;
  }
  if (points.size() == 2) {
    AddSegm(contour, Fitting::ToPoint(points.front()));
    AddSegm(contour, Fitting::ToPoint(points.back()));
    *maxDeviation = 0.0;
    *maxDeviationIndex = -1;
    return ErrorCode::Ok;
  }

  LargestDeviation largest;
  if (strategy == FittingStrategy::Mixed) {
    largest = MixedWalk(points, contour, progress).Run();
  } else if (strategy == FittingStrategy::MixedCells) {
    ErrorCode const code = CellsWalk(points, contour, progress).Run(&largest);
    if (code != ErrorCode::Ok) return code;
  } else {
    return ErrorCode::Failed;
  }
  *maxDeviation = largest.value;
  *maxDeviationIndex = largest.index;
  return ErrorCode::Ok;
}

}  // namespace Vorn
