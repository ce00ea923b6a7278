#include "cli/commands/FitOptions.h"

#include <algorithm>
#include <limits>
#include <sstream>

#include "cli/commands/CommonOptions.h"
#include "cli/commands/ContourOutput.h"
#include "cli/commands/FitHelp.h"
#include "cli/commands/OutputFiles.h"
#include "cli/commands/ReportFields.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"

namespace Vorn::Cli {

namespace {

constexpr int kMostDigits = 15;

/// Each strategy takes its own options alone.
void RefuseOtherStrategy(FitOptions const& options) {
  if (options.strategy != Strategy::Fewest) {
    RefuseFewestOptions(options.fewest, NameOf(options.strategy));
    return;
  }
  RefuseContradiction(options.fewest);
  if (!options.start) return;
  throw Failure(FailureKind::BadArgument,
                "--start is not for " + NameOf(Strategy::Fewest) +
                    ", the strategy when none is named, which finds the seam itself; --strategy " +
                    NameOf(Strategy::Mixed) + " takes it");
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

void AddFormats(Command& command, FitOptions* options) {
  auto const complaint = [](std::string const& text) -> std::string {
    return ParseFormats(text)
               ? ""
               : Quoted(text) +
                     " names none of json, csv, dxf, gcode, wkt, geojson, svg, png, html, or "
                     "one of them twice";
  };
  auto const take = [options](std::string const& text) {
    options->formats = ParseFormats(text).value();
  };
  command.AddChecked(
      "--to", complaint, take, "NAME[,NAME]...",
      "The format of outputs whose name does not tell, such as -: json, csv, dxf, gcode, wkt, "
      "geojson, "
      "svg, png, html; with --out-dir the formats to write, separated by commas; json if not said");
}

void AddManyOptions(Command& command, FitOptions* options) {
  constexpr int kMostJobs = 1024;
  command.AddText("--out-dir", &options->outFolder, "FOLDER",
                  "Fit one or many files and write the contours into this folder, named after the "
                  "inputs; it is made if need be");
  command.AddOutput("--summary", &options->summary,
                    "Write a table with a row for each file, the worst first, and totals: .csv, or "
                    ".html with a small picture of each contour");
  AddWholeNumber(command, "-j,--jobs", &options->jobs, {1, kMostJobs},
                 "Fit so many files at once; as many as there are processors if not said");
  command.AddFlag("--no-time", &options->hideTime,
                  "Leave the times out of the lines of many files");
}

}  // namespace

FitChoice FitOptions::Choice() const {
  FitChoice choice;
  choice.tolerance = points.tolerance;
  choice.strategy = strategy;
  choice.closed = closed;
  choice.fewest = Vorn::Cli::Choice(fewest);
  if (start) choice.start = static_cast<std::size_t>(*start);
  return choice;
}

std::vector<Target> FitOptions::Targets() const {
  std::vector<Target> targets;
  for (std::string const& path : outputs) {
    targets.push_back({{"--output", path}, FormatFor(path)});
  }
  if (!json.empty()) targets.push_back({{"--json", json}, Format::Json});
  if (!svg.empty()) targets.push_back({{"--svg", svg}, Format::Svg});
  return targets;
}

std::vector<NamedFile> FitOptions::Written() const {
  std::vector<NamedFile> files;
  for (Target const& target : Targets()) files.push_back(target.file);
  return files;
}

bool FitOptions::WritesGCode() const {
  if (!outFolder.empty()) {
    return std::find(formats.begin(), formats.end(), Format::GCode) != formats.end();
  }
  std::vector<Target> const targets = Targets();
  return std::any_of(targets.begin(), targets.end(),
                     [](Target const& target) { return target.format == Format::GCode; });
}

Format FitOptions::FormatFor(std::string const& path) const {
  std::optional<Format> otherwise;
  if (!formats.empty()) otherwise = formats.front();
  return OutputFormat(path, otherwise);
}

void AddFitOptions(Command& command, FitOptions* options) {
  command
      .AddTexts("POINTS", &options->paths, "FILE",
                "Files with the measured points, CSV tables or else drawings or tool paths; - is "
                "the standard input")
      .Require();
  AddPointsOptions(command, &options->points);
  AddPointsOutline(command, &options->points);
  AddChoice<Strategy>(
      command, "--strategy", &options->strategy,
      {{"fewest", Strategy::Fewest},
       {"mixed", Strategy::Mixed},
       {"cells", Strategy::Cells},
       {"arc", Strategy::Arc}},
      "fewest: as few pieces as the tolerances allow, for scans of any density; mixed: lines and "
      "arcs compared run by run; cells: lines first, arcs between them; arc: one arc for all "
      "points; " +
          NameOf(kUsualStrategy) + " if not said");
  AddFewestOptions(command, &options->fewest);
  AddChoice<ClosedChoice>(
      command, "--closed", &options->closed,
      {{"auto", ClosedChoice::Auto}, {"yes", ClosedChoice::Yes}, {"no", ClosedChoice::No}},
      "Whether the contour runs back to its start; auto (default): see below");
  AddWholeNumber(
      command, "--start", &options->start, {0, std::numeric_limits<int>::max(), "INDEX"},
      "Mixed, cells, arc: cut a closed contour open at this point, counted from 0; without "
      "it, at its sharpest corner");
  command.AddOutputs("-o,--output", &options->outputs,
                     "Write the contour to this file, in the format that its ending names; may be "
                     "given several times; - is the standard output");
  AddFormats(command, options);
  AddManyOptions(command, options);
  AddWriteOptions(command, &options->write);
  AddWholeNumber(command, "--digits", &options->digits, {0, kMostDigits},
                 "Digits after the point of lengths in the table; files always hold every digit");
  command.AddOutput("--json", &options->json, "The same as -o, always as JSON");
  command.AddOutput("--svg", &options->svg, "The same as -o, always as SVG");
  AddFieldOption(command, &options->fields);
  command.AddFlag("-q,--quiet", &options->isQuiet, "Draw no progress bar on the terminal");
  command.SetFooter(std::string(kPointsFileText) + kFitFooter);
}

void CompleteFitOptions(FitOptions* options) {
  options->points.path = options->paths.front();
  options->head = HeadOf(options->fields);
  bool const namesNoFile =
      options->outputs.empty() && options->json.empty() && options->svg.empty();
  if (namesNoFile && !options->AreMany() && options->formats.size() == 1) {
    options->outputs = {"-"};
  }
}

FitMany ManyOf(FitOptions const& options) {
  FitMany many;
  many.paths = options.paths;
  many.outFolder = options.outFolder;
  many.summary = options.summary;
  many.head = options.head;
  many.formats = options.formats.empty() ? std::vector{Format::Json} : options.formats;
  many.jobs = options.jobs;
  many.showTime = !options.hideTime;
  many.tellsBound = options.strategy == Strategy::Fewest;
  many.render = [&options](FitReport const& report, std::string const& path, Format format) {
    return RenderFit(report, path, format, options.write);
  };
  return many;
}

void RefuseWrongUse(FitOptions const& options) {
  auto const refuse = [](std::string const& message) {
    throw Failure(FailureKind::BadArgument, message);
  };
  RefuseOtherStrategy(options);
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

}  // namespace Vorn::Cli
