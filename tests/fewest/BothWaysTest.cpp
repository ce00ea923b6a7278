#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "geometry/fewest/BothWays.h"
#include "geometry/fewest/Bound.h"
#include "geometry/fewest/LocalFrame.h"
#include "support/fewest/Scans.h"

namespace Vorn::Fewest {
namespace {

using Testing::MakeNoisyProfile;
using Testing::ProfileStyle;

constexpr double kShare = 1.0 - 1e-6;

Path PathOf(Testing::Scan const& scan) {
  Shift const shift = ShiftFor(scan);
  Path path;
  path.points = shift.Apply(scan);
  path.leastTolerance = Tightest(scan).w * shift.scale;
  return path;
}

/// The start of a cover by one run, below which no chain comes.
std::vector<std::int32_t> const kOneRun{0};

void Silent(std::int32_t) {}

Chain FindCorners(Path const& path) { return FindChain(path, kShare, Silent); }

Path Corners() { return PathOf(MakeNoisyProfile(1, ProfileStyle::Corners, 1, 400, 0.45)); }

TEST(ReversedChain, TwiceIsTheChainItself) {
  Path const path = Corners();
  Chain const chain = FindCorners(path);
  ASSERT_EQ(chain.pieces.size(), 16U);
  Chain const twice = Reversed(Reversed(chain, path.Count()), path.Count());
  ASSERT_EQ(twice.pieces.size(), chain.pieces.size());
  for (std::size_t k = 0; k < chain.pieces.size(); ++k) {
    EXPECT_EQ(twice.pieces[k].first, chain.pieces[k].first);
    EXPECT_EQ(twice.pieces[k].end, chain.pieces[k].end);
    EXPECT_EQ(twice.pieces[k].circle.about.d, chain.pieces[k].circle.about.d);
    EXPECT_EQ(twice.pieces[k].circle.about.a, chain.pieces[k].circle.about.a);
  }
  for (std::size_t k = 0; k < chain.gates.size(); ++k) {
    EXPECT_EQ(twice.gates[k].split, chain.gates[k].split);
    EXPECT_EQ(twice.gates[k].across.x, chain.gates[k].across.x);
    EXPECT_EQ(twice.gates[k].least, chain.gates[k].least);
    EXPECT_EQ(twice.gates[k].greatest, chain.gates[k].greatest);
    EXPECT_EQ(twice.offsets[k], chain.offsets[k]);
  }
}

TEST(ReversedChain, HasItsJointsOnBothCirclesAndCoversTheReversedPoints) {
  Path const path = Corners();
  Path const back = Reversed(path);
  Chain const chain = Reversed(FindCorners(path), path.Count());
  std::int32_t covered = 0;
  for (std::size_t k = 0; k < chain.pieces.size(); ++k) {
    ChainPiece const& piece = chain.pieces[k];
    EXPECT_EQ(piece.first, covered);
    covered = piece.end;
    for (std::int32_t i = piece.first; i < piece.end; ++i) {
      WPoint const& p = back.At(i);
      EXPECT_LE(std::fabs(DistanceOf(piece.circle.about.a, ValueAt(piece.circle, {p.x, p.y}))),
                p.w);
    }
    if (k + 1 == chain.pieces.size()) break;
    Place const joint = PlaceOn(chain.gates[k], chain.offsets[k]);
    double const room = 1e-6 * path.leastTolerance;
    EXPECT_NEAR(ValueAt(piece.circle, joint), 0.0, room);
    EXPECT_NEAR(ValueAt(chain.pieces[k + 1].circle, joint), 0.0, room);
    // The value grows to the left of the path, and so do the offsets of its gates.
    Place const gradient = GradientAt(piece.circle, joint);
    Place const& across = chain.gates[k].across;
    EXPECT_GT(gradient.x * across.x + gradient.y * across.y, 0.0);
  }
  EXPECT_EQ(covered, path.Count());
}

TEST(FindChainBothWays, LooksBackwardsOnlyWhereThereMayBeFewer) {
  Path const path = Corners();
  std::size_t const forwards = FindCorners(path).pieces.size();
  std::vector<std::int32_t> const asManyRuns(forwards, 0);
  EXPECT_EQ(FindChainBothWays(path, kShare, asManyRuns, Silent).pieces.size(), forwards);
  EXPECT_LE(FindChainBothWays(path, kShare, kOneRun, Silent).pieces.size(), forwards);
  Path const back = Reversed(path);
  EXPECT_EQ(FindChainBothWays(path, kShare, kOneRun, Silent).pieces.size(),
            FindChainBothWays(back, kShare, kOneRun, Silent).pieces.size());
}

TEST(FindChainBothWays, LosesNoShorterChainToTheRunsThatAreLeft) {
  int shorterBackwards = 0;
  for (std::uint64_t seed = 1; seed <= 12; ++seed) {
    Path const path = PathOf(MakeNoisyProfile(seed, ProfileStyle::Mixed, 4, 400, 0.99));
    Cover const cover = CoverGreedily(path.points, path.limits, Silent);
    std::size_t const forwards = FindCorners(path).pieces.size();
    std::size_t const backwards = FindCorners(Reversed(path)).pieces.size();
    if (backwards < forwards) ++shorterBackwards;
    EXPECT_EQ(FindChainBothWays(path, kShare, cover.starts, Silent).pieces.size(),
              std::min(forwards, backwards))
        << "seed " << seed;
  }
  EXPECT_GT(shorterBackwards, 0);
}

TEST(FindChainWhile, IsEmptyAsSoonAsItIsNotToGoOn) {
  Path const path = Corners();
  std::size_t asked = 0;
  std::int32_t reached = 0;
  Chain const chain = FindChainWhile(path, kShare, [&](std::size_t pieces, std::int32_t covered) {
    EXPECT_EQ(pieces, ++asked);
    EXPECT_GT(covered, reached);
    reached = covered;
    return pieces < 5;
  });
  EXPECT_TRUE(chain.pieces.empty());
  EXPECT_EQ(asked, 5U);
}

}  // namespace
}  // namespace Vorn::Fewest
