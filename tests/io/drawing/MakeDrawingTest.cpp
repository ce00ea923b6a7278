#include <gtest/gtest.h>

#include <cmath>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {
namespace {

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

TEST(DescribeGaps, NamesTheWidestAndHowManyThereAre) {
  ContourFile contour;
  contour.pieces = {MakeLine({0, 0}, {5, 0}), MakeLine({5, 1}, {5, 5}), MakeLine({5, 5}, {2, 0})};
  EXPECT_EQ(DescribeGaps(contour), "GAP of 1 between pieces 1 and 2");
  contour.units = "mm";
  contour.isClosed = true;
  EXPECT_EQ(DescribeGaps(contour), "GAP of 2 mm between pieces 3 and 1, the widest of 2");
  for (Format const format : {Format::Svg, Format::Html}) {
    EXPECT_NE(Drawn(DrawingOf(contour), format).find("GAP of 2 mm between"), std::string::npos);
  }
  contour.pieces = {MakeLine({0, 0}, {5, 0}), MakeLine({5, 0}, {0, 0})};
  EXPECT_EQ(DescribeGaps(contour), "");
}

TEST(Drawn, NothingIsRefused) {
  for (Drawing const& nothing : {DrawingOf(ContourFile{}), MakeDrawing({}, {}), Drawing{}}) {
    for (Format const format : {Format::Svg, Format::Png, Format::Html}) {
      try {
        Drawn(nothing, format);
        FAIL() << NameOf(format);
      } catch (Failure const& failure) {
        EXPECT_EQ(failure.Kind(), FailureKind::BadArgument);
        EXPECT_EQ(failure.Message(), "there is nothing to draw: no points and no pieces");
      }
    }
  }
}

TEST(Drawn, OnePointOrOnePieceIsEnough) {
  for (Format const format : {Format::Svg, Format::Png, Format::Html}) {
    EXPECT_FALSE(Drawn(MakeDrawing({{1, 2, 0}}, {}), format).empty());
    EXPECT_FALSE(Drawn(MakeDrawing({}, {MakeLine({0, 0}, {1, 0})}), format).empty());
    EXPECT_FALSE(Drawn(MakeDrawing({{1, 2, 0}, {1, 2, 0}}, {}), format).empty()) << "no extent";
  }
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
}  // namespace Vorn::IO
