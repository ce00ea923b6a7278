#include <algorithm>
#include <cmath>
#include <cstdint>
#include <vector>

#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Motions.h"
#include "support/fewest/Scans.h"

// What must not change the number of pieces and the bound, on scans whose true number is known.

namespace Vorn::Testing {
namespace {

constexpr ProfileStyle kStyles[] = {ProfileStyle::Smooth, ProfileStyle::Corners,
                                    ProfileStyle::Mixed};

/// Profiles of every style, with noise of half the tolerance.
std::vector<Scan> Profiles(std::int32_t count) {
  std::vector<Scan> scans;
  for (ProfileStyle const style : kStyles)
    scans.push_back(MakeNoisyProfile(2, style, 1, count, 0.5));
  return scans;
}

void ExpectSixteen(Scan const& scan, FewestOptions const& options = {}) {
  FewestResult const result = FitKept(scan, options);
  EXPECT_EQ(PieceCount(result), 16);
  EXPECT_EQ(result.fewestPossible, 16);
}

TEST(FewestPiecesInvariants, NoisyProfilesHaveTheirTrueNumber) {
  for (ProfileStyle const style : kStyles) {
    for (std::uint64_t seed = 1; seed <= 5; ++seed) {
      for (double const noise : {0.45, 0.7}) {
        SCOPED_TRACE(testing::Message() << "style " << static_cast<int>(style) << ", seed " << seed
                                        << ", noise " << noise);
        ExpectSixteen(MakeNoisyProfile(seed, style, 1, 500, noise));
      }
    }
  }
}

TEST(FewestPiecesInvariants, NoiseNearTheToleranceTakesAWideLook) {
  FewestOptions options;
  options.effort = FewestPieces::Effort::Wide;
  for (ProfileStyle const style : kStyles) {
    for (std::uint64_t seed = 1; seed <= 5; ++seed) {
      SCOPED_TRACE(testing::Message() << "style " << static_cast<int>(style) << ", seed " << seed);
      ExpectSixteen(MakeNoisyProfile(seed, style, 1, 1000, 0.99), options);
    }
  }
}

TEST(FewestPiecesInvariants, ReversingThePointsKeepsTheNumber) {
  for (Scan const& scan : Profiles(600)) ExpectSixteen(Reversed(scan));
}

TEST(FewestPiecesInvariants, TurningKeepsTheNumber) {
  for (Scan const& scan : Profiles(600)) {
    for (double const angle :
         {0.1, 0.5235987755982988, 0.7853981633974483, 1.0, 2.0, 3.0, 4.0, 5.5}) {
      SCOPED_TRACE(testing::Message() << "turned by " << angle);
      ExpectSixteen(Rotated(scan, angle));
    }
  }
}

TEST(FewestPiecesInvariants, QuarterTurnsAndMirrorsKeepTheNumber) {
  for (Scan const& scan : Profiles(600)) {
    Scan turned = scan;
    for (int quarter = 0; quarter < 4; ++quarter) {
      turned = TurnedByAQuarter(turned);
      ExpectSixteen(turned);
      ExpectSixteen(Mirrored(turned));
    }
  }
}

TEST(FewestPiecesInvariants, MovingByAHundredMillionTolerancesKeepsTheNumber) {
  for (Scan const& scan : Profiles(600)) {
    for (double const tolerances : {1e2, 1e5, 1e8}) {
      SCOPED_TRACE(testing::Message() << "moved by " << tolerances);
      double const shift = 0.02 * tolerances;
      ExpectSixteen(Shifted(scan, shift, -0.7 * shift));
    }
  }
}

// Pieces far from the start of the path have as many digits as those near it. Each length is up to
// 5e8 times the tolerance.
TEST(FewestPiecesInvariants, PiecesFarFromTheStartKeepTheNumber) {
  for (double const length : {1e5, 1e6, 1e7}) {
    for (ProfileStyle const style : {ProfileStyle::Smooth, ProfileStyle::Mixed}) {
      SCOPED_TRACE(testing::Message() << "length " << length);
      Scan scan = MakeProfileBehindALongLine(1, style, length);
      EXPECT_EQ(PieceCount(FitKept(scan)), 16);
      std::reverse(scan.begin(), scan.end());
      EXPECT_EQ(PieceCount(FitKept(scan)), 16);
    }
  }
}

/// A fit of points times a power of two is the fit of the points times that power.
void ExpectScaledBits(Scan const& scan, FewestOptions const& options, double factor) {
  SCOPED_TRACE(testing::Message() << "times " << factor);
  FewestResult expected;
  FewestResult scaled;
  ErrorCode const code = FewestPieces::Fit(scan, options, &expected, nullptr, 100);
  ASSERT_EQ(FewestPieces::Fit(Magnified(scan, factor), options, &scaled, nullptr, 100), code);
  for (auto& elem : expected.contour) {
    elem.end = Scale(elem.end, factor);
    elem.center = Scale(elem.center, factor);
    elem.radius *= factor;
  }
  ExpectSameResult(scaled, expected);
}

TEST(FewestPiecesInvariants, PowersOfTwoScaleTheBits) {
  for (Scan const& scan : Profiles(400)) {
    ASSERT_GT(PieceCount(FitKept(scan)), 0);
    for (double const factor : {0x1p-1000, 0x1p-40, 0.5, 2.0, 0x1p40, 0x1p900}) {
      ExpectScaledBits(scan, {}, factor);
    }
  }
}

/// Points as far apart as their tolerances, where steps, gaps and corners are decided by both.
TEST(FewestPiecesInvariants, PowersOfTwoScaleTheBitsOfCoarsePoints) {
  constexpr std::uint64_t kSeed = 6304;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 25; ++i) {
    Scan scan;
    for (int k = random.Integer(3, 9); k > 0; --k) {
      auto const p = random.PointIn(-4.0, 4.0);
      scan.push_back({p.x, p.y, std::exp2(random.Uniform(-5.0, 0.0))});
    }
    FewestOptions options;
    options.closed = random.Flip();
    options.centre = random.Flip();
    options.effort = FewestPieces::Effort{random.Integer(0, 1)};
    options.largestStep = random.Uniform(0.3, 3.0);
    for (double const factor : {0x1p-60, 0x1p50}) ExpectScaledBits(scan, options, factor);
  }
}

TEST(FewestPiecesInvariants, TheSeamOfAClosedContourAddsNoPiece) {
  RandomGeometry random(6303);
  // A stadium with rounded ends: two lines and two half circles, and a hexagon.
  double const halfTurn = 10.0 * 3.141592653589793;
  std::vector<std::vector<NominalPiece>> const shapes{
      {{30.0, 0.0}, {halfTurn, 0.1}, {30.0, 0.0}, {halfTurn, 0.1}},
      {{20.0, 0.0, 0.0},
       {20.0, 0.0, 1.0471975511965976},
       {20.0, 0.0, 1.0471975511965976},
       {20.0, 0.0, 1.0471975511965976},
       {20.0, 0.0, 1.0471975511965976},
       {20.0, 0.0, 1.0471975511965976}}};
  for (auto const& pieces : shapes) {
    Scan scan = SampleWithNormalNoise(&random, pieces, 481, 0.02, 0.45);
    scan.pop_back();
    for (std::ptrdiff_t const start : {0, 1, 17, 60, 100, 240, 333, 479}) {
      SCOPED_TRACE(testing::Message() << "started at " << start);
      Scan turned = scan;
      std::rotate(turned.begin(), turned.begin() + start, turned.end());
      FewestResult const result = FitKept(turned, Closed());
      EXPECT_EQ(PieceCount(result), static_cast<std::int32_t>(pieces.size()));
      EXPECT_LE(result.fewestPossible, static_cast<std::int32_t>(pieces.size()));
    }
  }
}

TEST(FewestPiecesInvariants, AClosedContourMayRepeatItsFirstPoint) {
  RandomGeometry random(6304);
  double const halfTurn = 10.0 * 3.141592653589793;
  Scan scan = SampleWithNormalNoise(
      &random, {{30.0, 0.0}, {halfTurn, 0.1}, {30.0, 0.0}, {halfTurn, 0.1}}, 481, 0.02, 0.45);
  scan.back() = scan.front();
  EXPECT_EQ(PieceCount(FitKept(scan, Closed())), 4);
}

TEST(FewestPiecesInvariants, ARepeatedFirstPointCountsOnceWhicheverToleranceIsSmaller) {
  RandomGeometry random(6305);
  double const third = 2.0943951023931953;
  Scan const scan = SampleWithNormalNoise(
      &random, {{15.0, 0.0}, {30.0, 0.0, third}, {30.0, 0.0, third}, {15.0, 0.0, third}}, 301, 0.02,
      0.45);
  for (double const factor : {0.5, 1.0, 2.0}) {
    SCOPED_TRACE(testing::Message() << "last tolerance times " << factor);
    Scan repeated = scan;
    repeated.back() = {scan.front().x, scan.front().y, factor * scan.front().w};
    FewestResult const result = FitKept(repeated, Closed());
    EXPECT_EQ(PieceCount(result), 3);
    EXPECT_EQ(result.fewestPossible, 3);
  }
}

TEST(FewestPiecesInvariants, RepeatedPointsChangeNothing) {
  RandomGeometry random(6301);
  for (Scan const& scan : Profiles(500)) {
    Scan repeated;
    for (WPoint const& p : scan) {
      repeated.push_back(p);
      while (random.Integer(0, 2) == 0) repeated.push_back(p);
    }
    ExpectSixteen(repeated);
  }
}

TEST(FewestPiecesInvariants, APointRemovedNeverRaisesTheBound) {
  RandomGeometry random(6302);
  for (Scan scan : Profiles(250)) {
    FewestResult last = FitKept(scan);
    for (int round = 0; round < 40; ++round) {
      SCOPED_TRACE(testing::Message() << "seed 6302, round " << round);
      auto const at = random.Integer(0, static_cast<std::int32_t>(scan.size()) - 1);
      scan.erase(scan.begin() + at);
      FewestResult const result = FitKept(scan);
      EXPECT_LE(result.fewestPossible, last.fewestPossible);
      last = result;
    }
  }
}

TEST(FewestPiecesInvariants, LooserTolerancesNeverGiveMorePieces) {
  for (Scan const& scan : Profiles(300)) {
    FewestResult last = FitKept(WithTolerances(scan, 0.3));
    for (int step = 1; step < 20; ++step) {
      double const factor = 0.3 * std::pow(1.3, step);
      SCOPED_TRACE(testing::Message() << "tolerances times " << factor);
      FewestResult const result = FitKept(WithTolerances(scan, factor));
      EXPECT_LE(PieceCount(result), PieceCount(last));
      EXPECT_LE(result.fewestPossible, last.fewestPossible);
      last = result;
    }
  }
}

TEST(FewestPiecesInvariants, DenseScansHaveTheirTrueNumber) {
  for (std::uint64_t seed = 1; seed <= 3; ++seed) {
    SCOPED_TRACE(testing::Message() << "seed " << seed);
    FewestResult const bracket = FitKept(MakeDenseBracket(seed, 0.001, 0.1));
    EXPECT_EQ(PieceCount(bracket), 4);
    EXPECT_EQ(bracket.fewestPossible, 4);
    ExpectSixteen(MakeDenseProfile(seed, ProfileStyle::Mixed, 40.0, 0.002));
  }
}

}  // namespace
}  // namespace Vorn::Testing
