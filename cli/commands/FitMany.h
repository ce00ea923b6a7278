#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "cli/commands/Command.h"
#include "cli/commands/FitFiles.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/Formats.h"

namespace Vorn::Cli {

/// Many files to fit, and how. The functions are called from several threads at once.
struct FitMany {
  std::vector<std::string> paths;
  std::string outFolder;  ///< empty: nothing is written
  std::vector<Format> formats;
  std::optional<int> jobs;  ///< how many files at once; nothing: as many as there are processors
  bool showTime = true;
  bool tellsBound = false;  ///< how few pieces there can be at least, beside their number
  std::string summary;      ///< a file .csv or .html with a row for each; empty: none
  ReportHead head;          ///< of the summary
  std::function<FitReport(std::string const& path)> fit;
  std::function<FittedFile(FitReport const&, std::string const& path, Format)> render;
};

/// The file that the fit of `path` is written to: the name of the input with another ending.
std::string OutputOf(FitMany const& many, std::string const& path, Format format);

/// @throws Failure (FailureKind::BadArgument) naming the files when an input is the standard input,
/// two
///         outputs have one name, or an output is an input.
void RefuseCollisions(FitMany const& many);

/// Fits the files side by side: a line for each on the standard output, in the order of the inputs
/// whatever is ready first, and a summary. A file that fails has its line as well, its message goes
/// to standard error, and the others go on.
///
/// Everything that is written happens in one thread, file by file; the same inputs give the same
/// bytes whatever `jobs` is.
///
/// @return the worst code of all files: internal error, unreadable or unwritable file, wrong usage,
///         points too close, no fit, outside tolerance, in this order
ExitCode RunFitMany(FitMany const& many, Console const& console);

}  // namespace Vorn::Cli
