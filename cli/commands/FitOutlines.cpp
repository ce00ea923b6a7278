#include "cli/commands/FitOutlines.h"

#include <algorithm>
#include <cstdio>
#include <ostream>
#include <utility>

#include "cli/commands/ContourOutput.h"
#include "cli/commands/FineToleranceWarning.h"
#include "cli/commands/FitFiles.h"
#include "cli/commands/Outputs.h"
#include "cli/terminal/Progress.h"
#include "cli/texts/FitTable.h"
#include "vorn/io/Failure.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/JoinedFit.h"
#include "vorn/io/Messages.h"

namespace Vorn::Cli {

namespace {

std::vector<FitReport> FitEach(FitOptions const& options, std::vector<PointFile> outlines,
                               Console const& console) {
  FitChoice const choice = WarningOfFineTolerances(options.Choice(), console);
  std::vector<FitReport> reports;
  for (PointFile& outline : outlines) {
    ProgressBar progress(stderr, outline.points.size(), options.isQuiet);
    reports.push_back(FitContour(std::move(outline), choice, &progress));
    reports.back().head = options.head;
  }
  return reports;
}

/// The tables of the outlines, and what holds for all of them.
struct Results {
  std::vector<FitReport> reports;
  FitReport joined;
  std::vector<FittedFile> files;
};

/// What is wrong with the worst outline, or else with the worst file; nothing when all is well.
std::string ComplaintOf(Results const& results) {
  Verdict const verdict = VerdictOf(results.joined, results.files);
  if (verdict == Verdict::WithinTolerance) return "";
  if (results.joined.verdict == Verdict::WithinTolerance) {
    return Complaint(results.joined, results.files);
  }
  auto const worst = std::find_if(
      results.reports.begin(), results.reports.end(),
      [&](FitReport const& report) { return report.verdict == results.joined.verdict; });
  return Complaint(*worst, {});
}

void Print(FitOptions const& options, Results const& results, Console const& console) {
  for (FitReport const& report : results.reports) {
    console.out << ToTable(report, options.digits, "") << '\n';
  }
  FitReport const& joined = results.joined;
  console.out << "outlines    " << results.reports.size() << ": "
              << Counted(joined.file.points.size(), "point") << ", "
              << Counted(joined.pieces.size(), "piece") << '\n';
  if (FittedFile const* const worst = WorstOf(results.files)) {
    console.out << "read back   " << ReadBackText(joined, *worst) << '\n';
  }
  console.out << "result      " << Describe(VerdictOf(joined, results.files)) << '\n';
  for (FittedFile const& file : results.files) {
    console.out << "wrote       " << Printable(file.path) << '\n';
  }
}

}  // namespace

ExitCode RunFitOutlines(FitOptions const& options, std::vector<PointFile> outlines,
                        Console const& console) {
  if (options.start) {
    throw Failure(FailureKind::BadArgument, "--start is for one outline, and there are " +
                                                std::to_string(outlines.size()) +
                                                ": --outline N takes one of them");
  }
  Results results;
  results.reports = FitEach(options, std::move(outlines), console);
  results.joined = Joined(results.reports);
  Outputs outputs;
  bool isOutTaken = false;
  for (Target const& target : options.Targets()) {
    results.files.push_back(
        RenderFit(results.reports, target.file.path, target.format, options.write));
    outputs.Add(target.file.path, results.files.back().text);
    isOutTaken = isOutTaken || target.file.path == "-";
  }
  outputs.Write(console);
  if (!isOutTaken) Print(options, results, console);
  WarnOfMissingFeed(options.write, options.WritesGCode(), console);
  std::string const complaint = ComplaintOf(results);
  if (!complaint.empty()) console.err << "contour: " << complaint << '\n';
  return ExitCodeOf(VerdictOf(results.joined, results.files));
}

}  // namespace Vorn::Cli
