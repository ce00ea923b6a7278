#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <thread>

#include "cli/base/ExitCode.h"
#include "cli/terminal/Interruption.h"
#include "vorn/io/Files.h"

namespace Vorn::Cli {
namespace {

namespace fs = std::filesystem;

class EndCleanlyOnSignals : public testing::Test {
 protected:
  EndCleanlyOnSignals() {
    std::string name = (fs::temp_directory_path() / "contour-signal-XXXXXX").string();
    folder_ = mkdtemp(name.data());
  }

  ~EndCleanlyOnSignals() override { fs::remove_all(folder_); }

  std::string In(std::string const& name) const { return (folder_ / name).string(); }

  /// The exit code of a process that does this after it was told to end cleanly.
  static int CodeOf(std::function<void()> const& work) {
    pid_t const child = fork();
    if (child == 0) {
      // Ignored where the tests run in the background of a shell.
      for (int const signal : {SIGINT, SIGTERM, SIGHUP}) std::signal(signal, SIG_DFL);
      Cli::EndCleanlyOnSignals();
      work();
      _exit(99);
    }
    int status = 0;
    waitpid(child, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  }

  static void Send(int signal) { kill(getpid(), signal); }

  static void WaitForTheEnd() { std::this_thread::sleep_for(std::chrono::seconds(20)); }

  std::size_t FileCount() const {
    return static_cast<std::size_t>(
        std::distance(fs::directory_iterator(folder_), fs::directory_iterator()));
  }

  fs::path folder_;
};

TEST_F(EndCleanlyOnSignals, StagedFilesAreRemovedAndOldOnesStay) {
  for (int const signal : {SIGINT, SIGTERM, SIGHUP}) {
    AtomicFile(In("b"), "old").Commit();
    int const code = CodeOf([&] {
      AtomicFile const a(In("a"), "new");
      AtomicFile const b(In("b"), "new");
      AtomicFile const c(In("c"), std::string(1000000, 'c'));
      Send(signal);
      WaitForTheEnd();
    });
    EXPECT_EQ(code, static_cast<int>(ExitCode::Interrupted)) << "signal " << signal;
    EXPECT_EQ(FileCount(), 1u) << "signal " << signal;
    EXPECT_EQ(fs::file_size(In("b")), 3u);
  }
}

TEST_F(EndCleanlyOnSignals, WaitsWhileItIsHeldOff) {
  int const code = CodeOf([&] {
    AtomicFile a(In("a"), "new");
    AtomicFile b(In("b"), "new");
    auto const lock = HoldOffInterruption();
    Send(SIGINT);
    std::this_thread::sleep_for(std::chrono::milliseconds(100));
    a.Commit();
    b.Commit();
  });
  // The work ends before the lock is given back, or is interrupted after it.
  EXPECT_TRUE(code == 99 || code == static_cast<int>(ExitCode::Interrupted)) << code;
  EXPECT_TRUE(fs::exists(In("a")) && fs::exists(In("b"))) << "both were given their names";
  EXPECT_EQ(FileCount(), 2u);
}

TEST_F(EndCleanlyOnSignals, LeavesIgnoredSignalsIgnored) {
  int const code = CodeOf([] {});
  EXPECT_EQ(code, 99);
  pid_t const child = fork();
  if (child == 0) {
    signal(SIGHUP, SIG_IGN);
    Cli::EndCleanlyOnSignals();
    Send(SIGHUP);
    std::this_thread::sleep_for(std::chrono::milliseconds(100));
    _exit(98);
  }
  int status = 0;
  waitpid(child, &status, 0);
  ASSERT_TRUE(WIFEXITED(status));
  EXPECT_EQ(WEXITSTATUS(status), 98);
}

}  // namespace
}  // namespace Vorn::Cli
