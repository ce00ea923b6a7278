#include "cli/commands/PointsInput.h"

#include <CLI/CLI.hpp>
#include <istream>
#include <iterator>

#include "cli/commands/CommonOptions.h"

namespace Vorn::Cli {

namespace {

PointFile ReadPath(PointsInput const& input, Console const& console) {
  ToleranceColumn const column = ColumnFor(input.tolerance);
  if (input.path != "-") return ReadPoints(input.path, column);
  std::string const text(std::istreambuf_iterator<char>(console.in), {});
  if (console.in.bad()) throw Failure(ExitCode::File, "standard input: cannot be read");
  return ParsePoints(text, kStandardInputName, column);
}

}  // namespace

char const* const kPointsFileText =
    R"(Points file: one point a line, x,y or x,y,w (w: the tolerance of the point), in the order of
the contour. The first line may be a header. Fields are separated by a comma, a semicolon, a
tab or blanks. Lines that begin with # are comments; "# tolerance T" and "# units mm" are read.
)";

void AddPointsInput(CLI::App& app, PointsInput* input) {
  app.add_option("POINTS", input->path,
                 "CSV file with the measured points; - is the standard input")
      ->required()
      ->type_name("FILE");
  ToleranceChoice& choice = input->tolerance;
  CLI::Option* const same =
      AddPositiveNumber(app, "-t,--tolerance", &choice.same, "T",
                        "One tolerance for all points, in the units of the file");
  CLI::Option* const column =
      app.add_option("--tolerance-column", choice.column,
                     "Take each point's tolerance from the column of this name")
          ->type_name("NAME");
  CLI::Option* const cap = AddPositiveNumber(
      app, "--tolerance-per-point", &choice.cap, "CAP",
      "Give each point the smaller of CAP and 0.3 times the distance to its nearer neighbour");
  same->excludes(column)->excludes(cap);
  column->excludes(cap);
  app.add_option("--units", input->units,
                 "The units of the coordinates, for example mm; goes before what the file says")
      ->type_name("NAME");
}

PointFile ReadPointsInput(PointsInput const& input, Console const& console) {
  PointFile file = ReadPath(input, console);
  if (!input.units.empty()) file.units = input.units;
  return file;
}

}  // namespace Vorn::Cli
