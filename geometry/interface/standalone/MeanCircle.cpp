// Standalone members: no other operation of the library uses them. A circle about the mean of the
// circumcentres of consecutive triples, grown point by point, and the radius range for a run with
// fixed ends.

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <new>
#include <optional>
#include <vector>

#include "geometry/elementary/CircleThrough.h"
#include "geometry/elementary/Points.h"
#include "geometry/fitting/arc/ArcFit.h"
#include "geometry/fitting/arc/RadiusRange.h"
#include "geometry/fitting/runs/Runs.h"
#include "geometry/intersections/Circles.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Elementary::Circle;
using Elementary::Distance;
using Fitting::Ends;
using Fitting::Run;

namespace {

using Point = GeometryUtils::Point;

/// The radius range of a run with fixed ends, as far as the walk over it got.
struct EndedRange {
  /// Defined once a point has been taken.
  Fitting::RadiusRange range;
  /// How many points have been taken.
  std::int32_t taken = 0;
  /// Whether all points were taken and the last fixed end, if any, lies in the range, which then is
  /// its distance alone.
  bool isComplete = false;
};

/// The range of the radii at which a circle about a centre passes within tolerance of a run. A
/// fixed end keeps the tolerance of the measured point in whose place it stands. The run must exist
/// unless its count is not positive. Deliberate: the range of the first point alone may be empty.
EndedRange FindEndedRange(Run const& run, Ends const& ends, Point const& centre, double tolerance) {
  EndedRange found;
  std::optional<double> fixedDistance;
  for (; found.taken < run.count; ++found.taken) {
    Point p = run.PointAt(found.taken);
    bool const isFirstFixed = found.taken == 0 && ends.fixedStart;
    bool const isLastFixed = found.taken == run.count - 1 && ends.fixedEnd;
    if (isFirstFixed) p = *ends.fixedStart;
    if (isLastFixed) p = *ends.fixedEnd;
    double const distance = Distance(p, centre);
    if (isFirstFixed || isLastFixed) fixedDistance = distance;
    Fitting::RadiusRange own =
        Fitting::RadiusRange::Of(distance, Fitting::ToleranceOf(run[found.taken], tolerance));
    bool const isOffCentre = own.least > 0.0;
    if (!isOffCentre) return found;
    if (found.taken > 0) {
      own.NarrowBy(found.range);
      if (own.IsEmpty()) return found;
    }
    found.range = own;
  }
  if (fixedDistance) {
    bool const isReached =
        found.range.least <= *fixedDistance && *fixedDistance <= found.range.greatest;
    if (!isReached) return found;
    found.range = {*fixedDistance, *fixedDistance};
  }
  found.isComplete = true;
  return found;
}

/// What became of one length.
enum class Outcome { Accepted, OutOfTolerance, Failed };

/// The arc over one length.
struct MeanArc {
  Point start;
  Point end;
  Circle circle;
  bool ccw = false;
};

/// One call of GetFittingCircle.
class MeanCircleFit {
 public:
  MeanCircleFit(Run const& run, Ends const& ends) : run_(run), ends_(ends) {}

  /// Tries the stretch of the first `length` points, which must be one more than in the call
  /// before (3 in the first one).
  Outcome Try(std::int32_t length, MeanArc* arc) {
    Run const stretch = run_.OfCount(length);
    Ends ends = ends_;
    if (length < run_.count) ends.fixedEnd.reset();
    if (!AddCircumcentre(stretch, ends)) return Outcome::Failed;
    MeanArc trial;
    trial.circle.centre = MeanCentre();
    EndedRange const radii = FindEndedRange(stretch, ends, trial.circle.centre, kOwnTolerances);
    if (!radii.isComplete) return Outcome::OutOfTolerance;
    trial.circle.radius = radii.range.Middle();
    if (!PlaceEnds(stretch, ends, &trial)) return Outcome::Failed;
    if (!IsWithinTolerance(stretch, trial.circle)) return Outcome::OutOfTolerance;
    std::optional<bool> const ccw = Fitting::SenseOf(stretch, ends);
    if (!ccw) return Outcome::Failed;
    trial.ccw = *ccw;
    *arc = trial;
    return Outcome::Accepted;
  }

 private:
  static constexpr double kOwnTolerances = -1.0;

  /// Adds the circumcentre of the last three points of a stretch.
  bool AddCircumcentre(Run const& stretch, Ends const& ends) {
    std::int32_t const count = stretch.count;
    Point const measuredFirst = stretch.PointAt(count - 3);
    Point const first = count == 3 ? ends.fixedStart.value_or(measuredFirst) : measuredFirst;
    Point const last = ends.fixedEnd.value_or(stretch.LastPoint());
    std::optional<Point> const circumcentre =
        Elementary::PaddedCircumcentre(first, stretch.PointAt(count - 2), last);
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

  /// Moves the free ends onto the circle; a fixed end moves the centre instead, so that the circle
  /// passes through both ends.
  static bool PlaceEnds(Run const& stretch, Ends const& ends, MeanArc* trial) {
    Circle& circle = trial->circle;
    std::optional<Point> const start =
        ends.fixedStart ? ends.fixedStart
                        : Intersections::NearestOnCircle(circle, stretch.FirstPoint());
    std::optional<Point> const end =
        ends.fixedEnd ? ends.fixedEnd : Intersections::NearestOnCircle(circle, stretch.LastPoint());
    if (!start || !end) return false;
    trial->start = *start;
    trial->end = *end;
    if (!ends.fixedStart && !ends.fixedEnd) return true;
    std::optional<Point> const adjusted =
        Fitting::AdjustedCentre(trial->start, trial->end, circle.centre);
    if (!adjusted) return false;
    circle.centre = *adjusted;
    circle.radius = Distance(trial->start, circle.centre);
    return true;
  }

  static bool IsWithinTolerance(Run const& stretch, Circle const& circle) {
    for (std::int32_t k = 0; k < stretch.count; ++k) {
      double const distance = Distance(stretch.PointAt(k), circle.centre);
      if (std::fabs(circle.radius - distance) > stretch[k].w) return false;
    }
    return true;
  }

  Run const run_;
  Ends const ends_;
  std::vector<Point> circumcentres_;
};

}  // namespace

bool GeometryUtils::GetRadiusRange(std::vector<WPoint> const& wpoints, std::int32_t begin,
                                   std::int32_t count, double cx, double cy, double tolerance,
                                   bool firstFixed, Point const* first, bool lastFixed,
                                   Point const* last, std::int32_t* failIndex, double* rmin,
                                   double* rmax) {
  Run const run{wpoints, begin, count};
  if (count > 0 && !run.Exists()) return false;
  Ends const ends{firstFixed ? std::optional<Point>(*first) : std::nullopt,
                  lastFixed ? std::optional<Point>(*last) : std::nullopt};
  EndedRange const found = FindEndedRange(run, ends, {cx, cy}, tolerance);
  // Written as far as the walk got: on failure the range reached before.
  if (found.taken > 0) {
    *rmin = found.range.least;
    *rmax = found.range.greatest;
  }
  *failIndex = found.isComplete ? count : std::min(found.taken, count - 1);
  return found.isComplete;
}

ErrorCode GeometryUtils::GetFittingCircle(std::vector<WPoint> const& wpoints, std::int32_t begin,
                                          std::int32_t count, bool firstFixed, Point* first,
                                          bool lastFixed, Point* last, std::int32_t* fitCount,
                                          Point* center, double* radius, bool* ccw,
                                          double* /*extra*/) {
  Run const run{wpoints, begin, count};
  if (count < Fitting::kFewestArcPoints || !run.Exists()) return ErrorCode::Failed;
  try {
    MeanCircleFit fit(run,
                      {Fitting::FixedIf(firstFixed, *first), Fitting::FixedIf(lastFixed, *last)});
    for (std::int32_t length = Fitting::kFewestArcPoints; length <= count; ++length) {
      MeanArc arc;
      switch (fit.Try(length, &arc)) {
        case Outcome::Failed:
          // Deliberate: a failed step is an error even when a shorter length stands.
          return ErrorCode::Failed;
        case Outcome::OutOfTolerance:
          return length > Fitting::kFewestArcPoints ? ErrorCode::Ok : ErrorCode::Failed;
        case Outcome::Accepted:
          break;
      }
      *first = arc.start;
      *last = arc.end;
      *center = arc.circle.centre;
      *radius = arc.circle.radius;
      *ccw = arc.ccw;
      *fitCount = length;
    }
    return ErrorCode::Ok;
  } catch (std::bad_alloc const&) {
    return ErrorCode::OutOfMemory;
  }
}

}  // namespace Vorn
