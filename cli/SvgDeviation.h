#pragma once

#include <string>

#include "cli/Report.h"
#include "cli/SvgLayout.h"

namespace Vorn::Cli::Svg {

/// The lower part of the drawing: the re-measured deviation of every point over its tolerance,
/// positive to the left of the contour's sense of travel.
std::string DeviationPlot(Report const& report, Rect const& frame);

}  // namespace Vorn::Cli::Svg
