#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "vorn/GeometryUtils.h"
#include "vorn/io/PointsInfo.h"
#include "vorn/io/Spacing.h"

namespace Vorn::IO {
namespace {

TEST(FindClosePairs, ListsEveryPairTheSpacingRuleRefuses) {
  std::vector<WPoint> const points = {{0, 0, 1}, {3, 0, 1}, {9, 0, 1}, {9, 1, .5}, {9, 9, .5}};
  std::vector<ClosePair> const pairs = FindClosePairs(points, {});
  ASSERT_EQ(pairs.size(), 2u);
  EXPECT_EQ(pairs[0].second, 1u);
  EXPECT_EQ(pairs[0].distance, 3.0);
  EXPECT_EQ(pairs[0].needed, 3.0);
  EXPECT_EQ(pairs[1].second, 3u);
  EXPECT_EQ(pairs[1].needed, 2.25);
}

TEST(FindClosePairs, TakesTheLastAndTheFirstOfAClosedContour) {
  std::vector<WPoint> const points = {{0, 0, 1}, {9, 0, 1}, {9, 9, 1}, {0, 2, 1}};
  Closure closure;
  EXPECT_TRUE(FindClosePairs(points, closure).empty());
  closure.isClosed = true;
  std::vector<ClosePair> const pairs = FindClosePairs(points, closure);
  ASSERT_EQ(pairs.size(), 1u);
  EXPECT_EQ(pairs[0].first, 3u);
  EXPECT_EQ(pairs[0].second, 0u);
  closure.repeatsFirst = true;
  EXPECT_TRUE(FindClosePairs(points, closure).empty());
}

TEST(Analyse, CountsTheClosingPairOfAClosedContour) {
  std::vector<WPoint> const points = {{0, 0, 0}, {9, 0, 0}, {9, 9, 0}, {0, 3, 0}};
  double const open = Analyse(points, ClosedChoice::No).largestTolerance.value();
  double const closed = Analyse(points, ClosedChoice::Yes).largestTolerance.value();
  EXPECT_NEAR(open, 3.0, 1e-4);
  EXPECT_NEAR(closed, 1.0, 1e-4);
}

TEST(FindClosePairs, AgreesWithTheLibraryToTheLastBit) {
  constexpr std::uint64_t kSeed = 5;
  SCOPED_TRACE(kSeed);
  std::mt19937_64 engine(kSeed);
  std::uniform_real_distribution<double> share(0.0, 1.0);
  int broken = 0;
  for (int i = 0; i < 20000; ++i) {
    WPoint const a{share(engine), share(engine), share(engine)};
    WPoint b{share(engine), share(engine), 0.0};
    // On the edge of the rule, a few bits to this or that side.
    b.w = Distance(a, b) / 1.5 - a.w;
    for (auto steps = engine() % 4; steps > 0; --steps) b.w = std::nextafter(b.w, 9.0);
    bool const isBroken = !FindClosePairs({a, b}, {}).empty();
    EXPECT_EQ(isBroken, !GeometryUtils::IsPointValidToFit(a, b)) << i;
    broken += isBroken ? 1 : 0;
  }
  EXPECT_GT(broken, 2000);
  EXPECT_LT(broken, 18000);
}

PointsInfo InfoWith(double width, double height, std::optional<double> noise,
                    std::optional<double> largest) {
  PointsInfo info;
  info.box = {0.0, width, 0.0, height};
  info.noise = noise;
  info.largestTolerance = largest;
  return info;
}

TEST(SuggestTolerance, IsFiveTimesTheNoiseInTwoDigits) {
  Suggestion const suggestion = SuggestTolerance(InfoWith(30, 40, 0.00347, 0.1));
  EXPECT_EQ(suggestion.way, Suggestion::Way::Same);
  EXPECT_EQ(suggestion.tolerance, 0.017);
  EXPECT_EQ(suggestion.reason, "five times the noise");
}

TEST(SuggestTolerance, IsATenThousandthOfTheSizeWhereTheNoiseIsLess) {
  Suggestion const suggestion = SuggestTolerance(InfoWith(30, 40, 1e-6, 0.1));
  EXPECT_EQ(suggestion.way, Suggestion::Way::Same);
  EXPECT_EQ(suggestion.tolerance, 0.005);
  EXPECT_EQ(SuggestTolerance(InfoWith(30, 40, {}, 0.1)).tolerance, 0.005);
  EXPECT_EQ(SuggestTolerance(InfoWith(50, 0, 0.0, 0.1)).tolerance, 0.005) << "a straight line";
}

TEST(SuggestTolerance, KeepsTheShapeOfAFlatProfile) {
  EXPECT_EQ(SuggestTolerance(InfoWith(200, 0.1, 1e-8, 1.0)).tolerance, 0.001);
}

TEST(SuggestTolerance, SaysWhereItIsForTheFewestPiecesAloneAndDoesNotFollowTheSpacing) {
  EXPECT_EQ(SuggestTolerance(InfoWith(30, 40, 0.0, 0.005)).way, Suggestion::Way::Same);
  for (double const largest : {0.0049, 0.0001}) {
    Suggestion const suggestion = SuggestTolerance(InfoWith(30, 40, 0.0, largest));
    EXPECT_EQ(suggestion.way, Suggestion::Way::Fewest);
    EXPECT_EQ(suggestion.tolerance, 0.005);
    EXPECT_EQ(suggestion.reason,
              "a ten-thousandth of the size; too much for mixed and cells at this spacing");
  }
}

TEST(SuggestTolerance, NamesTheFewestPiecesWhereNeighboursCoincide) {
  Suggestion const suggestion = SuggestTolerance(InfoWith(30, 40, 0.01, {}));
  EXPECT_EQ(suggestion.way, Suggestion::Way::Fewest);
  EXPECT_EQ(suggestion.tolerance, 0.05);
}

TEST(Analyse, TakesTwoPoints) {
  PointsInfo const info = Analyse({{0, 0, 0}, {3, 4, 0}}, ClosedChoice::Auto);
  EXPECT_EQ(info.spacing.length, 5.0);
  EXPECT_EQ(info.closure.gap, 5.0);
  EXPECT_FALSE(info.noise.has_value());
  EXPECT_TRUE(info.corners.empty());
}

TEST(Analyse, TakesCoincidingPoints) {
  PointsInfo const info = Analyse(std::vector<WPoint>(20, WPoint{1, 1, 0}), ClosedChoice::Auto);
  EXPECT_EQ(info.duplicates.size(), 19u);
  EXPECT_FALSE(info.largestTolerance.has_value());
  EXPECT_EQ(info.suggestion.way, Suggestion::Way::None);
}

}  // namespace
}  // namespace Vorn::IO
