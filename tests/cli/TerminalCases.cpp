#include <fcntl.h>
#include <gtest/gtest.h>
#include <pty.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cmath>
#include <csignal>
#include <string>
#include <vector>

#include "cli/ProgramFixture.h"

/// The program on a terminal, and interrupted.
namespace Vorn::Cli::Testing {
namespace {

/// A run whose standard error is a terminal.
struct TerminalRun {
  int code = -1;
  std::string text;
};

/// Sends the signal, if any, as soon as something is written that contains `when`.
TerminalRun RunOnTerminal(std::vector<std::string> const& words, int signal = 0,
                          std::string const& when = "") {
  TerminalRun run;
  int terminal = -1;
  pid_t const child = forkpty(&terminal, nullptr, nullptr, nullptr);
  if (child == 0) {
    // The table would only be in the way.
    dup2(open("/dev/null", O_WRONLY), STDOUT_FILENO);
    std::vector<char*> arguments = {const_cast<char*>(CONTOUR_PROGRAM)};
    for (std::string const& word : words) arguments.push_back(const_cast<char*>(word.c_str()));
    arguments.push_back(nullptr);
    execv(CONTOUR_PROGRAM, arguments.data());
    _exit(99);
  }
  char buffer[256];
  for (ssize_t size = 0; (size = read(terminal, buffer, sizeof buffer)) > 0;) {
    run.text.append(buffer, static_cast<std::size_t>(size));
    if (signal == 0 || run.text.find(when) == std::string::npos) continue;
    kill(child, signal);
    signal = 0;
  }
  int status = 0;
  waitpid(child, &status, 0);
  close(terminal);
  if (WIFEXITED(status)) run.code = WEXITSTATUS(status);
  return run;
}

/// Takes many seconds to be fitted: a single wide arc of very many points.
std::string LongArc() {
  constexpr int kPoints = 60000;
  std::string text;
  for (int i = 0; i < kPoints; ++i) {
    double const angle = 5.0 * i / kPoints;
    double const radius = 1000.0 + 0.001 * std::sin(1e4 * i * i);
    text += std::to_string(radius * std::cos(angle)) + "," +
            std::to_string(radius * std::sin(angle)) + "\n";
  }
  return text;
}

TEST_F(Program, InterruptedInALongFitLeavesNothing) {
  Write("p.csv", LongArc());
  Write("p.json", "old");
  for (int const signal : {SIGINT, SIGTERM}) {
    TerminalRun const run =
        RunOnTerminal({"fit", (folder_ / "p.csv").string(), "-t", "0.01", "-o",
                       (folder_ / "p.json").string(), "-o", (folder_ / "p.dxf").string()},
                      signal, "fitting [");
    EXPECT_EQ(run.code, 130) << run.text;
    EXPECT_EQ(run.text.find("100 %"), std::string::npos) << "it was over before the signal came";
    EXPECT_EQ(run.text.substr(run.text.size() - 4), "\r\x1b[K") << "the bar is wiped off";
    EXPECT_EQ(Files(), (std::vector<std::string>{"p.csv", "p.json"}));
    EXPECT_EQ(Contents(folder_ / "p.json"), "old");
  }
}

TEST_F(Program, QuietDrawsNothingOnATerminal) {
  Write("p.csv", Corner());
  std::string const points = (folder_ / "p.csv").string();
  TerminalRun const quiet = RunOnTerminal({"fit", points, "-t", "0.01", "--quiet"});
  EXPECT_EQ(quiet.code, 0);
  EXPECT_EQ(quiet.text, "");
  TerminalRun const loud = RunOnTerminal({"fit", points, "-t", "0.01"});
  EXPECT_EQ(loud.text.rfind("\rfitting [", 0), 0u) << loud.text;
}

}  // namespace
}  // namespace Vorn::Cli::Testing
