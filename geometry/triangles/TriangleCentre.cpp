#include "geometry/triangles/TriangleCentre.h"

#include <cmath>

#include "geometry/intersections/SegmentPair.h"
#include "math/NumericConstants.h"

namespace Vorn::Triangles {

namespace {

using Elementary::Middle;

/// From the middle of side i to the vertex across.
Segment MedianOf(Triangle const& triangle, int i) {
  return {Middle(triangle.pts[i], triangle.pts[(i + 1) % 3]), triangle.pts[(i + 2) % 3]};
}

}  // namespace

Point InnerPoint(Triangle const& triangle) {
  Point const* const pts = triangle.pts;
  double const length2[3] = {Elementary::SquaredDistance(pts[1], pts[0]),
                             Elementary::SquaredDistance(pts[2], pts[1]),
                             Elementary::SquaredDistance(pts[0], pts[2])};
  int shortest = 0;
  if (length2[1] < length2[shortest]) shortest = 1;
  if (length2[2] < length2[shortest]) shortest = 2;
  Segment const medianA = MedianOf(triangle, shortest == 0 ? 1 : 0);
  Segment const medianB = MedianOf(triangle, shortest == 2 ? 1 : 2);
  if (length2[shortest] > Numeric::kZero) {
    Point crossing;
    SegmentsRelPosition const relation =
        Intersections::IntersectSegments({medianA, medianB}, &crossing);
    if (relation == SegmentsRelPosition::Collinear ||
        relation == SegmentsRelPosition::Intersecting) {
      return crossing;
    }
  }
  return Middle(medianA.start, medianB.start);
}

TriangleCentre CentreOf(Triangle const& triangle) {
  return {std::fabs(SignedArea(triangle)), InnerPoint(triangle)};
}

}  // namespace Vorn::Triangles
