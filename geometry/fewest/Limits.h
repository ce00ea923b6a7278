#pragma once

#include <cstddef>
#include <limits>

/// What a piece may be, besides within tolerance.
namespace Vorn::Fewest {

/// Bounds on every piece, in the unit of the points.
struct Limits {
  /// Least radius; 0 for none.
  double smallestRadius = 0.0;
  /// Greatest radius of an arc; infinite for none.
  double largestRadius = std::numeric_limits<double>::infinity();
  /// No arcs at all.
  bool segmentsOnly = false;
  /// Sine of half the greatest angle between neighbours on an arc.
  double sineOfHalfStep = 0.5;
  /// How far a piece may leave the path between neighbours; infinite for none.
  double farthestBetweenPoints = std::numeric_limits<double>::infinity();
  /// How far a joint between two points may lie off the straight way from one to the other, in
  /// halves of it, in addition to their tolerances.
  double jointRoom = 1.0;
  /// From how many states of the level before a gate takes offsets; more look wider.
  std::size_t mostSources = 2;
  /// Whether the gate of a corner lies where the circles of the longest runs on both sides cross,
  /// not only those of the points beside it: this takes longer and finds corners in any noise.
  bool looksFar = false;
};

}  // namespace Vorn::Fewest
