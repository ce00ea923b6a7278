#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>

#include "geometry/fewest/DenseOrder.h"
#include "geometry/fewest/Spacing.h"
#include "support/RandomGeometry.h"

namespace Vorn::Fewest {
namespace {

Path RandomPath(Testing::RandomGeometry* random, std::int32_t count) {
  Path path;
  for (std::int32_t i = 0; i < count; ++i) {
    path.points.push_back({0.01 * i + random->Uniform(-1.0, 1.0), random->Uniform(-1.0, 1.0),
                           random->Uniform(0.5, 2.0)});
  }
  return path;
}

double WidestGap2(Path const& path, std::int32_t first, std::int32_t end) {
  double widest = 0.0;
  for (std::int32_t i = first + 1; i < end; ++i) {
    double const dx = path.At(i).x - path.At(i - 1).x;
    double const dy = path.At(i).y - path.At(i - 1).y;
    widest = std::max(widest, dx * dx + dy * dy);
  }
  return widest;
}

TEST(Spacing, IsThatOfTheSinglePointsOfARun) {
  Testing::RandomGeometry random(11);
  Path const path = RandomPath(&random, 1000);
  Spacing spacing(path);
  auto const byX = [](WPoint const& p, WPoint const& q) { return p.x < q.x; };
  auto const byY = [](WPoint const& p, WPoint const& q) { return p.y < q.y; };
  auto const byW = [](WPoint const& p, WPoint const& q) { return p.w < q.w; };
  for (int round = 0; round < 2000; ++round) {
    std::int32_t const first = random.Integer(0, 999);
    std::int32_t const end = random.Integer(first + 1, 1000);
    SCOPED_TRACE(testing::Message() << first << " to " << end);
    RunSpacing const run = spacing.Of(first, end);
    auto const from = path.points.begin() + first;
    auto const to = path.points.begin() + end;
    EXPECT_EQ(run.widest2, WidestGap2(path, first, end));
    EXPECT_EQ(spacing.WidestGap2(first, end), WidestGap2(path, first, end));
    EXPECT_EQ(run.leastTolerance, std::min_element(from, to, byW)->w);
    EXPECT_EQ(run.lowX, std::min_element(from, to, byX)->x);
    EXPECT_EQ(run.highX, std::max_element(from, to, byX)->x);
    EXPECT_EQ(run.lowY, std::min_element(from, to, byY)->y);
    EXPECT_EQ(run.highY, std::max_element(from, to, byY)->y);
  }
}

constexpr RunSpacing kSquare{0.0, 0.1, -1.0, 1.0, -1.0, 1.0};

RunSpacing WithGap(double gap) {
  RunSpacing run = kSquare;
  run.widest2 = gap * gap;
  return run;
}

TEST(DenseOrder, AlongALineAGapOfAsMuchAsNoiseMayStepBackIsInOrder) {
  Circle const line{0.0, 0.0, 1.0, 0.0};
  EXPECT_TRUE(DenseOrder(line, WithGap(0.299), LocalFrame{}).IsInOrder(1.5));
  EXPECT_FALSE(DenseOrder(line, WithGap(0.301), LocalFrame{}).IsInOrder(1.5));
}

TEST(DenseOrder, AboutACentreWithinTheBoxOnlyNeighboursWithinToleranceMakeNoLargeStep) {
  Circle const unit{0.5, 0.0, 0.0, -0.5};
  EXPECT_TRUE(DenseOrder(unit, WithGap(0.099), LocalFrame{}).HasSmallSteps(0.5));
  EXPECT_FALSE(DenseOrder(unit, WithGap(0.101), LocalFrame{}).HasSmallSteps(0.5));
}

TEST(DenseOrder, FarFromTheCentreAStepIsItsLengthInRadii) {
  // Of radius 10 about (11, 0): the box comes as near as 10 to the centre.
  Circle const circle{0.05, -1.1, 0.0, 1.05};
  EXPECT_TRUE(DenseOrder(circle, WithGap(1.99), LocalFrame{}).HasSmallSteps(0.1));
  EXPECT_FALSE(DenseOrder(circle, WithGap(2.01), LocalFrame{}).HasSmallSteps(0.1));
}

TEST(DenseOrder, AStrideTurnsByAQuarterOfARadianAtMost) {
  Circle const unit{0.5, 0.0, 0.0, -0.5};
  EXPECT_EQ(DenseOrder(unit, WithGap(0.01), LocalFrame{}).Stride(), 25);
  EXPECT_EQ(DenseOrder(unit, WithGap(3.0), LocalFrame{}).Stride(), 1);
}

}  // namespace
}  // namespace Vorn::Fewest
