#pragma once

#include <optional>
#include <string>

#include "cli/Tolerances.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Cli {

/// What the user asked for.
struct Options {
  std::string points;
  ToleranceChoice tolerance;
  GeometryUtils::FittingStrategy strategy = GeometryUtils::FittingStrategy::Mixed;
  std::optional<std::string> json;
  std::optional<std::string> svg;
};

/// Reads the command line. Nothing when it only asked for help or the version, which then stands
/// in `*message`.
/// @throws Failure (ExitCode::Usage) when it is not understood or contradicts itself.
std::optional<Options> ParseCommandLine(int argc, char const* const* argv, std::string* message);

}  // namespace Vorn::Cli
