// Every element adds twice the area between itself and the x axis, so half the sum over a closed
// contour is its area. An arc adds the two chords start-centre and centre-end and twice its sector.

#include "geometry/contours/Area.h"

#include "math/NumericConstants.h"

namespace Vorn::Contours {

namespace {

using Numeric::kTruncatedTwoPi;

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
  Point const& centre = arc.center;
  Point const& end = arc.end;
  return (end.x - start.x) * centre.y + (end.x - centre.x) * end.y +
         (centre.x - start.x) * start.y + arc.radius * arc.radius * (startAngle - endAngle);
}

}  // namespace

std::optional<double> SignedArea(Contour const& contour) {
  double sum = 0.0;
  Point start = contour.front().end;
  for (auto elem = contour.begin() + 1; elem != contour.end(); ++elem) {
    if (!IsKnown(*elem)) return std::nullopt;
    sum += IsSegment(*elem) ? SegmentTerm(start, elem->end) : ArcTerm(start, *elem);
    start = elem->end;
  }
  return sum * 0.5;
}

}  // namespace Vorn::Contours
