// Members for the length and the sweep of an arc.

#include "geometry/elementary/Angles.h"

#include "vorn/GeometryUtils.h"

namespace Vorn {

double GeometryUtils::GetArcLength(Arc const& arc) { return Elementary::ArcLength(arc); }

double GeometryUtils::GetArcAngleRad(Arc const& arc) { return Elementary::ArcSweep(arc); }

}  // namespace Vorn
