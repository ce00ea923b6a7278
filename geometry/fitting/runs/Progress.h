// What a fit tells its caller about how far it has come.

#pragma once

#include <cstdint>

#include "vorn/GeometryUtils.h"

namespace Vorn::Fitting {

/// Tells the caller's sink how many points are done, as a percentage: the final one minus the share
/// of the points still open, truncated towards zero. Does nothing without a sink or points.
void ReportProgress(GeometryUtils::ProgressBase const& progress, std::int32_t current);

}  // namespace Vorn::Fitting
