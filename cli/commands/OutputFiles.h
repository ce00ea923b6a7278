#pragma once

#include <optional>
#include <string>
#include <vector>

#include "cli/commands/CommandLine.h"
#include "cli/commands/Outputs.h"
#include "vorn/io/Formats.h"

namespace Vorn::Cli {

/// The files that a command writes in formats of the user's choice.
struct OutputFiles {
  std::vector<std::string> paths;   ///< as given; "-" is the standard output
  std::optional<Format> otherwise;  ///< of files whose names tell no format

  /// The files with the option that named them.
  std::vector<NamedFile> Named() const;

  /// Whether the standard output is one of them, so that no summary may go there.
  bool TakeStandardOutput() const;
};

/// The format of a file to write: by its ending, else `otherwise`.
/// @throws Failure (FailureKind::BadArgument) asking for --to when neither tells.
Format OutputFormat(std::string const& path, std::optional<Format> otherwise);

/// Adds -o and --to.
/// @param noun    what goes into a file, as the help calls it: "contour"
/// @param formats the words that --to takes
void AddOutputFiles(Command& command, std::string const& noun,
                    std::vector<std::string> const& formats, OutputFiles* files);

/// Puts the standard output where a format is named and no file. Called when all words are read.
/// @throws Failure (FailureKind::BadArgument) when neither is.
void CompleteOutputFiles(OutputFiles* files);

}  // namespace Vorn::Cli
