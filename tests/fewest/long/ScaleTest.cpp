#include <cstdint>

#include "benchmarks/AllocationMeter.h"
#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Scans.h"

// Large scans whose true number of pieces is known, and the memory that they take.

namespace Vorn::Testing {
namespace {

constexpr ProfileStyle kStyles[] = {ProfileStyle::Smooth, ProfileStyle::Corners,
                                    ProfileStyle::Mixed};

void ExpectPieces(Scan const& scan, std::int32_t count) {
  FewestResult const result = FitKept(scan);
  EXPECT_EQ(PieceCount(result), count);
  EXPECT_EQ(result.fewestPossible, count);
}

TEST(FewestPiecesAtScale, OneArcOfAMillionPointsIsOnePiece) {
  ExpectPieces(MakeNoisyArc(1, 1000000, 0.45), 1);
}

TEST(FewestPiecesAtScale, AProfileOfAMillionPointsHasItsTrueNumber) {
  ExpectPieces(MakeNoisyProfile(1, ProfileStyle::Mixed, 1000, 1000000, 0.45), 16000);
}

TEST(FewestPiecesAtScale, NoiseNearTheToleranceTakesAWideLook) {
  FewestOptions options;
  options.effort = FewestPieces::Effort::Wide;
  for (ProfileStyle const style : kStyles) {
    for (std::uint64_t seed = 1; seed <= 5; ++seed) {
      SCOPED_TRACE(testing::Message() << "style " << static_cast<int>(style) << ", seed " << seed);
      FewestResult const result = FitKept(MakeNoisyProfile(seed, style, 10, 10000, 0.99), options);
      EXPECT_EQ(result.fewestPossible, 160);
      EXPECT_LE(PieceCount(result), 161);
    }
  }
}

TEST(FewestPiecesAtScale, ScansOneMicrometreApartHaveTheirTrueNumber) {
  for (std::uint64_t seed = 1; seed <= 3; ++seed) {
    SCOPED_TRACE(testing::Message() << "seed " << seed);
    ExpectPieces(MakeDenseBracket(seed, 0.001, 1.0), 4);
    for (ProfileStyle const style : kStyles) {
      ExpectPieces(MakeDenseProfile(seed, style, 200.0, 0.001), 16);
    }
  }
}

TEST(FewestPiecesAtScale, AScanATenthOfAMicrometreApartHasItsTrueNumber) {
  ExpectPieces(MakeDenseBracket(1, 0.0001, 1.0), 4);
}

TEST(FewestPiecesAtScale, ACircleTwiceAroundInDensePointsTakesThreeArcs) {
  FewestResult const result = FitKept(MakeRepeatedCircle(1, 2.0, 10.0, 125665, 0.01, 0.45));
  EXPECT_EQ(PieceCount(result), 3);
  EXPECT_EQ(result.fewestPossible, 1);
}

TEST(FewestPiecesAtScale, AClothoidCostsLittleMoreThanTheBound) {
  // Shared joints cost up to 2 / sqrt(3) where curvature changes steadily.
  FewestResult const result = FitKept(MakeClothoid(100.0, 1.0, 8000, 1e-4));
  EXPECT_LE(PieceCount(result), 1.18 * result.fewestPossible);
}

void ExpectMemoryBelow(Scan const& scan, double bytesPerPoint) {
  FewestResult result;
  Benchmarks::AllocationMeter const meter;
  ASSERT_EQ(FewestPieces::Fit(scan, {}, &result, nullptr, 100), ErrorCode::Ok);
  EXPECT_LE(static_cast<double>(meter.PeakBytes()),
            bytesPerPoint * static_cast<double>(scan.size()));
}

TEST(FewestPiecesMemory, IsAHundredAndFiftyBytesAPointAtMost) {
  ExpectMemoryBelow(MakeNoisyProfile(1, ProfileStyle::Mixed, 100, 100000, 0.45), 150.0);
  ExpectMemoryBelow(MakeNoisyArc(1, 1000000, 0.45), 150.0);
  ExpectMemoryBelow(MakeDenseBracket(1, 0.001, 1.0), 150.0);
}

}  // namespace
}  // namespace Vorn::Testing
