// Calls of the system that go wrong when a test wants them to. Loaded ahead of the C library
// (LD_PRELOAD), and only by the tests.
//
// CONTOUR_FAULT names the call and what happens at it, CONTOUR_FAULT_FILE how the name of the file
// begins that it concerns:
//
//   write rename fsync fchmod close mkstemp access exchange
//   full      ENOSPC        io      EIO          readonly  EROFS        unknown   EINVAL
//   kill      the process gets SIGKILL there     vanish    the folder is gone, then the call is
//   made int term hup   it gets that signal, and waits for its end slow      it gets SIGINT, and
//   the call is made a moment later half      writes a single byte               again     EINTR
//   the first time
//
// CONTOUR_FAULT_LOG is a file that gets a line for every fault, so that a test can tell that its
// fault happened.

#include <dlfcn.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>

namespace {

namespace fs = std::filesystem;

std::string Setting(char const* name) {
  char const* const value = std::getenv(name);
  return value == nullptr ? "" : value;
}

template <typename Function>
Function* Original(char const* name) {
  return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

std::string PathOf(int descriptor) {
  std::error_code error;
  return fs::read_symlink("/proc/self/fd/" + std::to_string(descriptor), error).string();
}

void Log(std::string const& line) {
  std::FILE* const file = std::fopen(Setting("CONTOUR_FAULT_LOG").c_str(), "a");
  if (file == nullptr) return;
  std::fprintf(file, "%s\n", line.c_str());
  std::fclose(file);
}

/// A signal that is ignored after all must not keep the test waiting.
[[noreturn]] void WaitForTheEnd() {
  constexpr unsigned kLongest = 60;
  constexpr int kNeverEnded = 99;
  sleep(kLongest);
  _exit(kNeverEnded);
}

enum class Outcome { Go, Fail, Half };

int ErrorFor(std::string const& what) {
  if (what == "full") return ENOSPC;
  if (what == "io") return EIO;
  if (what == "readonly") return EROFS;
  if (what == "unknown") return EINVAL;
  if (what == "again") return EINTR;
  return 0;
}

int SignalFor(std::string const& what) {
  if (what == "int") return SIGINT;
  if (what == "term") return SIGTERM;
  if (what == "hup") return SIGHUP;
  if (what == "kill") return SIGKILL;
  return 0;
}

void TakeFolderAway(std::string const& path) {
  std::error_code error;
  fs::remove_all(fs::absolute(fs::path(path)).parent_path(), error);
}

/// What becomes of this call; an outcome of Fail sets errno.
Outcome At(std::string const& call, std::string const& path) {
  std::string const fault = Setting("CONTOUR_FAULT");
  std::string const name = fs::path(path).filename().string();
  if (fault.rfind(call + ":", 0) != 0) return Outcome::Go;
  if (name.rfind(Setting("CONTOUR_FAULT_FILE"), 0) != 0) return Outcome::Go;
  std::string const what = fault.substr(call.size() + 1);
  static bool isRepeated = false;
  if ((what == "again" || what == "vanish" || what == "slow") && isRepeated) return Outcome::Go;
  isRepeated = true;
  Log(fault);
  if (what == "half") return Outcome::Half;
  if (what == "vanish") TakeFolderAway(path);
  if (what == "slow") {
    kill(getpid(), SIGINT);
    usleep(100'000);
  }
  if (int const signal = SignalFor(what); signal != 0) {
    kill(getpid(), signal);
    WaitForTheEnd();
  }
  errno = ErrorFor(what);
  return errno == 0 ? Outcome::Go : Outcome::Fail;
}

}  // namespace

extern "C" {

ssize_t write(int descriptor, void const* data, size_t size) {
  static auto* const original = Original<ssize_t(int, void const*, size_t)>("write");
  switch (At("write", PathOf(descriptor))) {
    case Outcome::Fail:
      return -1;
    case Outcome::Half:
      return original(descriptor, data, size > 0 ? 1 : 0);
    case Outcome::Go:
      break;
  }
  return original(descriptor, data, size);
}

int fsync(int descriptor) {
  static auto* const original = Original<int(int)>("fsync");
  return At("fsync", PathOf(descriptor)) == Outcome::Fail ? -1 : original(descriptor);
}

int fchmod(int descriptor, mode_t mode) noexcept {
  static auto* const original = Original<int(int, mode_t)>("fchmod");
  return At("fchmod", PathOf(descriptor)) == Outcome::Fail ? -1 : original(descriptor, mode);
}

int close(int descriptor) {
  static auto* const original = Original<int(int)>("close");
  bool const fails = At("close", PathOf(descriptor)) == Outcome::Fail;
  int const reason = errno;
  int const answer = original(descriptor);
  if (fails) errno = reason;
  return fails ? -1 : answer;
}

int mkstemp(char* name) {
  static auto* const original = Original<int(char*)>("mkstemp");
  return At("mkstemp", name) == Outcome::Fail ? -1 : original(name);
}

int access(char const* path, int mode) noexcept {
  static auto* const original = Original<int(char const*, int)>("access");
  return At("access", path) == Outcome::Fail ? -1 : original(path, mode);
}

int rename(char const* from, char const* to) noexcept {
  static auto* const original = Original<int(char const*, char const*)>("rename");
  return At("rename", to) == Outcome::Fail ? -1 : original(from, to);
}

int renameat2(int fromFolder, char const* from, int toFolder, char const* to,
              unsigned flags) noexcept {
  static auto* const original =
      Original<int(int, char const*, int, char const*, unsigned)>("renameat2");
  if (At("exchange", to) == Outcome::Fail) return -1;
  return original(fromFolder, from, toFolder, to, flags);
}
}
