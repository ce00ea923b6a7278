#pragma once

#include <algorithm>
#include <cmath>

#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

/// The intersection of two segments, inline: the overlap of two triangles asks for it nine times.
namespace Vorn::Intersections {

inline bool IsWithin(double value, double end1, double end2) {
  return std::min(end1, end2) <= value && value <= std::max(end1, end2);
}

/// Whether [p1, p2] and [p3, p4], ends in any order, have no number in common on one axis.
inline bool AreApart(double p1, double p2, double p3, double p4) {
  double const low = std::min(p1, p2);
  double const high = std::max(p1, p2);
  if (p3 > p4) return p4 > high || low > p3;
  return p3 > high || low > p4;
}

/// Two segments (x1, y1)-(x2, y2) and (x3, y3)-(x4, y4) and the differences that every step of
/// their intersection uses; the second difference is reversed.
struct SegmentPair {
  SegmentPair(double ax, double ay, double bx, double by, double cx, double cy, double dx,
              double dy)
      : x1(ax), y1(ay), x2(bx), y2(by), x3(cx), y3(cy), x4(dx), y4(dy) {}

  double x1, y1, x2, y2, x3, y3, x4, y4;
  double dx1 = x2 - x1;
  double dy1 = y2 - y1;
  double dx2 = x3 - x4;
  double dy2 = y3 - y4;

  bool AreBoxesApart() const { return AreApart(x1, x2, x3, x4) || AreApart(y1, y2, y3, y4); }
  double Determinant() const { return dy1 * dx2 - dy2 * dx1; }
  double ScaledParameter1() const { return (x1 - x3) * dy2 - (y1 - y3) * dx2; }
  double ScaledParameter2() const { return (y1 - y3) * dx1 - (x1 - x3) * dy1; }
};

/// Whether both scaled parameters lie in [0, det] (or [det, 0]): the segments, ends included, meet.
inline bool AreParametersInRange(double s, double u, double det) {
  if (det > 0.0) return 0.0 <= s && s <= det && 0.0 <= u && u <= det;
  return det <= s && s <= 0.0 && det <= u && u <= 0.0;
}

/// Segments whose determinant counts as zero: parallel ones and those of no length.
SegmentsRelPosition IntersectParallel(SegmentPair const& pair, double* x, double* y);

inline SegmentsRelPosition IntersectSegments(SegmentPair const& pair, double* x, double* y) {
  if (pair.AreBoxesApart()) return SegmentsRelPosition::Disjoint;
  double const det = pair.Determinant();
  if (!(std::fabs(det) > Numeric::kZero)) return IntersectParallel(pair, x, y);
  double const s = pair.ScaledParameter1();
  double const u = pair.ScaledParameter2();
  if (!AreParametersInRange(s, u, det)) return SegmentsRelPosition::Disjoint;
  // Products before the division: a crossing at an end point gives that end point exactly.
  *x = pair.x1 + s * pair.dx1 / det;
  *y = pair.y1 + s * pair.dy1 / det;
  return SegmentsRelPosition::Intersecting;
}

}  // namespace Vorn::Intersections
