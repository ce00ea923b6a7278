#pragma once

#include <string>

#include "io/drawing/Scene.h"

namespace Vorn::IO::Svg {

/// The lower part of the drawing: the deviation of every point along the contour, positive to the
/// left of its sense of travel, as a length, or over its tolerance where tolerances differ.
std::string DeviationPlot(Scene const& scene, Rect const& frame);

}  // namespace Vorn::IO::Svg
