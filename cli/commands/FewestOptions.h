#pragma once

#include <optional>
#include <string>

#include "cli/commands/CommandLine.h"
#include "vorn/FewestPieces.h"

/// The options of 'contour fit --strategy fewest'.
namespace Vorn::Cli {

/// What the command line says; what is not said is left to the service.
struct FewestOptions {
  std::optional<FewestPieces::Effort> effort;
  std::optional<double> largestStep;     ///< degrees
  std::optional<double> smallestRadius;  ///< this and the following in the units of the file
  std::optional<double> largestRadius;
  std::optional<double> between;
};

/// Adds the options to a command; they fill in `options` when its words are read.
void AddFewestOptions(Command& command, FewestOptions* options);

/// The options as the service takes them.
FewestPieces::Options Choice(FewestOptions const& options);

/// @throws Failure (FailureKind::BadArgument) when one is given though the strategy is another.
void RefuseFewestOptions(FewestOptions const& options, std::string const& strategy);

/// @throws Failure (FailureKind::BadArgument) when no radius is left.
void RefuseContradiction(FewestOptions const& options);

}  // namespace Vorn::Cli
