#include <gtest/gtest.h>

#include <string>

#include "io/PointTables.h"
#include "io/points/TableEnd.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {
namespace {

using namespace PointTables;

TEST(IsFooter, IsTextToTheEnd) {
  TableFacts const table{';', 2, 500};
  for (char const* footer :
       {"", "End of report", "Ende\n", "=====\nMean: 0.02\n\nOperator;A;B\n", "Points;500",
        "\"Anzahl\";\"500\"", "\xC3\x84nderung 2", "Fin # 5\n# 6;7\n", "Ende;;"}) {
    EXPECT_TRUE(IsFooter(footer, table)) << footer;
  }
}

TEST(IsFooter, DataGoneWrongIsNone) {
  TableFacts const table{';', 2, 500};
  for (char const* data :
       {"1;2", "End\n1;2", "1", "3mm", "abc;4", "Points;499", "Points;500.0", "nan", "NaN;NaN",
        "error", "OVER;OVER", "End;Report", "P1", "-;-", "---;---", ";5", "12.03.2026 printed"}) {
    EXPECT_FALSE(IsFooter(data, table)) << data;
  }
}

TEST(IsFooter, WordsBetweenBlanksMayBeAsManyAsTheColumns) {
  TableFacts const table{' ', 3, 500};
  EXPECT_TRUE(IsFooter("End of report", table));
  EXPECT_FALSE(IsFooter("bad bad bad", table));
  EXPECT_FALSE(IsFooter("End of 7", table));
}

TEST(CsvReader, SkipsTheFooterOfAnInstrumentAndTellsItsLines) {
  for (std::string const rows : {"x;y\n1;2\n3;4\n", "Report\nx;y\n1;2\n3;4\n", "1;2\n3;4\n"}) {
    PointFile const whole = Parse(rows);
    EXPECT_EQ(whole.skipped, "");
    PointFile const file = Parse(rows + "\nEnd of report\n-----\nMean 0.02\n\n");
    EXPECT_EQ(file.points.size(), 2u);
    std::size_t const first = whole.lines.back() + 2;
    EXPECT_EQ(file.skipped, "lines " + std::to_string(first) + " to " + std::to_string(first + 2) +
                                " behind the table");
  }
  EXPECT_EQ(Parse("1;2\n3;4\nPoints;2").skipped, "line 3 behind the table");
}

TEST(CsvReader, RefusesARowGoneWrongBehindPointsWithItsLine) {
  EXPECT_EQ(TableRefusal("x;y\n1;2\n3;4\nEnd of report\n5;6\n"),
            "p.csv:4:1: expected 2 columns, found 1: 'End of report'");
  EXPECT_EQ(TableRefusal("x;y\n1;2\n3;4\nabc;4\n"), "p.csv:4:1: x is not a number: 'abc'");
  EXPECT_EQ(TableRefusal("x;y\n1;2\n3;4\n5\n"), "p.csv:4:1: expected 2 columns, found 1: '5'");
  EXPECT_EQ(TableRefusal("x;y\n1;2\n3;4\nPoints;3\n"), "p.csv:4:1: x is not a number: 'Points'");
}

TEST(CsvReader, BehindRowsThatBeginWithTextThereIsNoFooter) {
  std::string const rows = "name;x;y\nFirst;1;2\nSecond;3;4\n";
  EXPECT_EQ(Parse(rows).points.size(), 2u);
  EXPECT_EQ(TableRefusal(rows + "Third\n"), "p.csv:4:1: expected 3 columns, found 1: 'Third'");
}

TEST(CsvReader, OnePointAndTextAreNoTable) {
  EXPECT_EQ(TableRefusal("x;y\n1;2\nEnd of report\n"),
            "p.csv:3:1: expected 2 columns, found 1: 'End of report'");
}

}  // namespace
}  // namespace Vorn::IO
