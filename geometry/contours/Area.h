// The signed area of a contour of segments and arcs.

#pragma once

#include <optional>

#include "geometry/contours/Elements.h"

namespace Vorn::Contours {

/// The area of a contour that has a first element: positive when it runs clockwise with y up.
/// Nothing when an element is of an unknown kind. An open contour is not closed.
std::optional<double> SignedArea(Contour const& contour);

}  // namespace Vorn::Contours
