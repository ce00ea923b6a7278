#include <gtest/gtest.h>

#include <cmath>

#include "geometry/fewest/Simplex.h"

namespace Vorn::Fewest {
namespace {

/// Three points within a tenth of y = 0 and the line as what is to be largest.
TEST(Simplex, SteepestLineThroughASlab) {
  Columns columns;
  columns.Append({-1.0, 0.0, 0.125});
  columns.Append({1.0, 0.0, 0.125});
  Programme programme;
  programme.columns = &columns;
  programme.last = 2;
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
  Programme programme;
  programme.columns = &columns;
  programme.last = 2;
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
