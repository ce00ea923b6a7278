// Angle conventions, arc sweep and arc length.
//
// An angle is wrapped at most once and always by the truncated constants: callers feed it angles
// of atan2 or differences of two of them, for which one wrap is enough, and further wraps would
// change results that are compared bit for bit.

#include <cmath>

#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Numeric::kTruncatedHalfPi;
using Numeric::kTruncatedPi;
using Numeric::kTruncatedTwoPi;

double GeometryUtils::GetNaturalAngle(double dy, double dx) { return std::atan2(-dy, dx); }

double GeometryUtils::NaturalAngleToAzimuthRad(double angle) {
  double const azimuth = kTruncatedHalfPi - angle;
  // Deliberate: one correction only, and none downwards: an angle below -3/2 pi gives an azimuth
  // above two pi.
  return azimuth < 0.0 ? azimuth + kTruncatedTwoPi : azimuth;
}

double GeometryUtils::NaturalAngleToTangentialAzimuthRad(double angle, bool flag) {
  // Deliberate: only the second form wraps. An angle of 0 gives -0.0 there.
  if (flag) return kTruncatedPi - angle;
  return angle > 0.0 ? kTruncatedTwoPi - angle : -angle;
}

double GeometryUtils::SubtrAng(double a, double b) {
  double const difference = a - b;
  if (difference >= kTruncatedPi) return difference - kTruncatedTwoPi;
  if (difference > -kTruncatedPi) return difference;
  return difference + kTruncatedTwoPi;
}

double GeometryUtils::GetArcLength(Arc const& arc) {
  double start = arc.startAngle;
  double end = arc.endAngle;
  if (arc.direction > 0.0) {
    if (start > end) end += kTruncatedTwoPi;
    return (end - start) * arc.radius;
  }
  if (end > start) end -= kTruncatedTwoPi;
  return (start - end) * arc.radius;
}

double GeometryUtils::GetArcAngleRad(Arc const& arc) {
  return Numeric::IsZero(arc.radius) ? 0.0 : GetArcLength(arc) / arc.radius;
}

}  // namespace Vorn
