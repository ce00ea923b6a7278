#pragma once

#include <string>

#include "io/drawing/Scene.h"

namespace Vorn::IO::Svg {

/// The upper part of the drawing: grid, band, points, pieces, joints and labels.
std::string ContourPlot(Scene const& scene);

}  // namespace Vorn::IO::Svg
