#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numbers>
#include <random>

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

/// The part of it that goes with the extent, within the rounding of the rest near the origin.
void ExpectExtent(double size, std::vector<Piece> const& pieces) {
  EXPECT_GE(JointTolerance(pieces), 1e-9 * size);
  EXPECT_LE(JointTolerance(pieces), 1e-9 * size * (1.0 + 1e-4));
}

TEST(JointTolerance, NearTheOriginIsABillionthOfTheExtent) {
  ExpectExtent(2000, {MakeLine({0, 0}, {-2000, 3})});
  ExpectExtent(50, {MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {1, 50})});
  ExpectExtent(4, {MakeArc({2, 0}, {-2, 0}, {0, 0}, 2.0, true)});
}

TEST(JointTolerance, FarFromTheOriginAddsSomeLastPlacesOfTheCoordinates) {
  // The last place of a double is 2^-26 from 2^26 to 2^27, so at 1e8, and 2^-33 at 1e6.
  for (auto const& [offset, lastPlace] :
       {std::pair{1e8, std::ldexp(1.0, -26)}, std::pair{1e6, std::ldexp(1.0, -33)}}) {
    double const tolerance =
        JointTolerance({MakeLine({offset, offset}, {offset + 100, offset + 40})});
    EXPECT_GT(tolerance, 1e-7 + 8 * lastPlace);
    EXPECT_LT(tolerance, 1e-7 + 32 * lastPlace);
  }
}

TEST(JointTolerance, TellsAGapOfAThousandthFromRoundingAt1e8) {
  double const far = 1e8;
  double const lastPlace = std::ldexp(1.0, -26);
  auto const withGap = [&](double gap) {
    return Way(
        {MakeLine({far, far}, {far + 10, far}), MakeLine({far + 10 + gap, far}, {far, far})});
  };
  EXPECT_TRUE(FindGaps(withGap(4 * lastPlace)).empty());
  std::vector<Gap> const gaps = FindGaps(withGap(1024 * lastPlace));
  ASSERT_EQ(gaps.size(), 1u) << "1.5e-5 of the unit";
  EXPECT_EQ(gaps[0].size, 1024 * lastPlace);
}

TEST(JointTolerance, CoversTheRoundingOfEndsFromCentreRadiusAndDegrees) {
  constexpr std::uint64_t kSeed = 20;
  SCOPED_TRACE(kSeed);
  std::mt19937_64 engine(kSeed);
  std::uniform_real_distribution<double> unit(-1.0, 1.0);
  for (int round = 0; round < 2000; ++round) {
    XY const centre = {1e8 * unit(engine), 1e5 * unit(engine)};
    double const radius = std::pow(10.0, 3.0 * unit(engine));
    double const degrees = 360.0 * unit(engine);
    auto const at = [&](long double angle) {
      return XY{static_cast<double>(centre.x + radius * std::cos(angle)),
                static_cast<double>(centre.y + radius * std::sin(angle))};
    };
    // The end as exact as a double can be, and as a reader works it out in doubles.
    XY const exact = at(std::numbers::pi_v<long double> * degrees / 180.0L);
    double const angle = degrees * (std::numbers::pi / 180.0);
    XY const read = {centre.x + radius * std::cos(angle), centre.y + radius * std::sin(angle)};
    Piece const line = MakeLine({exact.x - radius, exact.y}, exact);
    Piece const arc = MakeArc(read, at(0.0L), centre, radius, true);
    EXPECT_TRUE(FindGaps(Way({line, arc})).empty()) << round;
  }
}

TEST(JointTolerance, OfAHugeCircleGrowsWithTheRadius) {
  Piece const arc = MakeArc({0, 0}, {1, 0}, {0.5, -1e9}, 1e9, false);
  EXPECT_GT(JointTolerance({arc}), 1e-14 * 1e9);
  EXPECT_LT(JointTolerance({arc}), 1.001e-14 * 1e9);
}

TEST(JointTolerance, OfNothingIsZero) { EXPECT_EQ(JointTolerance({}), 0.0); }

TEST(ReturnsToStart, ComparesTheEndsWithinTheTolerance) {
  std::vector<Piece> const pieces = {MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {1, 1}),
                                     MakeLine({1, 1}, {0, 0.99e-9})};
  EXPECT_TRUE(ReturnsToStart(pieces));
  EXPECT_FALSE(ReturnsToStart({pieces[0], pieces[1], MakeLine({1, 1}, {0, 1.01e-9})}));
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

std::vector<Piece> Square(double low, double high) {
  return {MakeLine({low, low}, {high, low}), MakeLine({high, low}, {high, high}),
          MakeLine({high, high}, {low, high}), MakeLine({low, high}, {low, low})};
}

std::vector<Piece> Together(std::vector<Piece> pieces, std::vector<Piece> const& more) {
  pieces.insert(pieces.end(), more.begin(), more.end());
  return pieces;
}

TEST(FindGaps, OutlinesThatAreClosedByThemselvesHaveNoneBetweenThem) {
  EXPECT_TRUE(FindGaps(Way(Together(Square(0, 9), Square(3, 6)))).empty());
  EXPECT_TRUE(FindGaps(Way(Together(Square(0, 9), Square(3, 6)), true)).empty());
  std::vector<Piece> const mixed = Together(Square(0, 9), {MakeLine({20, 0}, {30, 0})});
  EXPECT_TRUE(FindGaps(Way(mixed)).empty()) << "an open one beside a closed one";
}

TEST(FindGaps, OfOpenRunsBesideAClosedOutlineAreTold) {
  std::vector<Gap> const gaps = FindGaps(
      Way(Together(Square(0, 9), {MakeLine({20, 0}, {30, 0}), MakeLine({31, 0}, {40, 0})})));
  ASSERT_EQ(gaps.size(), 1u);
  EXPECT_EQ(gaps[0].before, 4u);
  EXPECT_EQ(gaps[0].size, 1.0);
}

TEST(FindGaps, AClosedContourThatIsNotMadeOfClosedOutlinesHasThemAll) {
  std::vector<Piece> const mixed = Together(Square(0, 9), {MakeLine({20, 0}, {30, 0})});
  EXPECT_EQ(FindGaps(Way(mixed, true)).size(), 2u);
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
