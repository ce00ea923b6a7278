#include <gtest/gtest.h>

#include "cli/RunInProcess.h"
#include "support/SharedData.h"

namespace Vorn::Cli {
namespace {

// Five points; the third is too close to the second, the fifth repeats the fourth.
constexpr char const* kText =
    "# units mm\r\nid;x;y\r\na;0,50;0 // start\r\n\r\nb;4,5;0\r\nc;4,6;0\nd;9;0\ne;9;0";

TEST(SimplifyCommand, KeepsTheTextOfWhatIsLeft) {
  RunResult const run = RunInProcess({"simplify", "-", "--drop-close", "-t", "0.5"}, kText);
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_EQ(run.out, "# units mm\r\nid;x;y\r\na;0,50;0 // start\r\n\r\nb;4,5;0\r\ne;9;0");
  EXPECT_EQ(run.err,
            "contour: standard input: dropped 2 of 5 points: point 2 (line 6), point 3 (line 7)\n");
}

TEST(SimplifyCommand, WithoutAToleranceDropsPointsInOnePlace) {
  std::string const expected =
      "# units mm\r\nid;x;y\r\na;0,50;0 // start\r\n\r\nb;4,5;0\r\nc;4,6;0\ne;9;0";
  EXPECT_EQ(RunInProcess({"simplify", "-", "--drop-close"}, kText).out, expected);
  EXPECT_EQ(
      RunInProcess({"simplify", "-", "--drop-close", "--tolerance-per-point", "1"}, kText).out,
      expected);
}

TEST(SimplifyCommand, TakesTheTolerancesOfTheFile) {
  RunResult const column =
      RunInProcess({"simplify", "-", "--drop-close"}, "x,y,w\n0,0,.1\n1,0,.1\n2,0,2\n9,0,.1\n");
  EXPECT_EQ(column.out, "x,y,w\n0,0,.1\n1,0,.1\n9,0,.1\n");
  RunResult const comment =
      RunInProcess({"simplify", "-", "--drop-close"}, "# tolerance 1\n0,0\n1,0\n9,0\n");
  EXPECT_EQ(comment.out, "# tolerance 1\n0,0\n9,0\n");
}

TEST(SimplifyCommand, NothingToDropLeavesTheTextAsItIs) {
  RunResult const run = RunInProcess({"simplify", "-", "--drop-close", "-t", "0.001"}, "0 0\n1 1");
  EXPECT_EQ(run.out, "0 0\n1 1");
  EXPECT_EQ(run.err, "contour: standard input: dropped 0 of 2 points\n");
}

TEST(SimplifyCommand, ListsTenOfManyDroppedPoints) {
  std::string text;
  for (int i = 0; i <= 30; ++i) text += std::to_string(i) + ",0\n";
  RunResult const run = RunInProcess({"simplify", "-", "--drop-close", "-t", "5"}, text);
  EXPECT_EQ(run.out, "0,0\n30,0\n");
  EXPECT_NE(run.err.find("dropped 29 of 31 points: point 1 (line 2), "), std::string::npos);
  EXPECT_NE(run.err.find("point 10 (line 11) and 19 more\n"), std::string::npos) << run.err;
}

TEST(SimplifyCommand, RefusesToLeaveASinglePoint) {
  RunResult const run = RunInProcess({"simplify", "-", "--drop-close", "-t", "5"}, "0,0\n1,1\n");
  EXPECT_EQ(run.code, ExitCode::PointsTooClose);
  EXPECT_EQ(run.out, "");
  EXPECT_EQ(run.err,
            "contour: standard input: fewer than two points would be left: all lie too close to "
            "point 0 (line 1)\n");
}

TEST(SimplifyCommand, AClosedContourKeepsItsEndsApart) {
  std::string const text = "0,0\n4,0\n4,4\n0,4\n0,1\n";
  EXPECT_EQ(RunInProcess({"simplify", "-", "--drop-close", "-t", ".5"}, text).out, text);
  EXPECT_EQ(
      RunInProcess({"simplify", "-", "--drop-close", "-t", ".5", "--closed", "yes"}, text).out,
      "0,0\n4,0\n4,4\n0,4\n");
}

TEST(SimplifyCommand, AsksHow) {
  EXPECT_EQ(RunInProcess({"simplify", "-"}, kText).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"simplify", "p.csv", "--drop-close", "-o", "p.csv"}).code,
            ExitCode::Usage);
}

/// Points every 0.1 along x and then along y, one of them 1 away.
std::string Scan() {
  std::string text = "x,y\n";
  for (int i = 0; i < 100; ++i) {
    double const wobble = (i * 7 % 11 - 5) * 1e-4;
    text += std::to_string(i * 0.1) + "," + std::to_string(i == 40 ? 1.0 : wobble) + "\n";
  }
  for (int i = 1; i < 100; ++i) {
    double const wobble = (i * 5 % 13 - 6) * 1e-4;
    text += std::to_string(9.9 + wobble) + "," + std::to_string(i * 0.1) + "\n";
  }
  return text;
}

TEST(SimplifyCommand, ListsOutliersAndMeasuresEveryPoint) {
  RunResult const run = RunInProcess({"simplify", "-", "--outliers", "20", "-t", "0.02"}, Scan());
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_NE(run.err.find("standard input: 1 outlier\n"), std::string::npos) << run.err;
  EXPECT_NE(run.err.find("point 40 (line 42) is "), std::string::npos) << run.err;
  EXPECT_NE(run.err.find("a fit of the rest has 2 pieces; of all 199 points of the file 1 are "
                         "outside their tolerance, the largest deviation is "),
            std::string::npos)
      << run.err;
  EXPECT_EQ(run.out.find("4.000000,1.000000"), std::string::npos);
}

TEST(SimplifyCommand, AveragesInWindows) {
  RunResult const run =
      RunInProcess({"simplify", "-", "--spacing", "1", "--average", "-t", "0.3"}, Scan());
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_NE(run.err.find("stand for 199, "), std::string::npos) << run.err;
  EXPECT_NE(run.err.find("standard deviation across the path "), std::string::npos) << run.err;
  EXPECT_EQ(run.out.substr(0, 4), "x,y\n");
}

TEST(SimplifyCommand, ARestThatCannotBeFittedIsSaid) {
  RunResult const run = RunInProcess({"simplify", "-", "--spacing", "0.2", "-t", "50"}, Scan());
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_NE(run.err.find("the rest cannot be fitted: "), std::string::npos) << run.err;
}

TEST(SimplifyCommand, WritesPointsOfDrawingsAsATable) {
  RunResult const run =
      RunInProcess({"simplify", "-", "--spacing", "2"}, "LINESTRING (0 0, 1 0, 2 0, 3 0, 4 0)");
  EXPECT_EQ(run.out, "x,y\n0,0\n2,0\n4,0\n") << run.err;
}

class SimplifiedSharedData : public testing::TestWithParam<char const*> {};

TEST_P(SimplifiedSharedData, PassesTheSpacingRule) {
  std::optional<std::string> const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  std::string const path = *folder + "/" + GetParam() + ".csv";
  RunResult const simple = RunInProcess({"simplify", path, "--drop-close", "-t", "0.2"});
  ASSERT_EQ(simple.code, ExitCode::Ok) << simple.err;
  RunResult const info = RunInProcess({"info", "-", "-t", "0.2"}, simple.out);
  EXPECT_NE(info.out.find("): no pair is too close\n"), std::string::npos) << info.out;
}

INSTANTIATE_TEST_SUITE_P(SimplifyCommand, SimplifiedSharedData,
                         testing::Values("rail_head_known_arcs", "wheel_worn_a", "rail_worn_low",
                                         "mirror_sphere_83m", "hatch_boundary", "glyph_five",
                                         "test_track_centreline", "gcode_letter_d", "circle_r3"),
                         [](auto const& instance) { return std::string(instance.param); });

}  // namespace
}  // namespace Vorn::Cli
