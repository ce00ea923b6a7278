// Arcs against segments and against arcs.
//
// Notation for two arcs: B the bigger circle with radius R, S the smaller one with radius rho; q
// the distance from B's centre to the common chord, h half the chord's length.

#include <cmath>

#include "geometry/intersections/CirclePoints.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Intersections::CirclePoints;
using Numeric::kArcSplitPi;

namespace {

using Point = GeometryUtils::Point;

constexpr int kInvalidArc = -1;

/// The directions that an arc covers: an open interval of polar angles, counter-clockwise from low
/// to high, cut in two at the seam of atan2 when high does not lie above low. The arc's own end
/// points and the seam itself are not part of it.
class AngularRange {
 public:
  AngularRange(double direction, double startAngle, double endAngle)
      : low_(direction > 0.0 ? startAngle : endAngle),
        high_(direction > 0.0 ? endAngle : startAngle) {}

  bool Contains(double angle) const {
    if (high_ > low_) return low_ < angle && angle < high_;
    return (low_ < angle && angle < kArcSplitPi) || (-kArcSplitPi < angle && angle < high_);
  }

  bool HoldsDirection(Point const& center, Point const& p) const {
    return Contains(std::atan2(p.y - center.y, p.x - center.x));
  }

 private:
  double low_;
  double high_;
};

struct Circle {
  Point center;
  double radius;
  AngularRange range;
};

/// The common points of two full circles, of which the first is not the smaller one.
CirclePoints CutCircles(Circle const& bigger, Circle const& smaller) {
  double const dx = smaller.center.x - bigger.center.x;
  double const dy = smaller.center.y - bigger.center.y;
  double const distance = std::sqrt(dx * dx + dy * dy);
  double const bigR = bigger.radius;
  double const rho = smaller.radius;
  CirclePoints found;
  if (distance > bigR + rho || rho > distance + bigR || bigR > distance + rho) return found;

  double const q = (bigR * bigR + distance * distance - rho * rho) / (2.0 * distance);
  double const halfChord2 = bigR * bigR - q * q;
  if (halfChord2 < 0.0) return found;
  double const h = std::sqrt(halfChord2);
  if (h <= Numeric::kTangency) {
    found.Add(bigger.center.x + dx * bigR / distance, bigger.center.y + dy * bigR / distance);
    return found;
  }
  double const ex = dx / distance;
  double const ey = dy / distance;
  double const mx = bigger.center.x + q * ex;
  double const my = bigger.center.y + q * ey;
  found.Add(mx - ey * h, my + ex * h);
  found.Add(mx + ey * h, my - ex * h);
  return found;
}

}  // namespace

int GeometryUtils::GetLineSegmentAndCircleArcIntersection(double x1, double y1, double x2,
                                                          double y2, double cx, double cy, double r,
                                                          double d, double startAngle,
                                                          double endAngle, double* ax, double* ay,
                                                          double* bx, double* by) {
  if (startAngle == endAngle) return kInvalidArc;
  AngularRange const range(d, startAngle, endAngle);
  CirclePoints const onCircle = Intersections::CutCircle(x1, y1, x2, y2, cx, cy, r);
  CirclePoints onArc;
  for (int i = 0; i < onCircle.count; ++i) {
    Point const& p = onCircle.pts[i];
    if (range.HoldsDirection({cx, cy}, p)) onArc.Add(p.x, p.y);
  }
  return onArc.Write(ax, ay, bx, by);
}

int GeometryUtils::GetCircleArcAndCircleArcIntersection(double cx1, double cy1, double r1,
                                                        double d1, double startAngle1,
                                                        double endAngle1, double cx2, double cy2,
                                                        double r2, double d2, double startAngle2,
                                                        double endAngle2, double* ax, double* ay,
                                                        double* bx, double* by) {
  if (r1 <= 0.0 || r2 <= 0.0) return kInvalidArc;
  Circle const first{{cx1, cy1}, r1, AngularRange(d1, startAngle1, endAngle1)};
  Circle const second{{cx2, cy2}, r2, AngularRange(d2, startAngle2, endAngle2)};
  bool const isFirstBigger = r1 >= r2;
  Circle const& bigger = isFirstBigger ? first : second;
  Circle const& smaller = isFirstBigger ? second : first;

  CirclePoints const onCircles = CutCircles(bigger, smaller);
  CirclePoints onArcs;
  for (int i = 0; i < onCircles.count; ++i) {
    Point const& p = onCircles.pts[i];
    if (bigger.range.HoldsDirection(bigger.center, p) &&
        smaller.range.HoldsDirection(smaller.center, p)) {
      onArcs.Add(p.x, p.y);
    }
  }
  return onArcs.Write(ax, ay, bx, by);
}

}  // namespace Vorn
