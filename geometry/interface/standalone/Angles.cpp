// Standalone members: no other operation of the library uses them. Angle conventions and the
// difference of two angles; each wraps at most once.

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

}  // namespace Vorn
