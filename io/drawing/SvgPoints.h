#pragma once

#include <string>

#include "io/drawing/Scene.h"

namespace Vorn::IO::Svg {

/// Thin lines from the contour to the magnified points, on each side of a place the longest.
std::string Whiskers(Scene const& scene);

/// Dots for the points on lines, squares for those on arcs; without those outside.
std::string MeasuredPoints(Scene const& scene);

/// Crosses.
std::string OutsidePoints(Scene const& scene);

/// A ring about the point with the largest deviation; nothing if nothing was measured.
std::string WorstPoint(Scene const& scene);

}  // namespace Vorn::IO::Svg
