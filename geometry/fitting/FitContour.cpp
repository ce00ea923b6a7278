#include "geometry/fitting/FitContour.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

#include "geometry/contours/Elements.h"
#include "geometry/elementary/Deviations.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

using Strategy = GeometryUtils::FittingStrategy;

namespace {

bool AreNeighboursFarEnoughApart(std::vector<WPoint> const& points) {
  auto const areTooClose = [](WPoint const& a, WPoint const& b) {
    return !Elementary::AreFarEnoughApart(a, b);
  };
  return std::adjacent_find(points.begin(), points.end(), areTooClose) == points.end();
}

CurveResult JoinTwoPoints(CurveTask const& task) {
  task.contour.push_back(Contours::SegmentTo(ToPoint(task.points.front())));
  task.contour.push_back(Contours::SegmentTo(ToPoint(task.points.back())));
  return {ErrorCode::Ok, Deviation{0.0, -1}};
}

/// Whether there are two points at least, and no more than their indices count.
bool AreCountable(std::vector<WPoint> const& points) {
  constexpr std::size_t kMost = std::numeric_limits<std::int32_t>::max();
  return points.size() >= 2 && points.size() <= kMost;
}

}  // namespace

CurveResult FitContour(CurveTask const& task, Strategy strategy) {
  if (!AreCountable(task.points)) return {ErrorCode::Failed, std::nullopt};
  // A single arc is found by least squares as well, which bears points close together.
  if (strategy == Strategy::SingleArc) return FitSingleArc(task);
  if (!AreNeighboursFarEnoughApart(task.points)) return {ErrorCode::PointsTooClose, std::nullopt};
  if (task.points.size() == 2) return JoinTwoPoints(task);
  switch (strategy) {
    case Strategy::Mixed:
      return FitMixed(task);
    case Strategy::MixedCells:
      return FitMixedCells(task);
    default:
      return {ErrorCode::Failed, std::nullopt};
  }
}

}  // namespace Vorn::Fitting
