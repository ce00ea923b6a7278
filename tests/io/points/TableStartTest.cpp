#include <gtest/gtest.h>

#include <string>

#include "io/PointTables.h"
#include "io/points/TableStart.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {
namespace {

using namespace PointTables;

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

TEST(FindTable, AheadOfAHeaderThatNamesTheAxesAnythingButPointsIsAPreamble) {
  EXPECT_EQ(FindTable("05.01.2024;10:22:33\nX;Z\n0,5;1\n0,7;2\n").first, 1u);
  EXPECT_EQ(FindTable("2024-01-05 10:22:33\nx,y\n0.5,2\n0.7,3\n").first, 1u);
  EXPECT_EQ(FindTable("7\nX;Z\n0,5;1\n0,7;2\n").first, 1u);
  EXPECT_EQ(FindTable("2.0.1\n3mm;4\nX;Z\n0,5;1\n0,7;2\n").first, 2u);
  EXPECT_EQ(FindTable("1;2\nX;Z\n0,5;1\n0,7;2\n").first, 0u) << "a point";
  EXPECT_EQ(FindTable("3mm;4\na;b\n0,5;1\n0,7;2\n").first, 0u) << "names that tell nothing";
}

TEST(FindTable, RowsMayHoldTextsWhereTheHeaderNamesTheAxes) {
  EXPECT_EQ(FindTable("Report 7\nname;x;y\nP1;0.5;2\nP2;0.7;3\n").first, 1u);
  EXPECT_EQ(FindTable("Report 7\ntime;x;y;state\n10:22;0.5;2;OK\n10:23;0.7;3;OK\n").first, 1u);
  EXPECT_EQ(FindTable("Report 7\nname;x;y\n;mm;mm\nP1;0.5;2\nP2;0.7;3\n").first, 1u);
  EXPECT_EQ(FindTable("Report 7\nname;a;b\nP1;0.5;2\nP2;0.7;3\n").first, 0u);
  EXPECT_EQ(FindTable("x;y\nRadius;0,1;0,2\nSpeed;3;4\nx;y\n1;2\n3;4\n").first, 3u)
      << "other texts that stand with numbers";
}

TEST(FindTable, SeparatorsMayEndEveryLine) {
  EXPECT_EQ(FindTable("Report 7\nid;x;y;\n1;0.5;2;\n2;0.7;3;\n").first, 1u);
  EXPECT_EQ(FindTable("Report 7,,\n,,\nid,x,y\n1,0.5,2\n2,0.7,3\n").first, 2u);
}

TEST(IsRule, IsThreeStrokesAndNothingElse) {
  for (char const* rule : {"---", "-----;-----", "===", " *** ", "--- | ---", "___,___"}) {
    EXPECT_TRUE(IsRule(rule)) << rule;
  }
  for (char const* other : {"", "--", "-;-", "-1;2", "--- Data ---", "-=-", ";;;"}) {
    EXPECT_FALSE(IsRule(other)) << other;
  }
}

TEST(UnitInPreamble, ReadsTheWordInThreeLanguages) {
  for (char const* line : {"Units: mm", "unit=mm", "Einheit;mm", "Einheit;mm;;", "UNITS,\"mm\"",
                           "Unit\xC3\xA9 : [mm]", "Einheiten\tmm"}) {
    EXPECT_EQ(UnitInPreamble(line), "mm") << line;
  }
  for (char const* line : {"", "Units", "Units: many", "Unit 7", "mm", "Date: 5 mm"}) {
    EXPECT_EQ(UnitInPreamble(line), "") << line;
  }
}

TEST(CsvReader, TakesAReportWithCommentUnitsAndNumbersOfPoints) {
  for (std::string const end : {"\n", "\r\n", "\r", "\n\n"}) {
    for (std::string const tail : {"", ";"}) {
      std::string text;
      for (std::string const line : {"Report 7", "# units mm", "id;x;y", "1;0,5;2", "2;0,75;3"}) {
        text += line + (line.find(';') == std::string::npos ? "" : tail) + end;
      }
      for (std::string const mark : {"", "\xEF\xBB\xBF"}) {
        PointFile const file = Parse(mark + text);
        ASSERT_EQ(file.points.size(), 2u) << text;
        EXPECT_EQ(file.points[1].x, 0.75);
        EXPECT_EQ(file.units, "mm");
      }
    }
  }
}

TEST(CsvReader, RulesAroundTheHeaderAreNoHeader) {
  PointFile const file = Parse("Report 7\n=====\nid;x;y\n---;---;---\n1;0,5;2\n2;0,75;3\n");
  EXPECT_EQ(file.columns, "2 (x) and 3 (y)");
  EXPECT_EQ(file.points.size(), 2u);
  EXPECT_EQ(TableRefusal("x;y\n1;2\n---;---\n3;4\n"), "p.csv:3:1: x is not a number: '---'");
}

TEST(CsvReader, ASeparatorMayEndTheLinesOfDataAlone) {
  EXPECT_EQ(Parse("x;y\n0.5;2;\n0.7;3;\n").points.size(), 2u);
  EXPECT_EQ(Parse("x,y\n0.5,2,,\n0.7,3,,\n").points.size(), 2u);
  EXPECT_EQ(TableRefusal("x;y\n0.5;2;\n0.7;3;4\n"),
            "p.csv:3:7: expected 2 columns, found 3: '0.7;3;4'");
}

TEST(CsvReader, ReadsUtf16) {
  std::string bytes = "\xFF\xFE";
  for (char const c : std::string("Report 7\r\nX [mm]\tZ [mm]\r\n0,5\t1\r\n0,7\t2\r\n")) {
    bytes += c;
    bytes += '\0';
  }
  PointFile const file = Parse(bytes);
  ASSERT_EQ(file.points.size(), 2u);
  EXPECT_EQ(file.points[0].x, 0.5);
  EXPECT_EQ(file.units, "mm");
}

TEST(CsvReader, ReadsNamesInLatin1) {
  PointFile const file = Parse("Bericht\nNr;L\xE4nge [\xB5m];H\xF6he [\xB5m]\n1;2;3\n2;4;5\n");
  EXPECT_EQ(file.units, "\xC2\xB5m");
  EXPECT_EQ(file.columns, "2 (l\xC3\xA4nge [\xC2\xB5m]) and 3 (h\xC3\xB6he [\xC2\xB5m])");
}

TEST(CsvReader, TakesTheUnitFromThePreambleUnlessACommentSays) {
  EXPECT_EQ(Parse("Report\nUnits: inch\nx;y\n1;2\n3;4\n").units, "inch");
  EXPECT_EQ(Parse("# units mm\nUnits: inch\nx;y\n1;2\n3;4\n").units, "mm");
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

TEST(CsvReader, RefusesColumnsThatCannotBeTold) {
  EXPECT_EQ(TableRefusal("Nr,A,B,C\n1,2,3,4\n2,3,4,5\n"),
            "p.csv:1:1: cannot tell which two columns hold the points: the header has 'Nr', 'A', "
            "'B', 'C'");
  EXPECT_EQ(TableRefusal("X [mm],Z [\xC2\xB5m]\n1,2\n3,4\n"),
            "p.csv:1:1: one coordinate is in 'mm', the other in '\xC2\xB5m': a contour needs one "
            "unit");
  EXPECT_NE(TableRefusal("x,y,z\n1,2,3\n4,5,6\n"), "");
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
