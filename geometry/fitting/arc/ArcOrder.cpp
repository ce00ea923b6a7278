#include "geometry/fitting/arc/ArcOrder.h"

#include "geometry/elementary/Angles.h"
#include "math/NumericConstants.h"

namespace Vorn::Fitting {

using Numeric::kTruncatedHalfPi;
using Numeric::kTruncatedTwoPi;

namespace {

/// The angles of three points about a centre.
struct ThreeAngles {
  ThreeAngles(Point const& centre, Point const& p1, Point const& p2, Point const& p3)
      : a1(Elementary::AngleAbout(centre, p1)),
        a2(Elementary::AngleAbout(centre, p2)),
        a3(Elementary::AngleAbout(centre, p3)) {}

  /// Whether the second one lies between the others, in a turning direction.
  bool AreInOrder(bool ccw) const {
    if (ccw) return a3 > a1 ? a1 <= a2 && a2 <= a3 : a2 >= a1 || a2 <= a3;
    return a3 <= a1 ? a3 <= a2 && a2 <= a1 : a2 <= a1 || a2 >= a3;
  }

  double a1, a2, a3;
};

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

bool IsOnArc(ArcTurn const& turn, Point const& start, Point const& p, Point const& end) {
  return ThreeAngles(turn.centre, start, p, end).AreInOrder(turn.ccw);
}

bool ContinuesArc(ArcTurn const& turn, Point const& start, Point const& previous, Point const& next,
                  bool skipFirstStep) {
  ThreeAngles const angles(turn.centre, start, previous, next);
  if (!angles.AreInOrder(turn.ccw)) return false;
  return (skipFirstStep || IsShortStep(turn.ccw, angles.a1, angles.a2)) &&
         IsShortStep(turn.ccw, angles.a2, angles.a3);
}

}  // namespace Vorn::Fitting
