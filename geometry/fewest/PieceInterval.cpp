// The offsets at which a piece can end on a gate: their least and their greatest are linear
// programmes, linearised anew wherever the last one led.

#include <algorithm>
#include <cmath>

#include "geometry/fewest/PieceSearch.h"

namespace Vorn::Fewest {

namespace {

/// Where the next gain of offset is expected to be below this share of the gate the search for the
/// extreme ends.
constexpr double kLeastMove = 1e-2;

/// Programmes after which the search for an extreme offset gives up.
constexpr int kMostExtremeRounds = 16;

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

/// How steeply a circle grows along a gate at an offset.
double SlopeAt(Circle const& circle, Gate const& gate, double offset) {
  Place const gradient = GradientAt(circle, PlaceOn(gate, offset));
  return gradient.x * gate.across.x + gradient.y * gate.across.y;
}

}  // namespace

Interval PieceSearch::FindInterval(Opening const& from, Gate const& to, PlacedCircle const& known) {
  BeginProgramme(from, to.split);
  Opening const end{to, to.least, to.greatest, false};
  AddOpening(end);
  std::int32_t const first = from.First();
  Ends const ends{&from, &end, first, to.split};
  RunFit const inner = Fit({frame_.ToLocal(known), 0.0, false}, false, ends);
  if (!inner.isFound || inner.ratio > 1.0) return {};
  bool const isBent = std::fabs(inner.circle.a) >= kStepShare * Flattest();
  if (Flattest() > 0.0 && isBent && !KeepBent(inner.circle)) return {};
  normalisation_ = programme_.conditionCount;
  if (!programme_.Add({FormRow(inner.circle), Condition::Kind::Equality, 1.0})) return {};
  Extreme const low = FindExtreme(ends, inner, true);
  Extreme const high = FindExtreme(ends, inner, false);
  if (!low.isFound || !high.isFound || low.offset > high.offset) return {};
  return {std::max(low.offset, to.least), std::min(high.offset, to.greatest), true,
          frame_.FromLocal(low.circle), frame_.FromLocal(high.circle)};
}

PieceSearch::Extreme PieceSearch::FindExtreme(Ends const& ends, RunFit const& inner, bool isLow) {
  Gate gate = ends.to->gate;
  gate.origin = frame_.ToLocal(gate.origin);
  Extreme extreme;
  RunFit at = inner;
  if (!FindCrossing(at.circle, gate, &extreme.offset)) return {};
  extreme.circle = at.circle;
  extreme.isFound = true;
  double const width = (gate.greatest - gate.least) * frame_.scale;
  double slope = SlopeAt(at.circle, gate, extreme.offset);
  for (int round = 0; round < kMostExtremeRounds; ++round) {
    programme_.conditions[static_cast<std::size_t>(normalisation_)].row = FormRow(at.circle);
    // A larger value of f beside the crossing moves the crossing down the gate.
    Row const row = ValueRow(PlaceOn(gate, extreme.offset));
    Simplex simplex(slack_);
    Simplex::Status const status =
        simplex.Maximise(programme_, isLow ? row : Negated(row), -1e300, &basis_);
    if (status != Simplex::Status::Optimal) break;
    Circle const target = simplex.Solution();
    at = StepWithin(at, target);
    double offset = 0.0;
    if (!FindCrossing(at.circle, gate, &offset)) break;
    PieceRules::Check const check = Rules().AddBroken(at.circle, ends);
    if (check == PieceRules::Check::Hopeless) break;
    if (check == PieceRules::Check::Added) {
      at = inner;
      continue;
    }
    double const moved = isLow ? extreme.offset - offset : offset - extreme.offset;
    if (moved > 0.0) {
      extreme.offset = offset;
      extreme.circle = at.circle;
    }
    // The programme took the form and the slope as they were before the move: the next move is
    // about this one times what it has changed of the two, and hardly ever larger.
    double const newSlope = SlopeAt(at.circle, gate, offset);
    double const changed =
        std::fabs(Form(target, target) - 1.0) + std::fabs(newSlope / slope - 1.0);
    if (moved * std::min(changed, 1.0) <= kLeastMove * width) break;
    slope = newSlope;
  }
  extreme.offset /= frame_.scale;
  return extreme;
}

}  // namespace Vorn::Fewest
