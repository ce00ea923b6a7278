#include <algorithm>
#include <cmath>
#include <cstdint>
#include <numbers>
#include <vector>

#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Motions.h"
#include "support/fewest/Scans.h"

// Scans made to be hard. Whatever the answer, no promise is broken; where the least number is known
// it is found.

namespace Vorn::Testing {
namespace {

constexpr double kHalfTurn = std::numbers::pi;

/// Every promise kept, or NoFit where all points coincide.
void FitUnlessCoincident(Scan const& scan, FewestOptions const& options = {}) {
  if (DoPointsCoincide(scan)) {
    ExpectRefused(ErrorCode::NoFit, scan, options);
  } else {
    FitKept(scan, options);
  }
}

/// Six lines and arcs, at the end of each of which the path turns by nearly half a turn.
Scan MakeCusps(double turn, double noise) {
  RandomGeometry random(5);
  std::vector<NominalPiece> const pieces{{8.0, 0.0, 0.0},      {9.0, 0.08, turn},
                                         {10.0, -0.06, -turn}, {11.0, 0.0, turn},
                                         {12.0, 0.08, -turn},  {13.0, -0.06, turn}};
  return SampleWithNormalNoise(&random, pieces, 400, 0.02, noise);
}

/// The same scan turned, reversed and shifted.
std::vector<Scan> MovedAbout(Scan const& scan) {
  return {scan, Rotated(scan, 0.7), Reversed(scan), Shifted(scan, 1e5, -3e5)};
}

TEST(FewestPiecesHostile, ZigzagsJustWithinTheToleranceAreOneSegment) {
  for (double const share : {0.5, 0.9, 0.99, 0.9999}) {
    SCOPED_TRACE(testing::Message() << "share " << share);
    FewestResult const result = FitKept(MakeZigzag(101, 1.0, 0.01, share));
    EXPECT_EQ(result.fewestPossible, 1);
    EXPECT_EQ(PieceCount(result), 1);
  }
}

TEST(FewestPiecesHostile, ZigzagsExactlyAtTheToleranceAreOneSegment) {
  for (double const spacing : {1.0, 0.3}) {
    for (double const w : {0.01, 0.05, 3e-4}) {
      SCOPED_TRACE(testing::Message() << "spacing " << spacing << ", w " << w);
      FewestResult const result = FitKept(MakeZigzag(101, spacing, w, 1.0));
      EXPECT_EQ(result.fewestPossible, 1);
      EXPECT_EQ(PieceCount(result), 1);
      EXPECT_EQ(result.largestDeviation, 1.0);
    }
  }
}

TEST(FewestPiecesHostile, ExactLinesInAnyDirectionAreOneSegment) {
  for (double const heading : {0.0, 0.6, 2.0, 3.1, -2.4}) {
    for (std::int32_t const count : {5, 1000, 10000}) {
      SCOPED_TRACE(testing::Message() << "heading " << heading << ", count " << count);
      Scan scan;
      for (std::int32_t i = 0; i < count; ++i) {
        scan.push_back({0.2 * i * std::cos(heading), 0.2 * i * std::sin(heading), 0.05});
      }
      FewestResult const result = FitKept(scan);
      EXPECT_EQ(PieceCount(result), 1);
      EXPECT_EQ(ArcCount(result), 0);
      EXPECT_LT(result.largestDeviation, 0.01);
    }
  }
}

TEST(FewestPiecesHostile, ZigzagsBeyondTheToleranceTakeTwoPointsEach) {
  // Any circle leaves one of four points in turn above and below a line 1.1 w away; three are
  // always covered.
  FewestResult const result = FitKept(MakeZigzag(99, 1.0, 0.01, 1.1));
  EXPECT_EQ(result.fewestPossible, 33);
  // A connected chain meets the line between any two neighbours, 98 times, and a piece meets it
  // twice at most.
  EXPECT_EQ(PieceCount(result), 49);
  for (std::int32_t const count : {9, 10, 21, 50, 100}) {
    EXPECT_EQ(PieceCount(FitKept(MakeZigzag(count, 1.0, 0.01, 1.1))), count / 2) << count;
  }
}

TEST(FewestPiecesHostile, SpiralsOfManyTurnsAreFollowed) {
  // At 0.3 the points beside a joint that count as near reach around more than half a lap.
  for (double const w : {0.01, 0.1, 0.3}) {
    SCOPED_TRACE(testing::Message() << "w " << w);
    FewestResult const result = FitKept(MakeSpiral(6.0, 1.0, 800, w));
    EXPECT_GE(PieceCount(result), result.fewestPossible);
    EXPECT_LE(PieceCount(result), result.fewestPossible + 3);
  }
}

TEST(FewestPiecesHostile, TolerancesOverSixOrdersTakeFewPiecesMore) {
  for (std::uint64_t seed = 1; seed <= 4; ++seed) {
    SCOPED_TRACE(testing::Message() << "seed " << seed);
    FewestResult const result = FitKept(MakeManyTolerances(seed, ProfileStyle::Mixed, 500));
    EXPECT_LE(result.fewestPossible, 16);
    EXPECT_LE(PieceCount(result), 30);
  }
}

TEST(FewestPiecesHostile, TinyAndHugeNumbersAreScaled) {
  Scan const scan = MakeNoisyProfile(1, ProfileStyle::Mixed, 1, 300, 0.45);
  for (double const factor : {0x1p-1000, 0x1p-500, 0x1p960}) {
    SCOPED_TRACE(testing::Message() << "times " << factor);
    FewestResult result;
    ASSERT_EQ(FewestPieces::Fit(Magnified(scan, factor), {}, &result, nullptr, 100), ErrorCode::Ok);
    EXPECT_EQ(PieceCount(result), 16);
    EXPECT_EQ(result.fewestPossible, 16);
  }
}

TEST(FewestPiecesHostile, AFlatArcIsClosedByItsChord) {
  Scan scan;
  for (std::int32_t i = 0; i <= 240; ++i) {
    double const angle = (i - 120) / 12000.0;
    scan.push_back({1000.0 * std::sin(angle), 1000.0 * (std::cos(angle) - 1.0), 0.02});
  }
  FewestResult const result = FitKept(scan, Closed());
  EXPECT_EQ(PieceCount(result), 2);
  EXPECT_EQ(ArcCount(result), 1);
}

TEST(FewestPiecesHostile, AnOutlierFarAwayTakesAPieceOrTwoMore) {
  for (double const distance : {10.0, 1e3, 1e6}) {
    SCOPED_TRACE(testing::Message() << "distance " << distance);
    FewestResult const result = FitKept(MakeOutlier(101, 0.1, distance));
    EXPECT_LE(result.fewestPossible, 3);
    EXPECT_LE(PieceCount(result), 5);
  }
}

TEST(FewestPiecesHostile, CoordinatesOfAMillionMillionLoseOnlyTheirOwnDigits) {
  // Doubles are 1.2e-4 apart there, a hundredth of the tolerance.
  Scan const scan = Shifted(MakeNoisyProfile(1, ProfileStyle::Mixed, 1, 500, 0.45), 1e12, -1e12);
  FewestResult const result = FitKept(scan);
  EXPECT_EQ(PieceCount(result), 16);
  EXPECT_EQ(result.fewestPossible, 16);
}

TEST(FewestPiecesHostile, CoordinatesOfAMillionLoseNothing) {
  Scan const scan = Magnified(MakeNoisyProfile(1, ProfileStyle::Mixed, 1, 500, 0.45), 0.0625);
  FewestResult const result = FitKept(Shifted(scan, 1e6, 1e6));
  EXPECT_EQ(PieceCount(result), 16);
}

TEST(FewestPiecesHostile, ScribblesHaveAnAnswer) {
  RandomGeometry random(6402);
  for (int round = 0; round < 60; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 6402, round " << round);
    Scan scan;
    double const w = std::exp2(random.Uniform(-8.0, 1.0));
    for (int i = random.Integer(2, 60); i > 0; --i) {
      auto const p = random.PointIn(-5.0, 5.0);
      scan.push_back({p.x, p.y, w * random.Uniform(0.5, 1.0)});
    }
    FitUnlessCoincident(scan);
    FitUnlessCoincident(scan, Closed());
  }
}

TEST(FewestPiecesHostile, AWanderingPathThatCrossesItselfCostsPiecesOnlyWhereItDoes) {
  constexpr int kPoints = 200;
  for (std::uint64_t const seed : {3, 4, 6, 8}) {
    SCOPED_TRACE(testing::Message() << "seed " << seed);
    RandomGeometry random(seed);
    double x = 0.0;
    double y = 0.0;
    double heading = 0.0;
    Scan scan;
    for (int i = 0; i < kPoints; ++i) {
      heading += random.Uniform(-0.8, 0.8);
      x += std::cos(heading) * random.Uniform(0.2, 1.5);
      y += std::sin(heading) * random.Uniform(0.2, 1.5);
      scan.push_back({x, y, 0.05 * random.Uniform(0.3, 1.0)});
    }
    for (FewestOptions const& options : {FewestOptions{}, Closed()}) {
      FewestResult const result = FitKept(scan, options);
      EXPECT_LE(PieceCount(result), 1.75 * result.fewestPossible);
    }
  }
}

TEST(FewestPiecesHostile, PointsOnASmallGridHaveAnAnswer) {
  RandomGeometry random(6403);
  for (int round = 0; round < 100; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 6403, round " << round);
    Scan scan;
    for (int i = random.Integer(2, 30); i > 0; --i) {
      auto const p = random.GridPoint(3);
      scan.push_back({p.x, p.y, 0.25 * random.Integer(1, 3)});
    }
    FitUnlessCoincident(scan);
    FitUnlessCoincident(scan, Closed());
  }
}

TEST(FewestPiecesHostile, CuspsTakeAPieceForEachSide) {
  for (double const turn : {2.5, 3.0, 3.1, 3.13}) {
    for (double const noise : {0.0, 0.4}) {
      for (Scan const& scan : MovedAbout(MakeCusps(turn, noise))) {
        SCOPED_TRACE(testing::Message() << "turn " << turn << ", noise " << noise);
        EXPECT_EQ(PieceCount(FitKept(scan)), 6);
        EXPECT_LE(PieceCount(FitKept(scan, Closed())), 7);
      }
    }
  }
}

TEST(FewestPiecesHostile, AnyDoublesGiveAnAnswer) {
  RandomGeometry random(6404);
  for (int round = 0; round < 300; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 6404, round " << round);
    Scan scan;
    for (int i = random.Integer(2, 12); i > 0; --i) {
      scan.push_back({random.AnyDouble(), random.AnyDouble(), std::fabs(random.AnyDouble())});
    }
    FewestResult result;
    ErrorCode const code = FewestPieces::Fit(scan, {}, &result, nullptr, 100);
    EXPECT_TRUE(code == ErrorCode::Ok || code == ErrorCode::NoFit || code == ErrorCode::Failed);
  }
}

TEST(FewestPiecesHostile, OutAndBackOnOneLineIsFollowed) {
  Scan scan = MakeZigzag(41, 0.5, 0.1, 0.4);
  Scan const back = Reversed(scan);
  scan.insert(scan.end(), back.begin() + 1, back.end());
  FewestResult const result = FitKept(scan);
  EXPECT_EQ(PieceCount(result), 2);
}

TEST(FewestPiecesHostile, DenseScansOutAndBackOnOneLineAreFollowed) {
  // Every step is as short as noise may be; only many of them tell that the scan turns back.
  for (int const count : {150, 300, 600, 1200, 3000, 6000}) {
    for (double const noise : {0.1, 0.4, 0.7}) {
      for (std::uint64_t seed = 1; seed <= 5; ++seed) {
        SCOPED_TRACE(testing::Message() << count << " points, noise " << noise << ", " << seed);
        RandomGeometry random(seed);
        std::vector<NominalPiece> const pieces{{3.0, 0.0, 0.0}, {4.0, 0.0, kHalfTurn}};
        Scan const scan = SampleWithNormalNoise(&random, pieces, count, 0.02, noise);
        EXPECT_EQ(PieceCount(FitKept(scan)), 2);
      }
    }
  }
}

/// Six sides, each folded back over the one before by exactly half a turn.
std::vector<NominalPiece> MakeFoldedSides(bool areSomeArcs) {
  double const bend = areSomeArcs ? 1.0 : 0.0;
  return {{8.0, 0.0, 0.0},        {9.0, 0.08 * bend, kHalfTurn},   {10.0, -0.06 * bend, -kHalfTurn},
          {11.0, 0.0, kHalfTurn}, {12.0, 0.08 * bend, -kHalfTurn}, {13.0, -0.06 * bend, kHalfTurn}};
}

TEST(FewestPiecesHostile, SidesFoldedOverEachOtherTakeAPieceEach) {
  // Closed scans of arcs do not end where they begin and take one more.
  for (bool const areSomeArcs : {false, true}) {
    for (int const count : {396, 1200}) {
      for (double const noise : {0.0, 0.1, 0.4, 0.7}) {
        SCOPED_TRACE(testing::Message() << areSomeArcs << ", " << count << " points, " << noise);
        RandomGeometry random(1);
        Scan const scan =
            SampleWithNormalNoise(&random, MakeFoldedSides(areSomeArcs), count, 0.02, noise);
        EXPECT_EQ(PieceCount(FitKept(scan)), 6);
        EXPECT_EQ(PieceCount(FitKept(scan, Closed())), areSomeArcs ? 7 : 6);
      }
    }
  }
}

TEST(FewestPiecesHostile, TheJointOfADenseFoldLiesAtItsTip) {
  constexpr double kTolerance = 0.02;
  for (std::uint64_t seed = 1; seed <= 5; ++seed) {
    SCOPED_TRACE(testing::Message() << "seed " << seed);
    RandomGeometry random(seed);
    Scan const scan = SampleWithNormalNoise(&random, {{3.0, 0.0, 0.0}, {4.0, 0.0, kHalfTurn}}, 3000,
                                            kTolerance, 0.4);
    FewestResult const result = FitKept(scan);
    ASSERT_EQ(PieceCount(result), 2);
    EXPECT_NEAR(result.contour[1].end.x, 3.0, 0.2 * kTolerance);
  }
}

/// Two to six lines and arcs that cross and fold back over each other at random.
Scan MakeRandomFolds(std::uint64_t seed, std::int32_t* pieceCount) {
  RandomGeometry random(seed);
  bool const isExact = random.Flip();
  bool const areSomeArcs = random.Flip();
  std::vector<NominalPiece> pieces;
  double length = 0.0;
  *pieceCount = random.Integer(2, 6);
  for (int k = 0; k < *pieceCount; ++k) {
    double const turn = isExact ? kHalfTurn : random.Uniform(2.4, kHalfTurn);
    double const curvature = areSomeArcs && random.Flip() ? random.Uniform(-0.1, 0.1) : 0.0;
    pieces.push_back({random.Uniform(3.0, 9.0), curvature, random.Flip() ? turn : -turn});
    length += pieces.back().length;
  }
  double const spacing = std::pow(10.0, random.Uniform(-2.3, -0.3));
  double const noise = random.Uniform(0.0, 0.7);
  if (random.Flip() && spacing < 0.05) {
    return SampleDense(seed, pieces, spacing, 0.02, 0.02 * noise);
  }
  auto const count = static_cast<std::int32_t>(length / spacing) + 2 * *pieceCount;
  return SampleWithNormalNoise(&random, pieces, count, 0.02, noise);
}

TEST(FewestPiecesHostile, RandomFoldsMostlyTakeAPieceForEachSide) {
  constexpr int kRounds = 200;
  constexpr std::int32_t kMostMore = 150;
  int open = 0;
  int closed = 0;
  for (int round = 0; round < kRounds; ++round) {
    SCOPED_TRACE(testing::Message() << "round " << round);
    std::int32_t sides = 0;
    Scan const scan = MakeRandomFolds(static_cast<std::uint64_t>(6700 + round), &sides);
    std::int32_t const pieces = PieceCount(FitKept(scan));
    std::int32_t const closedPieces = PieceCount(FitKept(scan, Closed()));
    open += pieces <= sides ? 1 : 0;
    closed += closedPieces <= sides + 1 ? 1 : 0;
    EXPECT_LE(std::max(pieces, closedPieces), sides + kMostMore);
  }
  EXPECT_GE(open, 95 * kRounds / 100);
  EXPECT_GE(closed, 95 * kRounds / 100);
}

TEST(FewestPiecesHostile, AFigureEightIsFollowed) {
  RandomGeometry random(6405);
  double const turn = 2.0 * 3.141592653589793;
  Scan const scan = SampleWithNormalNoise(
      &random, {{0.95 * turn * 10.0, 0.1}, {0.95 * turn * 10.0, -0.1}}, 500, 0.05, 0.45);
  FewestResult const result = FitKept(scan);
  EXPECT_EQ(result.fewestPossible, 2);
  EXPECT_EQ(PieceCount(result), 2);
}

}  // namespace
}  // namespace Vorn::Testing
