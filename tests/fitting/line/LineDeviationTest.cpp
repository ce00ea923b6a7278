#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/Profiles.h"
#include "support/ReferenceFitting.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;

/// On the line y = 2, left to right; distances 1, 3, 2, 3 in units of 1, 2, 0.5 and 2.
std::vector<WPoint> const kPoints = {{0, 3, 1}, {1, 5, 2}, {2, 0, 0.5}, {3, -1, 2}};
Point const kLeft{-1, 2};
Point const kRight{7, 2};

struct MaxDeviation {
  double value;
  std::int32_t index;
};

MaxDeviation Measure(std::vector<WPoint> const& points, std::int32_t start, std::int32_t count,
                     Point const& a, Point const& b) {
  MaxDeviation result{kSentinel, kIntSentinel};
  result.value = GeometryUtils::GetMaxDeviationFromLine(points, start, count, a, b, &result.index);
  return result;
}

TEST(GetMaxDeviationFromLine, IsRelativeToTheToleranceOfThePoint) {
  auto const all = Measure(kPoints, 0, 4, kLeft, kRight);
  EXPECT_EQ(all.value, 4.0);
  EXPECT_EQ(all.index, 2);
  auto const part = Measure(kPoints, 0, 2, kLeft, kRight);
  EXPECT_EQ(part.value, 1.5);
  EXPECT_EQ(part.index, 1);
}

TEST(GetMaxDeviationFromLine, GivesTheAbsoluteIndex) {
  EXPECT_EQ(Measure(kPoints, 3, 1, kLeft, kRight).index, 3);
}

TEST(GetMaxDeviationFromLine, FirstOfEqualDeviationsStands) {
  std::vector<WPoint> const points = {{0, 3, 1}, {1, 1, 1}, {2, 4, 2}};
  auto const result = Measure(points, 0, 3, kLeft, kRight);
  EXPECT_EQ(result.value, 1.0);
  EXPECT_EQ(result.index, 0);
}

TEST(GetMaxDeviationFromLine, IsZeroWithoutPointForARunThatLeavesTheVector) {
  for (auto const& [start, count] : std::vector<std::pair<std::int32_t, std::int32_t>>{
           {0, 5}, {4, 1}, {-1, 2}, {0, 0}, {0, -1}, {2147483647, 2147483647}, {-2147483647, 4}}) {
    auto const result = Measure(kPoints, start, count, kLeft, kRight);
    EXPECT_EQ(result.value, 0.0) << start << ' ' << count;
    EXPECT_EQ(result.index, -1) << start << ' ' << count;
  }
  auto const none = Measure({}, 0, 1, kLeft, kRight);
  EXPECT_EQ(none.value, 0.0);
  EXPECT_EQ(none.index, -1);
}

TEST(GetMaxDeviationFromLine, IsZeroWithoutPointWhereThereIsNoLine) {
  auto const result = Measure(kPoints, 0, 4, kLeft, kLeft);
  EXPECT_EQ(result.value, 0.0);
  EXPECT_EQ(result.index, -1);
}

TEST(GetMaxDeviationFromLine, ZeroToleranceGivesInfinity) {
  auto const result = Measure({{0, 3, 1}, {1, 3, 0}, {2, 3, 0}}, 0, 3, kLeft, kRight);
  EXPECT_EQ(result.value, kInf);
  EXPECT_EQ(result.index, 1);
}

TEST(GetMaxDeviationFromLine, NotANumberNeverReplacesANumber) {
  auto const later = Measure({{0, 3, 1}, {1, kNaN, 1}}, 0, 2, kLeft, kRight);
  EXPECT_EQ(later.value, 1.0);
  EXPECT_EQ(later.index, 0);
  auto const first = Measure({{0, kNaN, 1}, {1, 3, 1}}, 0, 2, kLeft, kRight);
  EXPECT_TRUE(std::isnan(first.value));
  EXPECT_EQ(first.index, 0);
}

TEST(GetMaxDeviationFromLine, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5204;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 500; ++i) {
    std::vector<WPoint> points = MakeProfile(&random, random.Integer(1, 12));
    if (random.Integer(0, 3) == 0) AddHazard(&random, &points);
    Point const a = random.PointIn(-60, 60);
    Point const b = random.Integer(0, 9) == 0 ? a : random.PointIn(-60, 60);
    std::int32_t const start = random.Integer(-1, 4);
    std::int32_t const count = random.Integer(-1, 10);
    auto const result = Measure(points, start, count, a, b);
    std::int32_t index = kIntSentinel;
    double const expected =
        ReferenceFitting::GetMaxDeviationFromLine(points, start, count, a, b, &index);
    EXPECT_SAME_BITS(result.value, expected);
    EXPECT_EQ(result.index, index);
  }
}

struct Extremes {
  bool ok = false;
  double minimum = kSentinel;
  double maximum = kSentinel;
  std::int32_t minIndex = kIntSentinel;
  std::int32_t maxIndex = kIntSentinel;
};

template <class Library>
Extremes FindExtremes(Point const& a, Point const& b, std::vector<WPoint> const& points,
                      std::int32_t start, std::int32_t count) {
  Extremes e;
  e.ok = Library::GetDeviationFromLineParameters(a, b, points, start, count, &e.minimum, &e.maximum,
                                                 &e.minIndex, &e.maxIndex);
  return e;
}

TEST(GetDeviationFromLineParametersExtremes, TheOriginSideIsNegative) {
  auto const e = FindExtremes<GeometryUtils>(kLeft, kRight, kPoints, 0, 4);
  EXPECT_TRUE(e.ok);
  EXPECT_EQ(e.maximum, 3.0);
  EXPECT_EQ(e.maxIndex, 1);
  EXPECT_EQ(e.minimum, -3.0);
  EXPECT_EQ(e.minIndex, 3);
}

TEST(GetDeviationFromLineParametersExtremes, DirectionOfTheLineDoesNotMatter) {
  auto const e = FindExtremes<GeometryUtils>(kRight, kLeft, kPoints, 0, 4);
  EXPECT_EQ(e.maximum, 3.0);
  EXPECT_EQ(e.minimum, -3.0);
}

TEST(GetDeviationFromLineParametersExtremes, TolerancesPlayNoPart) {
  std::vector<WPoint> const points = {{0, 3, 1e-9}, {1, 5, 1e9}};
  EXPECT_EQ(FindExtremes<GeometryUtils>(kLeft, kRight, points, 0, 2).maxIndex, 1);
}

TEST(GetDeviationFromLineParametersExtremes, FirstOfEqualExtremesStands) {
  std::vector<WPoint> const points = {{0, 3, 1}, {1, 3, 1}, {2, 1, 1}, {3, 1, 1}};
  auto const e = FindExtremes<GeometryUtils>(kLeft, kRight, points, 0, 4);
  EXPECT_EQ(e.maxIndex, 0);
  EXPECT_EQ(e.minIndex, 2);
}

TEST(GetDeviationFromLineParametersExtremes, FailsUntouchedForAShortVectorOrNoLine) {
  for (auto const& e : {FindExtremes<GeometryUtils>(kLeft, kRight, kPoints, 0, 5),
                        FindExtremes<GeometryUtils>(kLeft, kRight, kPoints, 3, 2),
                        FindExtremes<GeometryUtils>(kLeft, kRight, kPoints, -1, 2),
                        FindExtremes<GeometryUtils>(kLeft, kRight, kPoints, 2147483647, 2147483647),
                        FindExtremes<GeometryUtils>(kLeft, kRight, {}, 0, 1),
                        FindExtremes<GeometryUtils>(kLeft, kLeft, kPoints, 0, 4)}) {
    EXPECT_FALSE(e.ok);
    EXPECT_EQ(e.minimum, kSentinel);
    EXPECT_EQ(e.maximum, kSentinel);
    EXPECT_EQ(e.minIndex, kIntSentinel);
    EXPECT_EQ(e.maxIndex, kIntSentinel);
  }
}

TEST(GetDeviationFromLineParametersExtremes, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5205;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 500; ++i) {
    std::vector<WPoint> points = MakeProfile(&random, random.Integer(1, 12));
    if (random.Integer(0, 3) == 0) AddHazard(&random, &points);
    Point const a = random.PointIn(-60, 60);
    Point const b = random.Integer(0, 9) == 0 ? a : random.PointIn(-60, 60);
    std::int32_t const start = random.Integer(-1, 4);
    std::int32_t const count = random.Integer(1, 10);
    auto const result = FindExtremes<GeometryUtils>(a, b, points, start, count);
    auto const expected = FindExtremes<ReferenceFitting>(a, b, points, start, count);
    EXPECT_EQ(result.ok, expected.ok);
    EXPECT_SAME_BITS(result.minimum, expected.minimum);
    EXPECT_SAME_BITS(result.maximum, expected.maximum);
    EXPECT_EQ(result.minIndex, expected.minIndex);
    EXPECT_EQ(result.maxIndex, expected.maxIndex);
  }
}

using Indices = std::vector<std::int32_t>;

TEST(GetDeviationFromLineParametersIndices, AppendsTheSmallerIndexFirst) {
  Indices indices = {42};
  EXPECT_TRUE(
      GeometryUtils::GetDeviationFromLineParameters(kLeft, kRight, kPoints, 0, 4, &indices));
  EXPECT_EQ(indices, (Indices{42, 1, 3}));
  std::vector<WPoint> const points = {{0, 0, 1}, {1, 2, 1}, {2, 9, 1}};
  indices.clear();
  EXPECT_TRUE(GeometryUtils::GetDeviationFromLineParameters(kLeft, kRight, points, 0, 3, &indices));
  EXPECT_EQ(indices, (Indices{0, 2}));
}

TEST(GetDeviationFromLineParametersIndices, AppendsAnEqualIndexOnce) {
  Indices indices;
  EXPECT_TRUE(
      GeometryUtils::GetDeviationFromLineParameters(kLeft, kRight, kPoints, 2, 1, &indices));
  EXPECT_EQ(indices, Indices{2});
}

TEST(GetDeviationFromLineParametersIndices, AppendsNothingOnFailure) {
  Indices indices = {42};
  EXPECT_FALSE(
      GeometryUtils::GetDeviationFromLineParameters(kLeft, kLeft, kPoints, 0, 4, &indices));
  EXPECT_FALSE(
      GeometryUtils::GetDeviationFromLineParameters(kLeft, kRight, kPoints, 2, 3, &indices));
  EXPECT_EQ(indices, Indices{42});
}

}  // namespace
}  // namespace Vorn::Testing
