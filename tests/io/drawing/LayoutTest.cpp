#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "io/Contours.h"
#include "io/drawing/Layout.h"

namespace Vorn::IO::Svg {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// A view with one pixel per unit and the origin of the plane at (100, 100).
View PlainView() {
  return {{-100.0 / 1.14, 100.0 / 1.14, -1.0, 1.0}, 0.0, 0.0, 200.0, 200.0, 400.0};
}

TEST(Rect, ContainsItsBordersAndOverlapsWithoutThem) {
  Rect const rect = {10, 20, 30, 40};
  EXPECT_EQ(rect.Right(), 40.0);
  EXPECT_EQ(rect.Bottom(), 60.0);
  EXPECT_TRUE(rect.Contains(rect));
  EXPECT_FALSE(rect.Contains({10, 20, 30.5, 40}));
  EXPECT_FALSE(rect.Contains({9.5, 20, 10, 10}));
  EXPECT_FALSE(rect.Overlaps({40, 20, 5, 5})) << "a common side is no area";
  EXPECT_FALSE(rect.Overlaps({10, 60, 5, 5}));
  EXPECT_TRUE(rect.Overlaps({39.5, 59.5, 5, 5}));
  EXPECT_TRUE(rect.Overlaps({15, 25, 1, 1})) << "one inside the other";
}

TEST(Box, GrowsToWhatItIncludes) {
  Box box = {1, 1, 2, 2};
  box.Include(-3, 5);
  EXPECT_EQ(box.Width(), 4.0);
  EXPECT_EQ(box.Height(), 3.0);
  box.Include(0, 3);
  EXPECT_EQ(box.Width(), 4.0);
}

TEST(NiceStep, IsOneTwoOrFiveTimesAPowerOfTen) {
  EXPECT_EQ(NiceStep(1.0), 1.0);
  EXPECT_EQ(NiceStep(1.1), 2.0);
  EXPECT_EQ(NiceStep(3.0), 5.0);
  EXPECT_EQ(NiceStep(7.0), 10.0);
  EXPECT_DOUBLE_EQ(NiceStep(0.03), 0.05);
}

TEST(TicksBetween, LabelsTellNeighboursApart) {
  Ticks const ticks = TicksBetween(400770.1, 400770.9, 0.2);
  ASSERT_EQ(ticks.values.size(), 4u);
  EXPECT_EQ(ticks.Label(ticks.values.front()), "400770.2");
  Ticks const whole = TicksBetween(-30.0, 30.0, 20.0);
  ASSERT_EQ(whole.values.size(), 3u);
  EXPECT_EQ(whole.Label(whole.values[1]), "0");
}

TEST(TicksBetween, EndsWhereStepsVanishAgainstTheValues) {
  EXPECT_LE(TicksBetween(1e17, 1e17, 0.1).values.size(), 40u);
}

TEST(View, TurnsTheYAxisUpAndKeepsOneScale) {
  View const view = PlainView();
  EXPECT_NEAR(view.Scale(), 1.0, 1e-12);
  EXPECT_NEAR(view(0.0, 0.0).x, 100.0, 1e-12);
  EXPECT_NEAR(view(10.0, 30.0).x, 110.0, 1e-12);
  EXPECT_NEAR(view(10.0, 30.0).y, 70.0, 1e-12);
}

TEST(View, PointsOnOneLineOrInOnePlaceStillGetAScale) {
  for (Box const& box : {Box{0, 10, 3, 3}, Box{3, 3, 0, 10}, Box{3, 3, 3, 3}, Box{0, 1e-300, 0, 0},
                         Box{-1e300, 1e300, 0, 1e300}}) {
    View const view(box, 0.0, 0.0, 500.0, 100.0, 400.0);
    EXPECT_GT(view.Scale(), 0.0);
    EXPECT_TRUE(std::isfinite(view(box.xMax, box.yMax).x));
  }
}

TEST(NiceStep, IsTheLeastNiceNumberNotBelow) {
  std::mt19937_64 engine(2);
  std::uniform_real_distribution<double> exponent(-12.0, 12.0);
  for (int round = 0; round < 2000; ++round) {
    double const least = std::pow(10.0, exponent(engine));
    double const step = NiceStep(least);
    double const power = std::pow(10.0, std::floor(std::log10(step) + 1e-9));
    double const factor = step / power;
    EXPECT_TRUE(std::fabs(factor - 1) < 1e-9 || std::fabs(factor - 2) < 1e-9 ||
                std::fabs(factor - 5) < 1e-9)
        << step;
    EXPECT_GE(step, least * (1 - 1e-15));
    EXPECT_LE(step, 2.5 * least * (1 + 1e-12)) << "from 2 to 5 is the widest gap";
    double const floor = NiceFloor(least);
    EXPECT_LE(floor, least * (1 + 1e-15));
    EXPECT_GE(floor, least / 2.5 * (1 - 1e-12));
  }
}

TEST(TicksBetween, AreMultiplesOfTheStepInside) {
  Ticks const ticks = TicksBetween(-7.0, 12.0, 4.0);
  EXPECT_EQ(ticks.step, 5.0);
  EXPECT_EQ(ticks.values, (std::vector<double>{-5, 0, 5, 10}));
  EXPECT_TRUE(TicksBetween(1.1, 1.9, 1.0).values.empty());
  EXPECT_EQ(TicksBetween(1.0, 2.0, 1.0).values, (std::vector<double>{1, 2}));
}

TEST(TicksBetween, AreNeverMoreThanForty) {
  EXPECT_EQ(TicksBetween(0.0, 1e9, 1.0).values.size(), 40u);
  EXPECT_TRUE(TicksBetween(std::nan(""), std::nan(""), 1.0).values.empty());
}

TEST(Ticks, LabelsHaveTheDigitsOfTheStep) {
  EXPECT_EQ(TicksBetween(0.0, 1.0, 0.2).Label(0.4), "0.4");
  EXPECT_EQ(TicksBetween(0.0, 1.0, 0.05).Label(0.5), "0.50");
  EXPECT_EQ(TicksBetween(0.0, 5000.0, 1000.0).Label(3000.0), "3000");
  EXPECT_EQ(TicksBetween(0.0, 5e8, 1e8).Label(2e8), "2e+08");
}

TEST(View, MapsTheMiddleOfTheBoxToTheMiddleOfTheFrame) {
  View const view({0, 200, 0, 100}, 10, 20, 400, 50, 300);
  Pixel const middle = view(100, 50);
  EXPECT_DOUBLE_EQ(middle.x, 10 + 200);
  EXPECT_DOUBLE_EQ(middle.y, 20 + 0.5 * view.Frame().height);
  Pixel const upper = view(100, 51);
  EXPECT_DOUBLE_EQ(upper.x, middle.x);
  EXPECT_NEAR(middle.y - upper.y, view.Scale(), 1e-12);
}

TEST(View, ShowsTheWholeBoxWithSomeRoomWhateverItsShape) {
  std::mt19937_64 engine(3);
  std::uniform_real_distribution<double> exponent(-6.0, 6.0);
  for (int round = 0; round < 500; ++round) {
    double const width = std::pow(10.0, exponent(engine));
    double const height = std::pow(10.0, exponent(engine));
    double const x = std::pow(10.0, exponent(engine));
    View const view({x, x + width, -height, 0}, 0, 0, 900, 100, 500);
    Box const seen = view.Visible();
    EXPECT_LE(seen.xMin, x);
    EXPECT_GE(seen.xMax, x + width);
    EXPECT_LE(seen.yMin, -height);
    EXPECT_GE(seen.yMax, 0.0);
    EXPECT_GE(view.Frame().height, 100.0);
    EXPECT_LE(view.Frame().height, 500.0);
    Pixel const corner = view(seen.xMin, seen.yMax);
    // Coordinates far larger than the extent take up the digits of the pixels.
    double const rounding = 1e-9 + 1e-15 * (x + width + height) * view.Scale();
    EXPECT_NEAR(corner.x, 0.0, rounding);
    EXPECT_NEAR(corner.y, 0.0, rounding);
  }
}

TEST(BoxAround, OfPiecesAloneTakesInTheBulgesOfArcs) {
  Box const box = BoxAround(MakeDrawing({}, {MakeArc({1, 0}, {-1, 0}, {0, 0}, 1, true)}));
  EXPECT_NEAR(box.yMax, 1.0, 1e-12);
  EXPECT_EQ(box.yMin, 0.0);
  EXPECT_EQ(box.xMin, -1.0);
}

TEST(BoxAround, AContourFarFromItsPointsWidensItByHalfTheirExtentAtMost) {
  Drawing const drawing = MakeDrawing({{0, 0, 0}, {10, 4, 0}},
                                      {MakeLine({0, 0}, {1000, -2}), MakeLine({0, 0}, {0, 9})});
  Box const box = BoxAround(drawing);
  EXPECT_EQ(box.xMax, 15.0) << "10 and half of the larger extent";
  EXPECT_EQ(box.yMin, -2.0);
  EXPECT_EQ(box.yMax, 9.0);
  EXPECT_EQ(box.xMin, 0.0);
}

TEST(BoxAround, PlacesAtInfinityAreLeftOut) {
  Drawing const drawing = MakeDrawing({{0, 0, 0}, {10, 4, 0}}, {});
  Box const box = BoxAround(drawing, {{kInfinity, 1}, {std::nan(""), 2}, {12, 3}});
  EXPECT_EQ(box.xMax, 12.0);
  EXPECT_EQ(box.yMax, 4.0);
}

TEST(ReadableMagnification, IsARoundNumberThatMakesTheToleranceReadable) {
  Drawing const drawing = MakeDrawing({{1, 0.01, 0.02}, {9, 0, 0.02}}, Contours::LineAndQuarter());
  // 14 pixels for 0.02 units of 10 pixels each are 70 times as large.
  EXPECT_EQ(ReadableMagnification(drawing, 10.0), 50.0);
  EXPECT_EQ(ReadableMagnification(drawing, 1000.0), 1.0);
  Drawing const outside = MakeDrawing({{1, 1.0, 0.02}, {9, 0, 0.02}}, Contours::LineAndQuarter());
  EXPECT_EQ(ReadableMagnification(outside, 10.0), 5.0) << "70 pixels for the deviation at most";
  Drawing const exact = MakeDrawing({{1, 0, 0}, {9, 0, 0}}, Contours::LineAndQuarter());
  EXPECT_EQ(ReadableMagnification(exact, 10.0), 1.0) << "nothing to magnify";
}

TEST(NiceFloor, IsOneTwoOrFiveTimesAPowerOfTen) {
  EXPECT_EQ(NiceFloor(1.0), 1.0);
  EXPECT_EQ(NiceFloor(4.9), 2.0);
  EXPECT_EQ(NiceFloor(70.0), 50.0);
  EXPECT_EQ(NiceFloor(100.0), 100.0);
}

TEST(ReadableMagnification, NothingMeasuredIsNotMagnified) {
  EXPECT_EQ(ReadableMagnification(MakeDrawing({{0, 0, 1}, {1, 0, 1}}, {}), 3.0), 1.0);
}

TEST(ReadableMagnification, IsNeverBelowOne) {
  Drawing const wide = MakeDrawing({{0, 5, 100}, {10, 5, 100}}, {MakeLine({0, 0}, {10, 0})});
  EXPECT_EQ(ReadableMagnification(wide, 50.0), 1.0);
}

TEST(ReadableMagnification, PointsOnTheContourWithoutTolerancesAreNotMagnified) {
  Drawing const exact = MakeDrawing({{0, 0, 0}, {10, 0, 0}}, {MakeLine({0, 0}, {10, 0})});
  EXPECT_EQ(ReadableMagnification(exact, 50.0), 1.0);
}

}  // namespace
}  // namespace Vorn::IO::Svg
