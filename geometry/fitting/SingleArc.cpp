// Strategy SingleArc: one arc through all points.
//
// An estimate gives a common tolerance and leaves out points that are too close together for it;
// the arc fitter finds a circle over the rest; from there (or from the estimate, where it does not
// reach the end) the circle is moved by weighted least squares over all points until the largest
// deviation no longer falls.

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "geometry/fitting/Strategies.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::kFewestArcPoints;
using Fitting::ToPoint;

namespace {

constexpr int kMaxRefinements = 100;
}  // namespace

SingleArcFit::SingleArcFit(std::vector<WPoint> const& points,
                           std::vector<GeometryUtils::Elem>* contour,
                           GeometryUtils::ProgressBase const& progress)
    : points_(points), contour_(*contour), progress_(progress) {}

ErrorCode SingleArcFit::Run(double* maxDeviation, std::int32_t* maxDeviationIndex) {
  if (Count() < kFewestArcPoints) return ErrorCode::Failed;
  if (Count() == kFewestArcPoints) {
    ErrorCode const code = FitThreePoints();
    if (code != ErrorCode::Ok) return code;
    *maxDeviation = 0.0;
    *maxDeviationIndex = -1;
    return ErrorCode::Ok;
  }
  ErrorCode const found = FindStartingCircle();
  if (found != ErrorCode::Ok) return found;
  *maxDeviation = GeometryUtils::GetMaxObtainedDeviation(points_, 0, Count(), circle_.centre,
                                                         circle_.radius, maxDeviationIndex);
  // Deliberate: this strategy names no point.
  *maxDeviationIndex = -1;

  double kept = 0.0;
  ErrorCode const refined = Refine(&kept, maxDeviationIndex);
  if (refined != ErrorCode::Ok) return refined;
  ErrorCode const written = WriteContour();
  if (written != ErrorCode::Ok) return written;
  *maxDeviation = kept;
  *maxDeviationIndex = -1;
  return ErrorCode::Ok;
}

ErrorCode SingleArcFit::FitThreePoints() {
  WPoint const& a = points_[0];
  WPoint const& b = points_[1];
  WPoint const& c = points_[2];
  Point centre;
  double radius = 0.0;
  bool ccw = false;
  ErrorCode const circle =
      GeometryUtils::GetCircle(a.x, a.y, b.x, b.y, c.x, c.y, &centre.x, &centre.y, &radius);
  if (circle != ErrorCode::Ok) return circle;
  ErrorCode const sense = GeometryUtils::IsCcw(ToPoint(a), ToPoint(b), ToPoint(c), &ccw);
  if (sense != ErrorCode::Ok) return sense;
  GeometryUtils::AddSegm(&contour_, ToPoint(a));
  GeometryUtils::AddArc(&contour_, ToPoint(a), ToPoint(c), centre, radius, !ccw);
  return ErrorCode::Ok;
}

/// The circle that the refinement starts from and its turning sense.
ErrorCode SingleArcFit::FindStartingCircle() {
  std::vector<std::int32_t> excluded;
  Circle estimate;
  if (!GeometryUtils::GetEstimatedDeviationForCircle(points_, &tolerance_, &excluded,
                                                     &estimate.centre, &estimate.radius)) {
    return ErrorCode::Failed;
  }
  std::vector<WPoint> const reduced = ReducedPoints(excluded);
  auto const reducedCount = static_cast<std::int32_t>(reduced.size());
  if (reducedCount < 2) return ErrorCode::Failed;

  Point start;
  Point end;
  std::int32_t arcCount = 0;
  double deviation = 0.0;
  std::int32_t deviationIndex = -1;
  ErrorCode const code = GeometryUtils::GetFittingCircle2(
      reduced, 0, reducedCount, kFewestArcPoints, false, &start, false, &end, nullptr, &arcCount,
      &circle_.centre, &circle_.radius, &ccw_, &deviation, &deviationIndex, progress_);
  if (code != ErrorCode::Ok && code != ErrorCode::OrientationMismatch) return code;
  if (code == ErrorCode::Ok && arcCount >= reducedCount) {
    GeometryUtils::AddSegm(&contour_, start);
    GeometryUtils::AddArc(&contour_, start, end, circle_.centre, circle_.radius, !ccw_);
    return ErrorCode::Ok;
  }

  // A partial fit (three points at least) says less about the whole than the estimate does.
  endsShort_ = code == ErrorCode::Ok;
  shortEnd_ = end;
  circle_ = estimate;
  std::int32_t const coveredCount = endsShort_ ? arcCount : Count();
  Point const firstPoint = ToPoint(points_.front());
  Point const endPoint = ToPoint(At(points_, coveredCount - 1));
  if (GeometryUtils::IsCcw(points_, 0, coveredCount, false, firstPoint, false, endPoint,
                           estimate.centre, &ccw_) != ErrorCode::Ok) {
    return ErrorCode::NoFit;
  }
  return ErrorCode::Ok;
}

/// The points that are not left out, each with the common tolerance.
std::vector<WPoint> SingleArcFit::ReducedPoints(std::vector<std::int32_t> const& excluded) const {
  std::vector<WPoint> reduced;
  auto nextExcluded = excluded.begin();
  for (std::int32_t i = 0; i < Count(); ++i) {
    if (nextExcluded != excluded.end() && *nextExcluded == i) {
      ++nextExcluded;
      continue;
    }
    WPoint const& p = At(points_, i);
    reduced.push_back({p.x, p.y, tolerance_});
  }
  return reduced;
}

/// Improves the circle until the largest deviation stops falling; a step that did not improve it is
/// undone. Writes the deviation of the circle kept.
ErrorCode SingleArcFit::Refine(double* deviation, std::int32_t* index) {
  double previous = -1.0;
  for (int iteration = 0; iteration < kMaxRefinements; ++iteration) {
    Circle const before = circle_;
    ErrorCode const code = ImproveCircle();
    if (code != ErrorCode::Ok) return code;
    double const current = GeometryUtils::GetMaxObtainedDeviation(
        points_, 0, Count(), circle_.centre, circle_.radius, index);
    if (previous >= 0.0 && current >= previous) {
      circle_ = before;
      break;
    }
    previous = current;
  }
  *deviation = previous;
  return ErrorCode::Ok;
}

/// Shifts the centre by least squares and takes the mean radius about it.
ErrorCode SingleArcFit::ImproveCircle() {
  std::vector<WPoint2> curve;
  if (!GeometryUtils::CalcDeviationCurve(points_, 0, Count(), circle_.centre, circle_.radius,
                                         &curve)) {
    return ErrorCode::Failed;
  }
  Point shift;
  if (!GeometryUtils::CalcCorrectionShiftForCircle(curve, &shift)) return ErrorCode::Failed;
  circle_.centre.x += shift.x;
  circle_.centre.y += shift.y;
  if (!GeometryUtils::CalcOptimalRadius(
          points_, 0, Count(), circle_.centre.x, circle_.centre.y, tolerance_,
          GeometryUtils::CircleRadiusFindingStrategy::MeanDistance, &circle_.radius)) {
    return ErrorCode::NoFit;
  }
  return ErrorCode::Ok;
}

/// Puts the final arc in the place of whatever the contour holds. Deliberate: after a partial fit
/// the arc ends where that fit ended.
ErrorCode SingleArcFit::WriteContour() {
  Point start;
  Point end = shortEnd_;
  if (!GeometryUtils::GetNearestPointOnCircle(circle_.centre, circle_.radius,
                                              ToPoint(points_.front()), &start)) {
    return ErrorCode::Failed;
  }
  if (!endsShort_ && !GeometryUtils::GetNearestPointOnCircle(circle_.centre, circle_.radius,
                                                             ToPoint(points_.back()), &end)) {
    return ErrorCode::Failed;
  }
  contour_.clear();
  GeometryUtils::AddSegm(&contour_, start);
  GeometryUtils::AddArc(&contour_, start, end, circle_.centre, circle_.radius, !ccw_);
  return ErrorCode::Ok;
}

std::int32_t SingleArcFit::Count() const { return static_cast<std::int32_t>(points_.size()); }

}  // namespace Vorn
