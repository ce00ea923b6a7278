#include "geometry/fewest/LineCorners.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <optional>

namespace Vorn::Fewest {

namespace {

using Point = GeometryUtils::Point;

/// How often all corners are looked at at most: one may only come out exactly when its neighbours
/// do.
constexpr int kSweeps = 8;

/// Sine of the angle from which on the crossing of two lines is a corner.
constexpr double kLeastSine = 0.05;

/// A joint moves where the sum of the squared deviations falls below this share of it.
constexpr double kLeastGain = 0.999;

/// A point within this many times its tolerance of a joint is beside it.
constexpr double kNear = 4.0;

/// Segments that deviate less than this share of the tolerances are exact.
constexpr double kExact = 1e-12;

/// A straight line through a place in a direction of length 1.
struct Line {
  Point place;
  Point direction;
};

/// The line of the least squares of the distances of points, each in units of its tolerance.
class Regression {
 public:
  explicit Regression(double unit) : unit_(unit) {}

  /// Takes the mean of the points first and their moments about it then.
  template <typename ForEachPoint>
  std::optional<Line> FitTo(ForEachPoint const& forEachPoint) {
    forEachPoint([&](WPoint const& p) { AddToMean(p); });
    if (count_ < 2) return {};
    mean_ = {mean_.x / weight_, mean_.y / weight_};
    forEachPoint([&](WPoint const& p) { AddMoments(p); });
    // The eigenvector of the larger eigenvalue, of its two forms the one without cancellation.
    double const root = std::sqrt(difference_ * difference_ + product_ * product_);
    Point const along = difference_ > 0.0 ? Point{difference_ + root, product_}
                                          : Point{product_, root - difference_};
    double const length = std::sqrt(along.x * along.x + along.y * along.y);
    if (!(length > 0.0)) return {};
    return Line{mean_, {along.x / length, along.y / length}};
  }

 private:
  void AddToMean(WPoint const& p) {
    double const inverse = unit_ / p.w;
    double const weight = inverse * inverse;
    weight_ += weight;
    mean_.x += weight * p.x;
    mean_.y += weight * p.y;
    ++count_;
  }
  void AddMoments(WPoint const& p) {
    double const dx = unit_ / p.w * (p.x - mean_.x);
    double const dy = unit_ / p.w * (p.y - mean_.y);
    difference_ += dx * dx - dy * dy;
    product_ += 2.0 * dx * dy;
  }

  double unit_;
  std::int32_t count_ = 0;
  double weight_ = 0.0;
  Point mean_;
  double difference_ = 0.0;
  double product_ = 0.0;
};

std::optional<Point> CrossingOf(Line const& one, Line const& other) {
  double const sine = one.direction.x * other.direction.y - one.direction.y * other.direction.x;
  if (!(std::fabs(sine) > kLeastSine)) return {};
  double const dx = other.place.x - one.place.x;
  double const dy = other.place.y - one.place.y;
  double const along = (dx * other.direction.y - dy * other.direction.x) / sine;
  return Point{one.place.x + along * one.direction.x, one.place.y + along * one.direction.y};
}

bool IsNear(Point const& joint, WPoint const& p) {
  return DistanceBetween(p, {joint.x, joint.y, 0.0}) <= kNear * p.w;
}

Point FootOn(Line const& line, Point const& p) {
  double const along =
      (p.x - line.place.x) * line.direction.x + (p.y - line.place.y) * line.direction.y;
  return {line.place.x + along * line.direction.x, line.place.y + along * line.direction.y};
}

class Sharpening {
 public:
  Sharpening(Path const& path, Chain const& chain, std::vector<BuiltPiece>* pieces)
      : path_(path), chain_(chain), pieces_(*pieces) {}

  void Run() {
    for (int sweep = 0; sweep < kSweeps; ++sweep) {
      if (!MoveAll()) return;
    }
  }

 private:
  /// Moves every joint and end once; false when none moved.
  bool MoveAll() {
    std::size_t const joints = pieces_.size() - (path_.start.isFree ? 1 : 0);
    bool isAnyMoved = false;
    for (std::size_t k = 0; k < joints; ++k) {
      if (IsBetweenSegments(k) && MoveJoint(k)) isAnyMoved = true;
    }
    if (path_.start.isFree && IsSegment(0) && MoveStart()) isAnyMoved = true;
    if (path_.finish.isFree && IsSegment(pieces_.size() - 1) && MoveFinish()) isAnyMoved = true;
    return isAnyMoved;
  }

  /// How much segments deviate, in tolerances.
  struct Deviations {
    double largest = 0.0;
    double squares = 0.0;  ///< the sum over the points

    Deviations And(Deviations const& other) const {
      return {std::max(largest, other.largest), squares + other.squares};
    }
    bool AreBetterThan(Deviations const& other) const {
      return largest <= other.largest && squares < kLeastGain * other.squares;
    }
  };

  /// The ends of a segment.
  struct Ends {
    Point start;
    Point end;
  };

  std::size_t Behind(std::size_t k) const { return (k + 1) % pieces_.size(); }

  bool IsSegment(std::size_t k) const {
    return pieces_[k].elem.type == GeometryUtils::ElemType::Segment;
  }
  bool IsBetweenSegments(std::size_t k) const {
    return Behind(k) != k && IsSegment(k) && IsSegment(Behind(k));
  }

  Deviations DeviationsOf(std::size_t k, Ends const& ends) const {
    BuiltPiece const segment = BuildSegment(ends.start, ends.end);
    Deviations found;
    for (std::int32_t i = chain_.pieces[k].first; i < chain_.pieces[k].end; ++i) {
      double const ratio = DistanceToPiece(segment, path_.At(i)) / path_.At(i).w;
      found = found.And({ratio, ratio * ratio});
    }
    return found;
  }

  /// Those of both segments at a joint.
  Deviations DeviationsAt(std::size_t k, Point const& joint) const {
    return DeviationsOf(k, {pieces_[k].start, joint})
        .And(DeviationsOf(Behind(k), {joint, pieces_[Behind(k)].elem.end}));
  }

  /// The line of the least squares of the distances of a segment's points, each in units of its
  /// tolerance. Points near its joints, some of which may lie on the neighbour's side of the
  /// corner, are left out where two others are left. Nothing for fewer than two points or
  /// coinciding ones.
  std::optional<Line> RegressionLineOf(std::size_t k) const {
    auto const forEach = [&](auto const& isTaken, auto const& take) {
      for (std::int32_t i = chain_.pieces[k].first; i < chain_.pieces[k].end; ++i) {
        if (isTaken(path_.At(i))) take(path_.At(i));
      }
    };
    auto const isAnywhere = [](WPoint const&) { return true; };
    auto const isInside = [&](WPoint const& p) {
      return !IsNear(pieces_[k].start, p) && !IsNear(pieces_[k].elem.end, p);
    };
    std::optional<Line> const inner =
        Regression(path_.leastTolerance).FitTo([&](auto const& take) { forEach(isInside, take); });
    if (inner) return inner;
    return Regression(path_.leastTolerance).FitTo([&](auto const& take) {
      forEach(isAnywhere, take);
    });
  }

  /// The best of some places for which `deviationsAt` tells the deviations; nothing where `now` is
  /// as good.
  template <typename DeviationsAtPlace>
  static std::optional<Point> BestOf(std::vector<Point> const& places, Point const& now,
                                     DeviationsAtPlace const& deviationsAt) {
    Deviations least = deviationsAt(now);
    std::optional<Point> best;
    if (!(least.largest > kExact)) return best;
    for (Point const& place : places) {
      Deviations const here = deviationsAt(place);
      if (!here.AreBetterThan(least)) continue;
      least = here;
      best = place;
    }
    return best;
  }

  /// Moves the joint behind a piece.
  bool MoveJoint(std::size_t k) {
    std::optional<Point> const best =
        BestOf(PlacesFor(k), pieces_[k].elem.end,
               [&](Point const& place) { return DeviationsAt(k, place); });
    if (!best) return false;
    pieces_[k].elem.end = *best;
    pieces_[Behind(k)].start = *best;
    return true;
  }

  /// Moves the start of an open path.
  bool MoveStart() {
    BuiltPiece& piece = pieces_.front();
    std::optional<Point> const best = BestOf(EndsFor(0, path_.At(chain_.pieces.front().first)),
                                             piece.start, [&](Point const& place) {
                                               return DeviationsOf(0, {place, piece.elem.end});
                                             });
    if (best) piece.start = *best;
    return best.has_value();
  }

  /// The same with its end.
  bool MoveFinish() {
    BuiltPiece& piece = pieces_.back();
    std::size_t const last = pieces_.size() - 1;
    std::optional<Point> const best = BestOf(EndsFor(last, path_.At(chain_.pieces.back().end - 1)),
                                             piece.elem.end, [&](Point const& place) {
                                               return DeviationsOf(last, {piece.start, place});
                                             });
    if (best) piece.elem.end = *best;
    return best.has_value();
  }

  /// Places for the end of an open path: the outermost point, and its foot on the regression line.
  std::vector<Point> EndsFor(std::size_t k, WPoint const& outermost) const {
    Point const at{outermost.x, outermost.y};
    std::vector<Point> places{at};
    std::optional<Line> const line = RegressionLineOf(k);
    if (line) places.push_back(FootOn(*line, at));
    return places;
  }

  /// The points beside a joint that are near it, and the crossing of the lines.
  std::vector<Point> PlacesFor(std::size_t k) const {
    ChainPiece const& before = chain_.pieces[k];
    ChainPiece const& behind = chain_.pieces[Behind(k)];
    Point const& joint = pieces_[k].elem.end;
    std::vector<Point> places;
    auto const addNear = [&](std::int32_t i) {
      WPoint const& p = path_.At(i);
      if (IsNear(joint, p)) places.push_back({p.x, p.y});
    };
    if (before.first < before.end) addNear(before.end - 1);
    if (behind.first < behind.end) addNear(behind.first);
    std::optional<Line> const in = RegressionLineOf(k);
    std::optional<Line> const out = RegressionLineOf(Behind(k));
    std::optional<Point> const crossing = in && out ? CrossingOf(*in, *out) : std::nullopt;
    if (crossing) places.push_back(*crossing);
    return places;
  }

  Path const& path_;
  Chain const& chain_;
  std::vector<BuiltPiece>& pieces_;
};

}  // namespace

void SharpenCorners(Path const& path, Chain const& chain, std::vector<BuiltPiece>* pieces) {
  if (!pieces->empty()) Sharpening(path, chain, pieces).Run();
}

}  // namespace Vorn::Fewest
