#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "vorn/io/Thinning.h"

namespace Vorn::IO {
namespace {

std::vector<WPoint> Line(int count, double step) {
  std::vector<WPoint> points;
  for (int i = 0; i < count; ++i) points.push_back({i * step, 0.0, 0.0});
  return points;
}

TEST(KeepEvery, KeepsFirstAndLastAndOneEverySpacing) {
  EXPECT_EQ(KeepEvery(Line(11, 1.0), 3.0), (std::vector<std::size_t>{0, 3, 6, 9, 10}));
  EXPECT_EQ(KeepEvery(Line(3, 1.0), 100.0), (std::vector<std::size_t>{0, 2}));
  EXPECT_EQ(KeepEvery(Line(1, 1.0), 1.0), (std::vector<std::size_t>{0}));
}

TEST(KeepEvery, MeasuresAlongThePath) {
  // Back and forth: two apart along the path, in one place across it.
  EXPECT_EQ(KeepEvery({{0, 0, 0}, {1, 0, 0}, {0, 0, 0}, {1, 0, 0}, {0, 0, 0}}, 2.0),
            (std::vector<std::size_t>{0, 2, 4}));
}

TEST(AverageAlong, IsTheMeanOfEachWindow) {
  // After the first point, windows of the points at 1 and 2, 3 and 4, then the last alone.
  Averages const averages =
      AverageAlong({{0, 0, 0}, {1, 1, 0}, {2, -1, 0}, {3, 2, 0}, {4, 0, 0}, {9, 0, 0}}, 3.5);
  ASSERT_GE(averages.points.size(), 3u);
  EXPECT_EQ(averages.points.front().x, 0.0);
  EXPECT_EQ(averages.points.back().x, 9.0);
  EXPECT_EQ(averages.points[1].x, 1.0);
}

TEST(AverageAlong, TellsTheStandardDeviationAcross) {
  // One window of a zigzag of height 1 about a level line: the deviation is 1.
  std::vector<WPoint> points = {{0, 0, 0}};
  for (int i = 1; i <= 1000; ++i) points.push_back({i * 10.0, i % 2 == 0 ? 1.0 : -1.0, 0});
  points.push_back({10010, 0, 0});
  Averages const averages = AverageAlong(points, 1e9);
  ASSERT_EQ(averages.points.size(), 3u);
  EXPECT_NEAR(averages.meanDeviation, 1.0, 1e-3);
  EXPECT_EQ(averages.fewest, 1000u);
  EXPECT_EQ(averages.most, 1000u);
}

TEST(AverageAlong, KeepsItsDigitsFarFromTheOrigin) {
  std::vector<WPoint> points;
  for (int i = 0; i <= 100; ++i) points.push_back({1e9 + i, 1e9 + (i % 2) * 0.5, 0});
  Averages const averages = AverageAlong(points, 50.0);
  EXPECT_LT(averages.largestDeviation, 0.26);
  EXPECT_GT(averages.largestDeviation, 0.24);
}

TEST(FindOutliers, FindsTheOneThatSticksOut) {
  std::mt19937 random(7);
  std::normal_distribution<double> noise(0.0, 0.01);
  std::vector<WPoint> points;
  for (int i = 0; i < 200; ++i) points.push_back({i * 1.0, noise(random), 0});
  points[120].y = 1.0;
  std::vector<Outlier> const outliers = FindOutliers(points, 15.0);
  ASSERT_EQ(outliers.size(), 1u);
  EXPECT_EQ(outliers[0].point, 120u);
  EXPECT_NEAR(outliers[0].distance, 1.0, 0.1);
}

TEST(FindOutliers, CornersAndArcsAreNone) {
  std::mt19937 random(11);
  std::normal_distribution<double> noise(0.0, 1e-4);
  std::vector<WPoint> points;
  for (int i = 0; i < 50; ++i) points.push_back({i * 0.1, noise(random), 0});
  for (int i = 0; i < 50; ++i) points.push_back({5.0 + noise(random), i * 0.1, 0});
  for (int i = 0; i < 200; ++i) {
    double const angle = i * 0.01;
    points.push_back({5.0 - 10.0 * (1.0 - std::cos(angle)), 5.0 + 10.0 * std::sin(angle), 0});
    points.back().x += noise(random);
  }
  EXPECT_TRUE(FindOutliers(points, 15.0).empty());
}

TEST(FindOutliers, ExactPointsAndFewPointsHaveNone) {
  EXPECT_TRUE(FindOutliers(Line(100, 1.0), 3.0).empty());
  EXPECT_TRUE(FindOutliers({{0, 0, 0}, {1, 9, 0}, {2, 0, 0}}, 1.0).empty());
  EXPECT_TRUE(FindOutliers({}, 1.0).empty());
  EXPECT_TRUE(FindOutliers(std::vector<WPoint>(20, WPoint{1, 1, 0}), 1.0).empty());
}

}  // namespace
}  // namespace Vorn::IO
