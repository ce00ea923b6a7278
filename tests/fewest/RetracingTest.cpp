#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fewest/Retracing.h"
#include "support/fewest/ProfileChain.h"

namespace Vorn::Fewest {
namespace {

constexpr std::int32_t kReach = 4;

/// The number of edges among the points [first, last]: pieces from one point exactly to the next.
int CountEdges(Path const& path, Chain const& chain, std::int32_t first, std::int32_t last) {
  int edges = 0;
  for (std::size_t k = 1; k + 1 < chain.pieces.size(); ++k) {
    ChainPiece const& piece = chain.pieces[k];
    if (piece.first < first || piece.end > last || piece.end != piece.first + 1) continue;
    auto const isAt = [&](std::size_t gate, std::int32_t point) {
      Place const joint = PlaceOn(chain.gates[gate], chain.offsets[gate]);
      return joint.x == path.At(point).x && joint.y == path.At(point).y;
    };
    edges += isAt(k - 1, piece.first) && isAt(k, piece.end) ? 1 : 0;
  }
  return edges;
}

TEST(Retracing, FollowsThePathNearAPointAndLeavesOtherPieces) {
  Path const path = NoisyProfile();
  Chain const chain = ChainOf(path);
  ASSERT_EQ(chain.pieces.size(), 16U);
  ChainPiece const& piece = chain.pieces[7];
  std::int32_t const point = (piece.first + piece.end) / 2;
  Retracing retracing(path, kChainShare, chain);
  ASSERT_TRUE(retracing.Follow({point}, kReach));
  Chain const& traced = retracing.Current();
  ExpectEveryPointOnce(traced, path.Count());
  EXPECT_EQ(CountEdges(path, traced, point - kReach, point + kReach), 2 * kReach);
  // One piece leads to the edges and one back from them.
  EXPECT_EQ(traced.pieces.size(), chain.pieces.size() + 2 * kReach + 1);
  for (std::size_t k = 0; k < 7; ++k) ExpectSamePiece(traced.pieces[k], chain.pieces[k]);
  for (std::size_t back = 1; back <= 8; ++back) {
    ExpectSamePiece(traced.pieces[traced.pieces.size() - back], chain.pieces[16 - back]);
  }
}

TEST(Retracing, ReplacesAJoint) {
  Path const path = NoisyProfile();
  Chain const chain = ChainOf(path);
  std::int32_t const split = chain.pieces[8].first;
  Retracing retracing(path, kChainShare, chain);
  ASSERT_TRUE(retracing.Follow({split}, kReach));
  ExpectEveryPointOnce(retracing.Current(), path.Count());
  EXPECT_EQ(CountEdges(path, retracing.Current(), split - kReach, split + kReach), 2 * kReach);
}

TEST(Retracing, AddsToTheEdgesOfCallsBefore) {
  Path const path = NoisyProfile();
  Retracing retracing(path, kChainShare, ChainOf(path));
  ASSERT_TRUE(retracing.Follow({100}, kReach));
  ASSERT_TRUE(retracing.Follow({300}, kReach));
  ExpectEveryPointOnce(retracing.Current(), path.Count());
  EXPECT_EQ(CountEdges(path, retracing.Current(), 0, path.Count()), 4 * kReach);
  EXPECT_FALSE(retracing.Follow({100, 300}, kReach)) << "no edge is new";
}

TEST(Retracing, BeginsAndEndsAtTheOuterPoints) {
  Path const path = NoisyProfile();
  std::int32_t const count = path.Count();
  Retracing retracing(path, kChainShare, ChainOf(path));
  ASSERT_TRUE(retracing.Follow({0, count - 1}, kReach));
  ExpectEveryPointOnce(retracing.Current(), count);
  EXPECT_EQ(retracing.Current().pieces.front().end, 1);
  EXPECT_EQ(retracing.Current().pieces.back().first, count - 2);
}

TEST(Retracing, WithoutPointsFollowsNothing) {
  Path const path = NoisyProfile();
  Retracing retracing(path, kChainShare, ChainOf(path));
  EXPECT_FALSE(retracing.Follow({}, kReach));
}

TEST(FindChainWithEdges, WithoutJointsIsTheChain) {
  Path const path = NoisyProfile();
  Chain const chain = ChainOf(path);
  Chain const found = FindChainWithEdges(path, kChainShare, std::vector<char>(path.points.size()));
  ASSERT_EQ(found.pieces.size(), chain.pieces.size());
  for (std::size_t k = 0; k < chain.pieces.size(); ++k) {
    ExpectSamePiece(found.pieces[k], chain.pieces[k]);
  }
}

TEST(FindChainWithEdges, PassesOverPointsThatCoincide) {
  Path path;
  for (std::int32_t i = 0; i < 8; ++i) path.points.push_back({0.1 * i, 0.0, 0.001});
  path.points.insert(path.points.begin() + 4, 3, path.points[4]);
  path.leastTolerance = 0.001;
  std::vector<char> const isJoint(path.points.size(), 1);
  Chain const found = FindChainWithEdges(path, kChainShare, isJoint);
  ExpectEveryPointOnce(found, path.Count());
  // The point that is there four times begins one edge.
  EXPECT_EQ(found.pieces.size(), 7U);
}

TEST(FindChainWithEdges, FollowsEveryEdgeWhereAllPointsAreJoints) {
  Path const path = NoisyProfile();
  std::vector<char> const isJoint(path.points.size(), 1);
  Chain const found = FindChainWithEdges(path, kChainShare, isJoint);
  ExpectEveryPointOnce(found, path.Count());
  EXPECT_EQ(found.pieces.size(), path.points.size() - 1);
}

}  // namespace
}  // namespace Vorn::Fewest
