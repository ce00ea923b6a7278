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

#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Numeric::IsZeroMagnitude;
using Numeric::kTangency;
using Numeric::kZero;

namespace {

/// Two segments and the differences that every step of their intersection uses.
struct SegmentPair {
  SegmentPair(double ax, double ay, double bx, double by, double cx, double cy, double dx,
              double dy)
      : x1(ax), y1(ay), x2(bx), y2(by), x3(cx), y3(cy), x4(dx), y4(dy) {}

  double x1, y1, x2, y2, x3, y3, x4, y4;
  double dx1 = x2 - x1;
  double dy1 = y2 - y1;
  double dx2 = x3 - x4;
  double dy2 = y3 - y4;

  double Determinant() const { return dy1 * dx2 - dy2 * dx1; }
  double ScaledParameter1() const { return (x1 - x3) * dy2 - (y1 - y3) * dx2; }
  double ScaledParameter2() const { return (y1 - y3) * dx1 - (x1 - x3) * dy1; }
};

bool IsWithin(double value, double end1, double end2) {
  return std::min(end1, end2) <= value && value <= std::max(end1, end2);
}

/// Whether [p1, p2] and [p3, p4], ends in any order, have no number in common on one axis.
bool AreApart(double p1, double p2, double p3, double p4) {
  double const low = std::min(p1, p2);
  double const high = std::max(p1, p2);
  if (p3 > p4) return p4 > high || low > p3;
  return p3 > high || low > p4;
}

bool AreBoxesApart(SegmentPair const& s) {
  return AreApart(s.x1, s.x2, s.x3, s.x4) || AreApart(s.y1, s.y2, s.y3, s.y4);
}

/// Whether both scaled parameters lie in [0, det] (or [det, 0]): the segments, ends included, meet.
bool AreParametersInRange(double s, double u, double det) {
  if (det > 0.0) return 0.0 <= s && s <= det && 0.0 <= u && u <= det;
  return det <= s && s <= 0.0 && det <= u && u <= 0.0;
}

bool IsPoint(double dx, double dy) { return IsZeroMagnitude(dx) && IsZeroMagnitude(dy); }

SegmentsRelPosition Meet(double px, double py, double* x, double* y) {
  *x = px;
  *y = py;
  return SegmentsRelPosition::Intersecting;
}

/// Two parallel proper segments whose lines have equal constants: the middle of what they share.
SegmentsRelPosition MeetCollinear(double const* box1, double const* box2, double* x, double* y) {
  double const xLow = std::max(box1[0], box2[0]);
  double const yLow = std::max(box1[1], box2[1]);
  double const xHigh = std::min(box1[2], box2[2]);
  double const yHigh = std::min(box1[3], box2[3]);
  bool const isShared = xLow <= xHigh && yLow <= yHigh;
  if (!isShared) return SegmentsRelPosition::Disjoint;
  *x = (xLow + xHigh) / 2.0;
  *y = (yLow + yHigh) / 2.0;
  return SegmentsRelPosition::Collinear;
}

}  // namespace

SegmentsRelPosition GeometryUtils::GetLinesIntersection(double a1, double b1, double c1, double a2,
                                                        double b2, double c2, double* x,
                                                        double* y) {
  double const det = a1 * b2 - b1 * a2;
  // Strict here and nowhere else: a determinant of exactly the smallest normal double is divided.
  if (std::fabs(det) < kZero) return SegmentsRelPosition::Parallel;
  return Meet((b1 * c2 - c1 * b2) / det, (c1 * a2 - a1 * c2) / det, x, y);
}

bool GeometryUtils::GetLineAndSegmentIntersection(double a, double b, double c, double x1,
                                                  double y1, double x2, double y2, double* x,
                                                  double* y) {
  double segmentA = 0.0;
  double segmentB = 0.0;
  double segmentC = 0.0;
  if (!GetLineParameters(x1, y1, x2, y2, &segmentA, &segmentB, &segmentC)) return false;
  double px = 0.0;
  double py = 0.0;
  if (GetLinesIntersection(a, b, c, segmentA, segmentB, segmentC, &px, &py) !=
      SegmentsRelPosition::Intersecting) {
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
  SegmentPair const pair(x1, y1, x2, y2, x3, y3, x4, y4);
  if (AreBoxesApart(pair)) return SegmentsRelPosition::Disjoint;
  double const det = pair.Determinant();
  if (std::fabs(det) > kZero) {
    double const s = pair.ScaledParameter1();
    double const u = pair.ScaledParameter2();
    if (!AreParametersInRange(s, u, det)) return SegmentsRelPosition::Disjoint;
    // Products before the division: a crossing at an end point gives that end point exactly.
    return Meet(x1 + s * pair.dx1 / det, y1 + s * pair.dy1 / det, x, y);
  }

  // A point that lies exactly on the other segment.
  if (IsPoint(pair.dx1, pair.dy1) && (x1 - x3) * (y4 - y3) == (y1 - y3) * (x4 - x3) &&
      IsWithin(x1, x3, x4) && IsWithin(y1, y3, y4)) {
    return Meet(x1, y1, x, y);
  }
  if (IsPoint(pair.dx2, pair.dy2) && (x3 - x1) * pair.dy1 == (y3 - y1) * pair.dx1 &&
      IsWithin(x3, x1, x2) && IsWithin(y3, y1, y2)) {
    return Meet(x3, y3, x, y);
  }

  double a1 = 0.0;
  double b1 = 0.0;
  double c1 = 0.0;
  double a2 = 0.0;
  double b2 = 0.0;
  double c2 = 0.0;
  bool const isProper2 = GetLineParameters(x3, y3, x4, y4, &a2, &b2, &c2);
  bool const isProper1 = GetLineParameters(x1, y1, x2, y2, &a1, &b1, &c1);
  if (isProper1 && isProper2) {
    // Deliberate: raw constants. Segments of different length on one line that misses the origin
    // differ here and count as parallel.
    if (std::fabs(c1 - c2) > kZero) return SegmentsRelPosition::Parallel;
    double box1[4];
    double box2[4];
    GetXyminXymax(x1, y1, x2, y2, box1);
    GetXyminXymax(x3, y3, x4, y4, box2);
    return MeetCollinear(box1, box2, x, y);
  }
  if (isProper1) {
    if (std::fabs(a1 * x3 + b1 * y3 + c1) > kZero) return SegmentsRelPosition::Disjoint;
    return Meet(x3, y3, x, y);
  }
  bool const isApart = isProper2 ? std::fabs(a2 * x1 + b2 * y1 + c2) > kZero
                                 : std::fabs(x1 - x3) > kZero || std::fabs(y1 - y3) > kZero;
  if (isApart) return SegmentsRelPosition::Disjoint;
  return Meet(x1, y1, x, y);
}

bool GeometryUtils::AreLineSegmentsIntersect(double x1, double y1, double x2, double y2, double x3,
                                             double y3, double x4, double y4) {
  SegmentPair const pair(x1, y1, x2, y2, x3, y3, x4, y4);
  if (AreBoxesApart(pair)) return false;
  double const det = pair.Determinant();
  // Deliberate: a wider threshold than in the classification above, and overlaps along one line do
  // not count.
  if (std::fabs(det) <= kTangency) return false;
  return AreParametersInRange(pair.ScaledParameter1(), pair.ScaledParameter2(), det);
}

bool GeometryUtils::GetNearestPointOnLine(double a, double b, double c, Point const& p,
                                          Point* foot) {
  double na = 0.0;
  double nb = 0.0;
  double nc = 0.0;
  GetNormal(a, b, c, p, &na, &nb, &nc);
  return GetLinesIntersection(a, b, c, na, nb, nc, &foot->x, &foot->y) ==
         SegmentsRelPosition::Intersecting;
}

}  // namespace Vorn
