#include "cli/commands/FitCommand.h"

#include <CLI/CLI.hpp>
#include <cstdio>
#include <limits>
#include <memory>
#include <ostream>
#include <utility>

#include "cli/ContourFit.h"
#include "cli/Json.h"
#include "cli/Numbers.h"
#include "cli/Progress.h"
#include "cli/Report.h"
#include "cli/Table.h"
#include "cli/commands/CommonOptions.h"
#include "cli/commands/ContourOutput.h"
#include "cli/commands/Outputs.h"
#include "cli/commands/PointsInput.h"
#include "cli/drawing/Drawing.h"
#include "cli/formats/Format.h"

namespace Vorn::Cli {

namespace {

using Strategy = GeometryUtils::FittingStrategy;

constexpr char const* kText =
    "Fit a contour of lines and arcs to measured points, so that it passes every point within\n"
    "its tolerance. Prints a table of the pieces and a summary, or writes the contour to files.";

constexpr char const* kFooter =
    R"(
Tolerance: at most one of the three options. Without one, the column w of the file counts, and
without that its comment "# tolerance T". Neighbouring points must be more than 1.5 times the
sum of their tolerances apart (strategies mixed and cells).

Closed contours: with --closed auto a contour is closed when its last point is the first one
again, or when its ends are no more than 1.5 times as far apart as the five points next to
either end and the contour does not turn back between them (by more than 135 degrees). A thin
body that is open at one end and a contour with its seam in a very sharp corner look alike, and
so do a closed contour and one that is open by a single step: then say --closed yes or no. The
contour is cut open at --start or else where it turns most (without a corner: where two pieces
meet) and fitted all the way round. Both ends are moved to one common point where that keeps
every point within its tolerance; otherwise the gap is reported. A full circle comes out as two
half circles.

Deviations are multiples of the tolerance of the point: up to 1 is within tolerance. They are
printed as the fit reports them, and as measured again by the program over every point. Up to
1 + 1e-9 counts as within, for the rounding of the second measurement. Points are counted from
0. The strategy arc reports its deviation as a length, and no point.

Outputs: the ending of a file tells its format: .json (the contour with deviations and all),
.csv, .dxf, .nc or .gcode, .wkt (the contour; see 'contour convert --help' for what each keeps),
.svg, .png, .html (drawings). --format tells it for - and for other endings. Numbers are written so
that they read back as the same doubles, but for G-code, which is rounded. With -o - the table
is not printed.

Exit codes:
  0   every point is within its tolerance
  1   the contour leaves the tolerance of a point (table and files are written)
  2   wrong usage
  3   a file cannot be read or written, or a line of the points file is wrong
  4   two neighbouring points are too close for their tolerances
  5   no fit, or a contour that stops before the last point (then table and files are written)
  70  internal error
  130 interrupted

Output files are written whole or not at all.

Examples:
  contour fit part.csv -t 0.02
  contour fit part.csv -t 0.02 -o part.dxf -o part.svg -o part.json
  contour fit part.csv -t 0.02 -o part.nc --feed 600
  contour fit - -t 0.02 -o - --format dxf < part.csv > part.dxf
  contour fit part.csv --tolerance-per-point 0.05 --strategy cells -o part.json
  contour fit outline.csv -t 0.01 --closed yes --start 120
)";

constexpr int kMostDigits = 15;

/// A file to write, and as what.
struct Target {
  NamedFile file;
  Format format = Format::Json;
};

struct Options {
  PointsInput points;
  Strategy strategy = Strategy::Mixed;
  ClosedChoice closed = ClosedChoice::Auto;
  std::optional<int> start;
  std::vector<std::string> outputs;
  std::optional<Format> format;
  WriteOptions write;
  std::optional<int> digits;
  std::string json;
  std::string svg;
  bool isQuiet = false;

  FitChoice Choice() const {
    FitChoice choice = {points.tolerance, strategy, closed, {}};
    if (start) choice.start = static_cast<std::size_t>(*start);
    return choice;
  }

  std::vector<Target> Targets() const {
    std::vector<Target> targets;
    for (std::string const& path : outputs) {
      targets.push_back({{"--output", path}, FormatFor(path)});
    }
    if (!json.empty()) targets.push_back({{"--json", json}, Format::Json});
    if (!svg.empty()) targets.push_back({{"--svg", svg}, Format::Svg});
    return targets;
  }

  Format FormatFor(std::string const& path) const { return OutputFormat(path, format, "--format"); }

  std::vector<NamedFile> Written() const {
    std::vector<NamedFile> files;
    for (Target const& target : Targets()) files.push_back(target.file);
    return files;
  }
};

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

ContourFile ContourOf(Report const& report) {
  return {report.file.path, report.pieces, report.closure.isClosed, report.file.units};
}

std::string TextOf(Report const& report, Format format, WriteOptions const& options) {
  switch (format) {
    case Format::Json:
      return ToJson(report);
    case Format::Svg:
      return ToSvg(DrawingOf(report));
    case Format::Html:
      return ToHtml(DrawingOf(report));
    case Format::Png:
      return ToPng(DrawingOf(report), {});
    default:
      return ToText(ContourOf(report), format, options);
  }
}

void WriteResults(Options const& options, Report const& report, Console const& console) {
  Outputs outputs;
  bool isOutTaken = false;
  for (Target const& target : options.Targets()) {
    outputs.Add(target.file.path, TextOf(report, target.format, options.write));
    isOutTaken = isOutTaken || target.file.path == "-";
  }
  outputs.Write(console);
  if (isOutTaken) return;
  console.out << ToTable(report, options.digits);
  for (NamedFile const& file : options.Written()) {
    console.out << "wrote       " << file.path << '\n';
  }
}

Report FitWithProgress(Options const& options, Console const& console) {
  PointFile file = ReadPointsInput(options.points, console);
  ProgressBar progress(stderr, file.points.size(), options.isQuiet);
  return FitContour(std::move(file), options.Choice(), &progress);
}

ExitCode Run(Options const& options, Console const& console) {
  RequireWritable(options.Written());
  Report const report = FitWithProgress(options, console);
  WriteResults(options, report, console);
  if (report.verdict != Verdict::WithinTolerance) {
    console.err << "contour: " << Complaint(report) << '\n';
  }
  return ExitCodeOf(report.verdict);
}

void AddOptions(CLI::App& app, Options* options) {
  AddPointsInput(app, &options->points);
  AddChoice<Strategy>(
      app, "--strategy", &options->strategy,
      {{"mixed", Strategy::Mixed}, {"cells", Strategy::MixedCells}, {"arc", Strategy::SingleArc}},
      "mixed: lines and arcs compared run by run (default); cells: lines first, arcs between "
      "them; arc: one arc for all points");
  AddChoice<ClosedChoice>(
      app, "--closed", &options->closed,
      {{"auto", ClosedChoice::Auto}, {"yes", ClosedChoice::Yes}, {"no", ClosedChoice::No}},
      "Whether the contour runs back to its start; auto (default): see below");
  AddWholeNumber(app, "--start", &options->start, 0, std::numeric_limits<int>::max(), "INDEX",
                 "Cut a closed contour open at this point, counted from 0; without it, at its "
                 "sharpest corner");
  app.add_option("-o,--output", options->outputs,
                 "Write the contour to this file, in the format that its ending names; may be "
                 "given several times; - is the standard output")
      ->expected(1)
      ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll)
      ->type_name("FILE");
  AddWord(
      app, "--format", {"json", "csv", "dxf", "gcode", "wkt", "svg", "png", "html"},
      [options](std::string const& word) { options->format = FormatNamed(word); },
      "The format of outputs whose name does not tell, such as -");
  AddWriteOptions(app, &options->write);
  AddWholeNumber(app, "--digits", &options->digits, 0, kMostDigits, "N",
                 "Digits after the point of lengths in the table; files always hold every digit");
  app.add_option("--json", options->json, "The same as -o, always as JSON")->type_name("FILE");
  app.add_option("--svg", options->svg, "The same as -o, always as SVG")->type_name("FILE");
  app.add_flag("-q,--quiet", options->isQuiet, "Draw no progress bar on the terminal");
  app.footer(std::string(kPointsFileText) + kFooter);
}

}  // namespace

void AddFitCommand(CLI::App& program, Action* action) {
  CLI::App* const app = program.add_subcommand("fit", kText);
  auto const options = std::make_shared<Options>();
  AddOptions(*app, options.get());
  app->callback([options, action] {
    RefuseSharedFiles({{"POINTS", options->points.path}}, options->Written());
    *action = [options](Console const& console) { return Run(*options, console); };
  });
}

}  // namespace Vorn::Cli
