// Every command with files that are broken, cannot be read or cannot be written: the exit code is
// 3, the message names the file, nothing goes to the standard output and no file changes.

#include <gtest/gtest.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "cli/ProgramFixture.h"

namespace Vorn::Cli::Testing {
namespace {

std::string Replaced(std::string text, std::string const& from, std::string const& to) {
  for (std::size_t at = 0; (at = text.find(from, at)) != std::string::npos; at += to.size()) {
    text.replace(at, from.size(), to);
  }
  return text;
}

std::string Repeated(std::string const& part, int times) {
  std::string text;
  for (int i = 0; i < times; ++i) text += part;
  return text;
}

/// Every command that reads points, for a file POINTS.
std::vector<std::string> const kPointsCommands = {
    "fit POINTS -t 0.1 -o out.json -o out.svg",
    "info POINTS",
    "info POINTS -t 1 --json",
    "check POINTS good.wkt -t 1 --table out.csv --json out.json",
    "plot POINTS -o out.svg",
    "plot POINTS good.wkt -o out.html",
    "simplify POINTS --drop-close -t 1 -o out.csv",
    "area POINTS --points",
};

/// Every command that reads a contour, for a file CONTOUR.
std::vector<std::string> const kContourCommands = {
    "check good.csv CONTOUR -t 1 --json out.json",
    "plot good.csv CONTOUR -o out.svg",
    "convert CONTOUR -o out.dxf -o out.html",
    "area CONTOUR --close",
    "intersect CONTOUR -o out.csv",
    "intersect good.wkt CONTOUR",
};

/// A name and what stands in the file.
struct BrokenFile {
  std::string name;
  std::string text;
};

std::vector<BrokenFile> BrokenPoints() {
  return {
      {"truncated.csv", "x,y\n1,2\n3,"},
      {"binary.csv", std::string("\x7F"
                                 "ELF\0\1\2\3",
                                 8)},
      {"columns.csv", "1" + Repeated(";1", 999'999)},
      {"nan.csv", "x,y\n1,2\nnan,4\n"},
      {"infinite.csv", "x,y\n1,2\n3,inf\n"},
      {"huge.csv", "x,y\n1,2\n3,1e999\n"},
      {"one.csv", "x,y\n1,2\n"},
      {"none.csv", "x,y\n"},
      {"comment.csv", "# tolerance 0.1\n"},
      {"empty.csv", ""},
      {"words.csv", "x,y\n1,2\nthree,four\n"},
  };
}

constexpr char const* kPieces = "type,start_x,start_y,end_x,end_y\n";

std::vector<BrokenFile> BrokenContours() {
  std::string const pieces = kPieces;
  std::string const json = R"({"schemaVersion": 1, "elements": [)";
  return {
      {"truncated.json", json + R"({"kind": "line", "start": {"x": 0,)"},
      {"nan.json", json + R"({"kind": "line", "start": {"x": NaN, "y": 0}}]})"},
      {"none.json", json + "]}"},
      {"deep.json", Repeated("[", 1'000'000)},
      {"truncated.csv", pieces + "line,0,0,4\n"},
      {"columns.csv", "type" + Repeated(",a", 999'999)},
      {"nan.csv", pieces + "line,0,0,nan,0\n"},
      {"none.csv", pieces},
      {"truncated.dxf", "0\nSECTION\n2\nENTITIES\n0\nLINE\n10\n"},
      {"nan.dxf",
       "0\nSECTION\n2\nENTITIES\n0\nLINE\n10\nnan\n20\n0\n11\n1\n21\n0\n0\nENDSEC\n0\n"
       "EOF\n"},
      {"none.dxf", "0\nSECTION\n2\nENTITIES\n0\nENDSEC\n0\nEOF\n"},
      {"truncated.nc", "G21\nG0 X0 Y0\nG1 X\n"},
      {"nan.nc", "G21\nG0 X0 Y0\nG1 Xnan\n"},
      {"none.nc", "G21\n"},
      {"truncated.wkt", "LINESTRING (0 0, 1"},
      {"nan.wkt", "LINESTRING (0 0, nan 1)"},
      {"one.wkt", "LINESTRING (0 0)"},
      {"none.wkt", "LINESTRING EMPTY"},
      {"binary", std::string("\x7F"
                             "ELF\0\1\2\3",
                             8)},
      {"empty.json", ""},
      {"empty.csv", ""},
      {"empty.dxf", ""},
      {"empty.nc", ""},
      {"empty.wkt", ""},
      {"empty", ""},
  };
}

class BrokenFiles : public Program {
 protected:
  BrokenFiles() {
    Write("good.csv", Corner());
    Write("good.wkt", "LINESTRING (0 0, 10 0, 10 10)");
    // What is there already must still be there afterwards.
    for (std::string const& name : OldFiles()) Write(name, "old");
  }

  static std::vector<std::string> OldFiles() {
    return {"out.csv", "out.dxf", "out.html", "out.json", "out.svg"};
  }

  /// @param name must stand in the message
  void ExpectRefused(std::string const& arguments, std::string const& name) const {
    std::vector<std::string> const before = Files();
    Ended const ended = Run(arguments);
    EXPECT_EQ(ended.code, 3) << arguments << ": " << ended.err;
    EXPECT_EQ(ended.out, "") << arguments;
    EXPECT_EQ(ended.err.rfind("contour: " + name + ":", 0), 0u) << arguments << ": " << ended.err;
    EXPECT_LT(ended.err.size(), 600u) << arguments << ": the message is of a bearable length";
    EXPECT_EQ(Files(), before) << arguments;
    for (std::string const& old : OldFiles()) {
      EXPECT_EQ(Contents(folder_ / old), "old") << arguments;
    }
  }

  void ExpectAllRefuse(std::string const& points, std::string const& contour) const {
    for (std::string const& command : kPointsCommands) {
      ExpectRefused(Replaced(command, "POINTS", points), points);
    }
    for (std::string const& command : kContourCommands) {
      ExpectRefused(Replaced(command, "CONTOUR", contour), contour);
    }
  }
};

TEST_F(BrokenFiles, WithPointsAreRefused) {
  for (BrokenFile const& file : BrokenPoints()) {
    Write(file.name, file.text);
    for (std::string const& command : kPointsCommands) {
      ExpectRefused(Replaced(command, "POINTS", file.name), file.name);
    }
    fs::remove(folder_ / file.name);
  }
}

TEST_F(BrokenFiles, WithContoursAreRefused) {
  for (BrokenFile const& file : BrokenContours()) {
    Write(file.name, file.text);
    for (std::string const& command : kContourCommands) {
      ExpectRefused(Replaced(command, "CONTOUR", file.name), file.name);
    }
    fs::remove(folder_ / file.name);
  }
}

TEST_F(BrokenFiles, ThatAreNotThereAreRefused) { ExpectAllRefuse("none.csv", "none.json"); }

TEST_F(BrokenFiles, ThatAreFoldersAreRefused) {
  fs::create_directory(folder_ / "folder.csv");
  ExpectAllRefuse("folder.csv", "folder.csv");
}

TEST_F(BrokenFiles, ThatCannotBeOpenedAreRefused) {
  // A link to itself cannot be opened even by the superuser.
  fs::create_symlink("loop.csv", folder_ / "loop.csv");
  ExpectAllRefuse("loop.csv", "loop.csv");
}

TEST_F(BrokenFiles, ThatMayNotBeReadAreRefused) {
  if (geteuid() == 0) GTEST_SKIP() << "the superuser may read every file";
  Write("secret.csv", Corner());
  fs::permissions(folder_ / "secret.csv", fs::perms::none);
  ExpectAllRefuse("secret.csv", "secret.csv");
}

/// Every option that names a file to write, for a file OUT. What else the command writes comes
/// before it, and must not be left behind.
std::vector<std::string> const kWritingCommands = {
    "fit good.csv -t 0.1 -o out.json -o OUT",
    "fit good.csv -t 0.1 -o out.json --json OUT",
    "fit good.csv -t 0.1 -o out.json --svg OUT",
    "check good.csv good.wkt -t 1 --json out.json --table OUT",
    "check good.csv good.wkt -t 1 --table out.csv --json OUT",
    "plot good.csv good.wkt -o out.svg -o OUT",
    "convert good.wkt -o out.dxf -o OUT",
    "simplify good.csv --drop-close -t 0.1 -o out.csv --dropped OUT",
    "simplify good.csv --drop-close -t 0.1 --dropped out.csv -o OUT",
    "intersect good.wkt -o OUT",
};

TEST_F(BrokenFiles, ThatCannotBeWrittenLeaveTheOthersAsTheyWere) {
  fs::create_directory(folder_ / "folder.svg");
  fs::create_directory(folder_ / "locked");
  for (std::string const& command : kWritingCommands) {
    for (char const* out : {"none/p.svg", "folder.svg", "good.csv/p.svg"}) {
      ExpectRefused(Replaced(command, "OUT", out), out);
    }
  }
  if (geteuid() == 0) return;
  fs::permissions(folder_ / "locked", fs::perms::owner_read | fs::perms::owner_exec);
  for (std::string const& command : kWritingCommands) {
    ExpectRefused(Replaced(command, "OUT", "locked/p.svg"), "locked/p.svg");
  }
}

TEST_F(BrokenFiles, ThatAreGoodAfterAllAreTaken) {
  // The tables above would prove nothing if the commands were wrong themselves.
  for (std::vector<std::string> const& commands :
       {kPointsCommands, kContourCommands, kWritingCommands}) {
    for (std::string const& command : commands) {
      std::string const arguments =
          Replaced(Replaced(Replaced(command, "POINTS", "good.csv"), "CONTOUR", "good.wkt"), "OUT",
                   "new.svg");
      Ended const ended = Run(arguments);
      EXPECT_EQ(ended.code, 0) << arguments << ": " << ended.err;
    }
  }
}

}  // namespace
}  // namespace Vorn::Cli::Testing
