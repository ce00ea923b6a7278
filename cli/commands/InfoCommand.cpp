#include "cli/commands/InfoCommand.h"

#include <memory>
#include <ostream>

#include "cli/commands/PointsInput.h"
#include "cli/texts/InfoText.h"
#include "vorn/io/InfoReport.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::Cli {

namespace {

constexpr char const* kText =
    "Tell what there is to know about measured points before a fit: number, extent, spacing,\n"
    "duplicates, corners, noise, and the tolerances that they allow.";

constexpr char const* kFooter =
    R"(
Spacing: for the strategies mixed and cells of 'contour fit', neighbouring points must be more than
1.5 times the sum of their tolerances apart; fewest, which is used when none is named, takes any
spacing. With a tolerance given, the pairs that break this rule are listed; without one, none is
needed.

Corners: turns of 30 degrees or more, measured over chords long enough for the noise not to matter;
of a closed contour the turn from its end to its start is one of them.
Noise: what differs from point to point, not a ripple that many neighbours share. The suggestion is
five times the noise or a ten-thousandth of the size, whichever is more, and tells where the
spacing allows mixed and cells no such tolerance.

Points are counted from 0. Exit codes:
  0   the points are described, whatever there is to say about them
  2   wrong usage
  3   the file cannot be read, or one of its lines is wrong
  70  internal error
  130 interrupted

Examples:
  contour info part.csv
  contour info part.csv --tolerance 0.02
  contour info part.csv --json | jq .noise
)";

struct Options {
  PointsInput points;
  ClosedChoice closed = ClosedChoice::Auto;
  bool asJson = false;
};

ExitCode Run(Options const& options, Console const& console) {
  InfoReport report;
  report.file = ReadPointsInput(options.points, console);
  report.info = Analyse(report.file.points, options.closed);
  if (IsToleranceStated(options.points.tolerance, report.file)) {
    Closure const& closure = report.info.closure;
    std::string source = AssignTolerances(options.points.tolerance, &report.file, closure.isClosed,
                                          Coinciding::GivenZero);
    report.rule = CheckRule(report.file.points, closure, std::move(source));
  }
  console.out << (options.asJson ? ToJson(report) : ToText(report));
  return ExitCode::Ok;
}

}  // namespace

void AddInfoCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("info", kText);
  auto const options = std::make_shared<Options>();
  AddPointsInput(command, &options->points);
  AddPointsOutline(command, &options->points);
  AddClosedChoice(command, &options->closed);
  command.AddFlag("--json", &options->asJson, "Write the facts as JSON, long lists whole");
  command.SetFooter(std::string(kPointsFileText) + kFooter);
  command.OnParsed([options, action] {
    *action = [options](Console const& console) { return Run(*options, console); };
  });
}

}  // namespace Vorn::Cli
