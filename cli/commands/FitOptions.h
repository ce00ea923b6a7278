#pragma once

#include <optional>
#include <string>
#include <vector>

#include "cli/commands/CommandLine.h"
#include "cli/commands/FewestOptions.h"
#include "cli/commands/FitFiles.h"
#include "cli/commands/FitMany.h"
#include "cli/commands/Outputs.h"
#include "cli/commands/PointsInput.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/Formats.h"
#include "vorn/io/ReportHead.h"

namespace Vorn::Cli {

/// A file to write, and as what.
struct Target {
  NamedFile file;
  Format format = Format::Json;
};

/// What the command line of a fit asks for.
struct FitOptions {
  std::vector<std::string> paths;
  PointsInput points;
  Strategy strategy = kUsualStrategy;
  FewestOptions fewest;
  ClosedChoice closed = ClosedChoice::Auto;
  std::optional<int> start;
  std::vector<std::string> outputs;
  std::vector<Format> formats;
  std::string outFolder;
  std::string summary;
  std::optional<int> jobs;
  bool hideTime = false;
  WriteOptions write;
  std::optional<int> digits;
  std::string json;
  std::string svg;
  bool isQuiet = false;
  std::vector<std::string> fields;
  ReportHead head;  ///< of the fields

  /// Whether files are fitted side by side, a line for each.
  bool AreMany() const { return paths.size() > 1 || !outFolder.empty() || !summary.empty(); }

  /// How the points are to be fitted.
  FitChoice Choice() const;

  /// The files to write for a single file of points.
  std::vector<Target> Targets() const;

  /// The same without their formats.
  std::vector<NamedFile> Written() const;

  /// Whether a tool path is among what is written.
  bool WritesGCode() const;

 private:
  /// The format of an output, by the ending of its name or --to.
  Format FormatFor(std::string const& path) const;
};

/// Gives the command the operands and options of a fit, which fill in `options`.
void AddFitOptions(Command& command, FitOptions* options);

/// Puts in what follows from words that are not there. Called when all words have been read.
void CompleteFitOptions(FitOptions* options);

/// What is to be done with many files; how each is fitted is left open.
FitMany ManyOf(FitOptions const& options);

/// @throws Failure (FailureKind::BadArgument) where options contradict each other.
void RefuseWrongUse(FitOptions const& options);

}  // namespace Vorn::Cli
