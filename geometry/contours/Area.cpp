// Signed area of a contour of segments and arcs.
//
// Every element adds twice the area between itself and the x axis, so half the sum over a closed
// contour is its area: positive when it runs clockwise with y up. An arc adds the two chords
// start-centre and centre-end and twice its sector.

#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Numeric::kTruncatedTwoPi;

namespace {

using Point = GeometryUtils::Point;
using Arc = GeometryUtils::Arc;
using ElemType = GeometryUtils::ElemType;

double SegmentTerm(Point const& start, Point const& end) {
  return (end.x - start.x) * (end.y + start.y);
}

double ArcTerm(Point const& start, Arc const& arc) {
  double startAngle = arc.startAngle;
  double endAngle = arc.endAngle;
  if (arc.direction < 0.0) {
    if (endAngle > startAngle) startAngle += kTruncatedTwoPi;
  } else {
    if (startAngle > endAngle) endAngle += kTruncatedTwoPi;
  }
  Point const& center = arc.center;
  Point const& end = arc.end;
  return (end.x - start.x) * center.y + (end.x - center.x) * end.y +
         (center.x - start.x) * start.y + arc.radius * arc.radius * (startAngle - endAngle);
}

}  // namespace

ErrorCode GeometryUtils::GetArea(std::vector<Elem> const& contour, double* area) {
  ErrorCode const check = CheckPolySelfIntersection(contour);
  if (check != ErrorCode::Ok) return check;

  double sum = 0.0;
  Point start = contour.front().end;
  for (auto elem = contour.begin() + 1; elem != contour.end(); ++elem) {
    if (elem->type == ElemType::Segment) {
      sum += SegmentTerm(start, elem->end);
    } else if (elem->type == ElemType::Arc) {
      sum += ArcTerm(start, *elem);
    } else {
      // The check walks up to an invalid element and may end there without complaint.
      return ErrorCode::Failed;
    }
    start = elem->end;
  }
  if (area == nullptr) return ErrorCode::Failed;
  *area = sum * 0.5;
  return ErrorCode::Ok;
}

}  // namespace Vorn
