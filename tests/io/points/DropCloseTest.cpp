#include <gtest/gtest.h>

#include <random>

#include "vorn/GeometryUtils.h"
#include "vorn/io/Spacing.h"
#include "vorn/io/Thinning.h"

namespace Vorn::IO {
namespace {

using Indices = std::vector<std::size_t>;

std::vector<WPoint> OnAxis(std::vector<double> const& x, double w) {
  std::vector<WPoint> points;
  for (double const value : x) points.push_back({value, 0.0, w});
  return points;
}

Indices Kept(std::vector<WPoint> const& points) { return KeepSpaced(points, RuleOfTolerances()); }

std::vector<WPoint> Chosen(std::vector<WPoint> const& points, Indices const& indices) {
  std::vector<WPoint> chosen;
  for (std::size_t const i : indices) chosen.push_back(points[i]);
  return chosen;
}

TEST(KeepSpaced, TakesTheNextPointFarEnoughFromTheOneKept) {
  // 1.5 * (1 + 1) = 3, and the distance must be above it.
  EXPECT_EQ(Kept(OnAxis({0, 1, 3, 3.5, 5, 7, 20}, 1.0)), (Indices{0, 3, 5, 6}));
}

TEST(KeepSpaced, KeepsTheLastPointInPlaceOfThoseBeforeIt) {
  EXPECT_EQ(Kept(OnAxis({0, 4, 8, 9}, 1.0)), (Indices{0, 1, 3}));
  // The last point has so large a tolerance that two must go for it.
  EXPECT_EQ(Kept({{0, 0, 1}, {4, 0, 1}, {8, 0, 1}, {12, 0, 1}, {13, 0, 3}}), (Indices{0, 1, 4}));
}

TEST(KeepSpaced, KeepsAllWhereNothingIsTooClose) {
  EXPECT_EQ(Kept(OnAxis({0, 4, 8, 12}, 1.0)), (Indices{0, 1, 2, 3}));
}

TEST(KeepSpaced, KeepsOnlyTheFirstWhereAllAreTooClose) {
  EXPECT_EQ(Kept(OnAxis({0, 1, 2}, 1.0)), Indices{0});
  EXPECT_EQ(Kept(OnAxis({0, 9, 1}, 1.0)), (Indices{0, 1, 2})) << "only neighbours count";
  EXPECT_EQ(Kept(OnAxis({5, 5}, 0.1)), Indices{0});
}

TEST(KeepSpaced, BySpacingDropsOnlyWhatLeavesNoTolerance) {
  std::vector<WPoint> const points = OnAxis({0, 0, 1e-12, 1, 1, 1, 2, 2}, 0.0);
  EXPECT_EQ(KeepSpaced(points, RuleOfSpacing(0.5)), (Indices{0, 2, 3, 7}));
  // Squares of such distances are no longer above zero.
  EXPECT_EQ(KeepSpaced(OnAxis({0, 1e-200, 1}, 0.0), RuleOfSpacing(0.5)), (Indices{0, 2}));
}

struct PropertyCase {
  char const* name;
  double step;
  double tolerance;
};

class RandomPaths : public testing::TestWithParam<PropertyCase> {};

TEST_P(RandomPaths, PassTheLibrarysRuleOnceTheCloseOnesAreDropped) {
  PropertyCase const& path = GetParam();
  int dropped = 0;
  int left = 0;
  for (std::uint64_t seed = 1; seed <= 200; ++seed) {
    SCOPED_TRACE(seed);
    std::mt19937_64 engine(seed);
    std::uniform_real_distribution<double> share(0.0, 1.0);
    std::vector<WPoint> points;
    WPoint place;
    for (auto count = 2 + engine() % 60; count > 0; --count) {
      // A grid of few places, so that points coincide and distances meet the limit exactly.
      bool const onGrid = engine() % 2 == 0;
      place.x += onGrid ? path.step : path.step * share(engine);
      place.y += onGrid ? 0.0 : path.step * (share(engine) - 0.5);
      place.w = path.tolerance * (engine() % 2 == 0 ? 1.0 : share(engine) + 0.01);
      points.push_back(place);
      if (engine() % 8 == 0) points.push_back(place);
    }
    Indices const kept = Kept(points);
    ASSERT_FALSE(kept.empty());
    EXPECT_EQ(kept.front(), 0u);
    std::vector<WPoint> const rest = Chosen(points, kept);
    for (std::size_t i = 1; i < rest.size(); ++i) {
      EXPECT_LT(kept[i - 1], kept[i]);
      EXPECT_TRUE(GeometryUtils::IsPointValidToFit(rest[i - 1], rest[i]));
    }
    EXPECT_FALSE(FindClosePair(rest).has_value());
    if (kept.size() > 1) {
      EXPECT_EQ(kept.back(), points.size() - 1);
    }
    dropped += static_cast<int>(points.size() - kept.size());
    left += static_cast<int>(kept.size());
  }
  EXPECT_GT(dropped, 100);
  EXPECT_GT(left, 400);
}

INSTANTIATE_TEST_SUITE_P(KeepSpaced, RandomPaths,
                         testing::Values(PropertyCase{"ExactlyTheLimit", 3.0, 1.0},
                                         PropertyCase{"Sparse", 8.0, 1.0},
                                         PropertyCase{"Dense", 0.75, 0.5},
                                         PropertyCase{"Small", 3e-150, 1e-150}),
                         [](auto const& instance) { return instance.param.name; });

TEST(KeepSpaced, LeavesPointsThatTakeTheirTolerancesFromTheSpacing) {
  for (std::uint64_t seed = 1; seed <= 100; ++seed) {
    SCOPED_TRACE(seed);
    std::mt19937_64 engine(seed);
    PointFile file;
    double x = 0.0;
    for (int i = 0; i < 40; ++i) {
      x += static_cast<double>(engine() % 4) * 0.125;
      file.points.push_back({x, 0.0, 0.0});
    }
    Indices const kept = KeepSpaced(file.points, RuleOfSpacing(0.1));
    file.points = Chosen(file.points, kept);
    file.lines.assign(file.points.size(), 1);
    ToleranceChoice choice;
    choice.cap = 0.1;
    AssignTolerances(choice, &file);
    EXPECT_FALSE(FindClosePair(file.points).has_value());
  }
}

TEST(DropCloseToFirst, TakesPointsAwayAtTheEnd) {
  std::vector<WPoint> const points = {{0, 0, 1}, {4, 0, 1}, {4, 4, 1}, {0, 4, 1}, {0, 3, 1}};
  Indices kept = {0, 1, 2, 4};
  DropCloseToFirst(points, RuleOfTolerances(), &kept);
  EXPECT_EQ(kept, (Indices{0, 1, 2}));
  DropCloseToFirst(points, RuleOfTolerances(), &kept);
  EXPECT_EQ(kept, (Indices{0, 1, 2}));
}

TEST(Others, AreTheIndicesThatAreNotKept) {
  EXPECT_EQ(Others({0, 3, 4}, 6), (Indices{1, 2, 5}));
  EXPECT_EQ(Others({0, 1}, 2), Indices{});
}

TEST(WithoutLines, KeepsEveryOtherByte) {
  std::string_view const text = "\xEF\xBB\xBFx,y\r\n# c\n 1,2 \r3,4\n\n5,6";
  EXPECT_EQ(WithoutLines(text, {}), text);
  EXPECT_EQ(WithoutLines(text, {3}), "\xEF\xBB\xBFx,y\r\n# c\n3,4\n\n5,6");
  EXPECT_EQ(WithoutLines(text, {4, 6}), "\xEF\xBB\xBFx,y\r\n# c\n 1,2 \r\n");
}

}  // namespace
}  // namespace Vorn::IO
