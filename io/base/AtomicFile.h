#pragma once

#include <string>
#include <string_view>

namespace Vorn::IO {

/// A file that appears whole or not at all: written under another name in the same folder, forced
/// to the disk, and only then given its real name. Until Commit() an existing file stays as it
/// was; dropped before, it leaves nothing behind.
///
/// Stage all files of a run first and commit them together: what commonly fails (no folder, no
/// permission, a full disk) fails while staging, with none of the files changed.
class AtomicFile {
 public:
  /// @throws Failure (FailureKind::File) naming the file when it cannot be written.
  AtomicFile(std::string const& path, std::string_view contents);
  AtomicFile(AtomicFile const&) = delete;
  AtomicFile& operator=(AtomicFile const&) = delete;
  ~AtomicFile();

  /// @throws Failure (FailureKind::File) naming the file.
  void Commit();

 private:
  int MakeTemporary();
  void RemoveTemporary();
  void Write(int descriptor, std::string_view contents) const;

  std::string path_;       ///< as the user wrote it, for messages
  std::string target_;     ///< behind symbolic links
  std::string temporary_;  ///< empty when there is none
};

/// Finds out before a long computation that a file could not be written afterwards.
/// @throws Failure (FailureKind::File) naming the file.
void RequireWritable(std::string const& path);

}  // namespace Vorn::IO
