#include "geometry/triangles/Triangle.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace Vorn::Triangles {

namespace {

/// The interval that three values span; without bounds when one of them is not a number.
void Span(double v0, double v1, double v2, double* low, double* high) {
  *low = std::min({v0, v1, v2});
  *high = std::max({v0, v1, v2});
  if (std::isnan(v0) || std::isnan(v1) || std::isnan(v2)) {
    *low = -std::numeric_limits<double>::infinity();
    *high = std::numeric_limits<double>::infinity();
  }
}

}  // namespace

Box BoxOf(Triangle const& triangle) {
  Point const* const pts = triangle.pts;
  Box box{};
  Span(pts[0].x, pts[1].x, pts[2].x, &box.xMin, &box.xMax);
  Span(pts[0].y, pts[1].y, pts[2].y, &box.yMin, &box.yMax);
  return box;
}

}  // namespace Vorn::Triangles
