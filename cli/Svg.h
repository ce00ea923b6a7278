#pragma once

#include <string>

#include "cli/Report.h"

namespace Vorn::Cli {

/// The report as a drawing: the contour with its pieces by kind, joints, measured points and
/// tolerance band, true to scale, and below it the deviation of every point as a multiple of its
/// tolerance, where the eye sees what the upper part is too small to show.
std::string ToSvg(Report const& report);

}  // namespace Vorn::Cli
