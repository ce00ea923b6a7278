#include "cli/commands/OutputFiles.h"

#include <algorithm>

#include "cli/commands/CommonOptions.h"
#include "vorn/io/Failure.h"

namespace Vorn::Cli {

std::vector<NamedFile> OutputFiles::Named() const {
  std::vector<NamedFile> files;
  for (std::string const& path : paths) files.push_back({"--output", path});
  return files;
}

bool OutputFiles::TakeStandardOutput() const {
  return std::find(paths.begin(), paths.end(), "-") != paths.end();
}

Format OutputFormat(std::string const& path, std::optional<Format> otherwise) {
  if (std::optional<Format> const format = FormatOf(path)) return *format;
  if (otherwise) return *otherwise;
  throw Failure(FailureKind::BadArgument, (path == "-" ? "the standard output" : path) +
                                              ": --to must say which format to write");
}

void AddOutputFiles(Command& command, std::string const& noun,
                    std::vector<std::string> const& formats, OutputFiles* files) {
  command.AddOutputs("-o,--output", &files->paths,
                     "Write the " + noun +
                         " to this file; may be given several times; - is the standard "
                         "output, which --to without -o means as well");
  AddFormat(command, "--to", formats, &files->otherwise, "Write the outputs as this");
}

void CompleteOutputFiles(OutputFiles* files) {
  if (files->paths.empty() && files->otherwise) files->paths = {"-"};
  if (files->paths.empty()) {
    throw Failure(FailureKind::BadArgument, "--output is required, or --to");
  }
}

}  // namespace Vorn::Cli
