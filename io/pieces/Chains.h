#pragma once

#include <cstddef>
#include <vector>

#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// The two ends of something that can be chained with others.
struct Ends {
  XY start;
  XY end;
};

/// One of them in a chain.
struct Link {
  std::size_t index = 0;
  bool isReversed = false;  ///< it is run through from its end to its start
};

/// A chain, which may be closed by its ends.
struct LinkChain {
  std::vector<Link> links;
  bool isClosed = false;  ///< its ends are no further apart than the tolerance
};

/// Chains by their ends, whatever their order and sense: each begins with the first that is in no
/// other yet and grows at both ends until it is closed. Of several that go on, the first counts.
/// The tolerance must be above 0. O(n log n), also for ends in one place; only ends that share a
/// cell of the tolerance without being within it of each other cost more.
std::vector<LinkChain> ChainsOf(std::vector<Ends> const& all, double tolerance);

}  // namespace Vorn::IO
