#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <utility>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "vorn/MathUtils.h"

namespace Vorn::Testing {
namespace {

struct System {
  int n = 0;
  std::vector<double> a;
  std::vector<double> b;
  std::vector<double> x;
  bool ok = false;

  double& At(int row, int column) { return a[static_cast<std::size_t>(row * n + column)]; }
};

System Make(int n, std::vector<double> a, std::vector<double> b) {
  return {n, std::move(a), std::move(b),
          std::vector<double>(static_cast<std::size_t>(n), kSentinel), false};
}

System Solved(System system) {
  system.ok = MathUtils::LinearEquationSystemSolve(system.n, system.a.data(), system.b.data(),
                                                   system.x.data());
  return system;
}

void ExpectBits(std::vector<double> const& actual, std::vector<double> const& expected) {
  ASSERT_EQ(actual.size(), expected.size());
  for (std::size_t i = 0; i < actual.size(); ++i) {
    SCOPED_TRACE(i);
    EXPECT_SAME_BITS(actual[i], expected[i]);
  }
}

/// The elimination written out over an explicit list of pivot rows, without the in-place tricks:
/// the sequence of floating-point operations on each entry is fixed, so bits must agree.
System Reference(System s) {
  for (int k = 0; k + 1 < s.n; ++k) {
    int pivot = k;
    for (int row = k + 1; row < s.n; ++row) {
      if (std::fabs(s.At(row, k)) > std::fabs(s.At(pivot, k))) pivot = row;
    }
    if (s.At(pivot, k) == 0.0) return s;
    if (pivot != k) {
      for (int column = k; column < s.n; ++column) std::swap(s.At(k, column), s.At(pivot, column));
      std::swap(s.b[static_cast<std::size_t>(k)], s.b[static_cast<std::size_t>(pivot)]);
    }
    for (int row = k + 1; row < s.n; ++row) {
      double const factor = s.At(row, k) / s.At(k, k);
      for (int column = k + 1; column < s.n; ++column) {
        double const product = factor * s.At(k, column);
        s.At(row, column) = s.At(row, column) - product;
      }
      double const product = factor * s.b[static_cast<std::size_t>(k)];
      s.b[static_cast<std::size_t>(row)] -= product;
    }
  }
  for (int i = s.n - 1; i >= 0; --i) {
    double sum = 0.0;
    for (int j = i + 1; j < s.n; ++j) sum += s.At(i, j) * s.x[static_cast<std::size_t>(j)];
    s.x[static_cast<std::size_t>(i)] = (s.b[static_cast<std::size_t>(i)] - sum) / s.At(i, i);
  }
  s.ok = true;
  return s;
}

void ExpectLikeReference(System const& input) {
  System const expected = Reference(input);
  System const actual = Solved(input);
  EXPECT_EQ(actual.ok, expected.ok);
  ExpectBits(actual.a, expected.a);
  ExpectBits(actual.b, expected.b);
  ExpectBits(actual.x, expected.x);
}

/// Gauss-Jordan with full pivoting in long double, unrelated to the order of operations above.
std::vector<long double> FullPivotSolution(System s) {
  auto const n = static_cast<std::size_t>(s.n);
  std::vector<std::vector<long double>> rows(n, std::vector<long double>(n + 1));
  for (std::size_t r = 0; r < n; ++r) {
    for (std::size_t c = 0; c < n; ++c) rows[r][c] = Extended(s.a[r * n + c]);
    rows[r][n] = Extended(s.b[r]);
  }
  std::vector<std::size_t> columnOf(n);
  std::vector<bool> rowDone(n, false);
  std::vector<bool> columnDone(n, false);
  for (std::size_t step = 0; step < n; ++step) {
    std::size_t pivotRow = n;
    std::size_t pivotColumn = n;
    for (std::size_t r = 0; r < n; ++r) {
      for (std::size_t c = 0; c < n; ++c) {
        if (rowDone[r] || columnDone[c]) continue;
        if (pivotRow == n || std::fabs(rows[r][c]) > std::fabs(rows[pivotRow][pivotColumn])) {
          pivotRow = r;
          pivotColumn = c;
        }
      }
    }
    rowDone[pivotRow] = columnDone[pivotColumn] = true;
    columnOf[pivotRow] = pivotColumn;
    for (std::size_t r = 0; r < n; ++r) {
      if (r == pivotRow) continue;
      long double const factor = rows[r][pivotColumn] / rows[pivotRow][pivotColumn];
      for (std::size_t c = 0; c <= n; ++c) rows[r][c] -= factor * rows[pivotRow][c];
    }
  }
  std::vector<long double> x(n);
  for (std::size_t r = 0; r < n; ++r) x[columnOf[r]] = rows[r][n] / rows[r][columnOf[r]];
  return x;
}

System RandomSystem(RandomGeometry* random, int n, double low, double high) {
  std::vector<double> a;
  std::vector<double> b;
  for (int i = 0; i < n * n; ++i) a.push_back(random->Uniform(low, high));
  for (int i = 0; i < n; ++i) b.push_back(random->Uniform(low, high));
  return Make(n, a, b);
}

TEST(LinearEquationSystemSolve, OrderZeroOrLessIsTrueAndWritesNothing) {
  for (int const n : {0, -1, -1000, -2147483647 - 1}) {
    double matrix = kSentinel;
    double rhs = kSentinel;
    double solution = kSentinel;
    EXPECT_TRUE(MathUtils::LinearEquationSystemSolve(n, &matrix, &rhs, &solution)) << n;
    EXPECT_SAME_BITS(matrix, kSentinel);
    EXPECT_SAME_BITS(rhs, kSentinel);
    EXPECT_SAME_BITS(solution, kSentinel);
    EXPECT_TRUE(MathUtils::LinearEquationSystemSolve(n, nullptr, nullptr, nullptr)) << n;
  }
}

TEST(LinearEquationSystemSolve, OrderOneDividesUnchecked) {
  System const plain = Solved(Make(1, {4.0}, {2.0}));
  EXPECT_TRUE(plain.ok);
  EXPECT_SAME_BITS(plain.x[0], 0.5);
  EXPECT_SAME_BITS(Solved(Make(1, {0.0}, {2.0})).x[0], kInf);
  EXPECT_SAME_BITS(Solved(Make(1, {-0.0}, {2.0})).x[0], -kInf);
  EXPECT_SAME_BITS(Solved(Make(1, {0.0}, {0.0})).x[0], kNaN);
  EXPECT_TRUE(Solved(Make(1, {0.0}, {2.0})).ok);
  EXPECT_SAME_BITS(Solved(Make(1, {3.0}, {-0.0})).x[0], -0.0);
}

TEST(LinearEquationSystemSolve, ZeroFirstColumnFailsAndLeavesSolutionUntouched) {
  System const input = Make(3, {0, 1, 2, 0, 3, 4, -0.0, 5, 7}, {1, 2, 3});
  System const result = Solved(input);
  EXPECT_FALSE(result.ok);
  ExpectBits(result.x, {kSentinel, kSentinel, kSentinel});
  ExpectBits(result.a, input.a);
  ExpectBits(result.b, input.b);
}

TEST(LinearEquationSystemSolve, ZeroSecondColumnFailsAfterTheFirstElimination) {
  // Rows 1 and 2 lose their second entry with the first: 4 - 2*2 and 6 - 3*2.
  System const result = Solved(Make(3, {1, 2, 1, 2, 4, 5, 3, 6, 9}, {1, 3, 4}));
  EXPECT_FALSE(result.ok);
  ExpectBits(result.x, {kSentinel, kSentinel, kSentinel});
  // Row 2 holds the greatest first entry: rows 0 and 2 change places before the elimination.
  EXPECT_SAME_BITS(result.a[0], 3.0);
  EXPECT_SAME_BITS(result.b[0], 4.0);
  EXPECT_SAME_BITS(result.a[4], 0.0);
  EXPECT_SAME_BITS(result.a[7], 0.0);
}

TEST(LinearEquationSystemSolve, ZeroLastPivotIsNotCheckedAndGivesNonFiniteSolution) {
  System const result = Solved(Make(2, {1, 2, 2, 4}, {1, 3}));
  EXPECT_TRUE(result.ok);
  EXPECT_FALSE(std::isfinite(result.x[0]));
  EXPECT_FALSE(std::isfinite(result.x[1]));
  // Pivot row (2, 4 | 3); the other becomes (1, 0 | -0.5), so y = -0.5/0, x = (3 - 4*y)/2.
  EXPECT_SAME_BITS(result.x[1], -kInf);
  EXPECT_SAME_BITS(result.x[0], kInf);
}

TEST(LinearEquationSystemSolve, DependentEquationsGiveNotANumber) {
  System const result = Solved(Make(2, {1, 2, 2, 4}, {1, 2}));
  EXPECT_TRUE(result.ok);
  EXPECT_TRUE(std::isnan(result.x[0]));
  EXPECT_TRUE(std::isnan(result.x[1]));
}

TEST(LinearEquationSystemSolve, EqualPivotMagnitudesKeepTheTopmostRow) {
  System const result = Solved(Make(2, {2, 1, -2, 3}, {5, 7}));
  EXPECT_TRUE(result.ok);
  ExpectBits(result.a, {2.0, 1.0, -2.0, 4.0});
  ExpectBits(result.b, {5.0, 12.0});
  ExpectBits(result.x, {1.0, 3.0});
}

TEST(LinearEquationSystemSolve, PivotByAHairSwapsRows) {
  System const result = Solved(Make(2, {2, 1, Down(-2.0), 3}, {5, 7}));
  EXPECT_SAME_BITS(result.a[0], Down(-2.0));
  EXPECT_SAME_BITS(result.a[1], 3.0);
  EXPECT_SAME_BITS(result.b[0], 7.0);
}

TEST(LinearEquationSystemSolve, EliminatedEntriesKeepTheirOldValues) {
  // Powers of two everywhere: each step is exact and checked by hand.
  System const result = Solved(Make(3, {1, 2, 4, 2, 4, 4, 4, 4, 4}, {15, 22, 24}));
  ASSERT_TRUE(result.ok);
  // k = 0: rows 0 and 2 swap, (4 4 4|24) stays on top; row 1 becomes (2)(2 2|10) with the old 2
  // kept, row 2 becomes (1)(1 3|9). k = 1: pivot 2, no swap; row 2 becomes (1 1)(2|4).
  ExpectBits(result.a, {4, 4, 4, 2, 2, 2, 1, 1, 2});
  ExpectBits(result.b, {24, 10, 4});
  ExpectBits(result.x, {1, 3, 2});
}

TEST(LinearEquationSystemSolve, LaterSwapsLeaveTheColumnsToTheLeftInPlace) {
  // After k = 0 the second column holds 1 in row 1 and 2 in row 2, so those rows swap; their
  // stale first entries 8 and 4 must not.
  System const result = Solved(Make(3, {8, 0, 0, 8, 1, 0, 4, 2, 1}, {8, 10, 9}));
  ASSERT_TRUE(result.ok);
  ExpectBits(result.a, {8, 0, 0, 8, 2, 1, 4, 1, -0.5});
  ExpectBits(result.b, {8, 5, -0.5});
  ExpectBits(result.x, {1, 2, 1});
}

TEST(LinearEquationSystemSolve, TinyPivotIsAccepted) {
  double const tiny = std::numeric_limits<double>::denorm_min();
  System const result = Solved(Make(2, {tiny, 0, 0, 1}, {tiny, 3}));
  EXPECT_TRUE(result.ok);
  ExpectBits(result.x, {1.0, 3.0});
}

TEST(LinearEquationSystemSolve, NotANumberOnTheDiagonalStaysThePivot) {
  System const result = Solved(Make(2, {kNaN, 1, 5, 2}, {3, 4}));
  EXPECT_TRUE(result.ok);
  EXPECT_TRUE(std::isnan(result.a[0]));
  EXPECT_SAME_BITS(result.a[1], 1.0);
  EXPECT_SAME_BITS(result.a[2], 5.0);
  EXPECT_SAME_BITS(result.b[0], 3.0);
  EXPECT_TRUE(std::isnan(result.x[0]));
  EXPECT_TRUE(std::isnan(result.x[1]));
}

TEST(LinearEquationSystemSolve, NotANumberBelowTheDiagonalIsNeverChosen) {
  System const result = Solved(Make(2, {0, 1, kNaN, 2}, {3, 4}));
  EXPECT_FALSE(result.ok);
  ExpectBits(result.x, {kSentinel, kSentinel});
  System const swapped = Solved(Make(3, {1, 1, 1, kNaN, 2, 2, 3, 4, 5}, {3, 4, 5}));
  EXPECT_TRUE(swapped.ok);
  EXPECT_SAME_BITS(swapped.a[0], 3.0);
  EXPECT_TRUE(std::isnan(swapped.a[3]));
}

TEST(LinearEquationSystemSolve, InfinityIsAPivotLikeAnyOther) {
  ExpectLikeReference(Make(2, {1, 2, kInf, 3}, {1, 1}));
  ExpectLikeReference(Make(3, {1, 2, 3, -kInf, 5, 6, 7, kInf, 9}, {1, kInf, 1}));
}

TEST(LinearEquationSystemSolve, FollowsTheReferenceBitForBit) {
  constexpr std::uint64_t kSeed = 611;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 1; n <= 7; ++n) {
    for (int i = 0; i < 300; ++i) {
      SCOPED_TRACE(testing::Message() << "n " << n << " case " << i);
      ExpectLikeReference(RandomSystem(&random, n, -10.0, 10.0));
      if (HasFailure()) return;
    }
  }
}

TEST(LinearEquationSystemSolve, FollowsTheReferenceOnSmallWholeNumbersWithTiesAndZeros) {
  constexpr std::uint64_t kSeed = 612;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int failed = 0;
  int nonFinite = 0;
  for (int i = 0; i < 4000; ++i) {
    SCOPED_TRACE(i);
    int const n = random.Integer(2, 4);
    System system = RandomSystem(&random, n, 0.0, 1.0);
    for (double& value : system.a) value = random.Integer(-1, 1);
    for (double& value : system.b) value = random.Integer(-3, 3);
    System const result = Solved(system);
    failed += result.ok ? 0 : 1;
    nonFinite += result.ok && !std::isfinite(result.x.back()) ? 1 : 0;
    ExpectLikeReference(system);
    if (HasFailure()) return;
  }
  EXPECT_GT(failed, 100);
  EXPECT_GT(nonFinite, 100);
}

TEST(LinearEquationSystemSolve, FollowsTheReferenceOnAnyBitPattern) {
  constexpr std::uint64_t kSeed = 613;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 2000; ++i) {
    SCOPED_TRACE(i);
    System system = RandomSystem(&random, random.Integer(1, 4), 0.0, 1.0);
    for (double& value : system.a) {
      if (random.Integer(0, 3) == 0) value = random.AnyDouble();
    }
    ExpectLikeReference(system);
    if (HasFailure()) return;
  }
}

TEST(LinearEquationSystemSolve, AgreesWithFullPivotingInLongDouble) {
  constexpr std::uint64_t kSeed = 614;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 500; ++i) {
    SCOPED_TRACE(i);
    int const n = random.Integer(1, 6);
    System input = RandomSystem(&random, n, -1.0, 1.0);
    // A heavy diagonal keeps the condition number small, so a tight bound can be asked for.
    for (int k = 0; k < n; ++k) input.At(k, (k + i) % n) += 8.0;
    System const result = Solved(input);
    ASSERT_TRUE(result.ok);
    std::vector<long double> const expected = FullPivotSolution(input);
    for (std::size_t k = 0; k < expected.size(); ++k) {
      EXPECT_NEAR(result.x[k], static_cast<double>(expected[k]), 1e-14);
    }
  }
}

TEST(LinearEquationSystemSolve, PowersOfTwoScaleTheSolutionExactly) {
  constexpr std::uint64_t kSeed = 615;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 300; ++i) {
    System const input = RandomSystem(&random, 3, -5.0, 5.0);
    System scaled = input;
    for (double& value : scaled.a) value *= 0x1p20;
    for (double& value : scaled.b) value *= 0x1p-7;
    System const plain = Solved(input);
    System const result = Solved(scaled);
    for (std::size_t k = 0; k < 3; ++k) EXPECT_SAME_BITS(result.x[k], plain.x[k] * 0x1p-27);
  }
}

}  // namespace
}  // namespace Vorn::Testing
