// An arc whose ends differ by g in their distance from a middle M, and that turns by 2 h about it,
// is to first order at the distance r + A sin(t), A = g / (2 sin h), for t from -h to h. The arc
// behind it, one lap later, is farther out by g (1 + cos(t + pi - h)), which is above 0 as long as
// 2 h is below a full turn: arcs that wind outwards by equal steps never meet.

#include "geometry/fewest/Laps.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <numbers>
#include <vector>

#include "geometry/fewest/OnePiece.h"
#include "geometry/fewest/PieceSearch.h"
#include "geometry/fewest/Turn.h"

namespace Vorn::Fewest {

namespace {

constexpr double kFullTurn = 2.0 * std::numbers::pi;

/// A turn from which on one arc is not enough: its ends would meet.
constexpr double kNearFullTurn = 6.0;

/// An arc turns by no more than this; beyond, its middle would move far out for a small step.
constexpr double kLargestTurn = 0.98 * kFullTurn;

/// The share of the room within the tolerances that all laps together wind outwards by: much more
/// than rounding, and little to see.
constexpr double kWindingShare = 1.0 / 32.0;

class Winding {
 public:
  Winding(Path const& path, PieceFit const& fit, bool isClosed)
      : path_(path), isClosed_(isClosed), circle_(fit.circle), ratio_(fit.ratio) {
    double const a = circle_.about.a;
    radius_ = 0.5 / std::fabs(a);
    // The gradient of f vanishes at the middle.
    middle_ = {circle_.origin.x - circle_.about.bx / (2.0 * a),
               circle_.origin.y - circle_.about.by / (2.0 * a)};
    sense_ = a > 0.0 ? -1.0 : 1.0;
  }

  Laps Run() {
    MeasureTurns();
    double const turn = turns_.back();
    if (!(turn > kNearFullTurn)) return {};
    count_ = static_cast<int>(std::ceil(turn / kLargestTurn));
    if (static_cast<std::size_t>(count_) > path_.points.size()) return {};
    step_ = turn / count_;
    gain_ = isClosed_ ? 0.0 : Gain();
    Laps laps;
    if (!AddArcs(&laps.chain)) return {};
    if (isClosed_) {
      Gate const seam = JointAfter(-1, 0);
      laps.start = StartAt(seam, 0.0);
      laps.finish = EndAt(seam, 0.0);
      laps.finish.gate.split = path_.Count();
    }
    return laps;
  }

 private:
  /// The turn from the first point to each other one and, of a closed path, back to the first.
  void MeasureTurns() {
    Turn turn(circle_.about);
    auto const add = [&](WPoint const& p) {
      turn.Add({p.x - circle_.origin.x, p.y - circle_.origin.y});
      turns_.push_back(turn.Angle());
    };
    turns_.reserve(path_.points.size() + 1);
    for (WPoint const& p : path_.points) add(p);
    if (isClosed_) add(path_.points.front());
  }

  /// By how much each arc winds outwards.
  double Gain() const {
    double const room = (1.0 - std::min(ratio_, 1.0)) * path_.leastTolerance;
    double const farthest = 0.5 * count_ + 0.5 / std::fabs(std::sin(0.5 * step_));
    return kWindingShare * room / farthest;
  }

  /// False where an arc would cover no points.
  bool AddArcs(Chain* chain) const {
    std::int32_t first = 0;
    for (int k = 0; k < count_; ++k) {
      std::int32_t const end = EndOf(k, first);
      if (end <= first) return false;
      chain->pieces.push_back({first, end, ArcOf(k), ratio_});
      first = end;
      if (k + 1 == count_) break;
      chain->gates.push_back(JointAfter(k, end));
      chain->offsets.push_back(0.0);
    }
    return true;
  }

  /// The first point from `first` on that lies behind arc k.
  std::int32_t EndOf(int k, std::int32_t first) const {
    if (k + 1 == count_) return path_.Count();
    auto const beyond = std::find_if(turns_.begin() + first, turns_.end() - 1,
                                     [&](double turn) { return turn >= (k + 1) * step_; });
    return static_cast<std::int32_t>(beyond - turns_.begin());
  }

  /// The direction from the middle at a number of arcs from the start.
  Place DirectionAt(double arcs) const {
    WPoint const& start = path_.points.front();
    double const angle =
        std::atan2(start.y - middle_.y, start.x - middle_.x) + sense_ * arcs * step_;
    return {std::cos(angle), std::sin(angle)};
  }

  /// The distance from the middle there.
  double DistanceAt(double arcs) const { return radius_ + gain_ * (arcs - 0.5 * count_); }

  PlacedCircle ArcOf(int k) const {
    double const arcs = k + 0.5;
    double const shift = 0.5 * gain_ / std::sin(0.5 * step_);
    Place const apex = DirectionAt(arcs);
    // A quarter turn ahead of the middle of the arc.
    Place const ahead{-sense_ * apex.y, sense_ * apex.x};
    Place const centre{middle_.x + shift * ahead.x, middle_.y + shift * ahead.y};
    double const r = DistanceAt(arcs);
    return {{-0.5 * sense_ / r, 0.0, 0.0, 0.5 * sense_ * r}, centre};
  }

  Gate JointAfter(int k, std::int32_t split) const {
    Place const outwards = DirectionAt(k + 1.0);
    double const distance = DistanceAt(k + 1.0);
    Gate gate;
    gate.split = split;
    gate.origin = {middle_.x + distance * outwards.x, middle_.y + distance * outwards.y};
    gate.across = {-sense_ * outwards.x, -sense_ * outwards.y};
    return gate;
  }

  Path const& path_;
  bool isClosed_;
  PlacedCircle circle_;
  double ratio_;
  Place middle_;
  double radius_ = 0.0;
  double sense_ = 1.0;  ///< 1 counter-clockwise, -1 clockwise
  std::vector<double> turns_;
  int count_ = 0;
  double step_ = 0.0;  ///< the turn of one arc
  double gain_ = 0.0;
};

}  // namespace

Laps WindLaps(Path const& path, PlacedCircle const& covering, bool isClosed) {
  constexpr double kWholeShare = 1.0;
  PlacedCircle const along = AlongPath(path, covering);
  if (along.about.a == 0.0) return {};
  PieceSearch search(path, kWholeShare);
  search.MoveTo(0, path.Count());
  PieceFit const known{along, 1.0, true};
  PieceFit const best = search.FitAlone(0, path.Count(), known);
  bool const isBetter = best.isFound && best.ratio <= 1.0 && best.circle.about.a != 0.0;
  return Winding(path, isBetter ? best : known, isClosed).Run();
}

}  // namespace Vorn::Fewest
