// A circle about the mean of the circumcentres of consecutive triples, grown point by point, with
// the radius range, centre adjustment and turning sense that go with it.

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <new>
#include <optional>
#include <vector>

#include "geometry/elementary/CircleThrough.h"
#include "geometry/fitting/Runs.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::ToPoint;

bool GeometryUtils::GetRadiusRange(std::vector<WPoint> const& wpoints, std::int32_t begin,
                                   std::int32_t count, double cx, double cy, double tolerance,
                                   bool firstFixed, Point const* first, bool lastFixed,
                                   Point const* last, std::int32_t* failIndex, double* rmin,
                                   double* rmax) {
  if (count > 0 && !Fitting::HoldsRun(wpoints, begin, count)) return false;
  Point const center{cx, cy};
  bool isAnyFixed = false;
  double fixedDistance = 0.0;
  for (std::int32_t k = 0; k < count; ++k) {
    *failIndex = k;
    WPoint const& measured = At(wpoints, begin + k);
    Point p = ToPoint(measured);
    if (k == 0 && firstFixed) {
      p = *first;
      isAnyFixed = true;
      fixedDistance = std::sqrt(GetDist2(p, center));
    }
    if (k == count - 1 && lastFixed) {
      p = *last;
      isAnyFixed = true;
      fixedDistance = std::sqrt(GetDist2(p, center));
    }
    double const distance = std::sqrt(GetDist2(p, center));
    // A fixed end keeps the tolerance of the measured point in whose place it stands.
    double const half = tolerance < 0.0 ? measured.w : tolerance;
    double lower = distance - half;
    double upper = distance + half;
    bool const isOffCentre = lower > 0.0;
    if (!isOffCentre) return false;
    if (k > 0) {
      lower = std::max(lower, *rmin);
      upper = std::min(upper, *rmax);
      if (lower > upper) return false;
    }
    *rmin = lower;
    *rmax = upper;
  }
  if (isAnyFixed) {
    bool const isReached = *rmin <= fixedDistance && fixedDistance <= *rmax;
    if (!isReached) return false;
    *rmin = *rmax = fixedDistance;
  }
  *failIndex = count;
  return true;
}

bool GeometryUtils::AdjustCenter(Point const& p1, Point const& p2, Point const& center,
                                 Point* adjusted) {
  double a = 0.0;
  double b = 0.0;
  double c = 0.0;
  if (!GetLineParameters(p1.x, p1.y, p2.x, p2.y, &a, &b, &c)) return false;
  Point const middle{(p1.x + p2.x) / 2.0, (p1.y + p2.y) / 2.0};
  double na = 0.0;
  double nb = 0.0;
  double nc = 0.0;
  GetNormal(a, b, c, middle, &na, &nb, &nc);
  return GetNearestPointOnLine(na, nb, nc, center, adjusted);
}

ErrorCode GeometryUtils::IsCcw(std::vector<WPoint> const& wpoints, std::int32_t begin,
                               std::int32_t count, bool firstFixed, Point const& first,
                               bool lastFixed, Point const& last, Point const& /*center*/,
                               bool* ccw) {
  if (count < 3 || !Fitting::HoldsRun(wpoints, begin, count)) return ErrorCode::Failed;
  Point const a = firstFixed ? first : ToPoint(At(wpoints, begin));
  Point const b = ToPoint(At(wpoints, begin + count / 2));
  Point const c = lastFixed ? last : ToPoint(At(wpoints, begin + count - 1));
  return IsCcw(a, b, c, ccw);
}

/// One call of GetFittingCircle.
class MeanCircleRun {
 public:
  using Point = GeometryUtils::Point;

  struct Fixed {
    bool first;
    Point firstPoint;
    bool last;
    Point lastPoint;
  };

  struct Circle {
    Point start;
    Point end;
    Point center;
    double radius = 0.0;
    bool ccw = false;
  };

  /// What became of one length.
  enum class Outcome { Accepted, OutOfTolerance, Failed };

  MeanCircleRun(std::vector<WPoint> const& wpoints, std::int32_t begin, std::int32_t count,
                Fixed const& fixed)
      : wpoints_(wpoints), begin_(begin), count_(count), fixed_(fixed) {}

  /// Tries the stretch of the first `length` points, which must be one more than in the call
  /// before (3 in the first one).
  Outcome Try(std::int32_t length, Circle* circle) {
    bool const isLastFixed = fixed_.last && length == count_;
    if (!AddCircumcentre(length)) return Outcome::Failed;
    Circle trial;
    trial.center = MeanCentre();
    if (!ChooseRadius(length, isLastFixed, &trial)) return Outcome::OutOfTolerance;
    if (!PlaceEnds(length, isLastFixed, &trial)) return Outcome::Failed;
    if (!IsWithinTolerance(length, trial)) return Outcome::OutOfTolerance;
    if (GeometryUtils::IsCcw(wpoints_, begin_, length, fixed_.first, trial.start, isLastFixed,
                             trial.end, trial.center, &trial.ccw) != ErrorCode::Ok) {
      return Outcome::Failed;
    }
    *circle = trial;
    return Outcome::Accepted;
  }

 private:
  WPoint const& Measured(std::int32_t position) const { return At(wpoints_, begin_ + position); }

  bool AddCircumcentre(std::int32_t length) {
    Point first = ToPoint(Measured(length - 3));
    Point const middle = ToPoint(Measured(length - 2));
    Point last = ToPoint(Measured(length - 1));
    if (fixed_.first && length == 3) first = fixed_.firstPoint;
    if (fixed_.last && length == count_) last = fixed_.lastPoint;
    std::optional<Point> const circumcentre = Elementary::PaddedCircumcentre(first, middle, last);
    if (!circumcentre) return false;
    circumcentres_.push_back(*circumcentre);
    return true;
  }

  Point MeanCentre() const {
    Point sum;
    for (Point const& circumcentre : circumcentres_) {
      sum.x += circumcentre.x;
      sum.y += circumcentre.y;
    }
    auto const n = static_cast<double>(circumcentres_.size());
    return {sum.x / n, sum.y / n};
  }

  bool ChooseRadius(std::int32_t length, bool isLastFixed, Circle* trial) const {
    std::int32_t failIndex = 0;
    double rmin = 0.0;
    double rmax = 0.0;
    if (!GeometryUtils::GetRadiusRange(wpoints_, begin_, length, trial->center.x, trial->center.y,
                                       -1.0, fixed_.first, &fixed_.firstPoint, isLastFixed,
                                       &fixed_.lastPoint, &failIndex, &rmin, &rmax)) {
      return false;
    }
    trial->radius = (rmin + rmax) * 0.5;
    return true;
  }

  /// Moves the free ends onto the circle; a fixed end moves the centre instead, so that the circle
  /// passes through both ends.
  bool PlaceEnds(std::int32_t length, bool isLastFixed, Circle* trial) const {
    if (fixed_.first) {
      trial->start = fixed_.firstPoint;
    } else if (!Snap(*trial, Measured(0), &trial->start)) {
      return false;
    }
    if (isLastFixed) {
      trial->end = fixed_.lastPoint;
    } else if (!Snap(*trial, Measured(length - 1), &trial->end)) {
      return false;
    }
    if (!fixed_.first && !isLastFixed) return true;
    if (!GeometryUtils::AdjustCenter(trial->start, trial->end, trial->center, &trial->center)) {
      return false;
    }
    trial->radius = std::sqrt(GeometryUtils::GetDist2(trial->start, trial->center));
    return true;
  }

  static bool Snap(Circle const& circle, WPoint const& p, Point* onCircle) {
    return GeometryUtils::GetNearestPointOnCircle(circle.center, circle.radius, ToPoint(p),
                                                  onCircle);
  }

  bool IsWithinTolerance(std::int32_t length, Circle const& circle) const {
    for (std::int32_t k = 0; k < length; ++k) {
      WPoint const& p = Measured(k);
      double const distance = std::sqrt(GeometryUtils::GetDist2(ToPoint(p), circle.center));
      if (std::fabs(circle.radius - distance) > p.w) return false;
    }
    return true;
  }

  std::vector<WPoint> const& wpoints_;
  std::int32_t const begin_;
  std::int32_t const count_;
  Fixed const fixed_;
  std::vector<Point> circumcentres_;
};

ErrorCode GeometryUtils::GetFittingCircle(std::vector<WPoint> const& wpoints, std::int32_t begin,
                                          std::int32_t count, bool firstFixed, Point* first,
                                          bool lastFixed, Point* last, std::int32_t* fitCount,
                                          Point* center, double* radius, bool* ccw,
                                          double* /*extra*/) {
  if (count < 3 || !Fitting::HoldsRun(wpoints, begin, count)) return ErrorCode::Failed;
  try {
    MeanCircleRun run(wpoints, begin, count, {firstFixed, *first, lastFixed, *last});
    for (std::int32_t length = 3; length <= count; ++length) {
      MeanCircleRun::Circle circle;
      switch (run.Try(length, &circle)) {
        case MeanCircleRun::Outcome::Failed:
          // Deliberate: a failed step is an error even when a shorter length stands.
          return ErrorCode::Failed;
        case MeanCircleRun::Outcome::OutOfTolerance:
          return length > 3 ? ErrorCode::Ok : ErrorCode::Failed;
        case MeanCircleRun::Outcome::Accepted:
          break;
      }
      *first = circle.start;
      *last = circle.end;
      *center = circle.center;
      *radius = circle.radius;
      *ccw = circle.ccw;
      *fitCount = length;
    }
    return ErrorCode::Ok;
  } catch (std::bad_alloc const&) {
    return ErrorCode::OutOfMemory;
  }
}

}  // namespace Vorn
