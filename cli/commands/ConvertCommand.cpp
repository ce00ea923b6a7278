#include "cli/commands/ConvertCommand.h"

#include <algorithm>
#include <memory>
#include <ostream>
#include <utility>

#include "cli/commands/CommonOptions.h"
#include "cli/commands/ContourInput.h"
#include "cli/commands/ContourOutput.h"
#include "cli/commands/OutputFiles.h"
#include "vorn/io/Departure.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Outlines.h"

namespace Vorn::Cli {

namespace {

constexpr char const* kText =
    "Write a contour in another format: JSON, CSV, DXF, G-code, WKT, GeoJSON or SVG, or draw it as "
    "SVG,\n"
    "PNG or HTML.";

constexpr char const* kFooter =
    R"(
The ending of a file tells its format: .json, .csv, .dxf, .nc or .gcode, .wkt, .geojson, .svg (read:
its shapes; written: a drawing, or with --svg-plain the contour), and for drawings .png, .html. For
- and other names --from and --to say it; without --from the content tells.

What a format keeps:
  json   everything: doubles to the last bit, gaps, units, closed or not
  csv    the same, but for what follows from ends, centre and radius
  dxf    R12; one POLYLINE with bulges, or with --dxf-entities LINE and ARC; units in a comment.
         Arcs read back to 2e-15 of the largest coordinate or radius. --dxf-version r2000 writes
         LWPOLYLINE, $INSUNITS, and outlines that are holes on a layer CONTOUR_HOLES
  gcode  rounded; mm or inch. G1, G2 and G3 with incremental I and J or with R, G0 over gaps, M2
         or M30 at the end. Arcs are worked out from the rounded numbers, so that the radii at both
         ends agree within 0.002 mm
  wkt    LINESTRING, CIRCULARSTRING or COMPOUNDCURVE, a MULTICURVE over gaps; no units
  geojson  a Polygon with holes for closed outlines, a LineString for others; arcs as chords no
         further than --chords from them; coordinates are those of the contour, not of the globe
  svg    with --svg-plain a path of lines and true arcs for each outline, in mm or inch
Read are, beside these, polylines and shapes of SVG with their transforms, every ring of polygons,
and, where --flatten says how far chords may be from them, SPLINE and ELLIPSE of DXF and curves of
SVG. Drawings show the pieces, their joints and their order; they cannot be read back. With measured
points 'contour plot' draws the deviations as well.
DXF, G-code and WKT hold arcs of more than 315 degrees as two halves. Where pieces do not meet, the
gap is kept and reported. Pieces that meet are chained, whatever their order in the file (see
'contour area --help').

Every file that holds the contour is read back. Where it leaves the contour by more than the last
digits of doubles, the line that names it says how far, and with --tolerance whether that is too
far; the digits of G-code then follow from the tolerance.

Exit codes:
  0   the files are written
  1   a file leaves the contour by more than --tolerance (it is written)
  2   wrong usage, or the format cannot hold the contour
  3   a file cannot be read or written, or holds no contour
  70  internal error
  130 interrupted

Output files are written whole or not at all.

Examples:
  contour convert part.json -o part.dxf -o part.nc --feed 600
  contour convert part.dxf -o - --to csv
  contour convert part.nc -o part.svg
)";

/// Chords of GeoJSON take this part of what the contour may be left by, if nobody says.
constexpr double kChordsInTolerance = 0.5;

struct Options {
  std::string input;
  OutputFiles outputs;
  std::optional<Format> from;
  std::string units;
  std::optional<double> tolerance;
  std::optional<int> outline;
  std::optional<double> flattening;
  WriteOptions write;
};

/// "closed", "open", or how many outlines of each kind where one of several is closed.
std::string ClosureText(ContourFile const& contour) {
  std::vector<ContourFile> const outlines = OutlinesOf(contour);
  auto const closed = static_cast<std::size_t>(
      std::count_if(outlines.begin(), outlines.end(),
                    [](ContourFile const& outline) { return outline.isClosed; }));
  if (outlines.size() == 1 || closed == 0) return contour.isClosed ? "closed" : "open";
  std::size_t const open = outlines.size() - closed;
  return Counted(closed, "closed outline") +
         (open > 0 ? ", " + Counted(open, "open outline") : std::string());
}

std::string Summary(ContourFile const& contour) {
  auto const arcs =
      static_cast<std::size_t>(std::count_if(contour.pieces.begin(), contour.pieces.end(),
                                             [](Piece const& piece) { return piece.IsArc(); }));
  std::size_t const lines = contour.pieces.size() - arcs;
  return Counted(contour.pieces.size(), "piece") + ": " + Counted(lines, "line") + ", " +
         Counted(arcs, "arc") + "; " + ClosureText(contour);
}

/// A file with the contour, and how far it leaves it; nothing of a drawing.
struct Converted {
  std::string path;
  Format format = Format::Json;
  std::string text;
  std::optional<double> departure;
};

Converted ConvertTo(Options const& options, ContourFile const& contour, std::string const& path) {
  Format const format = OutputFormat(path, options.outputs.otherwise);
  if (!HoldsContour(format, options.write))
    return {path, format, Drawn(DrawingOf(contour), format), {}};
  Converted file = {path, format, ToText(contour, format, options.write), {}};
  file.departure = DepartureOf(contour.pieces, ParseContour(file.text, path, format).pieces);
  return file;
}

bool IsTooFar(Options const& options, Converted const& file) {
  // Written so that what is not a number is too far.
  return file.departure && options.tolerance && !(*file.departure <= *options.tolerance);
}

std::string LineFor(Options const& options, ContourFile const& contour, Converted const& file) {
  std::string const text = "wrote       " + Printable(file.path);
  if (!file.departure || *file.departure <= JointTolerance(contour.pieces)) return text + "\n";
  std::string const units = contour.units.empty() ? "" : " " + contour.units;
  return text + ", up to " + FormatShort(*file.departure, 2) + units + " from the contour" +
         (IsTooFar(options, file) ? ": TOO FAR" : "") + "\n";
}

void PrintSummary(Options const& options, ContourFile const& contour,
                  std::vector<Converted> const& files, Console const& console) {
  ReportGaps(contour, console);
  for (Converted const& file : files) {
    if (!IsTooFar(options, file)) continue;
    console.err << "contour: " << (file.path == "-" ? "the standard output" : file.path)
                << ": leaves the contour by " << FormatShort(*file.departure) << '\n';
  }
  if (options.outputs.TakeStandardOutput()) return;
  console.out << "pieces      " << Summary(contour) << '\n';
  for (Converted const& file : files) console.out << LineFor(options, contour, file);
}

ExitCode Run(Options const& options, Console const& console) {
  RequireWritable(options.outputs.Named());
  ContourFile contour =
      ReadContourInput({options.input, options.from, options.outline, options.flattening}, console);
  if (!options.units.empty()) contour.units = Printable(options.units);
  Outputs outputs;
  std::vector<Converted> files;
  for (std::string const& path : options.outputs.paths) {
    files.push_back(ConvertTo(options, contour, path));
    outputs.Add(path, files.back().text);
  }
  outputs.Write(console);
  auto const isGCode = [](Converted const& file) { return file.format == Format::GCode; };
  WarnOfMissingFeed(options.write, std::any_of(files.begin(), files.end(), isGCode), console);
  PrintSummary(options, contour, files, console);
  bool const isTooFar = std::any_of(files.begin(), files.end(),
                                    [&](Converted const& file) { return IsTooFar(options, file); });
  return isTooFar ? ExitCode::OutsideTolerance : ExitCode::Ok;
}

void AddOptions(Command& command, Options* options) {
  command
      .AddText("CONTOUR", &options->input, "FILE", "File with the contour; - is the standard input")
      .Require();
  AddOutputFiles(command, "contour",
                 {"json", "csv", "dxf", "gcode", "wkt", "geojson", "svg", "png", "html"},
                 &options->outputs);
  AddContourFormat(command, &options->from, "Read the input as this");
  command.AddText("--units", &options->units, "NAME",
                  "The units of the coordinates, for example mm; goes before what the file says");
  AddOutline(command, &options->outline);
  AddFlatten(command, &options->flattening);
  AddPositiveNumber(command, "-t,--tolerance", &options->tolerance, "T",
                    "How far a file may leave the contour; G-code gets the digits for it");
  AddWriteOptions(command, &options->write);
  command.SetFooter(kFooter);
}

}  // namespace

void AddConvertCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("convert", kText);
  auto const options = std::make_shared<Options>();
  AddOptions(command, options.get());
  command.OnParsed([options, action] {
    OutputFiles& outputs = options->outputs;
    CompleteOutputFiles(&outputs);
    RefuseSharedFiles({{"CONTOUR", options->input}}, outputs.Named());
    for (std::string const& path : outputs.paths) OutputFormat(path, outputs.otherwise);
    options->write.gcode.tolerance = options->tolerance;
    if (!options->write.chords && options->tolerance) {
      options->write.chords = kChordsInTolerance * *options->tolerance;
    }
    *action = [options](Console const& console) { return Run(*options, console); };
  });
}

}  // namespace Vorn::Cli
