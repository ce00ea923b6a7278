#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "vorn/io/ContourFile.h"

namespace Vorn::IO {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

ContourFile Way(std::vector<Piece> pieces, bool isClosed = false) {
  ContourFile contour;
  contour.pieces = std::move(pieces);
  contour.isClosed = isClosed;
  return contour;
}

TEST(JointTolerance, IsABillionthOfTheLargestCoordinateOfAnEnd) {
  EXPECT_EQ(JointTolerance({MakeLine({0, 0}, {-2000, 3})}), 1e-9 * 2000);
  EXPECT_EQ(JointTolerance({MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {1, 50})}), 1e-9 * 50);
}

TEST(JointTolerance, OfAHugeCircleGrowsWithTheRadius) {
  Piece const arc = MakeArc({0, 0}, {1, 0}, {0.5, -1e9}, 1e9, false);
  EXPECT_EQ(JointTolerance({arc}), 1e-14 * 1e9);
}

TEST(JointTolerance, OfNothingIsZero) { EXPECT_EQ(JointTolerance({}), 0.0); }

TEST(ReturnsToStart, ComparesTheEndsWithinTheTolerance) {
  std::vector<Piece> const pieces = {MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {1, 1}),
                                     MakeLine({1, 1}, {0, 0.9e-9})};
  EXPECT_TRUE(ReturnsToStart(pieces));
  EXPECT_FALSE(ReturnsToStart({pieces[0], pieces[1], MakeLine({1, 1}, {0, 1.1e-9})}));
}

TEST(ReturnsToStart, NothingDoesNot) { EXPECT_FALSE(ReturnsToStart({})); }

TEST(ReturnsToStart, WhatIsNotANumberDoesNot) {
  EXPECT_FALSE(ReturnsToStart({MakeLine({0, 0}, {kNaN, 0})}));
  EXPECT_FALSE(ReturnsToStart({MakeLine({0, 0}, {kInfinity, 0})}) &&
               !std::isinf(JointTolerance({MakeLine({0, 0}, {kInfinity, 0})})));
}

TEST(FindGaps, TellsThePiecesAndTheWidth) {
  std::vector<Gap> const gaps =
      FindGaps(Way({MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {2, 0}), MakeLine({2, 3}, {5, 7})}));
  ASSERT_EQ(gaps.size(), 1u);
  EXPECT_EQ(gaps[0].before, 1u);
  EXPECT_EQ(gaps[0].after, 2u);
  EXPECT_EQ(gaps[0].size, 3.0);
}

TEST(FindGaps, LooksAtTheSeamOfAClosedContourOnly) {
  std::vector<Piece> const pieces = {MakeLine({0, 0}, {3, 0}), MakeLine({3, 0}, {3, 4})};
  EXPECT_TRUE(FindGaps(Way(pieces, false)).empty());
  std::vector<Gap> const gaps = FindGaps(Way(pieces, true));
  ASSERT_EQ(gaps.size(), 1u);
  EXPECT_EQ(gaps[0].before, 1u);
  EXPECT_EQ(gaps[0].after, 0u);
  EXPECT_EQ(gaps[0].size, 5.0) << "3, 4, 5";
}

TEST(FindGaps, NothingHasNone) {
  EXPECT_TRUE(FindGaps(Way({}, false)).empty());
  EXPECT_TRUE(FindGaps(Way({}, true)).empty());
}

TEST(DescribeGap, CountsPiecesFromOne) {
  EXPECT_EQ(Describe(Gap{1, 2, 0.25}), "pieces 2 and 3 do not meet: the gap is 0.25");
  EXPECT_EQ(Describe(Gap{4, 0, 1.5}),
            "the contour is closed, but its ends do not meet: the gap is 1.5");
}

TEST(RemovePiecesWithoutLength, KeepsFullTurnsAndCountsTheRest) {
  std::vector<Piece> pieces = {MakeLine({1, 1}, {1, 1}), MakeLine({1, 1}, {2, 1}),
                               MakeArc({2, 1}, {2, 1}, {2, 0}, 1.0, true)};
  EXPECT_EQ(RemovePiecesWithoutLength(&pieces), 2u);
  ASSERT_EQ(pieces.size(), 1u);
  EXPECT_EQ(pieces[0].end.x, 2.0);
  std::vector<Piece> none;
  EXPECT_EQ(RemovePiecesWithoutLength(&none), 0u);
}

}  // namespace
}  // namespace Vorn::IO
