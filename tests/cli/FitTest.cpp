#include <gtest/gtest.h>
#include <pty.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cmath>
#include <cstdio>

#include "cli/Fit.h"
#include "cli/Progress.h"

namespace Vorn::Cli {
namespace {

using Strategy = GeometryUtils::FittingStrategy;

TEST(Fit, HandsOnCodeContourAndDeviation) {
  FitAnswer const answer = Fit({{0, 0, 0.1}, {3, 4, 0.1}}, Strategy::Mixed, nullptr);
  EXPECT_EQ(answer.code, ErrorCode::Ok);
  ASSERT_EQ(answer.contour.size(), 2u);
  EXPECT_EQ(answer.contour[1].end.y, 4.0);
  EXPECT_EQ(answer.deviation, 0.0);
  EXPECT_EQ(answer.deviationIndex, -1);
}

TEST(Fit, FailureLeavesTheDeviationUnknown) {
  FitAnswer const answer = Fit({{0, 0, 1}, {1, 0, 1}}, Strategy::Mixed, nullptr);
  EXPECT_EQ(answer.code, ErrorCode::PointsTooClose);
  EXPECT_TRUE(std::isnan(answer.deviation));
}

TEST(Describe, GivesNumberNameAndMeaning) {
  EXPECT_EQ(Describe(ErrorCode::NoFit),
            "23, NoFit: no arc passes the points within their tolerances");
  EXPECT_EQ(Describe(static_cast<ErrorCode>(99)), "99, unknown");
}

TEST(NameOf, IsWhatTheCommandLineTakes) {
  EXPECT_EQ(NameOf(Strategy::Mixed), "mixed");
  EXPECT_EQ(NameOf(Strategy::MixedCells), "cells");
  EXPECT_EQ(NameOf(Strategy::SingleArc), "arc");
}

/// What the action writes to a terminal that its standard error is.
template <typename Action>
std::string OnTerminal(Action const& action) {
  int terminal = -1;
  pid_t const child = forkpty(&terminal, nullptr, nullptr, nullptr);
  if (child == 0) {
    action();
    _exit(0);
  }
  std::string text;
  char buffer[256];
  for (ssize_t size = 0; (size = read(terminal, buffer, sizeof buffer)) > 0;) {
    text.append(buffer, static_cast<std::size_t>(size));
  }
  int status = 0;
  waitpid(child, &status, 0);
  close(terminal);
  return text;
}

TEST(ProgressBar, DrawsGrowingValuesOnceAndWipesItselfOff) {
  std::string const text = OnTerminal([] {
    ProgressBar bar(stderr, 1000);
    for (std::int32_t const percent : {50, 50, 20, 50, 100, 200}) bar.SetProgress(percent);
  });
  std::string const half = std::string(15, '#') + std::string(15, '.');
  EXPECT_EQ(text, "\rfitting [" + half + "]  50 % \x1b[K\rfitting [" + std::string(30, '#') +
                      "] 100 % \x1b[K\r\x1b[K");
}

TEST(ProgressBar, SilentWhereAsked) {
  EXPECT_EQ(OnTerminal([] { ProgressBar(stderr, 1000, true).SetProgress(50); }), "");
}

TEST(ProgressBar, UnusedBarWritesNothing) {
  EXPECT_EQ(OnTerminal([] { ProgressBar const bar(stderr, 1000); }), "");
}

TEST(ProgressBar, SilentWithoutATerminal) {
  std::FILE* const file = std::tmpfile();
  ASSERT_NE(file, nullptr);
  {
    ProgressBar bar(file, 1000);
    bar.SetProgress(50);
  }
  EXPECT_EQ(std::ftell(file), 0);
  std::fclose(file);
}

}  // namespace
}  // namespace Vorn::Cli
