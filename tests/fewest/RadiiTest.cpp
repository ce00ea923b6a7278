#include <cmath>
#include <cstdint>
#include <limits>

#include "fewest/SharedContours.h"
#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Motions.h"

// Arcs within limits of their radius, over profiles whose true arcs have radii of 6 to 14 and over
// the measured contours.

namespace Vorn::Testing {
namespace {

/// By how much rounding may change a radius, relative to it.
constexpr double kRounding = 1e-9;

struct Limits {
  double smallest = 0.0;
  double largest = std::numeric_limits<double>::infinity();
};

FewestOptions Within(Limits const& limits) {
  FewestOptions options;
  options.smallestRadius = limits.smallest;
  options.largestRadius = limits.largest;
  return options;
}

/// The answer, after all of its radii were measured.
FewestResult FitWithin(Scan const& scan, Limits const& limits) {
  FewestResult const result = FitKept(scan, Within(limits));
  for (std::size_t k = 1; k < result.contour.size(); ++k) {
    auto const& elem = result.contour[k];
    if (elem.type != GeometryUtils::ElemType::Arc) continue;
    double const radius = std::hypot(elem.end.x - elem.center.x, elem.end.y - elem.center.y);
    EXPECT_GE(radius, limits.smallest * (1.0 - kRounding)) << "piece " << k;
    EXPECT_LE(radius, limits.largest * (1.0 + kRounding)) << "piece " << k;
  }
  return result;
}

constexpr ProfileStyle kProfileStyles[] = {ProfileStyle::Smooth, ProfileStyle::Corners,
                                           ProfileStyle::Mixed};

TEST(FewestPiecesOfLimitedRadii, LimitsBeyondTheTrueRadiiCostNoPiece) {
  for (std::uint64_t seed = 6301; seed <= 6305; ++seed) {
    for (ProfileStyle const style : kProfileStyles) {
      Scan const scan = MakeNoisyProfile(seed, style, 1, 1000, 0.45);
      EXPECT_EQ(PieceCount(FitWithin(scan, {5.0, 1e9})), 16) << "seed " << seed;
      EXPECT_EQ(PieceCount(FitWithin(scan, {5.0, 20.0})), 16) << "seed " << seed;
    }
  }
}

TEST(FewestPiecesOfLimitedRadii, LimitsThatShutOutTrueRadiiAreKeptAtTheCostOfPieces) {
  for (std::uint64_t seed = 6311; seed <= 6313; ++seed) {
    for (ProfileStyle const style : kProfileStyles) {
      Scan const scan = MakeNoisyProfile(seed, style, 1, 600, 0.45);
      for (Limits const& limits : {Limits{9.0, 1e9}, Limits{0.0, 9.0}, Limits{8.0, 11.0}}) {
        std::int32_t const count = PieceCount(FitWithin(scan, limits));
        EXPECT_GT(count, 16) << "seed " << seed;
        EXPECT_LE(count, PieceCount(FitWithin(scan, {0.0, 1e-3}))) << "seed " << seed;
      }
    }
  }
}

TEST(FewestPiecesOfLimitedRadii, WhereNoArcIsAllowedThereAreSegments) {
  for (std::uint64_t seed = 6321; seed <= 6323; ++seed) {
    Scan const scan = MakeNoisyProfile(seed, ProfileStyle::Mixed, 1, 600, 0.45);
    FewestOptions segments;
    segments.segmentsOnly = true;
    FewestResult const result = FitWithin(scan, {0.0, 1e-6});
    EXPECT_EQ(ArcCount(result), 0);
    EXPECT_LE(PieceCount(result), PieceCount(FitKept(scan, segments)) + 2);
  }
}

TEST(FewestPiecesOfLimitedRadii, ANarrowRangeIsEnoughForAnArcWithinIt) {
  for (double const noise : {0.0, 0.45}) {
    Scan const scan = MakeRepeatedCircle(6331, 0.5, 10.0, 400, 0.01, noise);
    EXPECT_EQ(PieceCount(FitWithin(scan, {9.9999, 10.0001})), 1) << "noise " << noise;
    EXPECT_GT(PieceCount(FitWithin(scan, {10.5, 11.0})), 1) << "noise " << noise;
  }
}

TEST(FewestPiecesOfLimitedRadii, DoNotDependOnWhereThePartLies) {
  Scan const scan = MakeNoisyProfile(6341, ProfileStyle::Mixed, 1, 600, 0.45);
  Limits const limits{8.0, 11.0};
  std::int32_t const count = PieceCount(FitWithin(scan, limits));
  EXPECT_EQ(PieceCount(FitWithin(TurnedByAQuarter(scan), limits)), count);
  EXPECT_EQ(PieceCount(FitWithin(Mirrored(scan), limits)), count);
  EXPECT_EQ(PieceCount(FitWithin(Magnified(scan, 8.0), {64.0, 88.0})), count);
}

class FewestPiecesOfLimitedRadiiOf : public testing::TestWithParam<SharedContour> {};

TEST_P(FewestPiecesOfLimitedRadiiOf, KeepsEveryPromise) {
  if (!SharedDataFolder()) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  Scan const scan = GetParam().Read();
  double extent = 0.0;
  for (WPoint const& p : scan) {
    extent = std::fmax(extent, std::hypot(p.x - scan[0].x, p.y - scan[0].y));
  }
  for (double const share : {0.02, 0.2, 2.0}) {
    FitWithin(scan, {share * extent, std::numeric_limits<double>::infinity()});
    FitWithin(scan, {0.0, share * extent});
    FitWithin(scan, {share * extent, 2.0 * share * extent});
  }
}

INSTANTIATE_TEST_SUITE_P(Contours, FewestPiecesOfLimitedRadiiOf, testing::ValuesIn(kSharedContours),
                         NameOf);

}  // namespace
}  // namespace Vorn::Testing
