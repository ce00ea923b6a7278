// What the help of `contour simplify` promises: which points stay, which go, and what is said of
// them.

#include <array>

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

using Words = std::vector<std::string>;

RunResult Simplified(std::string const& text, Words const& more) {
  Words words = {"simplify", "-"};
  words.insert(words.end(), more.begin(), more.end());
  return RunInProcess(words, text);
}

/// (0, 0), (1, 0) ... (last, 0).
std::string Row(int last) {
  std::string text;
  for (int i = 0; i <= last; ++i) text += std::to_string(i) + ",0\n";
  return text;
}

/// The first coordinates of what is left of points on the x axis.
std::string Left(std::string const& text, Words const& more) {
  std::istringstream lines(Simplified(text, more).out);
  std::string left;
  for (std::string line; std::getline(lines, line);) {
    left += (left.empty() ? "" : " ") + line.substr(0, line.find(','));
  }
  return left;
}

TEST(SimplifyRules, SpacingCountsFromThePointKeptBefore) {
  EXPECT_EQ(Left(Row(10), {"--spacing", "2.5"}), "0 3 6 9 10");
  EXPECT_EQ(Left(Row(10), {"--spacing", "2"}), "0 2 4 6 8 10") << "at least so far";
  EXPECT_EQ(Left(Row(10), {"--spacing", "0.5"}), "0 1 2 3 4 5 6 7 8 9 10");
  EXPECT_EQ(Left(Row(10), {"--spacing", "100"}), "0 10") << "the ends stay";
}

TEST(SimplifyRules, SpacingGoesAlongThePathNotAcross) {
  // Out and back: the last point is beside the first but 20 along the path.
  std::string text = Row(10);
  for (int i = 9; i >= 0; --i) text += std::to_string(i) + ",0.5\n";
  EXPECT_EQ(Left(text, {"--spacing", "4"}), "0 4 8 8 4 0");
}

TEST(SimplifyRules, DropCloseWantsMoreThanOneAndAHalfOfBothTolerances) {
  EXPECT_EQ(Left(Row(6), {"--drop-close", "-t", "0.333"}), "0 1 2 3 4 5 6");
  EXPECT_EQ(Left(Row(6), {"--drop-close", "-t", "0.334"}), "0 2 4 6");
  EXPECT_EQ(Left(Row(6), {"--drop-close", "-t", "0.667"}), "0 3 6");
  EXPECT_EQ(Left("0,0\n1,0\n2,0\n2.5,0\n", {"--drop-close", "-t", "0.33"}), "0 1 2.5")
      << "the last point stays, the one before it goes";
}

TEST(SimplifyRules, DropCloseTakesTheToleranceOfEachPoint) {
  // 1.5 * (0.1 + 0.6) = 1.05 > 1, and 1.5 * (0.1 + 0.5) = 0.9 < 1.
  EXPECT_EQ(
      Simplified("x,y,w\n0,0,0.1\n1,0,0.6\n2,0,0.1\n3,0,0.5\n4,0,0.1\n", {"--drop-close"}).out,
      "x,y,w\n0,0,0.1\n2,0,0.1\n3,0,0.5\n4,0,0.1\n");
}

/// A straight scan with a wobble of some hundredths; the points of the list stand out by 5.
std::string Scan(int count, std::vector<int> const& off) {
  constexpr std::array kWobble = {0.01, -0.02, 0.015, -0.005, 0.02, -0.01, 0.005, -0.015};
  std::ostringstream text;
  text << "x,y\n";
  for (int i = 0; i < count; ++i) {
    bool const isOff = std::find(off.begin(), off.end(), i) != off.end();
    text << 0.5 * i << ',' << (isOff ? 5.0 : kWobble.at(static_cast<std::size_t>(i) % 8)) << '\n';
  }
  return text.str();
}

TEST(SimplifyRules, OutliersAreDroppedAndListed) {
  RunResult const run = Simplified(Scan(40, {20}), {"--outliers", "6"});
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_EQ(run.out.find("\n10,5\n"), std::string::npos);
  EXPECT_EQ(std::count(run.out.begin(), run.out.end(), '\n'), 40) << "a header and 39 points";
  EXPECT_EQ(run.err.find("contour: standard input: 1 outlier\n"), 0u);
  EXPECT_NE(run.err.find("\ncontour: standard input: point 20 (line 22) is 4.9"), std::string::npos)
      << run.err;
  EXPECT_TRUE(
      run.err.ends_with("\ncontour: standard input: dropped 1 of 40 points: point 20 (line 22)\n"))
      << run.err;
}

TEST(SimplifyRules, TheFirstAndTheLastFourPointsStay) {
  for (int const index : {0, 3, 36, 39}) {
    EXPECT_EQ(Simplified(Scan(40, {index}), {"--outliers", "6"})
                  .err.find("contour: standard input: "
                            "0 outliers\n"),
              0u)
        << index;
  }
  for (int const index : {4, 35}) {
    EXPECT_EQ(
        Simplified(Scan(40, {index}), {"--outliers", "6"}).err.find("contour: standard input: 1 "),
        0u)
        << index;
  }
}

TEST(SimplifyRules, OutliersWithinTheToleranceStay) {
  EXPECT_NE(Simplified(Scan(40, {20}), {"--outliers", "6", "-t", "10"}).err.find("0 outliers"),
            std::string::npos);
  EXPECT_NE(Simplified(Scan(40, {20}), {"--outliers", "6", "-t", "0.1"}).err.find("1 outlier\n"),
            std::string::npos);
}

TEST(SimplifyRules, CornersAreNoOutliers) {
  std::string text = "x,y\n";
  for (int i = 0; i < 30; ++i) text += std::to_string(i) + "," + (i % 2 == 0 ? "0.01\n" : "0\n");
  for (int i = 1; i < 30; ++i) {
    text += std::string(i % 2 == 0 ? "29.01," : "29,") + std::to_string(i) + "\n";
  }
  EXPECT_EQ(Simplified(text, {"--outliers", "6"}).err.find("contour: standard input: 0 outliers\n"),
            0u);
}

class SimplifyFiles : public InFolder {};

TEST_F(SimplifyFiles, AHundredOutliersAreListedAndAllAreInTheFile) {
  std::vector<int> off;
  for (int i = 10; i < 1990; i += 15) off.push_back(i);
  RunResult const run =
      Simplified(Scan(2000, off), {"--outliers", "6", "--dropped", PathOf("d.csv")});
  EXPECT_EQ(run.err.find("contour: standard input: 132 outliers\n"), 0u) << run.err.substr(0, 80);
  std::size_t listed = 0;
  std::string const mark = " from its neighbours, ";
  for (std::size_t at = 0; (at = run.err.find(mark, at)) != std::string::npos; ++at) ++listed;
  EXPECT_EQ(listed, 100u);
  std::string const dropped = Contents("d.csv");
  EXPECT_EQ(dropped.find("point,line,x,y\n10,12,5,5\n25,27,12.5,5\n"), 0u);
  EXPECT_EQ(std::count(dropped.begin(), dropped.end(), '\n'), 133);
}

TEST_F(SimplifyFiles, WhatIsKeptIsWhatWasWritten) {
  std::string const text =
      "# units mm\r\nid;x;y;note\r\na;0,500;1;\"x;y\"\r\n// between\r\nb;7,50;+1e0;\r\n"
      "c;7,51;1;last";
  std::string const path = Write("p.csv", text);
  RunResult const run = RunInProcess({"simplify", path, "--drop-close", "-t", "0.1", "-o",
                                      PathOf("q.csv"), "--dropped", PathOf("d.csv")});
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  EXPECT_EQ(run.out, "");
  EXPECT_EQ(Contents("q.csv"),
            "# units mm\r\nid;x;y;note\r\na;0,500;1;\"x;y\"\r\n// between\r\nc;7,51;1;last");
  EXPECT_EQ(Contents("d.csv"), "point,line,x,y\n1,5,7.5,1\n");
}

TEST(SimplifyRules, TheStepsWorkInTheirOrder) {
  // The outlier goes first: else the spacing would keep it, as it lies far along the path.
  RunResult const run = Simplified(Scan(40, {20}), {"--outliers", "6", "--spacing", "4.9"});
  EXPECT_EQ(run.out.find(",5\n"), std::string::npos) << run.out;
  RunResult const both = Simplified(Row(20), {"--spacing", "2", "--drop-close", "-t", "1.5"});
  EXPECT_EQ(both.out, "0,0\n6,0\n12,0\n20,0\n") << "first every second, then more than 4.5 apart";
}

TEST(SimplifyRules, MeansStandForTheirWindows) {
  RunResult const run = Simplified(Row(10), {"--spacing", "2.5", "--average"});
  EXPECT_EQ(run.out, "x,y\n0,0\n1.5,0\n4,0\n7,0\n9,0\n10,0\n");
  EXPECT_EQ(run.err,
            "contour: standard input: 6 points stand for 11, 1 to 3 in a window; standard "
            "deviation across the path 0, at most 0\n");
}

TEST(SimplifyRules, FewerThanTwoPointsAreRefused) {
  RunResult const run = Simplified("0,0\n0,0\n0,0\n", {"--drop-close"});
  EXPECT_EQ(run.code, ExitCode::PointsTooClose);
  EXPECT_EQ(run.out, "");
  EXPECT_EQ(run.err,
            "contour: standard input: fewer than two points would be left: all lie too close to "
            "point 0 (line 1)\n");
}

TEST(SimplifyRules, AClosedContourMayRepeatItsFirstPoint) {
  std::string const square = "0,0\n4,0\n4,4\n0,4\n0,0\n";
  EXPECT_EQ(Simplified(square, {"--drop-close", "-t", "0.5"}).out, square);
  EXPECT_EQ(Simplified(square, {"--drop-close", "-t", "0.5", "--closed", "yes"}).out, square);
}

}  // namespace
}  // namespace Vorn::Cli::Testing
