// Members for fitting an arc over cells: the search for the longest arc, its sense and order, and
// the triples of its samples.

#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/fitting/arc/ArcFit.h"
#include "geometry/fitting/arc/ArcOrder.h"
#include "geometry/fitting/arc/ArcSearch.h"
#include "geometry/fitting/arc/Triples.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

ErrorCode GeometryUtils::GetFittingCircle2(std::vector<WPoint> const& points, std::int32_t first,
                                           std::int32_t maxCount, std::int32_t minCount,
                                           bool startFixed, Point* start, bool endFixed, Point* end,
                                           std::vector<Triangle>* cells, std::int32_t* arcCount,
                                           Point* centre, double* radius, bool* ccw,
                                           double* deviation, std::int32_t* deviationIndex,
                                           ProgressBase const& progress) {
  if (minCount > maxCount) return ErrorCode::Failed;
  auto const [code, arc, centres] = Fitting::FindLongestArc(
      {{points, first, maxCount},
       minCount,
       {Fitting::FixedIf(startFixed, *start), Fitting::FixedIf(endFixed, *end)},
       progress,
       cells != nullptr ? Fitting::AfterFailure::KeepCell : Fitting::AfterFailure::NoCell});
  *deviationIndex = -1;
  if (arc) {
    *start = arc->start;
    *centre = arc->circle.centre;
    *radius = arc->circle.radius;
    *ccw = arc->ccw;
    *deviation = arc->deviation.value;
    *deviationIndex = arc->deviation.index;
  }
  if (code == ErrorCode::Ok) {
    *end = arc->end;
    *arcCount = arc->count;
  }
  if (cells != nullptr) *cells = centres.Expand();
  return code;
}

bool GeometryUtils::IsValidArcOrder(Point const& center, bool ccw, Point const& p1, Point const& p2,
                                    Point const& p3) {
  return Fitting::IsOnArc({center, ccw}, p1, p2, p3);
}

bool GeometryUtils::IsValidArcOrder(Point const& centre, bool ccw, Point const& p1, Point const& p2,
                                    Point const& p3, bool skipFirstGap) {
  return Fitting::ContinuesArc({centre, ccw}, p1, p2, p3, skipFirstGap);
}

ErrorCode GeometryUtils::IsCcw(std::vector<WPoint> const& wpoints, std::int32_t begin,
                               std::int32_t count, bool firstFixed, Point const& first,
                               bool lastFixed, Point const& last, Point const& /*center*/,
                               bool* ccw) {
  std::optional<bool> const isCcw =
      Fitting::SenseOf({wpoints, begin, count},
                       {Fitting::FixedIf(firstFixed, first), Fitting::FixedIf(lastFixed, last)});
  if (!isCcw) return ErrorCode::Failed;
  *ccw = *isCcw;
  return ErrorCode::Ok;
}

bool GeometryUtils::AdjustCenter(Point const& p1, Point const& p2, Point const& center,
                                 Point* adjusted) {
  std::optional<Point> const found = Fitting::AdjustedCentre(p1, p2, center);
  if (found) *adjusted = *found;
  return found.has_value();
}

void GeometryUtils::GetTriPointIndices(int step, int size, int mirror, int* i0, int* i1, int* i2) {
  Fitting::Triple const triple = Fitting::TripleOf(step, size, mirror == 1);
  *i0 = triple.i0;
  *i1 = triple.i1;
  *i2 = triple.i2;
}

void GeometryUtils::TriPointsCoordsToArray(std::vector<IndexedPoint> const* samples, int i0, int i1,
                                           int i2, bool firstFixed, Point const& first,
                                           bool lastFixed, Point const& last, bool* usedFirst,
                                           bool* usedLast, double* const coords) {
  Fitting::TriplePoints const points(
      *samples, {i0, i1, i2},
      {Fitting::FixedIf(firstFixed, first), Fitting::FixedIf(lastFixed, last)});
  *usedFirst = points.usesStart;
  *usedLast = points.usesEnd;
  double* next = coords;
  for (Point const& p : {points.first, points.middle, points.last}) {
    *next++ = p.x;
    *next++ = p.y;
  }
}

}  // namespace Vorn
