#include "cli/commands/FitCommand.h"

#include <algorithm>
#include <cstdio>
#include <limits>
#include <memory>
#include <ostream>
#include <sstream>
#include <utility>

#include "cli/commands/CommonOptions.h"
#include "cli/commands/ContourOutput.h"
#include "cli/commands/FitFiles.h"
#include "cli/commands/FitMany.h"
#include "cli/commands/Outputs.h"
#include "cli/commands/PointsInput.h"
#include "cli/terminal/Progress.h"
#include "cli/texts/FitTable.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

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
every point within its tolerance; otherwise a short line joins them, and where no line within the
tolerance can, the gap is reported and the exit code is 1. A full circle comes out as two half
circles.

Deviations are multiples of the tolerance of the point: up to 1 is within tolerance. They are
printed as the fit reports them, and as measured again by the program over every point; the larger
counts. Up to 1 + 1e-6 counts as within, for the rounding of the measurement. Points are counted
from 0. The strategy arc reports its deviation as a length, and no point.

Outputs: the ending of a file tells its format: .json (the contour with deviations and all),
.csv, .dxf, .nc or .gcode, .wkt (the contour; see 'contour convert --help' for what each keeps),
.svg, .png, .html (drawings). --to tells it for - and for other endings. Numbers are written so
that they read back as the same doubles, but for G-code, which is rounded. Every file that holds
the contour is read back and measured before the word "within" is said. With -o - the table is
not printed.

Many files: each is fitted by itself, several at once, and has a line with its points, pieces,
largest deviation, time and result. Those that fail do not stop the others; their whole messages go
to standard error. Lines come in the order of the files, and the same files give the same bytes
whatever --jobs is (--no-time leaves out what differs from run to run). The exit code is the worst
of all files, in the order 70, 3, 2, 4, 5, 1, 0.

Exit codes:
  0   every point is within its tolerance
  1   the contour, or a file of it, leaves the tolerance of a point, or a closed contour has a gap
      (table and files are written)
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
  contour fit - -t 0.02 -o - --to dxf < part.csv > part.dxf
  contour fit part.csv --tolerance-per-point 0.05 --strategy cells -o part.json
  contour fit outline.csv -t 0.01 --closed yes --start 120
  contour fit scans/*.csv -t 0.02 --out-dir fitted --to json,dxf -j 8
)";

constexpr int kMostDigits = 15;

/// A file to write, and as what.
struct Target {
  NamedFile file;
  Format format = Format::Json;
};

struct Options {
  std::vector<std::string> paths;
  PointsInput points;
  Strategy strategy = Strategy::Mixed;
  ClosedChoice closed = ClosedChoice::Auto;
  std::optional<int> start;
  std::vector<std::string> outputs;
  std::vector<Format> formats;
  std::string outFolder;
  std::optional<int> jobs;
  bool hideTime = false;
  WriteOptions write;
  std::optional<int> digits;
  std::string json;
  std::string svg;
  bool isQuiet = false;

  /// Whether files are fitted side by side, a line for each.
  bool AreMany() const { return paths.size() > 1 || !outFolder.empty(); }

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

  Format FormatFor(std::string const& path) const {
    std::optional<Format> otherwise;
    if (!formats.empty()) otherwise = formats.front();
    return OutputFormat(path, otherwise, "--to");
  }

  bool WritesGCode() const {
    if (!outFolder.empty()) {
      return std::find(formats.begin(), formats.end(), Format::GCode) != formats.end();
    }
    std::vector<Target> const targets = Targets();
    return std::any_of(targets.begin(), targets.end(),
                       [](Target const& target) { return target.format == Format::GCode; });
  }

  std::vector<NamedFile> Written() const {
    std::vector<NamedFile> files;
    for (Target const& target : Targets()) files.push_back(target.file);
    return files;
  }
};

/// The contour in every format that is asked for.
std::vector<FittedFile> FilesOf(Options const& options, FitReport const& report) {
  std::vector<FittedFile> files;
  for (Target const& target : options.Targets()) {
    files.push_back(RenderFit(report, target.file.path, target.format, options.write));
  }
  return files;
}

void PrintResults(Options const& options, FitReport const& report,
                  std::vector<FittedFile> const& files, Console const& console) {
  FittedFile const* const worst = WorstOf(files);
  console.out << ToTable(report, options.digits,
                         worst == nullptr ? "" : ReadBackText(report, *worst));
  for (FittedFile const& file : files)
    console.out << "wrote       " << Printable(file.path) << '\n';
}

void WriteResults(Options const& options, FitReport const& report,
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

FitReport FitWithProgress(Options const& options, Console const& console) {
  PointFile file = ReadPointsInput(options.points, console);
  ProgressBar progress(stderr, file.points.size(), options.isQuiet);
  return FitContour(std::move(file), options.Choice(), &progress);
}

/// Reads from the file alone: a standard input is not among many.
FitReport FitOneOfMany(Options const& options, std::string const& path, Console const& console) {
  PointsInput input = options.points;
  input.path = path;
  return FitContour(ReadPointsInput(input, console), options.Choice(), nullptr);
}

FitMany ManyOf(Options const& options) {
  FitMany many;
  many.paths = options.paths;
  many.outFolder = options.outFolder;
  many.formats = options.formats.empty() ? std::vector{Format::Json} : options.formats;
  many.jobs = options.jobs;
  many.showTime = !options.hideTime;
  many.render = [&options](FitReport const& report, std::string const& path, Format format) {
    return RenderFit(report, path, format, options.write);
  };
  return many;
}

ExitCode RunMany(Options const& options, Console const& console) {
  FitMany many = ManyOf(options);
  WarnOfMissingFeed(options.write, options.WritesGCode(), console);
  many.fit = [&](std::string const& path) { return FitOneOfMany(options, path, console); };
  return RunFitMany(many, console);
}

ExitCode Run(Options const& options, Console const& console) {
  RequireWritable(options.Written());
  FitReport report = FitWithProgress(options, console);
  std::vector<FittedFile> const files = FilesOf(options, report);
  Verdict const verdict = VerdictOf(report, files);
  std::string const complaint = verdict == Verdict::WithinTolerance ? "" : Complaint(report, files);
  report.verdict = verdict;
  WriteResults(options, report, files, console);
  WarnOfMissingFeed(options.write, options.WritesGCode(), console);
  if (!complaint.empty()) console.err << "contour: " << complaint << '\n';
  return ExitCodeOf(verdict);
}

/// The formats of a list as --to takes it; nothing when a word is none or comes twice.
std::optional<std::vector<Format>> ParseFormats(std::string const& text) {
  std::vector<Format> formats;
  std::istringstream words(text + ",");
  for (std::string word; std::getline(words, word, ',');) {
    std::optional<Format> const format = FormatNamed(word);
    if (!format || std::find(formats.begin(), formats.end(), *format) != formats.end()) return {};
    formats.push_back(*format);
  }
  return formats;
}

void AddFormats(Command& command, Options* options) {
  auto const complaint = [](std::string const& text) -> std::string {
    return ParseFormats(text) ? ""
                              : Quoted(text) +
                                    " names none of json, csv, dxf, gcode, wkt, svg, png, html, or "
                                    "one of them twice";
  };
  auto const take = [options](std::string const& text) {
    options->formats = ParseFormats(text).value();
  };
  command.AddChecked(
      "--to", complaint, take, "NAME[,NAME]...",
      "The format of outputs whose name does not tell, such as -: json, csv, dxf, gcode, wkt, "
      "svg, png, html; with --out-dir the formats to write, separated by commas; json if not said");
}

void AddManyOptions(Command& command, Options* options) {
  constexpr int kMostJobs = 1024;
  command.AddText("--out-dir", &options->outFolder, "FOLDER",
                  "Fit one or many files and write the contours into this folder, named after the "
                  "inputs; it is made if need be");
  AddWholeNumber(command, "-j,--jobs", &options->jobs, 1, kMostJobs, "N",
                 "Fit so many files at once; as many as there are processors if not said");
  command.AddFlag("--no-time", &options->hideTime,
                  "Leave the times out of the lines of many files");
}

void RefuseWrongUse(Options const& options) {
  auto const refuse = [](std::string const& message) {
    throw Failure(FailureKind::BadArgument, message);
  };
  if (options.AreMany()) {
    if (!options.outputs.empty() || !options.json.empty() || !options.svg.empty()) {
      refuse("many files are written with --out-dir and --to, not with -o, --json or --svg");
    }
    if (options.digits) refuse("--digits is for the table of a single file");
    RefuseCollisions(ManyOf(options));
    return;
  }
  if (options.jobs) refuse("--jobs is for many files");
  if (options.hideTime) refuse("--no-time is for many files");
  if (options.formats.size() > 1) refuse("--to names one format, unless --out-dir is given");
  RefuseSharedFiles({{"POINTS", options.points.path}}, options.Written());
}

void AddOptions(Command& command, Options* options) {
  command
      .AddTexts("POINTS", &options->paths, "FILE",
                "CSV files with the measured points, each a contour; - is the standard input")
      .Require();
  AddPointsOptions(command, &options->points);
  AddChoice<Strategy>(
      command, "--strategy", &options->strategy,
      {{"mixed", Strategy::Mixed}, {"cells", Strategy::MixedCells}, {"arc", Strategy::SingleArc}},
      "mixed: lines and arcs compared run by run (default); cells: lines first, arcs between "
      "them; arc: one arc for all points");
  AddChoice<ClosedChoice>(
      command, "--closed", &options->closed,
      {{"auto", ClosedChoice::Auto}, {"yes", ClosedChoice::Yes}, {"no", ClosedChoice::No}},
      "Whether the contour runs back to its start; auto (default): see below");
  AddWholeNumber(command, "--start", &options->start, 0, std::numeric_limits<int>::max(), "INDEX",
                 "Cut a closed contour open at this point, counted from 0; without it, at its "
                 "sharpest corner");
  command.AddRepeatable(
      "-o,--output", &options->outputs, "FILE",
      "Write the contour to this file, in the format that its ending names; may be "
      "given several times; - is the standard output");
  AddFormats(command, options);
  AddManyOptions(command, options);
  AddWriteOptions(command, &options->write);
  AddWholeNumber(command, "--digits", &options->digits, 0, kMostDigits, "N",
                 "Digits after the point of lengths in the table; files always hold every digit");
  command.AddText("--json", &options->json, "FILE", "The same as -o, always as JSON");
  command.AddText("--svg", &options->svg, "FILE", "The same as -o, always as SVG");
  command.AddFlag("-q,--quiet", &options->isQuiet, "Draw no progress bar on the terminal");
  command.SetFooter(std::string(kPointsFileText) + kFooter);
}

}  // namespace

void AddFitCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("fit", kText);
  auto const options = std::make_shared<Options>();
  AddOptions(command, options.get());
  command.OnParsed([options, action] {
    options->points.path = options->paths.front();
    bool const namesNoFile =
        options->outputs.empty() && options->json.empty() && options->svg.empty();
    if (namesNoFile && !options->AreMany() && options->formats.size() == 1) {
      options->outputs = {"-"};
    }
    RefuseWrongUse(*options);
    *action = [options](Console const& console) {
      return options->AreMany() ? RunMany(*options, console) : Run(*options, console);
    };
  });
}

}  // namespace Vorn::Cli
