#include "geometry/fewest/promises/PieceChecks.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace Vorn::Promises {

namespace {

using Point = GeometryUtils::Point;

constexpr double kTurn = 2.0 * std::numbers::pi;

/// A piece may miss its joint by this share of the tolerance beside it, however large the rounding
/// of a distant centre is.
constexpr double kLargestGapToTolerance = 0.125;

/// The worst case of one promise within one piece.
struct Worst {
  double amount = 0.0;
  std::size_t number = kNone;

  void Take(double candidate, std::size_t at) {
    if (number != kNone && !(candidate > amount)) return;
    amount = candidate;
    number = at;
  }
};

/// A point of the path and where the piece passes it: a measured point or a joint.
struct Station {
  Point at;
  double w = 0.0;
  double along = 0.0;
};

double Distance(Point const& p, Point const& q) {
  double const dx = p.x - q.x;
  double const dy = p.y - q.y;
  return std::sqrt(dx * dx + dy * dy);
}

class PointChecks {
 public:
  PointChecks(Coverage const& coverage, std::size_t piece)
      : chain_(coverage.GetChain()),
        coverage_(coverage),
        piece_(piece),
        drawn_(coverage.Drawn(piece)),
        hasLimits_(drawn_.isArc && (std::isfinite(chain_.largestStep) ||
                                    std::isfinite(chain_.farthestBetweenPoints))),
        last_{drawn_.start} {}

  void Run(Report* report) {
    NumberRange const& range = coverage_.RangeOf(piece_);
    for (std::size_t number = range.first; number <= range.last; ++number) {
      WPoint const& p = coverage_.PointOf(number);
      Place const place = PlaceOf(drawn_, {p.x, p.y});
      TakeDistance(place, p, number, report);
      double const along = AlongInOrder(place, p);
      TakeOrder(along, p.w, number);
      if (hasLimits_) TakeStep({{p.x, p.y}, p.w, along}, number);
      lastAlong_ = along;
    }
    if (hasLimits_) TakeStep({drawn_.end, 0.0, drawn_.length}, range.last);
    Add(outside_, Promise::WithinTolerance, report);
    Add(back_, Promise::InOrder, report);
    Add(step_, Promise::SmallSteps, report);
    Add(bulge_, Promise::NearPath, report);
  }

 private:
  /// Exact, but only where rounding leaves it open.
  bool IsPointWithin(Place const& place, WPoint const& p) const {
    if (place.distance + place.error <= p.w) return true;
    return place.distance - place.error <= p.w && IsWithin(drawn_, p, place.beside);
  }

  void TakeDistance(Place const& place, WPoint const& p, std::size_t number, Report* report) {
    bool const isWithin = IsPointWithin(place, p);
    double const ratio = place.distance / p.w;
    if (!isWithin) outside_.Take(ratio, number);
    // Rounding may carry a point that lies exactly at its tolerance beyond it.
    double const shown = isWithin ? std::min(ratio, 1.0) : ratio;
    if (shown > report->largestRatio) {
      report->largestRatio = shown;
      report->largestIndex = coverage_.IndexOf(number);
    }
  }

  /// A point in the gap of an almost full circle, within tolerance of both ends, is where the
  /// points before it are.
  double AlongInOrder(Place const& place, WPoint const& p) const {
    if (!drawn_.isArc || Distance(drawn_.start, {p.x, p.y}) > p.w ||
        Distance(drawn_.end, {p.x, p.y}) > p.w) {
      return place.along;
    }
    return 2.0 * lastAlong_ > drawn_.length ? drawn_.length : 0.0;
  }

  /// The farthest that an earlier point reaches, less its own allowance, is compared with the
  /// point: all pairs at once.
  void TakeOrder(double along, double w, std::size_t number) {
    double const back = farthest_ - (along + kNoiseStepBack * w);
    if (back > 0.0) back_.Take(back, number);
    farthest_ = std::max(farthest_, along - kNoiseStepBack * w);
  }

  void TakeStep(Station const& next, std::size_t number) {
    double const step = std::fabs(next.along - last_.along) / drawn_.radius;
    // What computing the two angles may add.
    double const rounding = 16.0 * kUnitRoundoff * (1.0 + drawn_.sweep);
    bool const isLarge = step > chain_.largestStep + rounding;
    if (isLarge && Distance(last_.at, next.at) > last_.w + next.w) step_.Take(step, number);
    if (std::isfinite(chain_.farthestBetweenPoints)) TakeBulge(next, number);
    last_ = next;
  }

  void TakeBulge(Station const& next, std::size_t number) {
    Point const middle = PointAt(drawn_, 0.5 * (last_.along + next.along));
    double const bulge = PlaceOf(DrawSegment(last_.at, next.at), middle).distance;
    double const limit = chain_.farthestBetweenPoints + std::max(last_.w, next.w);
    if (bulge > limit) bulge_.Take(bulge, number);
  }

  void Add(Worst const& worst, Promise promise, Report* report) const {
    if (worst.number == kNone) return;
    WPoint const& p = coverage_.PointOf(worst.number);
    report->violations.push_back(
        {promise, piece_, kNone, coverage_.IndexOf(worst.number), {p.x, p.y}, worst.amount});
  }

  Chain const& chain_;
  Coverage const& coverage_;
  std::size_t piece_;
  DrawnPiece drawn_;
  bool hasLimits_;
  Station last_;
  double lastAlong_ = 0.0;
  double farthest_ = -std::numeric_limits<double>::infinity();
  Worst outside_;
  Worst back_;
  Worst step_;
  Worst bulge_;
};

/// By how much the circle of an arc misses a point that it should pass through.
double MissOf(DrawnPiece const& arc, Point const& p) {
  double const dx = p.x - arc.start.x - arc.toCentre.x;
  double const dy = p.y - arc.start.y - arc.toCentre.y;
  return std::fabs(PowerOf(arc, p)) / (std::sqrt(dx * dx + dy * dy) + arc.radius);
}

/// The length by which an angle of the arc is off the direction of the point it belongs to.
double MissOfAngle(GeometryUtils::Arc const& arc, double angle, Point const& p) {
  double const direction = std::atan2(p.y - arc.center.y, p.x - arc.center.x);
  double const off = std::fabs(direction - angle);
  return arc.radius * std::min(off, std::fabs(kTurn - off));
}

void AddAt(Point const& at, Promise promise, std::size_t piece, double amount, Report* report) {
  report->violations.push_back({promise, piece, kNone, kNone, at, amount});
}

}  // namespace

void CheckPoints(Coverage const& coverage, std::size_t piece, Report* report) {
  PointChecks(coverage, piece).Run(report);
}

void CheckArc(Coverage const& coverage, std::size_t piece, Report* report) {
  DrawnPiece const arc = coverage.Drawn(piece);
  if (!arc.isArc) return;
  GeometryUtils::Elem const& elem = coverage.ElemOf(piece);
  double const rounding = RoundingOf(arc);
  NumberRange const& range = coverage.RangeOf(piece);
  auto const checkJoint = [&](Point const& joint, double angle, double tolerance) {
    double const gap = std::max(MissOf(arc, joint), MissOfAngle(elem, angle, joint));
    double const allowed = std::min(rounding, kLargestGapToTolerance * tolerance);
    if (gap > allowed) AddAt(joint, Promise::Joined, piece, gap, report);
  };
  checkJoint(arc.start, elem.startAngle, coverage.PointOf(range.first).w);
  checkJoint(arc.end, elem.endAngle, coverage.PointOf(range.last).w);
  bool const isBack = (kTurn - arc.sweep) * arc.radius <= rounding;
  if (elem.startAngle == elem.endAngle || isBack) {
    AddAt(arc.start, Promise::BelowFullTurn, piece, isBack ? arc.sweep : kTurn, report);
  }
}

void CheckJoint(Coverage const& coverage, std::size_t piece, Report* report) {
  std::size_t const count = coverage.PieceCount();
  bool const isEnd = piece + 1 == count && !coverage.IsClosed();
  double const farthest = coverage.GetChain().farthestBetweenPoints;
  if (isEnd || count < 2 || !std::isfinite(farthest)) return;
  std::size_t const last = coverage.RangeOf(piece).last;
  WPoint const& p = coverage.PointOf(last);
  WPoint const& q = coverage.PointOf(coverage.RangeOf((piece + 1) % count).first);
  Point const& joint = coverage.GetChain().contour[piece + 1].end;
  double const off = PlaceOf(DrawSegment({p.x, p.y}, {q.x, q.y}), joint).distance;
  if (off <= farthest + p.w + q.w) return;
  report->violations.push_back(
      {Promise::NearPath, piece, kNone, coverage.IndexOf(last), {p.x, p.y}, off});
}

void CheckClosing(Coverage const& coverage, Report* report) {
  if (!coverage.IsClosed()) return;
  auto const& contour = coverage.GetChain().contour;
  Point const& begin = contour.front().end;
  Point const& end = contour.back().end;
  if (begin.x == end.x && begin.y == end.y) return;
  AddAt(end, Promise::Closed, coverage.PieceCount() - 1,
        std::hypot(end.x - begin.x, end.y - begin.y), report);
}

}  // namespace Vorn::Promises
