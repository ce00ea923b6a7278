#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <numeric>

#include "io/Contours.h"
#include "vorn/io/PieceMeasures.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;

std::vector<PieceMeasure> Measures(std::vector<WPoint> const& points,
                                   std::vector<Piece> const& pieces, bool isClosed = false) {
  return MeasurePieces(points, Remeasure(points, pieces).points, pieces, isClosed);
}

/// Up, then a quarter circle about (1, 2) to the right, then straight on to the right.
std::vector<Piece> RoundedCorner() {
  return {MakeLine({0, 0}, {0, 2}), MakeArc({0, 2}, {1, 3}, {1, 2}, 1.0, false),
          MakeLine({1, 3}, {4, 3})};
}

TEST(MeasurePieces, TellsTheRadiusOfThePointsAndNotOfThePiece) {
  // The part has a radius of 300; the arc drawn through its points has 280 and keeps 0.02.
  std::vector<WPoint> points;
  for (int i = -10; i <= 10; ++i) {
    double const angle = 0.5 * pi + 0.001 * i;
    points.push_back({300.0 * std::cos(angle), 300.0 * std::sin(angle) - 300.0, 0.02});
  }
  XY const start{points.front().x, points.front().y};
  XY const end{points.back().x, points.back().y};
  double const half = 0.5 * (end.x - start.x);
  Piece const arc = MakeArc(start, end, {0.0, start.y - std::sqrt(280.0 * 280.0 - half * half)},
                            280.0, half < 0.0);
  auto const measures = Measures(points, {arc});
  ASSERT_TRUE(measures.front().circle);
  EXPECT_NEAR(measures.front().circle->radius, 300.0, 1e-6);
  EXPECT_EQ(measures.front().points, points.size());
  EXPECT_FALSE(measures.front().line);
  EXPECT_LT(measures.front().ScatterOfPoints()->formError, 1e-9);
}

TEST(MeasurePieces, DirectionOfALineIsThatOfTravel) {
  std::vector<WPoint> const points = {{0, 0, .1}, {-1, 0, .1}, {-2, 0, .1}};
  auto const back = Measures(points, {MakeLine({0, 0}, {-2, 0})});
  ASSERT_TRUE(back.front().line);
  EXPECT_DOUBLE_EQ(back.front().line->direction, pi);
  auto const forth = Measures(points, {MakeLine({-2, 0}, {0, 0})});
  EXPECT_DOUBLE_EQ(forth.front().line->direction, 0.0);
  auto const down = Measures({{0, 1, .1}, {0, 0, .1}}, {MakeLine({0, 1}, {0, 0})});
  EXPECT_DOUBLE_EQ(down.front().line->direction, -0.5 * pi);
}

TEST(MeasurePieces, TurnsAtJointsAreNoughtWhereTangentialAndToTheLeftPositive) {
  std::vector<WPoint> const points = {{0, 1, .1}, {0.3, 2.7, .1}, {2, 3, .1}};
  auto const smooth = Measures(points, RoundedCorner());
  EXPECT_NEAR(smooth[0].turn.value(), 0.0, 1e-15);
  EXPECT_NEAR(smooth[1].turn.value(), 0.0, 1e-15);
  EXPECT_FALSE(smooth[2].turn) << "the end of an open contour";
  std::vector<Piece> const square = {MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {1, 1}),
                                     MakeLine({1, 1}, {0, 1}), MakeLine({0, 1}, {0, 0})};
  for (PieceMeasure const& measure : Measures(points, square, true)) {
    EXPECT_DOUBLE_EQ(measure.turn.value(), 0.5 * pi);
  }
  std::vector<Piece> const hairpin = {MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {0, 0})};
  EXPECT_DOUBLE_EQ(Measures(points, hairpin)[0].turn.value(), pi) << "never minus a half turn";
}

TEST(MeasurePieces, PieceWithoutEnoughPointsHasNoMeasure) {
  auto const measures = Measures({{0, 1, .1}, {0.3, 2.7, .1}, {2, 3, .1}}, RoundedCorner());
  for (PieceMeasure const& measure : measures) {
    EXPECT_EQ(measure.points, 1u);
    EXPECT_FALSE(measure.line || measure.circle);
    EXPECT_EQ(measure.ScatterOfPoints(), nullptr);
  }
}

/// A line along the x axis with a point at each of these heights.
std::vector<WPoint> AtHeights(std::vector<double> const& heights, double tolerance) {
  std::vector<WPoint> points;
  for (double const height : heights) {
    points.push_back({static_cast<double>(points.size()), height, tolerance});
  }
  return points;
}

DeviationSummary SummaryOf(std::vector<WPoint> const& points, bool hasTolerances) {
  std::vector<Piece> const pieces = {MakeLine({0, 0}, {10, 0})};
  return Summarise(points, Remeasure(points, pieces).points, hasTolerances);
}

TEST(Summarise, MeanAndRootMeanSquareAreLengthsWithSigns) {
  DeviationSummary const summary = SummaryOf(AtHeights({0.3, -0.3, 0.1, -0.5}, 1.0), true);
  EXPECT_NEAR(summary.mean, -0.1, 1e-15);
  EXPECT_NEAR(summary.rootMeanSquare, std::sqrt((0.09 + 0.09 + 0.01 + 0.25) / 4.0), 1e-15);
  EXPECT_EQ(summary.outside, 0u);
}

TEST(Summarise, HistogramIsOfMultiplesOfTheTolerance) {
  DeviationSummary const summary =
      SummaryOf(AtHeights({0.0, 0.02, -0.02, 0.15, -0.19, 0.2, 0.5, -3.0}, 0.2), true);
  ASSERT_TRUE(summary.isRelative);
  EXPECT_EQ(summary.histogram.low, -1.0);
  ASSERT_EQ(summary.histogram.counts.size(), 20u);
  EXPECT_DOUBLE_EQ(summary.histogram.width, 0.1);
  EXPECT_EQ(summary.histogram.counts[19], 1u) << "at the tolerance is within";
  EXPECT_EQ(summary.histogram.counts[0], 1u);
  EXPECT_EQ(summary.histogram.above, 1u);
  EXPECT_EQ(summary.histogram.below, 1u);
  EXPECT_EQ(summary.outside, 2u);
  std::size_t const inside = std::accumulate(summary.histogram.counts.begin(),
                                             summary.histogram.counts.end(), std::size_t{0});
  EXPECT_EQ(inside, 6u) << "every point counts once";
}

TEST(Summarise, HistogramWithoutTolerancesReachesToTheLargestDeviation) {
  DeviationSummary const summary = SummaryOf(AtHeights({0.25, -0.5, 0.0}, 0.0), false);
  EXPECT_FALSE(summary.isRelative);
  EXPECT_EQ(summary.histogram.low, -0.5);
  EXPECT_EQ(summary.histogram.counts[0], 1u);
  EXPECT_EQ(summary.outside, 0u);
  EXPECT_EQ(SummaryOf(AtHeights({0.0, 0.0}, 0.0), false).histogram.counts[10], 2u);
}

TEST(Summarise, WhatIsNotANumberIsOutside) {
  DeviationSummary const summary = SummaryOf(AtHeights({0.0, std::nan("")}, 0.1), true);
  EXPECT_EQ(summary.outside, 1u);
  EXPECT_EQ(summary.histogram.above + summary.histogram.below, 1u);
}

}  // namespace
}  // namespace Vorn::IO
