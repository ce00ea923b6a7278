#include <fcntl.h>
#include <gtest/gtest.h>
#include <pty.h>
#include <sys/wait.h>
#include <unistd.h>

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "cli/ProgramFixture.h"

namespace Vorn::Cli::Testing {
namespace {

TEST_F(Program, TwoPointsGiveOneLine) {
  Write("p.csv", "0,0\n3,4\n");
  Ended const ended = Run("fit p.csv --tolerance 0.1");
  EXPECT_EQ(ended.code, 0);
  EXPECT_EQ(ended.err, "");
  std::string const table = ended.out.substr(0, ended.out.find("time"));
  EXPECT_EQ(
      table,
      "p.csv, sweeps in degrees\n"
      "\n"
      "no  kind  start x  start y  end x  end y  centre x  centre y  radius  direction  "
      "sweep  length  points\n"
      " 1  line    0.000    0.000  3.000  4.000         -         -       -  -          "
      "    -   5.000       2\n"
      "\n"
      "Measured by least squares over the points of each piece, angles in degrees. A radius of "
      "the\n"
      "contour is one of those that the tolerance admits; the one here is that of the points.\n"
      "\n"
      "no  kind  points  radius  direction  +-  form error  deviation  turn to next\n"
      " 1  line       2       -     53.130   -      0.0000          -             -\n"
      "\n"
      "points      2\n"
      "columns     1 and 2\n"
      "tolerance   0.1 (given for all points)\n"
      "strategy    fewest\n"
      "closed      no (the last point is not the first)\n"
      "pieces      1 (proven the fewest): 1 line, 0 arcs\n"
      "compression 2.0 points a piece, 50.0 % of the points\n"
      "reported    0.000000 of the tolerance at point 0 (line 1)\n"
      "re-measured 0.000000 of the tolerance at point 0 (line 1), 0 from piece 1\n"
      "deviation   0.000000 of the tolerance at point 0 (line 1), the largest that was found\n"
      "scatter     root mean square 0, mean 0, none of 2 points outside\n"
      "result      within tolerance\n");
}

TEST_F(Program, FieldsStandInEveryReport) {
  Write("p.csv", Corner());
  Ended const ended =
      Run("fit p.csv -t 0.01 -o p.json --field part='Cam <7>' --field 'drawing number'=12=3");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("\npart        Cam <7>\ndrawing number 12=3\npoints "),
            std::string::npos)
      << ended.out;
  auto const json = nlohmann::ordered_json::parse(Contents(folder_ / "p.json"));
  EXPECT_EQ(json.at("fields").dump(), R"({"part":"Cam <7>","drawing number":"12=3"})");
  EXPECT_EQ(json.at("program").get<std::string>().rfind("contour ", 0), 0u);
}

TEST_F(Program, FieldsNeedANameAndComeOnce) {
  Write("p.csv", Corner());
  ExpectRefusal("fit p.csv -t 0.01 --field part", 2,
                "--field 'part': NAME=VALUE is wanted, such as part=Cam");
  ExpectRefusal("fit p.csv -t 0.01 --field =7", 2,
                "--field '=7': NAME=VALUE is wanted, such as part=Cam");
  ExpectRefusal("fit p.csv -t 0.01 --field a=1 --field a=2", 2, "--field 'a' is given twice");
}

TEST_F(Program, CornerBecomesTwoLinesInTableJsonAndDrawing) {
  Write("p.csv", Corner());
  Ended const ended = Run("fit p.csv --tolerance 0.01 --json p.json --svg p.svg");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("pieces      2 (proven the fewest): 2 lines, 0 arcs\n"),
            std::string::npos)
      << ended.out;
  EXPECT_NE(ended.out.find("wrote       p.json\nwrote       p.svg\n"), std::string::npos);
  auto const json = nlohmann::json::parse(Contents(folder_ / "p.json"));
  ASSERT_EQ(json.at("elements").size(), 2u);
  EXPECT_NEAR(json.at("elements").at(0).at("end").at("x").get<double>(), 10.0, 0.01);
  EXPECT_EQ(json.at("input").at("points"), 21);
  std::string const svg = Contents(folder_ / "p.svg");
  EXPECT_EQ(svg.rfind("<?xml", 0), 0u);
  EXPECT_EQ(svg.substr(svg.size() - 7), "</svg>\n");
  EXPECT_EQ(Files(), (std::vector<std::string>{"p.csv", "p.json", "p.svg"}));
}

TEST_F(Program, ToleranceComesFromOptionColumnOrComment) {
  Write("comment.csv", "# tolerance 0.125\n# units mm\nx,y\n0,0\n3,4\n");
  Write("column.csv", "# tolerance 0.125\nx,y,w\n0,0,0.25\n3,4,0.5\n");
  auto const tolerance = [this](std::string const& arguments) {
    std::string const out = Run("fit " + arguments).out;
    std::size_t const begin = std::min(out.find("tolerance   "), out.size());
    return out.substr(begin, out.find('\n', begin) - begin);
  };
  EXPECT_EQ(tolerance("comment.csv"), "tolerance   0.125 mm (comment in the file)");
  EXPECT_EQ(tolerance("column.csv"), "tolerance   0.25 to 0.5 (column 'w' of the file)");
  EXPECT_EQ(tolerance("column.csv --tolerance 0.75"), "tolerance   0.75 (given for all points)");
  EXPECT_EQ(tolerance("column.csv --tolerance-column W"),
            "tolerance   0.25 to 0.5 (column 'W' of the file)");
  EXPECT_EQ(tolerance("column.csv --tolerance-per-point 9"),
            "tolerance   1.5 (0.3 of the spacing, at most 9)");
}

TEST_F(Program, ExitCode1OutsideTolerance) {
  // One arc cannot follow a corner; the answer is given all the same.
  Write("p.csv", Corner());
  Ended const ended = Run("fit p.csv --tolerance 0.3 --strategy arc --json p.json");
  ASSERT_EQ(ended.code, 1) << ended.err;
  EXPECT_NE(ended.out.find("result      OUTSIDE TOLERANCE\n"), std::string::npos);
  EXPECT_NE(ended.err.find("contour: p.csv: the contour leaves the tolerance of point "),
            std::string::npos)
      << ended.err;
  auto const json = nlohmann::json::parse(Contents(folder_ / "p.json"));
  EXPECT_EQ(json.at("verdict"), "outside tolerance");
  EXPECT_GT(json.at("deviation").at("remeasured").at("value").get<double>(), 1.0);
  EXPECT_EQ(json.at("deviation").at("reported").at("kind"), "absolute");
}

TEST_F(Program, ExitCode2Usage) {
  Write("p.csv", Corner());
  for (char const* arguments :
       {"", "fit", "fit p.csv --tolerance 0", "fit p.csv --tolerance=-1",
        "fit p.csv --tolerance 1 --tolerance-per-point 1", "fit p.csv --strategy best",
        "fit p.csv --tolerance 0.01 --json p.csv", "fit p.csv"}) {
    Ended const ended = Run(arguments);
    EXPECT_EQ(ended.code, 2) << arguments;
    EXPECT_EQ(ended.out, "") << arguments;
    EXPECT_EQ(ended.err.rfind("contour: ", 0), 0u) << arguments << ": " << ended.err;
  }
  EXPECT_EQ(Contents(folder_ / "p.csv"), Corner());
}

TEST_F(Program, ExitCode3UnreadableFiles) {
  Write("empty.csv", "");
  Write("header.csv", "x,y\n");
  Write("one.csv", "x,y\n1,2\n");
  Write("nan.csv", "x,y\n1,2\nnan,3\n");
  Write("text.csv", "x,y\n1,2\n3,four\n");
  Write("column.csv", "x,y\n1,2\n3\n");
  Write("single.csv", "1\n2\n");
  Write("weights.csv", "x,y,w\n1,2,0\n3,4,1\n");
  std::string const option = " --tolerance 0.1";
  ExpectRefusal("fit none.csv" + option, 3, "none.csv: No such file or directory");
  ExpectRefusal("fit ." + option, 3, ".: is a directory");
  ExpectRefusal("fit empty.csv" + option, 3, "empty.csv: holds no points");
  ExpectRefusal("fit header.csv" + option, 3, "header.csv: holds a header but no points");
  ExpectRefusal("fit one.csv" + option, 3, "one.csv: holds one point only; a contour needs two");
  ExpectRefusal("fit nan.csv" + option, 3, "nan.csv:3:1: x is not a finite number: 'nan'");
  ExpectRefusal("fit text.csv" + option, 3, "text.csv:3:3: y is not a number: 'four'");
  ExpectRefusal("fit column.csv" + option, 3, "column.csv:3:1: expected 2 columns, found 1: '3'");
  ExpectRefusal("fit single.csv" + option, 3,
                "single.csv:1:1: only one column, '1'; expected x,y or x,y,w");
  ExpectRefusal("fit weights.csv", 3,
                "weights.csv:2:5: tolerance '0' must be a finite number above 0");
  ExpectRefusal("fit weights.csv --tolerance-column tol", 3,
                "weights.csv:1:1: no column 'tol'; the header has 'x', 'y', 'w'");
}

TEST_F(Program, ExitCode4PointsTooClose) {
  Write("p.csv", "x,y\n0,0\n1,0\n1.5,0\n3,0\n");
  ExpectRefusal("fit p.csv --tolerance 0.25 --strategy mixed --svg p.svg", 4,
                "p.csv: point 1 (line 3) and point 2 (line 4) are too close: distance 0.5, needed "
                "more than 0.75 (1.5 times the sum of their tolerances)\n"
                "the largest single tolerance that would pass for this file is 0.166666\n"
                "see: contour info p.csv -t 0.25\n"
                "ways out: --strategy fewest, which takes points of any density\n"
                "or --tolerance 0.166666, or --tolerance-per-point CAP to follow the spacing\n"
                "or leave points out: contour simplify p.csv -t 0.25 --drop-close");
  EXPECT_EQ(Files(), std::vector<std::string>{"p.csv"});
  EXPECT_EQ(Run("fit p.csv --tolerance 0.166666 --strategy mixed").code, 0)
      << "the tolerance named must pass";
  EXPECT_EQ(Run("fit p.csv --tolerance 0.25").code, 0) << "the usual strategy takes any spacing";
}

TEST_F(Program, ExitCode4CoincidingPoints) {
  Write("p.csv", "0,0\n1,0\n1,0\n3,0\n");
  Ended const ended = Run("fit p.csv --tolerance 0.1 --strategy mixed");
  EXPECT_EQ(ended.code, 4);
  EXPECT_NE(ended.err.find("no tolerance would pass"), std::string::npos) << ended.err;
  ExpectRefusal("fit p.csv --tolerance-per-point 0.1", 4,
                "p.csv: point 1 (line 2) and point 2 (line 3) coincide: no tolerance can follow "
                "from a spacing of zero\n"
                "to leave one of them out: contour simplify p.csv --drop-close");
}

TEST_F(Program, ExitCode5NoFit) {
  // A single arc needs three points.
  Write("p.csv", "0,0\n3,4\n");
  Ended const ended = Run("fit p.csv --tolerance 0.1 --strategy arc --json p.json");
  EXPECT_EQ(ended.code, 5);
  EXPECT_EQ(ended.out, "");
  EXPECT_EQ(ended.err.rfind("contour: p.csv: no fit (code 2, Failed", 0), 0u) << ended.err;
  EXPECT_EQ(Files(), std::vector<std::string>{"p.csv"});
}

TEST_F(Program, OutputsThatCannotBeWrittenAreNamedAndLeaveNothing) {
  Write("p.csv", Corner());
  fs::create_directory(folder_ / "sub");
  ExpectRefusal("fit p.csv --tolerance 0.01 --json none/p.json", 3,
                "none/p.json: cannot be written: No such file or directory");
  ExpectRefusal("fit p.csv --tolerance 0.01 --svg sub", 3,
                "sub: cannot be written: is a directory");
  ExpectRefusal("fit p.csv --tolerance 0.01 --json p.json --svg none/p.svg", 3,
                "none/p.svg: cannot be written: No such file or directory");
  EXPECT_EQ(Files(), (std::vector<std::string>{"p.csv", "sub"}));
}

TEST_F(Program, FullDiskLeavesTheOldFilesWhole) {
  Write("p.csv", Corner());
  Write("p.json", "old json");
  Write("p.svg", "old svg");
  // A limit of 6 blocks of 512 or 1024 bytes holds the JSON of two lines, not the drawing.
  Ended const ended =
      Run("fit p.csv --tolerance 0.01 --json p.json --svg p.svg", "trap '' XFSZ && ulimit -f 6 &&");
  EXPECT_EQ(ended.code, 3) << ended.err;
  EXPECT_EQ(ended.err, "contour: p.svg: cannot be written: File too large\n");
  EXPECT_EQ(Contents(folder_ / "p.json"), "old json");
  EXPECT_EQ(Contents(folder_ / "p.svg"), "old svg");
  EXPECT_EQ(Files(), (std::vector<std::string>{"p.csv", "p.json", "p.svg"}));
}

TEST_F(Program, StandardOutputThatFailsIsNoticed) {
  std::string const command =
      std::string("'") + CONTOUR_PROGRAM + "' --help >/dev/full 2>/dev/null";
  int const status = std::system(command.c_str());
  ASSERT_TRUE(WIFEXITED(status));
  EXPECT_EQ(WEXITSTATUS(status), 3);
}

TEST_F(Program, HelpAndVersionGoToStandardOutput) {
  for (char const* arguments : {"--help", "fit --help", "--version"}) {
    Ended const ended = Run(arguments);
    EXPECT_EQ(ended.code, 0) << arguments;
    EXPECT_NE(ended.out, "") << arguments;
    EXPECT_EQ(ended.err, "") << arguments;
  }
}

TEST_F(Program, EveryCommandListsItsExitCodesAndAnExample) {
  for (std::string const command :
       {"fit", "check", "info", "plot", "area", "intersect", "convert", "simplify"}) {
    std::string const help = Run(command + " --help").out;
    for (std::string const wanted :
         {"Exit codes:\n  0 ", "\n  2 ", "\n  3 ", "\n  70  internal error\n  130 interrupted\n",
          "Examples:\n  contour "}) {
      EXPECT_NE(help.find(wanted), std::string::npos) << command << ": " << wanted;
    }
  }
}

TEST_F(Program, ProgressGoesToATerminalOnly) {
  Write("p.csv", Corner());
  EXPECT_EQ(Run("fit p.csv --tolerance 0.01").err, "");
  std::string const points = (folder_ / "p.csv").string();
  int terminal = -1;
  pid_t const child = forkpty(&terminal, nullptr, nullptr, nullptr);
  ASSERT_GE(child, 0);
  if (child == 0) {
    // Standard error stays the terminal; the table would only be in the way.
    int const nowhere = open("/dev/null", O_WRONLY);
    dup2(nowhere, STDOUT_FILENO);
    execl(CONTOUR_PROGRAM, CONTOUR_PROGRAM, "fit", points.c_str(), "--tolerance", "0.01",
          static_cast<char*>(nullptr));
    _exit(99);
  }
  std::string text;
  char buffer[256];
  for (ssize_t size = 0; (size = read(terminal, buffer, sizeof buffer)) > 0;) {
    text.append(buffer, static_cast<std::size_t>(size));
  }
  int status = 0;
  waitpid(child, &status, 0);
  close(terminal);
  ASSERT_TRUE(WIFEXITED(status));
  EXPECT_EQ(WEXITSTATUS(status), 0);
  EXPECT_EQ(text.rfind("\rfitting [", 0), 0u) << text;
  EXPECT_NE(text.find("100 %"), std::string::npos) << text;
  EXPECT_EQ(text.substr(text.size() - 4), "\r\x1b[K") << "the bar is wiped off";
}

TEST_F(Program, TwoRunsWriteTheSameBytes) {
  Write("p.csv", Corner());
  ASSERT_EQ(Run("fit p.csv --tolerance 0.01 --json a.json --svg a.svg").code, 0);
  ASSERT_EQ(Run("fit p.csv --tolerance 0.01 --json b.json --svg b.svg").code, 0);
  EXPECT_EQ(Contents(folder_ / "a.json"), Contents(folder_ / "b.json"));
  EXPECT_EQ(Contents(folder_ / "a.svg"), Contents(folder_ / "b.svg"));
}

class ShippedExample : public Program, public testing::WithParamInterface<char const*> {};

TEST_P(ShippedExample, FitsWithinItsToleranceWithoutAnyOption) {
  std::string const file = std::string(CONTOUR_EXAMPLES) + "/" + GetParam() + ".csv";
  Ended const ended = Run("fit '" + file + "' --json e.json");
  ASSERT_EQ(ended.code, 0) << ended.err;
  auto const json = nlohmann::json::parse(Contents(folder_ / "e.json"));
  double const reported = json.at("deviation").at("reported").at("value").get<double>();
  double const remeasured = json.at("deviation").at("remeasured").at("value").get<double>();
  EXPECT_LE(remeasured, 1.0 + 1e-9);
  EXPECT_GT(remeasured, 0.05) << "noise and the shape must leave a trace";
  EXPECT_LE(reported, 1.0 + 1e-9);
  EXPECT_LT(json.at("elements").size(), json.at("input").at("points").get<std::size_t>() / 10);
}

INSTANTIATE_TEST_SUITE_P(Examples, ShippedExample,
                         testing::Values("machined_profile", "cam", "gear_tooth"),
                         [](auto const& instance) { return std::string(instance.param); });

}  // namespace
}  // namespace Vorn::Cli::Testing
