// One arc over one run of points: the cell of admissible centres gives the centre, the points' own
// tolerances about it give the radius, and the free ends are moved onto the circle.

#include "geometry/fitting/arc/ArcFit.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

#include "geometry/fitting/Runs.h"

namespace Vorn {

using Fitting::At;
using Fitting::kFewestArcPoints;
using Fitting::ToPoint;

ErrorCode ArcFit::Fit(Fitting::ArcRun const& run, std::vector<GeometryUtils::IndexedPoint>* samples,
                      Cells::CellSequence* cell, Arc* arc) {
  hasBuiltCell_ = false;
  if (run.count < kFewestArcPoints || !Fitting::HoldsRun(run.points, run.first, run.count)) {
    return ErrorCode::Failed;
  }
  Point const firstPoint = ToPoint(At(run.points, run.first));
  Point const middlePoint = ToPoint(At(run.points, run.first + run.count / 2));
  Point const lastPoint = ToPoint(At(run.points, run.first + run.count - 1));
  Arc found{run.start, run.end, {}};
  if (GeometryUtils::IsCcw(firstPoint, middlePoint, lastPoint, &found.ccw) != ErrorCode::Ok) {
    return ErrorCode::Failed;
  }
  hasBuiltCell_ = true;
  ArcCellBuilder builder(run, found.ccw, afterFailure_, samples, cell);
  builder.CollectSamples();
  ErrorCode const built = builder.Build();
  if (built != ErrorCode::Ok) return built;

  ErrorCode const placed = PlaceCircle(run, *cell, &found);
  if (placed != ErrorCode::Ok) return placed;
  auto const snap = [&found](Point const& p, Point* onArc) {
    return GeometryUtils::GetNearestPointOnCircle(found.centre, found.radius, p, onArc);
  };
  if (!run.startFixed && !snap(firstPoint, &found.start)) return ErrorCode::Failed;
  if (!run.endFixed && !snap(lastPoint, &found.end)) return ErrorCode::Failed;
  MeasureDeviation(run, &found);
  *arc = found;
  return ErrorCode::Ok;
}

ErrorCode ArcFit::PlaceCircle(Fitting::ArcRun const& run, Cells::CellSequence const& cell,
                              Arc* arc) {
  if (!cell.Center(&arc->centre)) return ErrorCode::Failed;
  if (!FindRadiusRange(run, arc->centre)) return ErrorCode::NoFit;
  if (run.startFixed && run.endFixed) {
    if (!GeometryUtils::AdjustCenter(run.start, run.end, arc->centre, &arc->centre)) {
      return ErrorCode::Failed;
    }
    if (!FindRadiusRange(run, arc->centre)) return ErrorCode::NoFit;
  }
  arc->radius = (minRadius_ + maxRadius_) * 0.5;
  if (run.startFixed) {
    arc->radius = std::sqrt(GeometryUtils::GetDist2(run.start, arc->centre));
  } else if (run.endFixed) {
    arc->radius = std::sqrt(GeometryUtils::GetDist2(run.end, arc->centre));
  }
  // A NaN is neither: then a free end fails, since it cannot be moved onto the circle.
  bool const isOutOfRange = arc->radius < minRadius_ || arc->radius > maxRadius_;
  return isOutOfRange ? ErrorCode::NoFit : ErrorCode::Ok;
}

bool ArcFit::FindRadiusRange(Fitting::ArcRun const& run, Point const& centre) {
  distances_.resize(static_cast<std::size_t>(run.count));
  WPoint const* const points = run.points.data() + run.first;
  for (std::size_t i = 0; i < distances_.size(); ++i) {
    double const dx = points[i].x - centre.x;
    double const dy = points[i].y - centre.y;
    distances_[i] = std::sqrt(dy * dy + dx * dx);
  }
  minRadius_ = distances_[0] - points[0].w;
  maxRadius_ = distances_[0] + points[0].w;
  if (minRadius_ > maxRadius_) return false;
  for (std::size_t i = 1; i < distances_.size(); ++i) {
    minRadius_ = std::max(minRadius_, distances_[i] - points[i].w);
    maxRadius_ = std::min(maxRadius_, distances_[i] + points[i].w);
    if (minRadius_ > maxRadius_) return false;
  }
  return true;
}

void ArcFit::MeasureDeviation(Fitting::ArcRun const& run, Arc* arc) const {
  WPoint const* const points = run.points.data() + run.first;
  std::size_t largestAt = 0;
  double largest = std::fabs(arc->radius - distances_[0]) / points[0].w;
  for (std::size_t i = 1; i < distances_.size(); ++i) {
    double const relative = std::fabs(arc->radius - distances_[i]) / points[i].w;
    if (relative > largest) {
      largest = relative;
      largestAt = i;
    }
  }
  arc->deviation = largest;
  arc->deviationIndex = run.first + static_cast<std::int32_t>(largestAt);
}

ErrorCode GeometryUtils::GetFittingCircleO(std::vector<WPoint> const& points, std::int32_t first,
                                           std::int32_t count, bool startFixed, Point* start,
                                           bool endFixed, Point* end,
                                           std::vector<IndexedPoint>* indexedPoints,
                                           std::vector<Triangle>* cells, std::int32_t* arcCount,
                                           Point* centre, double* radius, bool* ccw,
                                           double* deviation, std::int32_t* deviationIndex) {
  *deviationIndex = -1;
  ArcFit fit(cells != nullptr ? ArcFit::AfterFailure::KeepCell : ArcFit::AfterFailure::NoCell);
  ArcFit::Arc arc;
  Cells::CellSequence cell;
  ErrorCode const code = fit.Fit({points, first, count, startFixed, *start, endFixed, *end},
                                 indexedPoints, &cell, &arc);
  if (cells != nullptr && fit.HasBuiltCell()) *cells = cell.Expand();
  if (code != ErrorCode::Ok) return code;
  *start = arc.start;
  *end = arc.end;
  *arcCount = count;
  *centre = arc.centre;
  *radius = arc.radius;
  *ccw = arc.ccw;
  *deviation = arc.deviation;
  *deviationIndex = arc.deviationIndex;
  return ErrorCode::Ok;
}

}  // namespace Vorn
