#pragma once

#include "vorn/GeometryUtils.h"

namespace Vorn::Cells {

/// What one triangle adds to the centre of a cell.
struct TriangleCentre {
  explicit TriangleCentre(GeometryUtils::Triangle const& triangle);

  /// Without sign.
  double area;
  GeometryUtils::Point center;
};

/// Widens rect (min x, min y, max x, max y) to take in a triangle; only strict extremes replace
/// what stands there.
inline void ExtendRect(GeometryUtils::Triangle const& triangle, double* rect) {
  for (GeometryUtils::Point const& p : triangle.pts) {
    if (p.x < rect[0]) rect[0] = p.x;
    if (p.y < rect[1]) rect[1] = p.y;
    if (p.x > rect[2]) rect[2] = p.x;
    if (p.y > rect[3]) rect[3] = p.y;
  }
}

}  // namespace Vorn::Cells
