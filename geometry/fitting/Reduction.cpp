// Thinning of an arc candidate's samples once its cell has grown too large.
//
// Of the samples that made up the cell only those stay that bound it most: the two ends, and the
// samples nearest to and farthest from the cell's centre. The measured point in the angular middle
// of the arc comes in, so that the arc is held at three places at least.

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <iterator>
#include <map>
#include <optional>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "geometry/fitting/SampleThinning.h"
#include "geometry/fitting/Triples.h"
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
                 Point const& centre)
      : samples_(samples), run_(run), centre_(centre) {}

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
    auto const lastEntry = std::prev(entered_.end());
    nearest_ = farthest_ = std::next(entered_.begin());
    double nearest2 = Distance2(nearest_);
    double farthest2 = nearest2;
    for (auto entry = std::next(nearest_); entry != lastEntry; ++entry) {
      double const distance2 = Distance2(entry);
      if (distance2 < nearest2) {
        nearest2 = distance2;
        nearest_ = entry;
      }
      if (distance2 > farthest2) {
        farthest2 = distance2;
        farthest_ = entry;
      }
    }
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
    middle_ = NearestInDirection(Direction(isFirstOnArc ? p1 : p2));
    return true;
  }

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

  void Enter(int position, Point const& coords) {
    if (samples_.size() == 1 && position == 0) return;
    entered_[position] = coords;
    lastEnteredTolerance_ = samples_[static_cast<std::size_t>(position)].w;
  }

  double Distance2(SampleMap::const_iterator entry) const {
    return GeometryUtils::GetDist2(entry->second, centre_);
  }

  double Direction(Point const& p) const { return std::atan2(p.y - centre_.y, p.x - centre_.x); }

  std::optional<std::int32_t> NearestInDirection(double direction) const {
    std::optional<std::int32_t> nearest;
    double smallest = 0.0;
    for (std::int32_t j = run_.first + 1; j <= run_.first + run_.count - 2; ++j) {
      double difference = std::fabs(Direction(ToPoint(At(run_.points, j))) - direction);
      if (difference > Numeric::kTruncatedPi) difference = Numeric::kTruncatedTwoPi - difference;
      if (!nearest || difference < smallest) {
        smallest = difference;
        nearest = j;
      }
    }
    return nearest;
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

  SampleMap entered_;
  double lastEnteredTolerance_ = 0.0;
  SampleMap::const_iterator nearest_;
  SampleMap::const_iterator farthest_;
  /// Index of the measured point in the middle, until it is inserted.
  std::optional<std::int32_t> middle_;
};

ErrorCode Fitting::ThinSamples(ArcRun const& run, GeometryUtils::Point const& centre, int steps,
                               bool ccw, std::vector<GeometryUtils::IndexedPoint>* samples) {
  SampleThinning thinning(*samples, run, centre);
  if (!thinning.EnterTriples(steps) || !thinning.HasEnoughSamples()) return ErrorCode::Failed;
  thinning.FindNearestAndFarthest();
  if (!thinning.FindMiddle(ccw)) return ErrorCode::Failed;
  *samples = thinning.Rebuild();
  return ErrorCode::Ok;
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
