// Single elements of a contour: what is known of their kinds, where they end, and new ones.

#pragma once

#include <vector>

#include "geometry/elementary/Points.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Contours {

using Elementary::Point;
using Arc = GeometryUtils::Arc;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Contour = std::vector<Elem>;

/// Whether an element is of a kind that operations accept.
inline bool IsKnown(Elem const& elem) {
  return elem.type == ElemType::Segment || elem.type == ElemType::Arc;
}

/// Whether an element is a segment.
inline bool IsSegment(Elem const& elem) { return elem.type == ElemType::Segment; }

/// Whether two elements that follow on each other end in one place, so that the second one has no
/// length.
inline bool IsSamePlace(Point const& p, Point const& q) {
  return Numeric::IsZeroMagnitude(p.x - q.x) && Numeric::IsZeroMagnitude(p.y - q.y);
}

/// A segment to a point. Its arc fields are zero: nothing reads them, but a contour that is written
/// out or compared byte for byte does not depend on what memory held.
inline Elem SegmentTo(Point const& end) {
  Elem segment;
  segment.type = ElemType::Segment;
  segment.end = end;
  return segment;
}

/// What an arc element is made from.
struct ArcPiece {
  /// Gives the start angle; the element itself does not hold it.
  Point start;
  Point end;
  Point centre;
  /// Taken as it is: nothing compares it with the points.
  double radius;
  bool isClockwise;
};

/// An arc element, with the polar angles of both ends about the centre.
Elem ArcElement(ArcPiece const& piece);

/// A copy of an element of a known kind, moved: the end and, of an arc, the centre.
Elem Moved(Elem const& elem, Point const& shift);

/// Cuts an element of a known kind into pieces of equal length, the last of which ends where the
/// element ends. `parts` is at least 2, `pieces` has room for as many; `start` is where a segment
/// begins. An arc of equal angles is taken for a full circle.
void Split(Elem const& elem, int parts, Point const& start, Elem* pieces);

}  // namespace Vorn::Contours
