#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "geometry/fewest/LocalFrame.h"
#include "support/RandomGeometry.h"

namespace Vorn::Fewest {
namespace {

using Testing::RandomGeometry;

TEST(ScaleOf, TakesALengthToBetweenAHalfAndOne) {
  EXPECT_EQ(ScaleOf(0.5), 1.0);
  EXPECT_EQ(ScaleOf(0.75), 1.0);
  EXPECT_EQ(ScaleOf(1.0), 0.5);
  EXPECT_EQ(ScaleOf(3.0), 0.25);
  EXPECT_EQ(ScaleOf(0x1p-900), 0x1p899);
  EXPECT_EQ(ScaleOf(std::numeric_limits<double>::max()), 0x1p-1024);
}

TEST(ScaleOf, LeavesTheRangeOfSquaresToTheSmallestLengths) {
  EXPECT_EQ(ScaleOf(0x1p-1001), 0x1p1000);
  EXPECT_EQ(ScaleOf(0x1p-1074), 0x1p1000);
}

TEST(ScaleOf, IsOneWithoutALength) {
  EXPECT_EQ(ScaleOf(0.0), 1.0);
  EXPECT_EQ(ScaleOf(std::numeric_limits<double>::quiet_NaN()), 1.0);
}

TEST(ExtentOf, IsTheLargerDistanceFromTheFirstPointInXOrInY) {
  std::vector<WPoint> points = {{1.0, 2.0, 9.0}, {-3.0, 2.5, 9.0}, {2.0, 5.0, 9.0}};
  EXPECT_EQ(ExtentOf(points), 4.0);
  points.push_back({1.0, -4.0, 9.0});
  EXPECT_EQ(ExtentOf(points), 6.0);
  EXPECT_EQ(ExtentOf({points.data(), 1}), 0.0);
}

TEST(ShiftFor, MovesTheFirstPointToTheOriginAndTheOthersNearOne) {
  std::vector<WPoint> const points = {{100.0, -50.0, 0.5}, {103.0, -50.0, 0.25}, {100.0, -49.0, 1}};
  Shift const shift = ShiftFor(points);
  // Half the extent is 1.5, which a quarter takes to below one; half of that for the whole extent.
  EXPECT_EQ(shift.scale, 0.25);
  std::vector<WPoint> const moved = shift.Apply(points);
  EXPECT_EQ(moved[0].x, 0.0);
  EXPECT_EQ(moved[0].y, 0.0);
  EXPECT_EQ(moved[0].w, 0.125);
  EXPECT_EQ(moved[1].x, 0.75);
  EXPECT_EQ(moved[1].y, 0.0);
  EXPECT_EQ(moved[2].y, 0.25);
  GeometryUtils::Point const back = shift.Restore({0.75, 0.25});
  EXPECT_EQ(back.x, 103.0);
  EXPECT_EQ(back.y, -49.0);
}

TEST(ShiftFor, DoesNotOverflowWhereTheExtentDoes) {
  double const largest = std::numeric_limits<double>::max();
  std::vector<WPoint> const points = {{-largest, 0.0, 1.0}, {largest, largest, 1.0}};
  Shift const shift = ShiftFor(points);
  for (WPoint const& p : shift.Apply(points)) {
    EXPECT_LE(std::fabs(p.x), 1.0);
    EXPECT_LE(std::fabs(p.y), 1.0);
  }
}

TEST(ShiftFor, OfOnePlaceKeepsTheSize) {
  std::vector<WPoint> const points = {{7.0, 8.0, 0.5}, {7.0, 8.0, 0.5}};
  EXPECT_EQ(ShiftFor(points).scale, 0.5);
}

TEST(LocalFrame, PlacesMoveThereAndBack) {
  LocalFrame const frame{3.0, -5.0, 8.0};
  Sample const sample = frame.ToLocal(WPoint{3.5, -4.0, 0.25});
  EXPECT_EQ(sample.x, 4.0);
  EXPECT_EQ(sample.y, 8.0);
  EXPECT_EQ(sample.w, 2.0);
  Place const back = frame.FromLocal(Place{4.0, 8.0});
  EXPECT_EQ(back.x, 3.5);
  EXPECT_EQ(back.y, -4.0);
}

/// f is a distance for points near the circle: in local units it is the scale times as large.
TEST(LocalFrame, CirclesHaveTheSameValuesTimesTheScale) {
  constexpr std::uint64_t kSeed = 6400;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 200; ++i) {
    LocalFrame const frame{random.Uniform(-9.0, 9.0), random.Uniform(-9.0, 9.0),
                           std::exp2(random.Integer(-3, 3))};
    auto const origin = random.PointIn(-9.0, 9.0);
    PlacedCircle const circle{{random.Uniform(-1.0, 1.0), random.Uniform(-1.0, 1.0),
                               random.Uniform(-1.0, 1.0), random.Uniform(-1.0, 1.0)},
                              {origin.x, origin.y}};
    auto const p = random.PointIn(-9.0, 9.0);
    Place const place{p.x, p.y};
    double const expected = ValueAt(circle, place);
    Circle const local = frame.ToLocal(circle);
    EXPECT_NEAR(ValueAt(local, frame.ToLocal(place)), frame.scale * expected, 1e-10);
    EXPECT_NEAR(ValueAt(frame.FromLocal(local), place), expected, 1e-10);
    EXPECT_NEAR(Form(local, local), Form(circle.about, circle.about), 1e-10);
  }
}

}  // namespace
}  // namespace Vorn::Fewest
