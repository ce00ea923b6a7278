// Standalone members: no other operation of the library uses them. Whether a triangle has an area,
// and the crossings of two triangles as plain points from a side of choice.

#include <vector>

#include "geometry/intersections/SegmentPair.h"
#include "geometry/triangles/CrossingPoints.h"
#include "geometry/triangles/Triangle.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

bool GeometryUtils::IsValidTriangle(Triangle const& triangle) {
  return Numeric::Sign(Triangles::SignedArea(triangle)) != 0;
}

bool GeometryUtils::GetCrossingPoints(Triangle const& first, int startSide, Triangle const& second,
                                      std::vector<Point>* points) {
  int const firstSide = (startSide % 3 + 3) % 3;
  Triangles::CrossingPoints found;
  for (int turn = 0; turn < 3; ++turn) {
    int const i = (firstSide + turn) % 3;
    Triangles::SidePoints onSide(first.pts[i], &found);
    for (int j = 0; j < 3; ++j) {
      Point common;
      // Deliberate: only single points count here, and three on a side all stay.
      if (Intersections::IntersectSegments(
              {Triangles::SideOf(first, i), Triangles::SideOf(second, j)}, &common) ==
          SegmentsRelPosition::Intersecting) {
        onSide.TakeCrossing({common, i, j});
      }
    }
    onSide.Finish();
  }
  for (CrossingPoint const& crossing : found) points->push_back(crossing.pt);
  return true;
}

}  // namespace Vorn
