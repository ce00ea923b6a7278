#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "geometry/fewest/Bends.h"
#include "geometry/fewest/Bound.h"
#include "support/Profiles.h"

namespace Vorn::Fewest {
namespace {

TEST(IsBent, AsksWhetherTheMiddlePointIsBeyondAllThreeTolerances) {
  std::vector<WPoint> points{{0, 0, 0.1}, {100, 0.69, 0.2}, {200, 0, 0.4}};
  EXPECT_FALSE(IsBent(points, 0, 3));
  points[1].y = 0.71;
  EXPECT_TRUE(IsBent(points, 0, 3));
  points[1].y = -0.71;
  EXPECT_TRUE(IsBent(points, 0, 3));
}

TEST(IsBent, IsNotTrueWhereALineTurnedFromAShortChordCoversAll) {
  // The line x = 0.05 covers the three, though the middle lies ten tolerances off the chord.
  EXPECT_FALSE(IsBent(std::vector<WPoint>{{0, 0, 0.1}, {0.05, 1, 0.1}, {0.1, 0, 0.1}}, 0, 3));
}

TEST(IsBent, IsNeverTrueOfPointsNearALine) {
  std::mt19937 random(8301);
  std::uniform_real_distribution<double> unit(-1.0, 1.0);
  int bent = 0;
  for (int i = 0; i < 100000; ++i) {
    double const heading = 3.2 * unit(random);
    std::vector<WPoint> points;
    for (int k = 0; k < 3; ++k) {
      double const along = 3.0 * unit(random);
      double const w = 0.55 + 0.45 * unit(random);
      double const off = w * unit(random);
      points.push_back({along * std::cos(heading) - off * std::sin(heading),
                        along * std::sin(heading) + off * std::cos(heading), w});
    }
    EXPECT_FALSE(IsBent(points, 0, 3));
    points[1].w = 0.01;
    points[1].y += 5.0;
    bent += IsBent(points, 0, 3) ? 1 : 0;
  }
  EXPECT_GT(bent, 1000) << "what is far off is seen";
}

TEST(IsBent, IsNeverTrueOfAPointBeyondTheEnds) {
  EXPECT_FALSE(IsBent(std::vector<WPoint>{{0, 0, 0.1}, {3, 5, 0.1}, {2, 0, 0.1}}, 0, 3));
  EXPECT_FALSE(IsBent(std::vector<WPoint>{{0, 0, 0.1}, {0, 0.2, 0.1}, {0, 0, 0.1}}, 0, 3))
      << "ends that coincide";
}

TEST(CountBentRuns, IsOneForALineAndNeverAboveTheLeastCover) {
  EXPECT_EQ(CountBentRuns(Testing::MakeLinePoints({0.0, 0.0}, 1.0, 0.5, 1000, 0.01), 100), 1u);
  Limits limits;
  limits.segmentsOnly = true;
  for (double const tolerance : {1e-4, 1e-3, 1e-2, 1e-1}) {
    auto const arc = Testing::MakeArcPoints({3.0, 4.0}, 10.0, 0.2, 5.0, 1000, tolerance);
    std::size_t const bends = CountBentRuns(arc, 10000);
    std::size_t const least = CoverGreedily(arc, limits, [](std::int32_t) {}).starts.size();
    EXPECT_LE(bends, least);
    EXPECT_GT(4 * bends, least) << "a low estimate, but no idle one";
  }
}

TEST(CountBentRuns, StopsWhereThereAreEnough) {
  auto const arc = Testing::MakeArcPoints({3.0, 4.0}, 10.0, 0.2, 5.0, 1000, 1e-4);
  EXPECT_EQ(CountBentRuns(arc, 5), 5u);
  EXPECT_EQ(CountBentRuns(std::vector<WPoint>{}, 5), 1u);
}

}  // namespace
}  // namespace Vorn::Fewest
