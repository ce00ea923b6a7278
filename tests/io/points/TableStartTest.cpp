#include <gtest/gtest.h>

#include <string>

#include "io/points/TableStart.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {
namespace {

PointFile Parse(std::string const& text) {
  return ParsePoints(text, "p.csv", {ToleranceColumn::Use::IfPresent, "w"});
}

TEST(FindTable, BeginsAtTheHeaderOfThePoints) {
  EXPECT_EQ(FindTable("x,y\n1,2\n3,4\n").first, 0u);
  EXPECT_EQ(FindTable("1,2\n3,4\n").first, 0u);
  EXPECT_EQ(FindTable("Profile 7\n\nOperator: A. B.\nX;Z\n1;2\n3;4\n").first, 3u);
  EXPECT_EQ(FindTable("Profile 7 of 9\n1 2\n3 4\n").first, 1u);
  EXPECT_EQ(FindTable("Anzahl;2\nX;Z\n1;2\n3;4\n").first, 1u);
  EXPECT_EQ(FindTable("Profile 7\n1 2\n3 4\n").first, 1u);
}

TEST(FindTable, DataGoneWrongIsNoPreamble) {
  EXPECT_EQ(FindTable("1 2 3\n1 2\n3 4\n").first, 0u);
  EXPECT_EQ(FindTable("3mm,4\n1,2\n3,4\n").first, 0u);
  EXPECT_EQ(FindTable("abc,4\n1,2\n3,4\n").first, 0u);
  EXPECT_EQ(FindTable("nan 4\n1 2\n3 4\n").first, 0u);
  EXPECT_EQ(FindTable("1o0 4\n1 2\n3 4\n").first, 0u);
  EXPECT_EQ(FindTable("x,y\na,b\n1,2\n3,4\n").first, 1u) << "the nearer of two headers counts";
  EXPECT_EQ(FindTable("").first, 0u);
}

TEST(CsvReader, ReadsTheExportOfATracer) {
  PointFile const file = Parse(
      "Kontur-Messung V 4.2\nDatum: 05.01.2024\nTastspitze R 0,025\n\n"
      "# tolerance 0,02\nNr.;X-Pos;Z-Pos\n;[mm];[mm]\n1;0,5;-1,25\n2;0,75;-1,5\n3;1;2\n");
  ASSERT_EQ(file.points.size(), 3u);
  EXPECT_EQ(file.points[1].x, 0.75);
  EXPECT_EQ(file.points[1].y, -1.5);
  EXPECT_EQ(file.lines[0], 8u);
  EXPECT_EQ(file.units, "mm");
  EXPECT_EQ(file.tolerance, 0.02);
  EXPECT_EQ(file.columns, "2 (x-pos) and 3 (z-pos)");
}

TEST(CsvReader, TakesUnitsFromTheHeader) {
  EXPECT_EQ(Parse("X [mm],Z [mm]\n1,2\n3,4\n").units, "mm");
  EXPECT_EQ(Parse("# units inch\nX [mm],Z [mm]\n1,2\n3,4\n").units, "inch");
  EXPECT_EQ(Parse("X [mm],Z\n1,2\n3,4\n").units, "");
}

std::string Complaint(std::string const& text) {
  try {
    Parse(text);
  } catch (Failure const& failure) {
    return failure.what();
  }
  return "";
}

TEST(CsvReader, RefusesColumnsThatCannotBeTold) {
  EXPECT_EQ(Complaint("Nr,A,B,C\n1,2,3,4\n2,3,4,5\n"),
            "p.csv:1:1: cannot tell which two columns hold the points: the header has 'Nr', 'A', "
            "'B', 'C'");
  EXPECT_EQ(Complaint("X [mm],Z [\xC2\xB5m]\n1,2\n3,4\n"),
            "p.csv:1:1: one coordinate is in 'mm', the other in '\xC2\xB5m': a contour needs one "
            "unit");
  EXPECT_NE(Complaint("x,y,z\n1,2,3\n4,5,6\n"), "");
}

TEST(CsvReader, NumbersOfPointsAreNoCoordinates) {
  PointFile const file = Parse("Nr,X,Z\n1,0.5,7\n2,1.5,8\n");
  EXPECT_EQ(file.points[0].x, 0.5);
  EXPECT_EQ(file.points[0].y, 7.0);
}

TEST(CsvReader, NamesTheColumnsUsed) {
  EXPECT_EQ(Parse("1,2\n3,4\n").columns, "1 and 2");
  EXPECT_EQ(Parse("y,x,w\n1,2,0.1\n3,4,0.1\n").columns, "2 (x) and 1 (y), the tolerance in 3 (w)");
}

}  // namespace
}  // namespace Vorn::IO
