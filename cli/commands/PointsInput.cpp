#include "cli/commands/PointsInput.h"

#include <ostream>
#include <utility>

#include "cli/commands/CommonOptions.h"
#include "cli/commands/ContourInput.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

char const* const kPointsFileText =
    R"(Points file: one point a line, x,y or x,y,w (w: the tolerance of the point), in the order of
the contour. A header tells the columns: x and y, x and z, y and z, names that instruments write
in English, German and French, with units in them. Where it does not tell, --columns must. Text
ahead of the table and a footer behind it are skipped. Fields are separated by a comma, a
semicolon, a tab or blanks; decimal commas are read where the separator is none. What follows # or
// is a comment; "# tolerance T" and "# units mm" are read.

Points are taken from drawings and tool paths as well: the vertices of polylines and lines in DXF
(.dxf), G-code (.nc, .gcode), WKT (.wkt), GeoJSON (.geojson, .json) and SVG (.svg). Lines are
chained by their ends; several outlines are several contours. Arcs and curves are refused unless
--flatten says how far chords may be from them. SVG is turned up, and true to a page in mm, cm or
in.
)";

Option AddColumns(Command& command, ColumnChoice* columns) {
  auto const complaint = [](std::string const& text) -> std::string {
    return ParseColumnChoice(text) ? "" : Quoted(text) + " is not two or three different columns";
  };
  auto const take = [columns](std::string const& text) {
    *columns = ParseColumnChoice(text).value();
  };
  return command.AddChecked("--columns", complaint, take, "X,Y[,W]",
                            "The columns that hold x, y and, if there is a third, the tolerance: "
                            "names from the header or "
                            "numbers counted from 1");
}

void AddPointsInput(Command& command, PointsInput* input) {
  command
      .AddText("POINTS", &input->path, "FILE",
               "File with the measured points, a CSV table or else a drawing or tool path; - is "
               "the standard input")
      .Require();
  AddPointsOptions(command, input);
}

void AddPointsOptions(Command& command, PointsInput* input) {
  ToleranceChoice& choice = input->tolerance;
  Option const same = AddPositiveNumber(command, "-t,--tolerance", &choice.same, "T",
                                        "One tolerance for all points, in the units of the file");
  Option const column =
      command.AddText("--tolerance-column", &choice.column, "NAME",
                      "Take each point's tolerance from the column of this name or number");
  Option const cap = AddPositiveNumber(
      command, "--tolerance-per-point", &choice.cap, "CAP",
      "Give each point the smaller of CAP and 0.3 times the distance to its nearer neighbour");
  same.Exclude(column).Exclude(cap);
  column.Exclude(cap);
  AddColumns(command, &input->columns);
  command.AddText("--units", &input->units, "NAME",
                  "The units of the coordinates, for example mm; goes before what the file says");
  AddFormat(command, "--points-from", {"csv", "dxf", "gcode", "wkt", "geojson", "svg", "json"},
            &input->from,
            "Read the points from this: csv is a table; if not said, the ending of the file tells, "
            "or its content");
  AddPositiveNumber(
      command, "--flatten", &input->flattening, "T",
      "Take points from arcs and curves as well: the ends of chords no further than T "
      "from them");
}

void AddPointsOutline(Command& command, PointsInput* input) {
  AddOutline(command, &input->outline);
}

void AddClosedChoice(Command& command, ClosedChoice* choice) {
  AddChoice<ClosedChoice>(
      command, "--closed", choice,
      {{"auto", ClosedChoice::Auto}, {"yes", ClosedChoice::Yes}, {"no", ClosedChoice::No}},
      "Whether the contour runs back to its start; auto (default) judges by the ends as "
      "'contour fit' does");
}

PointReading ReadingOf(PointsInput const& input) {
  return {ColumnFor(input.tolerance), input.columns, input.from, input.flattening};
}

std::vector<PointFile> ChosenOutlines(PointsInput const& input, std::vector<PointFile> outlines) {
  if (input.outline) {
    auto const index = static_cast<std::size_t>(*input.outline) - 1;
    if (index >= outlines.size()) {
      throw Failure(FailureKind::BadArgument, {InputName(input.path)},
                    "there is no outline " + std::to_string(*input.outline) + ", the file has " +
                        Counted(outlines.size(), "outline"));
    }
    outlines = {std::move(outlines[index])};
  }
  if (!input.units.empty()) {
    for (PointFile& outline : outlines) outline.units = Printable(input.units);
  }
  return outlines;
}

std::vector<PointFile> ReadPointOutlinesInput(PointsInput const& input, Console const& console) {
  return ChosenOutlines(input, ReadPointOutlines(input.path, console.in, ReadingOf(input)));
}

std::string DroppedHeightsText(PointFile const& outline) {
  if (!outline.hadHeights) return "";
  return outline.path.substr(0, outline.path.size() - OutlineSuffix(outline.outline).size()) +
         ": dropped the coordinates beside x and y";
}

void ReportDroppedHeights(PointFile const& outline, Console const& console) {
  std::string const text = DroppedHeightsText(outline);
  if (!text.empty()) console.err << "contour: " << text << '\n';
}

std::string SkippedLinesText(PointFile const& file) {
  return file.skipped.empty() ? "" : file.path + ": skipped " + file.skipped;
}

void ReportSkippedLines(PointFile const& file, Console const& console) {
  std::string const text = SkippedLinesText(file);
  if (!text.empty()) console.err << "contour: " << text << '\n';
}

void RequireOneOutline(PointsInput const& input, std::size_t count) {
  if (count < 2) return;
  throw Failure(FailureKind::BadArgument, {InputName(input.path)},
                "holds " + Counted(count, "outline") + ": --outline N takes one of them");
}

PointFile ReadPointsInput(PointsInput const& input, Console const& console) {
  std::vector<PointFile> outlines = ReadPointOutlinesInput(input, console);
  RequireOneOutline(input, outlines.size());
  ReportDroppedHeights(outlines.front(), console);
  return std::move(outlines.front());
}

PointFile ReadAllPointsInput(PointsInput const& input, Console const& console) {
  std::vector<PointFile> outlines = ReadPointOutlinesInput(input, console);
  ReportDroppedHeights(outlines.front(), console);
  return outlines.size() == 1 ? std::move(outlines.front()) : Joined(outlines);
}

}  // namespace Vorn::Cli
