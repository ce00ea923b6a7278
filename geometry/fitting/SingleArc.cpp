// Strategy SingleArc.
//
// An estimate gives a common tolerance and leaves out points that are too close together for it;
// the arc fitter finds a circle over the rest; from there (or from the estimate, where it does not
// reach the end) the circle is moved by weighted least squares over all points until the largest
// deviation no longer falls.

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/elementary/CircleThrough.h"
#include "geometry/elementary/Sense.h"
#include "geometry/fitting/PieceElements.h"
#include "geometry/fitting/Strategies.h"
#include "geometry/fitting/arc/ArcFit.h"
#include "geometry/fitting/arc/ArcSearch.h"
#include "geometry/fitting/arc/CircleEstimate.h"
#include "geometry/fitting/arc/CircleRadius.h"
#include "geometry/fitting/arc/CircleShift.h"
#include "geometry/fitting/arc/ClosePoints.h"
#include "geometry/fitting/runs/Runs.h"
#include "geometry/intersections/Circles.h"

namespace Vorn::Fitting {

namespace {

using Elementary::Circle;

constexpr int kMaxRefinements = 100;

/// The points that are not left out, each with the common tolerance. `excluded` is ascending.
std::vector<WPoint> ReducedPoints(std::vector<WPoint> const& points,
                                  std::vector<std::int32_t> const& excluded, double tolerance) {
  std::vector<WPoint> reduced;
  auto nextExcluded = excluded.begin();
  for (std::size_t i = 0; i < points.size(); ++i) {
    if (nextExcluded != excluded.end() && static_cast<std::size_t>(*nextExcluded) == i) {
      ++nextExcluded;
      continue;
    }
    reduced.push_back({points[i].x, points[i].y, tolerance});
  }
  return reduced;
}

/// Appends the start of a contour and its only arc.
void AppendArc(FittedArc const& arc, Contours::Contour* contour) {
  contour->push_back(Contours::SegmentTo(arc.start));
  contour->push_back(ElementOf(arc));
}

/// The arc through exactly three points.
ErrorCode JoinThreePoints(CurveTask const& task) {
  Run const run = RunOverAll(task.points);
  Point const first = run.PointAt(0);
  Point const middle = run.PointAt(1);
  Point const last = run.PointAt(2);
  std::optional<Circle> const circle = Elementary::CircleThroughNeighbours(first, middle, last);
  if (!circle) return ErrorCode::Failed;
  std::optional<bool> const ccw = Elementary::IsCounterClockwise(first, middle, last);
  if (!ccw) return ErrorCode::Failed;
  AppendArc({{first, last, run.count, {}}, *circle, *ccw}, &task.contour);
  return ErrorCode::Ok;
}

/// The fit of four points or more.
class SingleArcFit {
 public:
  explicit SingleArcFit(CurveTask const& task) : task_(task), run_(RunOverAll(task.points)) {}

  CurveResult Fit() {
    ErrorCode const found = FindStartingCircle();
    if (found != ErrorCode::Ok) return {found, std::nullopt};
    // What a failure from here on leaves.
    Deviation passing{LargestDistance(run_, circle_).value, -1};
    double kept = -1.0;
    ErrorCode code = Refine(&kept, &passing.index);
    if (code == ErrorCode::Ok) code = WriteContour();
    if (code != ErrorCode::Ok) return {code, passing};
    // Deliberate: this strategy names no point.
    return {ErrorCode::Ok, Deviation{kept, -1}};
  }

 private:
  /// The circle that the refinement starts from and its turning sense.
  ErrorCode FindStartingCircle() {
    std::optional<ToleranceEstimate> const estimate = EstimateTolerance(task_.points);
    if (!estimate) return ErrorCode::Failed;
    std::optional<std::vector<std::int32_t>> const excluded =
        FindClosePoints(task_.points, *estimate);
    if (!excluded) return ErrorCode::Failed;
    tolerance_ = estimate->tolerance;
    std::vector<WPoint> const reduced = ReducedPoints(task_.points, *excluded, tolerance_);
    ArcSearchResult const search =
        FindLongestArc({RunOverAll(reduced), kFewestArcPoints, {}, task_.progress});
    if (search.code != ErrorCode::Ok) {
      bool const isNearlyStraight = search.code == ErrorCode::OrientationMismatch;
      return isNearlyStraight ? StartFromEstimate(estimate->circle, run_.count) : search.code;
    }
    FittedArc const& arc = *search.arc;
    // A partial fit (three points at least) says less about the whole than the estimate does.
    if (static_cast<std::size_t>(arc.count) < reduced.size()) {
      shortEnd_ = arc.end;
      return StartFromEstimate(estimate->circle, arc.count);
    }
    circle_ = arc.circle;
    ccw_ = arc.ccw;
    AppendArc(arc, &task_.contour);
    return ErrorCode::Ok;
  }

  /// Takes the estimated circle and the sense of so many points.
  ErrorCode StartFromEstimate(Circle const& estimate, std::int32_t coveredCount) {
    std::optional<bool> const ccw = SenseOf(run_.OfCount(coveredCount), {});
    if (!ccw) return ErrorCode::NoFit;
    circle_ = estimate;
    ccw_ = *ccw;
    return ErrorCode::Ok;
  }

  /// Improves the circle until the largest deviation stops falling; a step that did not improve it
  /// is undone. `deviation` receives that of the circle kept, `index` the position of the point
  /// that was farthest from the circle measured last.
  ErrorCode Refine(double* deviation, std::int32_t* index) {
    double previous = -1.0;
    for (int iteration = 0; iteration < kMaxRefinements; ++iteration) {
      Circle const before = circle_;
      ErrorCode const code = ImproveCircle();
      if (code != ErrorCode::Ok) return code;
      Deviation const current = LargestDistance(run_, circle_);
      *index = current.index;
      if (previous >= 0.0 && current.value >= previous) {
        circle_ = before;
        break;
      }
      previous = current.value;
    }
    *deviation = previous;
    return ErrorCode::Ok;
  }

  /// Shifts the centre by least squares and takes the mean radius about it.
  ErrorCode ImproveCircle() {
    std::vector<WPoint2> curve;
    if (!AppendDeviationCurve(run_, circle_, &curve)) return ErrorCode::Failed;
    std::optional<Point> const shift = FindCentreShift(curve);
    if (!shift) return ErrorCode::Failed;
    circle_.centre.x += shift->x;
    circle_.centre.y += shift->y;
    std::optional<double> const radius = FindRadius(
        run_, circle_.centre, tolerance_, GeometryUtils::CircleRadiusFindingStrategy::MeanDistance);
    if (!radius) return ErrorCode::NoFit;
    circle_.radius = *radius;
    return ErrorCode::Ok;
  }

  /// Puts the final arc in the place of whatever the contour holds. Deliberate: after a partial fit
  /// the arc ends where that fit ended.
  ErrorCode WriteContour() {
    std::optional<Point> const start = Intersections::NearestOnCircle(circle_, run_.FirstPoint());
    std::optional<Point> const end =
        shortEnd_ ? shortEnd_ : Intersections::NearestOnCircle(circle_, run_.LastPoint());
    if (!start || !end) return ErrorCode::Failed;
    task_.contour.clear();
    AppendArc({{*start, *end, run_.count, {}}, circle_, ccw_}, &task_.contour);
    return ErrorCode::Ok;
  }

  CurveTask const& task_;
  Run const run_;
  double tolerance_ = 0.0;
  Circle circle_;
  bool ccw_ = false;
  /// Where a fit ended that did not cover all points; nothing when it did or there was none.
  std::optional<Point> shortEnd_;
};

}  // namespace

CurveResult FitSingleArc(CurveTask const& task) {
  if (task.points.size() < static_cast<std::size_t>(kFewestArcPoints)) {
    return {ErrorCode::Failed, std::nullopt};
  }
  if (task.points.size() > static_cast<std::size_t>(kFewestArcPoints)) {
    return SingleArcFit(task).Fit();
  }
  ErrorCode const code = JoinThreePoints(task);
  if (code != ErrorCode::Ok) return {code, std::nullopt};
  return {ErrorCode::Ok, Deviation{0.0, -1}};
}

}  // namespace Vorn::Fitting
