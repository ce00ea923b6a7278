// The main service and its progress.

#include <cstdint>
#include <vector>

#include "geometry/fitting/FitContour.h"
#include "geometry/fitting/runs/Progress.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

ErrorCode GeometryUtils::CreateFittingCurve(std::vector<WPoint> const& points,
                                            FittingStrategy strategy, std::vector<Elem>* contour,
                                            double* maxDeviation, std::int32_t* maxDeviationIndex,
                                            ExecutionState* executionState,
                                            std::int32_t maxPercent) {
  if (contour == nullptr) return ErrorCode::Failed;
  ProgressBase const progress{executionState, maxPercent, static_cast<std::int32_t>(points.size())};
  Fitting::CurveResult const result = Fitting::FitContour({points, *contour, progress}, strategy);
  if (result.deviation) {
    *maxDeviation = result.deviation->value;
    *maxDeviationIndex = result.deviation->index;
  }
  return result.code;
}

void GeometryUtils::SetProgressState(ProgressBase const& progress, std::int32_t current) {
  Fitting::ReportProgress(progress, current);
}

}  // namespace Vorn
