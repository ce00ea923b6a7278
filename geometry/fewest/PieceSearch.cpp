#include "geometry/fewest/PieceSearch.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>

#include "geometry/fewest/Growth.h"

namespace Vorn::Fewest {

namespace {

Row Negated(Row const& r) { return {-r.a, -r.bx, -r.by, -r.d}; }

/// The row of the advance of a circle along a step from a place: the unit direction of travel times
/// the step, which is negative where the circle runs against it.
Row AdvanceRow(Place const& p, double dx, double dy) {
  return {2.0 * (p.y * dx - p.x * dy), -dy, dx, 0.0};
}

Circle LineThrough(Place const& p, Place const& q) {
  double const dx = q.x - p.x;
  double const dy = q.y - p.y;
  double const length = std::sqrt(dx * dx + dy * dy);
  if (!(length > 0.0)) return {0.0, 0.0, 1.0, -p.y};
  Circle line{0.0, -dy / length, dx / length, 0.0};
  line.d = -(line.bx * p.x + line.by * p.y);
  return line;
}

Place PlaceOf(Sample const& s) { return {s.x, s.y}; }

/// Box of a programme without a limit of curvature.
constexpr double kDefaultBox = 1024.0;

/// Stands for no limit of curvature.
constexpr double kUnlimited = 1e300;

/// Size of the box in units of 1 + the limit of curvature. On a normalised circle the gradient has
/// length 1, so at a place p on it |b| <= 1 + 2 |a| |p| and |d| <= |p| + 3 |a| |p|^2: this holds
/// those that pass within 1.6 of the origin, and local coordinates are of the order of 1.
constexpr double kBoxPerCurvature = 8.0;

/// A step back along the path that is shorter than this many times the sum of the tolerances of its
/// points counts as noise: each point may be off by its tolerance in any direction, which accounts
/// for 1, and neighbours of a reversal add the rest.
constexpr double kNoiseStep = 1.65;

/// A turn in radians below which a piece need not be looked at for a full one. Steps are at most 60
/// degrees, whose sine is 0.83 of their angle.
constexpr double kTurnToCount = 4.5;

/// Share of the greatest step that the search allows, for the rounding of what is measured.
constexpr double kStepShare = 1.0 - 1e-6;

/// Share of a tolerance by which rounding may break a row.
constexpr double kRoundingRoom = 1e-6;

/// A gate this flat to a piece has no offset for a place along it.
constexpr double kLeastSlope = 1e-3;

/// A gain of offset below this share of the gate ends the search for the extreme.
constexpr double kLeastMove = 1e-2;

/// From a circle that meets the rows with a ratio towards one within the rows on which Form(c, .)
/// is 1: as far as the circle, normalised, stays within the rows.
RunFit StepWithin(RunFit const& from, Circle const& to) {
  Circle const along{to.a - from.circle.a, to.bx - from.circle.bx, to.by - from.circle.by,
                     to.d - from.circle.d};
  // On the way the rows are at most ratio + share (1 - ratio) and the form is 1 + share^2 q.
  double const q = Form(along, along);
  double const r = from.ratio < 1.0 ? from.ratio : 1.0;
  double const square = (1.0 - r) * (1.0 - r) - q;
  double const half = r * (1.0 - r);
  double const rest = r * r - 1.0;
  double share = 1.0;
  if (square + 2.0 * half + rest > 0.0) {
    share = square > 0.0 ? (std::sqrt(half * half - square * rest) - half) / square : 0.0;
    share = share < 1.0 ? share : 1.0;
  }
  Circle const reached = Between(from.circle, to, share);
  double const form = Form(reached, reached);
  if (!(form > 0.0)) return from;
  double const norm = 1.0 / std::sqrt(form);
  return {Scaled(reached, norm), (r + share * (1.0 - r)) * norm, true};
}

/// How many points at either end of a piece may lie beyond its joint.
constexpr std::int32_t kPointsNearJoint = 4;

/// Runs up to this length are searched from several starts.
constexpr std::int32_t kShortRun = 4;

/// From this length on a run has one optimum, so that the circle of a rival is a good start.
constexpr std::int32_t kShortestForRival = 16;

/// Programmes after which the search for an extreme offset gives up.
constexpr int kMostExtremeRounds = 16;

}  // namespace

bool FindCrossing(Circle const& circle, Gate const& gate, double* offset) {
  double const f = ValueAt(circle, gate.origin);
  Place const gradient = GradientAt(circle, gate.origin);
  double const slope = gradient.x * gate.across.x + gradient.y * gate.across.y;
  double const discriminant = slope * slope - 4.0 * circle.a * f;
  if (!(discriminant >= 0.0)) return false;
  // Of the two crossings the one where f grows; the other is on the far side of the circle.
  double const root = std::sqrt(discriminant);
  if (slope > 0.0) {
    *offset = -2.0 * f / (slope + root);
    return true;
  }
  if (circle.a == 0.0) return false;
  *offset = (root - slope) / (2.0 * circle.a);
  return true;
}

void PieceSearch::SetShare(double share) {
  share_ = share;
  columns_.Clear();
}

Circle PieceSearch::ToLocal(Circle const& circle) const {
  return frame_.Convert(LocalFrame(), circle);
}

Circle PieceSearch::FromLocal(Circle const& circle) const {
  return LocalFrame().Convert(frame_, circle);
}

void PieceSearch::MoveTo(std::int32_t first, std::int32_t last) {
  columns_.Clear();
  columnsFirst_ = first;
  WPoint const& origin = path_.At(first);
  frame_.originX = origin.x;
  frame_.originY = origin.y;
  frame_.scale = ScaleOf(ExtentOf(
      std::span(path_.points)
          .subspan(static_cast<std::size_t>(first), static_cast<std::size_t>(last - first))));
  slack_ = SlackFor(1.0 / (frame_.scale * path_.leastTolerance));
}

void PieceSearch::Cover(std::int32_t first, std::int32_t last) {
  if (first < columnsFirst_ || first > columnsFirst_ + columns_.Size()) MoveTo(first, last);
  for (std::int32_t i = columnsFirst_ + columns_.Size(); i < last; ++i) {
    Sample sample = frame_.ToLocal(path_.At(i));
    sample.w *= share_;
    columns_.Append(sample);
  }
}

void PieceSearch::AddOpening(Opening const& opening) {
  if (opening.isFree) return;
  Place const low = frame_.ToLocal(PlaceOn(opening.gate, opening.low));
  if (opening.low == opening.high) {
    programme_.Add({ValueRow(low), Condition::Kind::Equality, 0.0});
    return;
  }
  Place const high = frame_.ToLocal(PlaceOn(opening.gate, opening.high));
  programme_.Add({ValueRow(low), Condition::Kind::HalfSpace, 0.0});
  programme_.Add({Negated(ValueRow(high)), Condition::Kind::HalfSpace, 0.0});
}

void PieceSearch::LimitCurvature(Opening const& from, std::int32_t end) {
  std::int32_t const first = from.isFree ? 0 : from.gate.split;
  double widest = 0.0;
  for (std::int32_t i = first + 1; i < end; ++i) {
    widest = std::max(widest, DistanceBetween(path_.At(i - 1), path_.At(i)));
  }
  double limit = kUnlimited;
  // The chord of a step of angle s on a radius r is 2 r sin(s / 2), and |a| = 1 / (2 r).
  if (widest > 0.0) limit = kStepShare * path_.limits.sineOfHalfStep / widest;
  if (path_.limits.smallestRadius > 0.0) limit = std::min(limit, 0.5 / path_.limits.smallestRadius);
  Row const row{1.0, 0.0, 0.0, 0.0};
  if (path_.limits.segmentsOnly) {
    programme_.Add({row, Condition::Kind::Equality, 0.0});
  } else if (limit < kUnlimited) {
    programme_.Add({row, Condition::Kind::Slab, limit / frame_.scale});
    programme_.box = kBoxPerCurvature * (1.0 + limit / frame_.scale);
  }
}

void PieceSearch::BeginProgramme(Opening const& from, std::int32_t end) {
  std::int32_t const first = from.isFree ? 0 : from.gate.split;
  Cover(first, end);
  programme_.columns = &columns_;
  programme_.first = first - columnsFirst_;
  programme_.last = end - columnsFirst_;
  programme_.conditionCount = 0;
  programme_.box = kDefaultBox;
  LimitCurvature(from, end);
  AddOpening(from);
}

PieceSearch::Check PieceSearch::AddBrokenOrder(Circle const& circle, Ends const& ends) {
  double worst = 0.0;
  double length = 0.0;
  Condition broken;
  for (std::int32_t i = ends.first + 1; i < ends.end; ++i) {
    Sample const p = frame_.ToLocal(path_.At(i - 1));
    Sample const q = frame_.ToLocal(path_.At(i));
    Row const row = AdvanceRow(PlaceOf(p), q.x - p.x, q.y - p.y);
    double const room = kNoiseStep * (p.w + q.w);
    double const advance = Apply(row, circle);
    length += advance;
    double const excess = -advance - room * (1.0 + kRoundingRoom);
    if (excess > worst) {
      worst = excess;
      broken = {Negated(row), Condition::Kind::HalfSpace, room};
    }
    double const gap2 = (q.x - p.x) * (q.x - p.x) + (q.y - p.y) * (q.y - p.y);
    Check const step = AddBrokenStep(circle, gap2, p, PlaceOf(q));
    if (step != Check::Holds) return step;
  }
  // An advance is the radius times the sine of a step, so this is the turn or less.
  if (2.0 * std::fabs(circle.a) * length > kTurnToCount && IsFullTurn(circle, ends)) {
    return Check::Hopeless;
  }
  if (!(worst > 0.0)) return Check::Holds;
  return programme_.Add(broken) ? Check::Added : Check::Hopeless;
}

PieceSearch::Check PieceSearch::AddBrokenStep(Circle const& circle, double gap2, Sample const& p,
                                              Place const& q) {
  double const limit = kStepShare * path_.limits.sineOfHalfStep;
  // The feet of two points on the circle are as far apart as the points, divided by the distance of
  // the nearer one from the centre in radii.
  Place const here = GradientAt(circle, PlaceOf(p));
  Place const there = GradientAt(circle, q);
  double const near2 =
      std::min(here.x * here.x + here.y * here.y, there.x * there.x + there.y * there.y);
  if (circle.a * circle.a * gap2 <= limit * limit * near2 || gap2 <= p.w * p.w) {
    return Check::Holds;
  }
  double const most = limit * std::sqrt(near2 / gap2);
  if (!(most > 0.0)) return Check::Hopeless;
  Condition const condition{{1.0, 0.0, 0.0, 0.0}, Condition::Kind::Slab, most};
  return programme_.Add(condition) ? Check::Added : Check::Hopeless;
}

bool PieceSearch::IsFullTurn(Circle const& circle, Ends const& ends) const {
  double turn = 0.0;
  Place before;
  auto const add = [&](Place const& p, bool isFirst) {
    Place const radial = GradientAt(circle, p);
    double const cross = before.x * radial.y - before.y * radial.x;
    if (!isFirst) turn += std::atan2(cross, before.x * radial.x + before.y * radial.y);
    before = radial;
  };
  if (!ends.from->isFree) add(frame_.ToLocal(ends.from->gate.origin), true);
  for (std::int32_t i = ends.first; i < ends.end; ++i) {
    add(PlaceOf(frame_.ToLocal(path_.At(i))), ends.from->isFree && i == ends.first);
  }
  if (ends.to != nullptr && !ends.to->isFree) add(frame_.ToLocal(ends.to->gate.origin), false);
  // Both ends of an open path may be drawn back within the tolerances of its ends.
  bool const isWhole = ends.from->isFree && ends.end == path_.Count();
  double const w = share_ * std::min(path_.At(ends.first).w, path_.At(ends.end - 1).w);
  double const room = (isWhole ? 0.5 : -4.0) * w * frame_.scale * 2.0 * std::fabs(circle.a);
  return std::fabs(turn) > 2.0 * std::numbers::pi + room;
}

PieceSearch::Check PieceSearch::AddBrokenJoint(Circle const& circle, Opening const& opening,
                                               std::int32_t point) {
  Sample const sample = frame_.ToLocal(path_.At(point));
  Place const p = PlaceOf(sample);
  Gate gate = opening.gate;
  gate.origin = frame_.ToLocal(gate.origin);
  double const sense = point >= gate.split ? 1.0 : -1.0;
  bool const isFixed = opening.low == opening.high;
  double offset = opening.low * frame_.scale;
  if (!isFixed && !FindCrossing(circle, gate, &offset)) return Check::Hopeless;
  Place const joint = PlaceOn(gate, offset);
  double const dx = p.x - joint.x;
  double const dy = p.y - joint.y;
  double const room = share_ * sample.w;
  double const gap2 = dx * dx + dy * dy;
  if (point == (sense > 0.0 ? gate.split : gate.split - 1)) {
    Check const step = AddBrokenStep(circle, gap2, sample, p);
    if (step != Check::Holds) return step;
  }
  // From a quarter turn on the direction at the point says nothing about its order.
  if (2.0 * circle.a * circle.a * gap2 > 1.0) return Check::Holds;
  Row const advance = AdvanceRow(p, sense * dx, sense * dy);
  if (Apply(advance, circle) >= -kRoundingRoom * sample.w ||
      gap2 <= room * room * (1.0 + kRoundingRoom)) {
    return Check::Holds;
  }
  if (isFixed) {
    Condition const condition{Negated(advance), Condition::Kind::HalfSpace, 0.0};
    return programme_.Add(condition) ? Check::Added : Check::Hopeless;
  }
  // The offsets for which the point lies beside the piece end at a limit; those within tolerance of
  // the point may go beyond.
  Place const normal = GradientAt(circle, p);
  double const fromOriginX = p.x - gate.origin.x;
  double const fromOriginY = p.y - gate.origin.y;
  double const slope = normal.y * gate.across.x - normal.x * gate.across.y;
  double const foot = fromOriginX * gate.across.x + fromOriginY * gate.across.y;
  double const apart = fromOriginX * gate.across.y - fromOriginY * gate.across.x;
  double const reach = room * room - apart * apart;
  double const half = reach > 0.0 ? std::sqrt(reach) : -1.0;
  bool const hasLimit = std::fabs(slope) > kLeastSlope;
  double limit = hasLimit ? (normal.y * fromOriginX - normal.x * fromOriginY) / slope : foot;
  bool const isUpper = offset > limit;
  if (std::fabs(limit - foot) <= half) {
    limit = isUpper ? foot + half : foot - half;
  } else if (!hasLimit) {
    return Check::Hopeless;
  }
  Row const value = ValueRow(PlaceOn(gate, limit));
  Condition const condition{isUpper ? Negated(value) : value, Condition::Kind::HalfSpace, 0.0};
  return programme_.Add(condition) ? Check::Added : Check::Hopeless;
}

PieceSearch::Check PieceSearch::AddBroken(Circle const& circle, Ends const& ends) {
  Check const order = AddBrokenOrder(circle, ends);
  if (order != Check::Holds || ends.first >= ends.end) return order;
  if (!ends.from->isFree) {
    std::int32_t const last =
        std::min(ends.end, ends.first + kPointsNearJoint * StrideFrom(path_, ends.first));
    for (std::int32_t i = ends.first; i < last; ++i) {
      Check const start = AddBrokenJoint(circle, *ends.from, i);
      if (start != Check::Holds) return start;
    }
  }
  if (ends.to == nullptr || ends.to->isFree) return Check::Holds;
  std::int32_t const stride = StrideFrom(path_, std::max(ends.first, ends.end - kPointsNearJoint));
  std::int32_t const last = std::max(ends.first, ends.end - kPointsNearJoint * stride);
  for (std::int32_t i = ends.end; i-- > last;) {
    Check const end = AddBrokenJoint(circle, *ends.to, i);
    if (end != Check::Holds) return end;
  }
  return Check::Holds;
}

RunFit PieceSearch::Fit(RunFit const& start, bool isTest, Ends const& ends) {
  Simplex simplex(slack_);
  RunFit at = start;
  RunFit fit;
  while (true) {
    fit = FitRun(programme_, at, isTest, &simplex, &basis_);
    if (!fit.isFound || (isTest && fit.ratio > 1.0)) break;
    Check const check = AddBroken(fit.circle, ends);
    if (check == Check::Holds) break;
    at = {fit.circle, 0.0, false};
    fit = {};
    if (check == Check::Hopeless) break;
  }
  // Conditions that were added for a better piece may shut out the one that was known.
  bool const isWorse = start.isFound && (!fit.isFound || fit.ratio > start.ratio);
  if (isWorse && AddBroken(start.circle, ends) == Check::Holds) return start;
  return fit;
}

RunFit PieceSearch::FirstFit(Opening const& from, std::int32_t end) {
  std::int32_t const first = from.isFree ? 0 : from.gate.split;
  BeginProgramme(from, end);
  int const conditions = programme_.conditionCount;
  Place const start = from.isFree
                          ? PlaceOf(frame_.ToLocal(path_.At(first)))
                          : frame_.ToLocal(PlaceOn(from.gate, 0.5 * (from.low + from.high)));
  std::int32_t const stride = StrideFrom(path_, first);
  RunFit best;
  for (std::int32_t ahead = 1; ahead <= 8; ahead *= 2) {
    std::int32_t const target = std::min(first + ahead * stride, end) - (from.isFree ? 0 : 1);
    if (target >= end) break;
    programme_.conditionCount = conditions;
    basis_ = Basis();
    RunFit const fit =
        Fit({LineThrough(start, PlaceOf(frame_.ToLocal(path_.At(target)))), 0.0, false}, true,
            {&from, nullptr, first, end});
    if (fit.isFound && (!best.isFound || fit.ratio < best.ratio)) best = fit;
    if (best.isFound && best.ratio <= 1.0) break;
  }
  return best;
}

Reach PieceSearch::FindFirstReach(Opening const& from) {
  std::int32_t const first = from.isFree ? 0 : from.gate.split;
  std::int32_t const stride = StrideFrom(path_, first);
  std::int32_t const longest = std::min(first + kShortRun * stride, path_.Count());
  // Short runs have several local optima: they are begun anew from several chords.
  for (std::int32_t end = longest; end > first; end = std::min(end - 1, end - stride / 4)) {
    RunFit const fit = FirstFit(from, end);
    if (fit.isFound && fit.ratio <= 1.0) return {end, fit.circle, end == longest};
  }
  return {first, Circle(), false};
}

Reach PieceSearch::FindReach(Opening const& from, std::int32_t expected) {
  Reach reach = FindFirstReach(from);
  if (reach.canGrow) Grow(from, expected, &reach);
  reach.circle = FromLocal(reach.circle);
  return reach;
}

Reach PieceSearch::FindReachBeyond(Opening const& from, Reach const& rival) {
  std::int32_t const first = from.isFree ? 0 : from.gate.split;
  if (rival.end - first < kShortestForRival * StrideFrom(path_, first)) {
    return FindReach(from, rival.end);
  }
  BeginProgramme(from, rival.end);
  Ends const ends{&from, nullptr, first, rival.end};
  RunFit const fit = Fit({ToLocal(rival.circle), 0.0, false}, true, ends);
  if (!fit.isFound || fit.ratio > 1.0) return {rival.end - 1, rival.circle, false};
  Reach reach{rival.end, fit.circle, true};
  Grow(from, rival.end + 1, &reach);
  reach.circle = FromLocal(reach.circle);
  return reach;
}

void PieceSearch::Grow(Opening const& from, std::int32_t expected, Reach* reach) {
  std::int32_t const first = from.isFree ? 0 : from.gate.split;
  std::int32_t const count = path_.Count();
  std::int32_t bad = count + 1;
  std::int32_t target = std::max(reach->end + 1, expected);
  std::int32_t step = std::max(1, (reach->end - first) / 8);
  while (reach->end < count && bad > reach->end + 1) {
    target = std::clamp(target, reach->end + 1, std::min(bad - 1, count));
    BeginProgramme(from, target);
    Basis const kept = basis_;
    RunFit const fit = Fit({reach->circle, 0.0, false}, true, {&from, nullptr, first, target});
    if (fit.isFound && fit.ratio <= 1.0) {
      reach->end = target;
      reach->circle = fit.circle;
      step *= 2;
    } else {
      basis_ = kept;
      bad = target;
    }
    target = bad <= count ? reach->end + (bad - reach->end) / 2 : reach->end + step;
  }
}

Interval PieceSearch::FindInterval(Opening const& from, Gate const& to, Circle const& known) {
  BeginProgramme(from, to.split);
  Opening const end{to, to.least, to.greatest, false};
  AddOpening(end);
  std::int32_t const first = from.isFree ? 0 : from.gate.split;
  Ends const ends{&from, &end, first, to.split};
  RunFit const inner = Fit({ToLocal(known), 0.0, false}, false, ends);
  if (!inner.isFound || inner.ratio > 1.0) return {};
  normalisation_ = programme_.conditionCount;
  if (!programme_.Add({FormRow(inner.circle), Condition::Kind::Equality, 1.0})) return {};
  Extreme const low = FindExtreme(ends, inner, true);
  Extreme const high = FindExtreme(ends, inner, false);
  if (!low.isFound || !high.isFound || low.offset > high.offset) return {};
  return {std::max(low.offset, to.least), std::min(high.offset, to.greatest), true,
          FromLocal(low.circle), FromLocal(high.circle)};
}

PieceSearch::Extreme PieceSearch::FindExtreme(Ends const& ends, RunFit const& inner, bool isLow) {
  Gate gate = ends.to->gate;
  gate.origin = frame_.ToLocal(gate.origin);
  Extreme extreme;
  RunFit at = inner;
  if (!FindCrossing(at.circle, gate, &extreme.offset)) return {};
  extreme.circle = at.circle;
  extreme.isFound = true;
  for (int round = 0; round < kMostExtremeRounds; ++round) {
    programme_.conditions[static_cast<std::size_t>(normalisation_)].row = FormRow(at.circle);
    // A larger value of f beside the crossing moves the crossing down the gate.
    Row const row = ValueRow(PlaceOn(gate, extreme.offset));
    Simplex simplex(slack_);
    Simplex::Status const status =
        simplex.Maximise(programme_, isLow ? row : Negated(row), -1e300, &basis_);
    if (status != Simplex::Status::Optimal) break;
    at = StepWithin(at, simplex.Solution());
    double offset = 0.0;
    if (!FindCrossing(at.circle, gate, &offset)) break;
    Check const check = AddBroken(at.circle, ends);
    if (check == Check::Hopeless) break;
    if (check == Check::Added) {
      at = inner;
      continue;
    }
    double const moved = isLow ? extreme.offset - offset : offset - extreme.offset;
    if (moved > 0.0) {
      extreme.offset = offset;
      extreme.circle = at.circle;
    }
    if (moved <= kLeastMove * (gate.greatest - gate.least) * frame_.scale) break;
  }
  extreme.offset /= frame_.scale;
  return extreme;
}

RunFit PieceSearch::FindBest(Opening const& from, Opening const& to, RunFit const& start) {
  std::int32_t const first = from.isFree ? 0 : from.gate.split;
  std::int32_t const end = to.isFree ? path_.Count() : to.gate.split;
  BeginProgramme(from, end);
  AddOpening(to);
  RunFit fit =
      Fit({ToLocal(start.circle), start.ratio, start.isFound}, false, {&from, &to, first, end});
  if (fit.isFound) fit.circle = FromLocal(fit.circle);
  return fit;
}

RunFit PieceSearch::FitAlone(std::int32_t first, std::int32_t last) {
  Cover(first, last);
  programme_.columns = &columns_;
  programme_.first = first - columnsFirst_;
  programme_.last = last - columnsFirst_;
  programme_.conditionCount = 0;
  Simplex simplex(slack_);
  Basis basis;
  RunFit fit = FitRun(programme_,
                      {LineThrough(PlaceOf(frame_.ToLocal(path_.At(first))),
                                   PlaceOf(frame_.ToLocal(path_.At(last - 1)))),
                       0.0, false},
                      false, &simplex, &basis);
  if (fit.isFound) fit.circle = FromLocal(fit.circle);
  return fit;
}

}  // namespace Vorn::Fewest
