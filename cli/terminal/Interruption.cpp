#include "cli/terminal/Interruption.h"

#include <unistd.h>

#include <csignal>
#include <cstring>
#include <thread>

#include "cli/base/ExitCode.h"
#include "vorn/io/Files.h"

namespace Vorn::Cli {

namespace {

/// The descriptor of the terminal whose line is to be wiped; -1: none. The lock guards it.
int terminalLine = -1;

[[noreturn]] void Leave() {
  [[maybe_unused]] auto const lock = HoldOffInterruption();
  RemoveTemporaries();
  if (terminalLine >= 0) {
    // There is nothing left to do about a terminal that is gone.
    [[maybe_unused]] auto const written = write(terminalLine, kWipeLine, std::strlen(kWipeLine));
  }
  _exit(static_cast<int>(ExitCode::Interrupted));
}

bool IsIgnored(int signal) {
  struct sigaction action {};
  return sigaction(signal, nullptr, &action) == 0 && action.sa_handler == SIG_IGN;
}

}  // namespace

void EndCleanlyOnSignals() {
  sigset_t awaited;
  sigemptyset(&awaited);
  for (int const signal : {SIGINT, SIGTERM, SIGHUP}) {
    if (!IsIgnored(signal)) sigaddset(&awaited, signal);
  }
  // Blocked here and so in every thread to come, for the one that waits to get them.
  pthread_sigmask(SIG_BLOCK, &awaited, nullptr);
  std::thread([awaited] {
    int signal = 0;
    while (sigwait(&awaited, &signal) != 0) {
    }
    Leave();
  }).detach();
}

std::unique_lock<std::recursive_mutex> HoldOffInterruption() { return LockStagedFiles(); }

void NoteTerminalLine(int descriptor) {
  auto const lock = HoldOffInterruption();
  terminalLine = descriptor;
}

}  // namespace Vorn::Cli
