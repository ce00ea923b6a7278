#pragma once

#include <string>

#include "io/drawing/Scene.h"

namespace Vorn::IO::Svg {

/// The marks of the first and the last point of a contour or of the points alone.
inline constexpr double kStartSize = 11.0;
inline constexpr double kEndSize = 7.0;

/// A triangle where the contour starts and, if it is open, a square where it ends.
std::string ContourEnds(Scene const& scene);

/// The same of points without a contour.
std::string EndsOfPoints(Scene const& scene);

/// Small arrows to the right of the points' sense of travel: nothing joins the points themselves.
std::string DirectionArrows(Scene const& scene);

/// A triangle that points along `direction`.
std::string ArrowHead(Pixel const& tip, Pixel const& direction, double size,
                      std::string const& attributes);

}  // namespace Vorn::IO::Svg
