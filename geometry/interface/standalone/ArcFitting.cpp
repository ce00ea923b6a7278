// Standalone members: no other operation of the library uses them. One arc over a fixed run and the
// thinning of its samples, both with the cell handed over as triangles, and the search for an arc
// from the longest run downwards. The steps are those of the fit, which holds its cells as
// sequences and searches upwards.

#include <algorithm>
#include <cstdint>
#include <utility>
#include <vector>

#include "geometry/cells/Centres.h"
#include "geometry/fitting/arc/ArcFit.h"
#include "geometry/fitting/arc/SampleThinning.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

ErrorCode GeometryUtils::GetFittingCircleO(std::vector<WPoint> const& points, std::int32_t first,
                                           std::int32_t count, bool startFixed, Point* start,
                                           bool endFixed, Point* end,
                                           std::vector<IndexedPoint>* indexedPoints,
                                           std::vector<Triangle>* cells, std::int32_t* arcCount,
                                           Point* centre, double* radius, bool* ccw,
                                           double* deviation, std::int32_t* deviationIndex) {
  *deviationIndex = -1;
  Fitting::ArcRun const arcRun{
      {points, first, count},
      {Fitting::FixedIf(startFixed, *start), Fitting::FixedIf(endFixed, *end)}};
  // Samples and cell are handed out as soon as there is a sense to build the cell for.
  if (!Fitting::SenseOf(arcRun.run, {})) return ErrorCode::Failed;
  Fitting::ArcFit fit(cells != nullptr ? Fitting::AfterFailure::KeepCell
                                       : Fitting::AfterFailure::NoCell);
  Fitting::ArcCell cell{std::move(*indexedPoints), {}};
  Fitting::FittedArc arc;
  ErrorCode const code = fit.Fit(arcRun, &cell, &arc);
  *indexedPoints = std::move(cell.samples);
  if (cells != nullptr) *cells = cell.centres.Expand();
  if (code != ErrorCode::Ok) return code;
  *start = arc.start;
  *end = arc.end;
  *arcCount = arc.count;
  *centre = arc.circle.centre;
  *radius = arc.circle.radius;
  *ccw = arc.ccw;
  *deviation = arc.deviation.value;
  *deviationIndex = arc.deviation.index;
  return ErrorCode::Ok;
}

namespace {

/// The length of a run cut to the points there are, plus one: the shortest that is too long. Zero
/// for a run that begins nowhere.
std::int32_t ShortestTooLong(Fitting::Run const& run) {
  std::int64_t const available = static_cast<std::int64_t>(run.points.size()) - run.first;
  if (run.first < 0 || available < 0) return 0;
  return static_cast<std::int32_t>(std::min<std::int64_t>(run.count, available + 1));
}

}  // namespace

ErrorCode GeometryUtils::GetFittingCircle1(std::vector<WPoint> const& points, std::int32_t first,
                                           std::int32_t maxCount, std::int32_t minCount,
                                           bool startFixed, Point* start, bool endFixed, Point* end,
                                           std::int32_t* arcCount, Point* centre, double* radius,
                                           bool* ccw, double* deviation,
                                           std::int32_t* deviationIndex) {
  Fitting::Ends ends{Fitting::FixedIf(startFixed, *start), Fitting::FixedIf(endFixed, *end)};
  Fitting::ArcFit fit(Fitting::AfterFailure::NoCell);
  for (std::int32_t n = maxCount; n >= minCount; --n) {
    Fitting::Run const run{points, first, n};
    Fitting::ArcCell cell;
    Fitting::FittedArc arc;
    *deviationIndex = -1;
    if (fit.Fit({run, ends}, &cell, &arc) == ErrorCode::Ok) {
      *start = arc.start;
      *end = arc.end;
      *arcCount = arc.count;
      *centre = arc.circle.centre;
      *radius = arc.circle.radius;
      *ccw = arc.ccw;
      *deviation = arc.deviation.value;
      *deviationIndex = arc.deviation.index;
      return ErrorCode::Ok;
    }
    // A fixed end is that of the full run only.
    ends.fixedEnd.reset();
    n = ShortestTooLong(run);
    if (n <= Fitting::kFewestArcPoints) break;
  }
  return ErrorCode::NoFit;
}

ErrorCode GeometryUtils::ReduceCircleArcPoints(std::vector<IndexedPoint>* samples,
                                               std::vector<Triangle>* cell, int steps,
                                               bool firstFixed, Point* first, bool lastFixed,
                                               Point* last, std::vector<WPoint> const& wpoints,
                                               std::int32_t begin, std::int32_t count, bool ccw) {
  Fitting::ArcRun const arcRun{
      {wpoints, begin, count},
      {Fitting::FixedIf(firstFixed, *first), Fitting::FixedIf(lastFixed, *last)}};
  if (count < 1 || !arcRun.run.Exists()) return ErrorCode::Failed;
  std::optional<Point> const centre = Cells::CentreOf(*cell);
  if (!centre) return ErrorCode::Failed;
  ErrorCode const code = Fitting::ThinSamples({arcRun, ccw, steps}, *centre, samples);
  if (code == ErrorCode::Ok) cell->clear();
  return code;
}

}  // namespace Vorn
