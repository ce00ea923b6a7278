#pragma once

#include <array>
#include <cstdint>

#include "geometry/fewest/Candidates.h"
#include "geometry/fewest/Columns.h"
#include "geometry/fewest/Inverse.h"
#include "geometry/fewest/Programme.h"

/// Linear programmes in the four coefficients of a circle, solved by the dual simplex method with
/// an explicit inverse of the basis (Dantzig 1963; pricing by the largest violation).
namespace Vorn::Fewest {

/// Solves one programme after another, each from the basis of the one before.
class Simplex {
 public:
  enum class Status { Optimal, Infeasible, Stalled };

  /// Largest relative violation of a row that counts as none.
  explicit Simplex(double slack) : slack_(slack) {}

  /// Finds the circle with the largest value of the objective.
  ///
  /// @param[in]     programme the rows
  /// @param[in]     objective what is to be large
  /// @param[in]     enough    a value below which the search stops early: the optimum is below it
  /// @param[in,out] basis     where to start; afterwards the basis of the answer
  /// @return Optimal; Infeasible when the rows contradict each other; Stalled when rounding keeps
  ///         the search from an end
  Status Maximise(Programme const& programme, Row const& objective, double enough, Basis* basis);
  /// The same from where the search before ended, which must have found the optimum of another
  /// objective over the same rows: the inverse is used again. In long runs a new one pays, since
  /// what it has lost in digits costs passes over all rows.
  Status MaximiseNext(Programme const& programme, Row const& objective, double enough,
                      Basis* basis);

  /// The circle found last.
  Circle const& Solution() const { return solution_; }
  /// Largest relative violation of a row that counts as none.
  double Slack() const { return slack_; }

  /// The rows of a basis with their inverse, and the limits of the rows; false when the rows depend
  /// on each other.
  bool InvertBasis(Programme const& programme, Basis const& basis, InvertedRows* inverted,
                   std::array<double, 4>* limits);
  /// The slab or point row that a circle breaks most, in units of its limit.
  Condition FindBrokenSlab(Programme const& programme, Circle const& circle) const;

 private:
  struct Entry {
    std::int32_t id = 0;
    double excess = 0.0;
    bool isFound = false;
  };

  /// Takes over the rows of a basis, stale ones replaced by the box, and inverts them; false when
  /// they depend on each other.
  bool Load(Programme const& programme, Basis* basis);
  /// Has every equality in the basis; false when one depends on the others.
  bool TakeEqualities(Programme const& programme, Basis* basis);
  /// Whether the solution lies on the rows of its basis within a share of the slack.
  bool IsAccurate(double slack) const;
  /// Turns or exchanges rows until no step along one raises the objective; false when rounding
  /// prevents it.
  bool MakeDualFeasible(Programme const& programme, Row const& objective, Basis* basis);
  /// The circle where the rows of the basis meet their limits.
  void Solve();
  /// A row that the solution breaks by more than the slack: the one that it breaks most, but of
  /// long runs the worst candidate as long as one outside the basis is broken. Not found when there
  /// is none.
  Entry Price(Programme const& programme, Basis const& basis, double slack);
  /// The row of the basis that may leave for the entering one so that the basis stays dual
  /// feasible; -1 when the rows contradict each other.
  int FindLeaving(std::array<double, 4> const& step) const;
  /// Exchanges a row of the basis for an entering one; false when the rows contradict each other.
  bool Pivot(Programme const& programme, Entry const& entry, Basis* basis);
  /// Has a row of the programme in a place of the basis; leaves the inverse as it is.
  void Put(Programme const& programme, std::size_t at, std::int32_t id, Basis* basis);
  /// Computes the inverse and the duals anew; false when rounding prevents it.
  bool Refresh(Programme const& programme, Row const& objective, Basis* basis);
  /// Updates inverse and duals for a row that takes the place of the leaving one.
  void Exchange(int leaving, std::array<double, 4> const& step);

  double slack_;
  Candidates candidates_;
  // Of the rows of the basis.
  std::array<Row, 4> rows_;
  std::array<Condition::Kind, 4> kinds_;
  std::array<double, 4> limits_;
  std::array<double, 4> duals_;
  std::array<Circle, 4> inverse_;
  int exchanges_ = 0;  ///< since the inverse was computed
  Circle solution_;
};

}  // namespace Vorn::Fewest
