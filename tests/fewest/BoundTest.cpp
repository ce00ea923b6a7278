#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "fewest/oracle/BoundOracle.h"
#include "geometry/fewest/Bound.h"
#include "geometry/fewest/ClosedBound.h"
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

TEST(CoverGreedily, PointsOfWhichNoFourLieOnACircleAreCoveredByThrees) {
  std::vector<WPoint> points;
  for (int i = 0; i < 40; ++i) {
    points.push_back({1.0 * i, 0.25 * (i * i * i % 11), 1e-6});
    EXPECT_EQ(Bound(points), (points.size() + 2) / 3);
  }
}

TEST(CoverGreedily, ASquareOfLongSidesHasFourRuns) {
  std::vector<WPoint> points;
  for (int i = 0; i < 10; ++i) points.push_back({0.1 * i, 0.0, 1e-3});
  for (int i = 0; i < 10; ++i) points.push_back({1.0, 0.1 * i, 1e-3});
  for (int i = 0; i < 10; ++i) points.push_back({1.0 - 0.1 * i, 1.0, 1e-3});
  for (int i = 0; i < 10; ++i) points.push_back({0.0, 1.0 - 0.1 * i, 1e-3});
  EXPECT_EQ(Bound(points), 4u);
}

TEST(CoverWithin, IsTheGreedyCoverOrEmptyWhereMoreRunsAreNeeded) {
  auto const arc = Testing::MakeArcPoints({3.0, 4.0}, 10.0, 0.2, 5.0, 1000, 0.01);
  Limits limits;
  limits.segmentsOnly = true;
  auto const least = CoverGreedily(arc, limits, [](std::int32_t) {}).starts;
  EXPECT_EQ(CoverWithin(least.size(), arc, limits).starts, least);
  EXPECT_EQ(CoverWithin(2 * least.size(), arc, limits).starts, least);
  EXPECT_TRUE(CoverWithin(least.size() - 1, arc, limits).starts.empty());
  EXPECT_TRUE(CoverWithin(0, arc, limits).starts.empty());
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

std::size_t ClosedBound(std::vector<WPoint> const& points) {
  Cover const open = CoverGreedily(points, Limits(), [](std::int32_t) {});
  return LeastClosedCover(points, Limits(), open);
}

/// The least number of runs over all starts, and over all divisions from each.
std::size_t LeastOfAllStarts(std::vector<WPoint> points) {
  std::int32_t least = Testing::LeastNumberOfRuns(points);
  for (std::size_t start = 1; start < points.size(); ++start) {
    std::rotate(points.begin(), points.begin() + 1, points.end());
    least = std::min(least, Testing::LeastNumberOfRuns(points));
  }
  return std::max<std::size_t>(static_cast<std::size_t>(least), kLeastClosedPieces);
}

TEST(LeastClosedCover, OneCircleAndTwoRunsAreTwoPieces) {
  auto const circle = Testing::MakeArcPoints({3.0, 4.0}, 10.0, 0.2, 6.0, 100, 0.001);
  EXPECT_EQ(ClosedBound(circle), 2u);
  EXPECT_EQ(ClosedBound({{0.0, 0.0, 0.1}, {1.0, 0.0, 0.1}}), 2u);
}

TEST(LeastClosedCover, ASquareThatBeginsWithinASideHasFourRuns) {
  std::vector<WPoint> points;
  for (int i = 0; i < 10; ++i) points.push_back({0.1 * i, 0.0, 1e-3});
  for (int i = 0; i < 10; ++i) points.push_back({1.0, 0.1 * i, 1e-3});
  for (int i = 0; i < 10; ++i) points.push_back({1.0 - 0.1 * i, 1.0, 1e-3});
  for (int i = 0; i < 10; ++i) points.push_back({0.0, 1.0 - 0.1 * i, 1e-3});
  std::rotate(points.begin(), points.begin() + 5, points.end());
  EXPECT_EQ(Bound(points), 5u);
  EXPECT_EQ(ClosedBound(points), 4u);
}

TEST(LeastClosedCover, IsTheLeastOfAllStartsAndDivisions) {
  Testing::RandomGeometry random(8201);
  int below = 0;
  for (int round = 0; round < 120; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 8201, round " << round);
    int const count = random.Integer(5, 13);
    double const w = random.Uniform(0.02, 0.3);
    std::vector<WPoint> points;
    for (int i = 0; i < count; ++i) {
      double const angle = 6.283185307179586 * i / count;
      double const radius = random.Uniform(0.7, 1.3);
      points.push_back({radius * std::cos(angle), radius * std::sin(angle), w});
    }
    EXPECT_EQ(ClosedBound(points), LeastOfAllStarts(points));
    below += ClosedBound(points) < Bound(points) ? 1 : 0;
  }
  EXPECT_GT(below, 10) << "cases in which the start matters";
}

}  // namespace
}  // namespace Vorn::Fewest
