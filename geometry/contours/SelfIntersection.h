// Whether a contour of segments and arcs crosses or touches itself.

#pragma once

#include <cstddef>

#include "geometry/contours/Elements.h"

namespace Vorn::Contours {

/// Where the search for near pairs begins to pay, as measured on rings, teeth and needles.
inline constexpr std::size_t kPlainSize = 32;

/// The answer of GeometryUtils::CheckPolySelfIntersection. Up to plainSize elements all pairs are
/// compared, O(n^2) without storage; beyond it only those that come near each other. The answer is
/// the same.
ErrorCode CheckContour(Contour const& contour, std::size_t plainSize);

}  // namespace Vorn::Contours
