// The intersection of two segments, inline: the overlap of two triangles asks for it nine times.
//
// It follows the classic scheme: reject by boxes, then solve the 2 x 2 system for both parameters
// scaled by the determinant, so that the range tests need no division.
//   F. Antonio, "Faster Line Segment Intersection", Graphics Gems III, 1992.

#pragma once

#include <algorithm>
#include <cmath>

#include "geometry/elementary/Points.h"
#include "geometry/elementary/Shapes.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Intersections {

using Elementary::Point;
using Elementary::Segment;

/// Whether a value lies between two others, which may stand in any order and count as between.
inline bool IsWithin(double value, double end1, double end2) {
  return std::min(end1, end2) <= value && value <= std::max(end1, end2);
}

/// Whether a point lies in the bounding box of a segment, borders included.
inline bool IsInBox(Point const& p, Segment const& segment) {
  return IsWithin(p.x, segment.start.x, segment.end.x) &&
         IsWithin(p.y, segment.start.y, segment.end.y);
}

/// Whether [p1, p2] and [p3, p4], ends in any order, have no number in common on one axis.
inline bool AreApart(double p1, double p2, double p3, double p4) {
  double const low = std::min(p1, p2);
  double const high = std::max(p1, p2);
  if (p3 > p4) return p4 > high || low > p3;
  return p3 > high || low > p4;
}

/// Two segments (x1, y1)-(x2, y2) and (x3, y3)-(x4, y4) and the differences that every step of
/// their intersection uses: d1 = P2 - P1 and d2 = P3 - P4, reversed, as the scheme wants it.
struct SegmentPair {
  /// The pair of two segments.
  SegmentPair(Segment const& first, Segment const& second)
      : x1(first.start.x),
        y1(first.start.y),
        x2(first.end.x),
        y2(first.end.y),
        x3(second.start.x),
        y3(second.start.y),
        x4(second.end.x),
        y4(second.end.y) {}

  double x1, y1, x2, y2, x3, y3, x4, y4;
  double dx1 = x2 - x1;
  double dy1 = y2 - y1;
  double dx2 = x3 - x4;
  double dy2 = y3 - y4;

  /// Whether the bounding boxes have no point in common.
  bool AreBoxesApart() const { return AreApart(x1, x2, x3, x4) || AreApart(y1, y2, y3, y4); }

  /// The cross product of d1 and d2, negated.
  double Determinant() const { return dy1 * dx2 - dy2 * dx1; }

  /// The parameter of the crossing along the first segment, times the determinant.
  double ScaledParameter1() const { return (x1 - x3) * dy2 - (y1 - y3) * dx2; }

  /// The parameter of the crossing along the second segment, times the determinant.
  double ScaledParameter2() const { return (y1 - y3) * dx1 - (x1 - x3) * dy1; }
};

/// Whether both scaled parameters lie in [0, det] (or [det, 0]): the segments, ends included, meet.
inline bool AreParametersInRange(double s, double u, double det) {
  if (det > 0.0) return 0.0 <= s && s <= det && 0.0 <= u && u <= det;
  return det <= s && s <= 0.0 && det <= u && u <= 0.0;
}

/// How two segments lie to each other.
struct Meeting {
  SegmentsRelPosition relation = SegmentsRelPosition::Disjoint;
  /// The common point for Intersecting, the middle of the common part for Collinear.
  Point common;

  /// Whether `common` says something.
  bool HasCommon() const {
    return relation == SegmentsRelPosition::Intersecting ||
           relation == SegmentsRelPosition::Collinear;
  }
};

/// How two segments lie whose determinant counts as zero: parallel ones and those of no length.
Meeting IntersectParallel(Segment const& first, Segment const& second);

/// How two segments lie to each other, ends included. See
/// GeometryUtils::GetLineSegmentsIntersection for what counts as parallel.
inline Meeting Intersect(SegmentPair const& pair) {
  if (pair.AreBoxesApart()) return {};
  double const det = pair.Determinant();
  if (!(std::fabs(det) > Numeric::kZero)) {
    // The segments made anew, not the pair: whose address is taken leaves the registers at once.
    return IntersectParallel({{pair.x1, pair.y1}, {pair.x2, pair.y2}},
                             {{pair.x3, pair.y3}, {pair.x4, pair.y4}});
  }
  double const s = pair.ScaledParameter1();
  double const u = pair.ScaledParameter2();
  if (!AreParametersInRange(s, u, det)) return {};
  // Products before the division: a crossing at an end point gives that end point exactly.
  return {SegmentsRelPosition::Intersecting,
          {pair.x1 + s * pair.dx1 / det, pair.y1 + s * pair.dy1 / det}};
}

/// The same for two segments. `common` receives the common point, if there is one; otherwise it
/// stays.
inline SegmentsRelPosition IntersectSegments(SegmentPair const& pair, Point* common) {
  Meeting const meeting = Intersect(pair);
  if (meeting.HasCommon()) *common = meeting.common;
  return meeting.relation;
}

/// Whether two segments have exactly one common point, as IntersectSegments tells it.
inline bool HaveOneCommonPoint(Segment const& first, Segment const& second) {
  return Intersect({first, second}).relation == SegmentsRelPosition::Intersecting;
}

}  // namespace Vorn::Intersections
