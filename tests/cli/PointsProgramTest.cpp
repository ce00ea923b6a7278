#include <gtest/gtest.h>

#include <string>

#include "cli/ProgramFixture.h"

namespace Vorn::Cli::Testing {
namespace {

TEST_F(Program, MessagesNameFileLineAndColumn) {
  std::string columns = "1";
  for (int i = 1; i < 1'000'000; ++i) columns += ";1";
  Write("truncated.csv", "x,y\n1,2\n3,");
  Write("binary.csv", std::string("\x7F\0", 2));
  Write("wide.csv", columns);
  ExpectRefusal("info truncated.csv", 3, "truncated.csv:3:3: y is missing");
  ExpectRefusal("info binary.csv", 3, "binary.csv: is not text: byte 1 is zero");
  ExpectRefusal("info wide.csv", 3,
                "wide.csv:1:7: 1000000 columns without a header; expected x,y or x,y,w; say it "
                "with --columns X,Y");
}

TEST_F(Program, ClosePointsAreSeenDroppedFittedAndChecked) {
  std::string text = Corner();
  text.insert(text.find("5,0\n"), "4.99,0\n");
  Write("p.csv", text);
  EXPECT_EQ(Run("fit p.csv -t 0.01 --strategy mixed -o p.dxf").code, 4);
  Ended const info = Run("info p.csv -t 0.01");
  EXPECT_EQ(info.code, 0);
  EXPECT_NE(info.out.find("1 of 21 pairs is too close"), std::string::npos) << info.out;
  Ended const simple = Run("simplify p.csv --drop-close -t 0.01 -o q.csv --dropped d.csv");
  EXPECT_EQ(simple.code, 0);
  EXPECT_EQ(simple.out, "");
  EXPECT_EQ(simple.err, "contour: p.csv: dropped 1 of 22 points: point 6 (line 8)\n");
  EXPECT_EQ(Contents(folder_ / "d.csv"), "point,line,x,y\n6,8,5,0\n");
  ASSERT_EQ(Run("fit q.csv -t 0.01 --strategy mixed -o p.dxf -o p.nc -o p.wkt -o p.csv.json").code,
            0);
  for (char const* contour : {"p.dxf", "p.nc", "p.wkt", "p.csv.json"}) {
    Ended const checked = Run(std::string("check p.csv ") + contour + " -t 0.01");
    EXPECT_EQ(checked.code, 0) << contour << ": " << checked.out << checked.err;
    EXPECT_NE(checked.out.find("outside     none of 22 points\n"), std::string::npos) << contour;
  }
  Write("far.csv", "0,1\n5,1\n");
  EXPECT_EQ(Run("check far.csv p.dxf -t 0.01").code, 1);
  EXPECT_EQ(Run("check far.csv p.dxf").code, 0) << "without a tolerance nothing is judged";
}

TEST_F(Program, EveryCommandOfPointsTellsTheFooterThatItSkipped) {
  Write("p.csv", Corner() + "\nEnd of report\nMean: 0.02\n");
  std::string const lines = "skipped     lines 24 to 25 behind the table\n";
  Ended const fit = Run("fit p.csv -t 0.01 -o p.json");
  EXPECT_NE(fit.out.find(lines), std::string::npos) << fit.out;
  EXPECT_NE(Contents(folder_ / "p.json").find("\"skipped\": \"lines 24 to 25 behind the table\""),
            std::string::npos);
  for (char const* command : {"info p.csv", "check p.csv p.json"}) {
    Ended const ended = Run(command);
    EXPECT_NE(ended.out.find(lines), std::string::npos) << command << ": " << ended.out;
  }
  for (char const* command :
       {"plot p.csv -o p.svg", "area --points p.csv --close", "fit p.csv p.csv -t 0.01 --jobs 1"}) {
    Ended const ended = Run(command);
    EXPECT_NE(ended.err.find("contour: p.csv: skipped lines 24 to 25 behind the table\n"),
              std::string::npos)
        << command << ": " << ended.err;
  }
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
