#include "geometry/fitting/runs/Progress.h"

namespace Vorn {

void Fitting::ReportProgress(GeometryUtils::ProgressBase const& progress, std::int32_t current) {
  if (progress.state == nullptr || progress.total < 1) return;
  std::int64_t percent = progress.maxPercent;
  std::int64_t const left = static_cast<std::int64_t>(progress.total) - current;
  if (left > 0) percent -= left * 100 / progress.total;
  // Never 0: a host takes 0 for "not started".
  if (percent == 0) percent = 1;
  progress.state->SetProgress(static_cast<std::int32_t>(percent));
}

}  // namespace Vorn
