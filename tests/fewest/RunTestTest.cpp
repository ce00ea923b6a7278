#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "geometry/fewest/RunTest.h"
#include "support/RandomGeometry.h"
#include "support/fewest/Programmes.h"

namespace Vorn::Fewest {
namespace {

using Testing::ProgrammeOf;
using Testing::RandomGeometry;

/// The corners of a square of side 2 and its middle.
Columns SquareWithMiddle(double tolerance) {
  Columns columns;
  for (double x : {-1.0, 1.0}) {
    for (double y : {-1.0, 1.0}) columns.Append({x, y, tolerance});
  }
  columns.Append({0.0, 0.0, tolerance});
  return columns;
}

TEST(ProveRun, ASquareWithItsMiddleNeedsTheGoldenRatioLessOne) {
  // The best circle has its centre on the middle of a side: the nearest points are at 1, the
  // farthest at the root of 5, and half of the difference is what the tolerance has to be.
  double const least = 0.5 * (std::sqrt(5.0) - 1.0);
  Simplex simplex(1e-10);
  Polytope polytope;
  Columns const narrow = SquareWithMiddle(least - 1e-6);
  Columns const wide = SquareWithMiddle(least + 1e-6);
  EXPECT_FALSE(ProveRun(ProgrammeOf(narrow), Basis(), &simplex, &polytope).isFound);
  EXPECT_TRUE(ProveRun(ProgrammeOf(wide), Basis(), &simplex, &polytope).isFound);
}

TEST(ProveRun, FindsTheCircleThatWasDisturbedByLessThanTheTolerance) {
  RandomGeometry random(11);
  Simplex simplex(1e-10);
  Polytope polytope;
  for (int trial = 0; trial < 300; ++trial) {
    Columns columns;
    double const radius = random.Uniform(0.5, 20.0);
    double const start = random.Uniform(-3.0, 3.0);
    double const sweep = random.Uniform(0.1, 6.0);
    int const count = random.Integer(4, 12);
    for (int i = 0; i < count; ++i) {
      double const angle = start + sweep * i / count;
      double const r = radius + 0.01 * random.Uniform(-0.99, 0.99);
      columns.Append({r * std::cos(angle), r * std::sin(angle), 0.01});
    }
    RunFit const fit = ProveRun(ProgrammeOf(columns), Basis(), &simplex, &polytope);
    ASSERT_TRUE(fit.isFound) << "trial " << trial;
    ASSERT_LE(fit.ratio, 1.0 + 1e-9) << "trial " << trial;
  }
}

TEST(ProveRun, AgreesWithTheSearchWhereTheSearchFinds) {
  RandomGeometry random(12);
  Simplex simplex(1e-10);
  Polytope polytope;
  int found = 0;
  int refused = 0;
  for (int trial = 0; trial < 2000; ++trial) {
    Columns columns;
    int const count = random.Integer(4, 9);
    double const w = random.Uniform(0.01, 0.5);
    for (int i = 0; i < count; ++i) {
      columns.Append({random.Uniform(-1.0, 1.0), random.Uniform(-1.0, 1.0), w});
    }
    Basis basis;
    RunFit const search =
        FitRun(ProgrammeOf(columns), {{0.0, 0.0, 1.0, 0.0}, 0.0, false}, false, &simplex, &basis);
    RunFit const proof = ProveRun(ProgrammeOf(columns), basis, &simplex, &polytope);
    if (search.isFound && search.ratio <= 1.0) {
      ++found;
      ASSERT_TRUE(proof.isFound) << "trial " << trial;
    }
    if (!proof.isFound) ++refused;
  }
  EXPECT_GT(found, 200);
  EXPECT_GT(refused, 200);
}

TEST(FitRun, TheRatioIsWhatTheRowsSay) {
  RandomGeometry random(13);
  Simplex simplex(1e-10);
  for (int trial = 0; trial < 300; ++trial) {
    Columns columns;
    for (int i = 0; i < 30; ++i) {
      double const x = 0.1 * i - 1.5;
      columns.Append({x, 0.2 * x * x + random.Uniform(-0.01, 0.01), 0.01});
    }
    Basis basis;
    RunFit const fit =
        FitRun(ProgrammeOf(columns), {{0.0, 0.0, 1.0, 0.0}, 0.0, false}, false, &simplex, &basis);
    ASSERT_TRUE(fit.isFound);
    double const largest = columns.FindWorst(0, 30, fit.circle).value;
    ASSERT_NEAR(fit.ratio, largest, 1e-6);
    ASSERT_NEAR(Form(fit.circle, fit.circle), 1.0, 1e-9);
  }
}

}  // namespace
}  // namespace Vorn::Fewest
