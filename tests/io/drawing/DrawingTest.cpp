#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <numbers>
#include <regex>

#include "io/Contours.h"
#include "io/Picture.h"
#include "io/drawing/Band.h"
#include "io/drawing/Decimation.h"
#include "io/drawing/Feet.h"
#include "io/drawing/Labels.h"
#include "io/drawing/Layout.h"
#include "io/drawing/Style.h"
#include "io/drawing/SvgElements.h"
#include "io/drawing/SvgPaths.h"
#include "vorn/io/Failure.h"

namespace Vorn::IO::Svg {
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

/// Along the x axis to 10, then a quarter turn to the left about (10, 5).
std::vector<Piece> LineAndQuarter() {
  return PiecesOf({Contours::Segment(0, 0), Contours::Segment(10, 0),
                   Contours::Arc(10, 5, 5, -0.5 * pi, 0.0, 1.0)});
}

TEST(FootOn, IsTheNearestPlaceOfALineAndItsLengthFromTheStart) {
  Piece const line = LineAndQuarter()[0];
  Foot const inside = FootOn(line, 4.0, 3.0);
  EXPECT_EQ(inside.at.x, 4.0);
  EXPECT_EQ(inside.at.y, 0.0);
  EXPECT_EQ(inside.along, 4.0);
  EXPECT_EQ(FootOn(line, -2.0, 3.0).along, 0.0);
  EXPECT_EQ(FootOn(line, 12.0, 3.0).at.x, 10.0);
  EXPECT_EQ(FootOn(line, 12.0, 3.0).along, 10.0);
}

TEST(FootOn, IsTheNearestPlaceOfAnArcAndItsLengthFromTheStart) {
  Piece const arc = LineAndQuarter()[1];
  Foot const inside = FootOn(arc, 13.0, 1.0);
  EXPECT_DOUBLE_EQ(inside.at.x, 13.0);
  EXPECT_DOUBLE_EQ(inside.at.y, 1.0);
  EXPECT_DOUBLE_EQ(inside.along, 5.0 * std::atan2(3.0, 4.0));
  EXPECT_EQ(FootOn(arc, 0.0, -1.0).along, 0.0);
  EXPECT_EQ(FootOn(arc, 15.0, 9.0).along, arc.length);
  EXPECT_EQ(FootOn(arc, 10.0, 5.0).along, 0.0) << "every place is as near to the centre";
}

TEST(Magnified, MovesThePointAwayFromItsFoot) {
  std::vector<Piece> const pieces = LineAndQuarter();
  WPoint const above{4.0, 0.25, 0.5};
  GeometryUtils::Point const moved = Magnified(above, FootOn(pieces[0], 4.0, 0.25), 8.0);
  EXPECT_EQ(moved.x, 4.0);
  EXPECT_EQ(moved.y, 2.0);
  // 1 inside the arc along its radius of slope -4/3.
  WPoint const inner{12.4, 1.8, 0.5};
  GeometryUtils::Point const far = Magnified(inner, FootOn(pieces[1], 12.4, 1.8), 3.0);
  EXPECT_NEAR(far.x, 13.0 - 3.0 * 0.6, 1e-12);
  EXPECT_NEAR(far.y, 1.0 + 3.0 * 0.8, 1e-12);
}

TEST(Magnified, OnceIsThePointItself) {
  WPoint const point{0.1, 0.2, 0.5};
  Foot const foot{{0.3, 0.7}, 0.0};
  EXPECT_EQ(Magnified(point, foot, 1.0).x, 0.1);
  EXPECT_EQ(Magnified(point, foot, 1.0).y, 0.2);
}

TEST(ReadableMagnification, IsARoundNumberThatMakesTheToleranceReadable) {
  Drawing const drawing = MakeDrawing({{1, 0.01, 0.02}, {9, 0, 0.02}}, LineAndQuarter());
  // 14 pixels for 0.02 units of 10 pixels each are 70 times as large.
  EXPECT_EQ(ReadableMagnification(drawing, 10.0), 50.0);
  EXPECT_EQ(ReadableMagnification(drawing, 1000.0), 1.0);
  Drawing const outside = MakeDrawing({{1, 1.0, 0.02}, {9, 0, 0.02}}, LineAndQuarter());
  EXPECT_EQ(ReadableMagnification(outside, 10.0), 5.0) << "70 pixels for the deviation at most";
  Drawing const exact = MakeDrawing({{1, 0, 0}, {9, 0, 0}}, LineAndQuarter());
  EXPECT_EQ(ReadableMagnification(exact, 10.0), 1.0) << "nothing to magnify";
}

TEST(NiceFloor, IsOneTwoOrFiveTimesAPowerOfTen) {
  EXPECT_EQ(NiceFloor(1.0), 1.0);
  EXPECT_EQ(NiceFloor(4.9), 2.0);
  EXPECT_EQ(NiceFloor(70.0), 50.0);
  EXPECT_EQ(NiceFloor(100.0), 100.0);
}

TEST(BandSections, ChangeWidthAtTheFeet) {
  std::vector<WPoint> const points = {{0, 0, .1}, {3, 0, .1}, {6, 0, .3}, {10, 0, .3}};
  Drawing const drawing = MakeDrawing(points, {LineAndQuarter()[0]});
  std::vector<BandSection> const sections = BandSections(drawing, FeetOf(drawing), 0.0);
  ASSERT_EQ(sections.size(), 2u);
  EXPECT_EQ(sections[0].tolerance, 0.1);
  EXPECT_EQ(sections[0].from, 0.0);
  EXPECT_EQ(sections[0].to, 3.0);
  EXPECT_EQ(sections[1].tolerance, 0.3);
  EXPECT_EQ(sections[1].from, 3.0);
  EXPECT_EQ(sections[1].to, 10.0);
}

TEST(BandSections, CoverPiecesWithoutPoints) {
  Drawing const drawing = MakeDrawing({{0, 0, .1}, {3, 0, .1}}, LineAndQuarter());
  std::vector<BandSection> const sections = BandSections(drawing, FeetOf(drawing), 0.0);
  ASSERT_EQ(sections.size(), 2u);
  EXPECT_EQ(sections[1].piece, 1u);
  EXPECT_EQ(sections[1].tolerance, 0.1);
  EXPECT_EQ(sections[1].to, LineAndQuarter()[1].length);
}

TEST(OnePerCell, KeepsTheFirstMarkOfEachCell) {
  std::vector<Pixel> const at = {{0.1, 0.1}, {0.2, 0.2}, {1.1, 0.1}, {-0.1, 0.1}, {0.15, 0.1}};
  EXPECT_EQ(OnePerCell(at, 1.0), (std::vector<std::size_t>{0, 2, 3}));
}

TEST(OnePerCell, LeavesOutWhatIsNowhere) {
  double const nan = std::nan("");
  EXPECT_EQ(OnePerCell({{nan, 0}, {0, HUGE_VAL}, {1e300, 0}, {5, 5}}, 1.0),
            (std::vector<std::size_t>{3}));
}

TEST(StreaksOf, JoinsCellsOneAboveTheOther) {
  std::vector<Streak> const runs = StreaksOf({{0.5, 2.5}, {0.5, 0.5}, {0.2, 1.7}, {0.5, 9.0}}, 1.0);
  ASSERT_EQ(runs.size(), 2u);
  EXPECT_EQ(runs[0].top.y, 0.5);
  EXPECT_EQ(runs[0].height, 2.0);
  EXPECT_EQ(runs[1].top.y, 9.5);
  EXPECT_EQ(runs[1].height, 0.0);
}

TEST(ToPng, ShowsEveryKindInItsColour) {
  Drawing drawing = DrawingOf(Contours::LineAndArcReport());
  Picture const picture = Picture::FromPng(ToPng(drawing, {}));
  EXPECT_EQ(picture.Width(), 1754);
  EXPECT_EQ(picture.Height(), 1240);
  for (std::string const& color :
       {kLineColor, kArcColor, kPointColor, kBandColor, kWorstColor, kStartColor, kLineTint}) {
    EXPECT_GT(picture.Count(color), 20) << color;
  }
  EXPECT_EQ(picture.Count("#ff00ff"), 0);
}

TEST(ToPng, WidthOverridesTheResolution) {
  Picture const picture =
      Picture::FromPng(ToPng(DrawingOf(Contours::LineAndArcReport()), {300.0, 594}));
  EXPECT_EQ(picture.Width(), 594);
  EXPECT_EQ(picture.Height(), 420);
}

TEST(ToPng, RefusesPicturesThatAreTooLarge) {
  EXPECT_THROW(ToPng(DrawingOf(Contours::LineAndArcReport()), {1e6, {}}), Failure);
}

TEST(ToPng, AnyNameIsDrawn) {
  // Only well-formed documents can be drawn at all.
  Drawing drawing = DrawingOf(Contours::LineAndArcReport());
  drawing.title = "<&\"'>]]>\x01 part \xC3\xA4";
  drawing.units = "<b>";
  EXPECT_GT(ToPng(drawing, {}).size(), 1000u);
}

TEST(ToSvg, DrawsEveryPieceOnceByKind) {
  std::string const svg = ToSvg(DrawingOf(Contours::LineAndArcReport()));
  EXPECT_EQ(Occurrences(svg, "<title>"), 2u);
  EXPECT_NE(svg.find("<title>1: line, length 4</title>"), std::string::npos);
  EXPECT_NE(svg.find("<title>2: arc, radius 1, 270 degrees</title>"), std::string::npos);
  EXPECT_EQ(svg.find("nan"), std::string::npos);
}

TEST(ToSvg, LegendTellsTheMagnification) {
  Drawing drawing = DrawingOf(Contours::LineAndArcReport());
  drawing.magnify = 7.0;
  std::string const svg = ToSvg(drawing);
  EXPECT_NE(svg.find("point, deviation \xC3\x97"
                     "7<"),
            std::string::npos);
  EXPECT_NE(svg.find("tolerance \xC3\x97"
                     "7<"),
            std::string::npos);
  drawing.magnify = 1.0;
  EXPECT_EQ(ToSvg(drawing).find("\xC3\x97"), std::string::npos);
}

TEST(ToSvg, PointsAloneInventNothing) {
  std::string const svg = ToSvg(MakeDrawing({{0, 0, 0}, {1, 0, 0}, {2, 1, 0}}, {}));
  for (char const* absent : {"pieces", "joint", "deviation", "band", "worst", "tolerance"}) {
    EXPECT_EQ(svg.find(absent), std::string::npos) << absent;
  }
  EXPECT_NE(svg.find("class=\"start\""), std::string::npos);
  EXPECT_NE(svg.find("class=\"end\""), std::string::npos);
}

TEST(ToSvg, OnePointIsDrawn) {
  EXPECT_NE(ToSvg(MakeDrawing({{3, 4, 0}}, {})).find("class=\"points\""), std::string::npos);
}

TEST(ToSvg, PointsBeyondTheirToleranceAreCrosses) {
  Drawing const drawing =
      MakeDrawing({{0, 0, 0.1}, {5, 0.3, 0.1}, {10, 0, 0.1}}, {LineAndQuarter()[0]});
  EXPECT_EQ(drawing.verdict, Verdict::OutsideTolerance);
  std::string const svg = ToSvg(drawing);
  EXPECT_EQ(Occurrences(svg, "class=\"outside\""), 2u) << "in the contour and in the diagram";
  EXPECT_NE(svg.find("OUTSIDE TOLERANCE"), std::string::npos);
}

/// A comb of so many teeth: short lines side by side.
std::vector<Piece> Comb(int teeth) {
  std::vector<Piece> pieces;
  for (int i = 0; i < teeth; ++i) {
    double const x = 0.1 * i;
    pieces.push_back(MakeLine({x, 0.0}, {x, 1.0}));
    pieces.push_back(MakeLine({x, 1.0}, {x + 0.1, 0.0}));
  }
  return pieces;
}

TEST(ToSvg, OutsideIsRed) {
  Drawing const drawing = MakeDrawing({{1, 0.5, 0.02}, {9, 0, 0.02}}, LineAndQuarter());
  std::string const svg = ToSvg(drawing);
  EXPECT_NE(svg.find("class=\"outside\" fill=\"none\" stroke=\"#c8102e\""), std::string::npos);
  EXPECT_NE(svg.find("fill=\"#c8102e\" font-weight=\"bold\">OUTSIDE TOLERANCE"), std::string::npos);
}

TEST(ToSvg, DeviationBesideTheToleranceDoesNotReadAsAllOfIt) {
  std::string const svg = ToSvg(MakeDrawing({{1, 0.199992, 0.2}, {9, 0, 0.2}}, LineAndQuarter()));
  EXPECT_NE(svg.find("0.99996 of the tolerance"), std::string::npos) << svg.substr(0, 2000);
}

TEST(ToSvg, AxesTellTheirUnits) {
  Drawing drawing = MakeDrawing({}, LineAndQuarter());
  EXPECT_NE(ToSvg(drawing).find(">x</text>"), std::string::npos);
  drawing.units = "mm";
  EXPECT_NE(ToSvg(drawing).find(">x [mm]</text>"), std::string::npos);
  EXPECT_NE(ToSvg(drawing).find(">y [mm]</text>"), std::string::npos);
}

TEST(ToSvg, LegendPromisesSizesOnlyWhereTheyAreWritten) {
  std::string const few = ToSvg(MakeDrawing({}, Comb(20)));
  EXPECT_NE(few.find("line: length"), std::string::npos);
  std::string const many = ToSvg(MakeDrawing({}, Comb(21)));
  EXPECT_EQ(many.find("line: length"), std::string::npos);
  EXPECT_EQ(many.find(">42: 1"), std::string::npos);
}

TEST(Labels, StandAsideWithALeaderWhereThereIsNoRoomBeside) {
  View const view({-50, 50, -50, 50}, 0.0, 0.0, 400.0, 400.0, 400.0);
  Piece const line = MakeLine({-10, 0}, {10, 0});
  Labels labels(view, 0.0);
  labels.TakePiece(line);
  EXPECT_EQ(labels.AddBeside(line, "1: 20").find("<line"), std::string::npos);
  // Now everything near is taken.
  for (int x = -150; x <= 150; x += 3) {
    for (int y = -55; y <= 55; y += 3) labels.Take({200.0 + x, 200.0 + y});
  }
  EXPECT_EQ(labels.AddBeside(line, "1: 20"), "");
  std::string const aside = labels.AddAnywhere(line, "1: 20");
  EXPECT_EQ(Occurrences(aside, "class=\"leader\""), 1u) << aside;
  EXPECT_EQ(Occurrences(aside, "<text"), 1u);
}

TEST(ToSvg, WithoutTolerancesThereIsNoVerdict) {
  Drawing const drawing = MakeDrawing({{0, 0, 0}, {5, 0.3, 0}, {10, 0, 0}}, {LineAndQuarter()[0]});
  EXPECT_FALSE(drawing.verdict.has_value());
  EXPECT_EQ(drawing.Worst(), 1u);
  EXPECT_EQ(ToSvg(drawing).find("tolerance"), std::string::npos);
}

TEST(ToSvg, PieceIsDrawnAlikeAtAnyScaleAndPlace) {
  auto const drawing = [](double scale, double offset) {
    double const w = 0.125 * scale;
    std::vector<GeometryUtils::Elem> const contour = {
        Contours::Segment(offset, offset),
        Contours::Segment(offset + 8.0 * scale, offset + 4.0 * scale)};
    return ToSvg(MakeDrawing({{offset, offset, w}, {offset + 8.0 * scale, offset + 4.0 * scale, w}},
                             PiecesOf(contour)));
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

TEST(ToSvg, HundredThousandPointsStaySmall) {
  std::vector<WPoint> points;
  for (int i = 0; i < 100'000; ++i) {
    points.push_back({0.01 * i, 0.005 * std::sin(0.37 * i) + 0.004 * std::sin(0.001 * i), 0.01});
  }
  std::vector<Piece> const pieces =
      PiecesOf({Contours::Segment(0, 0), Contours::Segment(999.99, 0)});
  EXPECT_LT(ToSvg(MakeDrawing(points, pieces)).size(), 500'000u);
}

}  // namespace
}  // namespace Vorn::IO::Svg
