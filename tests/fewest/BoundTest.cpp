#include <gtest/gtest.h>

#include <cmath>

#include "geometry/fewest/Bound.h"
#include "support/Profiles.h"

namespace Vorn::Fewest {
namespace {

std::size_t Bound(std::vector<WPoint> const& points) {
  return CoverGreedily(points, Limits(), [](std::int32_t) {}).starts.size();
}

TEST(CoverGreedily, OneLineAndOneArcAreOneRunEach) {
  EXPECT_EQ(Bound(Testing::MakeLinePoints({0.0, 0.0}, 1.0, 0.5, 1000, 0.01)), 1u);
  EXPECT_EQ(Bound(Testing::MakeArcPoints({3.0, 4.0}, 10.0, 0.2, 5.0, 1000, 0.001)), 1u);
}

TEST(CoverGreedily, ThreePointsAreOneRun) {
  EXPECT_EQ(Bound({{0.0, 0.0, 1e-6}, {1.0, 0.0, 1e-6}, {0.3, 2.0, 1e-6}}), 1u);
}

TEST(CoverGreedily, ASquareOfLongSidesHasFourRuns) {
  std::vector<WPoint> points;
  for (int i = 0; i < 10; ++i) points.push_back({0.1 * i, 0.0, 1e-3});
  for (int i = 0; i < 10; ++i) points.push_back({1.0, 0.1 * i, 1e-3});
  for (int i = 0; i < 10; ++i) points.push_back({1.0 - 0.1 * i, 1.0, 1e-3});
  for (int i = 0; i < 10; ++i) points.push_back({0.0, 1.0 - 0.1 * i, 1e-3});
  EXPECT_EQ(Bound(points), 4u);
}

TEST(CoverGreedily, TellsOfEveryRunAndAtTheEndOfAllPoints) {
  std::vector<std::int32_t> told;
  auto const points = Testing::MakeLinePoints({0.0, 0.0}, 1.0, 0.5, 50, 0.01);
  CoverGreedily(points, Limits(), [&](std::int32_t done) { told.push_back(done); });
  EXPECT_EQ(told, (std::vector<std::int32_t>{50}));
}

TEST(CoverGreedily, SegmentsOnlyCoversAnArcByChords) {
  // A chord of sweep s leaves a band of R (1 - cos(s / 2)), which two tolerances may fill.
  Limits limits;
  limits.segmentsOnly = true;
  auto const points = Testing::MakeArcPoints({0.0, 0.0}, 1.0, 0.0, 1.5, 3001, 0.01);
  double const sweep = 2.0 * std::acos((1.0 - 0.01) / (1.0 + 0.01));
  auto const cover = CoverGreedily(points, limits, [](std::int32_t) {});
  EXPECT_EQ(cover.starts.size(), static_cast<std::size_t>(std::ceil(1.5 / sweep)));
}

}  // namespace
}  // namespace Vorn::Fewest
