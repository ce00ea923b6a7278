#include "geometry/fitting/arc/SampleThinning.h"

#include <cstddef>
#include <cstdint>
#include <iterator>
#include <map>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/elementary/Points.h"
#include "geometry/fitting/arc/ArcOrder.h"
#include "geometry/fitting/arc/CentreChoices.h"
#include "geometry/intersections/Circles.h"
#include "math/Assert.h"

namespace Vorn::Fitting {

namespace {

using IndexedPoint = GeometryUtils::IndexedPoint;

/// Two ends, nearest, farthest and one to drop: with fewer there is nothing to thin.
constexpr std::size_t kFewestSamples = 5;

/// One thinning, step by step.
class SampleThinning {
 public:
  SampleThinning(ThinningTask const& task, Cells::RoughCentre const& centre, Samples const& samples)
      : samples_(samples), run_(task.arcRun.run), task_(task), centre_(centre) {}

  /// Enters the samples of all triples up to the task's step into the map. False when a triple
  /// leaves the list.
  bool EnterTriples() {
    int const size = static_cast<int>(samples_.size());
    UsedSamples used(samples_.size());
    for (int step = 1; step <= task_.steps; ++step) {
      for (bool const isMirrored : {false, true}) {
        Triple const triple = TripleOf(step, size, isMirrored);
        if (!used.Holds(triple)) return false;
        if (used.Mark(triple)) EnterTriple(triple);
      }
    }
    return true;
  }

  bool HasEnoughSamples() const { return entered_.size() >= kFewestSamples; }

  /// The samples whose distance from the centre is smallest and largest. When they are one and the
  /// same, two that cut the list in thirds.
  void FindNearestAndFarthest() {
    VORN_ASSERT(HasEnoughSamples());
    auto const firstEntry = std::next(entered_.begin());
    auto const lastEntry = std::prev(entered_.end());
    Choice<SampleMap::const_iterator> nearest;
    Choice<SampleMap::const_iterator> farthest;
    for (auto entry = firstEntry; entry != lastEntry; ++entry) {
      double const distance2 = centre_.SquaredDistanceTo(entry->second);
      nearest.Offer(distance2, entry);
      farthest.Offer(-distance2, entry);
    }
    nearest_ = nearest.best;
    farthest_ = farthest.best;
    double const slack2 = centre_.SquaredDistanceSlack(-farthest.least);
    Require(nearest.Lead() > slack2 && farthest.Lead() > slack2);
    if (nearest_ == farthest_) {
      auto const third = static_cast<std::ptrdiff_t>((entered_.size() - 1) / 3);
      nearest_ = std::next(entered_.begin(), third);
      farthest_ = std::next(nearest_, third);
    }
  }

  /// Finds the measured point whose direction from the centre is nearest to the middle of the arc.
  /// False when the run has no chord or the arc no middle.
  bool FindMiddle() {
    std::optional<Intersections::CirclePoints> const middles = MiddlesOfCircle();
    if (!middles || middles->count != 2) return false;
    Point const first = run_.FirstPoint();
    Point const last = run_.LastPoint();
    Point const& onArcIfFirst = middles->pts[0];
    bool const isFirstOnArc = IsOnArc({centre_.At(), task_.ccw}, first, onArcIfFirst, last);
    Require(centre_.AreClearlyApart(first, onArcIfFirst) &&
            centre_.AreClearlyApart(onArcIfFirst, last) && centre_.AreClearlyApart(last, first));
    middle_ = NearestInDirection(centre_.DirectionTo(middles->pts[isFirstOnArc ? 0 : 1]));
    return true;
  }

  /// Whether all that was chosen would be chosen for every centre within the error.
  bool IsClear() const { return isClear_; }

  /// The samples that stay, and the middle point.
  Samples Rebuild() {
    Samples kept;
    for (std::size_t i = 0; i < samples_.size(); ++i) {
      IndexedPoint const& sample = samples_[i];
      int const position = static_cast<int>(i);
      if (middle_ && *middle_ < sample.index) InsertMiddle(&kept);
      bool const isEnd = i == 0 || i + 1 == samples_.size();
      if (isEnd || !entered_.contains(position)) {
        kept.push_back(sample);
      } else if (position == nearest_->first) {
        kept.push_back(Extreme(nearest_));
      } else if (position == farthest_->first) {
        kept.push_back(Extreme(farthest_));
      } else if (middle_ && sample.index == *middle_) {
        InsertMiddle(&kept);
      }
    }
    return kept;
  }

 private:
  using SampleMap = std::map<int, Point>;

  void EnterTriple(Triple const& triple) {
    TriplePoints const points(samples_, triple, task_.arcRun.ends);
    Enter(triple.i0, points.first);
    Enter(triple.i1, points.middle);
    Enter(triple.i2, points.last);
  }

  void Enter(int position, Point const& p) {
    if (samples_.size() == 1 && position == 0) return;
    entered_[position] = p;
    lastEnteredTolerance_ = samples_[static_cast<std::size_t>(position)].w;
  }

  /// Where the circle through the run's ends, in the mean, meets the perpendicular to their chord
  /// through the centre: the middle of the arc and that of the arc's other side. Nothing for ends
  /// that coincide.
  std::optional<Intersections::CirclePoints> MiddlesOfCircle() const {
    Point const first = run_.FirstPoint();
    Point const last = run_.LastPoint();
    std::optional<Elementary::ImplicitLine> const chord = Elementary::LineThrough(first, last);
    if (!chord) return std::nullopt;
    double const radius =
        (Elementary::Distance(last, centre_.At()) + Elementary::Distance(first, centre_.At())) *
        0.5;
    return Intersections::CutCircleByLine({centre_.At(), radius},
                                          chord->NormalThrough(centre_.At()));
  }

  std::optional<std::int32_t> NearestInDirection(double direction) {
    Choice<std::int32_t> nearest;
    double slack = 0.0;
    for (std::int32_t position = 1; position < run_.count - 1; ++position) {
      Point const p = run_.PointAt(position);
      nearest.Offer(AngleBetween(centre_.DirectionTo(p), direction), run_.first + position);
      slack = std::max(slack, centre_.DirectionSlack(p));
    }
    if (nearest.count == 0) return std::nullopt;
    Require(nearest.Lead() > slack);
    return nearest.best;
  }

  void Require(bool isClear) { isClear_ = isClear_ && (isClear || centre_.IsExact()); }

  void InsertMiddle(Samples* kept) {
    WPoint const& p = run_[*middle_ - run_.first];
    kept->push_back({ToPoint(p), p.w, *middle_});
    middle_.reset();
  }

  /// Deliberate: the tolerance is that of the sample entered last, and the index is 0, so that the
  /// record never counts as lying behind a middle point.
  IndexedPoint Extreme(SampleMap::const_iterator entry) const {
    return {entry->second, lastEnteredTolerance_, 0};
  }

  Samples const& samples_;
  Run const& run_;
  ThinningTask const& task_;
  UncertainCentre const centre_;
  bool isClear_ = true;

  /// The samples in use by their positions, fixed ends in the place of those they stand for.
  SampleMap entered_;
  double lastEnteredTolerance_ = 0.0;
  SampleMap::const_iterator nearest_;
  SampleMap::const_iterator farthest_;
  /// Index of the measured point in the middle, until it is inserted.
  std::optional<std::int32_t> middle_;
};

}  // namespace

std::optional<ErrorCode> ThinSamples(ThinningTask const& task, Cells::RoughCentre const& centre,
                                     Samples* samples) {
  SampleThinning thinning(task, centre, *samples);
  if (!thinning.EnterTriples() || !thinning.HasEnoughSamples()) return ErrorCode::Failed;
  thinning.FindNearestAndFarthest();
  bool const hasMiddle = thinning.FindMiddle();
  if (!thinning.IsClear() || (!hasMiddle && centre.error > 0.0)) return std::nullopt;
  if (!hasMiddle) return ErrorCode::Failed;
  *samples = thinning.Rebuild();
  return ErrorCode::Ok;
}

ErrorCode ThinSamples(ThinningTask const& task, Point const& centre, Samples* samples) {
  // Without an error every choice is clear.
  return ThinSamples(task, Cells::RoughCentre{centre, 0.0}, samples).value_or(ErrorCode::Failed);
}

}  // namespace Vorn::Fitting
