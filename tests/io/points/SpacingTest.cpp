#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "vorn/io/Spacing.h"

namespace Vorn::IO {
namespace {

std::vector<WPoint> OnAxis(std::vector<double> const& x, double w) {
  std::vector<WPoint> points;
  for (double const value : x) points.push_back({value, 0.0, w});
  return points;
}

TEST(FindClosePair, TouchingTheLimitIsTooClose) {
  // 1.5 * (1 + 1) = 3, and the distance must be above it.
  EXPECT_TRUE(FindClosePair(OnAxis({0.0, 3.0}, 1.0)).has_value());
  EXPECT_FALSE(FindClosePair(OnAxis({0.0, std::nextafter(3.0, 4.0)}, 1.0)).has_value());
  EXPECT_TRUE(FindClosePair(OnAxis({0.0, std::nextafter(3.0, 2.0)}, 1.0)).has_value());
}

TEST(FindClosePair, NamesTheFirstPairAndWhatItNeeds) {
  std::vector<WPoint> const points = {{0, 0, 1}, {10, 0, 1}, {13, 4, 3}, {13, 5, 1}};
  std::optional<ClosePair> const pair = FindClosePair(points);
  ASSERT_TRUE(pair.has_value());
  EXPECT_EQ(pair->first, 1u);
  EXPECT_EQ(pair->second, 2u);
  EXPECT_EQ(pair->distance, 5.0);
  EXPECT_EQ(pair->needed, 6.0);
}

bool Passes(std::vector<WPoint> points, double w) {
  for (WPoint& point : points) point.w = w;
  return !FindClosePair(points).has_value();
}

TEST(LargestSingleTolerance, PassesAndTheNextDigitUpDoesNot) {
  constexpr std::uint64_t kSeed = 11;
  SCOPED_TRACE(kSeed);
  std::mt19937_64 engine(kSeed);
  for (int round = 0; round < 500; ++round) {
    double const scale = std::pow(10.0, static_cast<double>(engine() % 13) - 6.0);
    double const gap = scale * (1.0 + static_cast<double>(engine() % 900000) / 100000.0);
    std::vector<WPoint> const points = OnAxis({0.0, 20.0 * gap, 21.0 * gap, 41.0 * gap}, 1.0);
    std::optional<double> const largest = LargestSingleTolerance(points);
    ASSERT_TRUE(largest.has_value()) << gap;
    EXPECT_TRUE(Passes(points, *largest)) << gap;
    EXPECT_FALSE(Passes(points, *largest * (1.0 + 2e-5))) << gap;
  }
}

TEST(LargestSingleTolerance, StaysBelowALimitOfFewDigits) {
  // A spacing of 3 allows less than 1; six digits then end at 0.99999.
  std::optional<double> const largest = LargestSingleTolerance(OnAxis({0.0, 3.0, 6.0}, 5.0));
  ASSERT_TRUE(largest.has_value());
  EXPECT_LT(*largest, 1.0);
  EXPECT_GT(*largest, 0.99998);
}

TEST(LargestSingleTolerance, CoincidingNeighboursAllowNone) {
  EXPECT_FALSE(LargestSingleTolerance(OnAxis({0.0, 1.0, 1.0, 2.0}, 1.0)).has_value());
}

TEST(DescribeClosePair, SaysWhichPairAndTheToleranceThatPasses) {
  PointFile file;
  file.path = "part.csv";
  file.points = OnAxis({0.0, 1.0, 1.5}, 0.25);
  file.lines = {2, 3, 5};
  std::optional<ClosePair> const pair = FindClosePair(file.points);
  ASSERT_TRUE(pair.has_value());
  EXPECT_EQ(DescribeClosePair(file, *pair, LargestSingleTolerance(file.points)),
            "point 1 (line 3) and point 2 (line 5) are too close: distance 0.5, needed "
            "more than 0.75 (1.5 times the sum of their tolerances)\n"
            "the largest single tolerance that would pass for this file is 0.166666");
}

TEST(DescribeClosePair, CoincidingPointsHaveNoTolerance) {
  PointFile file;
  file.path = "part.csv";
  file.points = OnAxis({0.0, 0.0}, 0.25);
  file.lines = {1, 2};
  std::optional<ClosePair> const pair = FindClosePair(file.points);
  ASSERT_TRUE(pair.has_value());
  EXPECT_EQ(DescribeClosePair(file, *pair, LargestSingleTolerance(file.points)),
            "point 0 (line 1) and point 1 (line 2) are too close: distance 0, needed "
            "more than 0.75 (1.5 times the sum of their tolerances)\n"
            "no tolerance would pass: neighbours in this file coincide");
}

}  // namespace
}  // namespace Vorn::IO
