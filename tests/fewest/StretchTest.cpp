#include <cstddef>

#include "geometry/fewest/Stretch.h"
#include "gtest/gtest.h"

// Stretches of a chain along the x axis: pieces of ten points, joints halfway between two points.

namespace Vorn::Fewest {
namespace {

constexpr std::int32_t kPointsOfPiece = 10;

Path StraightPath(std::int32_t pieces) {
  Path path;
  for (std::int32_t i = 0; i < kPointsOfPiece * pieces; ++i) {
    path.points.push_back({static_cast<double>(i), 0.0, 0.1});
  }
  path.leastTolerance = 0.1;
  return path;
}

Chain StraightChain(std::int32_t pieces) {
  Chain chain;
  for (std::int32_t k = 0; k < pieces; ++k) {
    std::int32_t const end = kPointsOfPiece * (k + 1);
    chain.pieces.push_back({end - kPointsOfPiece, end, {{0.0, 0.0, 1.0, 0.0}, {}}, 0.1 * k});
    if (k + 1 == pieces) break;
    chain.gates.push_back({end, {end - 0.5, 0.0}, {0.0, 1.0}, -1.0, 1.0, false});
    chain.offsets.push_back(0.01 * k);
  }
  return chain;
}

TEST(HasOuterPoints, AsksOnlyThePiecesAtItsEnds) {
  Chain chain = StraightChain(5);
  EXPECT_TRUE(HasOuterPoints(chain, {1, 4}));
  chain.pieces[2].end = chain.pieces[2].first;
  EXPECT_TRUE(HasOuterPoints(chain, {1, 4}));
  EXPECT_FALSE(HasOuterPoints(chain, {1, 3}));
  EXPECT_FALSE(HasOuterPoints(chain, {2, 4}));
  EXPECT_FALSE(HasOuterPoints(chain, {2, 3}));
}

TEST(PathOf, BeginsAndEndsAtTheJointsBesideTheStretch) {
  Path const part = PathOf(StraightPath(5), StraightChain(5), {1, 4});
  ASSERT_EQ(part.Count(), 30);
  EXPECT_EQ(part.At(0).x, 10.0);
  EXPECT_FALSE(part.start.isFree);
  EXPECT_EQ(part.start.gate.split, 0);
  EXPECT_EQ(part.start.low, 0.0);
  EXPECT_EQ(part.start.high, 0.0);
  EXPECT_FALSE(part.finish.isFree);
  EXPECT_EQ(part.finish.gate.split, 30);
  EXPECT_EQ(part.finish.low, 0.03);
  EXPECT_EQ(part.finish.high, 0.03);
}

TEST(PathOf, KeepsTheFreeEndsOfTheWholePath) {
  Path const whole = PathOf(StraightPath(5), StraightChain(5), {0, 5});
  EXPECT_EQ(whole.Count(), 50);
  EXPECT_TRUE(whole.start.isFree);
  EXPECT_TRUE(whole.finish.isFree);
}

TEST(PathOf, SeesACuspFromBehind) {
  Chain chain = StraightChain(3);
  chain.gates[1].isCusp = true;
  Path const part = PathOf(StraightPath(3), chain, {2, 3});
  EXPECT_EQ(part.start.low, -0.01);
  EXPECT_EQ(part.start.gate.across.y, -1.0);
}

TEST(PartOf, CountsPointsFromTheFirstOfTheStretch) {
  Chain const part = PartOf(StraightChain(5), {1, 4});
  ASSERT_EQ(part.pieces.size(), 3U);
  ASSERT_EQ(part.gates.size(), 2U);
  ASSERT_EQ(part.offsets.size(), 2U);
  EXPECT_EQ(part.pieces[0].first, 0);
  EXPECT_EQ(part.pieces[2].end, 30);
  EXPECT_EQ(part.gates[0].split, 10);
  EXPECT_EQ(part.offsets[1], 0.02);
}

TEST(Put, IsTheInverseOfPartOf) {
  Chain const chain = StraightChain(5);
  Chain changed = chain;
  Chain part = PartOf(chain, {1, 4});
  part.pieces[1].ratio = 0.7;
  part.gates[1].split += 2;
  part.pieces[1].end += 2;
  part.pieces[2].first += 2;
  Put(part, {1, 4}, &changed);
  EXPECT_EQ(changed.pieces[2].ratio, 0.7);
  EXPECT_EQ(changed.pieces[2].end, 32);
  EXPECT_EQ(changed.pieces[3].first, 32);
  EXPECT_EQ(changed.gates[2].split, 32);
  for (std::size_t const k : {0U, 1U, 4U}) {
    EXPECT_EQ(changed.pieces[k].first, chain.pieces[k].first);
    EXPECT_EQ(changed.pieces[k].end, chain.pieces[k].end);
  }
  EXPECT_EQ(changed.gates[0].split, 10);
  EXPECT_EQ(changed.gates[3].split, 40);
}

TEST(Stretch, WidensWithinTheChain) {
  Stretch const one{3, 4};
  EXPECT_EQ(one.Widened(10).first, 2U);
  EXPECT_EQ(one.Widened(10).end, 5U);
  Stretch const atStart = Stretch{0, 3}.Widened(4);
  EXPECT_EQ(atStart.first, 0U);
  EXPECT_EQ(atStart.end, 4U);
}

}  // namespace
}  // namespace Vorn::Fewest
