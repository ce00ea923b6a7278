#include <gtest/gtest.h>

#include <numbers>

#include "cli/RunInProcess.h"
#include "cli/commands/FewestOptions.h"

namespace Vorn::Cli {
namespace {

/// The message of a usage error, without the hint at the help; empty when there is none.
std::string Refusal(std::vector<std::string> words) {
  words.insert(words.begin(), {"fit", "-", "-t", "0.1"});
  RunResult const result = RunInProcess(words, "0,0\n1,0\n2,0\n");
  if (result.code != ExitCode::Usage) return "";
  EXPECT_EQ(result.out, "");
  return result.err.substr(0, result.err.find('\n'));
}

TEST(FewestOptions, WhatIsNotSaidIsLeftToTheService) {
  FewestPieces::Options const options = Choice({});
  FewestPieces::Options const usual;
  EXPECT_EQ(options.effort, usual.effort);
  EXPECT_EQ(options.largestStep, usual.largestStep);
  EXPECT_EQ(options.smallestRadius, usual.smallestRadius);
  EXPECT_EQ(options.largestRadius, usual.largestRadius);
  EXPECT_EQ(options.farthestBetweenPoints, usual.farthestBetweenPoints);
}

TEST(FewestOptions, AnglesAreDegreesAndLengthsStay) {
  FewestOptions options;
  options.effort = FewestPieces::Effort::Full;
  options.largestStep = 90.0;
  options.smallestRadius = 2.0;
  options.largestRadius = 3.0;
  options.between = 0.25;
  FewestPieces::Options const choice = Choice(options);
  EXPECT_EQ(choice.effort, FewestPieces::Effort::Full);
  EXPECT_DOUBLE_EQ(choice.largestStep, std::numbers::pi / 2.0);
  EXPECT_EQ(choice.smallestRadius, 2.0);
  EXPECT_EQ(choice.largestRadius, 3.0);
  EXPECT_EQ(choice.farthestBetweenPoints, 0.25);
}

TEST(FewestOptions, AHalfTurnIsTheLargestStep) {
  FewestOptions options;
  options.largestStep = 180.0;
  EXPECT_LE(Choice(options).largestStep, std::numbers::pi) << "beyond it the service refuses";
  EXPECT_EQ(Refusal({"--strategy", "fewest", "--largest-step", "180"}), "");
}

TEST(FewestOptions, BadValuesAreUsageErrors) {
  for (char const* value : {"0", "-1", "181", "nan", "inf", "x"}) {
    EXPECT_NE(Refusal({"--strategy", "fewest", std::string("--largest-step=") + value})
                  .find("is not an angle above 0 and up to 180 degrees"),
              std::string::npos)
        << value;
  }
  for (char const* value : {"-1", "nan", "inf", "x"}) {
    for (char const* name : {"--min-radius=", "--between="}) {
      EXPECT_NE(Refusal({"--strategy", "fewest", std::string(name) + value})
                    .find("is not a finite number of 0 or more"),
                std::string::npos)
          << name << value;
    }
  }
  EXPECT_NE(Refusal({"--strategy", "fewest", "--max-radius=0"}).find("'0' is not"),
            std::string::npos);
  EXPECT_NE(Refusal({"--strategy", "fewest", "--effort=most"})
                .find("'most' is none of quick, wide, full"),
            std::string::npos);
  EXPECT_EQ(Refusal({"--strategy", "fewest", "--min-radius=2", "--max-radius=1"}),
            "contour: --min-radius is larger than --max-radius");
}

TEST(FewestOptions, EachStrategyTakesItsOwnAlone) {
  std::vector<std::pair<std::string, std::string>> const options = {{"--effort", "wide"},
                                                                    {"--largest-step", "30"},
                                                                    {"--min-radius", "1"},
                                                                    {"--max-radius", "9"},
                                                                    {"--between", "0.1"}};
  for (char const* strategy : {"mixed", "cells", "arc"}) {
    for (auto const& [name, value] : options) {
      EXPECT_EQ(Refusal({"--strategy", strategy, name, value}),
                "contour: " + name + " is for --strategy fewest, not for " + strategy);
    }
  }
  for (auto const& [name, value] : options) {
    EXPECT_EQ(Refusal({"--strategy", "fewest", name, value}), "") << name;
    EXPECT_EQ(Refusal({name, value}), "") << name << ", the strategy not being named";
  }
  EXPECT_EQ(Refusal({"--strategy", "fewest", "--start", "1"}),
            "contour: --start is not for fewest, the strategy when none is named, which finds the "
            "seam itself; --strategy mixed takes it");
}

}  // namespace
}  // namespace Vorn::Cli
