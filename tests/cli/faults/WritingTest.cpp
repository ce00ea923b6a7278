// Calls that fail while the results are written: the message names the file and the reason, and
// all files are as they were.

#include <gtest/gtest.h>

#include "cli/faults/FaultFixture.h"

namespace Vorn::Cli::Testing {
namespace {

struct Fault {
  char const* name;
  char const* reason;
};

/// Every call between the first byte and the last name, with the reasons that it may have.
constexpr Fault kFaults[] = {
    {"mkstemp:full", "No space left on device"},  {"mkstemp:readonly", "Read-only file system"},
    {"write:full", "No space left on device"},    {"write:io", "Input/output error"},
    {"fchmod:readonly", "Read-only file system"}, {"fsync:io", "Input/output error"},
    {"fsync:full", "No space left on device"},    {"close:io", "Input/output error"},
};

TEST_F(FaultyProgram, ThatCannotWriteOneFileLeavesAllAsTheyWere) {
  for (Fault const& fault : kFaults) {
    for (std::string const& file : Outputs()) {
      Ended const ended = RunWithFault(fault.name, file);
      EXPECT_EQ(ended.code, 3) << fault.name << " " << file;
      EXPECT_EQ(ended.out, "") << fault.name << " " << file;
      EXPECT_EQ(ended.err, "contour: " + file + ": cannot be written: " + fault.reason + "\n");
      ExpectAllOld(std::string(fault.name) + " " + file);
    }
  }
}

TEST_F(FaultyProgram, ThatCannotRenameOneFilePutsTheOthersBack) {
  // The names of files that are there are exchanged; one that is not there is a plain rename.
  for (std::string const& file : Outputs()) {
    fs::remove(folder_ / file);
    Ended const ended = RunWithFault("rename:io", file);
    EXPECT_EQ(ended.code, 3) << file;
    EXPECT_EQ(ended.err, "contour: " + file + ": cannot be written: Input/output error\n");
    EXPECT_FALSE(fs::exists(folder_ / file));
    Write(file, "old " + file);
    ExpectAllOld(file);
  }
}

TEST_F(FaultyProgram, ThatCannotRenameTheLastFileTakesNewOnesAway) {
  for (std::string const& file : Outputs()) fs::remove(folder_ / file);
  Ended const ended = RunWithFault("rename:io", "c.svg");
  EXPECT_EQ(ended.code, 3);
  EXPECT_EQ(Files(), std::vector<std::string>{"p.csv"});
}

TEST_F(FaultyProgram, OnADiskThatCannotExchangeFilesReplacesThemAllTheSame) {
  Ended const ended = RunWithFault("exchange:unknown", "");
  EXPECT_EQ(ended.code, 0) << ended.err;
  ExpectAllNew("by plain renames");
}

TEST_F(FaultyProgram, OnAReadOnlyDiskSaysSoBeforeItReads) {
  // The points are not even there: the folder is looked at first.
  Ended const ended = RunWithFault("access:readonly", "", "fit none.csv -t 0.01 -o a.json");
  EXPECT_EQ(ended.code, 3);
  EXPECT_EQ(ended.err, "contour: a.json: cannot be written: Read-only file system\n");
  ExpectAllOld("read-only");
}

TEST_F(FaultyProgram, GoesOnWhereAWriteIsCutShortOrInterrupted) {
  for (char const* fault : {"write:half", "write:again"}) {
    // Byte for byte takes long, so the short text alone gets it.
    std::string const file = fault == std::string("write:half") ? "b.dxf" : "";
    Ended const ended = RunWithFault(fault, file);
    EXPECT_EQ(ended.code, 0) << fault << ended.err;
    ExpectAllNew(fault);
    Restore();
  }
}

TEST_F(FaultyProgram, WhoseFolderVanishesSaysSoAndKeepsTheOtherFiles) {
  for (char const* fault : {"mkstemp:vanish", "fsync:vanish", "rename:vanish", "exchange:vanish"}) {
    fs::create_directory(folder_ / "out");
    if (fault == std::string("exchange:vanish")) Write("out/b.dxf", "old");
    Ended const ended =
        RunWithFault(fault, "b.dxf", "fit p.csv -t 0.01 -o a.json -o out/b.dxf -o c.svg");
    EXPECT_EQ(ended.code, 3) << fault;
    EXPECT_EQ(ended.err, "contour: out/b.dxf: cannot be written: No such file or directory\n");
    EXPECT_FALSE(fs::exists(folder_ / "out"));
    ExpectAllOld(fault);
  }
}

TEST_F(FaultyProgram, WithManyFilesFailsForTheOneThatCannotBeWritten) {
  Write("q.csv", Corner());
  Ended const ended =
      RunWithFault("write:full", "q.dxf", "fit p.csv q.csv -t 0.01 --to json,dxf --out-dir out");
  EXPECT_EQ(ended.code, 3);
  EXPECT_EQ(ended.err, "contour: out/q.dxf: cannot be written: No space left on device\n");
  EXPECT_TRUE(fs::exists(folder_ / "out" / "p.json"));
  EXPECT_TRUE(fs::exists(folder_ / "out" / "p.dxf"));
  EXPECT_FALSE(fs::exists(folder_ / "out" / "q.json")) << "all files of an input, or none";
  EXPECT_EQ(std::distance(fs::directory_iterator(folder_ / "out"), fs::directory_iterator()), 2);
}

/// A command that replaces a.json, b.dxf or c.svg, and the file that it cannot write.
struct Writer {
  char const* arguments;
  char const* file;
};

TEST_F(FaultyProgram, IsAnyCommandThatWrites) {
  Write("line.wkt", "LINESTRING (0 0, 10 0, 10 10)");
  constexpr Writer kWriters[] = {
      {"convert line.wkt -o a.json -o b.dxf", "b.dxf"},
      {"plot p.csv line.wkt -o a.json.html -o c.svg", "c.svg"},
      {"check p.csv line.wkt -t 1 --json a.json --table t.csv", "t.csv"},
      {"simplify p.csv -t 1 --drop-close -o s.csv --dropped d.csv", "d.csv"},
      {"intersect line.wkt -o i.csv", "i.csv"},
  };
  std::vector<std::string> const before = Files();
  for (Writer const& writer : kWriters) {
    Ended const ended = RunWithFault("fsync:full", writer.file, writer.arguments);
    EXPECT_EQ(ended.code, 3) << writer.arguments;
    EXPECT_EQ(ended.err, std::string("contour: ") + writer.file +
                             ": cannot be written: No space left on device\n");
    EXPECT_EQ(Files(), before) << writer.arguments;
    for (std::string const& name : Outputs()) EXPECT_TRUE(IsOld(name)) << writer.arguments;
  }
}

}  // namespace
}  // namespace Vorn::Cli::Testing
