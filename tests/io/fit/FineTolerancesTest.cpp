#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>
#include <vector>

#include "io/Contours.h"
#include "vorn/io/FineTolerances.h"
#include "vorn/io/FitContour.h"

namespace Vorn::IO {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

/// Points 1 apart along (0.8, 0.6).
std::vector<WPoint> Line(int count, double tolerance) {
  std::vector<WPoint> points;
  for (int i = 0; i < count; ++i) points.push_back({0.8 * i, 0.6 * i, tolerance});
  return points;
}

TEST(FindFineTolerance, IsBelowAHundredMillionthOfTheExtent) {
  double const limit = 1e-8 * 200.0;
  EXPECT_FALSE(FindFineTolerance({{0, 0, limit}, {200, 10, limit}}));
  EXPECT_TRUE(FindFineTolerance({{0, 0, limit}, {200, 10, std::nextafter(limit, 0.0)}}));
}

TEST(FindFineTolerance, NamesTheFirstOfTheSmallestTolerancesAndTheLongerSide) {
  std::vector<WPoint> const points = {{-1, 5, 1e-6}, {3, -5, 1e-9}, {2, 2, 1e-9}};
  auto const fine = FindFineTolerance(points);
  ASSERT_TRUE(fine);
  EXPECT_EQ(fine->point, 1u);
  EXPECT_EQ(fine->extent, 10.0);
}

TEST(FindFineTolerance, PointsWithoutExtentHaveNone) {
  EXPECT_FALSE(FindFineTolerance({}));
  EXPECT_FALSE(FindFineTolerance({{3, 4, 1e-300}}));
  EXPECT_FALSE(FindFineTolerance({{3, 4, 0.0}, {3, 4, 0.0}}));
}

TEST(FindFineTolerance, NumbersThatAreNoneAreNotFine) {
  EXPECT_FALSE(FindFineTolerance({{kNaN, kNaN, 1e-9}, {kNaN, kNaN, 1e-9}}));
  EXPECT_FALSE(FindFineTolerance({{0, 0, kNaN}, {10, 0, kNaN}}));
}

TEST(SuffersFromFineTolerances, OnlyTheStrategiesWithCells) {
  EXPECT_TRUE(SuffersFromFineTolerances(Strategy::Mixed));
  EXPECT_TRUE(SuffersFromFineTolerances(Strategy::Cells));
  EXPECT_FALSE(SuffersFromFineTolerances(Strategy::Arc));
  EXPECT_FALSE(SuffersFromFineTolerances(Strategy::Fewest));
}

/// How often a fit of 40 points warns.
int CountWarnings(Strategy strategy, double tolerance) {
  int warnings = 0;
  FitChoice choice;
  choice.strategy = strategy;
  choice.tolerance.same = tolerance;
  choice.warnOfFineTolerance = [&](PointFile const& file, FineTolerance const& fine) {
    ++warnings;
    EXPECT_EQ(file.points[fine.point].w, tolerance);
  };
  FitContour(Contours::FileWith(Line(40, 0.0)), choice, nullptr);
  return warnings;
}

TEST(FitContour, WarnsOnceOfAFineToleranceWhereTheStrategySuffers) {
  EXPECT_EQ(CountWarnings(Strategy::Mixed, 1e-9), 1);
  EXPECT_EQ(CountWarnings(Strategy::Mixed, 1e-3), 0);
  EXPECT_EQ(CountWarnings(Strategy::Fewest, 1e-9), 0);
}

TEST(FitContour, ThePointsOfAFineToleranceAreOnePieceOfTheFewest) {
  FitChoice choice;
  choice.strategy = Strategy::Fewest;
  choice.tolerance.same = 1e-9;
  EXPECT_EQ(FitContour(Contours::FileWith(Line(1000, 0.0)), choice, nullptr).pieces.size(), 1u);
}

}  // namespace
}  // namespace Vorn::IO
