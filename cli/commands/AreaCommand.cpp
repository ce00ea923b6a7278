#include "cli/commands/AreaCommand.h"

#include <algorithm>
#include <memory>
#include <ostream>
#include <utility>

#include "cli/commands/CommonOptions.h"
#include "cli/commands/ContourInput.h"
#include "cli/commands/PointsInput.h"
#include "cli/texts/AreaText.h"
#include "vorn/io/ContourArea.h"
#include "vorn/io/Files.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Points.h"

namespace Vorn::Cli {

namespace {

constexpr char const* kText = "Measure closed contours: area, sense, perimeter, centroid and box.";

constexpr char const* kFooter =
    R"(
Contours are read from JSON, CSV, DXF, G-code, WKT, GeoJSON or SVG, told by the name, by --from or
by the content. With --points the files hold measured points instead, and the contour is the
polygon through them, closed from the last point to the first.

A file may hold several outlines: its pieces are chained by their ends, in any order and sense,
where these are no further apart than 1e-6 of the size of the drawing. Each outline is measured;
one that lies in another is a hole, and the area of all has the holes taken off.

The area is that of lines and true arcs. Where neighbouring pieces do not meet, a straight line
bridges the gap, and the gap is listed. Where a contour crosses or touches itself, the area is the
sum of its loops, each positive where it runs counter-clockwise, and there is no centroid.

Exit codes:
  0   every contour is measured
  2   wrong usage, or a contour is open and --close is not given
  3   a file cannot be read, or holds no contour
  70  internal error
  130 interrupted

Examples:
  contour area part.json
  contour area part.dxf part.nc --json
  contour area part.csv --points
)";

struct Options {
  std::vector<std::string> paths;
  std::optional<Format> from;
  bool arePoints = false;
  ColumnChoice columns;
  std::string units;
  std::optional<int> outline;
  std::optional<double> flattening;
  bool doClose = false;
  bool asJson = false;
};

ContourFile PolygonThrough(PointFile const& file) {
  ContourFile contour;
  contour.path = file.path;
  contour.units = file.units;
  for (std::size_t i = 1; i < file.points.size(); ++i) {
    WPoint const& from = file.points[i - 1];
    WPoint const& to = file.points[i];
    contour.pieces.push_back(MakeLine({from.x, from.y}, {to.x, to.y}));
  }
  return Closed(std::move(contour));
}

void RefuseOpen(ContourFile const& contour) {
  double const gap = Distance(contour.pieces.back().end, contour.pieces.front().start);
  throw Failure(FailureKind::BadArgument,
                contour.path + ": the contour is open, its ends are " + FormatShort(gap) +
                    " apart; --close measures it with a line between them");
}

std::vector<ContourFile> ReadClosed(Options const& options, std::string const& path,
                                    Console const& console) {
  if (options.arePoints) {
    PointFile const file =
        ReadPoints(path, console.in, {ToleranceColumn::Use::Ignore, ""}, options.columns);
    ReportSkippedLines(file, console);
    return {PolygonThrough(file)};
  }
  std::vector<ContourFile> outlines =
      ReadOutlines({path, options.from, options.outline, options.flattening}, console);
  for (ContourFile& outline : outlines) {
    if (options.doClose) {
      outline = Closed(std::move(outline));
    } else if (!IsClosed(outline)) {
      RefuseOpen(outline);
    }
  }
  return outlines;
}

void Print(std::vector<ContourArea> const& areas, bool isFirst, Console const& console) {
  for (ContourArea const& area : areas) {
    console.out << (isFirst && &area == &areas.front() ? "" : "\n") << ToText(area);
  }
  if (areas.size() > 1) console.out << "\n" << NetText(areas);
}

ExitCode Run(Options const& options, Console const& console) {
  std::vector<ContourArea> all;
  for (std::string const& path : options.paths) {
    std::vector<ContourFile> outlines = ReadClosed(options, path, console);
    for (ContourFile& outline : outlines) {
      if (!options.units.empty()) outline.units = Printable(options.units);
    }
    std::vector<ContourArea> const areas = MeasureOutlines(std::move(outlines));
    if (!options.asJson) Print(areas, all.empty(), console);
    all.insert(all.end(), areas.begin(), areas.end());
  }
  if (options.asJson) console.out << ToJson(all);
  return ExitCode::Ok;
}

void AddOptions(Command& command, Options* options) {
  command
      .AddTexts("CONTOUR", &options->paths, "FILE", "Files with contours; - is the standard input")
      .Require();
  Option const from = AddContourFormat(command, &options->from, "Read the contours as this");
  Option const points = command
                            .AddFlag("--points", &options->arePoints,
                                     "The files hold points; measure the polygon through them")
                            .Exclude(from);
  AddColumns(command, &options->columns).Need(points);
  command.AddText("--units", &options->units, "NAME",
                  "The units of the coordinates, for example mm; goes before what the file says");
  AddOutline(command, &options->outline);
  AddFlatten(command, &options->flattening);
  command.AddFlag("--close", &options->doClose,
                  "Close an open contour with a line from its end to its start");
  command.AddFlag("--json", &options->asJson, "Write the measures as JSON, with every digit");
  command.SetFooter(kFooter);
}

void RefuseSharedInput(std::vector<std::string> const& paths) {
  if (std::count(paths.begin(), paths.end(), kStandardInput) > 1) {
    throw Failure(FailureKind::BadArgument, "the standard input can be read only once");
  }
}

}  // namespace

void AddAreaCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("area", kText);
  auto const options = std::make_shared<Options>();
  AddOptions(command, options.get());
  command.OnParsed([options, action] {
    RefuseSharedInput(options->paths);
    *action = [options](Console const& console) { return Run(*options, console); };
  });
}

}  // namespace Vorn::Cli
