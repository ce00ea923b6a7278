#include "cli/Program.h"

#include <cstdio>
#include <exception>
#include <memory>
#include <ostream>
#include <utility>

#include "cli/AtomicFile.h"
#include "cli/CsvReader.h"
#include "cli/Fit.h"
#include "cli/Json.h"
#include "cli/Numbers.h"
#include "cli/Options.h"
#include "cli/Progress.h"
#include "cli/Report.h"
#include "cli/Spacing.h"
#include "cli/Svg.h"
#include "cli/Table.h"
#include "cli/Tolerances.h"

namespace Vorn::Cli {

namespace {

FitAnswer FitWithProgress(Options const& options, PointFile const& file) {
  ProgressBar progress(stderr);
  return Fit(file.points, options.strategy, &progress);
}

void RefuseFailedFit(PointFile const& file, FitAnswer const& answer) {
  if (answer.code == ErrorCode::PointsTooClose) {
    if (std::optional<ClosePair> const pair = FindClosePair(file.points)) {
      throw Failure(ExitCode::PointsTooClose, DescribeClosePair(file, *pair));
    }
  }
  if (answer.code != ErrorCode::Ok) {
    throw Failure(ExitCode::NoFit, file.path + ": no fit (code " + Describe(answer.code) + ")");
  }
  if (answer.contour.size() < 2) {
    throw Failure(ExitCode::NoFit, file.path + ": no fit (the contour has no pieces)");
  }
}

void WriteFiles(Options const& options, Report const& report) {
  std::unique_ptr<AtomicFile> json;
  std::unique_ptr<AtomicFile> svg;
  if (options.json) json = std::make_unique<AtomicFile>(*options.json, ToJson(report));
  if (options.svg) svg = std::make_unique<AtomicFile>(*options.svg, ToSvg(report));
  if (json) json->Commit();
  if (svg) svg->Commit();
}

std::string Complaint(Report const& report) {
  PointFile const& file = report.file;
  if (report.verdict == Verdict::StopsEarly) {
    GeometryUtils::Point const& end = report.pieces.back().end;
    return file.path + ": no fit beyond (" + FormatShort(end.x) + ", " + FormatShort(end.y) +
           "): the contour stops before the last point, " + file.NameOf(file.points.size() - 1);
  }
  return file.path + ": the contour leaves the tolerance of " +
         file.NameOf(report.remeasured.worst) + " (relative deviation " +
         FormatShort(report.remeasured.Worst().relative) + ")";
}

ExitCode RunFit(Options const& options, std::ostream& out, std::ostream& err) {
  if (options.json) RequireWritable(*options.json);
  if (options.svg) RequireWritable(*options.svg);
  PointFile file = ReadPoints(options.points, ColumnFor(options.tolerance));
  std::string toleranceSource = AssignTolerances(options.tolerance, &file);
  FitAnswer answer = FitWithProgress(options, file);
  RefuseFailedFit(file, answer);
  Report const report =
      MakeReport(std::move(file), std::move(toleranceSource), options.strategy, std::move(answer));
  WriteFiles(options, report);
  out << ToTable(report);
  if (options.json) out << "wrote       " << *options.json << '\n';
  if (options.svg) out << "wrote       " << *options.svg << '\n';
  if (report.verdict != Verdict::WithinTolerance) err << "contour: " << Complaint(report) << '\n';
  return ExitCodeOf(report.verdict);
}

ExitCode Dispatch(int argc, char const* const* argv, std::ostream& out, std::ostream& err) {
  std::string message;
  std::optional<Options> const options = ParseCommandLine(argc, argv, &message);
  ExitCode code = ExitCode::Ok;
  if (options) {
    code = RunFit(*options, out, err);
  } else {
    out << message;
  }
  if (!out.flush()) throw Failure(ExitCode::File, "standard output: cannot be written");
  return code;
}

}  // namespace

ExitCode RunProgram(int argc, char const* const* argv, std::ostream& out, std::ostream& err) {
  try {
    return Dispatch(argc, argv, out, err);
  } catch (Failure const& failure) {
    err << "contour: " << failure.what() << '\n';
    return failure.Code();
  } catch (std::exception const& error) {
    err << "contour: internal error: " << error.what() << '\n';
    return ExitCode::Internal;
  }
}

}  // namespace Vorn::Cli
