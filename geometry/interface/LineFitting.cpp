// Members for fitting a line: the fitter, deviations from a line and the order of points along it.

#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/fitting/line/LineDeviation.h"
#include "geometry/fitting/line/LineFit.h"
#include "geometry/fitting/runs/LineOrder.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

ErrorCode GeometryUtils::GetFittingLine(std::vector<WPoint> const& points, std::int32_t start,
                                        std::int32_t count, bool startFixed, Point* startPoint,
                                        bool endFixed, Point* endPoint, bool lastAttempt,
                                        std::int32_t* lineCount, double* lineDeviation,
                                        std::int32_t* lineDeviationIndex,
                                        std::vector<std::int32_t>* indexList, ErrorCode* lineCode,
                                        ProgressBase const& progress) {
  Fitting::LineTask const task{
      {points, start, count},
      {Fitting::FixedIf(startFixed, *startPoint), Fitting::FixedIf(endFixed, *endPoint)},
      lastAttempt,
      progress};
  if (!Fitting::IsFittable(task)) return ErrorCode::Failed;
  *lineCode = ErrorCode::Ok;
  auto const [code, line] = Fitting::FitLine(task, indexList);
  if (line) {
    *lineCount = line->count;
    *startPoint = line->start;
    *endPoint = line->end;
    *lineDeviation = line->deviation.value;
    *lineDeviationIndex = line->deviation.index;
  }
  if (line && line->hasTurnedBack) *lineCode = ErrorCode::SelfIntersection;
  return code;
}

double GeometryUtils::GetMaxDeviationFromLine(std::vector<WPoint> const& points, std::int32_t start,
                                              std::int32_t count, Point const& a, Point const& b,
                                              std::int32_t* index) {
  Fitting::Deviation const largest =
      Fitting::LargestDeviationFromLine({points, start, count}, {a, b});
  *index = largest.index;
  return largest.value;
}

bool GeometryUtils::GetDeviationFromLineParameters(Point const& a, Point const& b,
                                                   std::vector<WPoint> const& points,
                                                   std::int32_t start, std::int32_t count,
                                                   double* minDeviation, double* maxDeviation,
                                                   std::int32_t* minIndex, std::int32_t* maxIndex) {
  std::optional<Fitting::DeviationExtremes> const extremes =
      Fitting::FindDeviationExtremes({points, start, count}, {a, b});
  if (!extremes) return false;
  *minDeviation = extremes->least.value;
  *maxDeviation = extremes->greatest.value;
  *minIndex = extremes->least.index;
  *maxIndex = extremes->greatest.index;
  return true;
}

bool GeometryUtils::GetDeviationFromLineParameters(Point const& a, Point const& b,
                                                   std::vector<WPoint> const& points,
                                                   std::int32_t start, std::int32_t count,
                                                   std::vector<std::int32_t>* indices) {
  std::optional<Fitting::DeviationExtremes> const extremes =
      Fitting::FindDeviationExtremes({points, start, count}, {a, b});
  if (!extremes) return false;
  Fitting::AppendIndices(*extremes, indices);
  return true;
}

bool GeometryUtils::IsValidLineOrder(Point const& first, Point const& middle, Point const& last) {
  return Fitting::MovesAway(first, middle, last);
}

}  // namespace Vorn
