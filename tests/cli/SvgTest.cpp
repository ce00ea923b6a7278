#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <regex>

#include "cli/Contours.h"
#include "cli/Svg.h"
#include "cli/SvgContour.h"
#include "cli/SvgLayout.h"

namespace Vorn::Cli::Svg {
namespace {

using std::numbers::pi;

std::size_t Occurrences(std::string const& text, std::string const& part) {
  std::size_t count = 0;
  for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) {
    ++count;
  }
  return count;
}

/// A view with one pixel per unit and the origin of the plane at (100, 100).
View PlainView() {
  return {{-100.0 / 1.14, 100.0 / 1.14, -1.0, 1.0}, 0.0, 0.0, 200.0, 200.0, 400.0};
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

TEST(PathData, CounterClockwiseIsTheNegativeSenseOfSvg) {
  auto const quarter = [](double direction) {
    double const to = direction > 0.0 ? 0.5 * pi : -0.5 * pi;
    return PathData(PiecesOf({Contours::Segment(50, 0), Contours::Arc(0, 0, 50, 0, to, direction)}),
                    PlainView());
  };
  EXPECT_EQ(quarter(1.0), "M150,100A50,50 0 0 0 100,50");
  EXPECT_EQ(quarter(-1.0), "M150,100A50,50 0 0 1 100,150");
}

TEST(PathData, ArcBeyondHalfATurnIsWrittenInParts) {
  std::string const data =
      PathData(PiecesOf({Contours::Segment(50, 0), Contours::Arc(0, 0, 50, 0, -0.5 * pi, 1.0)}),
               PlainView());
  EXPECT_EQ(data, "M150,100A50,50 0 0 0 100,50A50,50 0 0 0 50,100A50,50 0 0 0 100,150");
}

TEST(PathData, FlatArcOfAnEnormousRadiusIsALine) {
  double const radius = 1e9;
  std::string const data = PathData(
      PiecesOf({Contours::Segment(0, 0),
                Contours::Arc(0, -radius, radius, 0.5 * pi, 0.5 * pi - 50.0 / radius, -1.0)}),
      PlainView());
  EXPECT_EQ(data, "M100,100L150,100");
}

TEST(Escaped, LeavesNoMarkupAndNoControlCharacters) {
  EXPECT_EQ(Escaped("a<b>&\"c\"\x01\n"), "a&lt;b&gt;&amp;&quot;c&quot;");
}

TEST(ToSvg, DrawsEveryPieceOnceByKind) {
  std::string const svg = ToSvg(Contours::LineAndArcReport());
  EXPECT_EQ(Occurrences(svg, "<title>"), 2u);
  EXPECT_NE(svg.find("<title>1: line, length 4, 3 points</title>"), std::string::npos);
  EXPECT_NE(svg.find("<title>2: arc, radius 1, 270 degrees, 4 points</title>"), std::string::npos);
  EXPECT_EQ(svg.find("nan"), std::string::npos);
  EXPECT_EQ(Occurrences(svg, "<g"), Occurrences(svg, "</g>") + Occurrences(svg, "<g/>"));
}

TEST(ToSvg, PieceIsDrawnAlikeAtAnyScaleAndPlace) {
  auto const drawing = [](double scale, double offset) {
    double const w = 0.125 * scale;
    FitAnswer fit;
    fit.code = ErrorCode::Ok;
    fit.contour = {Contours::Segment(offset, offset),
                   Contours::Segment(offset + 8.0 * scale, offset + 4.0 * scale)};
    fit.deviation = 0.0;
    Report const report = MakeReport(
        Contours::FileWith({{offset, offset, w}, {offset + 8.0 * scale, offset + 4.0 * scale, w}}),
        "", GeometryUtils::FittingStrategy::Mixed, std::move(fit));
    return ToSvg(report);
  };
  std::regex const piece("<path stroke[^>]*>");
  auto const pieceOf = [&](std::string const& svg) {
    std::smatch match;
    EXPECT_TRUE(std::regex_search(svg, match, piece));
    return match.str();
  };
  std::string const reference = pieceOf(drawing(1.0, 0.0));
  EXPECT_EQ(pieceOf(drawing(0x1p-40, 0.0)), reference);
  EXPECT_EQ(pieceOf(drawing(0x1p60, 0.0)), reference);
  EXPECT_EQ(pieceOf(drawing(1.0, 0x1p20)), reference);
}

TEST(ToSvg, ThousandsOfPointsStaySmall) {
  std::vector<WPoint> points;
  for (int i = 0; i < 10000; ++i) points.push_back({0.1 * i, 0.0, 0.01});
  FitAnswer fit;
  fit.code = ErrorCode::Ok;
  fit.contour = {Contours::Segment(0, 0), Contours::Segment(999.9, 0)};
  fit.deviation = 0.0;
  Report const report = MakeReport(Contours::FileWith(std::move(points)), "",
                                   GeometryUtils::FittingStrategy::Mixed, std::move(fit));
  EXPECT_LT(ToSvg(report).size(), 500'000u);
}

}  // namespace
}  // namespace Vorn::Cli::Svg
