#include "cli/commands/SimplifyCommand.h"

#include <algorithm>
#include <limits>
#include <memory>
#include <ostream>

#include "cli/commands/Outputs.h"
#include "cli/commands/PointsInput.h"
#include "vorn/io/Files.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Thinning.h"

namespace Vorn::Cli {

namespace {

constexpr std::size_t kMostListed = 10;

constexpr char const* kText =
    "Leave measured points out so that a fit can work with the rest. What is kept stays as it is\n"
    "written, bit for bit, with header and comments.";

constexpr char const* kFooter =
    R"(
--drop-close keeps the first point, then always the next one that is more than 1.5 times the sum of
their tolerances away from the one kept before, and the last point; in a closed contour that does
not repeat its first point, the last one must be that far from the first as well. With --tolerance-per-point
tolerances follow the spacing, so that only points in one place are left out; so it is without any
tolerance.

What was dropped is said on standard error, points counted from 0. Exit codes:
  0   the points that are left are written; there may be nothing to drop
  2   wrong usage
  3   a file cannot be read or written, or a line of the points file is wrong
  4   fewer than two points would be left
  70  internal error
  130 interrupted

Examples:
  contour simplify part.csv --drop-close --tolerance 0.02 -o spaced.csv
  contour simplify part.csv --drop-close -t 0.02 | contour fit - -t 0.02
)";

struct Options {
  PointsInput points;
  ClosedChoice closed = ClosedChoice::Auto;
  bool dropClose = false;
  std::string output = kStandardInput;  // "-", which is standard output here
  std::string dropped;

  std::vector<NamedFile> Written() const {
    std::vector<NamedFile> files = {{"--output", output}};
    if (!dropped.empty()) files.push_back({"--dropped", dropped});
    return files;
  }
};

/// The rule that the options or the file state; gives the points their tolerances where these do
/// not follow the spacing.
TooClose RuleFor(ToleranceChoice const& choice, PointFile* file) {
  if (choice.cap) return RuleOfSpacing(*choice.cap);
  if (!IsToleranceStated(choice, *file)) {
    return RuleOfSpacing(std::numeric_limits<double>::infinity());
  }
  AssignTolerances(choice, file);
  return RuleOfTolerances();
}

std::vector<std::size_t> KeptPoints(Options const& options, PointFile* file) {
  TooClose const rule = RuleFor(options.points.tolerance, file);
  std::vector<std::size_t> kept = KeepSpaced(file->points, rule);
  Closure const closure = FindClosure(file->points, options.closed);
  if (closure.isClosed && !closure.repeatsFirst) DropCloseToFirst(file->points, rule, &kept);
  if (kept.size() < 2) {
    throw Failure(FailureKind::PointsTooClose,
                  file->path + ": fewer than two points would be left: all lie too close to " +
                      file->NameOf(0));
  }
  return kept;
}

std::string ListOfDropped(PointFile const& file, std::vector<std::size_t> const& dropped) {
  std::string text = "point,line,x,y\n";
  for (std::size_t const i : dropped) {
    text += std::to_string(i) + "," + std::to_string(file.lines[i]) + "," +
            FormatExact(file.points[i].x) + "," + FormatExact(file.points[i].y) + "\n";
  }
  return text;
}

std::string Message(PointFile const& file, std::vector<std::size_t> const& dropped) {
  std::string text = "contour: " + file.path + ": dropped " + std::to_string(dropped.size()) +
                     " of " + Counted(file.points.size(), "point");
  for (std::size_t i = 0; i < std::min(dropped.size(), kMostListed); ++i) {
    text += (i == 0 ? ": " : ", ") + file.NameOf(dropped[i]);
  }
  if (dropped.size() > kMostListed) {
    text += " and " + std::to_string(dropped.size() - kMostListed) + " more";
  }
  return text + "\n";
}

std::vector<std::size_t> LinesOf(PointFile const& file, std::vector<std::size_t> const& points) {
  std::vector<std::size_t> lines;
  lines.reserve(points.size());
  for (std::size_t const i : points) lines.push_back(file.lines[i]);
  return lines;
}

ExitCode Run(Options const& options, Console const& console) {
  RequireWritable(options.Written());
  PointsInput const& input = options.points;
  std::string const text = ReadTextFile(input.path, console.in);
  PointFile file = ParsePoints(text, input.path, ColumnFor(input.tolerance), input.columns);
  std::vector<std::size_t> const kept = KeptPoints(options, &file);
  std::vector<std::size_t> const dropped = Others(kept, file.points.size());
  Outputs outputs;
  outputs.Add(options.output, WithoutLines(text, LinesOf(file, dropped)));
  if (!options.dropped.empty()) outputs.Add(options.dropped, ListOfDropped(file, dropped));
  outputs.Write(console);
  console.err << Message(file, dropped);
  return ExitCode::Ok;
}

}  // namespace

void AddSimplifyCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("simplify", kText);
  auto const options = std::make_shared<Options>();
  AddPointsInput(command, &options->points);
  AddClosedChoice(command, &options->closed);
  command
      .AddFlag("--drop-close", &options->dropClose,
               "Leave out points that are too close to the one before")
      .Require();
  command.AddText(
      "-o,--output", &options->output, "FILE",
      "Write the points that are left to this file; - is the standard output (default)");
  command.AddText("--dropped", &options->dropped, "FILE",
                  "Write the points that are left out to this file");
  command.SetFooter(std::string(kPointsFileText) + kFooter);
  command.OnParsed([options, action] {
    RefuseSharedFiles({{"POINTS", options->points.path}}, options->Written());
    *action = [options](Console const& console) { return Run(*options, console); };
  });
}

}  // namespace Vorn::Cli
