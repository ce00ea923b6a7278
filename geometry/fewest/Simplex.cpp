// Notation: the basis holds four rows r_j with limits l_j; the solution v has r_j v = l_j, and the
// columns of the inverse are the circles c_j with r_i c_j = [i = j]. The objective is the sum of
// duals_j r_j. A row of two sides may take either sign, so every basis of such rows is dual
// feasible after its signs are chosen: this is why any basis can be a start.

#include "geometry/fewest/Simplex.h"

#include <cmath>

namespace Vorn::Fewest {

namespace {

/// More pivots than this are never needed but where rounding sends the search in circles.
constexpr int kMostPivots = 80;

/// After so many exchanges the inverse is computed anew.
constexpr int kExchangesBeforeInversion = 12;

/// A pivot smaller than this share of the largest would spoil the inverse.
constexpr double kLeastPivotShare = 1e-11;

/// A row of the basis that is missed by more than this share of the slack tells that the inverse
/// has lost too many digits.
constexpr double kResidualShare = 0.1;

/// Rounding may break the rows of a basis by this much where they are badly conditioned: well below
/// what the search leaves of the tolerances.
constexpr double kRounded = 1e-7;

/// A negative dual this close to 0 is what an exact tie leaves behind.
constexpr double kLeastDual = 1e-300;

double& Component(Circle* c, int k) {
  switch (k) {
    case 0:
      return c->a;
    case 1:
      return c->bx;
    case 2:
      return c->by;
    default:
      return c->d;
  }
}

double Component(Circle const& c, int k) {
  Circle copy = c;
  return Component(&copy, k);
}

/// The number of the component of largest size.
int LargestComponent(Circle const& c) {
  int best = 0;
  for (int k = 1; k < 4; ++k) {
    if (std::fabs(Component(c, k)) > std::fabs(Component(c, best))) best = k;
  }
  return best;
}

}  // namespace

bool Simplex::IsAccurate(double slack) const {
  for (std::size_t j = 0; j < 4; ++j) {
    double const residual = std::fabs(Apply(rows_[j], solution_) - limits_[j]);
    if (!(residual <= kResidualShare * slack * (limits_[j] > 1.0 ? limits_[j] : 1.0))) return false;
  }
  return true;
}

void Simplex::Put(Programme const& programme, std::size_t at, std::int32_t id, Basis* basis) {
  basis->ids[at] = id;
  rows_[at] = programme.RowOf(id);
  kinds_[at] = programme.KindOf(id);
  limits_[at] = programme.LimitOf(id);
}

bool Simplex::Load(Programme const& programme, Basis* basis) {
  for (std::size_t j = 0; j < 4; ++j) {
    std::int32_t const id = basis->ids[j];
    Put(programme, j, programme.IsStale(id) ? basis->FreeBox() : id, basis);
  }
  return InvertRows(rows_, &inverse_) && TakeEqualities(programme, basis);
}

bool Simplex::TakeEqualities(Programme const& programme, Basis* basis) {
  for (int k = 0; k < programme.conditionCount; ++k) {
    Condition const& condition = programme.conditions[static_cast<std::size_t>(k)];
    if (condition.kind != Condition::Kind::Equality || basis->Holds(-1 - k)) continue;
    int best = -1;
    double largest = 0.0;
    for (std::size_t j = 0; j < 4; ++j) {
      if (kinds_[j] == Condition::Kind::Equality) continue;
      double const step = std::fabs(Apply(condition.row, inverse_[j]));
      if (step > largest) {
        largest = step;
        best = static_cast<int>(j);
      }
    }
    if (best < 0) return false;
    Put(programme, static_cast<std::size_t>(best), -1 - k, basis);
    if (!InvertRows(rows_, &inverse_)) return false;
  }
  return true;
}

bool Simplex::MakeDualFeasible(Programme const& programme, Row const& objective, Basis* basis) {
  for (int round = 0; round < 8; ++round) {
    bool isChanged = false;
    for (std::size_t j = 0; j < 4; ++j) {
      duals_[j] = Apply(objective, inverse_[j]);
      if (duals_[j] >= 0.0 || kinds_[j] == Condition::Kind::Equality) continue;
      if (kinds_[j] == Condition::Kind::Slab) {
        rows_[j] = Negated(rows_[j]);
        inverse_[j] = Scaled(inverse_[j], -1.0);
        duals_[j] = -duals_[j];
        continue;
      }
      // A half space on the wrong side makes way for the box row that keeps the basis regular.
      Put(programme, j, Basis::kBox + LargestComponent(inverse_[j]), basis);
      isChanged = true;
      break;
    }
    if (!isChanged) return true;
    if (!InvertRows(rows_, &inverse_)) return false;
  }
  return false;
}

void Simplex::Solve() {
  solution_ = {};
  for (std::size_t j = 0; j < 4; ++j) solution_ = Sum(solution_, limits_[j], inverse_[j]);
}

Simplex::Entry Simplex::Price(Programme const& programme, Basis const& basis, double slack) {
  Entry entry;
  entry.excess = slack;
  auto const offer = [&](std::int32_t id, double excess) {
    if (!(excess > entry.excess)) return;
    entry.id = id;
    entry.excess = excess;
    entry.isFound = true;
  };
  auto const offerPoint = [&](Columns::Worst const& point) {
    if (point.index >= 0) offer(point.index, point.value - 1.0);
  };
  for (int k = 0; k < programme.conditionCount; ++k) {
    Condition const& condition = programme.conditions[static_cast<std::size_t>(k)];
    if (condition.kind == Condition::Kind::Equality) continue;
    double const value = Apply(condition.row, solution_);
    bool const isSlab = condition.kind == Condition::Kind::Slab;
    offer(-1 - k, (isSlab ? std::fabs(value) : value) - condition.limit);
  }
  if (!Candidates::ArePaying(programme)) {
    offerPoint(programme.columns->FindWorst(programme.first, programme.last, solution_));
  } else {
    offerPoint(candidates_.FindWorst(programme, solution_));
    if (!entry.isFound || basis.Holds(entry.id)) {
      offerPoint(candidates_.FindWorstOfAll(programme, solution_, 1.0 + slack));
    }
  }
  return entry;
}

int Simplex::FindLeaving(std::array<double, 4> const& step) const {
  double largest = 0.0;
  for (double s : step) largest = std::fabs(s) > largest ? std::fabs(s) : largest;
  int leaving = -1;
  double least = 0.0;
  for (std::size_t j = 0; j < 4; ++j) {
    if (!(step[j] > kLeastPivotShare * largest)) continue;
    if (kinds_[j] == Condition::Kind::Equality) continue;
    double const ratio = duals_[j] / step[j];
    if (leaving < 0 || ratio < least ||
        (ratio == least && step[j] > step[static_cast<std::size_t>(leaving)])) {
      leaving = static_cast<int>(j);
      least = ratio;
    }
  }
  return leaving;
}

void Simplex::Exchange(int leaving, std::array<double, 4> const& step) {
  auto const l = static_cast<std::size_t>(leaving);
  double const theta = duals_[l] / step[l];
  inverse_[l] = Scaled(inverse_[l], 1.0 / step[l]);
  for (std::size_t j = 0; j < 4; ++j) {
    if (j == l) continue;
    inverse_[j] = Sum(inverse_[j], -step[j], inverse_[l]);
    duals_[j] -= theta * step[j];
    if (duals_[j] < 0.0 && duals_[j] > -kLeastDual) duals_[j] = 0.0;
  }
  duals_[l] = theta;
}

bool Simplex::Pivot(Programme const& programme, Entry const& entry, Basis* basis) {
  Row row = programme.RowOf(entry.id);
  // Of two sides the broken one enters.
  Condition::Kind const kind = programme.KindOf(entry.id);
  if (kind == Condition::Kind::Slab && !(Apply(row, solution_) > 0.0)) row = Negated(row);
  std::array<double, 4> step;
  for (std::size_t j = 0; j < 4; ++j) step[j] = Apply(row, inverse_[j]);
  int const leaving = FindLeaving(step);
  if (leaving < 0) return false;
  auto const l = static_cast<std::size_t>(leaving);
  basis->ids[l] = entry.id;
  Exchange(leaving, step);
  rows_[l] = row;
  kinds_[l] = kind;
  limits_[l] = programme.LimitOf(entry.id);
  return true;
}

bool Simplex::Refresh(Programme const& programme, Row const& objective, Basis* basis) {
  return InvertRows(rows_, &inverse_) && MakeDualFeasible(programme, objective, basis);
}

bool Simplex::InvertBasis(Programme const& programme, Basis const& basis, InvertedRows* inverted,
                          std::array<double, 4>* limits) {
  Basis held = basis;
  if (!Load(programme, &held)) return false;
  *inverted = {rows_, inverse_};
  *limits = limits_;
  return true;
}

Condition Simplex::FindBrokenSlab(Programme const& programme, Circle const& circle) const {
  Condition worst;
  double largest = -1.0;
  for (int k = 0; k < programme.conditionCount; ++k) {
    Condition const& condition = programme.conditions[static_cast<std::size_t>(k)];
    if (condition.kind != Condition::Kind::Slab) continue;
    double const value = std::fabs(Apply(condition.row, circle)) / condition.limit;
    if (value > largest) {
      largest = value;
      worst = condition;
    }
  }
  Columns::Worst const point =
      programme.columns->FindWorst(programme.first, programme.last, circle);
  if (point.value > largest) {
    worst = {programme.columns->At(point.index), Condition::Kind::Slab, 1.0};
  }
  return worst;
}

Simplex::Status Simplex::Maximise(Programme const& programme, Row const& objective, double enough,
                                  Basis* basis) {
  if (!Load(programme, basis)) {
    *basis = Basis();
    if (!Load(programme, basis)) return Status::Stalled;
  }
  exchanges_ = 0;
  return MaximiseNext(programme, objective, enough, basis);
}

Simplex::Status Simplex::MaximiseNext(Programme const& programme, Row const& objective,
                                      double enough, Basis* basis) {
  if (!MakeDualFeasible(programme, objective, basis)) return Status::Stalled;
  Solve();
  for (int pivot = 0; pivot < kMostPivots; ++pivot) {
    // Rounding grows with the size of the circle, which the form of an objective measures.
    double const value = Apply(objective, solution_);
    if (value < enough) return Status::Infeasible;
    double const slack = value > 1.0 ? slack_ * value : slack_;
    Entry const entry = Price(programme, *basis, slack);
    // Nothing but rounding breaks a row of the basis.
    bool const isRounding = entry.isFound && basis->Holds(entry.id);
    if (!entry.isFound || isRounding) {
      if (exchanges_ == 0 || (!isRounding && IsAccurate(slack))) {
        return !entry.isFound || entry.excess <= kRounded ? Status::Optimal : Status::Stalled;
      }
      if (!Refresh(programme, objective, basis)) return Status::Stalled;
      solution_ = Fewest::Solve({rows_, inverse_}, limits_);
      exchanges_ = 0;
      continue;
    }
    if (!Pivot(programme, entry, basis)) return Status::Infeasible;
    if (++exchanges_ >= kExchangesBeforeInversion) {
      if (!Refresh(programme, objective, basis)) return Status::Stalled;
      exchanges_ = 0;
    }
    Solve();
  }
  return Status::Stalled;
}

}  // namespace Vorn::Fewest
