// Members for intersections of lines, segments, circles and arcs.

#include <optional>

#include "geometry/intersections/Arcs.h"
#include "geometry/intersections/Circles.h"
#include "geometry/intersections/Lines.h"
#include "geometry/intersections/SegmentPair.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Intersections::CirclePoints;

namespace {

constexpr int kInvalidArc = -1;

/// Writes as many points as there are, the first to (ax, ay), and returns their number.
int Write(CirclePoints const& found, double* ax, double* ay, double* bx, double* by) {
  if (found.count > 0) {
    *ax = found.pts[0].x;
    *ay = found.pts[0].y;
  }
  if (found.count > 1) {
    *bx = found.pts[1].x;
    *by = found.pts[1].y;
  }
  return found.count;
}

}  // namespace

SegmentsRelPosition GeometryUtils::GetLinesIntersection(double a1, double b1, double c1, double a2,
                                                        double b2, double c2, double* x,
                                                        double* y) {
  std::optional<Point> const crossing = Intersections::CrossLines({a1, b1, c1}, {a2, b2, c2});
  if (!crossing) return SegmentsRelPosition::Parallel;
  *x = crossing->x;
  *y = crossing->y;
  return SegmentsRelPosition::Intersecting;
}

bool GeometryUtils::GetNearestPointOnLine(double a, double b, double c, Point const& p,
                                          Point* foot) {
  std::optional<Point> const found = Intersections::FootOn({a, b, c}, p);
  if (found) *foot = *found;
  return found.has_value();
}

SegmentsRelPosition GeometryUtils::GetLineSegmentsIntersection(double x1, double y1, double x2,
                                                               double y2, double x3, double y3,
                                                               double x4, double y4, double* x,
                                                               double* y) {
  Intersections::Meeting const meeting =
      Intersections::Intersect({{{x1, y1}, {x2, y2}}, {{x3, y3}, {x4, y4}}});
  if (meeting.HasCommon()) {
    *x = meeting.common.x;
    *y = meeting.common.y;
  }
  return meeting.relation;
}

int GeometryUtils::GetLineSegmentAndCircleIntersection(double x1, double y1, double x2, double y2,
                                                       double cx, double cy, double r, double* ax,
                                                       double* ay, double* bx, double* by) {
  CirclePoints const found = Intersections::CutCircleBySegment({{cx, cy}, r}, {{x1, y1}, {x2, y2}});
  return Write(found, ax, ay, bx, by);
}

int GeometryUtils::GetLineAndCircleIntersection(double a, double b, double c, double cx, double cy,
                                                double r, double* ax, double* ay, double* bx,
                                                double* by) {
  return Write(Intersections::CutCircleByLine({{cx, cy}, r}, {a, b, c}), ax, ay, bx, by);
}

int GeometryUtils::GetLineSegmentAndCircleArcIntersection(double x1, double y1, double x2,
                                                          double y2, double cx, double cy, double r,
                                                          double d, double startAngle,
                                                          double endAngle, double* ax, double* ay,
                                                          double* bx, double* by) {
  Intersections::ArcRange const arc{{{cx, cy}, r}, {d, startAngle, endAngle}};
  if (arc.range.IsUndefined()) return kInvalidArc;
  return Write(Intersections::CutArcBySegment(arc, {{x1, y1}, {x2, y2}}), ax, ay, bx, by);
}

int GeometryUtils::GetCircleArcAndCircleArcIntersection(double cx1, double cy1, double r1,
                                                        double d1, double startAngle1,
                                                        double endAngle1, double cx2, double cy2,
                                                        double r2, double d2, double startAngle2,
                                                        double endAngle2, double* ax, double* ay,
                                                        double* bx, double* by) {
  std::optional<CirclePoints> const found =
      Intersections::CutArcByArc({{{cx1, cy1}, r1}, {d1, startAngle1, endAngle1}},
                                 {{{cx2, cy2}, r2}, {d2, startAngle2, endAngle2}});
  return found ? Write(*found, ax, ay, bx, by) : kInvalidArc;
}

bool GeometryUtils::GetNearestPointOnCircle(Point const& center, double radius, Point const& p,
                                            Point* nearest) {
  std::optional<Point> const found = Intersections::NearestOnCircle({center, radius}, p);
  if (found) *nearest = *found;
  return found.has_value();
}

}  // namespace Vorn
