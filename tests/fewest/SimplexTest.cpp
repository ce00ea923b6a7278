#include <gtest/gtest.h>

#include <cmath>

#include "geometry/fewest/Simplex.h"
#include "support/fewest/Programmes.h"

namespace Vorn::Fewest {
namespace {

using Testing::ProgrammeOf;

/// Three points within a tenth of y = 0 and the line as what is to be largest.
TEST(Simplex, SteepestLineThroughASlab) {
  Columns columns;
  columns.Append({-1.0, 0.0, 0.125});
  columns.Append({1.0, 0.0, 0.125});
  Programme programme = ProgrammeOf(columns);
  programme.Add({{1.0, 0.0, 0.0, 0.0}, Condition::Kind::Equality, 0.0});
  Simplex simplex(1e-12);
  Basis basis;
  // The row of the value at (1, 0) less that at (-1, 0): 2 bx, and each value is at most 1 / 8.
  ASSERT_EQ(simplex.Maximise(programme, {0.0, 2.0, 0.0, 0.0}, 0.0, &basis),
            Simplex::Status::Optimal);
  EXPECT_NEAR(simplex.Solution().bx, 0.125, 1e-12);
  EXPECT_NEAR(simplex.Solution().d, 0.0, 1e-12);
}

TEST(Simplex, HalfSpacesBindOnOneSideOnly) {
  Columns columns;
  columns.Append({1.0, 0.0, 1.0});
  columns.Append({0.0, 1.0, 1.0});
  Programme programme = ProgrammeOf(columns);
  programme.Add({{0.0, 0.0, 0.0, 1.0}, Condition::Kind::HalfSpace, 0.25});
  Simplex simplex(1e-12);
  Basis basis;
  ASSERT_EQ(simplex.Maximise(programme, {0.0, 0.0, 0.0, 1.0}, 0.0, &basis),
            Simplex::Status::Optimal);
  EXPECT_NEAR(simplex.Solution().d, 0.25, 1e-12);
  ASSERT_EQ(simplex.Maximise(programme, {0.0, 0.0, 0.0, -1.0}, -1e300, &basis),
            Simplex::Status::Optimal);
  EXPECT_LT(simplex.Solution().d, -100.0);
}

/// 2,001 points on the cubic of Chebyshev, which among all of its leading coefficient deviates
/// least from 0: by 1, so that only the line y = 0 is within a tolerance of 1.
TEST(Simplex, LongRunsHaveTheOptimumOfAllRows) {
  Columns columns;
  constexpr std::int32_t kHalf = 1000;
  for (std::int32_t i = -kHalf; i <= kHalf; ++i) {
    double const x = static_cast<double>(i) / kHalf;
    columns.Append({x, 4.0 * x * x * x - 3.0 * x, 1.0});
  }
  Programme programme = ProgrammeOf(columns);
  programme.Add({{1.0, 0.0, 0.0, 0.0}, Condition::Kind::Equality, 0.0});
  Simplex simplex(1e-12);
  Basis basis;
  ASSERT_EQ(simplex.Maximise(programme, {0.0, 0.0, 1.0, 0.0}, 0.0, &basis),
            Simplex::Status::Optimal);
  EXPECT_NEAR(simplex.Solution().by, 1.0, 1e-9);
  EXPECT_NEAR(simplex.Solution().bx, 0.0, 1e-9);
  EXPECT_NEAR(simplex.Solution().d, 0.0, 1e-9);
}

/// Far from the origin the four rows of a basis nearly depend on each other, and rounding breaks
/// them by more than the slack.
TEST(Simplex, RowsOfTheBasisThatRoundingBreaksAreNotExchangedForever) {
  Columns columns;
  for (std::int32_t i = 0; i < 40; ++i) {
    double const x = 1.0 + 1e-4 * i;
    columns.Append({x, 1.0 + 1e-5 * ((7 * i) % 5), 1e-4});
  }
  Programme programme = ProgrammeOf(columns);
  Simplex simplex(1e-15);
  Basis basis;
  ASSERT_EQ(simplex.Maximise(programme, {0.0, 0.0, 1.0, 0.0}, 0.0, &basis),
            Simplex::Status::Optimal);
  EXPECT_LE(columns.FindWorst(0, columns.Size(), simplex.Solution()).value, 1.0 + 1e-7);
}

TEST(Simplex, ContradictingEqualitiesAreInfeasible) {
  Columns columns;
  columns.Append({1.0, 0.0, 0.5});
  Programme programme;
  programme.columns = &columns;
  programme.last = 1;
  programme.Add({{1.0, 1.0, 0.0, 1.0}, Condition::Kind::Equality, 2.0});
  programme.Add({{0.75, 1.0, 0.0, 1.0}, Condition::Kind::Equality, -2.0});
  programme.Add({{1.0, 0.0, 0.0, 0.0}, Condition::Kind::Slab, 1.0});
  Simplex simplex(1e-12);
  Basis basis;
  EXPECT_EQ(simplex.Maximise(programme, {0.0, 0.0, 1.0, 0.0}, -1e300, &basis),
            Simplex::Status::Infeasible);
}

}  // namespace
}  // namespace Vorn::Fewest
