#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "io/pieces/Frame.h"

namespace Vorn::IO {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

Extent SquareAt(double x, double y, double side) { return {{x, y}, {x + side, y + side}}; }

TEST(OriginFor, IsAMultipleOfThePowerOfTenAbove32Sizes) {
  // 32 * 3 = 96, so the step is 100; 32 * 4 = 128, so it is 1000.
  EXPECT_EQ(OriginFor(SquareAt(7130, 2260, 3)).x, 7100.0);
  EXPECT_EQ(OriginFor(SquareAt(7130, 2260, 3)).y, 2300.0);
  EXPECT_EQ(OriginFor(SquareAt(7130, 2260, 4)).x, 7000.0);
  EXPECT_EQ(OriginFor(SquareAt(7130, 2260, 4)).y, 2000.0);
}

TEST(OriginFor, TheStepIsOneAtLeast) {
  XY const origin = OriginFor(SquareAt(123.4, -55.6, 1e-3));
  EXPECT_EQ(origin.x, 123.0);
  EXPECT_EQ(origin.y, -56.0);
}

TEST(OriginFor, EachAxisStandsForItself) {
  XY const origin = OriginFor({{-1, 5e6}, {1, 5e6 + 2}});
  EXPECT_EQ(origin.x, 0.0);
  EXPECT_EQ(origin.y, 5e6);
}

TEST(OriginFor, WithinSixteenSizesNothingIsTakenOff) {
  std::mt19937_64 engine(3);
  std::uniform_real_distribution<double> unit(-1.0, 1.0);
  for (int round = 0; round < 5000; ++round) {
    double const side = std::pow(10.0, 8.0 * unit(engine));
    // The middle is within 15.5 sizes then, less than half a step, and rounds to 0.
    double const reach = 15.0 * side;
    XY const low = {reach * unit(engine), reach * unit(engine)};
    XY const origin = OriginFor(SquareAt(low.x, low.y, side));
    EXPECT_EQ(origin.x, 0.0) << low.x << " side " << side;
    EXPECT_EQ(origin.y, 0.0) << low.y << " side " << side;
  }
}

TEST(OriginFor, ExtentsWithoutSizeOrEndHaveNone) {
  for (Extent const& extent :
       {SquareAt(1e6, 1e6, 0.0), Extent{{0, 0}, {kInfinity, 1}}, Extent{{-kInfinity, 0}, {1, 1}},
        Extent{{std::nan(""), 0}, {1, 1}}, Extent{{1e308, 0}, {1.7e308, 1}}}) {
    XY const origin = OriginFor(extent);
    EXPECT_EQ(origin.x, 0.0);
    EXPECT_EQ(origin.y, 0.0);
  }
}

TEST(OriginFor, AcrossZeroNothingIsTakenOff) {
  XY const origin = OriginFor({{-40, 1000}, {60, 1100}});
  EXPECT_EQ(origin.x, 0.0);
}

TEST(OriginFor, TakingItOffIsExact) {
  std::mt19937_64 engine(4);
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  int shifted = 0;
  for (int round = 0; round < 5000; ++round) {
    double const side = std::pow(10.0, 6.0 * unit(engine) - 3.0);
    double const x = std::pow(10.0, 12.0 * unit(engine)) * (round % 2 == 0 ? 1.0 : -1.0);
    XY const origin = OriginFor({{x, 0}, {x + side, side}});
    if (origin.x == 0.0) continue;
    ++shifted;
    for (int k = 0; k < 4; ++k) {
      double const at = x + side * unit(engine);
      double const off = at - origin.x;
      EXPECT_EQ(off + origin.x, at);
      EXPECT_EQ(static_cast<long double>(at) - static_cast<long double>(origin.x),
                static_cast<long double>(off));
    }
  }
  EXPECT_GT(shifted, 2000);
}

TEST(SeenFrom, MovesPlacesAndKeepsWhatFollowsFromTheShape) {
  Piece const arc = MakeArc({1003, 2000}, {1000, 2003}, {1000, 2000}, 3.0, true);
  std::vector<Piece> const seen =
      SeenFrom({1000, 2000}, {arc, MakeLine({1000, 2003}, {1004, 2006})});
  ASSERT_EQ(seen.size(), 2u);
  EXPECT_EQ(seen[0].start.x, 3.0);
  EXPECT_EQ(seen[0].start.y, 0.0);
  EXPECT_EQ(seen[0].end.y, 3.0);
  EXPECT_EQ(seen[0].center.x, 0.0);
  EXPECT_EQ(seen[0].center.y, 0.0);
  EXPECT_EQ(seen[0].radius, 3.0);
  EXPECT_EQ(seen[0].sweep, arc.sweep);
  EXPECT_EQ(seen[0].length, arc.length);
  EXPECT_EQ(seen[1].end.x, 4.0);
  EXPECT_EQ(seen[1].length, 5.0);
  EXPECT_TRUE(SeenFrom({1, 1}, {}).empty());
}

}  // namespace
}  // namespace Vorn::IO
