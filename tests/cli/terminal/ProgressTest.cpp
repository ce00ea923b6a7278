#include <gtest/gtest.h>
#include <pty.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>

#include "cli/terminal/Progress.h"

namespace Vorn::Cli {
namespace {

TEST(DescribePace, TellsRateAndTimeLeft) {
  EXPECT_EQ(DescribePace(1000, 50, 10.0), "50 points/s, 10 s left");
  EXPECT_EQ(DescribePace(1000000, 25, 1.0), "250000 points/s, 3 s left");
  EXPECT_EQ(DescribePace(123456, 10, 1.0), "12000 points/s, 9 s left") << "two good digits";
  EXPECT_EQ(DescribePace(1000, 100, 10.0), "100 points/s");
}

TEST(DescribePace, LongTimesAreToldInMinutesAndHours) {
  EXPECT_EQ(DescribePace(1000, 10, 10.0), "10 points/s, 1 min 30 s left");
  EXPECT_EQ(DescribePace(1000, 50, 125.0), "4 points/s, 2 min 05 s left");
  EXPECT_EQ(DescribePace(100000, 1, 100.0), "10 points/s, 2 h 45 min left");
}

TEST(DescribePace, SaysNothingTooEarly) {
  EXPECT_EQ(DescribePace(1000, 50, 0.1), "");
  EXPECT_EQ(DescribePace(1000, 0, 10.0), "");
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
  EXPECT_EQ(text, "\rfitting [" + half + "]  50 %\x1b[K\rfitting [" + std::string(30, '#') +
                      "] 100 %\x1b[K\r\x1b[K");
}

TEST(ProgressBar, SilentWhereAsked) {
  EXPECT_EQ(OnTerminal([] { ProgressBar(stderr, 1000, true).SetProgress(50); }), "");
}

TEST(ProgressBar, UnusedBarWritesNothing) {
  EXPECT_EQ(OnTerminal([] { ProgressBar const bar(stderr, 1000); }), "");
}

TEST(ProgressLine, FitsIntoTheColumns) {
  EXPECT_EQ(ProgressLine(50, "9 points/s", 80),
            "fitting [###############...............]  50 % 9 points/s");
  EXPECT_EQ(ProgressLine(50, "9 points/s", 40), "fitting [######......]  50 % 9 points/s");
  EXPECT_EQ(ProgressLine(50, "9 points/s", 30), "fitting [######.......]  50 %");
  EXPECT_EQ(ProgressLine(50, "", 80), "fitting [###############...............]  50 %");
  EXPECT_EQ(ProgressLine(100, "9 points/s", 12), "100 %");
  EXPECT_EQ(ProgressLine(100, "", 0), "");
  for (std::size_t columns = 0; columns < 100; ++columns) {
    for (std::int32_t percent : {0, 7, 99, 100}) {
      EXPECT_LE(ProgressLine(percent, "1200 points/s, 3 min 05 s left", columns).size(),
                columns > 0 ? columns - 1 : 0);
    }
  }
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
