#include <gtest/gtest.h>

#include <cmath>
#include <map>
#include <nlohmann/json.hpp>
#include <sstream>
#include <string>

#include "cli/ProgramFixture.h"

/// `contour fit` with many files.
namespace Vorn::Cli::Testing {
namespace {

/// A wave of lines and arcs; the more points, the longer its fit takes.
std::string Wave(int points, double height) {
  std::string text = "x,y\n";
  for (int i = 0; i < points; ++i) {
    text += std::to_string(0.1 * i) + "," + std::to_string(height * std::sin(0.01 * i)) + "\n";
  }
  return text;
}

class ManyFiles : public Program {
 protected:
  /// Long ones first, so that later ones are ready earlier when several run at once.
  void WriteInputs() const {
    fs::create_directory(folder_ / "in");
    for (int i = 0; i < 12; ++i) Write(NameOf(i), Wave(4000 - 300 * i, 1.0 + i));
    Write("in/x_bad.csv", "x,y\n1,2\n3,four\n");
    Write("in/y_close.csv", "0,0\n1,0\n1.001,0\n");
  }

  static std::string NameOf(int i) {
    return "in/w" + std::string(i < 10 ? "0" : "") + std::to_string(i) + ".csv";
  }

  std::map<std::string, std::string> ContentsOf(std::string const& folder) const {
    std::map<std::string, std::string> contents;
    for (auto const& entry : fs::directory_iterator(folder_ / folder)) {
      contents[entry.path().filename().string()] = Contents(entry.path());
    }
    return contents;
  }
};

/// A good file, one that cannot be read, with signs of CSV in its name, and a long one.
class Summaries : public Program {
 protected:
  void WriteInputs() const {
    Write("good.csv", Corner());
    Write("bad, \"one\".csv", "x,y\n1,2\n3,four\n");
    Write("wave.csv", Wave(400, 3.0));
  }
};

TEST_F(Summaries, AsCsvHaveARowForEachFileWorstFirstAndTotals) {
  WriteInputs();
  Ended const ended = Run("fit good.csv bad*.csv wave.csv -t 0.02 --summary all.csv");
  EXPECT_EQ(ended.code, 3) << ended.err;
  std::istringstream lines(Contents(folder_ / "all.csv"));
  std::vector<std::string> rows;
  for (std::string line; std::getline(lines, line);) rows.push_back(line);
  ASSERT_EQ(rows.size(), 5u);
  EXPECT_EQ(rows[0], "file,result,points,lines,arcs,largest_deviation,outside,root_mean_square");
  EXPECT_EQ(rows[1].rfind("\"bad, \"\"one\"\".csv\",failed: ", 0), 0u) << rows[1];
  EXPECT_EQ(rows[2].rfind("wave.csv,within tolerance,400,", 0), 0u) << rows[2];
  EXPECT_EQ(rows[3].rfind("good.csv,within tolerance,21,2,0,", 0), 0u) << rows[3];
  EXPECT_EQ(rows[4].rfind("total,2 of 3 files within tolerance,421,", 0), 0u) << rows[4];
}

TEST_F(Summaries, AsPagesHaveAPictureOfEachContourAndTheFields) {
  WriteInputs();
  Ended const ended =
      Run("fit good.csv bad*.csv wave.csv -t 0.02 --summary all.html --field 'part=<Cam>'");
  EXPECT_EQ(ended.code, 3) << ended.err;
  std::string const page = Contents(folder_ / "all.html");
  std::size_t pictures = 0;
  for (std::size_t at = 0; (at = page.find("<svg ", at)) != std::string::npos; ++at) ++pictures;
  EXPECT_EQ(pictures, 2u);
  EXPECT_NE(page.find("part <b>&lt;Cam&gt;</b>"), std::string::npos);
  EXPECT_LT(page.find("failed: "), page.find("wave.csv"));
  EXPECT_LT(page.find("wave.csv"), page.find("good.csv"));
  EXPECT_NE(page.find("2 of 3 files within tolerance"), std::string::npos);
  EXPECT_EQ(page.find("{{"), std::string::npos);
  EXPECT_EQ(page.find("://"), std::string::npos) << "no network";
}

TEST_F(Summaries, AreTheSameForAnyNumberOfJobs) {
  WriteInputs();
  Run("fit good.csv wave.csv -t 0.02 -j 1 --summary one.html");
  Run("fit good.csv wave.csv -t 0.02 -j 4 --summary four.html");
  EXPECT_EQ(Contents(folder_ / "one.html"), Contents(folder_ / "four.html"));
}

TEST_F(Summaries, HaveOneOfTwoEndingsAndOverwriteNoInput) {
  WriteInputs();
  ExpectRefusal("fit good.csv wave.csv -t 0.02 --summary all.txt", 2,
                "--summary all.txt: the name must end in .csv or .html");
  ExpectRefusal("fit good.csv wave.csv -t 0.02 --summary wave.csv", 2,
                "the summary would be written over the input wave.csv");
  ExpectRefusal("fit good.csv wave.csv -t 0.02 --summary none/all.csv", 3,
                "none/all.csv: cannot be written: No such file or directory");
}

TEST_F(ManyFiles, GiveTheSameBytesForAnyNumberOfJobs) {
  WriteInputs();
  std::map<std::string, std::string> expected;
  Ended first;
  for (char const* jobs : {"1", "2", "8"}) {
    std::string const folder = std::string("out") + jobs;
    Ended const ended =
        Run("fit in/*.csv -t 0.01 --strategy mixed --to json,dxf,svg --no-time -j " +
            std::string(jobs) + " --out-dir " + folder);
    EXPECT_EQ(ended.code, 3) << ended.err;
    auto const contents = ContentsOf(folder);
    EXPECT_EQ(contents.size(), 36u) << "twelve of fourteen, in three formats";
    if (std::string(jobs) == "1") {
      expected = contents;
      first = ended;
      continue;
    }
    EXPECT_EQ(ended.out, first.out) << jobs << " jobs";
    EXPECT_EQ(ended.err, first.err) << jobs << " jobs";
    EXPECT_EQ(contents, expected) << jobs << " jobs";
  }
}

TEST_F(ManyFiles, HaveALineEachInTheOrderOfTheInputs) {
  WriteInputs();
  Ended const ended = Run("fit in/*.csv -t 0.01 --strategy mixed --no-time -j 4");
  std::size_t at = ended.out.find("file        ");
  ASSERT_EQ(at, 0u) << ended.out;
  for (int i = 0; i < 12; ++i) {
    std::size_t const next = ended.out.find("\n" + NameOf(i) + " ");
    ASSERT_NE(next, std::string::npos) << ended.out;
    EXPECT_GE(next, at) << "line " << i;
    at = next;
  }
  EXPECT_NE(ended.out.find("failed: 3:3: y is not a number: 'four'\n"), std::string::npos)
      << ended.out;
  EXPECT_NE(ended.out.find("\n14 files: 2 failed, 12 within tolerance; "), std::string::npos)
      << ended.out;
  EXPECT_NE(ended.err.find("contour: in/x_bad.csv:3:3: y is not a number: 'four'\n"),
            std::string::npos)
      << ended.err;
  EXPECT_NE(ended.err.find("ways out: "), std::string::npos) << "the whole message: " << ended.err;
  EXPECT_EQ(ended.out.find("seconds"), std::string::npos);
  EXPECT_EQ(Files(), std::vector<std::string>{"in"}) << "without --out-dir nothing is written";
}

TEST_F(ManyFiles, AreWrittenAsTheyWouldBeAlone) {
  Write("a.csv", Corner());
  ASSERT_EQ(Run("fit a.csv -t 0.01 --out-dir deep/out --to dxf,json").code, 0);
  ASSERT_EQ(Run("fit a.csv -t 0.01 -o a.dxf -o a.json").code, 0);
  EXPECT_EQ(Contents(folder_ / "deep/out/a.dxf"), Contents(folder_ / "a.dxf"));
  EXPECT_EQ(Contents(folder_ / "deep/out/a.json"), Contents(folder_ / "a.json"));
  EXPECT_NE(Contents(folder_ / "a.dxf"), "");
  ASSERT_EQ(Run("fit a.csv -t 0.01 --out-dir plain").code, 0);
  EXPECT_EQ(ContentsOf("plain").count("a.json"), 1u) << "JSON if nothing is said";
}

TEST_F(ManyFiles, EndWithTheWorstCode) {
  Write("good.csv", Corner());
  Write("close.csv", "0,0\n1,0\n1.001,0\n");
  Write("bad.csv", "x\n");
  Write("bare.csv", "0,0\n3,0\n6,1\n");
  EXPECT_EQ(Run("fit good.csv bare.csv -t 0.01").code, 0);
  EXPECT_EQ(Run("fit good.csv bare.csv -t 0.3 --strategy arc").code, 1);
  EXPECT_EQ(Run("fit good.csv close.csv -t 0.01 --strategy mixed").code, 4);
  EXPECT_EQ(Run("fit close.csv good.csv -t 0.01 --strategy mixed").code, 4);
  EXPECT_EQ(Run("fit close.csv good.csv --tolerance-column w").code, 3);
  EXPECT_EQ(Run("fit close.csv bare.csv").code, 2) << "no tolerance";
  EXPECT_EQ(Run("fit close.csv bad.csv good.csv -t 0.01").code, 3);
  EXPECT_EQ(Run("fit none.csv good.csv -t 0.01").code, 3);
}

TEST_F(ManyFiles, AFileThatCannotBeWrittenFailsAlone) {
  Write("a.csv", Corner());
  Write("b.csv", Corner());
  fs::create_directories(folder_ / "out" / "a.json");
  Ended const ended = Run("fit a.csv b.csv -t 0.01 --out-dir out");
  EXPECT_EQ(ended.code, 3);
  EXPECT_NE(ended.err.find("a.json: cannot be written: "), std::string::npos) << ended.err;
  EXPECT_NE(Contents(folder_ / "out" / "b.json"), "");
}

TEST_F(ManyFiles, InterruptedKeepWhatIsDoneAndNothingElse) {
  Write("a.csv", Corner());
  Write("b.csv", Wave(400000, 1000.0));
  Ended const ended = Run("fit a.csv b.csv -t 0.01 --out-dir out --to json,dxf -j 2",
                          "timeout --preserve-status --signal=INT 1");
  EXPECT_EQ(ended.code, 130) << ended.out << ended.err;
  auto const contents = ContentsOf("out");
  EXPECT_EQ(contents.size(), 2u) << "neither of b.csv nor temporary";
  EXPECT_EQ(nlohmann::json::parse(contents.at("a.json")).at("elements").size(), 2u);
  EXPECT_EQ(contents.count("a.dxf"), 1u);
}

TEST_F(ManyFiles, RefuseWhatWouldCollide) {
  fs::create_directory(folder_ / "more");
  Write("a.csv", Corner());
  Write("more/a.csv", Corner());
  ExpectRefusal("fit a.csv more/a.csv -t 0.01 --out-dir out", 2,
                "the fits of a.csv and more/a.csv would both be written to out/a.json");
  ExpectRefusal("fit a.csv more/a.csv -t 0.01 --out-dir . --to csv", 2,
                "the fit of a.csv would be written over the input a.csv");
  ExpectRefusal("fit a.csv - -t 0.01", 2, "the standard input cannot be one of many files");
  ExpectRefusal("fit a.csv more/a.csv -t 0.01 -o b.json", 2,
                "many files are written with --out-dir and --to, not with -o, --json or --svg");
  ExpectRefusal("fit a.csv -t 0.01 -j 2", 2, "--jobs is for many files");
  ExpectRefusal("fit a.csv -t 0.01 -o b.json --to json,dxf", 2,
                "--to names one format, unless --out-dir is given");
  ExpectRefusal("fit a.csv -t 0.01 --out-dir more/a.csv", 3,
                "more/a.csv: the folder cannot be made: Not a directory");
  EXPECT_EQ(Run("fit a.csv -t 0.01 --out-dir out -j 0").code, 2);
  EXPECT_EQ(Run("fit a.csv -t 0.01 --out-dir out --to json,json").code, 2);
  EXPECT_EQ(Run("fit a.csv -t 0.01 --out-dir out --to json,best").code, 2);
  EXPECT_EQ(Contents(folder_ / "a.csv"), Corner());
  EXPECT_FALSE(fs::exists(folder_ / "out")) << "refused before anything is made";
}

}  // namespace
}  // namespace Vorn::Cli::Testing
