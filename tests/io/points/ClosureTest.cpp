#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <random>

#include "support/SharedData.h"
#include "vorn/io/Closure.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;

bool IsClosed(std::vector<WPoint> const& points) {
  return FindClosure(points, ClosedChoice::Auto).isClosed;
}

/// `count` points around a circle of radius 1 in steps of `step` radians.
std::vector<WPoint> Around(int count, double step) {
  std::vector<WPoint> points;
  for (int i = 0; i < count; ++i) {
    points.push_back({std::cos(i * step), std::sin(i * step), 0.001});
  }
  return points;
}

/// The sides of a square, `perSide` points each, from the corner (0, 0) round to before it.
std::vector<WPoint> Square(int perSide, double w) {
  std::vector<WPoint> points;
  for (int i = 0; i < 4 * perSide; ++i) {
    int const along = i % perSide;
    int const side = i / perSide;
    double const x = side == 0 ? along : side == 1 ? perSide : side == 2 ? perSide - along : 0;
    double const y = side == 0 ? 0 : side == 1 ? along : side == 2 ? perSide : perSide - along;
    points.push_back({x, y, w});
  }
  return points;
}

TEST(FindClosure, RepeatedFirstPointIsClosed) {
  Closure const closure =
      FindClosure({{0, 0, 1}, {1, 0, 1}, {0, 1, 1}, {0, 0, 1}}, ClosedChoice::Auto);
  EXPECT_TRUE(closure.isClosed);
  EXPECT_TRUE(closure.repeatsFirst);
  EXPECT_EQ(closure.gap, 0.0);
}

TEST(FindClosure, ThereAndBackIsNotClosed) {
  EXPECT_FALSE(IsClosed({{0, 0, 1}, {1, 0, 1}, {0, 0, 1}}));
  EXPECT_FALSE(IsClosed({{0, 0, 1}, {0, 0, 1}}));
}

TEST(FindClosure, GapOfOneStepIsClosedAndOfTwoIsOpen) {
  for (int const count : {8, 9, 57, 1000}) {
    double const step = 2.0 * pi / count;
    EXPECT_TRUE(IsClosed(Around(count, step))) << count;
    if (count > 8) {
      EXPECT_FALSE(IsClosed(Around(count - 1, step))) << count;
    }
  }
}

TEST(FindClosure, ScanThatStopsAnywhereInItsLastStepIsClosed) {
  for (double const share : {0.01, 0.3, 0.99}) {
    EXPECT_TRUE(IsClosed(Around(100, 2.0 * pi / (99.0 + share)))) << share;
  }
}

TEST(FindClosure, FewPointsAreClosedOnlyWhenTheyRepeat) {
  EXPECT_FALSE(IsClosed(Around(7, 2.0 * pi / 7.0)));
}

TEST(FindClosure, SeamInARightCornerIsClosed) { EXPECT_TRUE(IsClosed(Square(10, 0.1))); }

TEST(FindClosure, LongStepsElsewhereDoNotExcuseAGap) {
  // An open C of steps of 0.01 that misses 0.5 in the middle and 0.4 at its ends.
  std::vector<WPoint> points;
  for (int i = 0; i <= 588; ++i) {
    double const angle = 0.2 + i * 0.01;
    if (std::fabs(angle - pi) > 0.25) points.push_back({std::cos(angle), std::sin(angle), 0.001});
  }
  EXPECT_FALSE(IsClosed(points));
}

TEST(FindClosure, ThinBodyOpenAtOneEndStaysOpen) {
  std::vector<WPoint> points;
  for (int i = 0; i <= 20; ++i) points.push_back({20.0 - i, 0.4, 0.1});
  for (int i = 0; i <= 20; ++i) points.push_back({static_cast<double>(i), -0.4, 0.1});
  Closure const closure = FindClosure(points, ClosedChoice::Auto);
  EXPECT_FALSE(closure.isClosed);
  EXPECT_EQ(closure.reason, "the contour would turn back between its ends");
}

TEST(FindClosure, UserIsTakenAtTheirWord) {
  std::vector<WPoint> const open = Around(20, 0.1);
  EXPECT_TRUE(FindClosure(open, ClosedChoice::Yes).isClosed);
  std::vector<WPoint> closed = Around(20, 0.1 * pi);
  EXPECT_FALSE(FindClosure(closed, ClosedChoice::No).isClosed);
}

TEST(FindClosure, TellsTheMeasuredContoursApart) {
  auto const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  for (char const* name : {"hatch_boundary", "glyph_five", "gcode_letter_d", "circle_r3"}) {
    EXPECT_TRUE(IsClosed(Testing::ReadPoints(*folder + "/" + name + ".csv"))) << name;
  }
  for (char const* name : {"rail_head_known_arcs", "wheel_worn_a", "rail_worn_low",
                           "mirror_sphere_83m", "test_track_centreline", "airfoil_clark_y"}) {
    EXPECT_FALSE(IsClosed(Testing::ReadPoints(*folder + "/" + name + ".csv"))) << name;
  }
}

TEST(MakeCircuit, RunsFromTheSeamToTheSeamAgain) {
  std::vector<WPoint> points = {{0, 0, 1}, {1, 0, 1}, {1, 1, 1}, {0, 1, 1}};
  Closure closure;
  Circuit const circuit = MakeCircuit(points, closure, 2);
  EXPECT_EQ(circuit.origin, (std::vector<std::size_t>{2, 3, 0, 1, 2}));
  EXPECT_EQ(circuit.points[2].x, 0.0);
  EXPECT_EQ(circuit.points.back().y, 1.0);

  points.push_back(points.front());
  closure.repeatsFirst = true;
  EXPECT_EQ(MakeCircuit(points, closure, 2).origin, circuit.origin) << "the repeated point is gone";
  EXPECT_EQ(MakeCircuit(points, closure, 4).origin, (std::vector<std::size_t>{0, 1, 2, 3, 0}));
}

/// The square from another of its points on.
std::vector<WPoint> Rotated(std::vector<WPoint> points, std::size_t by) {
  std::rotate(points.begin(), points.begin() + static_cast<std::ptrdiff_t>(by), points.end());
  return points;
}

TEST(SharpestCorner, IsFoundWhereverTheFileBegins) {
  // One corner of the square is pulled out to be sharper than the others.
  std::vector<WPoint> square = Square(10, 0.01);
  square[20] = {12.0, 12.0, 0.01};
  for (std::size_t by = 0; by < square.size(); ++by) {
    std::vector<WPoint> points = Rotated(square, by);
    std::size_t const expected = (20 + square.size() - by) % square.size();
    EXPECT_EQ(SharpestCorner(points, {}), expected) << by;
    points.push_back(points.front());
    Closure closure;
    closure.repeatsFirst = true;
    EXPECT_EQ(SharpestCorner(points, closure), expected) << by;
  }
}

TEST(SharpestCorner, NoiseWithinTheToleranceIsNoCorner) {
  constexpr std::uint64_t kSeed = 3;
  SCOPED_TRACE(kSeed);
  std::mt19937_64 engine(kSeed);
  // Steps of 0.05 with noise of 0.02 either way: from point to point the path turns wildly.
  std::vector<WPoint> points = Square(200, 0.02);
  for (WPoint& point : points) {
    auto const noise = [&] { return 0.04 * (static_cast<double>(engine() >> 11) * 0x1p-53 - 0.5); };
    point = {0.05 * point.x + noise(), 0.05 * point.y + noise(), point.w};
  }
  std::size_t const corner = SharpestCorner(Rotated(points, 77), {}).value();
  std::size_t const side = (corner + 77) % 200;
  EXPECT_LE(std::min(side, 200 - side), 1u) << corner;
}

TEST(SharpestCorner, SmoothContourHasNone) {
  EXPECT_FALSE(SharpestCorner(Around(100, 2.0 * pi / 100), {}).has_value());
}

}  // namespace
}  // namespace Vorn::IO
