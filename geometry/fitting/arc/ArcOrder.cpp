// Whether points follow an arc in its turning direction. Angles come from atan2, so an arc may
// cross the seam between +pi and -pi.

#include <cmath>

#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Numeric::kTruncatedHalfPi;
using Numeric::kTruncatedTwoPi;

namespace {

using Point = GeometryUtils::Point;

double AngleAround(Point const& center, Point const& p) {
  return std::atan2(p.y - center.y, p.x - center.x);
}

/// Whether the way from one angle to the next, in the turning direction, is below a right angle.
bool IsShortStep(bool ccw, double from, double to) {
  double step = to - from;
  if (ccw) {
    if (step < 0.0) step += kTruncatedTwoPi;
    return step < kTruncatedHalfPi;
  }
  if (step > 0.0) step -= kTruncatedTwoPi;
  return step > -kTruncatedHalfPi;
}

}  // namespace

bool GeometryUtils::IsValidArcOrder(Point const& center, bool ccw, Point const& p1, Point const& p2,
                                    Point const& p3) {
  double const a1 = AngleAround(center, p1);
  double const a2 = AngleAround(center, p2);
  double const a3 = AngleAround(center, p3);
  if (ccw) {
    return a3 > a1 ? a1 <= a2 && a2 <= a3 : a2 >= a1 || a2 <= a3;
  }
  return a3 <= a1 ? a3 <= a2 && a2 <= a1 : a2 <= a1 || a2 >= a3;
}

bool GeometryUtils::IsValidArcOrder(Point const& centre, bool ccw, Point const& p1, Point const& p2,
                                    Point const& p3, bool skipFirstGap) {
  if (!IsValidArcOrder(centre, ccw, p1, p2, p3)) return false;
  double const a1 = AngleAround(centre, p1);
  double const a2 = AngleAround(centre, p2);
  double const a3 = AngleAround(centre, p3);
  return (skipFirstGap || IsShortStep(ccw, a1, a2)) && IsShortStep(ccw, a2, a3);
}

}  // namespace Vorn
