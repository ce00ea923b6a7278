#pragma once

#include <string>

#include "io/drawing/Scene.h"

namespace Vorn::IO::Svg {

/// The tolerance on both sides of the contour, or without one a disc about each point; nothing
/// where it is too narrow to be seen.
std::string ToleranceBand(Scene const& scene);

}  // namespace Vorn::IO::Svg
