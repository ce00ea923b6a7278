#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <random>

#include "io/pieces/Chains.h"

namespace Vorn::IO {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

/// The links of a chain, those run through backwards with a minus, counted from 1.
std::vector<int> Signed(LinkChain const& chain) {
  std::vector<int> numbers;
  for (Link const& link : chain.links) {
    int const number = static_cast<int>(link.index) + 1;
    numbers.push_back(link.isReversed ? -number : number);
  }
  return numbers;
}

XY StartOf(Ends const& ends, Link const& link) { return link.isReversed ? ends.end : ends.start; }
XY EndOf(Ends const& ends, Link const& link) { return link.isReversed ? ends.start : ends.end; }

TEST(ChainsOf, NothingMakesNone) { EXPECT_TRUE(ChainsOf({}, 1.0).empty()); }

TEST(ChainsOf, OneAloneIsAChainAndClosedWhenItsEndsMeet) {
  auto const open = ChainsOf({{{0, 0}, {1, 0}}}, 0.5);
  ASSERT_EQ(open.size(), 1u);
  EXPECT_FALSE(open[0].isClosed);
  auto const closed = ChainsOf({{{0, 0}, {0.5, 0}}}, 0.5);
  ASSERT_EQ(closed.size(), 1u);
  EXPECT_TRUE(closed[0].isClosed);
}

TEST(ChainsOf, ToleranceIsReachedAndNotPassed) {
  auto const chains = [](double gap) {
    return ChainsOf({{{0, 0}, {1, 0}}, {{1 + gap, 0}, {9, 0}}}, 0.25).size();
  };
  EXPECT_EQ(chains(0.25), 1u);
  EXPECT_EQ(chains(std::nextafter(0.25, 1.0) + 1e-15), 2u);
}

TEST(ChainsOf, DistanceCountsAndNotTheCell) {
  // Both differences are below the tolerance of 1, the distance is above it.
  EXPECT_EQ(ChainsOf({{{0, 0}, {5, 5}}, {{5.8, 5.8}, {9, 9}}}, 1.0).size(), 2u);
  EXPECT_EQ(ChainsOf({{{0, 0}, {5, 5}}, {{5.6, 5.8}, {9, 9}}}, 1.0).size(), 1u);
}

TEST(ChainsOf, GoesOnWithAStartBeforeAnEndAndWithTheFirstOfSeveral) {
  // Behind 1 the end of 2 and the starts of 3 and 4 lie in one place.
  auto const chains =
      ChainsOf({{{0, 0}, {1, 0}}, {{2, 2}, {1, 0}}, {{1, 0}, {3, 0}}, {{1, 0}, {3, 3}}}, 0.1);
  ASSERT_EQ(chains.size(), 2u);
  EXPECT_EQ(Signed(chains[0]), (std::vector<int>{1, 3}));
  EXPECT_EQ(Signed(chains[1]), (std::vector<int>{2, 4}));
}

TEST(ChainsOf, GrowsAtTheStartOnlyWhenTheEndIsDone) {
  auto const chains =
      ChainsOf({{{5, 0}, {6, 0}}, {{5, 0}, {4, 0}}, {{6, 0}, {7, 0}}, {{3, 0}, {4, 0}}}, 0.1);
  ASSERT_EQ(chains.size(), 1u);
  EXPECT_EQ(Signed(chains[0]), (std::vector<int>{4, -2, 1, 3}));
}

TEST(ChainsOf, RaysFromOnePlaceArePairedInTheirOrder) {
  // Looking at every end of the place for every ray would take minutes.
  constexpr int kRays = 200000;
  std::vector<Ends> rays;
  for (int i = 0; i < kRays; ++i) rays.push_back({{0, 0}, {10.0 * (i + 1), 0}});
  auto const chains = ChainsOf(rays, 0.1);
  ASSERT_EQ(chains.size(), kRays / 2u);
  for (std::size_t i = 0; i < chains.size(); ++i) {
    int const first = static_cast<int>(2 * i) + 1;
    ASSERT_EQ(Signed(chains[i]), (std::vector<int>{-(first + 1), first})) << i;
  }
}

TEST(ChainsOf, StopsWhereItIsClosed) {
  // A square, and a line that hangs on its first corner.
  auto const chains = ChainsOf(
      {{{0, 0}, {1, 0}}, {{1, 0}, {1, 1}}, {{1, 1}, {0, 1}}, {{0, 1}, {0, 0}}, {{0, 0}, {-5, 0}}},
      0.01);
  ASSERT_EQ(chains.size(), 2u);
  EXPECT_TRUE(chains[0].isClosed);
  EXPECT_EQ(Signed(chains[0]), (std::vector<int>{1, 2, 3, 4}));
  EXPECT_EQ(Signed(chains[1]), (std::vector<int>{5}));
}

TEST(ChainsOf, ShuffledAndTurnedEdgesOfPolygonsComeBackAsThePolygons) {
  for (std::uint64_t seed = 1; seed <= 40; ++seed) {
    SCOPED_TRACE(seed);
    std::mt19937_64 engine(seed);
    std::vector<Ends> all;
    std::vector<std::size_t> polygonOf;
    std::size_t const polygons = 1 + engine() % 5;
    for (std::size_t p = 0; p < polygons; ++p) {
      int const corners = 3 + static_cast<int>(engine() % 20);
      auto const corner = [&](int i) {
        double const angle = 6.283185307179586 * (i % corners) / corners;
        return XY{100.0 * static_cast<double>(p) + 10.0 * std::cos(angle), 10.0 * std::sin(angle)};
      };
      for (int i = 0; i < corners; ++i) {
        bool const isTurned = engine() % 2 == 0;
        all.push_back(isTurned ? Ends{corner(i + 1), corner(i)} : Ends{corner(i), corner(i + 1)});
        polygonOf.push_back(p);
      }
    }
    std::vector<std::size_t> order(all.size());
    std::iota(order.begin(), order.end(), std::size_t{0});
    std::shuffle(order.begin(), order.end(), engine);
    std::vector<Ends> shuffled;
    for (std::size_t const i : order) shuffled.push_back(all[i]);

    std::vector<LinkChain> const chains = ChainsOf(shuffled, 1e-6);
    ASSERT_EQ(chains.size(), polygons);
    std::vector<int> uses(all.size(), 0);
    for (LinkChain const& chain : chains) {
      EXPECT_TRUE(chain.isClosed);
      for (std::size_t k = 0; k < chain.links.size(); ++k) {
        Link const& link = chain.links[k];
        Link const& next = chain.links[(k + 1) % chain.links.size()];
        ++uses[link.index];
        EXPECT_EQ(polygonOf[order[link.index]], polygonOf[order[chain.links[0].index]]);
        EXPECT_LE(Distance(EndOf(shuffled[link.index], link), StartOf(shuffled[next.index], next)),
                  1e-6);
      }
    }
    EXPECT_TRUE(std::all_of(uses.begin(), uses.end(), [](int n) { return n == 1; }));
  }
}

TEST(ChainsOf, NegativeCoordinatesHaveTheirOwnCells) {
  // Rounding towards zero would put -0.05 and 0.05 into one cell, and rounding down does not.
  EXPECT_EQ(ChainsOf({{{-9, 0}, {-0.05, 0}}, {{0.05, 0}, {9, 0}}}, 0.1).size(), 1u);
  EXPECT_EQ(ChainsOf({{{-9, 0}, {-0.06, 0}}, {{0.06, 0}, {9, 0}}}, 0.1).size(), 2u);
}

TEST(ChainsOf, WhatIsNoPlaceIsChainedWithNothing) {
  for (double const bad : {kNaN, kInfinity, -kInfinity, 1e300}) {
    std::vector<Ends> const all = {{{0, 0}, {bad, 0}}, {{bad, 1}, {1, 1}}, {{0, 0}, {-1, 0}}};
    std::vector<LinkChain> const chains = ChainsOf(all, 0.1);
    ASSERT_EQ(chains.size(), 2u) << bad;
    EXPECT_EQ(Signed(chains[0]), (std::vector<int>{-3, 1}));
    EXPECT_EQ(Signed(chains[1]), (std::vector<int>{2}));
  }
}

}  // namespace
}  // namespace Vorn::IO
