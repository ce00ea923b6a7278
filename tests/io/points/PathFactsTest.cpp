#include <gtest/gtest.h>

#include <cmath>

#include "vorn/io/PathFacts.h"

namespace Vorn::IO {
namespace {

std::vector<WPoint> OnAxis(std::vector<double> const& x) {
  std::vector<WPoint> points;
  for (double const value : x) points.push_back({value, 0.0, 0.0});
  return points;
}

TEST(BoxOf, HoldsEveryPoint) {
  PointsBox const box = BoxOf({{1, -2, 0}, {-3, 5, 0}, {0, 0, 0}});
  EXPECT_EQ(box.lowX, -3.0);
  EXPECT_EQ(box.highX, 1.0);
  EXPECT_EQ(box.lowY, -2.0);
  EXPECT_EQ(box.highY, 5.0);
  EXPECT_EQ(BoxOf({{0, 0, 0}, {3, 4, 0}}).Diagonal(), 5.0);
}

TEST(SpacingOf, NamesTheFirstOfSeveralExtremes) {
  SpacingFacts const facts = SpacingOf(OnAxis({0, 3, 4, 7, 8, 10}));
  EXPECT_EQ(facts.least, 1.0);
  EXPECT_EQ(facts.leastSecond, 2u);
  EXPECT_EQ(facts.most, 3.0);
  EXPECT_EQ(facts.mostSecond, 1u);
  EXPECT_EQ(facts.median, 2.0);
  EXPECT_EQ(facts.length, 10.0);
}

TEST(SpacingOf, MedianOfAnEvenNumberIsTheMeanOfTheMiddleTwo) {
  EXPECT_EQ(SpacingOf(OnAxis({0, 1, 5, 7, 15})).median, 3.0);
  EXPECT_EQ(SpacingOf(OnAxis({0, 7})).median, 7.0);
}

TEST(FindDuplicates, TellsNeighboursFromReturns) {
  std::vector<WPoint> const points = {{0, 0, 0}, {1, 0, 0}, {1, 0, 0}, {0, 1, 0},
                                      {0, 0, 0}, {1, 0, 0}, {0, 0, 0}};
  std::vector<Duplicate> const duplicates = FindDuplicates(points);
  ASSERT_EQ(duplicates.size(), 4u);
  EXPECT_EQ(duplicates[0].later, 2u);
  EXPECT_EQ(duplicates[0].earlier, 1u);
  EXPECT_TRUE(duplicates[0].areNeighbours);
  EXPECT_EQ(duplicates[1].later, 4u);
  EXPECT_EQ(duplicates[1].earlier, 0u);
  EXPECT_FALSE(duplicates[1].areNeighbours);
  EXPECT_EQ(duplicates[2].later, 5u);
  EXPECT_EQ(duplicates[2].earlier, 1u);
  EXPECT_FALSE(duplicates[2].areNeighbours);
  EXPECT_EQ(duplicates[3].later, 6u);
  EXPECT_EQ(duplicates[3].earlier, 0u);
}

TEST(FindDuplicates, TakesBothZerosForOnePlaceAndNothingElse) {
  EXPECT_EQ(FindDuplicates({{0.0, 1, 0}, {5, 5, 0}, {-0.0, 1, 0}}).size(), 1u);
  double const near = std::nextafter(1.0, 2.0);
  EXPECT_TRUE(FindDuplicates({{1, 1, 0}, {near, 1, 0}, {1, near, 0}}).empty());
}

}  // namespace
}  // namespace Vorn::IO
