// Where the sides of one triangle cross the sides of another.
//
// Points come out by side of the first triangle and along a side by distance from its start. A
// point found is held back until the next one on the same side tells which of the two is nearer.

#pragma once

#include <cstddef>
#include <optional>

#include "geometry/triangles/InlineVector.h"
#include "geometry/triangles/PreparedTriangle.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Triangles {

using CrossingPoint = GeometryUtils::CrossingPoint;

/// How many points stay on a side of the first triangle.
inline constexpr std::size_t kKeptOnSide = 2;

/// How many points are found on a side: two ends of the stretches shared with three others.
inline constexpr std::size_t kMostOnSide = 6;

/// Crossing points, with room for two sides done and one that is being searched.
using CrossingPoints = InlineVector<CrossingPoint, 2 * kKeptOnSide + kMostOnSide>;

/// A set of pairs of sides: bit 3 i + j stands for side i of the first triangle and side j of the
/// second.
using SidePairs = unsigned;

/// The points found on one side of the first triangle, put in order of their distance from its
/// start two by two.
class SidePoints {
 public:
  /// Appends to `points`. `start` must outlive this.
  SidePoints(Point const& start, CrossingPoints* points) : start_(start), points_(*points) {}

  /// Takes a single crossing: holds it back, or appends it together with the one held.
  void TakeCrossing(CrossingPoint const& found);

  /// Takes the ends of a stretch that the side shares with another. Deliberate: a crossing held
  /// back is dropped, the ends stand for it.
  void TakeStretch(CrossingPoint const& end1, CrossingPoint const& end2);

  /// Appends a crossing still held back.
  void Finish();

 private:
  Point const& start_;
  CrossingPoints& points_;
  std::optional<CrossingPoint> held_;
};

/// The pairs of sides that may meet: they cross, as the intersection of two segments decides it,
/// or they are parallel and not apart. All pairs where a coordinate is not a number.
SidePairs PairsThatMayMeet(PreparedTriangle const& first, PreparedTriangle const& second);

/// The crossings of the given pairs of sides, at most two a side of the first triangle; the other
/// pairs must not meet. Where two sides share a stretch of a line, its ends are taken.
/// Deliberate: of three or more points on a side the two farthest apart survive, and the side
/// number is then rewritten as side1 of the one and side2 of the other.
void FindCrossingPoints(Triangle const& first, Triangle const& second, SidePairs pairs,
                        CrossingPoints* points);

}  // namespace Vorn::Triangles
