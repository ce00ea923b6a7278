#include "geometry/fewest/Fitter.h"

#include <algorithm>
#include <functional>
#include <utility>

#include "geometry/fewest/Assembly.h"
#include "geometry/fewest/BothWays.h"
#include "geometry/fewest/Centring.h"
#include "geometry/fewest/Closing.h"
#include "geometry/fewest/Keeping.h"
#include "geometry/fewest/Laps.h"
#include "geometry/fewest/OnePiece.h"
#include "geometry/fewest/Polyline.h"

namespace Vorn::Fewest {

namespace {

using Options = FewestPieces::Options;

/// From how many states a gate takes offsets, for each effort.
constexpr std::size_t kSources[] = {1, 4, 64};

/// The same for the quick one once a chain has broken a promise.
constexpr std::size_t kMoreSources = 2;

/// Shares of the tolerances at which another chain is looked for when one breaks a promise.
constexpr double kTighter[] = {0.97, 0.93, 0.88};

/// By what the tolerances near a broken promise are multiplied after each search that breaks one: a
/// little room is often enough and costs no piece.
constexpr double kTightening[] = {0.8, 0.8, 0.5, 0.5};

/// At least so many points on either side of a broken promise get a smaller tolerance.
constexpr std::int32_t kLeastReach = 4;

/// A contour of no more than this times the bound and one piece more is not mended.
constexpr double kNearBound = 1.1;

/// How often segments from point to point are taken shorter where they break promises.
constexpr int kMostRefinements = 16;

/// Looks for contours and measures what they promise.
class Fitter {
 public:
  explicit Fitter(FitTask&& task)
      : points_(task.points),
        options_(task.options),
        shift_(task.shift),
        keeping_(task.points, task.options, task.shift),
        path_(std::move(task.path)),
        runStarts_(task.runStarts),
        bound_(task.bound),
        progress_(task.progress) {}

  /// Whether one piece along a circle that covers all points, or arcs that go around it several
  /// times, keep every promise.
  bool RunAsOne(PlacedCircle const& covering, Answer* answer, Promises::Report* report) const {
    return (!options_.closed && RunAsOnePiece(covering, answer, report)) ||
           RunAsLaps(covering, answer, report);
  }

  /// A contour that keeps every promise; false when there is none. The first one found is taken
  /// unless it has clearly more pieces than the bound; then one that is repaired where the first
  /// chain breaks promises may have fewer.
  bool Run(Answer* answer, Promises::Report* report) {
    FindBest();
    if (!best_.isKept) return false;
    *answer = std::move(best_.answer);
    *report = std::move(best_.report);
    return true;
  }

 private:
  /// A contour and what was measured on it; without ranges where there was none to measure.
  struct Contour {
    Answer answer;
    Promises::Report report;
    bool isKept = false;

    std::size_t Size() const { return answer.ranges.size(); }
  };

  /// Tries other chains, ever farther from the fewest, until one keeps every promise.
  void FindBest() {
    if (Offer(Search(1.0))) return;
    // Gates that take offsets from more states lead to another chain, perhaps of as many pieces.
    quickSources_ = kMoreSources;
    Contour broken = Search(1.0);
    if (Offer(broken)) return;
    bool const hasAsFew = TryTighter(broken);
    if (!hasAsFew) TryTightened(std::move(broken));
    if (!best_.isKept) TryWhole();
    for (Repair const repair : {Repair::Mend, Repair::Retrace}) {
      if (IsNearBound()) return;
      TryRepaired(repair);
    }
  }

  /// Takes a contour for the best one when it keeps every promise with fewer pieces; whether it
  /// keeps them.
  bool Offer(Contour contour) {
    bool const isKept = contour.isKept;
    if (isKept && (!best_.isKept || contour.Size() < best_.Size())) best_ = std::move(contour);
    return isKept;
  }

  /// Whether the best contour has hardly more pieces than there have to be.
  bool IsNearBound() const {
    return best_.isKept &&
           static_cast<double>(best_.Size()) <= kNearBound * static_cast<double>(bound_) + 1.0;
  }

  /// Tries tolerances that are a little tighter everywhere, in place of a contour that breaks a
  /// promise: another chain of as many pieces may keep them all. Whether one does.
  bool TryTighter(Contour const& broken) {
    for (double const share : kTighter) {
      Contour const other = Search(share);
      bool const isKept = Offer(other);
      if (broken.Size() > 0 && other.Size() > broken.Size()) return false;
      if (isKept) return true;
    }
    return false;
  }

  /// Searches the whole path again with smaller tolerances where promises are broken.
  void TryTightened(Contour broken) {
    double const leastTolerance = path_.leastTolerance;
    for (double const factor : kTightening) {
      if (broken.Size() == 0) break;
      Tighten(broken.answer, broken.report, factor);
      broken = Search(1.0);
      if (Offer(broken)) break;
    }
    path_.points = shift_.Apply(points_);
    path_.leastTolerance = leastTolerance;
  }

  /// What does not yield near the place may yield when all pieces change.
  void TryWhole() {
    for (double const share : {0.9, 0.7, 0.5, 0.3}) {
      if (Offer(Search(share))) return;
    }
    // Segments keep to the path between the points and have no radius.
    path_.limits.segmentsOnly = true;
    bool const isKept = Offer(Search(1.0));
    path_.limits.segmentsOnly = options_.segmentsOnly;
    if (isKept) return;
    Contour along;
    along.isKept = RunAlongPoints(&along.answer, &along.report);
    Offer(std::move(along));
  }

  /// Repairs the first chain where it breaks promises.
  void TryRepaired(Repair repair) {
    quickSources_ = kSources[0];
    repair_ = repair;
    Offer(Search(1.0));
    repair_ = Repair::None;
  }

  /// Segments from point to point; every point becomes a joint where they break promises.
  bool RunAlongPoints(Answer* answer, Promises::Report* report) const {
    std::vector<char> isJoint(points_.size(), 0);
    for (int round = 0; round < kMostRefinements; ++round) {
      *answer = FollowPoints(points_, options_.closed, isJoint);
      if (keeping_.IsKept(*answer, report)) return true;
      if (answer->ranges.empty()) return false;
      for (Promises::Violation const& violation : report->violations) {
        MarkPoints(answer->ranges[violation.piece], &isJoint);
        if (violation.otherPiece == Promises::kNone) continue;
        MarkPoints(answer->ranges[violation.otherPiece], &isJoint);
      }
    }
    *answer = FollowPoints(points_, options_.closed, std::vector<char>(points_.size(), 1));
    return keeping_.IsKept(*answer, report);
  }

  /// Marks the points of a piece and the one behind it.
  void MarkPoints(FewestPieces::Range const& range, std::vector<char>* isJoint) const {
    std::int32_t const count = path_.Count();
    std::int32_t const length = (range.last - range.first + count) % count + 1;
    for (std::int32_t k = 0; k <= length; ++k) {
      (*isJoint)[static_cast<std::size_t>((range.first + k) % count)] = 1;
    }
  }

  bool RunAsOnePiece(PlacedCircle const& covering, Answer* answer, Promises::Report* report) const {
    for (Chain const& chain : MakeOnePiece(path_, covering)) {
      if (keeping_.KeepsCentred({path_, 0}, chain, answer, report)) return true;
      RoundEnds(Tightest(points_).w, answer);
      if (keeping_.IsKept(*answer, report)) return true;
    }
    return false;
  }

  bool RunAsLaps(PlacedCircle const& covering, Answer* answer, Promises::Report* report) const {
    Laps const laps = WindLaps(path_, covering, options_.closed);
    if (laps.chain.pieces.empty()) return false;
    Path path = path_;
    path.start = laps.start;
    path.finish = laps.finish;
    return keeping_.Keeps({path, 0}, laps.chain, answer, report);
  }

  /// Finds and measures one contour.
  Contour Search(double share) {
    Contour found;
    if (options_.closed) {
      found.isKept = SearchClosed(share, &found.answer, &found.report);
      return found;
    }
    Chain const chain = SearchOpen(share);
    found.isKept = !chain.pieces.empty() &&
                   keeping_.KeepsRepaired(repair_, {path_, 0}, chain, &found.answer, &found.report);
    return found;
  }

  /// The shortest open chain of all efforts; empty when there is none.
  Chain SearchOpen(double share) {
    Chain chain;
    // A wider look starts from other gates, so it may also end with more pieces.
    for (std::int32_t effort = 0; effort <= static_cast<std::int32_t>(options_.effort); ++effort) {
      Look(effort);
      Chain next = FindOpen(share);
      bool const isBetter = chain.pieces.empty() || next.pieces.size() < chain.pieces.size();
      if (isBetter && !next.pieces.empty()) chain = std::move(next);
      if (chain.pieces.size() == runStarts_.size()) break;
    }
    return chain;
  }

  /// Has the next search look as hard as an effort asks.
  void Look(std::int32_t effort) {
    path_.limits.mostSources = effort == 0 ? quickSources_ : kSources[effort];
    path_.limits.looksFar = effort > 0;
  }

  Chain FindOpen(double share) {
    return FindChainBothWays(path_, share * kSearchShare, runStarts_,
                             [&](std::int32_t done) { Tell(done); });
  }

  void Tell(std::int32_t done) { progress_.Tell(kCovered, kSearched, done); }

  /// Multiplies the tolerances of the search about the places where promises fail by a factor below
  /// 1, which leaves room for them and may cost a piece there.
  void Tighten(Answer const& answer, Promises::Report const& report, double factor) {
    for (Promises::Violation const& violation : report.violations) {
      TightenNear(answer.ranges[violation.piece], violation.at, factor);
      if (violation.otherPiece != Promises::kNone) {
        TightenNear(answer.ranges[violation.otherPiece], violation.at, factor);
      }
    }
    path_.leastTolerance *= factor;
  }

  void TightenNear(FewestPieces::Range const& range, GeometryUtils::Point const& at,
                   double factor) {
    std::int32_t const count = path_.Count();
    std::int32_t const length = (range.last - range.first + count) % count + 1;
    std::int32_t const nearest = keeping_.NearestOf({range.first, range.first + length - 1}, at);
    std::int32_t const reach = std::max(kLeastReach, length / 8);
    for (std::int32_t k = nearest - reach; k <= nearest + reach; ++k) {
      std::int32_t const i = range.first + k;
      if (!options_.closed && (i < 0 || i >= count)) continue;
      path_.points[static_cast<std::size_t>((i % count + count) % count)].w *= factor;
    }
  }

  /// The closed contour of the fewest pieces of all efforts. Where no circuit closes it begins at a
  /// joint of an open chain.
  bool SearchClosed(double share, Answer* answer, Promises::Report* report) {
    std::function<void(std::int32_t)> const tell = [&](std::int32_t done) { Tell(done); };
    std::function<bool(CutPath const&, Chain const&, Answer*, Promises::Report*)> const keeps =
        [&](CutPath const& cut, Chain const& chain, Answer* closed, Promises::Report* measured) {
          return keeping_.KeepsRepaired(repair_, {cut.path, cut.rotation}, chain, closed, measured);
        };
    ClosingTask const task{path_, share * kSearchShare, bound_, runStarts_, tell, keeps};
    ClosedContour best;
    for (std::int32_t effort = 0; effort <= static_cast<std::int32_t>(options_.effort); ++effort) {
      Look(effort);
      ClosedContour next = CloseAnywhere(task);
      if (IsBetter(next, best)) best = std::move(next);
      if (best.isKept && best.answer.ranges.size() <= bound_) break;
    }
    Chain open;
    if (!best.isShort) open = SearchOpen(share);
    if (!open.pieces.empty()) CloseAtJoints(task, open, &best);
    *answer = std::move(best.answer);
    *report = std::move(best.report);
    bool const isFew = open.pieces.empty() || answer->ranges.size() <= open.pieces.size() + 1;
    if (best.isKept && isFew) return true;
    return (!open.pieces.empty() && CloseBySegment(open, answer, report)) || best.isKept;
  }

  /// Whether a closed contour is to be taken for another one.
  static bool IsBetter(ClosedContour const& one, ClosedContour const& other) {
    if (one.isKept != other.isKept) return one.isKept;
    return other.answer.ranges.empty() ||
           (one.isKept && one.answer.ranges.size() < other.answer.ranges.size());
  }

  /// The open chain with a segment from its end back to its start; leaves the answer where that
  /// breaks a promise.
  bool CloseBySegment(Chain const& open, Answer* answer, Promises::Report* report) const {
    Chain const centred = options_.centre ? Centre(path_, open) : open;
    for (Chain const* chain : {&centred, &open}) {
      Answer closed = Restore(shift_, *chain, BuildPieces(path_, *chain));
      Promises::Report closedReport;
      if (!AppendClosingSegment(&closed) || !keeping_.IsKept(closed, &closedReport)) continue;
      *answer = std::move(closed);
      *report = std::move(closedReport);
      return true;
    }
    return false;
  }

  std::vector<WPoint> const& points_;
  Options const& options_;
  Shift const& shift_;
  Keeping keeping_;
  Path path_;
  std::vector<std::int32_t> const& runStarts_;
  std::size_t bound_;
  Repair repair_ = Repair::None;
  Contour best_;
  std::size_t quickSources_ = kSources[0];
  Progress& progress_;
};

}  // namespace

bool FindContour(FitTask task, PlacedCircle const* covering, Answer* answer,
                 Promises::Report* report) {
  Fitter fitter(std::move(task));
  if (covering != nullptr && fitter.RunAsOne(*covering, answer, report)) return true;
  return fitter.Run(answer, report);
}

}  // namespace Vorn::Fewest
