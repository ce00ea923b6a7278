#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "geometry/fewest/BareRun.h"

namespace Vorn::Fewest {
namespace {

/// Points along x whose tolerances are 0.01: gaps above 0.16 are wide.
Path PathAt(std::vector<double> const& places) {
  Path path;
  for (double const x : places) path.points.push_back({x, 0.0, 0.01});
  return path;
}

double RadiusOver(double gap) { return 0.5 * gap / std::sin(4.0 / 180.0 * std::numbers::pi); }

TEST(LeastRadiusOfBareRun, TurnsByEightDegreesFromOnePointToTheOther) {
  Path const path = PathAt({0, 1, 11, 12});
  EXPECT_NEAR(LeastRadiusOfBareRun(path, 1, 3), RadiusOver(10.0), 1e-12);
  EXPECT_NEAR(LeastRadiusOfBareRun(path, 0, 2), RadiusOver(1.0), 1e-12);
}

TEST(LeastRadiusOfBareRun, OfOnePointCountsTheWiderGapBesideIt) {
  Path const path = PathAt({0, 1, 11, 12});
  EXPECT_NEAR(LeastRadiusOfBareRun(path, 1, 2), RadiusOver(10.0), 1e-12);
  EXPECT_NEAR(LeastRadiusOfBareRun(path, 0, 1), RadiusOver(1.0), 1e-12);
  EXPECT_NEAR(LeastRadiusOfBareRun(path, 3, 4), RadiusOver(1.0), 1e-12);
}

TEST(LeastRadiusOfBareRun, IsNoneForMorePointsOrNarrowGaps) {
  Path const path = PathAt({0, 1, 11, 11.1, 12});
  EXPECT_EQ(LeastRadiusOfBareRun(path, 0, 3), 0.0);
  EXPECT_EQ(LeastRadiusOfBareRun(path, 1, 1), 0.0) << "no points";
  EXPECT_EQ(LeastRadiusOfBareRun(path, 2, 4), 0.0) << "a gap of 0.1";
  EXPECT_EQ(LeastRadiusOfBareRun(path, 2, 3), 0.0) << "a point with such a gap on one side";
}

}  // namespace
}  // namespace Vorn::Fewest
