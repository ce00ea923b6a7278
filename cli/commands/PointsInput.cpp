#include "cli/commands/PointsInput.h"

#include "cli/commands/CommonOptions.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

char const* const kPointsFileText =
    R"(Points file: one point a line, x,y or x,y,w (w: the tolerance of the point), in the order of
the contour. A header tells the columns: x and y, x and z, y and z, names that instruments write
in English, German and French, with units in them. Where it does not tell, --columns must. Text
ahead of the table is skipped. Fields are separated by a comma, a semicolon, a
tab or blanks; decimal commas are read where the separator is none. What follows # or // is a
comment; "# tolerance T" and "# units mm" are read.
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
               "CSV file with the measured points; - is the standard input")
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
}

void AddClosedChoice(Command& command, ClosedChoice* choice) {
  AddChoice<ClosedChoice>(
      command, "--closed", choice,
      {{"auto", ClosedChoice::Auto}, {"yes", ClosedChoice::Yes}, {"no", ClosedChoice::No}},
      "Whether the contour runs back to its start; auto (default) judges by the ends as "
      "'contour fit' does");
}

PointFile ReadPointsInput(PointsInput const& input, Console const& console) {
  PointFile file = ReadPoints(input.path, console.in, ColumnFor(input.tolerance), input.columns);
  if (!input.units.empty()) file.units = Printable(input.units);
  return file;
}

}  // namespace Vorn::Cli
