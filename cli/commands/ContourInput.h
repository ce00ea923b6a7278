#pragma once

#include <optional>
#include <string>
#include <vector>

#include "cli/commands/Command.h"
#include "cli/commands/CommandLine.h"
#include "vorn/io/ContourFile.h"
#include "vorn/io/Formats.h"

namespace Vorn::Cli {

/// A contour that a command reads.
struct ContourInput {
  std::string path;
  std::optional<Format> from;
  std::optional<int> outline;        ///< counted from 1; nothing: all there are
  std::optional<double> flattening;  ///< for curves that are no arcs; nothing: these are refused
};

/// Adds --outline, or the option of another name for the outlines of another file.
void AddOutline(Command& command, std::optional<int>* outline,
                std::string const& name = "--outline");

/// Adds --flatten.
void AddFlatten(Command& command, std::optional<double>* flattening);

/// The outlines in the file, each chained from its pieces (see OutlinesOf), or the one asked for.
/// @throws Failure as ReadContour does, or (FailureKind::BadArgument) when there are not so many.
std::vector<ContourFile> ReadOutlines(ContourInput const& input, Console const& console);

/// The same as one contour with gaps between the outlines. One whose pieces are chained in the file
/// as far as they can be stays as it is.
ContourFile ReadContourInput(ContourInput const& input, Console const& console);

/// Says on the standard error where pieces do not meet.
void ReportGaps(ContourFile const& contour, Console const& console);

}  // namespace Vorn::Cli
