#include "geometry/triangles/PreparedTriangle.h"

#include <algorithm>
#include <cmath>

#include "geometry/elementary/Sense.h"
#include "geometry/intersections/SegmentPair.h"
#include "math/NumericConstants.h"

namespace Vorn::Triangles {

using Elementary::AreaOfTerms;
using Elementary::AreaTerm;

PreparedTriangle::PreparedTriangle(Triangle const& from) : triangle(from), box(BoxOf(from)) {
  for (int i = 0; i < 3; ++i) {
    Point const& start = from.pts[i];
    Point const& end = from.pts[(i + 1) % 3];
    sides[i] = {end.x - start.x,          end.y - start.y,          AreaTerm(start, end),
                std::min(start.x, end.x), std::min(start.y, end.y), std::max(start.x, end.x),
                std::max(start.y, end.y)};
  }
  sense = Numeric::Sign(AreaOfTerms(sides[0].term, sides[1].term, sides[2].term));
  double const sum =
      from.pts[0].x + from.pts[1].x + from.pts[2].x + from.pts[0].y + from.pts[1].y + from.pts[2].y;
  isOrdered = !std::isnan(sum);
}

PointStatus PreparedTriangle::StatusOf(Point const& p) const {
  if (box.xMin > p.x || p.x > box.xMax || box.yMin > p.y || p.y > box.yMax) {
    return PointStatus::Outside;
  }
  double fromVertex[3];
  for (int i = 0; i < 3; ++i) fromVertex[i] = AreaTerm(p, triangle.pts[i]);
  // The term of the way back to p is that of the way from p, negated, down to the last bit.
  double const areas[3] = {AreaOfTerms(fromVertex[0], sides[0].term, -fromVertex[1]),
                           AreaOfTerms(fromVertex[1], sides[1].term, -fromVertex[2]),
                           AreaOfTerms(fromVertex[2], sides[2].term, -fromVertex[0])};
  bool const isNearSide = (areas[0] == 0.0) | (areas[1] == 0.0) | (areas[2] == 0.0);
  if (isNearSide || sense == 0) return StatusNearSides(p, areas);
  bool const isNegative = sense < 0;
  bool const isInside = ((areas[0] < 0.0) == isNegative) & ((areas[1] < 0.0) == isNegative) &
                        ((areas[2] < 0.0) == isNegative);
  return isInside ? PointStatus::Inside : PointStatus::Outside;
}

PointStatus PreparedTriangle::StatusNearSides(Point const& p, double const* areas) const {
  int hits = 0;
  bool isOutside = false;
  for (int i = 0; i < 3; ++i) {
    int const side = Numeric::Sign(areas[i]);
    if (side == 0 && Intersections::IsInBox(p, SideOf(triangle, i))) {
      ++hits;
    } else if (side == 0 || side != sense) {
      // On the line of a side but not on the side counts as beyond it.
      isOutside = true;
    }
  }
  if (sense == 0) return hits > 0 ? PointStatus::OnDegenerate : PointStatus::Outside;
  switch (hits) {
    case 0:
      return isOutside ? PointStatus::Outside : PointStatus::Inside;
    case 1:
      return PointStatus::OnSide;
    case 2:
      return PointStatus::OnVertex;
    default:
      return PointStatus::Undefined;
  }
}

}  // namespace Vorn::Triangles
