#include <gtest/gtest.h>

#include <cmath>

#include "io/FormatContours.h"
#include "vorn/io/FileMeasure.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

/// Points on the Wedge, every one exactly on it.
std::vector<WPoint> PointsOfWedge(double w) {
  return {{0, 0, w}, {1, 0, w}, {4, 0, w}, {4.6, -0.2, w}, {5, -1, w}, {2.5, -0.5, w}};
}

TEST(MeasureText, MeasuresAgainstWhatStandsInTheText) {
  std::string const text =
      "type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction\n"
      "line,0,0,10,0,,,,\n";
  FileMeasure const measure =
      MeasureText(text, Format::Csv, {{0, 0, 1}, {3, 0.5, 1}, {5, -1, 4}, {7, 0.5, 1}});
  EXPECT_EQ(measure.relative, 0.5);
  EXPECT_EQ(measure.point, 1u) << "the first of two";
  EXPECT_TRUE(measure.isWithin);
  EXPECT_TRUE(measure.IsWithin());
  EXPECT_TRUE(measure.unreadable.empty());
}

TEST(MeasureText, BeyondTheToleranceIsOutside) {
  std::string const text = "LINESTRING (0 0, 10 0)";
  EXPECT_TRUE(MeasureText(text, Format::Wkt, {{5, 1, 1}}).IsWithin());
  EXPECT_FALSE(MeasureText(text, Format::Wkt, {{5, 1.00001, 1}}).IsWithin());
}

TEST(MeasureText, ATextThatCannotBeReadIsAnAnswer) {
  for (Format const format : {Format::Json, Format::Csv, Format::Dxf, Format::GCode, Format::Wkt,
                              Format::GeoJson, Format::Svg}) {
    FileMeasure const measure = MeasureText("nothing of the kind", format, {{0, 0, 1}});
    EXPECT_TRUE(measure.unreadable.starts_with("the file:")) << NameOf(format);
    EXPECT_FALSE(measure.IsWithin()) << NameOf(format);
  }
}

TEST(ToTextFor, EveryFormatKeepsPointsOnTheContourWithinAFineTolerance) {
  for (double const w : {0.1, 0.001, 1e-6}) {
    for (Format const format :
         {Format::Json, Format::Csv, Format::Dxf, Format::GCode, Format::Wkt, Format::GeoJson}) {
      std::string const text = ToTextFor(PointsOfWedge(w), Wedge(), format, {});
      FileMeasure const measure = MeasureText(text, format, PointsOfWedge(w));
      EXPECT_TRUE(measure.IsWithin())
          << NameOf(format) << " at " << w << ": " << measure.relative << measure.unreadable;
    }
  }
}

TEST(ToTextFor, DigitsOfGCodeGrowUntilThePointsAreWithin) {
  // The point is on the very border: four digits, which a tolerance of 0.01 asks for, round the
  // line away from it.
  ContourFile contour;
  contour.units = "mm";
  contour.pieces = {MakeLine({0, 0.00004}, {10, 0.00004})};
  std::vector<WPoint> const points = {{0, 0.00004, 0.01}, {5, 0.01004, 0.01}, {10, 0, 0.01}};
  std::string const usual = ToText(contour, Format::GCode, {});
  EXPECT_FALSE(MeasureText(usual, Format::GCode, points).IsWithin());
  std::string const text = ToTextFor(points, contour, Format::GCode, {});
  EXPECT_TRUE(MeasureText(text, Format::GCode, points).IsWithin()) << text;
}

TEST(ToTextFor, DigitsThatAreGivenAreKept) {
  WriteOptions options;
  options.gcode.decimals = 2;
  std::string const text = ToTextFor(PointsOfWedge(1e-6), Wedge(), Format::GCode, options);
  EXPECT_NE(text.find("G1 X4.00 Y0.00\n"), std::string::npos) << text;
}

TEST(ToTextFor, NoDigitsMendAContourThatIsOutsideItself) {
  ContourFile contour;
  contour.units = "mm";
  contour.pieces = {MakeLine({0, 0}, {10, 0})};
  std::string const text = ToTextFor({{5, 3, 0.01}}, contour, Format::GCode, {});
  EXPECT_NE(text.find("X10.0000"), std::string::npos) << "the digits of the tolerance, no more";
}

TEST(ToTextFor, ChordsOfGeoJsonEndWhereTheyWouldTakeAPointOut) {
  // A point outside the arc by all of its tolerance is beyond reach of any chord beside it.
  ContourFile contour;
  contour.pieces = {MakeArc({10, 0}, {-10, 0}, {0, 0}, 10.0, true)};
  double const w = 0.05;
  std::vector<WPoint> points;
  for (double const angle : {0.3, 1.1, 1.9, 2.7}) {
    points.push_back({(10 + w) * std::cos(angle), (10 + w) * std::sin(angle), w});
  }
  WriteOptions coarse;
  coarse.chords = 0.5 * w;
  std::string const plain = ToText(contour, Format::GeoJson, coarse);
  EXPECT_FALSE(MeasureText(plain, Format::GeoJson, points).IsWithin()) << "else this shows nothing";
  for (WriteOptions const& options : {WriteOptions(), coarse}) {
    std::string const text = ToTextFor(points, contour, Format::GeoJson, options);
    FileMeasure const measure = MeasureText(text, Format::GeoJson, points);
    EXPECT_TRUE(measure.IsWithin()) << measure.relative;
  }
}

TEST(ToTextFor, ADrawingHoldsNoContour) {
  for (Format const format : {Format::Svg, Format::Html, Format::Png}) {
    EXPECT_EQ(Refusal([&] { ToTextFor(PointsOfWedge(1), Wedge(), format, {}); },
                      FailureKind::BadArgument),
              NameOf(format) + " holds no contour");
  }
}

}  // namespace
}  // namespace Vorn::IO
