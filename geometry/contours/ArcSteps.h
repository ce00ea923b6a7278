#pragma once

#include "vorn/GeometryUtils.h"

namespace Vorn {

/// The intersection routines with arcs, bound to the records that contours hold. The routines are
/// private members of GeometryUtils, so its operations hand them to the walks that live outside.
struct ArcSteps {
  int (*segmentAndArc)(double x1, double y1, double x2, double y2, double cx, double cy, double r,
                       double d, double startAngle, double endAngle, double* ax, double* ay,
                       double* bx, double* by);
  int (*arcAndArc)(double cx1, double cy1, double r1, double d1, double startAngle1,
                   double endAngle1, double cx2, double cy2, double r2, double d2,
                   double startAngle2, double endAngle2, double* ax, double* ay, double* bx,
                   double* by);

  /// The number of common points; negative when the arc has equal angles.
  int CountSegmentArc(GeometryUtils::Point const& start, GeometryUtils::Point const& end,
                      GeometryUtils::Arc const& arc) const {
    GeometryUtils::Point first;
    GeometryUtils::Point second;
    return segmentAndArc(start.x, start.y, end.x, end.y, arc.center.x, arc.center.y, arc.radius,
                         arc.direction, arc.startAngle, arc.endAngle, &first.x, &first.y, &second.x,
                         &second.y);
  }

  /// The number of common points; negative when a radius is not positive.
  int CountArcArc(GeometryUtils::Arc const& a, GeometryUtils::Arc const& b) const {
    GeometryUtils::Point first;
    GeometryUtils::Point second;
    return arcAndArc(a.center.x, a.center.y, a.radius, a.direction, a.startAngle, a.endAngle,
                     b.center.x, b.center.y, b.radius, b.direction, b.startAngle, b.endAngle,
                     &first.x, &first.y, &second.x, &second.y);
  }
};

}  // namespace Vorn
