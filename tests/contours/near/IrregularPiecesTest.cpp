// Pieces of which no region can be told meet any other piece as far as the search knows, so each of
// their pairs is asked for.

#include <cmath>
#include <limits>
#include <set>
#include <utility>
#include <vector>

#include "geometry/contours/near/NearPairs.h"
#include "gtest/gtest.h"

namespace Vorn::Contours {
namespace {

using Pairs = std::set<std::pair<std::size_t, std::size_t>>;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

/// Segments of length 1, a hundred apart; those of the list hold a not-a-number.
std::vector<Piece> Segments(std::size_t count, double y, std::set<std::size_t> const& odd) {
  std::vector<Piece> pieces;
  for (std::size_t i = 0; i < count; ++i) {
    double const x = 100.0 * static_cast<double>(i);
    pieces.push_back({{x, odd.count(i) > 0 ? kNaN : y}, {x + 1.0, y}, nullptr});
  }
  return pieces;
}

/// The pairs that were asked for when none answers yes.
Pairs Asked(std::vector<Piece> const& first, std::vector<Piece> const& second) {
  Pairs asked;
  EXPECT_FALSE(AnyPair(first, second, [&](std::size_t i, std::size_t k) {
    asked.emplace(i, k);
    return false;
  }));
  return asked;
}

TEST(AnyPairOfTwoLists, AsksForEveryPairOfAnIrregularPiece) {
  // Far from each other but for the irregular ones: 2 of the first list, 0 of the second.
  Pairs const asked = Asked(Segments(5, 0.0, {2}), Segments(4, 1000.0, {0}));
  for (std::size_t k = 0; k < 4; ++k) EXPECT_TRUE(asked.count({2, k}) > 0) << k;
  for (std::size_t i = 0; i < 5; ++i) EXPECT_TRUE(asked.count({i, 0}) > 0) << i;
  EXPECT_EQ(asked.size(), 8u) << "and for no other one";
}

TEST(AnyPairOfTwoLists, AsksForNearOnes) {
  Pairs const asked = Asked(Segments(5, 0.0, {}), Segments(5, 0.0, {}));
  for (std::size_t i = 0; i < 5; ++i) EXPECT_TRUE(asked.count({i, i}) > 0) << i;
  EXPECT_EQ(asked.size(), 5u);
}

TEST(AnyPairOfTwoLists, EndsWithTheFirstYes) {
  std::vector<Piece> const first = Segments(3, 0.0, {1});
  std::vector<Piece> const second = Segments(3, 1000.0, {2});
  for (auto const& wanted : {std::pair<std::size_t, std::size_t>{1, 0}, {0, 2}}) {
    EXPECT_TRUE(AnyPair(first, second,
                        [&](std::size_t i, std::size_t k) { return std::pair(i, k) == wanted; }));
  }
  EXPECT_FALSE(AnyPair(first, second, [](std::size_t i, std::size_t k) {
    return i == 0 && k == 0;
  })) << "a pair that is far apart is not asked for";
}

TEST(AnyPairOfOneList, AsksForEveryPairOfAnIrregularPieceInItsOrder) {
  Pairs asked;
  std::vector<Piece> const pieces = Segments(5, 0.0, {3});
  EXPECT_FALSE(AnyPair(pieces, Neighbours::LeftOut, [&](std::size_t i, std::size_t k) {
    EXPECT_LT(i, k);
    asked.emplace(i, k);
    return false;
  }));
  EXPECT_EQ(asked, (Pairs{{0, 3}, {1, 3}, {2, 3}, {3, 4}}));
}

TEST(AnyPairOfTwoLists, OfNothingHasNone) {
  EXPECT_TRUE(Asked({}, Segments(3, 0.0, {1})).empty());
  EXPECT_TRUE(Asked(Segments(3, 0.0, {1}), {}).empty());
}

}  // namespace
}  // namespace Vorn::Contours
