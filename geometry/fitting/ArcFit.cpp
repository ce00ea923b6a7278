// Arcs through runs of points.
//
// Every triple of samples allows the circle centres of one circle cell; an arc can follow the run
// while the overlap of the cells of all triples is not empty. The triples spread from the middle of
// the run outwards, each step with its mirror image. ArcCellBuilder overlaps the cells of one run,
// ArcSearch lengthens the run point by point.

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <utility>
#include <vector>

#include "geometry/cells/CellSequence.h"
#include "geometry/fitting/Runs.h"
#include "geometry/fitting/SampleThinning.h"
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

  ArcCellBuilder(Fitting::ArcRun const& run, bool ccw, std::vector<IndexedPoint>* samples,
                 Cells::CellSequence* cell)
      : run_(run), ccw_(ccw), samples_(*samples), cell_(*cell) {}

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
        if (isGuarded && Fitting::IsOversized(cell_.size(), Fitting::kArcCellWeight)) {
          *hasThinned = true;
          return Thin(step);
        }
      }
    }
    return ErrorCode::Ok;
  }

  ErrorCode Thin(int steps) {
    Point centre;
    if (!cell_.Center(&centre)) return ErrorCode::Failed;
    ErrorCode const code = Fitting::ThinSamples(run_, centre, steps, ccw_, &samples_);
    if (code == ErrorCode::Ok) cell_.clear();
    return code;
  }

  /// Overlaps the cell with that of one triple.
  ErrorCode NarrowBy(Fitting::Triple const& triple, bool* isFirstCell) {
    tripleCell_.clear();
    ErrorCode const code = CellOf(triple, &tripleCell_);
    if (code != ErrorCode::Ok) return code;
    if (*isFirstCell) {
      *isFirstCell = false;
      cell_ = Cells::CellSequence(tripleCell_);
      return ErrorCode::Ok;
    }
    cell_.NarrowBy(tripleCell_);
    return cell_.empty() ? ErrorCode::NoFit : ErrorCode::Ok;
  }

  ErrorCode CellOf(Fitting::Triple const& triple, std::vector<Triangle>* cell) const {
    bool usesStart = false;
    bool usesEnd = false;
    double coords[6];
    GeometryUtils::TriPointsCoordsToArray(&samples_, triple.i0, triple.i1, triple.i2,
                                          run_.startFixed, run_.start, run_.endFixed, run_.end,
                                          &usesStart, &usesEnd, coords);
    return GeometryUtils::GetCircleTriangles({coords[0], coords[1], ToleranceAt(triple.i0)},
                                             {coords[2], coords[3], ToleranceAt(triple.i1)},
                                             {coords[4], coords[5], ToleranceAt(triple.i2)},
                                             usesStart, usesEnd, 0, cell);
  }

  double ToleranceAt(int position) const { return samples_[static_cast<std::size_t>(position)].w; }

  Fitting::ArcRun const& run_;
  bool const ccw_;
  std::vector<IndexedPoint>& samples_;
  Cells::CellSequence& cell_;
  std::vector<Triangle> tripleCell_;
};

namespace {

using Point = GeometryUtils::Point;

constexpr std::int32_t kFewestArcPoints = 3;

}  // namespace

/// One arc over one fixed run.
class ArcFit {
 public:
  /// What a successful fit hands out.
  struct Arc {
    Point start;
    Point end;
    Point centre;
    double radius = 0.0;
    bool ccw = false;
    double deviation = 0.0;
    std::int32_t deviationIndex = -1;
  };

  /// Fits an arc; as GetFittingCircleO, but for the cell, which is held without copies. `samples`
  /// and `cell` are left alone when the run is too short, does not exist, or does not turn.
  ErrorCode Fit(Fitting::ArcRun const& run, std::vector<GeometryUtils::IndexedPoint>* samples,
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
    ArcCellBuilder builder(run, found.ccw, samples, cell);
    builder.CollectSamples();
    ErrorCode const built = builder.Build();
    if (built != ErrorCode::Ok) return built;

    ErrorCode const placed = PlaceCircle(run, *cell, &found);
    if (placed != ErrorCode::Ok) return placed;
    if (!run.startFixed && !Snap(found, firstPoint, &found.start)) return ErrorCode::Failed;
    if (!run.endFixed && !Snap(found, lastPoint, &found.end)) return ErrorCode::Failed;
    MeasureDeviation(run, &found);
    *arc = found;
    return ErrorCode::Ok;
  }

  /// Whether the last fit got as far as to collect samples and to build a cell.
  bool HasBuiltCell() const { return hasBuiltCell_; }

 private:
  /// Centre and radius: from the cell and the points' tolerances, or from the fixed ends.
  ErrorCode PlaceCircle(Fitting::ArcRun const& run, Cells::CellSequence const& cell, Arc* arc) {
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
    bool const isInRange = minRadius_ <= arc->radius && arc->radius <= maxRadius_;
    return isInRange ? ErrorCode::Ok : ErrorCode::NoFit;
  }

  /// As GetRadiusRange with each point's own tolerance; keeps the distances for the deviation.
  bool FindRadiusRange(Fitting::ArcRun const& run, Point const& centre) {
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

  static bool Snap(Arc const& arc, Point const& p, Point* onArc) {
    return GeometryUtils::GetNearestPointOnCircle(arc.centre, arc.radius, p, onArc);
  }

  /// The largest relative deviation, and the first point that has it.
  void MeasureDeviation(Fitting::ArcRun const& run, Arc* arc) const {
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

  bool hasBuiltCell_ = false;
  double minRadius_ = 0.0;
  double maxRadius_ = 0.0;
  std::vector<double> distances_;
};

ErrorCode GeometryUtils::GetFittingCircleO(std::vector<WPoint> const& points, std::int32_t first,
                                           std::int32_t count, bool startFixed, Point* start,
                                           bool endFixed, Point* end,
                                           std::vector<IndexedPoint>* indexedPoints,
                                           std::vector<Triangle>* cells, std::int32_t* arcCount,
                                           Point* centre, double* radius, bool* ccw,
                                           double* deviation, std::int32_t* deviationIndex) {
  *deviationIndex = -1;
  ArcFit fit;
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

  /// The caller's outputs. `cells` may be null.
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
    ErrorCode code = ErrorCode::NoFit;
    for (std::int32_t n = run_.minCount; n <= run_.maxCount; ++n) {
      code = Try(n);
      if (code == ErrorCode::OrientationMismatch && IsInLineOrder(n)) {
        // The points still lie on a line: the arc may begin to bend later.
        cell_.clear();
        continue;
      }
      if (code == ErrorCode::OrientationMismatch) code = ErrorCode::SelfIntersection;
      if (code == ErrorCode::Ok && !ContinuesArc(n)) code = ErrorCode::SelfIntersection;
      if (code != ErrorCode::Ok) break;
      triedCount_ = n;
      if (n < run_.maxCount) {
        Save();
        PrepareEnd(n + 1);
      }
      GeometryUtils::SetProgressState(progress_, run_.first + n + 1);
    }
    if (code == ErrorCode::Ok) {
      Finish();
    } else if (saved_) {
      Restore(code);
      code = ErrorCode::Ok;
    }
    if (out_.cells != nullptr) *out_.cells = cell_.Expand();
    return code;
  }

 private:
  /// The longest success so far.
  struct Success {
    ArcFit::Arc arc;
    Point end;
    std::int32_t count;
    Cells::CellSequence cell;
    std::vector<IndexedPoint> samples;
  };

  /// One try; a success goes straight into the outputs, but for the end point and the count.
  ErrorCode Try(std::int32_t n) {
    *out_.deviationIndex = -1;
    ErrorCode const code = fit_.Fit(RunOf(n), &samples_, &cell_, &arc_);
    if (code != ErrorCode::Ok) return code;
    workingEnd_ = arc_.end;
    WriteArc();
    return ErrorCode::Ok;
  }

  Fitting::ArcRun RunOf(std::int32_t n) const {
    return {run_.points, run_.first, n, run_.startFixed, *out_.start, run_.endFixed, workingEnd_};
  }

  void WriteArc() {
    *out_.start = arc_.start;
    *out_.centre = arc_.centre;
    *out_.radius = arc_.radius;
    *out_.ccw = arc_.ccw;
    *out_.deviation = arc_.deviation;
    *out_.deviationIndex = arc_.deviationIndex;
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
      if (!GeometryUtils::IsValidArcOrder(arc_.centre, arc_.ccw, PointAt(0), PointAt(j - 1),
                                          PointAt(j), skipFirstGap)) {
        return false;
      }
    }
    if (sense_ && *sense_ != arc_.ccw) return false;
    lastTested_ = n - 1;
    sense_ = arc_.ccw;
    return true;
  }

  void Save() {
    if (!saved_) saved_.emplace();
    saved_->arc = arc_;
    saved_->end = workingEnd_;
    saved_->count = triedCount_;
    if (out_.cells == nullptr) return;
    saved_->cell = std::move(cell_);
    saved_->samples = samples_;
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

  void Finish() {
    *out_.end = workingEnd_;
    *out_.count = triedCount_;
    GeometryUtils::SetProgressState(progress_, run_.first + triedCount_);
  }

  void Restore(ErrorCode reason) {
    arc_ = saved_->arc;
    workingEnd_ = saved_->end;
    triedCount_ = saved_->count;
    WriteArc();
    cell_ = std::move(saved_->cell);
    // A cell whose samples can be thinned is handed out empty.
    if (reason == ErrorCode::SelfIntersection && out_.cells != nullptr) ThinSaved();
    Finish();
  }

  void ThinSaved() {
    Point centre;
    if (!cell_.Center(&centre)) return;
    int const steps = static_cast<int>((saved_->samples.size() - 1) / 2);
    if (Fitting::ThinSamples(RunOf(triedCount_), centre, steps, arc_.ccw, &saved_->samples) ==
        ErrorCode::Ok) {
      cell_.clear();
    }
  }

  Run const run_;
  Outputs const out_;
  ProgressBase const& progress_;
  ArcFit fit_;
  ArcFit::Arc arc_;
  Point workingEnd_;
  std::int32_t triedCount_ = 0;
  std::vector<IndexedPoint> samples_;
  Cells::CellSequence cell_;
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
