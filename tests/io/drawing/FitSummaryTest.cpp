#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "io/Contours.h"
#include "vorn/io/FitSummary.h"

namespace Vorn::IO {
namespace {

SummaryRow Fitted(std::string path, double deviation) {
  SummaryRow row;
  row.path = std::move(path);
  row.isFitted = true;
  row.isWithin = deviation <= 1.0;
  row.result = row.isWithin ? "within tolerance" : "OUTSIDE TOLERANCE";
  row.points = 10;
  row.lines = 2;
  row.arcs = 1;
  row.outside = row.isWithin ? 0 : 3;
  row.deviation = deviation;
  row.rootMeanSquare = 0.25;
  return row;
}

SummaryRow Failed(std::string path, std::string why) {
  SummaryRow row;
  row.path = std::move(path);
  row.result = std::move(why);
  return row;
}

std::vector<std::string> FirstFields(std::string const& csv) {
  std::vector<std::string> fields;
  for (std::size_t at = 0; at < csv.size(); at = csv.find('\n', at) + 1) {
    fields.push_back(csv.substr(at, csv.find(',', at) - at));
  }
  return fields;
}

std::size_t Count(std::string const& text, std::string const& part) {
  std::size_t count = 0;
  for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) {
    ++count;
  }
  return count;
}

TEST(SummaryCsv, WorstFirstAndTheTotalLast) {
  EXPECT_EQ(SummaryCsv({Fitted("a", 0.5), Failed("b", "no fit"), Fitted("c", 0.875)}),
            "file,result,points,lines,arcs,largest_deviation,outside,root_mean_square\n"
            "b,no fit,,,,,,\n"
            "c,within tolerance,10,2,1,0.875,0,0.25\n"
            "a,within tolerance,10,2,1,0.5,0,0.25\n"
            "total,2 of 3 files within tolerance,20,4,2,0.875,0,\n");
}

TEST(SummaryCsv, EqualRowsKeepTheirOrder) {
  EXPECT_EQ(FirstFields(SummaryCsv(
                {Fitted("b", 0.5), Fitted("a", 0.5), Failed("z", "x"), Failed("y", "x")})),
            (std::vector<std::string>{"file", "z", "y", "b", "a", "total"}));
}

TEST(SummaryCsv, OutsideGoesBeforeWithinWhateverTheDeviation) {
  // A contour that is not closed is not within tolerance though its points are.
  SummaryRow open = Fitted("open", 0.125);
  open.isWithin = false;
  EXPECT_EQ(FirstFields(SummaryCsv({Fitted("good", 0.75), open})),
            (std::vector<std::string>{"file", "open", "good", "total"}));
}

TEST(SummaryCsv, ADeviationThatIsNoNumberIsTheLargest) {
  std::vector<SummaryRow> rows;
  for (int i = 0; i < 40; ++i) {
    rows.push_back(Fitted("r" + std::to_string(i), 2.0 + i));
    if (i % 5 == 0) rows.push_back(Fitted("n" + std::to_string(i), std::nan("")));
  }
  std::vector<std::string> const order = FirstFields(SummaryCsv(rows));
  std::vector<std::string> const bad = {"n0", "n5", "n10", "n15", "n20", "n25", "n30", "n35"};
  EXPECT_EQ(std::vector<std::string>(order.begin() + 1, order.begin() + 9), bad);
  EXPECT_EQ(order[9], "r39");
  EXPECT_EQ(order[48], "r0");
  std::string const csv = SummaryCsv(rows);
  EXPECT_NE(csv.substr(csv.rfind("total")).find(",nan,"), std::string::npos) << "of all as well";
}

TEST(SummaryCsv, NothingHasATotalAlone) {
  EXPECT_EQ(SummaryCsv({}),
            "file,result,points,lines,arcs,largest_deviation,outside,root_mean_square\n"
            "total,0 of 0 files within tolerance,,,,,,\n");
}

TEST(SummaryCsv, NamesWithSeparatorsAreQuoted) {
  std::string const csv =
      SummaryCsv({Failed("a,b.csv", "says \"no\""), Failed("c\nd", "x"), Failed("e\rf", "y")});
  EXPECT_NE(csv.find("\"a,b.csv\",\"says \"\"no\"\"\",,,,,,\n"), std::string::npos) << csv;
  EXPECT_NE(csv.find("\"c\nd\",x,"), std::string::npos);
  EXPECT_NE(csv.find("\"e\rf\",y,"), std::string::npos);
}

TEST(SummaryHtml, HasARowForEachFileAndOneForAll) {
  std::string const page = SummaryHtml({Fitted("a", 0.5), Failed("b", "no fit")}, {});
  EXPECT_EQ(Count(page, "<td>a</td>"), 1u);
  EXPECT_EQ(Count(page, "<tr class=\"bad\">"), 2u) << "the failed one and the total";
  EXPECT_EQ(Count(page, "<td>1 of 2 files within tolerance</td>"), 1u);
  EXPECT_LT(page.find("<td>b</td>"), page.find("<td>a</td>")) << "the worst first";
  EXPECT_EQ(page.find("{{"), std::string::npos);
}

TEST(SummaryHtml, TextsOfTheUserAreText) {
  SummaryRow row = Fitted("<b>&\"x\".csv", 0.5);
  row.result = "1 < 2";
  ReportHead const head = {{{"<i>", "</p>"}}, "contour <1>"};
  std::string const page = SummaryHtml({row}, head);
  EXPECT_NE(page.find("&lt;b&gt;&amp;"), std::string::npos);
  EXPECT_NE(page.find("1 &lt; 2"), std::string::npos);
  EXPECT_NE(page.find("<span>&lt;i&gt; <b>&lt;/p&gt;</b></span>"), std::string::npos);
  EXPECT_NE(page.find("contour &lt;1&gt;"), std::string::npos);
}

TEST(SummaryHtml, MarksOfThePageInTextsOfTheUserStayText) {
  ReportHead const head = {{{"part", "{{rows}}"}, {"{{total}}", "{{program}}"}}, "{{fields}}"};
  std::string const page = SummaryHtml({Fitted("{{program}}.csv", 0.5)}, head);
  EXPECT_NE(page.find("<span>part <b>{{rows}}</b></span>"), std::string::npos) << page;
  EXPECT_NE(page.find("<span>{{total}} <b>{{program}}</b></span>"), std::string::npos);
  EXPECT_NE(page.find("<span>{{fields}}</span>"), std::string::npos);
  EXPECT_NE(page.find("<td>{{program}}.csv</td>"), std::string::npos);
  EXPECT_NE(page.find("<td>10</td>"), std::string::npos);
}

TEST(SummaryRowOf, TellsWhatTheReportTells) {
  FitReport const report = Contours::LineAndArcReport();
  SummaryRow const row = SummaryRowOf(report, Verdict::NotClosed);
  EXPECT_EQ(row.path, "part.csv");
  EXPECT_EQ(row.result, Describe(Verdict::NotClosed));
  EXPECT_TRUE(row.isFitted);
  EXPECT_FALSE(row.isWithin);
  EXPECT_EQ(row.points, 7u);
  EXPECT_EQ(row.lines, 1u);
  EXPECT_EQ(row.arcs, 1u);
  EXPECT_EQ(row.outside, 0u);
  // The fourth point is 0.015 off the circle, three quarters of its tolerance.
  EXPECT_NEAR(row.deviation, 0.75, 1e-9);
  EXPECT_NEAR(row.rootMeanSquare, std::sqrt((0.01 * 0.01 + 0.015 * 0.015) / 7.0), 1e-9);
  EXPECT_TRUE(row.picture.starts_with("<svg viewBox="));
  EXPECT_EQ(Count(row.picture, "<path"), 1u);
  EXPECT_TRUE(SummaryRowOf(report, Verdict::WithinTolerance).isWithin);
}

}  // namespace
}  // namespace Vorn::IO
