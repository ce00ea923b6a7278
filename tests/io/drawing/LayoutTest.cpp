#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "io/drawing/Feet.h"
#include "io/drawing/Layout.h"

namespace Vorn::IO::Svg {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

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

TEST(PlaceOn, IsThatFarFromTheStartAlongThePiece) {
  Piece const line = MakeLine({1, 1}, {4, 5});
  EXPECT_DOUBLE_EQ(PlaceOn(line, 2.5).x, 2.5);
  EXPECT_DOUBLE_EQ(PlaceOn(line, 2.5).y, 3.0);
  Piece const arc = MakeArc({2, 0}, {-2, 0}, {0, 0}, 2, true);
  EXPECT_NEAR(PlaceOn(arc, 0.5 * arc.length).y, 2.0, 1e-15);
  EXPECT_EQ(PlaceOn(line, line.length).x, 4.0);
  EXPECT_EQ(PlaceOn(MakeLine({3, 7}, {3, 7}), 0.0).y, 7.0) << "a piece without length";
}

TEST(PieceStarts, AddUpTheLengths) {
  EXPECT_EQ(PieceStarts({}), std::vector<double>{0.0});
  EXPECT_EQ(PieceStarts({MakeLine({0, 0}, {3, 4}), MakeLine({9, 9}, {9, 11})}),
            (std::vector<double>{0.0, 5.0, 7.0}));
}

TEST(MakeDrawing, MeasuresOnlyPointsAgainstPieces) {
  EXPECT_FALSE(MakeDrawing({{0, 1, 1}}, {}).IsMeasured());
  EXPECT_FALSE(MakeDrawing({}, {MakeLine({0, 0}, {1, 0})}).IsMeasured());
  EXPECT_FALSE(MakeDrawing({}, {}).HasContour());
  Drawing const both = MakeDrawing({{0, 1, 2}, {1, -3, 2}}, {MakeLine({0, 0}, {5, 0})});
  ASSERT_TRUE(both.IsMeasured());
  EXPECT_EQ(both.deviations[1].distance, 3.0);
  EXPECT_EQ(both.Worst(), 1u);
  EXPECT_EQ(both.verdict, Verdict::OutsideTolerance);
}

TEST(MakeDrawing, OnePointWithoutAToleranceLeavesItUnjudged) {
  Drawing const drawing = MakeDrawing({{0, 1, 2}, {1, 0, 0}}, {MakeLine({0, 0}, {5, 0})});
  EXPECT_FALSE(drawing.HasTolerances());
  EXPECT_FALSE(drawing.verdict);
}

TEST(MakeDrawing, APlaceThatIsNoneIsOutside) {
  Drawing const drawing =
      MakeDrawing({{0, 0, 1}, {std::nan(""), 0, 1}, {2, 0, 1}}, {MakeLine({0, 0}, {5, 0})});
  EXPECT_EQ(drawing.verdict, Verdict::OutsideTolerance);
}

TEST(DescribeTolerance, TellsOneOrARangeWithUnits) {
  Drawing drawing = MakeDrawing({{0, 0, 0.02}, {1, 0, 0.02}}, {});
  EXPECT_EQ(DescribeTolerance(drawing), "tolerance 0.02");
  drawing.units = "mm";
  drawing.points[1].w = 0.05;
  EXPECT_EQ(DescribeTolerance(drawing), "tolerance 0.02 to 0.05 mm");
  drawing.points[0].w = 0.0;
  EXPECT_EQ(DescribeTolerance(drawing), "");
}

}  // namespace
}  // namespace Vorn::IO::Svg
