// Tool paths of the program, run by a controller: that of the tests and, where one is installed,
// that of a machine.
#include <array>
#include <cmath>
#include <sstream>

#include "cli/ProgramFixture.h"
#include "support/ToolController.h"

namespace Vorn::Cli::Testing {
namespace {

using Vorn::Testing::DistanceToCuts;
using Vorn::Testing::ToolController;

class ToolPathProgram : public Program {
 protected:
  /// Half a wheel with flats: lines and arcs either way, `scale` large.
  static std::vector<std::array<double, 2>> Rim(double scale) {
    std::vector<std::array<double, 2>> points;
    for (int i = 0; i <= 60; ++i) {
      double const angle = 0.05 * i;
      points.push_back({scale * 10.0 * std::cos(angle), scale * 10.0 * std::sin(angle)});
    }
    for (int i = 1; i <= 20; ++i)
      points.push_back({points[60][0], points[60][1] - scale * 0.5 * i});
    return points;
  }

  void WritePoints(std::string const& name,
                   std::vector<std::array<double, 2>> const& points) const {
    std::ostringstream text;
    text.precision(17);
    for (auto const& [x, y] : points) text << x << ',' << y << '\n';
    Write(name, text.str());
  }

  ToolController RunIn(std::string const& name) const {
    ToolController controller;
    controller.Run(Contents(folder_ / name));
    return controller;
  }

  /// Relative to the tolerance.
  static double WorstOf(ToolController const& controller,
                        std::vector<std::array<double, 2>> const& points, double tolerance) {
    double worst = 0.0;
    for (auto const& [x, y] : points) {
      worst = std::max(worst, DistanceToCuts(controller, x, y) / tolerance);
    }
    return worst;
  }

  /// What a machine's own interpreter says; empty: it took the program, or there is none.
  std::string ComplaintOfMachine(std::string const& name) const {
    if (std::system("command -v rs274 >/dev/null") != 0) return "";
    Write("tools.tbl", "");
    Write("machine.var", "");
    std::string const command = "cd '" + folder_.string() +
                                "' && rs274 -t tools.tbl -v machine.var -g " + name +
                                " >.machine 2>&1";
    int const status = std::system(command.c_str());
    std::string const text = Contents(folder_ / ".machine");
    bool const isGood = status == 0 && text.find("PROGRAM_END") != std::string::npos;
    return isGood ? "" : text;
  }
};

TEST_F(ToolPathProgram, EveryPointIsWithinToleranceOfWhatTheToolCuts) {
  auto const points = Rim(1.0);
  WritePoints("p.csv", points);
  for (double const tolerance : {0.1, 0.001, 0.00001, 0.0000002}) {
    for (char const* options : {"", "--r-words", "--plane xz", "--plane xz --r-words",
                                "--safe-height 5 --cut-height -1 --plunge-feed 50"}) {
      std::ostringstream line;
      line << "fit p.csv -o p.nc --units mm --feed 600 -t " << tolerance << ' ' << options;
      Ended const ended = Run(line.str());
      EXPECT_EQ(ended.code, 0) << line.str() << ended.err;
      EXPECT_EQ(ended.err, "") << line.str();
      ToolController const controller = RunIn("p.nc");
      EXPECT_EQ(controller.fault, "") << line.str();
      EXPECT_LE(WorstOf(controller, points, tolerance), 1.0 + 1e-5) << line.str();
      EXPECT_EQ(ComplaintOfMachine("p.nc"), "") << line.str();
    }
  }
}

TEST_F(ToolPathProgram, TooFewDigitsOnRequestAreSaidAndEndInCodeOne) {
  WritePoints("p.csv", Rim(1.0));
  Ended const ended = Run("fit p.csv -o p.nc --feed 600 -t 0.00001 --gcode-decimals 4");
  EXPECT_EQ(ended.code, 1);
  EXPECT_NE(ended.out.find("\nresult      OUTSIDE TOLERANCE\n"), std::string::npos) << ended.out;
  EXPECT_NE(ended.out.find("\nread back   "), std::string::npos) << ended.out;
  EXPECT_NE(ended.err.find("contour: p.nc: rounded, the contour leaves the tolerance of point "),
            std::string::npos)
      << ended.err;
  EXPECT_NE(ended.err.find("--gcode-decimals"), std::string::npos) << ended.err;
  EXPECT_EQ(Run("check p.csv p.nc -t 0.00001").code, 1);
}

TEST_F(ToolPathProgram, ManyFilesAreMeasuredAsTheyStandToo) {
  WritePoints("p.csv", Rim(1.0));
  Ended const coarse =
      Run("fit p.csv --out-dir out --to nc,json --feed 600 -t 0.00001 --gcode-decimals 4");
  EXPECT_EQ(coarse.code, 1);
  EXPECT_NE(coarse.out.find("OUTSIDE TOLERANCE"), std::string::npos) << coarse.out;
  EXPECT_NE(coarse.err.find("out/p.gcode: rounded"), std::string::npos) << coarse.err;
  EXPECT_EQ(Run("fit p.csv --out-dir out --to nc,json --feed 600 -t 0.00001").code, 0);
  EXPECT_EQ(Run("check p.csv out/p.gcode -t 0.00001").code, 0);
}

TEST_F(ToolPathProgram, AMissingFeedIsSaid) {
  WritePoints("p.csv", Rim(1.0));
  std::string const warning =
      "contour: G-code without a feed: a controller stops at the first cut; --feed F gives it "
      "one\n";
  Ended const fit = Run("fit p.csv -o p.nc -o p.json -t 0.01");
  EXPECT_EQ(fit.code, 0);
  EXPECT_EQ(fit.err, warning);
  EXPECT_EQ(RunIn("p.nc").fault, "line 4: cannot cut with no feed");
  EXPECT_EQ(Run("convert p.json -o q.nc").err, warning);
  EXPECT_EQ(Run("convert p.json -o q.dxf").err, "");
}

TEST_F(ToolPathProgram, TheProgramEndsAsAsked) {
  WritePoints("p.csv", Rim(1.0));
  auto const lastLine = [&](std::string const& options) {
    EXPECT_EQ(Run("fit p.csv -o p.nc -t 0.01 --feed 9 " + options).code, 0);
    std::string const text = Contents(folder_ / "p.nc");
    return text.substr(text.rfind('\n', text.size() - 2) + 1);
  };
  EXPECT_EQ(lastLine(""), "M2\n");
  EXPECT_EQ(lastLine("--end m30"), "M30\n");
  EXPECT_EQ(lastLine("--end none").substr(0, 2), "G1");
  EXPECT_EQ(RunIn("p.nc").fault, "the program has no end");
}

TEST_F(ToolPathProgram, HeaderAndFooterAreFilledIn) {
  WritePoints("p.csv", Rim(1.0));
  Write("head.txt",
        "(part {name} in {units}, {tolerance}, feed {feed})\nG54 T1 M6\nG43 H1 S800 M3\n");
  Write("foot.txt", "M5\n({pieces} pieces, {braces stay})\n");
  Ended const ended =
      Run("fit p.csv -o p.nc -t 0.01 --units mm --feed 9 --header head.txt --footer foot.txt");
  EXPECT_EQ(ended.code, 0) << ended.err;
  std::string const text = Contents(folder_ / "p.nc");
  EXPECT_EQ(text.find("(part p.csv in mm, 0.01, feed 9)\nG54 T1 M6\nG43 H1 S800 M3\nG21\nG17 "), 0u)
      << text;
  EXPECT_NE(text.find("\nM5\n(2 pieces, {braces stay})\nM2\n"), std::string::npos) << text;
  Write("head.txt", "({nonsense})\n");
  Ended const wrong = Run("fit p.csv -o p.nc -t 0.01 --header head.txt");
  EXPECT_EQ(wrong.code, 2);
  EXPECT_NE(wrong.err.find("'{nonsense}' is none of the fields {name}"), std::string::npos);
}

TEST_F(ToolPathProgram, AHeaderThatCannotBeReadBackIsSaid) {
  WritePoints("p.csv", Rim(1.0));
  Write("head.txt", "#1=5\n");
  Ended const ended = Run("fit p.csv -o p.nc -t 0.01 --feed 9 --header head.txt");
  EXPECT_EQ(ended.code, 1);
  EXPECT_NE(ended.err.find("p.nc: cannot be read back and measured: "), std::string::npos);
}

TEST_F(ToolPathProgram, HeightsLiftTheToolOverGaps) {
  Write("gap.wkt", "MULTICURVE ((0 0, 10 0), (20 0, 30 0))\n");
  EXPECT_EQ(Run("convert gap.wkt -o g.nc --units mm --feed 600 --safe-height 5 --cut-height -1.5 "
                "--plunge-feed 50")
                .code,
            0);
  EXPECT_EQ(Contents(folder_ / "g.nc"),
            "G21\nG17 G90 G91.1\n"
            "G0 Z5.0000\nG0 X0.0000 Y0.0000\nG1 Z-1.5000 F50\nG1 X10.0000 Y0.0000 F600\n"
            "G0 Z5.0000\nG0 X20.0000 Y0.0000\nG1 Z-1.5000 F50\nG1 X30.0000 Y0.0000 F600\n"
            "G0 Z5.0000\nM2\n");
  EXPECT_EQ(Run("convert gap.wkt -o g.nc --safe-height 5").code, 2);
  EXPECT_EQ(Run("convert gap.wkt -o g.nc --safe-height 5 --cut-height 0 --plane xz").code, 2);
}

TEST_F(ToolPathProgram, AConversionSaysHowFarItLeavesTheContour) {
  Write("p.wkt", "LINESTRING (0 0, 0.123456 1)\n");
  Ended const coarse = Run("convert p.wkt -o p.nc --gcode-decimals 2 --feed 9 -t 0.001");
  EXPECT_EQ(coarse.code, 1);
  EXPECT_NE(coarse.out.find("wrote       p.nc, up to 0.0035 from the contour: TOO FAR\n"),
            std::string::npos)
      << coarse.out;
  EXPECT_NE(coarse.err.find("contour: p.nc: leaves the contour by 0.003"), std::string::npos);
  Ended const fine = Run("convert p.wkt -o p.nc --feed 9 -t 0.0000001");
  EXPECT_EQ(fine.code, 0);
  EXPECT_NE(Contents(folder_ / "p.nc").find("X0.123456000 Y1.000000000"), std::string::npos);
}

}  // namespace
}  // namespace Vorn::Cli::Testing
