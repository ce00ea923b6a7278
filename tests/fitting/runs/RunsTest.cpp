#include <limits>
#include <vector>

#include "geometry/fitting/runs/Deviations.h"
#include "geometry/fitting/runs/Runs.h"
#include "gtest/gtest.h"
#include "support/Bits.h"

namespace Vorn::Testing {
namespace {

using Fitting::Deviation;
using Fitting::FindLargest;
using Fitting::LargestDeviation;

constexpr std::int32_t kMost = std::numeric_limits<std::int32_t>::max();
constexpr std::int32_t kLeast = std::numeric_limits<std::int32_t>::min();

std::vector<WPoint> const kThree = {{0, 0, .1}, {1, 2, .2}, {3, 4, .3}};

TEST(Run, ExistsWhenAllOfItsPointsDo) {
  EXPECT_TRUE((Fitting::Run{kThree, 0, 3}.Exists()));
  EXPECT_TRUE((Fitting::Run{kThree, 1, 2}.Exists()));
  EXPECT_TRUE((Fitting::Run{kThree, 3, 0}.Exists()));
  EXPECT_FALSE((Fitting::Run{kThree, 1, 3}.Exists()));
  EXPECT_FALSE((Fitting::Run{kThree, 4, 0}.Exists()));
  EXPECT_FALSE((Fitting::Run{kThree, -1, 1}.Exists()));
  EXPECT_FALSE((Fitting::Run{kThree, 0, -1}.Exists()));
}

TEST(Run, CountsThatWouldOverflowDoNotExist) {
  EXPECT_FALSE((Fitting::Run{kThree, kMost, kMost}.Exists()));
  EXPECT_FALSE((Fitting::Run{kThree, 1, kMost}.Exists()));
  EXPECT_FALSE((Fitting::Run{kThree, kLeast, kLeast}.Exists()));
}

TEST(Run, PositionsCountFromItsFirstPoint) {
  Fitting::Run const run{kThree, 1, 2};
  EXPECT_EQ(run[1].w, .3);
  EXPECT_EQ(run.FirstPoint().y, 2);
  EXPECT_EQ(run.LastPoint().x, 3);
  EXPECT_EQ(run.OfCount(1).LastPoint().x, 1);
}

TEST(FixedIf, GivesNothingForAFreeEnd) {
  EXPECT_FALSE(Fitting::FixedIf(false, {1, 2}));
  EXPECT_EQ(Fitting::FixedIf(true, {1, 2})->y, 2);
}

Deviation LargestOf(std::vector<double> const& values) {
  return FindLargest(static_cast<std::int32_t>(values.size()),
                     [&](std::int32_t i) { return values[static_cast<std::size_t>(i)]; });
}

TEST(FindLargest, OfEqualOnesTheFirst) {
  EXPECT_EQ(LargestOf({1, 3, 3, 2}).index, 1);
  EXPECT_EQ(LargestOf({-5, -7}).value, -5);
}

TEST(FindLargest, NotANumberStaysOnlyInFirstPlace) {
  EXPECT_EQ(LargestOf({kNaN, 3}).index, 0);
  EXPECT_EQ(LargestOf({3, kNaN, 4}).index, 2);
}

TEST(FindLargest, OfNothingIsTheDefault) {
  EXPECT_EQ(LargestOf({}).index, -1);
  EXPECT_EQ(LargestOf({}).value, -1.0);
}

TEST(LargestDeviation, TheFirstElementAlwaysSetsIt) {
  LargestDeviation largest;
  EXPECT_EQ(largest.Get().index, -1);
  largest.Take({0.0, 7});
  EXPECT_EQ(largest.Get().index, 7);
}

TEST(LargestDeviation, OfEqualOnesTheFirstStands) {
  LargestDeviation largest;
  largest.Take({0.5, 3});
  largest.Take({0.5, 9});
  largest.Take({0.25, 11});
  EXPECT_EQ(largest.Get().index, 3);
  largest.Take({0.75, 13});
  EXPECT_EQ(largest.Get().index, 13);
}

}  // namespace
}  // namespace Vorn::Testing
