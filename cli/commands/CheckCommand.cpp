#include "cli/commands/CheckCommand.h"

#include <memory>
#include <numeric>
#include <ostream>
#include <utility>

#include "cli/commands/CommonOptions.h"
#include "cli/commands/ContourInput.h"
#include "cli/commands/Outputs.h"
#include "cli/commands/PointsInput.h"
#include "cli/texts/CheckText.h"
#include "vorn/io/CheckReport.h"
#include "vorn/io/Files.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::Cli {

namespace {

constexpr std::size_t kWorstRows = 10;

constexpr char const* kText =
    "Measure points against a contour from a file: how far each lies from the nearest piece, "
    "whether\n"
    "that is within its tolerance, whether the pieces meet, and whether they cross.";

constexpr char const* kFooter =
    R"(
The contour is read from JSON, CSV, DXF, G-code, WKT, GeoJSON or SVG, told by the ending of the
name, by --from or by the content. Every point is measured against every piece as drawn, clipped at
its ends. A relative deviation counts as within tolerance up to 1 + 1e-6, for rounding. Without any
tolerance deviations are lengths, and none is judged. A last table tells for each piece the line or
circle of least squares through its points, with form error and standard deviations, as 'contour
fit' does.

Deviations to the left of the contour's sense of travel are positive in the tables. Points are
counted from 0, pieces from 1. Pieces cross where two of them that are not neighbours have a point
in common. Gaps are no pieces; for the area they are bridged by straight lines.

Exit codes:
  0   every point is within its tolerance, or none is given
  1   a point is outside its tolerance
  2   wrong usage
  3   a file cannot be read or written, or a line of it is wrong
  4   a tolerance by spacing was asked for, but neighbours coincide
  70  internal error
  130 interrupted

Examples:
  contour check part.csv part.dxf --tolerance 0.02
  contour check part.csv part.nc --tolerance 0.02 --table deviations.csv
  contour check part.csv part.json --tolerance 0.02 --json - | jq .relative
)";

struct Options {
  PointsInput points;
  ClosedChoice closed = ClosedChoice::Auto;
  std::string contour;
  std::optional<Format> from;
  std::optional<int> outline;
  std::string table;
  std::string json;
  bool all = false;

  std::vector<NamedFile> Written() const {
    std::vector<NamedFile> files;
    if (!table.empty()) files.push_back({"--table", table});
    if (!json.empty()) files.push_back({"--json", json});
    return files;
  }
};

void WarnOfUnits(CheckReport const& report, Console const& console) {
  std::string const& ofPoints = report.file.units;
  std::string const& ofContour = report.contour.units;
  bool const differ =
      !ofPoints.empty() && !ofContour.empty() && LowerCase(ofPoints) != LowerCase(ofContour);
  if (!differ) return;
  console.err << "contour: the points are in " << ofPoints << ", the contour in " << ofContour
              << ": nothing is converted\n";
}

std::string TextFor(Options const& options, CheckReport const& report) {
  if (!options.all) return ToText(report, report.WorstFirst(), kWorstRows);
  std::vector<std::size_t> order(report.deviations.size());
  std::iota(order.begin(), order.end(), std::size_t{0});
  return ToText(report, order, order.size());
}

ExitCode Run(Options const& options, Console const& console) {
  RequireWritable(options.Written());
  PointFile file = ReadAllPointsInput(options.points, console);
  ContourFile contour = ReadContourInput(
      {options.contour, options.from, options.outline, options.points.flattening}, console);
  std::string source;
  if (IsToleranceStated(options.points.tolerance, file)) {
    bool const isClosed = FindClosure(file.points, options.closed).isClosed;
    source = AssignTolerances(options.points.tolerance, &file, isClosed);
  }
  CheckReport const report =
      MakeCheckReport(std::move(file), std::move(source), std::move(contour));
  WarnOfUnits(report, console);
  Outputs outputs;
  if (!options.table.empty()) outputs.Add(options.table, ToCsv(report));
  if (!options.json.empty()) outputs.Add(options.json, ToJson(report));
  outputs.Write(console);
  bool const isOutTaken = options.table == "-" || options.json == "-";
  if (!isOutTaken) console.out << TextFor(options, report);
  return report.outside.empty() ? ExitCode::Ok : ExitCode::OutsideTolerance;
}

void AddOptions(Command& command, Options* options) {
  AddPointsInput(command, &options->points);
  command
      .AddText("CONTOUR", &options->contour, "FILE",
               "File with the contour; - is the standard input")
      .Require();
  AddClosedChoice(command, &options->closed);
  AddContourFormat(command, &options->from, "Read the contour as this");
  AddOutline(command, &options->outline);
  command.AddOutput(
      "--table", &options->table,
      "Write every point's deviation to this CSV file; - is the standard output, which "
      "then holds nothing else");
  command.AddOutput("--json", &options->json,
                    "Write all that is found to this JSON file, with all digits; - is the standard "
                    "output, which then holds nothing else");
  command.AddFlag("--all", &options->all, "List every point, not just the ten worst");
  command.SetFooter(std::string(kPointsFileText) + kFooter);
}

void RefuseBadFiles(Options const& options) {
  if (options.points.path == kStandardInput && options.contour == kStandardInput) {
    throw Failure(FailureKind::BadArgument, "POINTS and CONTOUR cannot both be the standard input");
  }
  RefuseSharedFiles({{"POINTS", options.points.path}, {"CONTOUR", options.contour}},
                    options.Written());
}

}  // namespace

void AddCheckCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("check", kText);
  auto const options = std::make_shared<Options>();
  AddOptions(command, options.get());
  command.OnParsed([options, action] {
    RefuseBadFiles(*options);
    *action = [options](Console const& console) { return Run(*options, console); };
  });
}

}  // namespace Vorn::Cli
