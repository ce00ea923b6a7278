#pragma once

#include <cstddef>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"

namespace Vorn::IO {

/// The smallest box around the points, sides along the axes.
struct VORN_IO_EXPORT PointsBox {
  double lowX = 0.0;   ///< the left side
  double highX = 0.0;  ///< the right side
  double lowY = 0.0;   ///< the lower side
  double highY = 0.0;  ///< the upper side

  /// From left to right.
  double Width() const { return highX - lowX; }
  /// From below to above.
  double Height() const { return highY - lowY; }
  /// From corner to corner.
  double Diagonal() const;
};

/// The box of the points; needs at least one.
VORN_IO_EXPORT PointsBox BoxOf(std::vector<WPoint> const& points);

/// Distances between neighbours. The closing gap of a closed contour is none of them.
struct SpacingFacts {
  double least = 0.0;           ///< the shortest distance
  std::size_t leastSecond = 0;  ///< index of the later point of the first pair that near
  double median = 0.0;          ///< of an even number of distances the mean of the middle two
  double most = 0.0;            ///< the longest distance
  std::size_t mostSecond = 0;   ///< index of the later point of the first pair that far
  double length = 0.0;          ///< the sum
};

/// Needs two points.
VORN_IO_EXPORT SpacingFacts SpacingOf(std::vector<WPoint> const& points);

/// A point that lies exactly where an earlier one does.
struct Duplicate {
  std::size_t earlier = 0;     ///< the first point in that place
  std::size_t later = 0;       ///< index of the point that repeats it
  bool areNeighbours = false;  ///< the point just before `later` lies there as well
};

/// Every point that repeats an earlier one, in the order of the points. O(n log n).
VORN_IO_EXPORT std::vector<Duplicate> FindDuplicates(std::vector<WPoint> const& points);

}  // namespace Vorn::IO
