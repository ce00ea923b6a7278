#pragma once

#include <optional>
#include <string>
#include <vector>

#include "cli/commands/Command.h"
#include "vorn/io/FileMeasure.h"
#include "vorn/io/FitReport.h"

namespace Vorn::Cli {

/// A fitted contour as it goes into a file.
struct FittedFile {
  std::string path;
  Format format = Format::Json;
  std::string text;
  std::optional<FileMeasure> measure;  ///< of a format that is read again
};

/// The text of the file, measured as it stands there.
/// @throws as ToText does.
FittedFile RenderFit(FitReport const& report, std::string const& path, Format format,
                     WriteOptions const& options);

/// The text of the file with several outlines, each measured by itself as it stands there.
FittedFile RenderFit(std::vector<FitReport> const& outlines, std::string const& path, Format format,
                     WriteOptions const& options);

/// The file that leaves the tolerances furthest: the first that cannot be read back, else the one
/// of the largest deviation. Null when none was measured.
FittedFile const* WorstOf(std::vector<FittedFile> const& files);

/// The verdict about the contour and all its files.
Verdict VerdictOf(FitReport const& report, std::vector<FittedFile> const& files);

/// What is wrong with the contour or else with the worst of its files, for standard error.
std::string Complaint(FitReport const& report, std::vector<FittedFile> const& files);

/// "0.998 of the tolerance at point 5 (line 7) in a.nc": a measure for the summary.
std::string ReadBackText(FitReport const& report, FittedFile const& file);

}  // namespace Vorn::Cli
