#pragma once

#include <iosfwd>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "vorn/io/Export.h"

namespace Vorn::IO {

/// The path that stands for standard input.
inline constexpr char const* kStandardInput = "-";

/// How a file that is read is called in messages: its path, or "standard input".
VORN_IO_EXPORT std::string InputName(std::string const& path);

/// The whole contents of a file, read in one go; those of `in` for the path `-`.
/// @throws Failure (FailureKind::File) naming the file when it cannot be read, is a directory, or
///         has a line of more than 16 MiB; of 256 MiB where it begins as JSON, XML or well-known
///         text, which may stand in one line. No more than 16 MiB behind so much of it are read.
VORN_IO_EXPORT std::string ReadTextFile(std::string const& path, std::istream& in);

/// A file that appears whole or not at all: written under another name in the same folder, forced
/// to the disk, and only then given its real name. Until Commit() an existing file stays as it
/// was; dropped before, it leaves nothing behind.
///
/// Stage all files of a run first and commit them by CommitAll(): what commonly fails (no folder,
/// no permission, a full disk) fails while staging, with none of the files changed. A device or a
/// named pipe cannot be staged: it is written when it is committed.
class VORN_IO_EXPORT AtomicFile {
 public:
  /// @throws Failure (FailureKind::File) naming the file when it cannot be written.
  AtomicFile(std::string const& path, std::string_view contents);
  AtomicFile(AtomicFile const&) = delete;
  AtomicFile& operator=(AtomicFile const&) = delete;
  ~AtomicFile();

  /// @throws Failure (FailureKind::File) naming the file.
  void Commit();

  /// Commits all files or none of them, then the devices and pipes. When a file cannot get its
  /// name, those before it are put back: a replaced one has its old contents again, a new one goes.
  /// Where the file system cannot exchange two files, a replaced one keeps its new contents.
  /// @throws Failure (FailureKind::File) naming the file.
  static void CommitAll(std::vector<std::unique_ptr<AtomicFile>> const& files);

  /// Whether it is a device or a named pipe, which may keep Commit() waiting for a reader.
  bool IsStream() const;

 private:
  /// Writes the contents to the device or pipe.
  void WriteStream() const;
  /// Makes the file under another name and gives its descriptor.
  int MakeTemporary();
  /// Takes the file under the other name away.
  void RemoveTemporary();
  /// Writes the contents through to the disk.
  void Write(int descriptor, std::string_view contents) const;
  /// Gives the staged file its name; what had the name is staged in its place, if that is possible.
  void TakePlace();
  /// Gives the staged file its name for good.
  void Rename();
  /// Undoes TakePlace().
  void GiveBack();

  std::string path_;                     ///< as the user wrote it, for messages
  std::string target_;                   ///< behind symbolic links
  std::string temporary_;                ///< empty when there is none
  bool isNew_ = false;                   ///< whether nothing had its name before TakePlace()
  std::optional<std::string> contents_;  ///< of a device or a named pipe
};

/// Finds out before a long computation that a file could not be written afterwards.
/// @throws Failure (FailureKind::File) naming the file.
VORN_IO_EXPORT void RequireWritable(std::string const& path);

/// While the lock is held no other thread makes, renames or removes a staged file. A thread may
/// hold it more than once.
VORN_IO_EXPORT std::unique_lock<std::recursive_mutex> LockStagedFiles();

/// Removes the files of all that are staged; to be called just before the process ends.
VORN_IO_EXPORT void RemoveTemporaries();

}  // namespace Vorn::IO
