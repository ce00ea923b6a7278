// The service: checks what it is given, moves the points near the origin, finds the bound and the
// chain, and hands out what was measured.

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>
#include <utility>
#include <vector>

#include "geometry/fewest/Bends.h"
#include "geometry/fewest/Bound.h"
#include "geometry/fewest/ClosedBound.h"
#include "geometry/fewest/Fitter.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/RepeatedEnd.h"
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

/// What to fit, as it came in.
struct Order {
  std::vector<WPoint> const& points;
  Options const& options;
};

Fewest::Path PathOf(Order const& order, Fewest::Shift const& shift) {
  Fewest::Path path;
  path.points = shift.Apply(order.points);
  path.limits = LimitsOf(order.options, shift.scale);
  path.leastTolerance = Fewest::Tightest(order.points).w * shift.scale;
  return path;
}

FewestPieces::Result ResultOf(Fewest::Answer answer, Promises::Report const& report,
                              std::size_t bound) {
  FewestPieces::Result result;
  result.contour = std::move(answer.contour);
  result.ranges = std::move(answer.ranges);
  result.largestDeviation = report.largestRatio;
  result.largestDeviationIndex = static_cast<std::int32_t>(report.largestIndex);
  result.fewestPossible = static_cast<std::int32_t>(bound);
  result.isFewest = result.ranges.size() == bound;
  return result;
}

bool HasArcs(Fewest::Answer const& answer) {
  return std::any_of(
      answer.contour.begin(), answer.contour.end(),
      [](GeometryUtils::Elem const& elem) { return elem.type == GeometryUtils::ElemType::Arc; });
}

/// What was found for an order.
struct Found {
  Fewest::Answer answer;
  Promises::Report report;
};

/// Replaces a contour by one of segments where they are as few: points that a few segments pass
/// say nothing of arcs.
void PreferSegments(Order const& order, Fewest::Shift const& shift, Fewest::Progress* progress,
                    Found* found) {
  std::size_t const most = found->answer.ranges.size();
  if (!HasArcs(found->answer) || Fewest::CountBentRuns(order.points, most + 1) > most) return;
  Options options = order.options;
  options.segmentsOnly = true;
  Fewest::Path path = PathOf({order.points, options}, shift);
  Fewest::Cover const cover = Fewest::CoverWithin(most, path.points, path.limits);
  if (cover.starts.empty()) return;
  Fewest::FitTask task{order.points, options, shift,    std::move(path),
                       cover.starts, most,    *progress};
  Found straight;
  if (!Fewest::FindContour(std::move(task), nullptr, &straight.answer, &straight.report)) return;
  if (straight.answer.ranges.size() <= most) *found = std::move(straight);
}

/// Fits points that a closed contour does not repeat.
ErrorCode FitDistinct(Order const& order, Fewest::Progress* progress,
                      FewestPieces::Result* result) {
  Fewest::Shift const shift = Fewest::ShiftFor(order.points);
  Fewest::Path path = PathOf(order, shift);
  if (DoPointsCoincide(path.points)) return ErrorCode::NoFit;
  Fewest::Cover const cover =
      Fewest::CoverGreedily(path.points, path.limits,
                            [&](std::int32_t done) { progress->Tell(0, Fewest::kCovered, done); });
  std::size_t const open = cover.starts.size();
  bool const isClosed = order.options.closed;
  std::size_t const bound =
      isClosed ? Fewest::LeastClosedCover(path.points, path.limits, cover) : open;
  // Three points are covered without a circle.
  bool const isOne = open == 1 && path.points.size() > 3;
  Fewest::FitTask task{order.points, order.options, shift,    std::move(path),
                       cover.starts, bound,         *progress};
  Found found;
  if (!Fewest::FindContour(std::move(task), isOne ? &cover.last : nullptr, &found.answer,
                           &found.report)) {
    return ErrorCode::NoFit;
  }
  PreferSegments(order, shift, progress, &found);
  *result = ResultOf(std::move(found.answer), found.report, bound);
  return ErrorCode::Ok;
}

/// Fits points of which the last may repeat the first.
ErrorCode FitPoints(Order const& order, Fewest::Progress* progress, FewestPieces::Result* result) {
  Fewest::RepeatedEnd const end(order.points);
  if (!order.options.closed || !end.IsRepeated()) return FitDistinct(order, progress, result);
  std::vector<WPoint> const distinct = end.Distinct();
  ErrorCode const code = FitDistinct({distinct, order.options}, progress, result);
  if (code == ErrorCode::Ok) end.Restore(result);
  return code;
}

}  // namespace

ErrorCode FewestPieces::Fit(std::vector<WPoint> const& points, Options const& options,
                            Result* result, ExecutionState* executionState,
                            std::int32_t maxPercent) {
  if (result == nullptr || !AreValid(points) || !IsValid(options)) return ErrorCode::Failed;
  Fewest::Progress progress(executionState, maxPercent, static_cast<std::int32_t>(points.size()));
  Result found;
  ErrorCode const code = FitPoints({points, options}, &progress, &found);
  if (code != ErrorCode::Ok) return code;
  progress.Finish();
  *result = std::move(found);
  return code;
}

}  // namespace Vorn
