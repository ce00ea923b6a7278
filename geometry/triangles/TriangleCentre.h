// The centre of a single triangle.

#pragma once

#include "geometry/triangles/Triangle.h"

namespace Vorn::Triangles {

/// What one triangle adds to the centre of a cell.
struct TriangleCentre {
  /// The area, without sign.
  double area = 0.0;
  /// The inner point.
  Point centre;
};

/// An inner point of a triangle that stays well conditioned for slim ones: the crossing of the
/// medians of the two longer sides, which meet at the widest angle. Where the shortest side has no
/// length or the medians do not meet, the middle between the middles of the longer sides.
Point InnerPoint(Triangle const& triangle);

/// Area and inner point of a triangle.
TriangleCentre CentreOf(Triangle const& triangle);

}  // namespace Vorn::Triangles
