#pragma once

#include "cli/base/Library.h"
#include "vorn/io/Failure.h"
#include "vorn/io/FitReport.h"

namespace Vorn::Cli {

/// How the program ends. Scripts rely on the numbers.
enum class ExitCode : int {
  Ok = 0,
  OutsideTolerance = 1,
  Usage = 2,
  File = 3,
  PointsTooClose = 4,
  NoFit = 5,
  Internal = 70,
  Interrupted = 130,
};

/// The exit code that goes with a failure.
ExitCode ExitCodeOf(FailureKind kind);

/// The exit code that goes with a fitted contour.
ExitCode ExitCodeOf(Verdict verdict);

}  // namespace Vorn::Cli
