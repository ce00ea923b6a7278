#include "geometry/fewest/RunTest.h"

#include <cmath>

namespace Vorn::Fewest {

namespace {

/// Linearisations after which the search ends; it gains a factor of 10 and more with each.
constexpr int kMostRounds = 6;

/// A gain of the ratio below this share ends the search.
constexpr double kLeastGain = 1e-4;

/// Below this largest value of the linearised form no further linearisation brings it to 1.
constexpr double kHopeless = 0.5;

/// The form may fall short of 1 by this much through rounding; being quadratic it also takes up the
/// slack of the rows twice.
constexpr double kFormSlack = 1e-9;

constexpr int kMostCuts = 200;

/// The circle on the way from one to another, both within the rows, at which the form is largest.
Circle BestBetween(Circle const& from, Circle const& to) {
  Circle const along{to.a - from.a, to.bx - from.bx, to.by - from.by, to.d - from.d};
  double const slope = Form(from, along);
  double const curvature = Form(along, along);
  if (!(slope > 0.0) || !(slope < -curvature)) return to;
  return Between(from, to, -slope / curvature);
}

}  // namespace

RunFit FitRun(Programme const& programme, RunFit const& start, bool isTest, Simplex* simplex,
              Basis* basis) {
  RunFit best = start;
  for (int round = 0; round < kMostRounds; ++round) {
    double const enough = isTest ? kHopeless : 0.0;
    Row const objective = FormRow(best.circle);
    bool const isNew = round == 0 || Candidates::ArePaying(programme);
    Simplex::Status const status = isNew
                                       ? simplex->Maximise(programme, objective, enough, basis)
                                       : simplex->MaximiseNext(programme, objective, enough, basis);
    if (status != Simplex::Status::Optimal) return best;
    Circle found = simplex->Solution();
    if (best.isFound) found = BestBetween(Scaled(best.circle, 1.0 / best.ratio), found);
    double const form = Form(found, found);
    if (!(form > 0.0)) return best;
    double const ratio = 1.0 / std::sqrt(form);
    bool const isBetter = !best.isFound || ratio < best.ratio * (1.0 - kLeastGain);
    if (!best.isFound || ratio < best.ratio) best = {Scaled(found, ratio), ratio, true};
    if (!isBetter || (isTest && ratio <= 1.0)) return best;
  }
  return best;
}

RunFit ProveRun(Programme const& programme, Basis const& basis, Simplex* simplex,
                Polytope* workspace) {
  InvertedRows inverted;
  std::array<double, 4> limits;
  if (!simplex->InvertBasis(programme, basis, &inverted, &limits)) return {{}, 2.0, true};
  Polytope& polytope = *workspace;
  polytope.Begin(inverted, limits);
  for (int cut = 0; cut < kMostCuts; ++cut) {
    if (polytope.IsEmpty()) return {};
    Polytope::Peak const peak = polytope.FindPeak();
    if (peak.form < 1.0 - kFormSlack - 2.0 * simplex->Slack()) return {};
    Circle const circle = Scaled(peak.circle, 1.0 / std::sqrt(peak.form));
    Condition const broken = simplex->FindBrokenSlab(programme, circle);
    double const value = std::fabs(Apply(broken.row, circle));
    if (!(value > broken.limit * (1.0 + simplex->Slack()))) {
      return {circle, value / broken.limit, true};
    }
    Row const& r = broken.row;
    // What rounding does to a row must not cut off a circle that meets it.
    double const limit = broken.limit * (1.0 + simplex->Slack());
    if (!polytope.Cut(r, limit) || !polytope.Cut(Negated(r), limit)) {
      break;
    }
  }
  return {{}, 2.0, true};
}

}  // namespace Vorn::Fewest
