#include <cmath>
#include <cstdint>
#include <numbers>

#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Motions.h"

// A circle scanned more than once around: one arc less than the laps asks for is impossible, since
// no arc is a full turn.

namespace Vorn::Testing {
namespace {

constexpr double kRadius = 10.0;
constexpr double kTolerance = 0.01;

Scan CircleOf(double turns, std::int32_t count, double noise) {
  return MakeRepeatedCircle(6601, turns, kRadius, count, kTolerance, noise);
}

TEST(FewestPiecesOfARepeatedCircle, TwiceAroundTakesThreeArcsAtAnyDensity) {
  for (std::int32_t const count : {300, 1000, 2000, 5000, 10000, 20000, 50000}) {
    for (double const noise : {0.0, 0.45, 0.9}) {
      SCOPED_TRACE(testing::Message() << count << " points, noise " << noise);
      FewestResult const result = FitKept(CircleOf(2.0, count, noise));
      EXPECT_EQ(PieceCount(result), 3);
      EXPECT_EQ(ArcCount(result), 3);
      EXPECT_EQ(result.fewestPossible, 1);
      EXPECT_LE(result.largestDeviation, noise + 0.04);
    }
  }
}

TEST(FewestPiecesOfARepeatedCircle, TwiceAroundTakesThreeArcsWhenClosed) {
  for (std::int32_t const count : {300, 1000, 2000, 5000, 20000}) {
    for (double const noise : {0.0, 0.45, 0.9}) {
      SCOPED_TRACE(testing::Message() << count << " points, noise " << noise);
      FewestResult const result = FitKept(CircleOf(2.0, count, noise), Closed());
      EXPECT_EQ(PieceCount(result), 3);
      EXPECT_EQ(result.fewestPossible, 2);
    }
  }
}

TEST(FewestPiecesOfARepeatedCircle, ALapMoreTakesOneArcMore) {
  for (double const turns : {1.2, 1.5, 1.95, 2.5, 3.0, 5.0, 7.3}) {
    SCOPED_TRACE(testing::Message() << turns << " turns");
    Scan const scan = CircleOf(turns, 3000, 0.45);
    auto const arcs = static_cast<std::int32_t>(std::floor(turns)) + 1;
    EXPECT_EQ(PieceCount(FitKept(scan)), arcs);
    EXPECT_EQ(PieceCount(FitKept(Reversed(scan))), arcs);
    EXPECT_EQ(PieceCount(FitKept(Rotated(Mirrored(scan), 0.7))), arcs);
    EXPECT_EQ(PieceCount(FitKept(Shifted(scan, 1e6, -3e5))), arcs);
  }
}

TEST(FewestPiecesOfARepeatedCircle, AClosedOneOfOneLapTakesTwoArcs) {
  for (double const noise : {0.0, 0.45, 0.9}) {
    FewestResult const result = FitKept(CircleOf(1.0, 2000, noise), Closed());
    EXPECT_EQ(PieceCount(result), 2);
    EXPECT_TRUE(result.isFewest);
  }
}

TEST(FewestPiecesOfARepeatedCircle, AClosedScanOfAnyLapsTakesOneArcMore) {
  for (double const turns : {1.3, 2.3, 3.3, 5.3}) {
    for (double const noise : {0.0, 0.45}) {
      SCOPED_TRACE(testing::Message() << turns << " turns, noise " << noise);
      Scan const scan = MakeRepeatedCircle(6602, turns, 5.0, 750, 0.02, noise);
      auto const pieces = static_cast<std::int32_t>(turns) + 2;
      EXPECT_LE(PieceCount(FitKept(scan, Closed())), pieces);
      EXPECT_LE(PieceCount(FitKept(Reversed(scan), Closed())), pieces);
      EXPECT_LE(PieceCount(FitKept(Rotated(scan, 0.7), Closed())), pieces);
      EXPECT_LE(PieceCount(FitKept(Shifted(scan, 1e5, -3e5), Closed())), pieces);
    }
  }
}

TEST(FewestPiecesOfARepeatedCircle, LapsBetweenTwoLinesTakeOneArcMoreEach) {
  for (double const laps : {1.0, 2.0, 3.0, 5.0, 5.25}) {
    for (std::int32_t const count : {300, 1500}) {
      for (double const noise : {0.0, 0.4}) {
        SCOPED_TRACE(testing::Message()
                     << laps << " laps, " << count << " points, noise " << noise);
        RandomGeometry random(77);
        double const length = 2.0 * std::numbers::pi * kRadius * laps;
        Scan const scan = SampleWithNormalNoise(
            &random, {{40.0, 0.0}, {length, 1.0 / kRadius}, {40.0, 0.0}}, count, 0.04, noise);
        std::int32_t const pieces = 2 + static_cast<std::int32_t>(laps) + 1;
        EXPECT_LE(PieceCount(FitKept(scan)), pieces);
        EXPECT_LE(PieceCount(FitKept(Reversed(scan))), pieces);
        EXPECT_LE(PieceCount(FitKept(Rotated(scan, 0.7))), pieces);
        EXPECT_LE(PieceCount(FitKept(Shifted(scan, 1e5, -3e5))), pieces);
      }
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
