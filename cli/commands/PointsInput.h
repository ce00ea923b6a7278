#pragma once

#include <optional>
#include <string>
#include <vector>

#include "cli/commands/Command.h"
#include "cli/commands/CommandLine.h"
#include "vorn/io/Closure.h"
#include "vorn/io/PointOutlines.h"
#include "vorn/io/Points.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::Cli {

/// The measured points a command reads, and the options that say how.
struct PointsInput {
  std::string path;  ///< "-" is the standard input
  ToleranceChoice tolerance;
  ColumnChoice columns;
  std::string units;                 ///< --units; empty: what the file says
  std::optional<Format> from;        ///< --points-from; nothing: the name or the content tells
  std::optional<double> flattening;  ///< --flatten; nothing: arcs and curves are refused
  std::optional<int> outline;        ///< counted from 1; nothing: all there are
};

/// Adds the option --columns.
Option AddColumns(Command& command, ColumnChoice* columns);

/// Adds the positional POINTS and the options for tolerances, columns and units.
void AddPointsInput(Command& command, PointsInput* input);

/// Adds the options alone, for a command that may read many files.
void AddPointsOptions(Command& command, PointsInput* input);

/// Adds --outline, for commands that work with one of several outlines in a file.
void AddPointsOutline(Command& command, PointsInput* input);

/// Adds --closed, for commands to which the neighbourhood of the last and the first point matters.
void AddClosedChoice(Command& command, ClosedChoice* choice);

/// Reads the points of every outline in the file, or of the one asked for. Tolerances that come
/// from options are not assigned yet, see AssignTolerances.
/// @throws Failure as ReadPointOutlines does, (FailureKind::BadArgument) when there are not so many
///         outlines.
std::vector<PointFile> ReadPointOutlinesInput(PointsInput const& input, Console const& console);

/// "scan.wkt: dropped the coordinates beside x and y"; empty when there were none.
std::string DroppedHeightsText(PointFile const& outline);

/// Says it on the standard error, if there is anything to say.
void ReportDroppedHeights(PointFile const& outline, Console const& console);

/// "scan.csv: skipped lines 502 to 504 behind the table"; empty when none were.
std::string SkippedLinesText(PointFile const& file);

/// Says it on the standard error, where the command has no summary that does.
void ReportSkippedLines(PointFile const& file, Console const& console);

/// @throws Failure (FailureKind::BadArgument) unless the file has one outline, or one was chosen.
void RequireOneOutline(PointsInput const& input, std::size_t count);

/// The same for a command that works with one outline.
/// @throws Failure (FailureKind::BadArgument) when there are several.
PointFile ReadPointsInput(PointsInput const& input, Console const& console);

/// The points of all outlines one after the other, for a command that looks at each point by
/// itself.
PointFile ReadAllPointsInput(PointsInput const& input, Console const& console);

/// How the text of a points file is read.
PointReading ReadingOf(PointsInput const& input);

/// The one outline that is asked for, with the units that are said; all of them without --outline.
/// @throws Failure (FailureKind::BadArgument) when there are not so many outlines.
std::vector<PointFile> ChosenOutlines(PointsInput const& input, std::vector<PointFile> outlines);

/// For the footer of a command's help.
extern char const* const kPointsFileText;

}  // namespace Vorn::Cli
