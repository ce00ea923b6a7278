// Options that need each other, exclude each other, or are for another use of a command; and what
// every command says of operands and options that it does not know.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "cli/RunInProcess.h"

namespace Vorn::Cli {
namespace {

using Words = std::vector<std::string>;

/// The first line of what is said, for a line that is refused as wrong usage.
std::string Refusal(Words const& words) {
  RunResult const run = RunInProcess(words);
  EXPECT_EQ(run.code, ExitCode::Usage) << words[0] << ": " << run.err;
  EXPECT_EQ(run.out, "") << words[0];
  std::string const line = run.err.substr(0, run.err.find('\n'));
  return line.starts_with("contour: ") ? line.substr(9) : line;
}

Words Joined(Words words, Words const& more) {
  words.insert(words.end(), more.begin(), more.end());
  return words;
}

Words const kPointsLines[] = {{"fit", "p.csv"},
                              {"check", "p.csv", "c.json"},
                              {"info", "p.csv"},
                              {"plot", "p.csv", "--to", "svg"},
                              {"simplify", "p.csv", "--drop-close"}};

TEST(OptionPairs, AtMostOneOptionGivesTheTolerance) {
  for (Words const& line : kPointsLines) {
    Words const same = {"-t", "1"};
    Words const column = {"--tolerance-column", "w"};
    Words const cap = {"--tolerance-per-point", "1"};
    EXPECT_EQ(Refusal(Joined(Joined(line, same), column)),
              "--tolerance excludes --tolerance-column");
    EXPECT_EQ(Refusal(Joined(Joined(line, cap), same)),
              "--tolerance excludes --tolerance-per-point");
    EXPECT_EQ(Refusal(Joined(Joined(line, cap), column)),
              "--tolerance-column excludes --tolerance-per-point");
  }
}

TEST(OptionPairs, AnOptionIsGivenOnce) {
  for (Words const& line : kPointsLines) {
    EXPECT_EQ(Refusal(Joined(line, {"-t", "1", "--tolerance", "2"})),
              "--tolerance: At Most 1 required but received 2");
    EXPECT_EQ(Refusal(Joined(line, {"--units", "mm", "--units", "mm"})),
              "--units: At Most 1 required but received 2");
  }
}

TEST(OptionPairs, AnOptionHasItsValue) {
  for (Words const& line : kPointsLines) {
    EXPECT_EQ(Refusal(Joined(line, {"--tolerance"})), "--tolerance: 1 required T missing");
    EXPECT_EQ(Refusal(Joined(line, {"--tolerance="})), "--tolerance: 1 required T missing");
    EXPECT_EQ(Refusal(Joined(line, {"--columns"})), "--columns: 1 required X,Y[,W] missing");
  }
}

TEST(OptionPairs, UnknownOptionsAndOperandsTooManyAreNamed) {
  Words const lines[] = {{"check", "p.csv", "c.json"}, {"info", "p.csv"},
                         {"plot", "p.csv", "c.json"},  {"intersect", "a.json", "b.json"},
                         {"convert", "c.json"},        {"simplify", "p.csv"}};
  for (Words const& line : lines) {
    EXPECT_EQ(Refusal(Joined(line, {"--colour"})),
              "The following argument was not expected: --colour");
    EXPECT_EQ(Refusal(Joined(line, {"more"})), "The following argument was not expected: more");
  }
}

TEST(OptionPairs, MissingOperandsAreNamed) {
  EXPECT_EQ(Refusal({"fit"}), "POINTS is required");
  EXPECT_EQ(Refusal({"check"}), "POINTS is required");
  EXPECT_EQ(Refusal({"check", "p.csv"}), "CONTOUR is required");
  EXPECT_EQ(Refusal({"info"}), "POINTS is required");
  EXPECT_EQ(Refusal({"plot"}), "POINTS is required");
  EXPECT_EQ(Refusal({"area"}), "CONTOUR is required");
  EXPECT_EQ(Refusal({"intersect"}), "A is required");
  EXPECT_EQ(Refusal({"convert"}), "CONTOUR is required");
  EXPECT_EQ(Refusal({"simplify"}), "POINTS is required");
}

TEST(OptionPairs, HeightsComeTogetherAndThePlungeWithThem) {
  for (Words const& line : {Words{"fit", "p.csv"}, Words{"convert", "c.json", "--to", "gcode"}}) {
    EXPECT_EQ(Refusal(Joined(line, {"--safe-height", "5"})), "--safe-height requires --cut-height");
    EXPECT_EQ(Refusal(Joined(line, {"--cut-height", "0"})), "--cut-height requires --safe-height");
    EXPECT_EQ(Refusal(Joined(line, {"--plunge-feed", "9"})), "--plunge-feed requires --cut-height");
  }
}

TEST(OptionPairs, TextsOfToolPathsComeFromFiles) {
  for (Words const& line : {Words{"fit", "p.csv"}, Words{"convert", "c.json", "--to", "gcode"}}) {
    for (char const* name : {"--header", "--footer"}) {
      EXPECT_EQ(Refusal(Joined(line, {name, "-"})),
                std::string(name) + ": the standard input is no such file");
      RunResult const none = RunInProcess(Joined(line, {name, "no/such.txt"}));
      EXPECT_EQ(none.code, ExitCode::File);
      EXPECT_EQ(none.err, "contour: no/such.txt: No such file or directory\n");
    }
  }
}

TEST(OptionPairs, MeansNeedWindows) {
  EXPECT_EQ(Refusal({"simplify", "p.csv", "--average"}), "--average requires --spacing");
  EXPECT_EQ(Refusal({"simplify", "p.csv"}),
            "one of --drop-close, --spacing and --outliers is required");
}

TEST(OptionPairs, TheSizeOfAPictureIsSaidOnce) {
  EXPECT_EQ(Refusal({"plot", "p.csv", "-o", "p.png", "--dpi", "90", "--width", "800"}),
            "--dpi excludes --width");
}

TEST(OptionPairs, PointsOfAnAreaHaveNoFormatButColumns) {
  EXPECT_EQ(Refusal({"area", "p.csv", "--points", "--from", "csv"}), "--from excludes --points");
  EXPECT_EQ(Refusal({"area", "c.json", "--columns", "1,2"}), "--columns requires --points");
}

TEST(OptionPairs, OptionsOfTheFewestPiecesAreForThatStrategy) {
  Words const options[] = {{"--effort", "wide"},
                           {"--largest-step", "9"},
                           {"--min-radius", "1"},
                           {"--max-radius", "9"},
                           {"--between", "1"}};
  for (Words const& option : options) {
    for (std::string const strategy : {"mixed", "cells", "arc"}) {
      EXPECT_EQ(Refusal(Joined({"fit", "p.csv", "--strategy", strategy}, option)),
                option[0] + " is for --strategy fewest, not for " + strategy);
    }
  }
  for (Words const& line : {Words{"fit", "p.csv"}, Words{"fit", "p.csv", "--strategy", "fewest"}}) {
    EXPECT_EQ(
        Refusal(Joined(line, {"--start", "3"})),
        "--start is not for fewest, the strategy when none is named, which finds the seam itself; "
        "--strategy mixed takes it");
  }
  EXPECT_EQ(
      Refusal({"fit", "p.csv", "--strategy", "fewest", "--min-radius", "5", "--max-radius", "4"}),
      "--min-radius is larger than --max-radius");
}

TEST(OptionPairs, OfOneFileAndOfMany) {
  Words const one = {"fit", "p.csv"};
  Words const many = {"fit", "p.csv", "q.csv"};
  EXPECT_EQ(Refusal(Joined(one, {"--jobs", "2"})), "--jobs is for many files");
  EXPECT_EQ(Refusal(Joined(one, {"--no-time"})), "--no-time is for many files");
  EXPECT_EQ(Refusal(Joined(one, {"--to", "json,dxf"})),
            "--to names one format, unless --out-dir is given");
  EXPECT_EQ(Refusal(Joined(many, {"--digits", "2"})), "--digits is for the table of a single file");
  for (Words const& output : {Words{"-o", "a.json"}, Words{"--json", "a"}, Words{"--svg", "a"}}) {
    EXPECT_EQ(Refusal(Joined(many, output)),
              "many files are written with --out-dir and --to, not with -o, --json or --svg");
  }
  EXPECT_EQ(Refusal({"fit", "p.csv", "-"}), "the standard input cannot be one of many files");
}

TEST(OptionPairs, AnOutlineIsOneOfAFile) {
  EXPECT_EQ(Refusal({"intersect", "a.json", "--outline-b", "1"}),
            "--outline-b is for the file B, and there is none");
}

TEST(OptionPairs, OnlyOneFileIsTheStandardInput) {
  EXPECT_EQ(Refusal({"check", "-", "-"}), Refusal({"check", "-", "-", "--all"}));
  for (Words const& line : {Words{"check", "-", "-"}, Words{"intersect", "-", "-"},
                            Words{"plot", "-", "-", "--to", "svg"}, Words{"area", "-", "-"}}) {
    EXPECT_NE(Refusal(line).find("standard input"), std::string::npos) << line[0];
  }
}

TEST(OptionPairs, AnOutputIsNoInputAndNoOtherOutput) {
  EXPECT_EQ(Refusal({"fit", "p.csv", "-o", "./p.csv"}),
            "POINTS and --output name the same file: ./p.csv");
  EXPECT_EQ(Refusal({"fit", "p.csv", "-o", "a.dxf", "-o", "x/../a.dxf"}),
            "two --output name the same file: x/../a.dxf");
  EXPECT_EQ(Refusal({"check", "p.csv", "c.json", "--json", "c.json"}),
            "CONTOUR and --json name the same file: c.json");
  EXPECT_EQ(Refusal({"check", "p.csv", "c.json", "--table", "t", "--json", "t"}),
            "--table and --json name the same file: t");
  EXPECT_EQ(Refusal({"plot", "p.csv", "c.json", "-o", "c.json", "--to", "svg"}),
            "CONTOUR and --output name the same file: c.json");
  EXPECT_EQ(Refusal({"intersect", "a.json", "b.json", "-o", "b.json"}),
            "B and --output name the same file: b.json");
  EXPECT_EQ(Refusal({"convert", "c.json", "-o", "c.json"}),
            "CONTOUR and --output name the same file: c.json");
  EXPECT_EQ(Refusal({"simplify", "p.csv", "--drop-close", "--dropped", "p.csv"}),
            "POINTS and --dropped name the same file: p.csv");
  EXPECT_EQ(Refusal({"simplify", "p.csv", "--drop-close", "-o", "q.csv", "--dropped", "q.csv"}),
            "--output and --dropped name the same file: q.csv");
}

TEST(OptionPairs, FieldsHaveANameOfTheirOwn) {
  for (Words const& line : {Words{"fit", "p.csv"}, Words{"plot", "p.csv", "--to", "svg"}}) {
    for (std::string const bad : {"part", "=Cam"}) {
      EXPECT_EQ(Refusal(Joined(line, {"--field=" + bad})),
                "--field '" + bad + "': NAME=VALUE is wanted, such as part=Cam");
    }
    EXPECT_EQ(Refusal(Joined(line, {"--field", "a=1", "--field", "b=1", "--field", "a=2"})),
              "--field 'a' is given twice");
  }
}

}  // namespace
}  // namespace Vorn::Cli
