#pragma once

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/LocalFrame.h"
#include "support/fewest/Scans.h"

/// A noisy profile of sixteen pieces and its chain, for tests of what is done to chains.
namespace Vorn::Fewest {

constexpr double kChainShare = 1.0 - 1e-6;

inline Path NoisyProfile() {
  Testing::Scan const scan =
      Testing::MakeNoisyProfile(8201, Testing::ProfileStyle::Mixed, 1, 600, 0.45);
  Shift const shift = ShiftFor(scan);
  Path path;
  path.points = shift.Apply(scan);
  path.leastTolerance = Tightest(scan).w * shift.scale;
  return path;
}

inline Chain ChainOf(Path const& path) {
  return FindChain(path, kChainShare, [](std::int32_t) {});
}

inline void ExpectSamePiece(ChainPiece const& one, ChainPiece const& other) {
  EXPECT_EQ(one.first, other.first);
  EXPECT_EQ(one.end, other.end);
  EXPECT_EQ(one.circle.about.a, other.circle.about.a);
  EXPECT_EQ(one.circle.about.d, other.circle.about.d);
}

inline void ExpectEveryPointOnce(Chain const& chain, std::int32_t count) {
  ASSERT_FALSE(chain.pieces.empty());
  ASSERT_EQ(chain.gates.size() + 1, chain.pieces.size());
  ASSERT_EQ(chain.offsets.size(), chain.gates.size());
  std::int32_t next = 0;
  for (std::size_t k = 0; k < chain.pieces.size(); ++k) {
    EXPECT_EQ(chain.pieces[k].first, next);
    next = chain.pieces[k].end;
    if (k == chain.gates.size()) break;
    EXPECT_EQ(chain.gates[k].split, next);
  }
  EXPECT_EQ(next, count);
}

}  // namespace Vorn::Fewest
