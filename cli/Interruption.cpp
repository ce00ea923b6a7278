#include "cli/Interruption.h"

#include <unistd.h>

#include <csignal>
#include <cstring>
#include <set>
#include <thread>

#include "cli/Failure.h"

namespace Vorn::Cli {

namespace {

struct Traces {
  std::recursive_mutex mutex;
  std::multiset<std::string> temporaries;
  int terminalLine = -1;
};

/// Never destroyed: the waiting thread may outlive main().
Traces& TheTraces() {
  static Traces* const traces = new Traces;
  return *traces;
}

[[noreturn]] void Leave() {
  Traces& traces = TheTraces();
  std::unique_lock const lock = HoldOffInterruption();
  for (std::string const& path : traces.temporaries) unlink(path.c_str());
  if (traces.terminalLine >= 0) {
    // There is nothing left to do about a terminal that is gone.
    [[maybe_unused]] auto const written =
        write(traces.terminalLine, kWipeLine, std::strlen(kWipeLine));
  }
  _exit(static_cast<int>(ExitCode::Interrupted));
}

bool IsIgnored(int signal) {
  struct sigaction action {};
  return sigaction(signal, nullptr, &action) == 0 && action.sa_handler == SIG_IGN;
}

}  // namespace

void EndCleanlyOnSignals() {
  TheTraces();
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

std::unique_lock<std::recursive_mutex> HoldOffInterruption() {
  return std::unique_lock(TheTraces().mutex);
}

void NoteTemporary(std::string const& path) {
  auto const lock = HoldOffInterruption();
  TheTraces().temporaries.insert(path);
}

void ForgetTemporary(std::string const& path) {
  auto const lock = HoldOffInterruption();
  auto const found = TheTraces().temporaries.find(path);
  if (found != TheTraces().temporaries.end()) TheTraces().temporaries.erase(found);
}

void NoteTerminalLine(int descriptor) {
  auto const lock = HoldOffInterruption();
  TheTraces().terminalLine = descriptor;
}

}  // namespace Vorn::Cli
