// Arcs against segments and against arcs.
//
// Of an arc the centre, radius, direction and angles are read, never the end. The range of an arc
// is open: its own end points do not count, nor do the angles +-3.1415926535897905, where a range
// that passes the seam of atan2 is split.

#pragma once

#include <optional>

#include "geometry/elementary/Shapes.h"
#include "geometry/intersections/Circles.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Intersections {

using Arc = GeometryUtils::Arc;

/// The common points of a segment, ends included, and an arc: of two the one nearer to the end of
/// the segment first. Nothing for an arc of equal angles, which has no range.
std::optional<CirclePoints> CutArcBySegment(Arc const& arc, Segment const& segment);

/// The common points of two arcs: first the one on the left when looking from the centre of the
/// bigger circle to that of the smaller (for equal radii, from the first). None for arcs of one
/// circle; one where half the common chord is not above one double epsilon. Nothing when a radius
/// is not above zero.
std::optional<CirclePoints> CutArcByArc(Arc const& first, Arc const& second);

}  // namespace Vorn::Intersections
