// Arcs against segments and against arcs.
//
// Of an arc the centre, radius, direction and angles are read, never the end. The range of an arc
// is open: its own end points do not count, nor do the angles +-3.1415926535897905, where a range
// that passes the seam of atan2 is split.
//
// All of it is inline: the public members come with loose numbers, which would otherwise go through
// memory and take up to a quarter of the time.
//
// Notation for two arcs: B the bigger circle with radius R, S the smaller one with radius rho; q
// the distance from B's centre to the common chord, h half the chord's length.

#pragma once

#include <cmath>
#include <optional>

#include "geometry/elementary/Angles.h"
#include "geometry/elementary/Shapes.h"
#include "geometry/intersections/Circles.h"
#include "math/Assert.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Intersections {

using Arc = GeometryUtils::Arc;

/// The directions that an arc covers: an open interval of polar angles, counter-clockwise from low
/// to high, cut in two at the seam of atan2 when high does not lie above low. The arc's own end
/// points and the seam itself are not part of it.
class AngularRange {
 public:
  /// From one angle to another, counter-clockwise for a direction above 0.
  AngularRange(double direction, double startAngle, double endAngle)
      : low_(direction > 0.0 ? startAngle : endAngle),
        high_(direction > 0.0 ? endAngle : startAngle) {}

  /// Whether both angles are equal, which leaves open what is meant. Not-a-numbers are not equal.
  bool IsUndefined() const { return low_ == high_; }

  /// Whether a polar angle lies inside.
  bool Contains(double angle) const {
    if (high_ > low_) return low_ < angle && angle < high_;
    return (low_ < angle && angle < Numeric::kArcSplitPi) ||
           (-Numeric::kArcSplitPi < angle && angle < high_);
  }

 private:
  double low_;
  double high_;
};

/// What an intersection reads of an arc.
struct ArcRange {
  /// That of an arc.
  ArcRange(Arc const& arc)  // NOLINT(google-explicit-constructor): it stands for the arc
      : circle{arc.center, arc.radius}, range(arc.direction, arc.startAngle, arc.endAngle) {}
  /// That of a circle and of angles.
  ArcRange(Circle const& aCircle, AngularRange const& aRange) : circle(aCircle), range(aRange) {}

  Circle circle;
  AngularRange range;

  /// Adds to `kept` the points whose direction from the centre is in the range.
  void Keep(CirclePoints const& points, CirclePoints* kept) const {
    for (int i = 0; i < points.count; ++i) {
      Point const& p = points.pts[i];
      if (range.Contains(Elementary::AngleAbout(circle.centre, p))) kept->Add(p);
    }
  }
};

/// The common points of two full circles, of which the first is not the smaller one.
inline CirclePoints CutCircles(Circle const& bigger, Circle const& smaller) {
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

/// The common points of a segment, ends included, and an arc: of two the one nearer to the end of
/// the segment first. The arc must have a range: see IsUndefined.
inline CirclePoints CutArcBySegment(ArcRange const& arc, Segment const& segment) {
  VORN_ASSERT(!arc.range.IsUndefined());
  CirclePoints const onCircle = CutCircleBySegment(arc.circle, segment);
  CirclePoints found;
  arc.Keep(onCircle, &found);
  return found;
}

/// The common points of two arcs: first the one on the left when looking from the centre of the
/// bigger circle to that of the smaller (for equal radii, from the first). None for arcs of one
/// circle; one where half the common chord is not above one double epsilon. Nothing when a radius
/// is not above zero.
inline std::optional<CirclePoints> CutArcByArc(ArcRange const& first, ArcRange const& second) {
  std::optional<CirclePoints> found;
  if (first.circle.radius <= 0.0 || second.circle.radius <= 0.0) return found;
  bool const isFirstBigger = first.circle.radius >= second.circle.radius;
  ArcRange const& bigger = isFirstBigger ? first : second;
  ArcRange const& smaller = isFirstBigger ? second : first;
  CirclePoints onBigger;
  bigger.Keep(CutCircles(bigger.circle, smaller.circle), &onBigger);
  smaller.Keep(onBigger, &found.emplace());
  return found;
}

}  // namespace Vorn::Intersections
