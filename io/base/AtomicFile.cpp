#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>

#include "io/base/StagedFiles.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"

namespace Vorn::IO {

namespace {

namespace fs = std::filesystem;

[[noreturn]] void Refuse(std::string const& path, std::string const& reason) {
  throw Failure(FailureKind::File, {path}, "cannot be written: " + reason);
}

/// A device such as /dev/null or a pipe with a name, which takes what it is given at once.
bool IsStreamFile(fs::file_status const& status) {
  return fs::is_character_file(status) || fs::is_fifo(status);
}

/// Behind symbolic links: the new contents go where a plain write would have put them. The links of
/// /dev/fd to pipes lead to no name, so what is a stream keeps its own.
std::string Target(std::string const& path) {
  std::error_code error;
  if (!fs::is_symlink(path, error) || IsStreamFile(fs::status(path, error))) return path;
  bool const isThere = fs::exists(path, error);
  if (error) Refuse(path, error.message());
  if (!isThere) {
    Refuse(path, "is a link to " + fs::read_symlink(path, error).string() + ", which is not there");
  }
  fs::path const target = fs::weakly_canonical(path, error);
  if (error) Refuse(path, error.message());
  return target.string();
}

std::string FolderOf(std::string const& path) {
  fs::path const folder = fs::path(path).parent_path();
  return folder.empty() ? "." : folder.string();
}

/// What a new file allows before the mask of the process: everybody reads and writes.
constexpr mode_t kReadAndWrite = 0666;

/// The bits of a mode that are permissions; the others tell the kind of the file.
constexpr mode_t kPermissions = 07777;

mode_t DefaultMode() {
  mode_t const mask = umask(0);
  umask(mask);
  return kReadAndWrite & ~mask;
}

/// A replaced file keeps its permissions.
mode_t ModeFor(std::string const& target) {
  struct stat status {};
  return stat(target.c_str(), &status) == 0 ? (status.st_mode & kPermissions) : DefaultMode();
}

bool IsThere(std::string const& path) {
  struct stat status {};
  return lstat(path.c_str(), &status) == 0;
}

/// Makes each of two files have the name of the other.
/// @return false when that is not possible here, for one that a rename of the first would tell.
bool Exchange(std::string const& a, std::string const& b) {
#if defined(RENAME_EXCHANGE)
  // A folder that has got the name meanwhile would be exchanged as well.
  std::error_code error;
  if (!fs::is_regular_file(b, error)) return false;
  return renameat2(AT_FDCWD, a.c_str(), AT_FDCWD, b.c_str(), RENAME_EXCHANGE) == 0;
#else
  return false;
#endif
}

}  // namespace

void RequireWritable(std::string const& path) {
  std::string const target = Target(path);
  std::error_code error;
  fs::file_status const status = fs::status(target, error);
  if (fs::is_directory(status)) Refuse(path, "is a directory");
  if (IsStreamFile(status)) {
    if (access(target.c_str(), W_OK) != 0) Refuse(path, std::strerror(errno));
    return;
  }
  if (fs::exists(status) && !fs::is_regular_file(status)) Refuse(path, "is not a regular file");
  if (fs::path(target).filename().empty()) Refuse(path, "names no file");
  if (access(FolderOf(target).c_str(), W_OK | X_OK) != 0) Refuse(path, std::strerror(errno));
}

AtomicFile::AtomicFile(std::string const& path, std::string_view contents)
    : path_(path), target_(Target(path)) {
  RequireWritable(path);
  if (IsStreamFile(fs::status(target_))) {
    contents_ = contents;
    return;
  }
  int const descriptor = MakeTemporary();
  try {
    Write(descriptor, contents);
  } catch (...) {
    close(descriptor);
    RemoveTemporary();
    throw;
  }
  if (close(descriptor) != 0) {
    int const reason = errno;
    RemoveTemporary();
    Refuse(path_, std::strerror(reason));
  }
}

int AtomicFile::MakeTemporary() {
  std::string name = target_ + ".XXXXXX";
  auto const lock = LockStagedFiles();
  int const descriptor = mkstemp(name.data());
  if (descriptor < 0) Refuse(path_, std::strerror(errno));
  NoteTemporary(name);
  temporary_ = name;
  return descriptor;
}

void AtomicFile::RemoveTemporary() {
  auto const lock = LockStagedFiles();
  unlink(temporary_.c_str());
  ForgetTemporary(temporary_);
  temporary_.clear();
}

void AtomicFile::Write(int descriptor, std::string_view contents) const {
  while (!contents.empty()) {
    ssize_t const written = write(descriptor, contents.data(), contents.size());
    if (written < 0 && errno == EINTR) continue;
    if (written < 0) Refuse(path_, std::strerror(errno));
    contents.remove_prefix(static_cast<std::size_t>(written));
  }
  if (temporary_.empty()) return;
  if (fchmod(descriptor, ModeFor(target_)) != 0) Refuse(path_, std::strerror(errno));
  if (fsync(descriptor) != 0) Refuse(path_, std::strerror(errno));
}

AtomicFile::~AtomicFile() {
  if (!temporary_.empty()) RemoveTemporary();
}

bool AtomicFile::IsStream() const { return contents_.has_value(); }

/// Nobody may be reading yet, so no lock is held here.
void AtomicFile::WriteStream() const {
  int const descriptor = open(target_.c_str(), O_WRONLY);
  if (descriptor < 0) Refuse(path_, std::strerror(errno));
  try {
    Write(descriptor, *contents_);
  } catch (...) {
    close(descriptor);
    throw;
  }
  if (close(descriptor) != 0) Refuse(path_, std::strerror(errno));
}

void AtomicFile::Rename() {
  if (std::rename(temporary_.c_str(), target_.c_str()) != 0) Refuse(path_, std::strerror(errno));
  ForgetTemporary(temporary_);
  temporary_.clear();
}

void AtomicFile::TakePlace() {
  isNew_ = !IsThere(target_);
  if (isNew_ || !Exchange(temporary_, target_)) Rename();
}

void AtomicFile::GiveBack() {
  if (!temporary_.empty()) {
    Exchange(temporary_, target_);
  } else if (isNew_) {
    unlink(target_.c_str());
  }
}

void AtomicFile::Commit() {
  if (IsStream()) return WriteStream();
  auto const lock = LockStagedFiles();
  Rename();
}

void AtomicFile::CommitAll(std::vector<std::unique_ptr<AtomicFile>> const& files) {
  std::vector<AtomicFile*> staged;
  std::vector<AtomicFile*> streams;
  for (auto const& file : files) (file->IsStream() ? streams : staged).push_back(file.get());
  {
    auto const lock = LockStagedFiles();
    std::size_t placed = 0;
    try {
      for (; placed < staged.size(); ++placed) staged[placed]->TakePlace();
    } catch (...) {
      while (placed > 0) staged[--placed]->GiveBack();
      throw;
    }
    for (AtomicFile* const file : staged) {
      if (!file->temporary_.empty()) file->RemoveTemporary();
    }
  }
  for (AtomicFile* const stream : streams) stream->WriteStream();
}

}  // namespace Vorn::IO
