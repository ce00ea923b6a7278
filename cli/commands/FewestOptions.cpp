#include "cli/commands/FewestOptions.h"

#include <cmath>
#include <numbers>

#include "cli/commands/CommonOptions.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr double kHalfTurn = 180.0;

double Radians(double degrees) { return degrees / kHalfTurn * std::numbers::pi; }

void AddLength(Command& command, std::string const& name, std::optional<double>* value,
               std::string const& valueName, std::string const& help) {
  auto const complaint = [](std::string const& text) -> std::string {
    std::optional<double> const length = ParseNumber(text);
    bool const isGood = length && std::isfinite(*length) && *length >= 0.0;
    return isGood ? "" : Quoted(text) + " is not a finite number of 0 or more";
  };
  auto const take = [value](std::string const& text) { *value = ParseNumber(text); };
  command.AddChecked(name, complaint, take, valueName, help);
}

void AddLargestStep(Command& command, FewestOptions* options) {
  auto const complaint = [](std::string const& text) -> std::string {
    std::optional<double> const degrees = ParseNumber(text);
    bool const isGood = degrees && *degrees > 0.0 && *degrees <= kHalfTurn;
    return isGood ? "" : Quoted(text) + " is not an angle above 0 and up to 180 degrees";
  };
  auto const take = [options](std::string const& text) {
    options->largestStep = ParseNumber(text);
  };
  command.AddChecked("--largest-step", complaint, take, "DEGREES",
                     "Fewest: the largest turn of an arc between neighbouring points; 60 if not "
                     "said. Points nearer than their tolerances count as one");
}

}  // namespace

void AddFewestOptions(Command& command, FewestOptions* options) {
  using Effort = FewestPieces::Effort;
  AddWord(
      command, "--effort", {"quick", "wide", "full"},
      [options](std::string const& word) {
        options->effort = word == "quick"  ? Effort::Quick
                          : word == "wide" ? Effort::Wide
                                           : Effort::Full;
      },
      "Fewest: how hard to look for fewer pieces. quick (default); wide: also where quick may "
      "lose some; full: everywhere, many times as long");
  AddLargestStep(command, options);
  AddLength(command, "--min-radius", &options->smallestRadius, "R",
            "Fewest: no arc has a smaller radius");
  AddPositiveNumber(command, "--max-radius", &options->largestRadius, "R",
                    "Fewest: what is flatter than this radius comes as a line");
  AddLength(command, "--between", &options->between, "D",
            "Fewest: no piece leaves the straight path between neighbouring points by more than D "
            "and their tolerances");
}

FewestPieces::Options Choice(FewestOptions const& options) {
  FewestPieces::Options choice;
  if (options.effort) choice.effort = *options.effort;
  if (options.largestStep) choice.largestStep = Radians(*options.largestStep);
  if (options.smallestRadius) choice.smallestRadius = *options.smallestRadius;
  if (options.largestRadius) choice.largestRadius = *options.largestRadius;
  if (options.between) choice.farthestBetweenPoints = *options.between;
  return choice;
}

void RefuseFewestOptions(FewestOptions const& options, std::string const& strategy) {
  auto const refuse = [&](bool isGiven, char const* name) {
    if (!isGiven) return;
    throw Failure(FailureKind::BadArgument,
                  std::string(name) + " is for --strategy fewest, not for " + strategy);
  };
  refuse(options.effort.has_value(), "--effort");
  refuse(options.largestStep.has_value(), "--largest-step");
  refuse(options.smallestRadius.has_value(), "--min-radius");
  refuse(options.largestRadius.has_value(), "--max-radius");
  refuse(options.between.has_value(), "--between");
}

void RefuseContradiction(FewestOptions const& options) {
  if (!options.smallestRadius || !options.largestRadius) return;
  if (*options.smallestRadius <= *options.largestRadius) return;
  throw Failure(FailureKind::BadArgument, "--min-radius is larger than --max-radius");
}

}  // namespace Vorn::Cli
