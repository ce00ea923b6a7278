// Slanted bounds of runs of pieces, which keep bundles and fans of long slanted pieces apart.
//   D. Ballard, "Strip Trees: A Hierarchical Representation for Curves", CACM 24(5), 1981.

#pragma once

#include <cmath>
#include <cstddef>

#include "geometry/contours/near/Box.h"
#include "geometry/elementary/Points.h"

namespace Vorn::Contours {

using Elementary::Point;

/// The region on the left of two sides that run in opposite senses, between their ends.
struct Trapezium {
  struct Side {
    Point from;
    Point to;
  };
  Side lower;
  Side upper;
};

/// At most so many trapezia are bounded by one.
inline constexpr std::size_t kMostParts = 6;

/// The trapezium of a region that is not empty: of a segment both long sides are the segment
/// itself, of a box they are its longer sides.
Trapezium TrapeziumOf(Extent const& extent);

/// A trapezium around one to kMostParts others. It lies along the longest of them and takes its
/// slopes from the outermost of the long ones.
Trapezium Around(Trapezium const* parts, std::size_t count);

/// Whether the second trapezium lies beyond the line of a long side of the first, by more than
/// margin.
inline bool IsBeyond(Trapezium::Side const& side, Trapezium const& t, double margin) {
  double const dx = side.to.x - side.from.x;
  double const dy = side.to.y - side.from.y;
  double const gap = margin * (std::fabs(dx) + std::fabs(dy));
  auto const isBeyond = [&](Point const& p) {
    return dy * (p.x - side.from.x) - dx * (p.y - side.from.y) > gap;
  };
  return isBeyond(t.lower.from) && isBeyond(t.lower.to) && isBeyond(t.upper.from) &&
         isBeyond(t.upper.to);
}

/// Whether the second trapezium is beyond one of the long sides of the first by more than margin.
inline bool IsOutside(Trapezium const& first, Trapezium const& second, double margin) {
  return IsBeyond(first.lower, second, margin) || IsBeyond(first.upper, second, margin);
}

}  // namespace Vorn::Contours
