#include <cmath>
#include <vector>

#include "geometry/fitting/arc/CircleRadius.h"
#include "geometry/fitting/arc/RadiusRange.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"

namespace Vorn::Testing {
namespace {

using Fitting::CommonRange;
using Fitting::RadiusRange;

std::optional<RadiusRange> CommonOf(std::vector<RadiusRange> const& ranges) {
  return CommonRange(static_cast<std::int32_t>(ranges.size()),
                     [&](std::int32_t i) { return ranges[static_cast<std::size_t>(i)]; });
}

TEST(RadiusRange, ReachesByTheToleranceToEitherSide) {
  RadiusRange const range = RadiusRange::Of(5.0, 0.5);
  EXPECT_EQ(range.least, 4.5);
  EXPECT_EQ(range.greatest, 5.5);
  EXPECT_EQ(range.Middle(), 5.0);
}

TEST(RadiusRange, IsEmptyOnlyWithTheLeastAboveTheGreatest) {
  EXPECT_TRUE((RadiusRange{2.0, 1.0}.IsEmpty()));
  EXPECT_FALSE((RadiusRange{1.0, 1.0}.IsEmpty()));
  EXPECT_FALSE((RadiusRange{kNaN, 1.0}.IsEmpty()));
}

TEST(RadiusRange, LimitsThatAreNotNumbersStayOnItsOwnSideOnly) {
  RadiusRange range{1.0, 2.0};
  range.NarrowBy({kNaN, kNaN});
  EXPECT_EQ(range.least, 1.0);
  EXPECT_EQ(range.greatest, 2.0);
  RadiusRange own{kNaN, kNaN};
  own.NarrowBy({1.0, 2.0});
  EXPECT_TRUE(std::isnan(own.least));
  EXPECT_TRUE(std::isnan(own.greatest));
}

TEST(CommonRange, IsWhatAllHaveInCommon) {
  std::optional<RadiusRange> const common = CommonOf({{1, 5}, {2, 6}, {0, 4}});
  ASSERT_TRUE(common);
  EXPECT_EQ(common->least, 2);
  EXPECT_EQ(common->greatest, 4);
}

TEST(CommonRange, IsNothingOnceItIsEmpty) {
  EXPECT_FALSE(CommonOf({{2, 1}}));
  EXPECT_FALSE(CommonOf({{1, 2}, {3, 4}}));
  EXPECT_FALSE(CommonOf({{1, 2}, {3, 4}, {kNaN, kNaN}}));
  EXPECT_TRUE(CommonOf({{1, 2}, {2, 3}}));
}

TEST(FindRadiusRange, HoldsExactlyTheRadiiThatSuitEveryPoint) {
  int found = 0;
  for (std::uint64_t seed = 1; seed <= 500; ++seed) {
    SCOPED_TRACE(seed);
    RandomGeometry random(seed);
    std::vector<WPoint> points;
    for (int i = random.Integer(1, 8); i > 0; --i) {
      GeometryUtils::Point const p = random.PointOnCircle({1, 2}, random.Uniform(4.9, 5.1));
      points.push_back({p.x, p.y, random.Uniform(0.05, 0.2)});
    }
    auto const range = Fitting::FindRadiusRange(Fitting::RunOverAll(points), {1, 2}, -1.0);
    long double least = 0.0L;
    long double greatest = 1e9L;
    for (WPoint const& p : points) {
      long double const distance = std::hypot(p.x - 1.0L, p.y - 2.0L);
      least = std::max(least, distance - p.w);
      greatest = std::min(greatest, distance + p.w);
    }
    if (std::fabs(static_cast<double>(greatest - least)) < 1e-12) continue;
    ASSERT_EQ(range.has_value(), least < greatest);
    if (!range) continue;
    ++found;
    EXPECT_NEAR(range->least, static_cast<double>(least), 1e-12);
    EXPECT_NEAR(range->greatest, static_cast<double>(greatest), 1e-12);
  }
  EXPECT_GT(found, 100);
}

}  // namespace
}  // namespace Vorn::Testing
