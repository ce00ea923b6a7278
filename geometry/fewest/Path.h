#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <vector>

#include "geometry/fewest/Circle.h"
#include "geometry/fewest/Gates.h"
#include "geometry/fewest/Limits.h"
#include "math/Assert.h"
#include "vorn/Types.h"

/// The measured points as a path.
namespace Vorn::Fewest {

/// Points beyond an end of a path, the nearest first.
struct Outside {
  std::array<WPoint, 2> points;
  std::int32_t count = 0;

  /// The point at a position; null behind the last one.
  WPoint const* At(std::int32_t i) const {
    return i < count ? &points[static_cast<std::size_t>(i)] : nullptr;
  }
  void Add(WPoint const& p) {
    if (count < 2) points[static_cast<std::size_t>(count++)] = p;
  }
};

/// The points, moved near the origin, with what the search asks of them.
struct Path {
  /// The points.
  std::vector<WPoint> points;
  /// What a piece may be.
  Limits limits;
  /// The least of the tolerances.
  double leastTolerance = 1.0;
  /// Where the chain begins and ends: free at the ends of an open path, one fixed place on a gate
  /// of a closed one.
  Opening start;
  Opening finish;
  /// The points next to the ends: those of the other end of a closed path, or of the path that this
  /// is a part of. None where the path ends.
  Outside before;
  Outside behind;

  /// How many points there are.
  std::int32_t Count() const { return static_cast<std::int32_t>(points.size()); }
  /// The point of an index in [0, Count()).
  WPoint const& At(std::int32_t i) const {
    VORN_ASSERT(0 <= i && i < Count());
    return points[static_cast<std::size_t>(i)];
  }
};

/// Has the points at one end of a closed path lie beyond the other.
void Wrap(Path* path);

/// Distance of two points.
double DistanceBetween(WPoint const& p, WPoint const& q);

/// The point of least tolerance, the first of equal ones.
WPoint const& Tightest(std::vector<WPoint> const& points);

/// How many points there are from one to the first that lies clearly ahead of it: 1 where points
/// lie farther apart than their tolerances, more in denser scans, whose neighbours say nothing
/// about direction or order. Every "few points" of the search counts in these strides.
std::int32_t StrideFrom(Path const& path, std::int32_t point);

/// How far a circle advances with the points [first, last), of which the first, every `step`th and
/// the last are looked at; below 0 where they run against it.
double AdvanceAlong(Path const& path, PlacedCircle const& circle, std::int32_t first,
                    std::int32_t last, std::int32_t step);

/// The gate in the middle of the gap before point `split`, square to the path, which is that of
/// `before`, the piece before it, where the points are too dense to tell.
Gate MiddleGate(Path const& path, std::int32_t split, PlacedCircle const& before);

/// Unit vector to the left of the way from one point to another; 0 for coinciding points.
Place LeftNormal(WPoint const& from, WPoint const& to);

/// The gate across a place at which the path arrives with one left normal and leaves with another;
/// its split and limits are left open.
Gate BisectorGate(Place const& place, Place const& normalIn, Place const& normalOut);

}  // namespace Vorn::Fewest
