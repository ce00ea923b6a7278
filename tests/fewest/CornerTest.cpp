#include <gtest/gtest.h>

#include <cstdint>

#include "geometry/fewest/Corner.h"

namespace Vorn::Fewest {
namespace {

constexpr double kTolerance = 0.02;
constexpr double kSpacing = 0.002;
constexpr std::int32_t kTip = 100;

/// Out along the x axis up to a tip at 0.2 and back.
Path FoldedPath(double spacing) {
  Path path;
  for (std::int32_t i = 0; i <= 2 * kTip; ++i) {
    std::int32_t const steps = i <= kTip ? i : 2 * kTip - i;
    path.points.push_back({spacing * steps, 0.0, kTolerance});
  }
  path.leastTolerance = kTolerance;
  return path;
}

PlacedCircle LineAlongX(double sense) { return {LineThrough({0.0, 0.0}, {sense, 0.0}), {}}; }

TEST(CornerGate, LiesAtTheTipOfADenseFold) {
  Path const path = FoldedPath(kSpacing);
  for (std::int32_t const split : {kTip - 20, kTip, kTip + 1, kTip + 20}) {
    SCOPED_TRACE(testing::Message() << "split " << split);
    Gate gate;
    ASSERT_TRUE(CornerGate(path, split, LineAlongX(1.0), LineAlongX(-1.0), &gate));
    EXPECT_TRUE(gate.isCusp);
    EXPECT_EQ(gate.split, split);
    EXPECT_EQ(gate.origin.x, path.At(kTip).x);
    EXPECT_EQ(gate.origin.y, 0.0);
    EXPECT_EQ(gate.across.x, 0.0);
    EXPECT_EQ(gate.across.y, 1.0);
    EXPECT_LT(gate.least, -kTolerance);
    EXPECT_GT(gate.greatest, kTolerance);
  }
}

TEST(CornerGate, IsNoneWhereADensePathRunsOn) {
  Path const path = FoldedPath(kSpacing);
  Gate gate;
  EXPECT_FALSE(CornerGate(path, kTip / 4, LineAlongX(1.0), LineAlongX(1.0), &gate));
  EXPECT_FALSE(CornerGate(path, kTip, LineAlongX(1.0), LineAlongX(1.0), &gate));
}

TEST(CornerGate, IsNoneFarFromTheTip) {
  Path const path = FoldedPath(kSpacing);
  Gate gate;
  EXPECT_FALSE(CornerGate(path, kTip / 4, LineAlongX(1.0), LineAlongX(-1.0), &gate));
}

TEST(CornerGate, IsNoneAtASparseFoldWhosePointsTellTheWay) {
  Path const path = FoldedPath(1.0);
  Gate gate;
  EXPECT_FALSE(CornerGate(path, kTip + 1, LineAlongX(1.0), LineAlongX(-1.0), &gate));
}

TEST(CornerGate, LiesWhereTwoLinesCross) {
  Path path;
  for (std::int32_t i = 0; i < 10; ++i) path.points.push_back({0.1 * i - 1.0, 0.0, kTolerance});
  for (std::int32_t i = 1; i <= 10; ++i) path.points.push_back({0.0, 0.1 * i, kTolerance});
  path.leastTolerance = kTolerance;
  PlacedCircle const up{LineThrough({0.0, 0.0}, {0.0, 1.0}), {}};
  Gate gate;
  ASSERT_TRUE(CornerGate(path, 10, LineAlongX(1.0), up, &gate));
  EXPECT_FALSE(gate.isCusp);
  EXPECT_NEAR(gate.origin.x, 0.0, 1e-12);
  EXPECT_NEAR(gate.origin.y, 0.0, 1e-12);
}

}  // namespace
}  // namespace Vorn::Fewest
