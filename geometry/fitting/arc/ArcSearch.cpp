// The longest run of points that one arc can follow: by growing the run from its shortest length,
// or by shrinking it from its longest.

#include <cstddef>
#include <cstdint>
#include <optional>
#include <utility>
#include <vector>

#include "geometry/cells/fast/CellSequence.h"
#include "geometry/fitting/Runs.h"
#include "geometry/fitting/arc/ArcFit.h"
#include "geometry/fitting/arc/SampleThinning.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::kFewestArcPoints;
using Fitting::ToPoint;

/// One call of GetFittingCircle2: tries of growing length over the same start.
class ArcSearch {
 public:
  using Point = GeometryUtils::Point;
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
      : run_(run),
        out_(out),
        progress_(progress),
        fit_(out.cells != nullptr ? ArcFit::AfterFailure::KeepCell : ArcFit::AfterFailure::NoCell),
        workingEnd_(*out.end) {}

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
  /// Positions up to here are known to be in order; the first two need no test.
  std::int32_t lastTested_ = 1;
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
