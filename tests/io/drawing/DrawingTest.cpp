#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <regex>
#include <vector>

#include "io/Contours.h"
#include "io/Picture.h"
#include "io/drawing/Labels.h"
#include "io/drawing/Layout.h"
#include "io/drawing/Style.h"
#include "vorn/io/Failure.h"

namespace Vorn::IO::Svg {
namespace {

std::size_t Occurrences(std::string const& text, std::string const& part) {
  std::size_t count = 0;
  for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) {
    ++count;
  }
  return count;
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
      MakeDrawing({{0, 0, 0.1}, {5, 0.3, 0.1}, {10, 0, 0.1}}, {Contours::LineAndQuarter()[0]});
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
  Drawing const drawing = MakeDrawing({{1, 0.5, 0.02}, {9, 0, 0.02}}, Contours::LineAndQuarter());
  std::string const svg = ToSvg(drawing);
  EXPECT_NE(svg.find("class=\"outside\" fill=\"none\" stroke=\"#c8102e\""), std::string::npos);
  EXPECT_NE(svg.find("fill=\"#c8102e\" font-weight=\"bold\">OUTSIDE TOLERANCE"), std::string::npos);
}

TEST(ToSvg, DeviationBesideTheToleranceDoesNotReadAsAllOfIt) {
  std::string const svg =
      ToSvg(MakeDrawing({{1, 0.199992, 0.2}, {9, 0, 0.2}}, Contours::LineAndQuarter()));
  EXPECT_NE(svg.find("0.99996 of the tolerance"), std::string::npos) << svg.substr(0, 2000);
}

TEST(ToSvg, AxesTellTheirUnits) {
  Drawing drawing = MakeDrawing({}, Contours::LineAndQuarter());
  EXPECT_NE(ToSvg(drawing).find(">x</text>"), std::string::npos);
  drawing.units = "mm";
  EXPECT_NE(ToSvg(drawing).find(">x [mm]</text>"), std::string::npos);
  EXPECT_NE(ToSvg(drawing).find(">y [mm]</text>"), std::string::npos);
}

/// A line of the given size with a point near each end, measured.
std::string LineDrawing(double width, double height) {
  Drawing drawing =
      MakeDrawing({{0, 0, 0.1}, {width, height, 0.1}}, {MakeLine({0, 0}, {width, height})});
  drawing.magnify = 1.0;
  return ToSvg(drawing);
}

/// Left side, top, width and height of the frames of contour and diagram, in pixels.
std::vector<Rect> FramesOf(std::string const& svg) {
  std::regex const frame(
      "<rect x=\"([0-9.]+)\" y=\"([0-9.]+)\" width=\"([0-9.]+)\" height=\"([0-9.]+)\" "
      "fill=\"none\"");
  std::vector<Rect> frames;
  for (std::sregex_iterator it(svg.begin(), svg.end(), frame), end; it != end; ++it) {
    frames.push_back(
        {std::stod((*it)[1]), std::stod((*it)[2]), std::stod((*it)[3]), std::stod((*it)[4])});
  }
  return frames;
}

TEST(ToSvg, DiagramStandsBesideATallContour) {
  std::vector<Rect> const wide = FramesOf(LineDrawing(30.0, 20.0));
  ASSERT_EQ(wide.size(), 2u);
  EXPECT_GT(wide[1].top, wide[0].Bottom());
  EXPECT_EQ(wide[1].left, wide[0].left);

  for (double const width : {0.0, 1.0, 20.0}) {
    std::vector<Rect> const tall = FramesOf(LineDrawing(width, 30.0));
    ASSERT_EQ(tall.size(), 2u) << width;
    EXPECT_GT(tall[1].left, tall[0].Right()) << width;
    EXPECT_EQ(tall[1].Bottom(), tall[0].Bottom()) << width;
    // Three quarters of the page, and as far to the right as the diagram below a wide one.
    EXPECT_GT(tall[0].height, 590.0) << width;
    EXPECT_EQ(tall[1].Right(), wide[1].Right()) << width;
  }
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

TEST(ToSvg, TolerancesOfPointsAloneAreDiscsWhereTheyCanBeSeen) {
  auto const discs = [](double w) {
    std::string const svg = ToSvg(MakeDrawing({{0, 0, w}, {10, 4, w}, {20, 0, w}}, {}));
    return Picture::FromSvg(svg, 800).Count(kBandColor);
  };
  std::string const narrow = ToSvg(MakeDrawing({{0, 0, 1e-4}, {20, 0, 1e-4}}, {}));
  EXPECT_EQ(narrow.find("class=\"band\""), std::string::npos);
  // Three discs of a tenth of the width across: the page shows some 23 units on 800 pixels.
  EXPECT_GT(discs(1.0), 3 * 500);
  EXPECT_GT(discs(2.0), 3 * discs(1.0)) << "four times the area, less what covers them";
}

TEST(ToSvg, MoreThanTwoThousandPiecesAreOnePathOfEachKind) {
  auto const paths = [](int pieces) {
    std::vector<Piece> zigzag;
    for (int i = 0; i < pieces; ++i) {
      zigzag.push_back(MakeLine({1.0 * i, 1.0 * (i % 2)}, {i + 1.0, 1.0 * ((i + 1) % 2)}));
    }
    std::string const svg = ToSvg(MakeDrawing({}, zigzag));
    std::size_t const begin = svg.find("<g class=\"pieces\"");
    return Occurrences(svg.substr(begin, svg.find("</g>", begin) - begin), "<path ");
  };
  EXPECT_EQ(paths(2000), 2000u);
  EXPECT_EQ(paths(2001), 1u);
}

TEST(ToSvg, WithoutTolerancesThereIsNoVerdict) {
  Drawing const drawing =
      MakeDrawing({{0, 0, 0}, {5, 0.3, 0}, {10, 0, 0}}, {Contours::LineAndQuarter()[0]});
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
