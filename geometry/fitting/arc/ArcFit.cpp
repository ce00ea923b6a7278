#include "geometry/fitting/arc/ArcFit.h"

#include <cmath>
#include <cstddef>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/elementary/Points.h"
#include "geometry/elementary/Sense.h"
#include "geometry/intersections/Circles.h"
#include "geometry/intersections/Lines.h"

namespace Vorn::Fitting {

namespace {

using Elementary::Circle;

/// A fixed end as it is, a free one as the point of the circle that is nearest to the run's own end
/// point; nothing when there is none.
std::optional<Point> PlaceEnd(std::optional<Point> const& fixed, Circle const& circle,
                              Point const& measured) {
  return fixed ? fixed : Intersections::NearestOnCircle(circle, measured);
}

/// The radius through a fixed end, the start if both are fixed, or else the middle of the range.
double ChooseRadius(Ends const& ends, Point const& centre, RadiusRange const& range) {
  if (ends.fixedStart) return Elementary::Distance(*ends.fixedStart, centre);
  if (ends.fixedEnd) return Elementary::Distance(*ends.fixedEnd, centre);
  return range.Middle();
}

}  // namespace

std::optional<bool> SenseOf(Run const& run, Ends const& ends) {
  if (run.count < kFewestArcPoints || !run.Exists()) return std::nullopt;
  return Elementary::IsCounterClockwise(ends.fixedStart.value_or(run.FirstPoint()),
                                        run.PointAt(run.count / 2),
                                        ends.fixedEnd.value_or(run.LastPoint()));
}

std::optional<Point> AdjustedCentre(Point const& p1, Point const& p2, Point const& centre) {
  std::optional<Elementary::ImplicitLine> const bisector =
      Elementary::PerpendicularBisector(p1, p2);
  if (!bisector) return std::nullopt;
  return Intersections::FootOn(*bisector, centre);
}

ErrorCode ArcFit::Fit(ArcRun const& arcRun, ArcCell* cell, FittedArc* arc) {
  auto const& [run, ends] = arcRun;
  // Fixed ends are not looked at here: they decide where the arc ends, not how the points turn.
  std::optional<bool> const ccw = SenseOf(run, {});
  if (!ccw) return ErrorCode::Failed;
  ErrorCode const built = ArcCellBuilder(arcRun, *ccw, afterFailure_, cell).Build();
  if (built != ErrorCode::Ok) return built;
  Circle circle;
  ErrorCode const placed = PlaceCircle(arcRun, cell->centres, &circle);
  if (placed != ErrorCode::Ok) return placed;
  std::optional<Point> const start = PlaceEnd(ends.fixedStart, circle, run.FirstPoint());
  std::optional<Point> const end = PlaceEnd(ends.fixedEnd, circle, run.LastPoint());
  if (!start || !end) return ErrorCode::Failed;
  *arc = {{*start, *end, run.count, MeasureDeviation(run, circle.radius)}, circle, *ccw};
  return ErrorCode::Ok;
}

ErrorCode ArcFit::PlaceCircle(ArcRun const& arcRun, Cells::CellSequence const& centres,
                              Circle* circle) {
  auto const& [run, ends] = arcRun;
  std::optional<Point> const centre = centres.Centre();
  if (!centre) return ErrorCode::Failed;
  circle->centre = *centre;
  std::optional<RadiusRange> range = MeasureRadiusRange(run, circle->centre);
  if (!range) return ErrorCode::NoFit;
  if (ends.fixedStart && ends.fixedEnd) {
    std::optional<Point> const adjusted =
        AdjustedCentre(*ends.fixedStart, *ends.fixedEnd, circle->centre);
    if (!adjusted) return ErrorCode::Failed;
    circle->centre = *adjusted;
    range = MeasureRadiusRange(run, circle->centre);
    if (!range) return ErrorCode::NoFit;
  }
  circle->radius = ChooseRadius(ends, circle->centre, *range);
  // A NaN is neither: then a free end fails, since it cannot be moved onto the circle.
  bool const isOutOfRange = circle->radius < range->least || circle->radius > range->greatest;
  return isOutOfRange ? ErrorCode::NoFit : ErrorCode::Ok;
}

std::optional<RadiusRange> ArcFit::MeasureRadiusRange(Run const& run, Point const& centre) {
  distances_.resize(static_cast<std::size_t>(run.count));
  WPoint const* const points = &run[0];
  for (std::size_t i = 0; i < distances_.size(); ++i) {
    distances_[i] = Elementary::Distance(ToPoint(points[i]), centre);
  }
  return CommonRange(run.count, [&](std::int32_t i) {
    return RadiusRange::Of(distances_[static_cast<std::size_t>(i)], points[i].w);
  });
}

Deviation ArcFit::MeasureDeviation(Run const& run, double radius) const {
  WPoint const* const points = &run[0];
  Deviation largest = FindLargest(run.count, [&](std::int32_t i) {
    return std::fabs(radius - distances_[static_cast<std::size_t>(i)]) / points[i].w;
  });
  largest.index += run.first;
  return largest;
}

}  // namespace Vorn::Fitting
