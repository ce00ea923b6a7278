#pragma once

#include <string>

#include "io/drawing/Scene.h"

namespace Vorn::IO::Svg {

/// What the marks of the drawing mean, one row at this height of the page, and above the frame a
/// length to compare with.
std::string LegendRow(Scene const& scene, double y);

}  // namespace Vorn::IO::Svg
