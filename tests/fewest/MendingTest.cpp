#include <gtest/gtest.h>

#include <cstddef>
#include <vector>

#include "geometry/fewest/Mending.h"
#include "support/fewest/ProfileChain.h"

// A noisy profile of sixteen pieces of which one is said to break a promise.

namespace Vorn::Fewest {
namespace {

constexpr std::size_t kBroken = 7;

std::vector<Promises::Violation> BrokenAt(std::size_t piece) {
  return {{Promises::Promise::InOrder, piece, Promises::kNone, 0, {}, 1.0}};
}

TEST(Mending, WithoutViolationsLeavesTheChain) {
  Path const path = NoisyProfile();
  Chain const chain = ChainOf(path);
  Mending mending(path, kChainShare, chain);
  EXPECT_FALSE(mending.Mend({}));
  ASSERT_EQ(mending.Current().pieces.size(), chain.pieces.size());
  for (std::size_t k = 0; k < chain.pieces.size(); ++k) {
    ExpectSamePiece(mending.Current().pieces[k], chain.pieces[k]);
  }
}

TEST(Mending, SearchesThePieceAndItsNeighboursAndLeavesTheOthers) {
  Path const path = NoisyProfile();
  Chain const chain = ChainOf(path);
  ASSERT_EQ(chain.pieces.size(), 16U);
  Mending mending(path, kChainShare, chain);
  ASSERT_TRUE(mending.Mend(BrokenAt(kBroken)));
  Chain const& mended = mending.Current();
  ExpectEveryPointOnce(mended, path.Count());
  ASSERT_GE(mended.pieces.size(), chain.pieces.size());
  for (std::size_t k = 0; k < kBroken - 1; ++k) ExpectSamePiece(mended.pieces[k], chain.pieces[k]);
  for (std::size_t back = 1; back < chain.pieces.size() - kBroken - 1; ++back) {
    ExpectSamePiece(mended.pieces[mended.pieces.size() - back],
                    chain.pieces[chain.pieces.size() - back]);
  }
  ChainPiece const& old = chain.pieces[kBroken];
  ChainPiece const& now = mended.pieces[kBroken];
  EXPECT_TRUE(now.first != old.first || now.end != old.end ||
              now.circle.about.a != old.circle.about.a)
      << "smaller tolerances have another best piece";
}

TEST(Mending, EndsWhenNoSmallerToleranceIsLeft) {
  Path const path = NoisyProfile();
  Mending mending(path, kChainShare, ChainOf(path));
  int rounds = 0;
  while (rounds < 100 && mending.Mend(BrokenAt(kBroken))) {
    ++rounds;
    ExpectEveryPointOnce(mending.Current(), path.Count());
  }
  EXPECT_GT(rounds, 1);
  EXPECT_LT(rounds, 100);
}

TEST(Mending, MendsPlacesThatAreFarApartAtOnce) {
  Path const path = NoisyProfile();
  Chain const chain = ChainOf(path);
  Mending mending(path, kChainShare, chain);
  std::vector<Promises::Violation> violations = BrokenAt(1);
  violations.push_back(BrokenAt(14).front());
  ASSERT_TRUE(mending.Mend(violations));
  ExpectEveryPointOnce(mending.Current(), path.Count());
  ChainPiece const& middle = chain.pieces[kBroken];
  bool isKept = false;
  for (ChainPiece const& piece : mending.Current().pieces) {
    if (piece.first == middle.first && piece.end == middle.end) isKept = true;
  }
  EXPECT_TRUE(isKept) << "the pieces between them stay";
}

}  // namespace
}  // namespace Vorn::Fewest
