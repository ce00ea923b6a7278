#include "vorn/io/PointsInfo.h"

#include <algorithm>

#include "io/points/Noise.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Spacing.h"

namespace Vorn::IO {

namespace {

/// Of normal deviations one in two million is further out; a piece must follow every point.
constexpr double kTolerancePerNoise = 5.0;

/// What drawings of parts commonly ask for.
constexpr double kTolerancePerSize = 1e-4;

/// Keeps the shape of a flat profile.
constexpr double kTolerancePerNarrowSide = 1e-2;

constexpr int kSuggestedDigits = 2;

double Rounded(double value) {
  return ParseNumber(FormatShort(value, kSuggestedDigits)).value_or(value);
}

/// Fine enough for the shape of the part.
Suggestion ToleranceForShape(PointsBox const& box) {
  double const narrowSide = std::min(box.Width(), box.Height());
  double const forSize = kTolerancePerSize * box.Diagonal();
  double const forNarrowSide = kTolerancePerNarrowSide * narrowSide;
  if (narrowSide > 0.0 && forNarrowSide < forSize) {
    return {Suggestion::Way::Same, forNarrowSide, "a hundredth of the narrow side"};
  }
  return {Suggestion::Way::Same, forSize, "a ten-thousandth of the size"};
}

/// The points, and the first one again where it is the neighbour of the last.
std::vector<WPoint> WithClosingPair(std::vector<WPoint> points, Closure const& closure) {
  if (closure.isClosed && !closure.repeatsFirst) points.push_back(points.front());
  return points;
}

}  // namespace

std::vector<ClosePair> FindClosePairs(std::vector<WPoint> const& points, Closure const& closure) {
  std::vector<ClosePair> pairs;
  auto const test = [&](std::size_t first, std::size_t second) {
    WPoint const& a = points[first];
    WPoint const& b = points[second];
    if (AreTooClose(a, b)) {
      pairs.push_back({first, second, Distance(a, b), NeededDistance(a, b)});
    }
  };
  for (std::size_t i = 1; i < points.size(); ++i) test(i - 1, i);
  if (closure.isClosed && !closure.repeatsFirst) test(points.size() - 1, 0);
  return pairs;
}

Suggestion SuggestTolerance(PointsInfo const& info) {
  double const forNoise = kTolerancePerNoise * info.noise.value_or(0.0);
  Suggestion const forShape = ToleranceForShape(info.box);
  bool const isNoisy = forNoise > forShape.tolerance;
  double const wanted = Rounded(isNoisy ? forNoise : forShape.tolerance);
  std::string const reason = isNoisy ? "five times the noise" : forShape.reason;
  if (!(wanted > 0.0)) return {Suggestion::Way::None, 0.0, "all points coincide"};
  if (wanted <= info.largestTolerance.value_or(0.0)) {
    return {Suggestion::Way::Same, wanted, reason};
  }
  return {Suggestion::Way::Fewest, wanted,
          reason + "; too much for mixed and cells at this spacing"};
}

PointsInfo Analyse(std::vector<WPoint> const& points, ClosedChoice closed) {
  PointsInfo info;
  info.box = BoxOf(points);
  info.spacing = SpacingOf(points);
  info.duplicates = FindDuplicates(points);
  info.closure = FindClosure(points, closed);
  info.largestTolerance = LargestSingleTolerance(WithClosingPair(points, info.closure));
  info.noise = EstimateNoise(points);
  info.corners =
      FindCorners(points, ReachForNoise(info.noise.value_or(0.0)), info.closure.isClosed);
  info.suggestion = SuggestTolerance(info);
  return info;
}

}  // namespace Vorn::IO
