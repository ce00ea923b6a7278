#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <limits>

#include "geometry/fewest/Inverse.h"
#include "support/RandomGeometry.h"

namespace Vorn::Fewest {
namespace {

using Testing::RandomGeometry;

TEST(InvertRows, RefusesRowsThatDependOnEachOther) {
  std::array<Circle, 4> inverse;
  Row const row{1.0, 2.0, 3.0, 4.0};
  std::array<Row, 4> const rows{row, {0.0, 1.0, 0.0, 0.0}, Negated(row), {0.0, 0.0, 0.0, 1.0}};
  EXPECT_FALSE(InvertRows(rows, &inverse));
  double const nan = std::numeric_limits<double>::quiet_NaN();
  EXPECT_FALSE(InvertRows(
      {Row{nan, 0.0, 0.0, 0.0}, {0.0, 1.0, 0.0, 0.0}, {0.0, 0.0, 1.0, 0.0}, {0.0, 0.0, 0.0, 1.0}},
      &inverse));
}

TEST(InvertRows, OfATriangularMatrixIsKnown) {
  std::array<Circle, 4> inverse;
  ASSERT_TRUE(InvertRows(
      {Row{1.0, 2.0, 0.0, 0.0}, {0.0, 1.0, 0.0, 0.0}, {0.0, 0.0, 4.0, 0.0}, {0.0, 0.0, 8.0, 2.0}},
      &inverse));
  EXPECT_EQ(inverse[0].a, 1.0);
  EXPECT_EQ(inverse[1].a, -2.0);
  EXPECT_EQ(inverse[1].bx, 1.0);
  EXPECT_EQ(inverse[2].by, 0.25);
  EXPECT_EQ(inverse[2].d, -1.0);
  EXPECT_EQ(inverse[3].d, 0.5);
}

double SizeOf(Row const& r, Circle const& c) {
  return std::fabs(r.a * c.a) + std::fabs(r.bx * c.bx) + std::fabs(r.by * c.by) +
         std::fabs(r.d * c.d);
}

/// Rows of points a thousandth apart with tolerances over six orders: conditions of 1e9 and more.
TEST(Solve, MissesEachRowByTheRoundingOfItsTermsOnly) {
  RandomGeometry random(7111);
  int solved = 0;
  for (int round = 0; round < 2000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 7111, round " << round);
    Columns columns;
    for (int i = 0; i < 4; ++i) {
      double const x = 0.001 * i + random.Uniform(0.0, 0.0005);
      double const w = std::pow(10.0, random.Uniform(-8.0, -2.0));
      columns.Append({x, x * x + random.Uniform(-1e-3, 1e-3), w});
    }
    InvertedRows inverted;
    std::array<double, 4> values;
    for (std::int32_t i = 0; i < 4; ++i) {
      inverted.rows[static_cast<std::size_t>(i)] = columns.At(i);
      values[static_cast<std::size_t>(i)] = random.Integer(0, 1) == 0 ? -1.0 : 1.0;
    }
    if (!InvertRows(inverted.rows, &inverted.inverse)) continue;
    ++solved;
    Circle const circle = Solve(inverted, values);
    for (std::size_t j = 0; j < 4; ++j) {
      double const missing = std::fabs(Apply(inverted.rows[j], circle) - values[j]);
      EXPECT_LE(missing, 0x1p-50 * SizeOf(inverted.rows[j], circle));
    }
  }
  EXPECT_GT(solved, 1900);
}

}  // namespace
}  // namespace Vorn::Fewest
