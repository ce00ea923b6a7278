#include "geometry/fewest/PieceSearch.h"

#include <algorithm>
#include <cmath>

#include "geometry/fewest/BareRun.h"
#include "geometry/fewest/Growth.h"

namespace Vorn::Fewest {

namespace {

/// Box of a programme without a limit of curvature.
constexpr double kDefaultBox = 1024.0;

/// Stands for no limit of curvature.
constexpr double kUnlimited = 1e300;

/// Size of the box in units of 1 + the limit of curvature. On a normalised circle the gradient has
/// length 1, so at a place p on it |b| <= 1 + 2 |a| |p| and |d| <= |p| + 3 |a| |p|^2: this holds
/// those that pass within 1.6 of the origin, and local coordinates are of the order of 1.
constexpr double kBoxPerCurvature = 8.0;

/// Share of a tolerance that is left to the rounding of what is measured.
constexpr double kRoundingRoom = 1e-6;

/// Linearisations after which the search for an arc of the largest radius ends.
constexpr int kMostBendings = 4;

/// Runs up to this length are searched from several starts.
constexpr std::int32_t kShortRun = 4;

/// From this length on a run has one optimum, so that the circle of a rival is a good start.
constexpr std::int32_t kShortestForRival = 16;

}  // namespace

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
  std::int32_t const rows = RowsPerPoint();
  auto const covered = [&] { return columnsFirst_ + (columns_.Size() + rows - 1) / rows; };
  if (first < columnsFirst_ || first > covered()) MoveTo(first, last);
  for (std::int32_t i = covered(); i < last; ++i) {
    if (rows > 1 && i > columnsFirst_) columns_.Append(MiddleOf(path_.At(i - 1), path_.At(i)));
    Sample sample = frame_.ToLocal(path_.At(i));
    sample.w *= share_;
    columns_.Append(sample);
  }
}

Sample PieceSearch::MiddleOf(WPoint const& p, WPoint const& q) const {
  double const room = path_.limits.farthestBetweenPoints + share_ * std::max(p.w, q.w);
  return frame_.ToLocal(WPoint{0.5 * (p.x + q.x), 0.5 * (p.y + q.y), room * (1.0 - kRoundingRoom)});
}

void PieceSearch::UseRows(std::int32_t first, std::int32_t last) {
  Cover(first, last);
  std::int32_t const rows = RowsPerPoint();
  programme_.columns = &columns_;
  programme_.first = rows * (first - columnsFirst_);
  programme_.last = rows * (last - 1 - columnsFirst_) + 1;
  programme_.conditionCount = 0;
}

void PieceSearch::AddOpening(Opening const& opening) {
  if (opening.isFree) return;
  // In units of the least tolerance, as the rows of the points are in units of theirs: the slack of
  // the programme is a share of these units.
  double const weight = 1.0 / (path_.leastTolerance * frame_.scale);
  Row const low = Weighted(ValueRow(frame_.ToLocal(PlaceOn(opening.gate, opening.low))), weight);
  if (opening.low == opening.high) {
    programme_.Add({low, Condition::Kind::Equality, 0.0});
    return;
  }
  Row const high = Weighted(ValueRow(frame_.ToLocal(PlaceOn(opening.gate, opening.high))), weight);
  programme_.Add({low, Condition::Kind::HalfSpace, 0.0});
  programme_.Add({Negated(high), Condition::Kind::HalfSpace, 0.0});
}

void PieceSearch::LimitCurvature(Opening const& from, std::int32_t end) {
  std::int32_t const first = from.First();
  double const widest = std::sqrt(spacing_.WidestGap2(first, end));
  double limit = kUnlimited;
  // The chord of a step of angle s on a radius r is 2 r sin(s / 2), and |a| = 1 / (2 r).
  if (widest > 0.0) limit = kStepShare * path_.limits.sineOfHalfStep / widest;
  double const least =
      std::max(path_.limits.smallestRadius, LeastRadiusOfBareRun(path_, first, end));
  if (least > 0.0) limit = std::min(limit, 0.5 / least);
  Row const row{1.0, 0.0, 0.0, 0.0};
  if (path_.limits.segmentsOnly) {
    programme_.Add({row, Condition::Kind::Equality, 0.0});
  } else if (limit < kUnlimited) {
    programme_.Add({row, Condition::Kind::Slab, limit / frame_.scale});
    programme_.box = kBoxPerCurvature * (1.0 + limit / frame_.scale);
  }
}

void PieceSearch::BeginProgramme(Opening const& from, std::int32_t end) {
  std::int32_t const first = from.First();
  UseRows(first, end);
  programme_.box = kDefaultBox;
  LimitCurvature(from, end);
  AddOpening(from);
}

RunFit PieceSearch::Fit(RunFit const& start, bool isTest, Ends const& ends) {
  RunFit const fit = FitAnyRadius(start, isTest, ends);
  if (!fit.isFound || path_.limits.segmentsOnly || !(std::fabs(fit.circle.a) < Flattest())) {
    return fit;
  }
  int const conditions = programme_.conditionCount;
  RunFit const any{fit.circle, 0.0, false};
  if (programme_.Add({{1.0, 0.0, 0.0, 0.0}, Condition::Kind::Equality, 0.0})) {
    RunFit const straight = FitAnyRadius(any, isTest, ends);
    if (straight.isFound && straight.ratio <= 1.0) return straight;
  }
  RunFit bent = any;
  for (int round = 0; round < kMostBendings; ++round) {
    programme_.conditionCount = conditions;
    if (!KeepBent(bent.circle)) return {};
    bent = FitAnyRadius({bent.circle, 0.0, false}, isTest, ends);
    if (!bent.isFound || bent.ratio > 1.0) return bent;
    if (std::fabs(bent.circle.a) >= kStepShare * Flattest()) return bent;
  }
  return {};
}

double PieceSearch::Flattest() const {
  // A circle has |a| = 1 / (2 r).
  return 0.5 / (path_.limits.largestRadius * frame_.scale) / kStepShare;
}

bool PieceSearch::KeepBent(Circle const& circle) {
  // |a| of the normalised circle v is |a of v| / Form(circle, v), but for a square of the change.
  Row const form = FormRow(circle);
  double const least = Flattest();
  double const sign = circle.a > 0.0 ? -1.0 : 1.0;
  Row const row{least * form.a + sign, least * form.bx, least * form.by, least * form.d};
  return programme_.Add({row, Condition::Kind::HalfSpace, 0.0});
}

RunFit PieceSearch::FitAnyRadius(RunFit const& start, bool isTest, Ends const& ends) {
  Simplex simplex(slack_);
  RunFit at = start;
  RunFit fit;
  while (true) {
    fit = FitRun(programme_, at, isTest, &simplex, &basis_);
    if (!fit.isFound || (isTest && fit.ratio > 1.0)) break;
    PieceRules::Check const check = Rules().AddBroken(fit.circle, ends);
    if (check == PieceRules::Check::Holds) break;
    at = {fit.circle, 0.0, false};
    fit = {};
    if (check == PieceRules::Check::Hopeless) break;
  }
  // Conditions that were added for a better piece may shut out the one that was known.
  bool const isWorse = start.isFound && (!fit.isFound || fit.ratio > start.ratio);
  if (isWorse && Rules().AddBroken(start.circle, ends) == PieceRules::Check::Holds) return start;
  return fit;
}

RunFit PieceSearch::FirstFit(Opening const& from, std::int32_t end) {
  std::int32_t const first = from.First();
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

PieceSearch::LocalReach PieceSearch::FindFirstReach(Opening const& from) {
  std::int32_t const first = from.First();
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
  LocalReach reach = FindFirstReach(from);
  if (reach.canGrow) Grow(from, expected, &reach);
  return {reach.end, frame_.FromLocal(reach.circle)};
}

Reach PieceSearch::FindReachBeyond(Opening const& from, Reach const& rival) {
  std::int32_t const first = from.First();
  if (rival.end - first < kShortestForRival * StrideFrom(path_, first)) {
    return FindReach(from, rival.end);
  }
  BeginProgramme(from, rival.end);
  Ends const ends{&from, nullptr, first, rival.end};
  RunFit const fit = Fit({frame_.ToLocal(rival.circle), 0.0, false}, true, ends);
  if (!fit.isFound || fit.ratio > 1.0) return {rival.end - 1, rival.circle};
  LocalReach reach{rival.end, fit.circle, true};
  Grow(from, rival.end + 1, &reach);
  return {reach.end, frame_.FromLocal(reach.circle)};
}

void PieceSearch::Grow(Opening const& from, std::int32_t expected, LocalReach* reach) {
  std::int32_t const first = from.First();
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

PieceFit PieceSearch::FindBest(Opening const& from, Opening const& to, PieceFit const& start) {
  std::int32_t const end = to.isFree ? path_.Count() : to.gate.split;
  BeginProgramme(from, end);
  AddOpening(to);
  return FitFrom(start, {&from, &to, from.First(), end});
}

PieceFit PieceSearch::FindBestUpTo(Opening const& from, std::int32_t end, PieceFit const& start) {
  BeginProgramme(from, end);
  return FitFrom(start, {&from, nullptr, from.First(), end});
}

PieceFit PieceSearch::FitFrom(PieceFit const& start, Ends const& ends) {
  return FromLocal(Fit({frame_.ToLocal(start.circle), start.ratio, start.isFound}, false, ends));
}

}  // namespace Vorn::Fewest
