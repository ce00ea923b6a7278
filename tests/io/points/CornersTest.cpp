#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <numbers>
#include <random>

#include "vorn/io/Corners.h"

namespace Vorn::IO {
namespace {

TEST(FindCorners, NamesPointDegreesAndSide) {
  std::vector<Corner> const corners = FindCorners(
      {{0, 0, 0}, {1, 0, 0}, {2, 0, 0}, {2, 1, 0}, {2, 2, 0}, {3, 3, 0}, {4, 4, 0}}, 0.0);
  ASSERT_EQ(corners.size(), 2u);
  EXPECT_EQ(corners[0].point, 2u);
  EXPECT_NEAR(corners[0].degrees, 90.0, 1e-12);
  EXPECT_TRUE(corners[0].isLeft);
  EXPECT_FALSE(corners[0].IsReversal());
  EXPECT_EQ(corners[1].point, 4u);
  EXPECT_NEAR(corners[1].degrees, 45.0, 1e-12);
  EXPECT_FALSE(corners[1].isLeft);
}

TEST(FindCorners, BeginWithThirtyDegrees) {
  auto const count = [](double degrees) {
    double const turn = degrees * std::numbers::pi / 180.0;
    return FindCorners({{-1, 0, 0}, {0, 0, 0}, {std::cos(turn), std::sin(turn), 0}}, 0.0).size();
  };
  EXPECT_EQ(count(29.999), 0u);
  EXPECT_EQ(count(30.001), 1u);
}

TEST(FindCorners, GoingBackIsAReversal) {
  std::vector<Corner> const corners =
      FindCorners({{0, 0, 0}, {1, 0, 0}, {2, 0, 0}, {1, 0.1, 0}, {0, 0.2, 0}}, 0.0);
  ASSERT_EQ(corners.size(), 1u);
  EXPECT_EQ(corners[0].point, 2u);
  EXPECT_TRUE(corners[0].IsReversal());
}

TEST(FindCorners, PointsInOnePlaceCountOnce) {
  std::vector<Corner> const corners =
      FindCorners({{0, 0, 0}, {1, 0, 0}, {1, 0, 0}, {1, 0, 0}, {1, 1, 0}}, 0.0);
  ASSERT_EQ(corners.size(), 1u);
  EXPECT_EQ(corners[0].point, 1u);
  EXPECT_NEAR(corners[0].degrees, 90.0, 1e-12);
}

TEST(FindCorners, FewOrCoincidingPointsHaveNone) {
  EXPECT_TRUE(FindCorners({{0, 0, 0}, {1, 0, 0}}, 0.0).empty());
  EXPECT_TRUE(FindCorners(std::vector<WPoint>(50, WPoint{3, 4, 0}), 0.0).empty());
  EXPECT_TRUE(FindCorners({{0, 0, 0}, {1, 0, 0}, {1, 1, 0}}, 5.0).empty()) << "beyond the reach";
}

/// Round a square of side 4 with a step of 1, from any place.
std::vector<WPoint> Square(std::size_t start, bool repeatsFirst) {
  std::vector<WPoint> round;
  for (double i = 0; i < 4; ++i) round.push_back({i, 0, 0});
  for (double i = 0; i < 4; ++i) round.push_back({4, i, 0});
  for (double i = 0; i < 4; ++i) round.push_back({4 - i, 4, 0});
  for (double i = 0; i < 4; ++i) round.push_back({0, 4 - i, 0});
  std::rotate(round.begin(), round.begin() + static_cast<std::ptrdiff_t>(start), round.end());
  if (repeatsFirst) round.push_back(WPoint(round.front()));
  return round;
}

TEST(FindCorners, OfAClosedPathCountTheOneAtTheSeam) {
  for (std::size_t start = 0; start < 16; ++start) {
    for (bool const repeatsFirst : {false, true}) {
      for (double const reach : {0.0, 1.0, 1.5}) {
        std::vector<Corner> const corners = FindCorners(Square(start, repeatsFirst), reach, true);
        ASSERT_EQ(corners.size(), 4u) << start << ", reach " << reach;
        for (std::size_t i = 0; i < 4; ++i) {
          EXPECT_EQ(corners[i].point, (16 - start) % 4 + 4 * i) << start << ", reach " << reach;
          EXPECT_NEAR(corners[i].degrees, 90.0, 1e-12);
          EXPECT_TRUE(corners[i].isLeft);
        }
      }
    }
  }
  EXPECT_EQ(FindCorners(Square(0, true), 0.0).size(), 3u) << "an open path has none at its ends";
}

TEST(FindCorners, OfAClosedPathEndWhereTwoReachesGoAllTheWayRound) {
  EXPECT_TRUE(FindCorners(Square(0, false), 8.0, true).empty());
  EXPECT_TRUE(FindCorners(std::vector<WPoint>(50, WPoint{3, 4, 0}), 0.0, true).empty());
  EXPECT_TRUE(FindCorners({{0, 0, 0}, {0, 0, 0}}, 0.0, true).empty());
}

/// Along x, then up, `perSide` points a unit each way.
std::vector<WPoint> NoisyCorner(int perUnit, double sigma, std::uint64_t seed) {
  std::mt19937_64 engine(seed);
  std::normal_distribution<double> noise(0.0, sigma);
  std::vector<WPoint> points;
  int const count = 20 * perUnit;
  for (int i = 0; i <= 2 * count; ++i) {
    double const place = static_cast<double>(i) / perUnit;
    points.push_back(
        {std::min(place, 20.0) + noise(engine), std::max(place - 20.0, 0.0) + noise(engine), 0.0});
  }
  return points;
}

TEST(FindCorners, NoiseMakesNoneAndHidesNone) {
  constexpr double kSigma = 0.02;
  for (std::uint64_t seed = 1; seed <= 20; ++seed) {
    // Ten points in the reach, whose neighbours jump by more than their spacing.
    std::vector<WPoint> const points = NoisyCorner(20, kSigma, seed);
    std::vector<Corner> const corners = FindCorners(points, ReachForNoise(kSigma));
    ASSERT_EQ(corners.size(), 1u) << "seed " << seed;
    EXPECT_NEAR(static_cast<double>(corners[0].point), 400.0, 3.0) << "seed " << seed;
    EXPECT_NEAR(corners[0].degrees, 90.0, 25.0) << "seed " << seed;
    EXPECT_GT(FindCorners(points, 0.0).size(), 10u) << "without a reach noise does make corners";
  }
}

}  // namespace
}  // namespace Vorn::IO
