// Standalone members: no other operation of the library uses them. The segment at the centre of a
// line cell given as triangles (the fit holds its cells as sequences, and cuts the line alike), and
// a line through the points of a run that deviate most.

#include <cstdint>
#include <vector>

#include "geometry/cells/Centres.h"
#include "geometry/cells/FixedPoints.h"
#include "geometry/elementary/Deviations.h"
#include "geometry/fitting/line/LineCut.h"
#include "geometry/fitting/line/LineFit.h"
#include "geometry/fitting/runs/Deviations.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

bool GeometryUtils::GetOptimalLineSegment(std::vector<Triangle> const* cell, double x1, double y1,
                                          double x2, double y2, bool xOfY, bool startFixed,
                                          Point startPoint, bool endFixed, Point endPoint,
                                          double* sx, double* sy, double* ex, double* ey) {
  Cells::FixedPoints const fixed{startFixed, startPoint, endFixed, endPoint, xOfY};
  std::optional<Point> const parameters = Cells::CentreForLine(fixed, Cells::PlainCell{*cell});
  if (!parameters) return false;
  std::optional<Elementary::Segment> const segment =
      Fitting::CutLine(*parameters, fixed, {{x1, y1}, {x2, y2}});
  if (!segment) return false;
  *sx = segment->start.x;
  *sy = segment->start.y;
  *ex = segment->end.x;
  *ey = segment->end.y;
  return true;
}

namespace {

/// The positions of the points behind the first one that are nearest to and farthest from the chord
/// of a run, of equal ones the first. Nothing for ends that coincide.
struct ChordExtremes {
  Fitting::Deviation nearest;
  Fitting::Deviation farthest;
};

std::optional<ChordExtremes> FindChordExtremes(Fitting::Run const& run) {
  ChordExtremes extremes;
  for (std::int32_t i = 1; i < run.count; ++i) {
    std::optional<double> const deviation =
        Elementary::DeviationBySquares(run.FirstPoint(), run.LastPoint(), run.PointAt(i));
    if (!deviation) return std::nullopt;
    if (i == 1 || *deviation < extremes.nearest.value) extremes.nearest = {*deviation, i};
    if (i == 1 || *deviation > extremes.farthest.value) extremes.farthest = {*deviation, i};
  }
  return extremes;
}

}  // namespace

bool GeometryUtils::ReduceOverlappedTrianglesQuantityForStraightLine(
    std::vector<WPoint> const& points, int start, int count, double /*tolerance*/,
    std::vector<Triangle>* cell) {
  constexpr std::int32_t kFewestPoints = 4;
  Fitting::Run const run{points, start, count};
  if (count < kFewestPoints || !run.Exists()) return false;
  std::optional<ChordExtremes> const extremes = FindChordExtremes(run);
  if (!extremes) return false;
  auto const [nearest, farthest] = *extremes;
  std::vector<WPoint> shortRun = {run[0], run[nearest.index]};
  if (farthest.index != nearest.index) shortRun.push_back(run[farthest.index]);
  shortRun.push_back(run[count - 1]);
  // Deliberate: the cell is emptied and stays empty; the caller rebuilds it.
  cell->clear();

  ProgressBase const silent;
  std::vector<std::int32_t> offenders;
  return Fitting::FitLine({Fitting::RunOverAll(shortRun), {}, true, silent}, &offenders).code ==
         ErrorCode::Ok;
}

}  // namespace Vorn
