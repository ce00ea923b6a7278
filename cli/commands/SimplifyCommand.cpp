#include "cli/commands/SimplifyCommand.h"

#include <limits>
#include <memory>
#include <ostream>
#include <utility>

#include "cli/commands/CommonOptions.h"
#include "cli/commands/Outputs.h"
#include "cli/commands/PointsInput.h"
#include "cli/texts/ThinningText.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Files.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Thinning.h"

namespace Vorn::Cli {

namespace {

constexpr char const* kText =
    "Leave measured points out so that a fit can work with the rest. What is kept stays as it is\n"
    "written, bit for bit, with header and comments.";

constexpr char const* kFooter =
    R"(
At least one of --outliers, --spacing and --drop-close is needed; they work in this order.

--outliers K drops the points further than K standard deviations from where their neighbours have
them: from a parabola through four points before, four behind, or both, by which it is nearest, so
that corners stay. The standard deviation follows from the median of all these distances. With a
tolerance, points no further than it from where their neighbours have them stay as well. The first
and the last four points stay. The first 100 outliers are listed, all are in the file of --dropped.

--spacing S keeps the first point, then always the next one that is at least S along the path behind
the one kept before, and the last point. With --average it writes the mean of the points in windows
of S along the path instead, between the first and the last point, and says how the points scatter
across the path in each window. Where the path bends, its bend is part of that.

--drop-close keeps the first point, then always the next one that is more than 1.5 times the sum of
their tolerances away from the one kept before, and the last point; in a closed contour that does
not repeat its first point, the last one must be that far from the first as well. With
--tolerance-per-point tolerances follow the spacing, so that only points in one place are left out;
so it is without any tolerance.

With --outliers or --spacing and a tolerance, the rest is fitted and every point of the file, those
that were dropped as well, is measured against that contour. What was found and what was dropped is
said on standard error, points counted from 0. Points from drawings and tool paths, and means, are
written as a table of x and y. Exit codes:
  0   the points that are left are written; there may be nothing to drop
  2   wrong usage
  3   a file cannot be read or written, or a line of the points file is wrong
  4   fewer than two points would be left
  70  internal error
  130 interrupted

Examples:
  contour simplify part.csv --drop-close --tolerance 0.02 -o spaced.csv
  contour simplify part.csv --drop-close -t 0.02 | contour fit - -t 0.02 --strategy mixed
  contour simplify scan.csv --outliers 6 --spacing 0.5 --average -t 0.02 -o means.csv
)";

struct Options {
  PointsInput points;
  ClosedChoice closed = ClosedChoice::Auto;
  bool dropClose = false;
  bool doAverage = false;
  std::optional<double> spacing;
  std::optional<double> outliers;
  std::string output = kStandardInput;  // "-", which is standard output here
  std::string dropped;

  /// Whether points are taken away by their places, so that it is worth to know what a fit of the
  /// rest does to them.
  bool IsThinning() const { return spacing || outliers; }

  std::vector<NamedFile> Written() const {
    std::vector<NamedFile> files = {{"--output", output}};
    if (!dropped.empty()) files.push_back({"--dropped", dropped});
    return files;
  }
};

/// The points on their way through the steps: what the file holds, which of them are left, and the
/// points that are written, which may be means.
struct Thinned {
  PointFile file;
  std::vector<std::size_t> kept;
  std::vector<WPoint> points;
  std::string findings;  ///< for standard error
};

std::vector<WPoint> PointsAt(std::vector<std::size_t> const& kept, PointFile const& file) {
  std::vector<WPoint> points;
  points.reserve(kept.size());
  for (std::size_t const i : kept) points.push_back(file.points[i]);
  return points;
}

void Keep(std::vector<std::size_t> const& ofRest, Thinned* thinned) {
  std::vector<std::size_t> kept;
  std::vector<WPoint> points;
  for (std::size_t const i : ofRest) {
    kept.push_back(thinned->kept[i]);
    points.push_back(thinned->points[i]);
  }
  thinned->kept = std::move(kept);
  thinned->points = std::move(points);
}

/// The points of the file with the tolerances by which they are judged against a fit of the rest:
/// one that follows the spacing is no more than its cap for any of them.
std::optional<std::vector<WPoint>> JudgedPoints(Options const& options, PointFile file) {
  ToleranceChoice choice = options.points.tolerance;
  if (!IsToleranceStated(choice, file)) return {};
  if (choice.cap) choice = {choice.cap, {}, {}};
  AssignTolerances(choice, &file);
  return file.points;
}

/// A point that its neighbours bear out within its tolerance is none, however exact the others are.
void DropOutliers(Options const& options, Thinned* thinned) {
  std::vector<Outlier> outliers = FindOutliers(thinned->points, *options.outliers);
  if (auto const judged = JudgedPoints(options, thinned->file)) {
    std::erase_if(outliers, [&](Outlier const& outlier) {
      return outlier.distance <= (*judged)[outlier.point].w;
    });
  }
  thinned->findings += OutliersText(outliers, thinned->file);
  std::vector<std::size_t> dropped;
  dropped.reserve(outliers.size());
  for (Outlier const& outlier : outliers) dropped.push_back(outlier.point);
  Keep(Others(dropped, thinned->points.size()), thinned);
}

void Average(double window, Thinned* thinned) {
  Averages const averages = AverageAlong(thinned->points, window);
  thinned->points = averages.points;
  thinned->findings +=
      "contour: " + thinned->file.path + ": " + Counted(averages.points.size(), "point") +
      " stand for " + std::to_string(thinned->kept.size()) + ", " +
      std::to_string(averages.fewest) + " to " + std::to_string(averages.most) +
      " in a window; standard deviation across the path " + FormatShort(averages.meanDeviation, 3) +
      ", at most " + FormatShort(averages.largestDeviation, 3) + '\n';
}

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

void DropClose(Options const& options, Thinned* thinned) {
  PointFile rest = thinned->file;
  rest.points = thinned->points;
  TooClose const rule = RuleFor(options.points.tolerance, &rest);
  std::vector<std::size_t> kept = KeepSpaced(rest.points, rule);
  Closure const closure = FindClosure(rest.points, options.closed);
  if (closure.isClosed && !closure.repeatsFirst) DropCloseToFirst(rest.points, rule, &kept);
  if (kept.size() < 2) {
    throw Failure(FailureKind::PointsTooClose,
                  rest.path + ": fewer than two points would be left: all lie too close to " +
                      rest.NameOf(0));
  }
  if (options.doAverage) {
    std::vector<WPoint> points;
    points.reserve(kept.size());
    for (std::size_t const i : kept) points.push_back(thinned->points[i]);
    thinned->points = std::move(points);
  } else {
    Keep(kept, thinned);
  }
}

/// What a fit of the rest does to every point of the file; nothing without a tolerance.
std::string DescribeRest(Options const& options, Thinned const& thinned) {
  auto const judged = JudgedPoints(options, thinned.file);
  if (!options.IsThinning() || !judged) return "";
  std::string const begin = "contour: " + thinned.file.path + ": ";
  try {
    PointFile rest = thinned.file;
    rest.points = thinned.points;
    rest.lines.clear();
    FitChoice choice;
    choice.tolerance = options.points.tolerance;
    choice.closed = options.closed;
    FitReport const report = FitContour(std::move(rest), choice, nullptr);
    return begin + FitOfRestText(report, thinned.file, *judged) + '\n';
  } catch (Failure const& failure) {
    std::string const& message = failure.Message();
    return begin + "the rest cannot be fitted: " + message.substr(0, message.find('\n')) + '\n';
  }
}

std::vector<std::size_t> LinesOf(PointFile const& file, std::vector<std::size_t> const& points) {
  std::vector<std::size_t> lines;
  lines.reserve(points.size());
  for (std::size_t const i : points) lines.push_back(file.lines[i]);
  return lines;
}

/// The only outline of the file, or the one asked for.
PointFile TheOutline(PointsInput const& input, std::string const& text) {
  std::vector<PointFile> outlines =
      ChosenOutlines(input, ParsePointOutlines(text, input.path, ReadingOf(input)));
  RequireOneOutline(input, outlines.size());
  return std::move(outlines.front());
}

Thinned Thin(Options const& options, std::string const& text) {
  Thinned thinned;
  thinned.file = TheOutline(options.points, text);
  thinned.kept = Others({}, thinned.file.points.size());
  thinned.points = PointsAt(thinned.kept, thinned.file);
  if (options.outliers) DropOutliers(options, &thinned);
  if (options.doAverage) {
    Average(*options.spacing, &thinned);
  } else if (options.spacing) {
    Keep(KeepEvery(thinned.points, *options.spacing), &thinned);
  }
  if (options.dropClose) DropClose(options, &thinned);
  return thinned;
}

ExitCode Run(Options const& options, Console const& console) {
  RequireWritable(options.Written());
  std::string const text = ReadTextFile(options.points.path, console.in);
  Thinned const thinned = Thin(options, text);
  ReportDroppedHeights(thinned.file, console);
  PointFile const& file = thinned.file;
  std::vector<std::size_t> const dropped = Others(thinned.kept, file.points.size());
  bool const staysText = !file.lines.empty() && !options.doAverage;
  Outputs outputs;
  outputs.Add(options.output, staysText ? WithoutLines(text, LinesOf(file, dropped))
                                        : PointTable(file, thinned.points));
  if (!options.dropped.empty()) outputs.Add(options.dropped, DroppedList(file, dropped));
  outputs.Write(console);
  console.err << thinned.findings;
  if (!options.doAverage) console.err << DroppedText(file, dropped);
  console.err << DescribeRest(options, thinned);
  return ExitCode::Ok;
}

void AddOptions(Command& command, Options* options) {
  AddPointsInput(command, &options->points);
  AddPointsOutline(command, &options->points);
  AddClosedChoice(command, &options->closed);
  command.AddFlag(
      "--drop-close", &options->dropClose,
      "Leave out points that are too close to the one before for the strategies mixed and "
      "cells of 'contour fit'");
  Option const spacing = AddPositiveNumber(command, "--spacing", &options->spacing, "S",
                                           "Keep a point every S along the path");
  command
      .AddFlag("--average", &options->doAverage,
               "Write the means of the points in windows of --spacing along the path")
      .Need(spacing);
  AddPositiveNumber(command, "--outliers", &options->outliers, "K",
                    "Leave out points further than K standard deviations from where their "
                    "neighbours have them");
  command.AddOutput(
      "-o,--output", &options->output,
      "Write the points that are left to this file; - is the standard output (default)");
  command.AddOutput("--dropped", &options->dropped,
                    "Write the points that are left out to this file");
  command.SetFooter(std::string(kPointsFileText) + kFooter);
}

}  // namespace

void AddSimplifyCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("simplify", kText);
  auto const options = std::make_shared<Options>();
  AddOptions(command, options.get());
  command.OnParsed([options, action] {
    if (!options->IsThinning() && !options->dropClose) {
      throw Failure(FailureKind::BadArgument,
                    "one of --drop-close, --spacing and --outliers is required");
    }
    RefuseSharedFiles({{"POINTS", options->points.path}}, options->Written());
    *action = [options](Console const& console) { return Run(*options, console); };
  });
}

}  // namespace Vorn::Cli
