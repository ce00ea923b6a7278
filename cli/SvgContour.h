#pragma once

#include <string>

#include "cli/Report.h"
#include "cli/SvgLayout.h"

namespace Vorn::Cli::Svg {

/// Whether the tolerance is wide enough on the page to be seen at all.
bool IsBandVisible(Report const& report, View const& view);

/// The path data of pieces one after another, a joined line as long as each starts where the one
/// before ends.
std::string PathData(std::vector<Piece> const& pieces, View const& view);

/// The upper part of the drawing: grid, band, points, pieces, joints and labels.
std::string ContourPlot(Report const& report, View const& view);

}  // namespace Vorn::Cli::Svg
