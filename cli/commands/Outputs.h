#pragma once

#include <string>
#include <utility>
#include <vector>

#include "cli/commands/Command.h"

namespace Vorn::Cli {

/// A file named on the command line, and by which option: {"--json", "part.json"}.
struct NamedFile {
  std::string option;
  std::string path;
};

/// Refuses that a file is written twice or written over what is read; "-" is no file.
/// @throws Failure (FailureKind::BadArgument) naming both options and the file.
void RefuseSharedFiles(std::vector<NamedFile> const& read, std::vector<NamedFile> const& written);

/// Finds out before a long computation that a file could not be written afterwards.
/// @throws Failure (FailureKind::File) naming the file.
void RequireWritable(std::vector<NamedFile> const& files);

/// The results of a command on their way into files and to the standard output.
class Outputs {
 public:
  /// "-" stands for the standard output.
  void Add(std::string const& path, std::string text);

  /// Writes every file whole or none of them, then the standard output.
  /// @throws Failure (FailureKind::File) naming the file.
  void Write(Console const& console) const;

 private:
  std::vector<std::pair<std::string, std::string>> texts_;
};

}  // namespace Vorn::Cli
