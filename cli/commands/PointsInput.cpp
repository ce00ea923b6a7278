#include "cli/commands/PointsInput.h"

#include <CLI/CLI.hpp>

#include "cli/Numbers.h"
#include "cli/commands/CommonOptions.h"

namespace Vorn::Cli {

namespace {

/// The words of --columns.
CLI::Validator Columns() {
  return CLI::Validator(
      [](std::string& text) -> std::string {
        return ParseColumnChoice(text) ? ""
                                       : Quoted(text) + " is not two or three different columns";
      },
      "");
}

}  // namespace

char const* const kPointsFileText =
    R"(Points file: one point a line, x,y or x,y,w (w: the tolerance of the point), in the order of
the contour. The first line may be a header. Fields are separated by a comma, a semicolon, a
tab or blanks; decimal commas are read where the separator is none. What follows # or // is a
comment; "# tolerance T" and "# units mm" are read.
)";

CLI::Option* AddColumns(CLI::App& app, ColumnChoice* columns) {
  return app
      .add_option_function<std::string>(
          "--columns",
          [columns](std::string const& text) { *columns = ParseColumnChoice(text).value(); },
          "The columns that hold x, y and, if there is a third, the tolerance: names from the "
          "header or numbers counted from 1")
      ->check(Columns())
      ->type_name("X,Y[,W]");
}

void AddPointsInput(CLI::App& app, PointsInput* input) {
  app.add_option("POINTS", input->path,
                 "CSV file with the measured points; - is the standard input")
      ->required()
      ->type_name("FILE");
  AddPointsOptions(app, input);
}

void AddPointsOptions(CLI::App& app, PointsInput* input) {
  ToleranceChoice& choice = input->tolerance;
  CLI::Option* const same =
      AddPositiveNumber(app, "-t,--tolerance", &choice.same, "T",
                        "One tolerance for all points, in the units of the file");
  CLI::Option* const column =
      app.add_option("--tolerance-column", choice.column,
                     "Take each point's tolerance from the column of this name or number")
          ->type_name("NAME");
  CLI::Option* const cap = AddPositiveNumber(
      app, "--tolerance-per-point", &choice.cap, "CAP",
      "Give each point the smaller of CAP and 0.3 times the distance to its nearer neighbour");
  same->excludes(column)->excludes(cap);
  column->excludes(cap);
  AddColumns(app, &input->columns);
  app.add_option("--units", input->units,
                 "The units of the coordinates, for example mm; goes before what the file says")
      ->type_name("NAME");
}

void AddClosedChoice(CLI::App& app, ClosedChoice* choice) {
  AddChoice<ClosedChoice>(
      app, "--closed", choice,
      {{"auto", ClosedChoice::Auto}, {"yes", ClosedChoice::Yes}, {"no", ClosedChoice::No}},
      "Whether the contour runs back to its start; auto (default) judges by the ends as "
      "'contour fit' does");
}

PointFile ReadPointsInput(PointsInput const& input, Console const& console) {
  PointFile file = ReadPoints(input.path, console.in, ColumnFor(input.tolerance), input.columns);
  if (!input.units.empty()) file.units = input.units;
  return file;
}

}  // namespace Vorn::Cli
