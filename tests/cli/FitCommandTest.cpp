#include <gtest/gtest.h>

#include "cli/RunInProcess.h"

namespace Vorn::Cli {
namespace {

constexpr char const* kPoints = "x,y,tol\n0,0,0.25\n3,4,0.25\n6,0,0.25\n";

/// The line of the summary that begins with the word, without it; empty when there is none.
std::string SummaryLine(std::string const& out, std::string const& word) {
  std::size_t const begin = out.find("\n" + word + " ");
  if (begin == std::string::npos) return "";
  std::size_t const end = out.find('\n', begin + 1);
  std::string const line = out.substr(begin + 1, end - begin - 1);
  return line.substr(line.find_first_not_of(' ', word.size()));
}

/// The message of the usage error; empty when there is none.
std::string UsageError(std::vector<std::string> const& words) {
  RunResult const result = RunInProcess(words);
  if (result.code != ExitCode::Usage) return "";
  EXPECT_EQ(result.out, "");
  return result.err;
}

TEST(FitCommand, StrategyIsFewestUnlessSaid) {
  auto const strategy = [](std::vector<std::string> words) {
    words.insert(words.begin(), {"fit", "-", "-t", "0.1"});
    return SummaryLine(RunInProcess(words, kPoints).out, "strategy");
  };
  EXPECT_EQ(strategy({}), "fewest");
  EXPECT_EQ(strategy({"--strategy", "mixed"}), "mixed");
  EXPECT_EQ(strategy({"--strategy=cells"}), "cells");
  EXPECT_EQ(strategy({"--strategy", "arc"}), "arc");
  EXPECT_EQ(strategy({"--strategy", "fewest"}), "fewest");
}

TEST(FitCommand, ToleranceIsReadInEveryForm) {
  auto const tolerance = [](std::vector<std::string> words) {
    words.insert(words.begin(), {"fit", "-"});
    return SummaryLine(RunInProcess(words, kPoints).out, "tolerance");
  };
  EXPECT_EQ(tolerance({"--tolerance", "+2e-2"}), "0.02 (given for all points)");
  EXPECT_EQ(tolerance({"-t", ".5"}), "0.5 (given for all points)");
  EXPECT_EQ(tolerance({"-t.5", "--units", "mm"}), "0.5 mm (given for all points)");
  EXPECT_EQ(tolerance({"--tolerance-per-point", ".5"}), "0.5 (0.3 of the spacing, at most 0.5)");
  EXPECT_EQ(tolerance({"--tolerance-column", "tol"}), "0.25 (column 'tol' of the file)");
}

TEST(FitCommand, PointsMayComeFromTheStandardInput) {
  RunResult const result = RunInProcess({"fit", "-", "-t", "0.1"}, "0,0\n1,oops\n");
  EXPECT_EQ(result.code, ExitCode::File);
  EXPECT_EQ(result.err, "contour: standard input:2:3: y is not a number: 'oops'\n");
}

TEST(FitCommand, ToleranceMustBeAFiniteNumberAboveZero) {
  for (char const* value : {"0", "-1", "nan", "inf", "1e999", "abc", "1,5", ""}) {
    for (char const* name : {"--tolerance=", "--tolerance-per-point="}) {
      std::string const argument = std::string(name) + value;
      EXPECT_NE(UsageError({"fit", "p.csv", argument}), "") << argument;
    }
  }
  EXPECT_NE(
      UsageError({"fit", "p.csv", "--tolerance=-1"}).find("'-1' is not a finite number above 0"),
      std::string::npos);
}

TEST(FitCommand, ContradictionsAndUnknownsAreUsageErrors) {
  EXPECT_NE(UsageError({}), "");
  EXPECT_NE(UsageError({"fit"}), "");
  EXPECT_NE(UsageError({"bend", "p.csv"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "q.csv", "-o", "r.json"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--colour", "red"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--tolerance"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--strategy", "spline"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--strategy", "0"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--tolerance", "1", "--tolerance-per-point", "1"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--tolerance", "1", "--tolerance-column", "w"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--tolerance-per-point", "1", "--tolerance-column", "w"}),
            "");
}

TEST(FitCommand, UsageErrorsPointToTheHelpOfTheCommand) {
  EXPECT_NE(UsageError({"fit", "p.csv", "--strategy", "spline"})
                .find("'spline' is none of fewest, mixed, cells, arc\nRun 'contour fit --help'"),
            std::string::npos);
  EXPECT_NE(UsageError({"bend"}).find("\nRun 'contour --help'"), std::string::npos);
}

TEST(FitCommand, OneFileIsNotTwoThings) {
  EXPECT_EQ(UsageError({"fit", "p.csv", "--json", "out", "--svg", "./out"}),
            "contour: --json and --svg name the same file: ./out\n");
  EXPECT_EQ(UsageError({"fit", "p.csv", "--svg", "p.csv"}),
            "contour: POINTS and --svg name the same file: p.csv\n");
  EXPECT_EQ(UsageError({"fit", "p.csv", "--json", "p.csv"}),
            "contour: POINTS and --json name the same file: p.csv\n");
}

TEST(FitCommand, HelpNamesEveryOptionAndExitCode) {
  std::string const help = RunInProcess({"fit", "--help"}).out;
  for (char const* part : {"POINTS",
                           "-t,--tolerance",
                           "--tolerance-column",
                           "--tolerance-per-point",
                           "--units",
                           "--strategy",
                           "fewest",
                           "mixed",
                           "cells",
                           "arc",
                           "--json",
                           "--svg",
                           "Exit codes",
                           "\n  0 ",
                           "\n  1 ",
                           "\n  2 ",
                           "\n  3 ",
                           "\n  4 ",
                           "\n  5 ",
                           "\n  130 "}) {
    EXPECT_NE(help.find(part), std::string::npos) << part;
  }
  EXPECT_NE(RunInProcess({"--help"}).out.find("fit"), std::string::npos);
}

TEST(Program, VersionIsOneLine) {
  std::string const version = RunInProcess({"--version"}).out;
  EXPECT_EQ(version.rfind("contour ", 0), 0u);
  EXPECT_EQ(version.find('\n'), version.size() - 1);
}

}  // namespace
}  // namespace Vorn::Cli
