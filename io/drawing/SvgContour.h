#pragma once

#include <string>

#include "io/drawing/Scene.h"

namespace Vorn::IO::Svg {

/// The path data of a stretch of one piece, without the move to its start.
std::string StretchData(Piece const& piece, double from, double to, View const& view);

/// The path data of pieces one after another, a joined line as long as each starts where the one
/// before ends.
std::string PathData(std::vector<Piece> const& pieces, View const& view);

/// The upper part of the drawing: grid, band, points, pieces, joints and labels.
std::string ContourPlot(Scene const& scene);

/// A triangle that points along `direction`.
std::string ArrowHead(Pixel const& tip, Pixel const& direction, double size,
                      std::string const& attributes);

/// The marks of the first and the last point of a contour or of the points alone.
inline constexpr double kStartSize = 11.0;
inline constexpr double kEndSize = 7.0;

}  // namespace Vorn::IO::Svg
