#include <gtest/gtest.h>

#include <cmath>

#include "io/Contours.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/Formats.h"
#include "vorn/io/JoinedFit.h"

namespace Vorn::IO {
namespace {

/// A fit of a square of the side 10 with its lower left corner here.
FitReport FittedSquare(double x, double y, std::size_t outline) {
  std::vector<WPoint> points;
  for (int i = 0; i < 10; ++i) points.push_back({x + i, y, 0});
  for (int i = 0; i < 10; ++i) points.push_back({x + 10, y + i, 0});
  for (int i = 0; i < 10; ++i) points.push_back({x + 10 - i, y + 10, 0});
  for (int i = 0; i < 10; ++i) points.push_back({x, y + 10 - i, 0});
  PointFile file = Contours::FileWith(points);
  file.path += OutlineSuffix(outline);
  file.outline = outline;
  FitChoice choice;
  choice.tolerance.same = 0.01;
  return FitContour(std::move(file), choice, nullptr);
}

ContourFile FileOf(FitReport const& report) {
  ContourFile contour;
  contour.pieces = report.pieces;
  return contour;
}

TEST(Joined, OfOneIsThatOneWithoutItsSeam) {
  FitReport const one = FittedSquare(0, 0, 1);
  FitReport const joined = Joined({one});
  EXPECT_EQ(joined.pieces.size(), one.pieces.size());
  EXPECT_EQ(joined.verdict, one.verdict);
  EXPECT_EQ(joined.remeasured.points.size(), 40u);
  EXPECT_FALSE(joined.closure.isClosed);
  EXPECT_EQ(joined.closure.reason, "1 outlines");
}

TEST(Joined, CountsPointsPiecesAndRangesThroughAll) {
  FitReport const a = FittedSquare(0, 0, 1);
  FitReport const b = FittedSquare(100, 0, 2);
  std::size_t const pieces = a.pieces.size();
  FitReport const joined = Joined({a, b});
  EXPECT_EQ(joined.pieces.size(), pieces + b.pieces.size());
  EXPECT_EQ(joined.file.points.size(), 80u);
  EXPECT_EQ(joined.file.points[40].x, b.file.points[0].x);
  ASSERT_TRUE(joined.ranges);
  ASSERT_EQ(joined.ranges->size(), joined.pieces.size());
  EXPECT_EQ((*joined.ranges)[pieces].first, 40 + (*b.ranges)[0].first);
  EXPECT_EQ((*joined.ranges)[pieces].count, (*b.ranges)[0].count);
  EXPECT_EQ(joined.remeasured.points[40].piece, pieces + b.remeasured.points[0].piece);
  EXPECT_EQ(joined.pieces[pieces].start.x, b.pieces[0].start.x);
  EXPECT_DOUBLE_EQ(joined.fit.seconds, a.fit.seconds + b.fit.seconds);
}

TEST(Joined, HasTheWorstOfTheVerdictsAndDeviations) {
  FitReport a = FittedSquare(0, 0, 1);
  FitReport b = FittedSquare(100, 0, 2);
  b.remeasured.points[7].relative = 50.0;
  EXPECT_EQ(Joined({a, b}).remeasured.worst, 47u);
  EXPECT_EQ(Joined({b, a}).remeasured.worst, 7u);
  b.verdict = Verdict::OutsideTolerance;
  EXPECT_EQ(Joined({a, b}).verdict, Verdict::OutsideTolerance);
  a.verdict = Verdict::StopsEarly;
  EXPECT_EQ(Joined({a, b}).verdict, Verdict::StopsEarly);
  EXPECT_EQ(Joined({b, a}).verdict, Verdict::StopsEarly);
}

TEST(Joined, NamesThePointOfTheLargestReportedDeviation) {
  FitReport a = FittedSquare(0, 0, 1);
  FitReport b = FittedSquare(100, 0, 2);
  a.fit.deviation = 0.25;
  a.fit.deviationIndex = 3;
  b.fit.deviation = 0.5;
  b.fit.deviationIndex = 9;
  EXPECT_EQ(Joined({a, b}).fit.deviation, 0.5);
  EXPECT_EQ(Joined({a, b}).fit.deviationIndex, 49);
  EXPECT_EQ(Joined({b, a}).fit.deviationIndex, 9);
  b.fit.deviationIndex = -1;
  EXPECT_EQ(Joined({a, b}).fit.deviation, 0.25) << "one that names no point counts for nothing";
}

TEST(Joined, RangesAreUnknownWhereThoseOfOneAre) {
  FitReport const a = FittedSquare(0, 0, 1);
  FitReport b = FittedSquare(100, 0, 2);
  b.ranges.reset();
  EXPECT_FALSE(Joined({a, b}).ranges);
  EXPECT_FALSE(Joined({b, a}).ranges);
}

TEST(MeasureText, OutlinesAreMeasuredEachByItself) {
  // The second square lies beside the first one: a point between them is near the wrong outline.
  FitReport const a = FittedSquare(0, 0, 1);
  FitReport const b = FittedSquare(10.5, 0, 2);
  std::string const text = ToText(FileOf(Joined({a, b})), Format::Json, {});
  FileMeasure const measure = MeasureText(text, Format::Json, {a, b});
  EXPECT_TRUE(measure.IsWithin()) << measure.unreadable;

  FitReport moved = b;
  // 0.5 from its own square and exactly on the other one.
  moved.file.points[35] = {10.0, 5.0, 0.01};
  FileMeasure const wrong = MeasureText(text, Format::Json, {a, moved});
  EXPECT_FALSE(wrong.IsWithin());
  EXPECT_EQ(wrong.point, 40u + 35u);
  EXPECT_NEAR(wrong.relative, 50.0, 1.0) << "the square is within its tolerance of its points";
  EXPECT_TRUE(MeasureText(text, Format::Json, Joined({a, moved}).file.points).IsWithin())
      << "against both outlines together";
}

TEST(MeasureText, OrderOfTheOutlinesInTheFileDoesNotMatter) {
  FitReport const a = FittedSquare(0, 0, 1);
  FitReport const b = FittedSquare(100, 0, 2);
  std::string const text = ToText(FileOf(Joined({b, a})), Format::Dxf, {});
  EXPECT_TRUE(MeasureText(text, Format::Dxf, {a, b}).IsWithin());
}

TEST(MeasureText, WhereOutlinesCannotBeToldApartAllCount) {
  // Only one of both is in the file, so both reports would have the same one.
  FitReport const a = FittedSquare(0, 0, 1);
  FitReport const b = FittedSquare(100, 0, 2);
  std::string const text = ToText(FileOf(a), Format::Json, {});
  FileMeasure const measure = MeasureText(text, Format::Json, {a, b});
  EXPECT_FALSE(measure.IsWithin());
  EXPECT_GE(measure.point, 40u);
  // The farthest corner of the second square is 100 from the first one.
  EXPECT_NEAR(measure.relative, 100.0 / 0.01, 1.0);
}

TEST(MeasureText, AnUnreadableTextOfOutlinesIsAnAnswerToo) {
  FileMeasure const measure =
      MeasureText("{}", Format::Json, std::vector<FitReport>{FittedSquare(0, 0, 1)});
  EXPECT_FALSE(measure.unreadable.empty());
  EXPECT_FALSE(measure.IsWithin());
}

}  // namespace
}  // namespace Vorn::IO
