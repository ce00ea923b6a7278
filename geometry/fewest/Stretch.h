#pragma once

#include <cstddef>

#include "geometry/fewest/BackwardPass.h"
#include "geometry/fewest/Path.h"

/// Part of a chain as a chain of its own, between joints that stay where they are.
namespace Vorn::Fewest {

/// The pieces [first, end) of a chain.
struct Stretch {
  std::size_t first = 0;
  std::size_t end = 0;

  /// How many pieces there are.
  std::size_t Size() const { return end - first; }
  /// As many pieces more as it has, half of them on either side, within a chain of `count`.
  Stretch Widened(std::size_t count) const;
};

/// Whether both outer pieces of a stretch cover points. Where one does not, the stretch has no
/// first or no last point to be searched from, and PathOf must not be asked for it.
bool HasOuterPoints(Chain const& chain, Stretch const& stretch);

/// The points of a stretch as a path from joint to joint.
Path PathOf(Path const& path, Chain const& chain, Stretch const& stretch);

/// The pieces of a stretch, the points counted from its first one.
Chain PartOf(Chain const& chain, Stretch const& stretch);

/// The same pieces, the points counted from a place `by` points before.
Chain MovedBy(Chain chain, std::int32_t by);

/// Puts pieces in the place of those of a stretch, as many as it has.
void Put(Chain const& part, Stretch const& stretch, Chain* chain);

}  // namespace Vorn::Fewest
