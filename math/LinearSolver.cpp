// Gaussian elimination with row pivoting and back substitution.
//   G. H. Golub, C. F. Van Loan, "Matrix Computations", section 3.4.

#include <cmath>
#include <cstddef>
#include <type_traits>
#include <utility>

#include "vorn/MathUtils.h"

namespace Vorn {

namespace {

/// A square system in the caller's arrays. The order is a number or, for the small ones that every
/// circle is found with, a constant, which lets the compiler unroll the loops.
template <typename Order>
class LinearSystem {
 public:
  LinearSystem(Order order, double* matrix, double* rhs)
      : order_(order), matrix_(matrix), rhs_(rhs) {}

  /// Brings the entry of greatest magnitude at or below the diagonal of this column onto the
  /// diagonal; the topmost of equals. False when the column has only exact zeros there: no
  /// tolerance, since a tiny pivot may be all that the data gives.
  bool BringPivotUp(std::size_t column) {
    std::size_t best = column;
    double bestMagnitude = std::fabs(Row(column)[column]);
    for (std::size_t row = column + 1; row < order_; ++row) {
      double const magnitude = std::fabs(Row(row)[column]);
      if (magnitude > bestMagnitude) {
        bestMagnitude = magnitude;
        best = row;
      }
    }
    if (bestMagnitude == 0.0) return false;
    if (best != column) {
      for (std::size_t j = column; j < order_; ++j) std::swap(Row(column)[j], Row(best)[j]);
      std::swap(rhs_[column], rhs_[best]);
    }
    return true;
  }

  /// Subtracts the pivot row from the rows below it. What stands below the diagonal stays as it
  /// is: nothing reads it again.
  void Eliminate(std::size_t column) {
    double const* const pivot = Row(column);
    for (std::size_t row = column + 1; row < order_; ++row) {
      double* const target = Row(row);
      double const factor = target[column] / pivot[column];
      for (std::size_t j = column + 1; j < order_; ++j) target[j] -= factor * pivot[j];
      rhs_[row] -= factor * rhs_[column];
    }
  }

  void SubstituteBack(double* solution) {
    for (std::size_t i = order_; i-- > 0;) {
      double sum = 0.0;
      for (std::size_t j = i + 1; j < order_; ++j) sum += Row(i)[j] * solution[j];
      solution[i] = (rhs_[i] - sum) / Row(i)[i];
    }
  }

 private:
  double* Row(std::size_t row) { return matrix_ + row * order_; }

  Order const order_;
  double* const matrix_;
  double* const rhs_;
};

template <typename Order>
bool Solve(Order order, double* matrix, double* rhs, double* solution) {
  LinearSystem<Order> system(order, matrix, rhs);
  // Deliberate: the last column is never pivoted, so a system that turns out singular only there
  // is answered with infinities or NaNs and true.
  for (std::size_t column = 0; column + 1 < order; ++column) {
    if (!system.BringPivotUp(column)) return false;
    system.Eliminate(column);
  }
  system.SubstituteBack(solution);
  return true;
}

template <std::size_t kOrder>
using FixedOrder = std::integral_constant<std::size_t, kOrder>;

}  // namespace

bool MathUtils::LinearEquationSystemSolve(int n, double* matrix, double* rhs, double* solution) {
  switch (n) {
    case 2:
      return Solve(FixedOrder<2>{}, matrix, rhs, solution);
    case 3:
      return Solve(FixedOrder<3>{}, matrix, rhs, solution);
    case 4:
      return Solve(FixedOrder<4>{}, matrix, rhs, solution);
    default:
      return n <= 0 || Solve(static_cast<std::size_t>(n), matrix, rhs, solution);
  }
}

}  // namespace Vorn
