#include <gtest/gtest.h>

#include <string>

#include "cli/ProgramFixture.h"

namespace Vorn::Cli::Testing {
namespace {

TEST_F(Program, BrokenPointsFilesEndEveryCommandWithCode3) {
  Write("truncated.csv", "x,y\n1,2\n3,");
  Write("binary.csv", std::string("\x7F"
                                  "ELF\0\1\2\3",
                                  8));
  Write("nan.csv", "x,y\n1,2\nnan,4\n");
  Write("one.csv", "x,y\n1,2\n");
  Write("none.csv", "x,y\n");
  std::string columns = "1";
  for (int i = 1; i < 1'000'000; ++i) columns += ";1";
  Write("wide.csv", columns);
  Write("contour.csv", "type,start_x,start_y,end_x,end_y\nline,0,0,4,0\n");
  struct Case {
    std::string file;
    std::string message;
  };
  for (Case const& broken :
       {Case{"truncated.csv", "truncated.csv:3:3: y is missing"},
        Case{"binary.csv", "binary.csv: is not text: byte 4 is zero"},
        Case{"nan.csv", "nan.csv:3:1: x is not a finite number: 'nan'"},
        Case{"one.csv", "one.csv: holds one point only; a contour needs two"},
        Case{"none.csv", "none.csv: holds a header but no points"},
        Case{"wide.csv",
             "wide.csv:1:7: 1000000 columns without a header; expected x,y or x,y,w, or --columns "
             "with the numbers of those to take"}}) {
    ExpectRefusal("info " + broken.file, 3, broken.message);
    ExpectRefusal("check " + broken.file + " contour.csv -t 1", 3, broken.message);
    ExpectRefusal("simplify " + broken.file + " --drop-close -t 1", 3, broken.message);
    ExpectRefusal("fit " + broken.file + " -t 1", 3, broken.message);
  }
}

TEST_F(Program, ClosePointsAreSeenDroppedFittedAndChecked) {
  std::string text = Corner();
  text.insert(text.find("5,0\n"), "4.99,0\n");
  Write("p.csv", text);
  EXPECT_EQ(Run("fit p.csv -t 0.01 -o p.dxf").code, 4);
  Ended const info = Run("info p.csv -t 0.01");
  EXPECT_EQ(info.code, 0);
  EXPECT_NE(info.out.find("1 of 21 pairs is too close"), std::string::npos) << info.out;
  Ended const simple = Run("simplify p.csv --drop-close -t 0.01 -o q.csv --dropped d.csv");
  EXPECT_EQ(simple.code, 0);
  EXPECT_EQ(simple.out, "");
  EXPECT_EQ(simple.err, "contour: p.csv: dropped 1 of 22 points: point 6 (line 8)\n");
  EXPECT_EQ(Contents(folder_ / "d.csv"), "point,line,x,y\n6,8,5,0\n");
  ASSERT_EQ(Run("fit q.csv -t 0.01 -o p.dxf -o p.nc -o p.wkt -o p.csv.json").code, 0);
  for (char const* contour : {"p.dxf", "p.nc", "p.wkt", "p.csv.json"}) {
    Ended const checked = Run(std::string("check p.csv ") + contour + " -t 0.01");
    EXPECT_EQ(checked.code, 0) << contour << ": " << checked.out << checked.err;
    EXPECT_NE(checked.out.find("outside     none of 22 points\n"), std::string::npos) << contour;
  }
  Write("far.csv", "0,1\n5,1\n");
  EXPECT_EQ(Run("check far.csv p.dxf -t 0.01").code, 1);
  EXPECT_EQ(Run("check far.csv p.dxf").code, 0) << "without a tolerance nothing is judged";
}

TEST_F(Program, CommandsOfPointsSayTheirUsage) {
  for (char const* command : {"info", "check", "simplify"}) {
    Ended const help = Run(std::string(command) + " --help");
    EXPECT_EQ(help.code, 0) << command;
    EXPECT_NE(help.out.find("Examples:\n  contour " + std::string(command)), std::string::npos);
    EXPECT_EQ(Run(command).code, 2) << command;
  }
}

}  // namespace
}  // namespace Vorn::Cli::Testing
