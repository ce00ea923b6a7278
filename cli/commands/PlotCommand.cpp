#include "cli/commands/PlotCommand.h"

#include <cmath>
#include <filesystem>
#include <memory>
#include <ostream>
#include <utility>

#include "cli/commands/CommonOptions.h"
#include "cli/commands/ContourInput.h"
#include "cli/commands/OutputFiles.h"
#include "cli/commands/PointsInput.h"
#include "cli/commands/ReportFields.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::Cli {

namespace {

constexpr char const* kText =
    "Draw measured points, or a contour, or a contour with the deviations of the points from it, "
    "as\n"
    "SVG, PNG or a page of HTML that pans and zooms.";

constexpr char const* kFooter =
    R"(
The ending of a file tells its format: .svg, .png, .html. For - and other names --to says it.

With CONTOUR (JSON, CSV, DXF, G-code, WKT, GeoJSON or SVG) the drawing shows its lines and arcs with
their joints true to scale, and each point moved away from the contour until it is K times as far
from it as it is; the tolerance is drawn K times as wide. Below are the deviations along the
contour, positive to the left of the direction of travel. Without CONTOUR the drawing shows the
points and their order. A single file called .json, .dxf, .nc, .gcode, .wkt, .geojson or .svg is a
contour, which is drawn by itself.

A tolerance is drawn when one of the three options or the file states it, as for 'contour fit', and
only then is the contour judged. Points that fall on the same place of the page are drawn once.
A page of HTML with more than 20,000 points draws, where they are dense, the range that they reach,
and holds their numbers rounded to a hundred-thousandth of the smallest tolerance or finer (without
tolerances a billionth of the size); it says so, and takes less than 15 bytes a point. Verdict,
table, points outside and the worst of each piece come from the exact numbers.

Exit codes:
  0   the drawings are written, whatever they show
  2   wrong usage
  3   a file cannot be read or written
  4   a tolerance by spacing was asked for, but neighbours coincide
  70  internal error
  130 interrupted

Output files are written whole or not at all.

Examples:
  contour plot part.csv -o points.svg
  contour plot part.dxf -o part.svg
  contour plot part.csv part.json --tolerance 0.02 -o part.html -o part.png --dpi 300
  contour plot part.csv part.dxf --magnify 50 -o part.svg
)";

struct Options {
  PointsInput points;
  std::string contour;
  OutputFiles outputs;
  std::vector<std::string> fields;
  ReportHead head;  ///< of the fields
  std::optional<int> outline;
  std::optional<double> magnify;
  std::optional<double> dpi;
  std::optional<int> width;

  std::vector<NamedFile> Read() const {
    std::vector<NamedFile> files;
    if (!points.path.empty()) files.push_back({"POINTS", points.path});
    if (!contour.empty()) files.push_back({"CONTOUR", contour});
    return files;
  }

  /// Whether an option speaks of measured points.
  bool IsAboutPoints() const {
    ToleranceChoice const& tolerance = points.tolerance;
    return tolerance.same || tolerance.column || tolerance.cap || points.columns.IsGiven() ||
           magnify;
  }
};

Format DrawingFormat(Options const& options, std::string const& path) {
  Format const format = OutputFormat(path, options.outputs.otherwise);
  if (HoldsContour(format)) {
    throw Failure(FailureKind::BadArgument,
                  path + ": not a drawing; 'contour convert' writes " + NameOf(format));
  }
  return format;
}

/// A single file in a format that holds no points is the contour.
void TellContourFromPoints(Options* options) {
  if (!options->contour.empty()) return;
  std::optional<Format> const format = FormatOf(options->points.path);
  if (!format || !IsReadAsContour(*format) || *format == Format::Csv) return;
  if (options->IsAboutPoints()) {
    throw Failure(FailureKind::BadArgument,
                  options->points.path +
                      ": a contour alone has nothing to judge or to magnify; POINTS is missing");
  }
  options->contour = std::move(options->points.path);
  options->points.path.clear();
}

void RefuseSharedInput(Options const& options) {
  if (options.points.path == "-" && options.contour == "-") {
    throw Failure(FailureKind::BadArgument, "POINTS and CONTOUR cannot both be the standard input");
  }
}

std::string NameOfFile(std::string const& path) {
  return path == "-" ? "standard input" : std::filesystem::path(path).filename().string();
}

ContourFile ReadDrawnContour(Options const& options, Console const& console) {
  ContourFile contour =
      ReadContourInput({options.contour, {}, options.outline, options.points.flattening}, console);
  ReportGaps(contour, console);
  return contour;
}

Drawing ReadDrawing(Options const& options, Console const& console) {
  if (options.points.path.empty()) {
    ContourFile contour = ReadDrawnContour(options, console);
    if (!options.points.units.empty()) contour.units = Printable(options.points.units);
    Drawing drawing = DrawingOf(contour);
    drawing.head = options.head;
    return drawing;
  }
  PointFile file = ReadAllPointsInput(options.points, console);
  ReportSkippedLines(file, console);
  if (IsToleranceStated(options.points.tolerance, file)) {
    bool const isClosed = FindClosure(file.points, ClosedChoice::Auto).isClosed;
    AssignTolerances(options.points.tolerance, &file, isClosed);
  }
  ContourFile contour;
  if (!options.contour.empty()) contour = ReadDrawnContour(options, console);
  std::string const gaps = DescribeGaps(contour);
  Drawing drawing = MakeDrawing(std::move(file.points), std::move(contour.pieces));
  drawing.units = file.units.empty() ? contour.units : file.units;
  drawing.title = NameOfFile(options.points.path);
  drawing.facts = {DescribeTolerance(drawing)};
  if (!options.contour.empty()) drawing.facts.push_back("contour " + NameOfFile(options.contour));
  if (!gaps.empty()) drawing.facts.push_back(gaps);
  drawing.magnify = options.magnify;
  drawing.head = options.head;
  return drawing;
}

std::string Drawn(Options const& options, Drawing const& drawing, Format format) {
  PngSize size;
  if (options.dpi) size.dpi = *options.dpi;
  size.width = options.width;
  return Drawn(drawing, format, size);
}

std::string Summary(Drawing const& drawing) {
  std::string text;
  if (!drawing.points.empty()) {
    text = "points      " + std::to_string(drawing.points.size()) + '\n';
  }
  if (!drawing.HasContour()) return text;
  text += "pieces      " + Counted(drawing.pieces.size() - drawing.ArcCount(), "line") + ", " +
          Counted(drawing.ArcCount(), "arc") + '\n';
  if (!drawing.IsMeasured()) return text;
  PointDeviation const& worst = drawing.deviations[drawing.Worst()];
  text += "deviation   " + FormatShort(worst.distance);
  if (!drawing.units.empty()) text += " " + drawing.units;
  if (drawing.HasTolerances()) text += ", " + FormatShort(worst.relative) + " of the tolerance,";
  text += " at point " + std::to_string(drawing.Worst()) + '\n';
  if (drawing.verdict) text += "result      " + Describe(*drawing.verdict) + '\n';
  return text;
}

ExitCode Run(Options const& options, Console const& console) {
  RequireWritable(options.outputs.Named());
  Drawing const drawing = ReadDrawing(options, console);
  Outputs outputs;
  for (std::string const& path : options.outputs.paths) {
    outputs.Add(path, Drawn(options, drawing, DrawingFormat(options, path)));
  }
  outputs.Write(console);
  if (options.outputs.TakeStandardOutput()) return ExitCode::Ok;
  console.out << Summary(drawing);
  for (std::string const& path : options.outputs.paths)
    console.out << "wrote       " << Printable(path) << '\n';
  return ExitCode::Ok;
}

/// A number above zero, or the word for choosing one.
void AddMagnify(Command& command, std::optional<double>* magnify) {
  auto const complaint = [](std::string const& text) -> std::string {
    std::optional<double> const value = ParseNumber(text);
    bool const isGood = text == "auto" || (value && std::isfinite(*value) && *value > 0.0);
    return isGood ? "" : Quoted(text) + " is neither auto nor a number above 0";
  };
  auto const take = [magnify](std::string const& text) {
    *magnify = text == "auto" ? std::optional<double>() : ParseNumber(text);
  };
  command.AddChecked(
      "--magnify", complaint, take, "K",
      "Draw deviations and tolerance K times as large as they are; auto (the default): a round "
      "number that makes the largest tolerance readable");
}

void AddOptions(Command& command, Options* options) {
  constexpr int kMostPixels = 30000;
  AddPointsInput(command, &options->points);
  command.AddText("CONTOUR", &options->contour, "FILE",
                  "File with a contour; - is the standard input");
  AddOutputFiles(command, "drawing", {"svg", "png", "html"}, &options->outputs);
  AddOutline(command, &options->outline);
  AddMagnify(command, &options->magnify);
  AddFieldOption(command, &options->fields);
  Option const dpi = AddPositiveNumber(command, "--dpi", &options->dpi, "N",
                                       "PNG: pixels to the inch on A4; 150 if not said");
  AddWholeNumber(command, "--width", &options->width, {1, kMostPixels}, "PNG: width in pixels")
      .Exclude(dpi);
  command.SetFooter(std::string(kPointsFileText) + kFooter);
}

}  // namespace

void AddPlotCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("plot", kText);
  auto const options = std::make_shared<Options>();
  AddOptions(command, options.get());
  command.OnParsed([options, action] {
    CompleteOutputFiles(&options->outputs);
    options->head = HeadOf(options->fields);
    TellContourFromPoints(options.get());
    RefuseSharedInput(*options);
    RefuseSharedFiles(options->Read(), options->outputs.Named());
    for (std::string const& path : options->outputs.paths) DrawingFormat(*options, path);
    *action = [options](Console const& console) { return Run(*options, console); };
  });
}

}  // namespace Vorn::Cli
