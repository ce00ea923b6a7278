#include "io/base/StagedFiles.h"

#include <unistd.h>

#include <set>

#include "vorn/io/Files.h"

namespace Vorn::IO {

namespace {

struct Staged {
  std::recursive_mutex mutex;
  std::multiset<std::string> temporaries;
};

/// Never destroyed: a thread that removes the files may outlive main().
Staged& TheStaged() {
  static auto* const staged = new Staged;
  return *staged;
}

}  // namespace

std::unique_lock<std::recursive_mutex> LockStagedFiles() {
  return std::unique_lock(TheStaged().mutex);
}

void NoteTemporary(std::string const& path) {
  auto const lock = LockStagedFiles();
  TheStaged().temporaries.insert(path);
}

void ForgetTemporary(std::string const& path) {
  auto const lock = LockStagedFiles();
  auto const found = TheStaged().temporaries.find(path);
  if (found != TheStaged().temporaries.end()) TheStaged().temporaries.erase(found);
}

void RemoveTemporaries() {
  auto const lock = LockStagedFiles();
  for (std::string const& path : TheStaged().temporaries) unlink(path.c_str());
  TheStaged().temporaries.clear();
}

}  // namespace Vorn::IO
