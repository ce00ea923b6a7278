#pragma once

#include <cstddef>
#include <cstdint>
#include <span>

#include "vorn/Types.h"

/// Places where points lie too far from any straight line.
namespace Vorn::Fewest {

/// Whether the middle point of [first, end) lies so far from the chord between the ends that no
/// line is within the tolerances of all three. Never true where a line is. O(1).
bool IsBent(std::span<WPoint const> points, std::int32_t first, std::int32_t end);

/// The number of pieces below which no segments cover the points: a low estimate at little cost.
/// Counts no further than `enough`. O(log n) for each bend.
std::size_t CountBentRuns(std::span<WPoint const> points, std::size_t enough);

}  // namespace Vorn::Fewest
