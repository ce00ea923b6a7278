// Intersections of straight lines and segments.
//
// Segment against segment follows the classic scheme: reject by boxes, then solve the 2 x 2 system
// for both parameters scaled by the determinant, so that the range tests need no division.
//   F. Antonio, "Faster Line Segment Intersection", Graphics Gems III, 1992.
//
// Notation there: d1 = P2 - P1, d2 = P3 - P4 (reversed, as the scheme wants it), det = d1 x d2,
// s and u the parameters of the crossing along segments 1 and 2, each times det.

#include <algorithm>
#include <cmath>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/intersections/SegmentPair.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Intersections::IsWithin;
using Intersections::SegmentPair;
using Numeric::IsZeroMagnitude;
using Numeric::kTangency;
using Numeric::kZero;

namespace {

bool IsPoint(double dx, double dy) { return IsZeroMagnitude(dx) && IsZeroMagnitude(dy); }

SegmentsRelPosition Meet(double px, double py, double* x, double* y) {
  *x = px;
  *y = py;
  return SegmentsRelPosition::Intersecting;
}

/// Two parallel proper segments whose lines have equal constants: the middle of what their boxes
/// share.
SegmentsRelPosition MeetCollinear(SegmentPair const& s, double* x, double* y) {
  double const xLow = std::max(std::min(s.x1, s.x2), std::min(s.x3, s.x4));
  double const yLow = std::max(std::min(s.y1, s.y2), std::min(s.y3, s.y4));
  double const xHigh = std::min(std::max(s.x1, s.x2), std::max(s.x3, s.x4));
  double const yHigh = std::min(std::max(s.y1, s.y2), std::max(s.y3, s.y4));
  bool const isShared = xLow <= xHigh && yLow <= yHigh;
  if (!isShared) return SegmentsRelPosition::Disjoint;
  *x = (xLow + xHigh) / 2.0;
  *y = (yLow + yHigh) / 2.0;
  return SegmentsRelPosition::Collinear;
}

}  // namespace

SegmentsRelPosition Intersections::IntersectParallel(SegmentPair const& s, double* x, double* y) {
  // A point that lies exactly on the other segment.
  if (IsPoint(s.dx1, s.dy1) && (s.x1 - s.x3) * (s.y4 - s.y3) == (s.y1 - s.y3) * (s.x4 - s.x3) &&
      IsWithin(s.x1, s.x3, s.x4) && IsWithin(s.y1, s.y3, s.y4)) {
    return Meet(s.x1, s.y1, x, y);
  }
  if (IsPoint(s.dx2, s.dy2) && (s.x3 - s.x1) * s.dy1 == (s.y3 - s.y1) * s.dx1 &&
      IsWithin(s.x3, s.x1, s.x2) && IsWithin(s.y3, s.y1, s.y2)) {
    return Meet(s.x3, s.y3, x, y);
  }

  Lines::ImplicitLine line1;
  Lines::ImplicitLine line2;
  bool const isProper1 = line1.Through(s.x1, s.y1, s.x2, s.y2);
  bool const isProper2 = line2.Through(s.x3, s.y3, s.x4, s.y4);
  if (isProper1 && isProper2) {
    // Deliberate: raw constants. Segments of different length on one line that misses the origin
    // differ here and count as parallel.
    if (std::fabs(line1.c - line2.c) > kZero) return SegmentsRelPosition::Parallel;
    return MeetCollinear(s, x, y);
  }
  if (isProper1) {
    if (std::fabs(line1.At(s.x3, s.y3)) > kZero) return SegmentsRelPosition::Disjoint;
    return Meet(s.x3, s.y3, x, y);
  }
  bool const isApart = isProper2 ? std::fabs(line2.At(s.x1, s.y1)) > kZero
                                 : std::fabs(s.x1 - s.x3) > kZero || std::fabs(s.y1 - s.y3) > kZero;
  if (isApart) return SegmentsRelPosition::Disjoint;
  return Meet(s.x1, s.y1, x, y);
}

SegmentsRelPosition Lines::Cross(ImplicitLine const& line1, ImplicitLine const& line2, double* x,
                                 double* y) {
  auto const& [a1, b1, c1] = line1;
  auto const& [a2, b2, c2] = line2;
  double const det = a1 * b2 - b1 * a2;
  // Strict here and nowhere else: a determinant of exactly the smallest normal double is divided.
  if (std::fabs(det) < kZero) return SegmentsRelPosition::Parallel;
  return Meet((b1 * c2 - c1 * b2) / det, (c1 * a2 - a1 * c2) / det, x, y);
}

SegmentsRelPosition GeometryUtils::GetLinesIntersection(double a1, double b1, double c1, double a2,
                                                        double b2, double c2, double* x,
                                                        double* y) {
  return Lines::Cross({a1, b1, c1}, {a2, b2, c2}, x, y);
}

bool GeometryUtils::GetLineAndSegmentIntersection(double a, double b, double c, double x1,
                                                  double y1, double x2, double y2, double* x,
                                                  double* y) {
  Lines::ImplicitLine segment;
  if (!segment.Through(x1, y1, x2, y2)) return false;
  double px = 0.0;
  double py = 0.0;
  if (Lines::Cross({a, b, c}, segment, &px, &py) != SegmentsRelPosition::Intersecting) {
    return false;
  }
  if (!IsWithin(px, x1, x2) || !IsWithin(py, y1, y2)) return false;
  *x = px;
  *y = py;
  return true;
}

SegmentsRelPosition GeometryUtils::GetLineSegmentsIntersection(double x1, double y1, double x2,
                                                               double y2, double x3, double y3,
                                                               double x4, double y4, double* x,
                                                               double* y) {
  return Intersections::IntersectSegments(SegmentPair(x1, y1, x2, y2, x3, y3, x4, y4), x, y);
}

bool GeometryUtils::AreLineSegmentsIntersect(double x1, double y1, double x2, double y2, double x3,
                                             double y3, double x4, double y4) {
  SegmentPair const pair(x1, y1, x2, y2, x3, y3, x4, y4);
  if (pair.AreBoxesApart()) return false;
  double const det = pair.Determinant();
  // Deliberate: a wider threshold than in the classification above, and overlaps along one line do
  // not count.
  if (std::fabs(det) <= kTangency) return false;
  return Intersections::AreParametersInRange(pair.ScaledParameter1(), pair.ScaledParameter2(), det);
}

bool GeometryUtils::GetNearestPointOnLine(double a, double b, double c, Point const& p,
                                          Point* foot) {
  Lines::ImplicitLine const line{a, b, c};
  return Lines::Cross(line, line.NormalThrough(p.x, p.y), &foot->x, &foot->y) ==
         SegmentsRelPosition::Intersecting;
}

}  // namespace Vorn
