#pragma once

#include <cstddef>
#include <span>

#include "geometry/fewest/Bound.h"
#include "geometry/fewest/Limits.h"
#include "vorn/Types.h"

/// How few circles and lines can cover the points of a closed contour.
namespace Vorn::Fewest {

/// Below this number no closed contour goes: neither a segment nor an arc of less than a full turn
/// ends where it begins.
inline constexpr std::size_t kLeastClosedPieces = 2;

/// The least number of runs that cover the points of a closed contour, on which the first point
/// follows the last, and kLeastClosedPieces at least. `open` is the greedy cover of the same points
/// as an open path.
///
/// A closed cover of m runs, cut where the input ends, is an open one of m + 1 at most, so that the
/// answer is that of the open path or one less. It is one less when as few runs, each the longest,
/// lead from some start once around. No cover has a run that reaches beyond a longest one from its
/// start to its end, so each begins a run behind the start of any longest one and at its end at the
/// latest: these are the starts to be tried. Of longest runs the end never comes earlier for a
/// later start, so that runs which lead from s to e, less than once around, say the same of all
/// starts from s down to e less one turn: a few walks are enough where runs do not repeat
/// themselves. Where kMostWalks are not, the answer is one less than the open one, which is below
/// the truth at worst.
std::size_t LeastClosedCover(std::span<WPoint const> points, Limits const& limits,
                             Cover const& open);

}  // namespace Vorn::Fewest
