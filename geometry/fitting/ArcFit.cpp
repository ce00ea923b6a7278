// Arcs through runs of points.
//
// Every triple of samples allows the circle centres of one circle cell; an arc can follow the run
// while the overlap of the cells of all triples is not empty. The triples spread from the middle of
// the run outwards, each step with its mirror image. ArcCellBuilder overlaps the cells of one run,
// ArcSearch lengthens the run point by point.

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "geometry/fitting/Triples.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::ToPoint;

/// The centre cell of one run and the samples that make it up.
class ArcCellBuilder {
 public:
  using IndexedPoint = GeometryUtils::IndexedPoint;
  using Point = GeometryUtils::Point;
  using Triangle = GeometryUtils::Triangle;

  struct Run {
    std::vector<WPoint> const& points;
    std::int32_t first;
    std::int32_t count;
    bool startFixed;
    Point* start;
    bool endFixed;
    Point* end;
    bool ccw;
  };

  ArcCellBuilder(Run const& run, std::vector<IndexedPoint>* samples, std::vector<Triangle>* cell)
      : run_(run), samples_(*samples), cell_(*cell) {}

  /// Takes up every point of the run, or, when the samples of a shorter run over the same start are
  /// at hand, these with the new ends.
  void CollectSamples() {
    if (samples_.empty()) {
      for (std::int32_t i = 0; i < run_.count; ++i) samples_.push_back(SampleOf(run_.first + i));
      return;
    }
    samples_.front() = SampleOf(run_.first);
    samples_.push_back(SampleOf(run_.first + run_.count - 1));
  }

  /// Overlaps the cells of all triples. A cell that grows too large has its samples thinned, and
  /// the next pass starts afresh over those left, led by the triple that spans the run. A pass
  /// after a thinning that did not shorten the list is let grow, since thinning would go on for
  /// ever. Ends with a pass that thinned nothing.
  ErrorCode Build() {
    bool isFirstPass = true;
    bool isGuarded = true;
    for (;;) {
      std::size_t const sizeBefore = samples_.size();
      bool hasThinned = false;
      ErrorCode const code = RunPass(!isFirstPass, isGuarded, &hasThinned);
      if (code != ErrorCode::Ok || !hasThinned) return code;
      isFirstPass = false;
      isGuarded = samples_.size() < sizeBefore;
    }
  }

 private:
  IndexedPoint SampleOf(std::int32_t index) const {
    WPoint const& p = At(run_.points, index);
    return {ToPoint(p), p.w, index};
  }

  ErrorCode RunPass(bool isLed, bool isGuarded, bool* hasThinned) {
    cell_.clear();
    bool isFirstCell = true;
    int const size = static_cast<int>(samples_.size());
    Fitting::UsedSamples used(samples_.size());
    if (isLed) {
      Fitting::Triple const spanning{0, (size - 1) / 2, size - 1};
      used.Mark(spanning);
      ErrorCode const code = NarrowBy(spanning, &isFirstCell);
      if (code != ErrorCode::Ok) return code;
    }
    for (int step = 1; step <= (size - 1) / 2; ++step) {
      for (int mirror = 0; mirror < 2; ++mirror) {
        Fitting::Triple triple{};
        GeometryUtils::GetTriPointIndices(step, size, mirror, &triple.i0, &triple.i1, &triple.i2);
        if (!used.Mark(triple)) continue;
        ErrorCode const code = NarrowBy(triple, &isFirstCell);
        if (code != ErrorCode::Ok) return code;
        if (isGuarded && Fitting::IsOversized(cell_, Fitting::kArcCellWeight)) {
          *hasThinned = true;
          return GeometryUtils::ReduceCircleArcPoints(
              &samples_, &cell_, step, run_.startFixed, run_.start, run_.endFixed, run_.end,
              run_.points, run_.first, run_.count, run_.ccw);
        }
      }
    }
    return ErrorCode::Ok;
  }

  /// Overlaps the cell with that of one triple.
  ErrorCode NarrowBy(Fitting::Triple const& triple, bool* isFirstCell) {
    std::vector<Triangle> tripleCell;
    ErrorCode const code = CellOf(triple, &tripleCell);
    if (code != ErrorCode::Ok) return code;
    if (*isFirstCell) {
      *isFirstCell = false;
      cell_.swap(tripleCell);
      return ErrorCode::Ok;
    }
    std::vector<Triangle> common;
    for (Triangle const& triangle : cell_) {
      GeometryUtils::GetOverlapping(triangle, &tripleCell, &common);
    }
    cell_.swap(common);
    return cell_.empty() ? ErrorCode::NoFit : ErrorCode::Ok;
  }

  ErrorCode CellOf(Fitting::Triple const& triple, std::vector<Triangle>* cell) const {
    bool usesStart = false;
    bool usesEnd = false;
    double coords[6];
    GeometryUtils::TriPointsCoordsToArray(&samples_, triple.i0, triple.i1, triple.i2,
                                          run_.startFixed, *run_.start, run_.endFixed, *run_.end,
                                          &usesStart, &usesEnd, coords);
    return GeometryUtils::GetCircleTriangles({coords[0], coords[1], ToleranceAt(triple.i0)},
                                             {coords[2], coords[3], ToleranceAt(triple.i1)},
                                             {coords[4], coords[5], ToleranceAt(triple.i2)},
                                             usesStart, usesEnd, 0, cell);
  }

  double ToleranceAt(int position) const { return samples_[static_cast<std::size_t>(position)].w; }

  Run const run_;
  std::vector<IndexedPoint>& samples_;
  std::vector<Triangle>& cell_;
};

namespace {

using Point = GeometryUtils::Point;

constexpr std::int32_t kFewestArcPoints = 3;

}  // namespace

ErrorCode GeometryUtils::GetFittingCircleO(std::vector<WPoint> const& points, std::int32_t first,
                                           std::int32_t count, bool startFixed, Point* start,
                                           bool endFixed, Point* end,
                                           std::vector<IndexedPoint>* indexedPoints,
                                           std::vector<Triangle>* cells, std::int32_t* arcCount,
                                           Point* centre, double* radius, bool* ccw,
                                           double* deviation, std::int32_t* deviationIndex) {
  *deviationIndex = -1;
  if (count < kFewestArcPoints || !Fitting::HoldsRun(points, first, count))
    return ErrorCode::Failed;
  Point const firstPoint = ToPoint(At(points, first));
  Point const lastPoint = ToPoint(At(points, first + count - 1));
  double const area =
      GetArea(Triangle{{firstPoint, ToPoint(At(points, first + count / 2)), lastPoint}});
  if (area == 0.0) return ErrorCode::Failed;
  bool const isCcw = area < 0.0;

  ArcCellBuilder builder({points, first, count, startFixed, start, endFixed, end, isCcw},
                         indexedPoints, cells);
  builder.CollectSamples();
  ErrorCode const code = builder.Build();
  if (code != ErrorCode::Ok) return code;

  Point found;
  if (!GetCenter(cells, &found)) return ErrorCode::Failed;
  double rMin = 0.0;
  double rMax = 0.0;
  auto const findRadiusRange = [&] {
    return GetRadiusRange(points, first, count, found.x, found.y, -1.0, &rMin, &rMax);
  };
  if (!findRadiusRange()) return ErrorCode::NoFit;
  if (startFixed && endFixed) {
    if (!AdjustCenter(*start, *end, found, &found)) return ErrorCode::Failed;
    if (!findRadiusRange()) return ErrorCode::NoFit;
  }
  double foundRadius = (rMin + rMax) * 0.5;
  if (startFixed) {
    foundRadius = std::sqrt(GetDist2(*start, found));
  } else if (endFixed) {
    foundRadius = std::sqrt(GetDist2(*end, found));
  }
  bool const isInRange = rMin <= foundRadius && foundRadius <= rMax;
  if (!isInRange) return ErrorCode::NoFit;

  Point arcStart = *start;
  Point arcEnd = *end;
  if (!startFixed && !GetNearestPointOnCircle(found, foundRadius, firstPoint, &arcStart)) {
    return ErrorCode::Failed;
  }
  if (!endFixed && !GetNearestPointOnCircle(found, foundRadius, lastPoint, &arcEnd)) {
    return ErrorCode::Failed;
  }
  *start = arcStart;
  *end = arcEnd;

  for (std::int32_t i = 0; i < count; ++i) {
    WPoint const& p = At(points, first + i);
    double const relative = std::fabs(foundRadius - std::sqrt(GetDist2(ToPoint(p), found))) / p.w;
    if (i == 0 || relative > *deviation) {
      *deviation = relative;
      *deviationIndex = first + i;
    }
  }
  *arcCount = count;
  *centre = found;
  *radius = foundRadius;
  *ccw = isCcw;
  return ErrorCode::Ok;
}

/// One call of GetFittingCircle2: tries of growing length over the same start.
class ArcSearch {
 public:
  using IndexedPoint = GeometryUtils::IndexedPoint;
  using Triangle = GeometryUtils::Triangle;
  using ProgressBase = GeometryUtils::ProgressBase;

  struct Run {
    std::vector<WPoint> const& points;
    std::int32_t first;
    std::int32_t maxCount;
    std::int32_t minCount;
    bool startFixed;
    bool endFixed;
  };

  /// The caller's outputs. Tries write straight into them, but for the end point and the count.
  struct Outputs {
    Point* start;
    Point* end;
    std::vector<Triangle>* cells;
    std::int32_t* count;
    Point* centre;
    double* radius;
    bool* ccw;
    double* deviation;
    std::int32_t* deviationIndex;
  };

  ArcSearch(Run const& run, Outputs const& out, ProgressBase const& progress)
      : run_(run), out_(out), progress_(progress), workingEnd_(*out.end) {}

  ErrorCode Search() {
    out_.cells->clear();
    ErrorCode code = ErrorCode::NoFit;
    std::int32_t triedCount = 0;
    for (std::int32_t n = run_.minCount; n <= run_.maxCount; ++n) {
      code = Try(n, &triedCount);
      if (code == ErrorCode::OrientationMismatch && IsInLineOrder(n)) {
        // The points still lie on a line: the arc may begin to bend later.
        out_.cells->clear();
        continue;
      }
      if (code == ErrorCode::OrientationMismatch) code = ErrorCode::SelfIntersection;
      if (code == ErrorCode::Ok && !ContinuesArc(n)) code = ErrorCode::SelfIntersection;
      if (code != ErrorCode::Ok) break;
      if (n < run_.maxCount) {
        Save(triedCount);
        PrepareEnd(n + 1);
      }
      GeometryUtils::SetProgressState(progress_, run_.first + n + 1);
    }
    if (code == ErrorCode::Ok) return Finish(triedCount);
    if (!saved_) return code;
    Restore(code);
    return ErrorCode::Ok;
  }

 private:
  /// The longest success so far.
  struct Success {
    Point start;
    Point end;
    std::int32_t count;
    Point centre;
    double radius;
    bool ccw;
    double deviation;
    std::int32_t deviationIndex;
    std::vector<Triangle> cells;
    std::vector<IndexedPoint> samples;
  };

  ErrorCode Try(std::int32_t n, std::int32_t* triedCount) {
    return GeometryUtils::GetFittingCircleO(run_.points, run_.first, n, run_.startFixed, out_.start,
                                            run_.endFixed, &workingEnd_, &samples_, out_.cells,
                                            triedCount, out_.centre, out_.radius, out_.ccw,
                                            out_.deviation, out_.deviationIndex);
  }

  Point PointAt(std::int32_t position) const {
    return ToPoint(At(run_.points, run_.first + position));
  }

  bool IsInLineOrder(std::int32_t n) const {
    return GeometryUtils::IsValidLineOrder(PointAt(0), PointAt(n - 2), PointAt(n - 1));
  }

  /// Whether the points since the last success follow the arc, and it turns as it did before.
  bool ContinuesArc(std::int32_t n) {
    bool const skipFirstGap = n != run_.minCount;
    for (std::int32_t j = lastTested_ + 1; j < n; ++j) {
      if (!GeometryUtils::IsValidArcOrder(*out_.centre, *out_.ccw, PointAt(0), PointAt(j - 1),
                                          PointAt(j), skipFirstGap)) {
        return false;
      }
    }
    if (sense_ && *sense_ != *out_.ccw) return false;
    lastTested_ = n - 1;
    sense_ = *out_.ccw;
    return true;
  }

  void Save(std::int32_t count) {
    saved_ = Success{*out_.start,  workingEnd_, count,           *out_.centre,
                     *out_.radius, *out_.ccw,   *out_.deviation, *out_.deviationIndex,
                     *out_.cells,  samples_};
  }

  /// The end that the next try of n points starts from.
  void PrepareEnd(std::int32_t n) {
    bool const reachesInputEnd =
        static_cast<std::size_t>(run_.first) + static_cast<std::size_t>(n) == run_.points.size();
    if (reachesInputEnd && run_.endFixed) {
      workingEnd_ = *out_.end;
    } else if (Fitting::HoldsRun(run_.points, run_.first, n)) {
      workingEnd_ = PointAt(n - 1);
    }
  }

  ErrorCode Finish(std::int32_t count) {
    *out_.end = workingEnd_;
    *out_.count = count;
    GeometryUtils::SetProgressState(progress_, run_.first + count);
    return ErrorCode::Ok;
  }

  void Restore(ErrorCode reason) {
    if (reason == ErrorCode::SelfIntersection) {
      // Where it cannot be thinned, the cell stays as it is.
      GeometryUtils::ReduceCircleArcPoints(
          &saved_->samples, &saved_->cells, static_cast<int>((saved_->samples.size() - 1) / 2),
          run_.startFixed, &saved_->start, run_.endFixed, &saved_->end, run_.points, run_.first,
          saved_->count, saved_->ccw);
    }
    *out_.start = saved_->start;
    *out_.end = saved_->end;
    *out_.cells = saved_->cells;
    *out_.count = saved_->count;
    *out_.centre = saved_->centre;
    *out_.radius = saved_->radius;
    *out_.ccw = saved_->ccw;
    *out_.deviation = saved_->deviation;
    *out_.deviationIndex = saved_->deviationIndex;
    GeometryUtils::SetProgressState(progress_, run_.first + saved_->count);
  }

  Run const run_;
  Outputs const out_;
  ProgressBase const& progress_;
  Point workingEnd_;
  std::vector<IndexedPoint> samples_;
  /// Positions up to here are known to be in order; the first three need no test.
  std::int32_t lastTested_ = 2;
  std::optional<bool> sense_;
  std::optional<Success> saved_;
};

ErrorCode GeometryUtils::GetFittingCircle2(std::vector<WPoint> const& points, std::int32_t first,
                                           std::int32_t maxCount, std::int32_t minCount,
                                           bool startFixed, Point* start, bool endFixed, Point* end,
                                           std::vector<Triangle>* cells, std::int32_t* arcCount,
                                           Point* centre, double* radius, bool* ccw,
                                           double* deviation, std::int32_t* deviationIndex,
                                           ProgressBase const& progress) {
  if (minCount > maxCount) return ErrorCode::Failed;
  ArcSearch search({points, first, maxCount, minCount, startFixed, endFixed},
                   {start, end, cells, arcCount, centre, radius, ccw, deviation, deviationIndex},
                   progress);
  return search.Search();
}

ErrorCode GeometryUtils::GetFittingCircle1(std::vector<WPoint> const& points, std::int32_t first,
                                           std::int32_t maxCount, std::int32_t minCount,
                                           bool startFixed, Point* start, bool endFixed, Point* end,
                                           std::int32_t* arcCount, Point* centre, double* radius,
                                           bool* ccw, double* deviation,
                                           std::int32_t* deviationIndex) {
  Point workingEnd = *end;
  bool isEndFixed = endFixed;
  for (std::int32_t n = maxCount; n >= minCount; --n) {
    std::vector<IndexedPoint> samples;
    std::vector<Triangle> cells;
    if (GetFittingCircleO(points, first, n, startFixed, start, isEndFixed, &workingEnd, &samples,
                          &cells, arcCount, centre, radius, ccw, deviation,
                          deviationIndex) == ErrorCode::Ok) {
      *end = workingEnd;
      return ErrorCode::Ok;
    }
    isEndFixed = false;
    n = Fitting::LongestRun(points, first, n);
    if (n <= kFewestArcPoints) break;
    workingEnd = ToPoint(At(points, first + n - 2));
  }
  return ErrorCode::NoFit;
}

}  // namespace Vorn
