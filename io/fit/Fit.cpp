#include "io/fit/Fit.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <limits>

#include "vorn/io/Failure.h"

namespace Vorn::IO {

namespace {

std::string Meaning(ErrorCode code) {
  switch (code) {
    case ErrorCode::Ok:
      return "Ok";
    case ErrorCode::InvalidArcRadius:
      return "InvalidArcRadius: an arc has no valid radius";
    case ErrorCode::Failed:
      return "Failed: the points have no usable shape for this strategy";
    case ErrorCode::OutOfMemory:
      return "OutOfMemory: too many points for the memory there is";
    case ErrorCode::IntersectionUndefined:
      return "IntersectionUndefined: two arcs do not intersect in a defined way";
    case ErrorCode::SelfIntersection:
      return "SelfIntersection: the points turn back or leave the order of an arc";
    case ErrorCode::PointsTooClose:
      return "PointsTooClose: neighbouring points are too close for their tolerances";
    case ErrorCode::OrientationMismatch:
      return "OrientationMismatch: the points do not turn one way as an arc must";
    case ErrorCode::NoFit:
      return "NoFit: no arc passes the points within their tolerances";
    case ErrorCode::InvalidLineCell:
      return "InvalidLineCell: two points do not define a line within their tolerances";
  }
  return "unknown";
}

GeometryUtils::FittingStrategy InCore(Strategy strategy) {
  switch (strategy) {
    case Strategy::Mixed:
      return GeometryUtils::FittingStrategy::Mixed;
    case Strategy::Cells:
      return GeometryUtils::FittingStrategy::MixedCells;
    case Strategy::Arc:
      return GeometryUtils::FittingStrategy::SingleArc;
    case Strategy::Fewest:
      break;
  }
  throw Failure(FailureKind::Internal, "a strategy that the core does not have");
}

}  // namespace

FitAnswer Fit(std::vector<WPoint> const& points, Strategy strategy, ExecutionState* progress) {
  FitAnswer answer;
  answer.deviation = std::numeric_limits<double>::quiet_NaN();
  auto const begin = std::chrono::steady_clock::now();
  answer.code = GeometryUtils::CreateFittingCurve(points, InCore(strategy), &answer.contour,
                                                  &answer.deviation, &answer.deviationIndex,
                                                  progress, kFullProgress);
  answer.seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - begin).count();
  return answer;
}

std::string Describe(ErrorCode code) {
  return std::to_string(static_cast<std::int32_t>(code)) + ", " + Meaning(code);
}

bool ReachesLastPoint(std::vector<WPoint> const& points, std::vector<Piece> const& pieces,
                      Strategy strategy) {
  if (pieces.empty()) return false;
  if (strategy == Strategy::Arc || strategy == Strategy::Fewest) return true;
  GeometryUtils::Point const& end = pieces.back().end;
  WPoint const& last = points.back();
  WPoint const& before = points[points.size() - 2];
  double const halfSpacing = 0.5 * std::hypot(last.x - before.x, last.y - before.y);
  double const gap = std::hypot(end.x - last.x, end.y - last.y);
  return gap <= std::max(halfSpacing, last.w);
}

}  // namespace Vorn::IO
