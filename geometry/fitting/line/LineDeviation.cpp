#include "geometry/fitting/line/LineDeviation.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "geometry/elementary/Deviations.h"
#include "geometry/elementary/ImplicitLine.h"
#include "math/NumericConstants.h"

namespace Vorn::Fitting {

namespace {

constexpr Deviation kNoDeviation{0.0, -1};

}  // namespace

Deviation LargestDeviationFromLine(Run const& run, Elementary::Segment const& segment) {
  if (run.count < 1 || !run.Exists()) return kNoDeviation;
  Deviation largest;
  for (std::int32_t i = 0; i < run.count; ++i) {
    std::optional<double> const deviation =
        Elementary::DeviationBySquares(segment.start, segment.end, run.PointAt(i));
    if (!deviation) return kNoDeviation;
    double const relative = std::fabs(*deviation) / run[i].w;
    if (i == 0 || relative > largest.value) largest = {relative, run.first + i};
  }
  return largest;
}

std::optional<DeviationExtremes> FindDeviationExtremes(Run const& run,
                                                       Elementary::Segment const& segment) {
  if (run.count < 1 || !run.Exists()) return std::nullopt;
  std::optional<Elementary::ImplicitLine> const line =
      Elementary::LineThrough(segment.start, segment.end);
  if (!line) return std::nullopt;
  // Without a norm no point has a deviation, and there are no extremes to hand out.
  double const divisor = line->SignedNorm();
  if (Numeric::IsZeroMagnitude(divisor)) return std::nullopt;
  DeviationExtremes extremes;
  for (std::int32_t i = 0; i < run.count; ++i) {
    Deviation const deviation{line->At(run.PointAt(i)) / divisor, run.first + i};
    if (i == 0 || deviation.value < extremes.least.value) extremes.least = deviation;
    if (i == 0 || deviation.value > extremes.greatest.value) extremes.greatest = deviation;
  }
  return extremes;
}

void AppendIndices(DeviationExtremes const& extremes, std::vector<std::int32_t>* indices) {
  auto const [lower, upper] = std::minmax(extremes.least.index, extremes.greatest.index);
  indices->push_back(lower);
  if (upper != lower) indices->push_back(upper);
}

}  // namespace Vorn::Fitting
