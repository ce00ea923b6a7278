#include <cmath>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/Profiles.h"
#include "support/ReferenceFitting.h"

namespace Vorn::Testing {
namespace {

using Strategy = GeometryUtils::CircleRadiusFindingStrategy;

/// Distances 5, 10 and 13 from the origin.
std::vector<WPoint> const kPoints = {{3, 4, 4}, {-6, 8, 2}, {5, -12, 4}};

struct Range {
  bool ok = false;
  double lowest = kSentinel;
  double highest = kSentinel;
};

template <class Library>
Range FindRange(std::vector<WPoint> const& points, std::int32_t first, std::int32_t count,
                double cx, double cy, double tolerance) {
  Range r;
  r.ok = Library::GetRadiusRange(points, first, count, cx, cy, tolerance, &r.lowest, &r.highest);
  return r;
}

TEST(GetRadiusRange, IntersectsTheBandsOfThePoints) {
  Range const two = FindRange<GeometryUtils>(kPoints, 1, 2, 0, 0, -1.0);  // [8,12] and [9,17]
  EXPECT_TRUE(two.ok);
  EXPECT_EQ(two.lowest, 9.0);
  EXPECT_EQ(two.highest, 12.0);
}

TEST(GetRadiusRange, ACommonToleranceReplacesThoseOfThePoints) {
  Range const r = FindRange<GeometryUtils>(kPoints, 0, 3, 0, 0, 6.0);
  EXPECT_TRUE(r.ok);
  EXPECT_EQ(r.lowest, 7.0);
  EXPECT_EQ(r.highest, 11.0);
  Range const zero = FindRange<GeometryUtils>(kPoints, 1, 1, 0, 0, 0.0);
  EXPECT_TRUE(zero.ok);
  EXPECT_EQ(zero.lowest, 10.0);
  EXPECT_EQ(zero.highest, 10.0);
}

TEST(GetRadiusRange, NegativeZeroIsACommonTolerance) {
  EXPECT_EQ(FindRange<GeometryUtils>(kPoints, 1, 1, 0, 0, -0.0).lowest, 10.0);
}

TEST(GetRadiusRange, FailsUntouchedWhereTheIntervalIsEmpty) {
  Range const r = FindRange<GeometryUtils>(kPoints, 0, 3, 0, 0, -1.0);  // [1,9], [8,12], [9,17]
  EXPECT_TRUE(r.ok);                                                    // exactly one radius
  EXPECT_EQ(r.lowest, 9.0);
  EXPECT_EQ(r.highest, 9.0);
  std::vector<WPoint> narrower = kPoints;
  narrower[2].w = 3.875;
  Range const empty = FindRange<GeometryUtils>(narrower, 0, 3, 0, 0, -1.0);
  EXPECT_FALSE(empty.ok);
  EXPECT_EQ(empty.lowest, kSentinel);
  EXPECT_EQ(empty.highest, kSentinel);
}

TEST(GetRadiusRange, LowerEndsBelowZeroAreAllowed) {
  Range const r = FindRange<GeometryUtils>({{1, 0, 3}}, 0, 1, 0, 0, -1.0);
  EXPECT_TRUE(r.ok);
  EXPECT_EQ(r.lowest, -2.0);
}

TEST(GetRadiusRange, AnEmptyRunIsTrueAndWritesNothing) {
  for (std::int32_t count : {0, -1, -2147483647}) {
    Range const r = FindRange<GeometryUtils>(kPoints, 0, count, 0, 0, -1.0);
    EXPECT_TRUE(r.ok);
    EXPECT_EQ(r.lowest, kSentinel);
    EXPECT_EQ(r.highest, kSentinel);
  }
}

TEST(GetRadiusRange, RefusesRunsThatLeaveTheVector) {
  EXPECT_FALSE(FindRange<GeometryUtils>(kPoints, 0, 4, 0, 0, 100.0).ok);
  EXPECT_FALSE(FindRange<GeometryUtils>(kPoints, -1, 2, 0, 0, 100.0).ok);
  EXPECT_FALSE(FindRange<GeometryUtils>(kPoints, 2147483647, 2147483647, 0, 0, 100.0).ok);
  EXPECT_FALSE(FindRange<GeometryUtils>({}, 0, 1, 0, 0, 100.0).ok);
}

TEST(GetRadiusRange, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5501;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int found = 0;
  for (int i = 0; i < 1000; ++i) {
    std::vector<WPoint> points = MakeArcPoints({1, 2}, 30, 0, 3, random.Integer(2, 20), 0.5);
    for (WPoint& p : points) p.w = random.Uniform(0, 1.0);
    double const cx = 1 + random.Uniform(-0.5, 0.5);
    double const tolerance = random.Flip() ? -1.0 : random.Uniform(0, 0.5);
    auto const count = static_cast<std::int32_t>(points.size());
    Range const r = FindRange<GeometryUtils>(points, 0, count, cx, 2, tolerance);
    Range const e = FindRange<ReferenceFitting>(points, 0, count, cx, 2, tolerance);
    found += e.ok ? 1 : 0;
    EXPECT_EQ(r.ok, e.ok);
    EXPECT_SAME_BITS(r.lowest, e.lowest);
    EXPECT_SAME_BITS(r.highest, e.highest);
  }
  EXPECT_GT(found, 100);
  EXPECT_LT(found, 900);
}

struct Radius {
  bool ok = false;
  double value = kSentinel;
};

template <class Library = GeometryUtils>
Radius Choose(std::vector<WPoint> const& points, std::int32_t first, std::int32_t count,
              double tolerance, Strategy strategy) {
  Radius r;
  r.ok = Library::CalcOptimalRadius(points, first, count, 0, 0, tolerance, strategy, &r.value);
  return r;
}

TEST(CalcOptimalRadius, MidRangeIsTheMiddleOfTheRange) {
  Radius const r = Choose(kPoints, 1, 2, -1.0, Strategy::MidRange);
  EXPECT_TRUE(r.ok);
  EXPECT_EQ(r.value, 10.5);
}

TEST(CalcOptimalRadius, MeanDistanceIsPlainWithACommonTolerance) {
  Radius const r = Choose(kPoints, 0, 3, 4.0, Strategy::MeanDistance);
  EXPECT_TRUE(r.ok);
  EXPECT_EQ(r.value, 28.0 / 3.0);
}

TEST(CalcOptimalRadius, MeanDistanceIsWeightedWithTheTolerancesOfThePoints) {
  Radius const r = Choose(kPoints, 0, 3, -1.0, Strategy::MeanDistance);
  EXPECT_TRUE(r.ok);
  EXPECT_EQ(r.value, (5.0 * 4 + 10.0 * 2 + 13.0 * 4) / 10.0);
}

TEST(CalcOptimalRadius, FailsUntouchedWhereTheRangeIsEmpty) {
  for (Strategy strategy : {Strategy::MidRange, Strategy::MeanDistance}) {
    Radius const r = Choose(kPoints, 0, 3, 1.0, strategy);
    EXPECT_FALSE(r.ok);
    EXPECT_EQ(r.value, kSentinel);
  }
}

TEST(CalcOptimalRadius, FailsUntouchedWithoutWeight) {
  std::vector<WPoint> const points = {{3, 4, 0}, {-3, 4, 0}};
  EXPECT_FALSE(Choose(points, 0, 2, -1.0, Strategy::MeanDistance).ok);
  EXPECT_TRUE(Choose(points, 0, 2, 0.0, Strategy::MeanDistance).ok);
  EXPECT_TRUE(Choose(points, 0, 2, -1.0, Strategy::MidRange).ok);
  double const smallest = std::numeric_limits<double>::min();
  EXPECT_FALSE(Choose({{3, 4, smallest}}, 0, 1, -1.0, Strategy::MeanDistance).ok);
  EXPECT_TRUE(Choose({{3, 4, Up(smallest)}}, 0, 1, -1.0, Strategy::MeanDistance).ok);
}

TEST(CalcOptimalRadius, FailsUntouchedForAnUnknownStrategyOrBadRun) {
  for (Radius const& r :
       {Choose(kPoints, 1, 2, -1.0, Strategy{2}), Choose(kPoints, 1, 2, -1.0, Strategy{-1}),
        Choose(kPoints, 0, 0, -1.0, Strategy::MidRange),
        Choose(kPoints, 0, -2, -1.0, Strategy::MeanDistance),
        Choose(kPoints, 2, 2, -1.0, Strategy::MeanDistance),
        Choose(kPoints, -1, 1, -1.0, Strategy::MidRange)}) {
    EXPECT_FALSE(r.ok);
    EXPECT_EQ(r.value, kSentinel);
  }
}

/// Unrolling the loop must not change the order of the sum.
TEST(CalcOptimalRadius, SumsInPointOrder) {
  constexpr std::uint64_t kSeed = 5502;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (std::int32_t count = 1; count < 40; ++count) {
    std::vector<WPoint> points;
    for (std::int32_t i = 0; i < count; ++i) {
      points.push_back({random.Uniform(0.1, 3), random.Uniform(-3, 3), random.Uniform(4, 5)});
    }
    for (double tolerance : {-1.0, 5.0}) {
      Radius const r = Choose(points, 0, count, tolerance, Strategy::MeanDistance);
      Radius const e =
          Choose<ReferenceFitting>(points, 0, count, tolerance, Strategy::MeanDistance);
      EXPECT_TRUE(r.ok);
      EXPECT_SAME_BITS(r.value, e.value);
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
