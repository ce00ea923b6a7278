#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <sstream>

#include "cli/RunInProcess.h"
#include "vorn/io/Files.h"

namespace Vorn::Cli {
namespace {

namespace fs = std::filesystem;

/// A folder of its own for every test.
class CheckCommand : public testing::Test {
 protected:
  CheckCommand() {
    std::string name = (fs::temp_directory_path() / "contour-check-XXXXXX").string();
    folder_ = mkdtemp(name.data());
  }

  ~CheckCommand() override { fs::remove_all(folder_); }

  std::string Write(std::string const& name, std::string const& text) const {
    std::ofstream(folder_ / name, std::ios::binary) << text;
    return PathOf(name);
  }

  std::string PathOf(std::string const& name) const { return (folder_ / name).string(); }

  fs::path folder_;
};

std::string Contents(std::string const& path) {
  std::istringstream none;
  return ReadTextFile(path, none);
}

/// A corner, then a half circle of radius 1 about (4, 4).
constexpr char const* kContour =
    "type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction\n"
    "line,0,0,5,0,,,,\n"
    "line,5,0,5,4,,,,\n"
    "arc,5,4,3,4,4,4,1,ccw\n";

constexpr char const* kPoints = "# units mm\nx,y\n0,0\n2,0.25\n5,2\n4,4.5\n3,4\n";

TEST_F(CheckCommand, WithoutAToleranceGivesLengthsAndExitCode0) {
  std::string const contour = Write("c.csv", kContour);
  RunResult const run = RunInProcess({"check", "-", contour}, kPoints);
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_EQ(run.err, "");
  EXPECT_EQ(run.out,
            "standard input against " + contour +
                ", lengths in mm\n"
                "\n"
                "points      5\n"
                "columns     1 (x) and 2 (y)\n"
                "pieces      3: 2 lines, 1 arc, 12.1416 long, open\n"
                "tolerance   none given: deviations are lengths\n"
                "largest     0.5 at point 3 (line 6), to the left of piece 3\n"
                "scatter     root mean square 0.25 mm, mean 0.15 mm\n"
                "joints      the pieces meet\n"
                "crossing    the contour does not cross itself\n"
                "area        none: the contour is open\n"
                "result      measured\n"
                "\n"
                "point  line  x     y  deviation  piece\n"
                "    3     6  4   4.5        0.5      3\n"
                "    1     4  2  0.25       0.25      1\n"
                "    0     3  0     0          0      1\n"
                "    2     5  5     2          0      2\n"
                "    4     7  3     4          0      3\n"
                "\n"
                "Measured by least squares over the points of each piece, angles in "
                "degrees. A radius of the\n"
                "contour is one of those that the tolerance admits; the one here is that "
                "of the points.\n"
                "\n"
                "no  kind  points  radius  direction  +-  form error  deviation  turn to "
                "next\n"
                " 1  line       2       -      7.125   -     0.00000          -        "
                "90.000\n"
                " 2  line       1       -          -   -           -          -         "
                "0.000\n"
                " 3  arc        2       -          -   -           -          -             "
                "-\n");
}

TEST_F(CheckCommand, WithAToleranceJudges) {
  std::string const contour = Write("c.csv", kContour);
  RunResult const outside = RunInProcess({"check", "-", contour, "-t", "0.25"}, kPoints);
  EXPECT_EQ(outside.code, ExitCode::OutsideTolerance);
  EXPECT_NE(outside.out.find("relative    2.000000 of the tolerance at point 3 (line 6)"),
            std::string::npos)
      << outside.out;
  EXPECT_NE(outside.out.find("outside     1 of 5 points\n"), std::string::npos);
  EXPECT_NE(outside.out.find("result      OUTSIDE TOLERANCE\n"), std::string::npos);
  RunResult const within = RunInProcess({"check", "-", contour, "-t", "0.5"}, kPoints);
  EXPECT_EQ(within.code, ExitCode::Ok) << "as far as the tolerance is within";
  EXPECT_NE(within.out.find("outside     none of 5 points\n"), std::string::npos) << within.out;
}

TEST_F(CheckCommand, EachPointMayHaveATolerance) {
  std::string const contour = Write("c.csv", kContour);
  RunResult const run =
      RunInProcess({"check", "-", contour}, "x,y,w\n2,0.25,0.125\n4,4.5,4\n3,4,1\n");
  EXPECT_EQ(run.code, ExitCode::OutsideTolerance);
  EXPECT_NE(run.out.find("largest     0.5 at point 1 (line 3)"), std::string::npos) << run.out;
  EXPECT_NE(run.out.find("relative    2.000000 of the tolerance at point 0 (line 2)"),
            std::string::npos);
}

TEST_F(CheckCommand, TableHoldsEveryPointWithAllDigits) {
  std::string const contour = Write("c.csv", kContour);
  RunResult const lengths = RunInProcess({"check", "-", contour, "--table", "-"}, kPoints);
  EXPECT_EQ(lengths.out,
            "point,line,x,y,deviation,piece\n"
            "0,3,0,0,0,1\n1,4,2,0.25,0.25,1\n2,5,5,2,0,2\n3,6,4,4.5,0.5,3\n4,7,3,4,0,3\n");
  std::string const table = PathOf("t.csv");
  RunResult const judged =
      RunInProcess({"check", "-", contour, "-t", "0.25", "--table", table}, kPoints);
  EXPECT_NE(judged.out.find("result      "), std::string::npos);
  EXPECT_NE(Contents(table).find("\n3,6,4,4.5,0.5,3,0.25,2\n"), std::string::npos);
}

TEST_F(CheckCommand, JsonHoldsEveryFactExactly) {
  std::string const contour = Write("c.csv", kContour);
  RunResult const judged = RunInProcess({"check", "-", contour, "-t", "0.1", "--json", "-"},
                                        "# units mm\nx,y\n0,0\n0.1,0.3\n4,5.05\n3,4\n");
  EXPECT_EQ(judged.code, ExitCode::OutsideTolerance);
  auto const json = nlohmann::json::parse(judged.out);
  EXPECT_EQ(json.at("schemaVersion"), 1);
  EXPECT_EQ(json.at("points"),
            nlohmann::json::parse(R"({"file": "standard input", "count": 4, "units": "mm"})"));
  EXPECT_EQ(json.at("contour").at("lines"), 2);
  EXPECT_EQ(json.at("contour").at("arcs"), 1);
  EXPECT_EQ(json.at("contour").at("closed"), false);
  EXPECT_TRUE(json.at("contour").at("units").is_null());
  EXPECT_EQ(json.at("tolerance").at("smallest"), 0.1);
  EXPECT_EQ(json.at("result"), "outside tolerance");
  EXPECT_EQ(json.at("largest").at("point"), 1);
  EXPECT_EQ(json.at("largest").at("line"), 4);
  EXPECT_EQ(json.at("largest").at("x"), 0.1);
  EXPECT_EQ(json.at("largest").at("deviation"), 0.3);
  EXPECT_EQ(json.at("relative").at("relative"), 0.3 / 0.1);
  EXPECT_EQ(json.at("outside"), nlohmann::json::parse("[1]"));
  EXPECT_TRUE(json.at("gaps").empty());
  EXPECT_EQ(json.at("crosses"), false);
  EXPECT_TRUE(json.at("area").is_null());
  EXPECT_EQ(json.at("deviations").size(), 4u);
}

TEST_F(CheckCommand, JsonLeavesOutWhatIsNotKnown) {
  std::string const square =
      Write("s.csv",
            "# closed yes\ntype,start_x,start_y,end_x,end_y\nline,0,0,4,0\nline,4.5,0,4,3\n"
            "line,4,3,0,3\nline,0,3,0,0\n");
  std::string const path = PathOf("r.json");
  RunResult const run = RunInProcess({"check", "-", square, "--json", path}, kPoints);
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_NE(run.out.find("result      measured\n"), std::string::npos) << "the text comes as well";
  auto const json = nlohmann::json::parse(Contents(path));
  EXPECT_TRUE(json.at("tolerance").is_null());
  EXPECT_TRUE(json.at("relative").is_null());
  EXPECT_TRUE(json.at("outside").is_null());
  EXPECT_FALSE(json.at("largest").contains("relative"));
  EXPECT_EQ(json.at("gaps"), nlohmann::json::parse(R"([{"before": 1, "after": 2, "size": 0.5}])"));
  EXPECT_EQ(json.at("area").at("direction"), "ccw");
  EXPECT_EQ(json.at("area").at("value"), 12.75);
}

TEST_F(CheckCommand, AllListsThePointsInTheirOrder) {
  std::string const contour = Write("c.csv", kContour);
  std::string points;
  for (int i = 0; i <= 20; ++i) points += std::to_string(0.25 * i) + ",0.125\n";
  RunResult const worst = RunInProcess({"check", "-", contour}, points);
  RunResult const all = RunInProcess({"check", "-", contour, "--all"}, points);
  auto const lines = [](std::string const& text) {
    return std::count(text.begin(), text.end(), '\n');
  };
  EXPECT_EQ(lines(all.out) - lines(worst.out), 11);
  EXPECT_LT(all.out.find("\n    0     1 "), all.out.find("\n   20    21 "));
}

TEST_F(CheckCommand, ReportsGapsCrossingsAndArea) {
  std::string const gaps =
      Write("g.csv",
            "type,start_x,start_y,end_x,end_y\nline,0,0,4,0\nline,4.5,0,4.5,3\nline,4.5,3,0,3\n");
  EXPECT_NE(
      RunInProcess({"check", "-", gaps}, kPoints)
          .out.find("joints      1 gap\n            pieces 1 and 2 do not meet: the gap is 0.5\n"),
      std::string::npos);
  std::string const square =
      Write("s.csv",
            "# closed yes\ntype,start_x,start_y,end_x,end_y\nline,0,0,4,0\nline,4,0,4,3\n"
            "line,4,3,0,3\nline,0,3,0,0\n");
  EXPECT_NE(RunInProcess({"check", "-", square}, kPoints)
                .out.find("area        12, counter-clockwise (y up)\n"),
            std::string::npos);
  std::string const bow =
      Write("b.csv",
            "# closed yes\ntype,start_x,start_y,end_x,end_y\nline,0,0,4,3\nline,4,3,4,0\n"
            "line,4,0,0,3\nline,0,3,0,0\n");
  std::string const out = RunInProcess({"check", "-", bow}, kPoints).out;
  EXPECT_NE(out.find("crossing    THE CONTOUR CROSSES OR TOUCHES ITSELF: 1 crossing, 0 touching, "
                     "0 overlaps\n            crossing at (2, 1.5) of pieces 1 and 3\n"),
            std::string::npos)
      << out;
  EXPECT_NE(out.find("area        none: the contour crosses itself\n"), std::string::npos) << out;
}

TEST_F(CheckCommand, SaysWhenTheUnitsDiffer) {
  std::string const contour = Write("c.csv", std::string("# units inch\n") + kContour);
  EXPECT_EQ(RunInProcess({"check", "-", contour}, kPoints).err,
            "contour: the points are in mm, the contour in inch: nothing is converted\n");
}

TEST_F(CheckCommand, RefusesWhatItCannotRead) {
  std::string const contour = Write("c.csv", kContour);
  std::string const points = Write("p.csv", kPoints);
  EXPECT_EQ(RunInProcess({"check", "-", "-"}, kPoints).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"check", points}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"check", points, contour, "--table", points}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"check", points, contour, "--json", contour}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"check", points, contour, "--table", "-", "--json", "-"}).code,
            ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"check", PathOf("none.csv"), contour}).code, ExitCode::File);
  EXPECT_EQ(RunInProcess({"check", points, PathOf("none.csv")}).code, ExitCode::File);
  EXPECT_EQ(RunInProcess({"check", points, points}).code, ExitCode::File);
  EXPECT_EQ(RunInProcess({"check", points, Write("e.csv", "")}).code, ExitCode::File);
}

TEST_F(CheckCommand, ContourMayComeFromStandardInputWithItsFormatSaid) {
  std::string const points = Write("p.csv", kPoints);
  RunResult const run = RunInProcess({"check", points, "-", "--from", "csv"}, kContour);
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
}

TEST_F(CheckCommand, TellsScatterAndTheLineOfLeastSquares) {
  std::string const contour = Write(
      "line.csv",
      "type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction\nline,0,0,4,0,,,,\n");
  std::string const points = "x,y\n0,0.1\n1,-0.1\n3,-0.1\n4,0.1\n";
  RunResult const run = RunInProcess({"check", "-", contour, "-t", "0.2"}, points);
  EXPECT_NE(run.out.find("scatter     root mean square 0.1, mean "), std::string::npos) << run.out;
  EXPECT_NE(run.out.find("outside     none of 4 points"), std::string::npos) << run.out;
  EXPECT_NE(run.out.find("Measured by least squares over the points of each piece"),
            std::string::npos);
  // The line through the mean, along x: form error 0.2, deviation the root of 0.04 over 4 - 2.
  EXPECT_NE(run.out.find("0.2000"), std::string::npos) << run.out;
  EXPECT_NE(run.out.find("0.1414"), std::string::npos) << run.out;
}

TEST_F(CheckCommand, JsonHoldsScatterAndLeastSquares) {
  std::string const contour = Write(
      "line.csv",
      "type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction\nline,0,0,4,0,,,,\n");
  RunResult const run = RunInProcess({"check", "-", contour, "-t", "0.2", "--json", "-"},
                                     "x,y\n0,0.1\n1,-0.1\n3,-0.1\n4,0.1\n");
  nlohmann::json const json = nlohmann::json::parse(run.out);
  EXPECT_NEAR(json.at("scatter").at("rootMeanSquare").get<double>(), 0.1, 1e-15);
  EXPECT_EQ(json.at("scatter").at("histogram").at("kind"), "relative");
  ASSERT_EQ(json.at("pieces").size(), 1U);
  EXPECT_EQ(json.at("pieces")[0].at("points"), 4);
  EXPECT_NEAR(json.at("pieces")[0].at("leastSquares").at("formError").get<double>(), 0.2, 1e-12);
}

}  // namespace
}  // namespace Vorn::Cli
