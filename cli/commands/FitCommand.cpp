#include "cli/commands/FitCommand.h"

#include <cstdio>
#include <memory>
#include <ostream>
#include <utility>

#include "cli/commands/ContourOutput.h"
#include "cli/commands/FineToleranceWarning.h"
#include "cli/commands/FitFiles.h"
#include "cli/commands/FitHelp.h"
#include "cli/commands/FitMany.h"
#include "cli/commands/FitOptions.h"
#include "cli/commands/FitOutlines.h"
#include "cli/commands/Outputs.h"
#include "cli/commands/PointsInput.h"
#include "cli/terminal/Progress.h"
#include "cli/texts/FitTable.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/JoinedFit.h"
#include "vorn/io/Messages.h"

namespace Vorn::Cli {

namespace {

/// The contour in every format that is asked for.
std::vector<FittedFile> FilesOf(FitOptions const& options, FitReport const& report) {
  std::vector<FittedFile> files;
  for (Target const& target : options.Targets()) {
    files.push_back(RenderFit(report, target.file.path, target.format, options.write));
  }
  return files;
}

void PrintResults(FitOptions const& options, FitReport const& report,
                  std::vector<FittedFile> const& files, Console const& console) {
  FittedFile const* const worst = WorstOf(files);
  console.out << ToTable(report, options.digits,
                         worst == nullptr ? "" : ReadBackText(report, *worst));
  for (FittedFile const& file : files)
    console.out << "wrote       " << Printable(file.path) << '\n';
}

void WriteResults(FitOptions const& options, FitReport const& report,
                  std::vector<FittedFile> const& files, Console const& console) {
  Outputs outputs;
  bool isOutTaken = false;
  for (FittedFile const& file : files) {
    outputs.Add(file.path, file.text);
    isOutTaken = isOutTaken || file.path == "-";
  }
  outputs.Write(console);
  if (!isOutTaken) PrintResults(options, report, files, console);
}

FitReport FitWithProgress(FitOptions const& options, PointFile file, Console const& console) {
  ProgressBar progress(stderr, file.points.size(), options.isQuiet);
  FitChoice const choice = WarningOfFineTolerances(options.Choice(), console);
  FitReport report = FitContour(std::move(file), choice, &progress);
  report.head = options.head;
  return report;
}

/// Reads from the file alone: a standard input is not among many.
FitReport FitOneOfMany(FitOptions const& options, FitChoice const& choice, std::string const& path,
                       Console const& console) {
  PointsInput input = options.points;
  input.path = path;
  std::vector<FitReport> reports;
  for (PointFile& outline : ReadPointOutlinesInput(input, console)) {
    reports.push_back(FitContour(std::move(outline), choice, nullptr));
    reports.back().head = options.head;
  }
  return reports.size() == 1 ? std::move(reports.front()) : Joined(reports);
}

ExitCode RunMany(FitOptions const& options, Console const& console) {
  FitMany many = ManyOf(options);
  WarnOfMissingFeed(options.write, options.WritesGCode(), console);
  FitChoice const choice = WarningOfFineTolerances(options.Choice(), console);
  many.fit = [&](std::string const& path) { return FitOneOfMany(options, choice, path, console); };
  return RunFitMany(many, console);
}

ExitCode Run(FitOptions const& options, Console const& console) {
  RequireWritable(options.Written());
  std::vector<PointFile> outlines = ReadPointOutlinesInput(options.points, console);
  ReportDroppedHeights(outlines.front(), console);
  if (outlines.size() > 1) return RunFitOutlines(options, std::move(outlines), console);
  FitReport report = FitWithProgress(options, std::move(outlines.front()), console);
  std::vector<FittedFile> const files = FilesOf(options, report);
  Verdict const verdict = VerdictOf(report, files);
  std::string const complaint = verdict == Verdict::WithinTolerance ? "" : Complaint(report, files);
  report.verdict = verdict;
  WriteResults(options, report, files, console);
  WarnOfMissingFeed(options.write, options.WritesGCode(), console);
  if (!complaint.empty()) console.err << "contour: " << complaint << '\n';
  return ExitCodeOf(verdict);
}

}  // namespace

void AddFitCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("fit", kFitText);
  auto const options = std::make_shared<FitOptions>();
  AddFitOptions(command, options.get());
  command.OnParsed([options, action] {
    CompleteFitOptions(options.get());
    RefuseWrongUse(*options);
    *action = [options](Console const& console) {
      return options->AreMany() ? RunMany(*options, console) : Run(*options, console);
    };
  });
}

}  // namespace Vorn::Cli
