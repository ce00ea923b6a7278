// Notation for two arcs: B the bigger circle with radius R, S the smaller one with radius rho; q
// the distance from B's centre to the common chord, h half the chord's length.
#include "geometry/intersections/Arcs.h"

#include <cmath>

#include "geometry/elementary/Angles.h"
#include "math/NumericConstants.h"

namespace Vorn::Intersections {

namespace {

using Numeric::kArcSplitPi;

/// The directions that an arc covers: an open interval of polar angles, counter-clockwise from low
/// to high, cut in two at the seam of atan2 when high does not lie above low. The arc's own end
/// points and the seam itself are not part of it.
class AngularRange {
 public:
  explicit AngularRange(Arc const& arc)
      : low_(arc.direction > 0.0 ? arc.startAngle : arc.endAngle),
        high_(arc.direction > 0.0 ? arc.endAngle : arc.startAngle) {}

  bool Contains(double angle) const {
    if (high_ > low_) return low_ < angle && angle < high_;
    return (low_ < angle && angle < kArcSplitPi) || (-kArcSplitPi < angle && angle < high_);
  }

 private:
  double low_;
  double high_;
};

/// The points of a circle whose direction from the arc's centre is in the arc's range.
CirclePoints PointsInRange(Arc const& arc, CirclePoints const& points) {
  AngularRange const range(arc);
  CirclePoints kept;
  for (int i = 0; i < points.count; ++i) {
    Point const& p = points.pts[i];
    if (range.Contains(Elementary::AngleAbout(arc.center, p))) kept.Add(p);
  }
  return kept;
}

/// The common points of two full circles, of which the first is not the smaller one.
CirclePoints CutCircles(Circle const& bigger, Circle const& smaller) {
  double const dx = smaller.centre.x - bigger.centre.x;
  double const dy = smaller.centre.y - bigger.centre.y;
  double const distance = Elementary::Distance(bigger.centre, smaller.centre);
  double const bigR = bigger.radius;
  double const rho = smaller.radius;
  CirclePoints found;
  if (distance > bigR + rho || rho > distance + bigR || bigR > distance + rho) return found;

  double const q = (bigR * bigR + distance * distance - rho * rho) / (2.0 * distance);
  double const halfChord2 = bigR * bigR - q * q;
  if (halfChord2 < 0.0) return found;
  double const h = std::sqrt(halfChord2);
  if (h <= Numeric::kTangency) {
    found.Add({bigger.centre.x + dx * bigR / distance, bigger.centre.y + dy * bigR / distance});
    return found;
  }
  double const ex = dx / distance;
  double const ey = dy / distance;
  double const mx = bigger.centre.x + q * ex;
  double const my = bigger.centre.y + q * ey;
  found.Add({mx - ey * h, my + ex * h});
  found.Add({mx + ey * h, my - ex * h});
  return found;
}

Circle CircleOf(Arc const& arc) { return {arc.center, arc.radius}; }

}  // namespace

std::optional<CirclePoints> CutArcBySegment(Arc const& arc, Segment const& segment) {
  if (arc.startAngle == arc.endAngle) return std::nullopt;
  return PointsInRange(arc, CutCircleBySegment(CircleOf(arc), segment));
}

std::optional<CirclePoints> CutArcByArc(Arc const& first, Arc const& second) {
  if (first.radius <= 0.0 || second.radius <= 0.0) return std::nullopt;
  bool const isFirstBigger = first.radius >= second.radius;
  Arc const& bigger = isFirstBigger ? first : second;
  Arc const& smaller = isFirstBigger ? second : first;
  CirclePoints const onCircles = CutCircles(CircleOf(bigger), CircleOf(smaller));
  return PointsInRange(smaller, PointsInRange(bigger, onCircles));
}

}  // namespace Vorn::Intersections
