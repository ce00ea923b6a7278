#pragma once

#include <string>

#include "cli/commands/Command.h"
#include "cli/commands/CommandLine.h"
#include "vorn/io/Closure.h"
#include "vorn/io/Points.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::Cli {

/// The measured points a command reads, and the options that say how.
struct PointsInput {
  std::string path;  ///< "-" is the standard input
  ToleranceChoice tolerance;
  ColumnChoice columns;
  std::string units;  ///< --units; empty: what the file says
};

/// Adds the option --columns.
Option AddColumns(Command& command, ColumnChoice* columns);

/// Adds the positional POINTS and the options for tolerances, columns and units.
void AddPointsInput(Command& command, PointsInput* input);

/// Adds the options alone, for a command that may read many files.
void AddPointsOptions(Command& command, PointsInput* input);

/// Adds --closed, for commands to which the neighbourhood of the last and the first point matters.
void AddClosedChoice(Command& command, ClosedChoice* choice);

/// Reads the points. Tolerances that come from options are not assigned yet, see AssignTolerances.
/// @throws Failure as ReadPoints does.
PointFile ReadPointsInput(PointsInput const& input, Console const& console);

/// For the footer of a command's help.
extern char const* const kPointsFileText;

}  // namespace Vorn::Cli
