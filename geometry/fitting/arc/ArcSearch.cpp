#include "geometry/fitting/arc/ArcSearch.h"

#include <cstddef>
#include <utility>

#include "geometry/fitting/arc/ArcFit.h"
#include "geometry/fitting/arc/ArcOrder.h"
#include "geometry/fitting/arc/SampleThinning.h"
#include "geometry/fitting/runs/LineOrder.h"
#include "geometry/fitting/runs/Progress.h"
#include "math/Assert.h"

namespace Vorn::Fitting {

namespace {

/// One search, try by try.
class ArcSearch {
 public:
  explicit ArcSearch(ArcSearchTask const& task)
      : task_(task), fit_(task.cellUse), workingEnd_(task.ends.fixedEnd) {}

  ArcSearchResult Search() {
    ErrorCode code = ErrorCode::Failed;
    for (std::int32_t n = task_.minCount; n <= task_.run.count; ++n) {
      code = Try(n);
      if (code == ErrorCode::OrientationMismatch && IsInLineOrder(n)) {
        // The points still lie on a line: the arc may begin to bend later.
        cell_.centres.clear();
        continue;
      }
      if (code == ErrorCode::OrientationMismatch) code = ErrorCode::SelfIntersection;
      if (code == ErrorCode::Ok && !FollowsArc(n)) code = ErrorCode::SelfIntersection;
      if (code != ErrorCode::Ok) break;
      if (n < task_.run.count) {
        Save();
        PrepareEnd(n + 1);
      }
      ReportProgress(task_.progress, task_.run.first + n + 1);
    }
    return Finish(code);
  }

 private:
  /// The longest success so far, and what it was made of when the cell is asked for.
  struct Success {
    FittedArc arc;
    ArcCell cell;
  };

  bool IsCellAskedFor() const { return task_.cellUse == AfterFailure::KeepCell; }

  ErrorCode Try(std::int32_t n) {
    arc_.reset();
    FittedArc arc;
    ErrorCode const code = fit_.Fit(ArcRunOf(n), &cell_, &arc);
    if (code == ErrorCode::Ok) arc_ = arc;
    return code;
  }

  ArcRun ArcRunOf(std::int32_t n) const {
    return {task_.run.OfCount(n), {task_.ends.fixedStart, workingEnd_}};
  }

  bool IsInLineOrder(std::int32_t n) const {
    Run const& run = task_.run;
    return MovesAway(run.PointAt(0), run.PointAt(n - 2), run.PointAt(n - 1));
  }

  /// Whether the points since the last success follow the arc, and it turns as it did before.
  bool FollowsArc(std::int32_t n) {
    Run const& run = task_.run;
    ArcTurn const turn{arc_->circle.centre, arc_->ccw};
    bool const skipFirstStep = n != task_.minCount;
    for (std::int32_t j = lastTested_ + 1; j < n; ++j) {
      if (!ContinuesArc(turn, run.PointAt(0), run.PointAt(j - 1), run.PointAt(j), skipFirstStep)) {
        return false;
      }
    }
    if (sense_ && *sense_ != arc_->ccw) return false;
    lastTested_ = n - 1;
    sense_ = arc_->ccw;
    return true;
  }

  void Save() {
    if (!saved_) saved_.emplace();
    saved_->arc = *arc_;
    if (!IsCellAskedFor()) return;
    saved_->cell.centres = std::move(cell_.centres);
    saved_->cell.samples = cell_.samples;
  }

  /// The end that the next try, of n points, must keep to.
  void PrepareEnd(std::int32_t n) {
    if (!task_.ends.fixedEnd) return;
    Run const run = task_.run.OfCount(n);
    bool const reachesInputEnd =
        static_cast<std::size_t>(run.first) + static_cast<std::size_t>(n) == run.points.size();
    if (reachesInputEnd) {
      workingEnd_ = task_.ends.fixedEnd;
    } else if (run.Exists()) {
      workingEnd_ = run.LastPoint();
    }
  }

  ArcSearchResult Finish(ErrorCode code) {
    if (code != ErrorCode::Ok && saved_) {
      // A cell whose samples can be thinned is handed out empty.
      if (code == ErrorCode::SelfIntersection && IsCellAskedFor()) ThinSaved();
      code = ErrorCode::Ok;
      arc_ = saved_->arc;
      cell_.centres = std::move(saved_->cell.centres);
    }
    VORN_ASSERT(code != ErrorCode::Ok || arc_);
    if (code == ErrorCode::Ok) ReportProgress(task_.progress, task_.run.first + arc_->count);
    return {code, arc_, std::move(cell_.centres)};
  }

  void ThinSaved() {
    auto& [arc, cell] = *saved_;
    std::optional<Point> const centre = cell.centres.Centre();
    if (!centre) return;
    workingEnd_ = arc.end;
    if (!task_.ends.fixedEnd) workingEnd_.reset();
    ArcRun const arcRun = ArcRunOf(arc.count);
    int const steps = static_cast<int>((cell.samples.size() - 1) / 2);
    if (ThinSamples({arcRun, arc.ccw, steps}, *centre, &cell.samples) == ErrorCode::Ok) {
      cell.centres.clear();
    }
  }

  ArcSearchTask const& task_;
  ArcFit fit_;
  /// What the last try found; nothing when it found none.
  std::optional<FittedArc> arc_;
  ArcCell cell_;
  /// The end that the next try must keep to, if the end is fixed.
  std::optional<Point> workingEnd_;
  /// Positions up to here are known to be in order; the first two need no test.
  std::int32_t lastTested_ = 1;
  std::optional<bool> sense_;
  std::optional<Success> saved_;
};

}  // namespace

ArcSearchResult FindLongestArc(ArcSearchTask const& task) { return ArcSearch(task).Search(); }

}  // namespace Vorn::Fitting
