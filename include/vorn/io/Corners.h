#pragma once

#include <cstddef>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"

namespace Vorn::IO {

/// Turns of fewer degrees are no corners.
inline constexpr double kLeastCorner = 30.0;

/// From here on a corner counts as a reversal: the path goes back on itself.
inline constexpr double kLeastReversal = 150.0;

/// A place where the path turns sharply.
struct Corner {
  std::size_t point = 0;  ///< index of the point where the path turns
  double degrees = 0.0;   ///< 0 to 180
  bool isLeft = false;    ///< counter-clockwise, the y axis pointing up

  /// Whether the path goes back on itself there.
  bool IsReversal() const { return degrees >= kLeastReversal; }
};

/// The places where the path turns by kLeastCorner or more, in the order of the points.
///
/// The turn at a point is that between the chord from the last point that lies at least `reach`
/// before it along the path and the chord to the first one as far behind it; 0 takes the points
/// next to it. Of corners that follow each other within `reach` the sharpest is named. O(n).
///
/// The ends of an open path have no turn. A closed one goes on from its last point to its first,
/// which may be the same point twice and then counts as the first; it has no corners when it is not
/// longer than two reaches.
VORN_IO_EXPORT std::vector<Corner> FindCorners(std::vector<WPoint> const& points, double reach,
                                               bool isClosed = false);

/// How far to reach so that noise of this size alone makes no corners: the directions of both
/// chords are then good to some degrees.
VORN_IO_EXPORT double ReachForNoise(double noise);

}  // namespace Vorn::IO
