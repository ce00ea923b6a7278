// Fitted pieces as elements of a contour.

#pragma once

#include "geometry/contours/Elements.h"
#include "geometry/fitting/runs/Pieces.h"

namespace Vorn::Fitting {

/// The element of an arc. A segment needs no more than its end: see Contours::SegmentTo.
inline GeometryUtils::Elem ElementOf(FittedArc const& arc) {
  return Contours::ArcElement({arc.start, arc.end, arc.circle.centre, arc.circle.radius, !arc.ccw});
}

}  // namespace Vorn::Fitting
