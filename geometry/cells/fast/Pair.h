// Two doubles that are worked on at once. Lanes never meet in a sum, so the results are those of
// plain doubles.

#pragma once

#include <cstdint>
#include <limits>

namespace Vorn::Cells {

/// Two doubles.
using Pair [[gnu::vector_size(16)]] = double;

/// Two sets of bits, one a lane. A comparison of pairs gives all bits where it holds, none
/// elsewhere.
using PairBits [[gnu::vector_size(16)]] = std::int64_t;

/// The bits of both lanes.
inline unsigned Union(PairBits const& bits) { return static_cast<unsigned>(bits[0] | bits[1]); }

/// The lesser value in each lane; the first where one is not a number.
inline Pair Least(Pair const& a, Pair const& b) { return b < a ? b : a; }

/// The greater value in each lane; the first where one is not a number.
inline Pair Most(Pair const& a, Pair const& b) { return b > a ? b : a; }

/// The values without their signs.
inline Pair Sizes(Pair const& a) {
  return reinterpret_cast<Pair>(reinterpret_cast<PairBits>(a) &
                                std::numeric_limits<std::int64_t>::max());
}

}  // namespace Vorn::Cells
