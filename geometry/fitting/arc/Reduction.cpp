// Thinning of an arc candidate's samples once its cell has grown too large.
//
// Of the samples that made up the cell only those stay that bound it most: the two ends, and the
// samples nearest to and farthest from the cell's centre. The measured point in the angular middle
// of the arc comes in, so that the arc is held at three places at least.

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <iterator>
#include <limits>
#include <map>
#include <optional>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "geometry/fitting/arc/SampleThinning.h"
#include "geometry/fitting/arc/Triples.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::ToPoint;

/// One call of ReduceCircleArcPoints.
class SampleThinning {
 public:
  using IndexedPoint = GeometryUtils::IndexedPoint;
  using Point = GeometryUtils::Point;

  SampleThinning(std::vector<IndexedPoint> const& samples, Fitting::ArcRun const& run,
                 Cells::RoughCentre const& centre)
      : samples_(samples), run_(run), centre_(centre.at), error_(centre.error) {}

  /// Enters the samples of all triples up to a step into the map. False when a triple leaves the
  /// list.
  bool EnterTriples(int steps) {
    int const size = static_cast<int>(samples_.size());
    Fitting::UsedSamples used(samples_.size());
    for (int step = 1; step <= steps; ++step) {
      for (int mirror = 0; mirror < 2; ++mirror) {
        Fitting::Triple triple{};
        GeometryUtils::GetTriPointIndices(step, size, mirror, &triple.i0, &triple.i1, &triple.i2);
        if (!used.Holds(triple)) return false;
        if (!used.Mark(triple)) continue;
        bool usedFirst = false;
        bool usedLast = false;
        double coords[6];
        GeometryUtils::TriPointsCoordsToArray(&samples_, triple.i0, triple.i1, triple.i2,
                                              run_.startFixed, run_.start, run_.endFixed, run_.end,
                                              &usedFirst, &usedLast, coords);
        Enter(triple.i0, {coords[0], coords[1]});
        Enter(triple.i1, {coords[2], coords[3]});
        Enter(triple.i2, {coords[4], coords[5]});
      }
    }
    return true;
  }

  bool HasEnoughSamples() const { return entered_.size() >= kFewestSamples; }

  /// The samples whose distance from the centre is smallest and largest. When they are one and the
  /// same, two that cut the list in thirds.
  void FindNearestAndFarthest() {
    auto const firstEntry = std::next(entered_.begin());
    auto const lastEntry = std::prev(entered_.end());
    Choice<SampleMap::const_iterator> nearest;
    Choice<SampleMap::const_iterator> farthest;
    for (auto entry = firstEntry; entry != lastEntry; ++entry) {
      double const distance2 = Distance2(entry);
      nearest.Offer(distance2, entry);
      farthest.Offer(-distance2, entry);
    }
    nearest_ = nearest.best;
    farthest_ = farthest.best;
    double const slack2 = DistanceSlack2(-farthest.least);
    Require(nearest.Lead() > slack2 && farthest.Lead() > slack2);
    if (nearest_ == farthest_) {
      auto const third = static_cast<std::ptrdiff_t>((entered_.size() - 1) / 3);
      nearest_ = std::next(entered_.begin(), third);
      farthest_ = std::next(nearest_, third);
    }
  }

  /// Finds the measured point whose direction from the centre is nearest to the middle of the arc.
  /// False when the run has no chord or the arc no middle.
  bool FindMiddle(bool ccw) {
    WPoint const& first = At(run_.points, run_.first);
    WPoint const& last = At(run_.points, run_.first + run_.count - 1);
    double a = 0.0;
    double b = 0.0;
    double c = 0.0;
    if (!GeometryUtils::GetLineParameters(first.x, first.y, last.x, last.y, &a, &b, &c)) {
      return false;
    }
    double na = 0.0;
    double nb = 0.0;
    double nc = 0.0;
    GeometryUtils::GetNormal(a, b, c, centre_, &na, &nb, &nc);
    double const radius = (std::sqrt(GeometryUtils::GetDist2(ToPoint(last), centre_)) +
                           std::sqrt(GeometryUtils::GetDist2(ToPoint(first), centre_))) *
                          0.5;
    Point p1;
    Point p2;
    if (GeometryUtils::GetLineAndCircleIntersection(na, nb, nc, centre_.x, centre_.y, radius, &p1.x,
                                                    &p1.y, &p2.x, &p2.y) != 2) {
      return false;
    }
    bool const isFirstOnArc =
        GeometryUtils::IsValidArcOrder(centre_, ccw, ToPoint(first), p1, ToPoint(last));
    Require(AreClearlyApart(ToPoint(first), p1) && AreClearlyApart(p1, ToPoint(last)) &&
            AreClearlyApart(ToPoint(last), ToPoint(first)));
    middle_ = NearestInDirection(Direction(isFirstOnArc ? p1 : p2));
    return true;
  }

  /// Whether all that was chosen would be chosen for every centre within the error.
  bool IsClear() const { return isClear_; }

  std::vector<IndexedPoint> Rebuild() {
    std::vector<IndexedPoint> kept;
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

  /// Two ends, nearest, farthest and one to drop: with fewer there is nothing to thin.
  static constexpr std::size_t kFewestSamples = 5;

  /// More than all roundings of a distance or of a direction together, relative to it.
  static constexpr double kRounding = 0x1p-48;
  static constexpr double kSafety = 16.0;

  /// The first of the candidates with the least value, and how far behind the next one is.
  template <typename Candidate>
  struct Choice {
    void Offer(double value, Candidate const& candidate) {
      bool const isBetter = count == 0 || value < least;
      if (count > 0) runnerUp = std::min(runnerUp, isBetter ? least : value);
      if (isBetter) {
        least = value;
        best = candidate;
      }
      ++count;
    }

    double Lead() const { return runnerUp - least; }

    Candidate best{};
    double least = 0.0;
    double runnerUp = std::numeric_limits<double>::infinity();
    int count = 0;
  };

  void Enter(int position, Point const& coords) {
    if (samples_.size() == 1 && position == 0) return;
    entered_[position] = coords;
    lastEnteredTolerance_ = samples_[static_cast<std::size_t>(position)].w;
  }

  double Distance2(SampleMap::const_iterator entry) const {
    return GeometryUtils::GetDist2(entry->second, centre_);
  }

  double Direction(Point const& p) const { return std::atan2(p.y - centre_.y, p.x - centre_.x); }

  std::optional<std::int32_t> NearestInDirection(double direction) {
    Choice<std::int32_t> nearest;
    double slack = 0.0;
    for (std::int32_t j = run_.first + 1; j <= run_.first + run_.count - 2; ++j) {
      Point const p = ToPoint(At(run_.points, j));
      nearest.Offer(AngleBetween(Direction(p), direction), j);
      slack = std::max(slack, DirectionSlack(p));
    }
    if (nearest.count == 0) return std::nullopt;
    Require(nearest.Lead() > slack);
    return nearest.best;
  }

  static double AngleBetween(double direction, double other) {
    double const difference = std::fabs(direction - other);
    return difference > Numeric::kTruncatedPi ? Numeric::kTruncatedTwoPi - difference : difference;
  }

  void Require(bool isClear) { isClear_ = isClear_ && (isClear || error_ == 0.0); }

  bool AreClearlyApart(Point const& p, Point const& q) const {
    return AngleBetween(Direction(p), Direction(q)) > DirectionSlack(p) + DirectionSlack(q);
  }

  /// By how much two squared distances up to the largest one may change against each other with a
  /// centre within the error, their rounding included; several times over.
  double DistanceSlack2(double largest2) const {
    double const distance = std::sqrt(largest2);
    return kSafety * (error_ + kRounding * distance) * (distance + error_);
  }

  /// The same for the directions of two points no nearer than this one.
  double DirectionSlack(Point const& p) const {
    return kSafety * (error_ / std::sqrt(GeometryUtils::GetDist2(p, centre_)) + kRounding);
  }

  void InsertMiddle(std::vector<IndexedPoint>* kept) {
    WPoint const& p = At(run_.points, *middle_);
    kept->push_back({ToPoint(p), p.w, *middle_});
    middle_.reset();
  }

  /// Deliberate: the tolerance is that of the sample entered last, and the index is 0, so that the
  /// record never counts as lying behind a middle point.
  IndexedPoint Extreme(SampleMap::const_iterator entry) const {
    return {entry->second, lastEnteredTolerance_, 0};
  }

  std::vector<IndexedPoint> const& samples_;
  Fitting::ArcRun const& run_;
  Point const centre_;
  double const error_;
  bool isClear_ = true;

  SampleMap entered_;
  double lastEnteredTolerance_ = 0.0;
  SampleMap::const_iterator nearest_;
  SampleMap::const_iterator farthest_;
  /// Index of the measured point in the middle, until it is inserted.
  std::optional<std::int32_t> middle_;
};

std::optional<ErrorCode> Fitting::ThinSamples(ArcRun const& run, Cells::RoughCentre const& centre,
                                              int steps, bool ccw,
                                              std::vector<GeometryUtils::IndexedPoint>* samples) {
  SampleThinning thinning(*samples, run, centre);
  if (!thinning.EnterTriples(steps) || !thinning.HasEnoughSamples()) return ErrorCode::Failed;
  thinning.FindNearestAndFarthest();
  bool const hasMiddle = thinning.FindMiddle(ccw);
  if (!thinning.IsClear() || (!hasMiddle && centre.error > 0.0)) return std::nullopt;
  if (!hasMiddle) return ErrorCode::Failed;
  *samples = thinning.Rebuild();
  return ErrorCode::Ok;
}

ErrorCode Fitting::ThinSamples(ArcRun const& run, GeometryUtils::Point const& centre, int steps,
                               bool ccw, std::vector<GeometryUtils::IndexedPoint>* samples) {
  // Without an error every choice is clear.
  return ThinSamples(run, Cells::RoughCentre{centre, 0.0}, steps, ccw, samples)
      .value_or(ErrorCode::Failed);
}

ErrorCode GeometryUtils::ReduceCircleArcPoints(std::vector<IndexedPoint>* samples,
                                               std::vector<Triangle>* cell, int steps,
                                               bool firstFixed, Point* first, bool lastFixed,
                                               Point* last, std::vector<WPoint> const& wpoints,
                                               std::int32_t begin, std::int32_t count, bool ccw) {
  if (count < 1 || !Fitting::HoldsRun(wpoints, begin, count)) return ErrorCode::Failed;
  Point centre;
  if (!GetCenter(cell, &centre)) return ErrorCode::Failed;
  ErrorCode const code = Fitting::ThinSamples(
      {wpoints, begin, count, firstFixed, *first, lastFixed, *last}, centre, steps, ccw, samples);
  if (code == ErrorCode::Ok) cell->clear();
  return code;
}

void GeometryUtils::GetTriPointIndices(int step, int size, int mirror, int* i0, int* i1, int* i2) {
  bool const isInner = step < size / 3;
  int const low = isInner ? step : 0;
  int const middle = isInner ? (step - 1 + size) / 2 : step;
  int const high = size - 1;
  bool const isMirrored = mirror == 1;
  *i0 = isMirrored ? size - 1 - high : low;
  *i1 = isMirrored ? size - 1 - middle : middle;
  *i2 = isMirrored ? size - 1 - low : high;
}

void GeometryUtils::TriPointsCoordsToArray(std::vector<IndexedPoint> const* samples, int i0, int i1,
                                           int i2, bool firstFixed, Point const& first,
                                           bool lastFixed, Point const& last, bool* usedFirst,
                                           bool* usedLast, double* const coords) {
  int const positions[3] = {i0, i1, i2};
  for (int i = 0; i < 3; ++i) {
    Point const& p = (*samples)[static_cast<std::size_t>(positions[i])].pt;
    coords[2 * i] = p.x;
    coords[2 * i + 1] = p.y;
  }
  *usedFirst = firstFixed && i0 == 0;
  if (*usedFirst) {
    coords[0] = first.x;
    coords[1] = first.y;
  }
  *usedLast = lastFixed && static_cast<std::size_t>(i2) + 1 == samples->size();
  if (*usedLast) {
    coords[4] = last.x;
    coords[5] = last.y;
  }
}

}  // namespace Vorn
