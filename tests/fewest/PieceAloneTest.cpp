#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <numbers>

#include "geometry/fewest/PieceSearch.h"

// Circles of points alone.

namespace Vorn::Fewest {
namespace {

constexpr double kTolerance = 0.01;

/// Points along an arc of the unit circle from (1, 0) on, counter-clockwise where `turn` is above
/// 0.
Path UnitArc(double turn, std::int32_t count) {
  Path path;
  for (std::int32_t i = 0; i < count; ++i) {
    double const angle = turn * i / (count - 1);
    path.points.push_back({std::cos(angle), std::sin(angle), kTolerance});
  }
  path.leastTolerance = kTolerance;
  return path;
}

TEST(FitAlone, RunsAlongThePointsHoweverFarTheyTurn) {
  for (double const degrees : {20.0, 90.0, 170.0, 190.0, 270.0, 340.0}) {
    for (double const sense : {1.0, -1.0}) {
      for (std::int32_t const count : {20, 4000}) {
        SCOPED_TRACE(testing::Message() << sense * degrees << " degrees, " << count << " points");
        Path const path = UnitArc(sense * degrees / 180.0 * std::numbers::pi, count);
        PieceSearch search(path, 1.0);
        search.MoveTo(0, count);
        PieceFit const fit = search.FitAlone(0, count);
        ASSERT_TRUE(fit.isFound);
        EXPECT_LT(fit.ratio, 1e-3);
        EXPECT_GT(AdvanceAlong(path, fit.circle, 0, count, 1), 0.0);
      }
    }
  }
}

TEST(AdvanceAlong, IsTheLengthForPointsOnALine) {
  Path path;
  for (std::int32_t i = 0; i < 10; ++i) path.points.push_back({0.5 * i, 2.0, kTolerance});
  PlacedCircle const line{LineThrough({0.0, 0.0}, {1.0, 0.0}), {0.0, 2.0}};
  for (std::int32_t const step : {1, 2, 4, 100}) {
    EXPECT_EQ(AdvanceAlong(path, line, 0, 10, step), 4.5);
    EXPECT_EQ(AdvanceAlong(path, Scaled(line, -1.0), 2, 9, step), -3.0);
  }
  EXPECT_EQ(AdvanceAlong(path, line, 3, 4, 1), 0.0);
  EXPECT_EQ(AdvanceAlong(path, line, 3, 3, 1), 0.0);
}

}  // namespace
}  // namespace Vorn::Fewest
