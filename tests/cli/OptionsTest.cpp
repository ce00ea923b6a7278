#include <gtest/gtest.h>

#include "cli/Failure.h"
#include "cli/Options.h"

namespace Vorn::Cli {
namespace {

std::optional<Options> Parse(std::vector<char const*> const& arguments, std::string* message) {
  std::vector<char const*> line = {"contour"};
  line.insert(line.end(), arguments.begin(), arguments.end());
  return ParseCommandLine(static_cast<int>(line.size()), line.data(), message);
}

/// The message of the usage error; empty when there is none.
std::string UsageError(std::vector<char const*> const& arguments) {
  std::string message;
  try {
    Parse(arguments, &message);
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Code(), ExitCode::Usage);
    return failure.what();
  }
  return "";
}

TEST(Options, DefaultsAreMixedAndNoFiles) {
  std::string message;
  std::optional<Options> const options = Parse({"fit", "p.csv"}, &message);
  ASSERT_TRUE(options.has_value());
  EXPECT_EQ(options->points, "p.csv");
  EXPECT_EQ(options->strategy, GeometryUtils::FittingStrategy::Mixed);
  EXPECT_FALSE(options->tolerance.same || options->tolerance.column || options->tolerance.cap);
  EXPECT_FALSE(options->json || options->svg);
}

TEST(Options, AllOfThemAreRead) {
  std::string message;
  std::optional<Options> const options =
      Parse({"fit", "--tolerance", "+2e-2", "p.csv", "--strategy=cells", "--json", "a.json",
             "--svg", "a.svg"},
            &message);
  ASSERT_TRUE(options.has_value());
  EXPECT_EQ(options->tolerance.same, 0.02);
  EXPECT_EQ(options->strategy, GeometryUtils::FittingStrategy::MixedCells);
  EXPECT_EQ(options->json, "a.json");
  EXPECT_EQ(options->svg, "a.svg");
  EXPECT_EQ(Parse({"fit", "p.csv", "--strategy", "arc"}, &message)->strategy,
            GeometryUtils::FittingStrategy::SingleArc);
  EXPECT_EQ(Parse({"fit", "p.csv", "--tolerance-per-point", ".5"}, &message)->tolerance.cap, 0.5);
  EXPECT_EQ(Parse({"fit", "p.csv", "--tolerance-column", "tol"}, &message)->tolerance.column,
            "tol");
}

TEST(Options, ToleranceMustBeAFiniteNumberAboveZero) {
  for (char const* value : {"0", "-1", "nan", "inf", "1e999", "abc", "1,5", ""}) {
    for (char const* name : {"--tolerance=", "--tolerance-per-point="}) {
      std::string const argument = std::string(name) + value;
      EXPECT_NE(UsageError({"fit", "p.csv", argument.c_str()}), "") << argument;
    }
  }
  EXPECT_NE(
      UsageError({"fit", "p.csv", "--tolerance=-1"}).find("'-1' is not a finite number above 0"),
      std::string::npos);
}

TEST(Options, ContradictionsAndUnknownsAreUsageErrors) {
  EXPECT_NE(UsageError({}), "");
  EXPECT_NE(UsageError({"fit"}), "");
  EXPECT_NE(UsageError({"bend", "p.csv"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "q.csv"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--colour", "red"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--tolerance"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--strategy", "spline"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--strategy", "0"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--tolerance", "1", "--tolerance-per-point", "1"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--tolerance", "1", "--tolerance-column", "w"}), "");
  EXPECT_NE(UsageError({"fit", "p.csv", "--tolerance-per-point", "1", "--tolerance-column", "w"}),
            "");
}

TEST(Options, OneFileIsNotTwoThings) {
  EXPECT_EQ(UsageError({"fit", "p.csv", "--json", "out", "--svg", "./out"}),
            "--json and --svg name the same file: ./out");
  EXPECT_EQ(UsageError({"fit", "p.csv", "--svg", "p.csv"}),
            "POINTS and --svg name the same file: p.csv");
  EXPECT_EQ(UsageError({"fit", "p.csv", "--json", "p.csv"}),
            "POINTS and --json name the same file: p.csv");
}

TEST(Options, HelpNamesEveryOptionAndExitCode) {
  std::string help;
  EXPECT_FALSE(Parse({"fit", "--help"}, &help).has_value());
  for (char const* part : {"POINTS", "--tolerance", "--tolerance-column", "--tolerance-per-point",
                           "--strategy", "mixed", "cells", "arc", "--json", "--svg", "Exit codes",
                           "\n  0 ", "\n  1 ", "\n  2 ", "\n  3 ", "\n  4 ", "\n  5 "}) {
    EXPECT_NE(help.find(part), std::string::npos) << part;
  }
  std::string overview;
  EXPECT_FALSE(Parse({"--help"}, &overview).has_value());
  EXPECT_NE(overview.find("fit"), std::string::npos);
}

TEST(Options, VersionIsOneLine) {
  std::string version;
  EXPECT_FALSE(Parse({"--version"}, &version).has_value());
  EXPECT_EQ(version.rfind("contour ", 0), 0u);
  EXPECT_EQ(version.find('\n'), version.size() - 1);
}

}  // namespace
}  // namespace Vorn::Cli
