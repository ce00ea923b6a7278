// The service: checks what it is given, moves the points near the origin, finds the bound and the
// chain, and hands out what was measured.

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

#include "geometry/fewest/Bound.h"
#include "geometry/fewest/Fitter.h"
#include "geometry/fewest/LocalFrame.h"
#include "vorn/FewestPieces.h"

namespace Vorn {

namespace {

using Options = FewestPieces::Options;

bool IsMeasured(WPoint const& p) {
  return std::isfinite(p.x) && std::isfinite(p.y) && std::isfinite(p.w) && p.w > 0.0;
}

bool AreValid(std::vector<WPoint> const& points) {
  return points.size() >= 2 &&
         points.size() <= static_cast<std::size_t>(std::numeric_limits<std::int32_t>::max()) &&
         std::all_of(points.begin(), points.end(), IsMeasured);
}

bool IsValid(Options const& options) {
  auto const effort = static_cast<std::int32_t>(options.effort);
  return effort >= 0 && effort <= 2 && options.largestStep > 0.0 &&
         options.largestStep <= std::numbers::pi && options.smallestRadius >= 0.0 &&
         std::isfinite(options.smallestRadius) && options.largestRadius > 0.0 &&
         options.largestRadius >= options.smallestRadius && options.farthestBetweenPoints >= 0.0;
}

Fewest::Limits LimitsOf(Options const& options, double scale) {
  return {options.smallestRadius * scale, options.largestRadius * scale, options.segmentsOnly,
          std::sin(0.5 * options.largestStep), options.farthestBetweenPoints * scale};
}

}  // namespace

ErrorCode FewestPieces::Fit(std::vector<WPoint> const& points, Options const& options,
                            Result* result, ExecutionState* executionState,
                            std::int32_t maxPercent) {
  if (result == nullptr || !AreValid(points) || !IsValid(options)) return ErrorCode::Failed;
  Fewest::Progress progress(executionState, maxPercent, static_cast<std::int32_t>(points.size()));
  Fewest::Shift const shift = Fewest::ShiftFor(points);
  Fewest::Path path;
  path.points = shift.Apply(points);
  if (Fewest::DoCoincide(path.points)) return ErrorCode::NoFit;
  path.limits = LimitsOf(options, shift.scale);
  path.leastTolerance = Fewest::Tightest(points).w * shift.scale;

  Fewest::Cover const cover =
      Fewest::CoverGreedily(path.points, path.limits,
                            [&](std::int32_t done) { progress.Tell(0, Fewest::kCovered, done); });
  Fewest::Answer answer;
  Promises::Report report;
  // Three points are covered without a circle; a closed contour takes two pieces at least.
  bool const isOne = !options.closed && cover.starts.size() == 1 && points.size() > 3;
  Fewest::FitTask task{points, options, shift, std::move(path), cover.starts.size(), progress};
  if (!Fewest::FindContour(std::move(task), isOne ? &cover.last : nullptr, &answer, &report)) {
    return ErrorCode::NoFit;
  }
  progress.Finish();
  result->contour = std::move(answer.contour);
  result->ranges = std::move(answer.ranges);
  result->largestDeviation = report.largestRatio;
  result->largestDeviationIndex = static_cast<std::int32_t>(report.largestIndex);
  // A closed cover of m runs, cut where the input ends, is an open one of m + 1 at most.
  auto const open = static_cast<std::int32_t>(cover.starts.size());
  result->fewestPossible = options.closed ? std::max(1, open - 1) : open;
  result->isFewest = static_cast<std::int32_t>(result->ranges.size()) == result->fewestPossible;
  return ErrorCode::Ok;
}

}  // namespace Vorn
