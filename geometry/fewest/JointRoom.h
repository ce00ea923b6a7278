#pragma once

#include <cstdint>
#include <limits>

#include "geometry/fewest/Path.h"

/// How far a joint between two points may lie off the straight way from one to the other.
namespace Vorn::Fewest {

/// Distances to both sides of the straight way; infinite for no limit.
struct JointRoom {
  double left = std::numeric_limits<double>::infinity();
  double right = std::numeric_limits<double>::infinity();
};

/// Whether the two points beside a split lie so far apart that the points next to them tell the
/// direction of the path there. A joint may lie at either of them then.
bool IsWideGap(Path const& path, std::int32_t split);

/// The room in the gap before point `split`: no more than pieces may leave the path between points,
/// and more limited where the gap is wide. There the joint of a corner lies near the place where
/// the straight lines through the points before and behind meet, unless the path turns there by
/// more than 150 degrees, or by more than 30 at the next points already; a joint elsewhere may lie
/// as far off as an arc of the greatest step bulges. So nothing reaches far out between the points
/// of a polygon, where pieces of two points say nothing about what lies between them.
JointRoom RoomForJoint(Path const& path, std::int32_t split);

}  // namespace Vorn::Fewest
