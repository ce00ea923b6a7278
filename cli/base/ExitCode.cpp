#include "cli/base/ExitCode.h"

namespace Vorn::Cli {

ExitCode ExitCodeOf(FailureKind kind) {
  switch (kind) {
    case FailureKind::BadArgument:
      return ExitCode::Usage;
    case FailureKind::File:
      return ExitCode::File;
    case FailureKind::PointsTooClose:
      return ExitCode::PointsTooClose;
    case FailureKind::NoFit:
      return ExitCode::NoFit;
    case FailureKind::Internal:
      return ExitCode::Internal;
  }
  return ExitCode::Internal;
}

ExitCode ExitCodeOf(Verdict verdict) {
  switch (verdict) {
    case Verdict::WithinTolerance:
      return ExitCode::Ok;
    case Verdict::OutsideTolerance:
    case Verdict::NotClosed:
      return ExitCode::OutsideTolerance;
    case Verdict::StopsEarly:
      return ExitCode::NoFit;
  }
  return ExitCode::Internal;
}

}  // namespace Vorn::Cli
