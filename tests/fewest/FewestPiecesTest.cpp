#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <numbers>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Motions.h"
#include "support/fewest/PromiseChecker.h"
#include "support/fewest/Scans.h"
#include "vorn/FewestPieces.h"

// What the header says about arguments, options, progress and the simplest shapes.

namespace Vorn::Testing {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kPi = std::numbers::pi;

Scan SmallProfile() { return MakeNoisyProfile(1, ProfileStyle::Mixed, 1, 400, 0.45); }

// --- Bad input -----------------------------------------------------------------------------------

TEST(FewestPiecesFit, RefusesFewerThanTwoPoints) {
  ExpectRefused(ErrorCode::Failed, {});
  ExpectRefused(ErrorCode::Failed, {{1, 2, 0.1}});
}

TEST(FewestPiecesFit, RefusesCoordinatesThatAreNotFinite) {
  for (double const bad : {kNaN, kInfinity, -kInfinity}) {
    for (std::size_t const at : {0U, 7U, 19U}) {
      Scan scan = MakeZigzag(20, 1.0, 0.1, 0.5);
      scan[at].x = bad;
      ExpectRefused(ErrorCode::Failed, scan);
      scan[at].x = 0.0;
      scan[at].y = bad;
      ExpectRefused(ErrorCode::Failed, scan);
    }
  }
}

TEST(FewestPiecesFit, RefusesTolerancesThatAreNotAboveZero) {
  for (double const bad : {0.0, -0.0, -0.1, kNaN, kInfinity, -kInfinity}) {
    for (std::size_t const at : {0U, 7U, 19U}) {
      Scan scan = MakeZigzag(20, 1.0, 0.1, 0.5);
      scan[at].w = bad;
      ExpectRefused(ErrorCode::Failed, scan);
    }
  }
}

TEST(FewestPiecesFit, RefusesANullResult) {
  EXPECT_EQ(FewestPieces::Fit(SmallProfile(), {}, nullptr, nullptr, 100), ErrorCode::Failed);
}

TEST(FewestPiecesFit, RefusesOptionsOutsideTheirRanges) {
  Scan const scan = MakeZigzag(20, 1.0, 0.1, 0.5);
  auto const refuses = [&scan](auto const& change) {
    FewestOptions options;
    change(&options);
    ExpectRefused(ErrorCode::Failed, scan, options);
  };
  for (double const bad : {0.0, -1.0, 3.2, kNaN, kInfinity}) {
    SCOPED_TRACE(testing::Message() << "largestStep " << bad);
    refuses([bad](FewestOptions* o) { o->largestStep = bad; });
  }
  for (double const bad : {-1e-9, kNaN, kInfinity}) {
    SCOPED_TRACE(testing::Message() << "smallestRadius " << bad);
    refuses([bad](FewestOptions* o) { o->smallestRadius = bad; });
  }
  for (double const bad : {0.0, -1.0, kNaN}) {
    SCOPED_TRACE(testing::Message() << "largestRadius " << bad);
    refuses([bad](FewestOptions* o) { o->largestRadius = bad; });
  }
  for (double const bad : {-1e-9, kNaN}) {
    SCOPED_TRACE(testing::Message() << "farthestBetweenPoints " << bad);
    refuses([bad](FewestOptions* o) { o->farthestBetweenPoints = bad; });
  }
  refuses([](FewestOptions* o) {
    o->smallestRadius = 2.0;
    o->largestRadius = 1.0;
  });
  for (std::int32_t const bad : {-1, 3, 1000}) {
    refuses([bad](FewestOptions* o) { o->effort = static_cast<FewestPieces::Effort>(bad); });
  }
}

TEST(FewestPiecesFit, PointsThatCoincideHaveNoFit) {
  ExpectRefused(ErrorCode::NoFit, MakeOnePoint(2, {3, 4}, 0.1));
  ExpectRefused(ErrorCode::NoFit, MakeOnePoint(50, {3, 4}, 0.1));
  ExpectRefused(ErrorCode::NoFit, MakeOnePoint(50, {3, 4}, 0.1), Closed());
  ExpectRefused(ErrorCode::NoFit, MakeOnePoint(1000, {1e12, -1e12}, 1e-3));
}

// --- The simplest shapes -------------------------------------------------------------------------

TEST(FewestPiecesFit, TwoPointsGiveOneSegment) {
  Scan const scan{{1, 2, 0.1}, {5, -1, 0.2}};
  FewestResult const result = FitKept(scan);
  ASSERT_EQ(PieceCount(result), 1);
  EXPECT_EQ(ArcCount(result), 0);
  EXPECT_EQ(result.fewestPossible, 1);
  EXPECT_TRUE(result.isFewest);
  EXPECT_EQ(result.ranges[0].first, 0);
  EXPECT_EQ(result.ranges[0].last, 1);
}

TEST(FewestPiecesFit, TwoPointsFarFromTheOriginGiveOneSegment) {
  FewestResult const result = FitKept({{1e12, 0, 1e-5}, {1e12 + 1, 0, 1e-5}});
  EXPECT_EQ(PieceCount(result), 1);
}

TEST(FewestPiecesFit, PointsOfALineGiveOneSegmentHoweverItLies) {
  // At 315 degrees strategies that look at neighbours alone see a staircase.
  for (int degrees = 0; degrees < 360; degrees += 15) {
    SCOPED_TRACE(testing::Message() << degrees << " degrees");
    FewestResult const result =
        FitKept(Rotated(MakeZigzag(200, 0.1, 0.01, 0.0), degrees * kPi / 180.0));
    EXPECT_EQ(PieceCount(result), 1);
    EXPECT_EQ(ArcCount(result), 0);
    EXPECT_EQ(result.fewestPossible, 1);
  }
}

TEST(FewestPiecesFit, ALineWithNoiseGivesOneSegment) {
  RandomGeometry random(6101);
  Scan const scan = SampleWithNormalNoise(&random, {{100.0, 0.0}}, 2000, 0.05, 0.33);
  FewestResult const result = FitKept(scan);
  EXPECT_EQ(PieceCount(result), 1);
  EXPECT_EQ(ArcCount(result), 0);
}

TEST(FewestPiecesFit, AnArcGivesOneArc) {
  for (double const sweep : {0.5, 1.5, 3.0, 4.5, 6.0}) {
    SCOPED_TRACE(testing::Message() << "sweep " << sweep);
    RandomGeometry random(6102);
    Scan const scan = SampleWithNormalNoise(&random, {{10.0 * sweep, 0.1}}, 500, 0.01, 0.45);
    FewestResult const result = FitKept(scan);
    ASSERT_EQ(PieceCount(result), 1);
    ASSERT_EQ(ArcCount(result), 1);
    EXPECT_NEAR(result.contour[1].radius, 10.0, 0.5);
    EXPECT_EQ(result.contour[1].direction, 1.0);
  }
}

TEST(FewestPiecesFit, AnArcScannedBackwardsRunsClockwise) {
  RandomGeometry random(6103);
  Scan const scan = SampleWithNormalNoise(&random, {{30.0, 0.1}}, 200, 0.01, 0.45);
  FewestResult const result = FitKept(Reversed(scan));
  ASSERT_EQ(PieceCount(result), 1);
  EXPECT_EQ(result.contour[1].direction, -1.0);
}

TEST(FewestPiecesFit, AResultIsReplaced) {
  FewestResult result = Untouchable();
  Scan const scan = SmallProfile();
  EXPECT_EQ(FewestPieces::Fit(scan, {}, &result, nullptr, 100), ErrorCode::Ok);
  ExpectSameResult(result, FitKept(scan));
}

TEST(FewestPiecesFit, GivesTheSameBitsOnEveryCall) {
  Scan const scan = SmallProfile();
  FewestResult const first = FitKept(scan);
  for (int i = 0; i < 3; ++i) {
    ExpectSameResult(FitKept(scan), first);
    FitKept(MakeZigzag(50, 1.0, 0.1, 0.9));
  }
}

// --- Options -------------------------------------------------------------------------------------

TEST(FewestPiecesFit, AFullCircleComesAsTwoArcs) {
  Scan scan = MakeRepeatedCircle(6104, 1.0, 10.0, 361, 0.01, 0.45);
  scan.pop_back();
  FewestResult const result = FitKept(scan, Closed());
  EXPECT_EQ(PieceCount(result), 2);
  EXPECT_EQ(ArcCount(result), 2);
  EXPECT_EQ(result.fewestPossible, 2);
  EXPECT_TRUE(result.isFewest);
}

TEST(FewestPiecesFit, ASquareGivesFourSides) {
  RandomGeometry random(6105);
  double const quarter = 0.5 * kPi;
  Scan const scan = SampleWithNormalNoise(&random,
                                          {{5.0, 0.0},
                                           {10.0, 0.0, quarter},
                                           {10.0, 0.0, quarter},
                                           {10.0, 0.0, quarter},
                                           {5.0, 0.0, quarter}},
                                          399, 0.01, 0.45);
  FewestResult const closed = FitKept(scan, Closed());
  EXPECT_EQ(PieceCount(closed), 4) << "the seam moves to a corner";
  EXPECT_EQ(closed.fewestPossible, 4);
  EXPECT_EQ(ArcCount(closed), 0);
  FewestResult const open = FitKept(scan);
  EXPECT_EQ(PieceCount(open), 5);
}

TEST(FewestPiecesOptions, SegmentsOnlyLeavesArcsOut) {
  FewestOptions options;
  options.segmentsOnly = true;
  RandomGeometry random(6201);
  Scan const scan = SampleWithNormalNoise(&random, {{38.0, 0.05}}, 400, 0.05, 0.0);
  FewestResult const result = FitKept(scan, options);
  EXPECT_EQ(ArcCount(result), 0);
  // A side from r + w over r - w back to r + w spans 2 acos((r - w) / (r + w)) = 0.1998, which goes
  // 9.5 times into the sweep of 1.9.
  EXPECT_EQ(PieceCount(result), 10);
  EXPECT_LE(result.fewestPossible, 10);
}

TEST(FewestPiecesOptions, NoArcIsSmallerThanTheSmallestRadius) {
  RandomGeometry random(6203);
  Scan const scan =
      SampleWithNormalNoise(&random, {{10.0, 0.0}, {3.0, 0.5}, {10.0, 0.0}}, 400, 0.02, 0.4);
  FewestOptions options;
  options.smallestRadius = 3.0;
  FewestResult const result = FitKept(scan, options);
  for (auto const& elem : result.contour) {
    if (elem.type != GeometryUtils::ElemType::Arc) continue;
    EXPECT_GE(elem.radius, 3.0);
  }
  EXPECT_EQ(PieceCount(FitKept(scan)), 3);
}

TEST(FewestPiecesOptions, StepsAreNoLargerThanAsked) {
  // Points 40 degrees apart on a circle; ExpectPromisesKept measures the steps.
  Scan const scan = MakeRepeatedCircle(6204, 0.75, 10.0, 7, 0.05, 0.0);
  FewestOptions options;
  EXPECT_EQ(PieceCount(FitKept(scan, options)), 1);
  options.largestStep = 0.5;
  FewestResult const result = FitKept(scan, options);
  EXPECT_GT(PieceCount(result), 1);
}

double LargestRadius(FewestResult const& result) {
  double largest = 0.0;
  for (auto const& elem : result.contour) {
    if (elem.type == GeometryUtils::ElemType::Arc) largest = std::fmax(largest, elem.radius);
  }
  return largest;
}

TEST(FewestPiecesOptions, WhatIsFlatterThanTheLargestRadiusComesAsSegments) {
  RandomGeometry random(6202);
  Scan const scan = SampleWithNormalNoise(&random, {{40.0, 0.0005}, {20.0, 0.1}}, 600, 0.01, 0.4);
  for (double const largest : {30.0, 100.0, 1000.0}) {
    FewestOptions options;
    options.largestRadius = largest;
    FewestResult const result = FitKept(scan, options);
    EXPECT_LE(LargestRadius(result), largest * (1.0 + 1e-9));
    // Chords of the flat arc leave it by 0.02 at most when they are 17.9 long: three of them.
    EXPECT_LE(PieceCount(result), 4);
    EXPECT_GT(PieceCount(result), PieceCount(FitKept(scan)));
  }
}

TEST(FewestPiecesOptions, ARadiusAtTheLargestIsKept) {
  Scan const scan = MakeNoisyArc(6206, 500, 0.45);
  double const radius = LargestRadius(FitKept(scan));
  FewestOptions options;
  options.largestRadius = 1.01 * radius;
  EXPECT_EQ(PieceCount(FitKept(scan, options)), 1);
}

/// How far a result leaves the middle of the way between neighbours that one arc covers.
double LargestBulge(Scan const& scan, FewestResult const& result) {
  double largest = 0.0;
  for (std::size_t k = 0; k < result.ranges.size(); ++k) {
    auto const& elem = result.contour[k + 1];
    if (elem.type != GeometryUtils::ElemType::Arc) continue;
    for (std::int32_t i = result.ranges[k].first; i < result.ranges[k].last; ++i) {
      WPoint const& p = scan[static_cast<std::size_t>(i)];
      WPoint const& q = scan[static_cast<std::size_t>(i) + 1];
      double const x = 0.5 * (p.x + q.x) - elem.center.x;
      double const y = 0.5 * (p.y + q.y) - elem.center.y;
      largest = std::fmax(largest, std::fabs(std::hypot(x, y) - elem.radius));
    }
  }
  return largest;
}

TEST(FewestPiecesOptions, PiecesStayNearThePathWhereAsked) {
  // Neighbours are 30 degrees apart: the arc bulges 0.34.
  Scan const scan = MakeRepeatedCircle(6205, 0.75, 10.0, 10, 0.05, 0.0);
  for (double const farthest : {0.0, 0.1, 0.3, 0.35}) {
    SCOPED_TRACE(testing::Message() << "at most " << farthest);
    FewestOptions options;
    options.farthestBetweenPoints = farthest;
    FewestResult const result = FitKept(scan, options);
    EXPECT_LE(LargestBulge(scan, result), farthest + 0.05);
    // Segments from point to point do in any case. Two points a segment leave joints of 0.7 between
    // them.
    EXPECT_EQ(PieceCount(result), farthest < 0.29 ? 9 : 1);
  }
}

TEST(FewestPiecesOptions, CentringBringsDeviationsDown) {
  FewestOptions plain;
  plain.centre = false;
  Scan const profile = SmallProfile();
  FewestResult const centred = FitKept(profile);
  FewestResult const uncentred = FitKept(profile, plain);
  EXPECT_EQ(PieceCount(centred), PieceCount(uncentred));
  EXPECT_EQ(centred.fewestPossible, uncentred.fewestPossible);
  EXPECT_LE(centred.largestDeviation, uncentred.largestDeviation);
  // One arc, with points at up to 0.45 of their tolerance on both sides of it.
  EXPECT_LE(FitKept(MakeNoisyArc(1, 2000, 0.45)).largestDeviation, 0.46);
}

TEST(FewestPiecesOptions, CentringGoesOnWhereOneGateStaysBehind) {
  // 80 lines and 80 arcs; without centring four of five pieces are arcs.
  FewestOptions plain;
  plain.centre = false;
  Scan const scan = MakeNoisyProfile(1, ProfileStyle::Mixed, 10, 10000, 0.45);
  EXPECT_LE(ArcCount(FitKept(scan)), 100);
  EXPECT_GE(ArcCount(FitKept(scan, plain)), 110);
}

TEST(FewestPiecesOptions, HarderEffortsNeverGiveMorePieces) {
  for (std::uint64_t seed = 1; seed <= 3; ++seed) {
    SCOPED_TRACE(testing::Message() << "seed " << seed);
    Scan const scan = MakeNoisyProfile(seed, ProfileStyle::Mixed, 1, 300, 0.9);
    FewestOptions options;
    FewestResult const quick = FitKept(scan, options);
    options.effort = FewestPieces::Effort::Wide;
    FewestResult const wide = FitKept(scan, options);
    options.effort = FewestPieces::Effort::Full;
    FewestResult const full = FitKept(scan, options);
    EXPECT_LE(PieceCount(wide), PieceCount(quick));
    EXPECT_LE(PieceCount(full), PieceCount(wide));
    EXPECT_EQ(wide.fewestPossible, quick.fewestPossible);
    EXPECT_EQ(full.fewestPossible, quick.fewestPossible);
  }
}

// --- Progress ------------------------------------------------------------------------------------

class Recorder : public ExecutionState {
 public:
  void SetProgress(std::int32_t percent) override { told.push_back(percent); }

  std::vector<std::int32_t> told;
};

class Stopper : public ExecutionState {
 public:
  explicit Stopper(std::size_t after) : left_(after) {}

  struct Stopped {};

  void SetProgress(std::int32_t /*percent*/) override {
    if (left_-- == 0) throw Stopped();
  }

 private:
  std::size_t left_;
};

TEST(FewestPiecesProgress, NeverFallsAndEndsAtTheMaximum) {
  for (std::int32_t const maxPercent : {100, 40, 1}) {
    Recorder recorder;
    FewestResult result;
    Scan const scan = SmallProfile();
    ASSERT_EQ(FewestPieces::Fit(scan, {}, &result, &recorder, maxPercent), ErrorCode::Ok);
    ASSERT_FALSE(recorder.told.empty());
    EXPECT_GE(recorder.told.front(), 1);
    EXPECT_EQ(recorder.told.back(), maxPercent);
    for (std::size_t i = 1; i < recorder.told.size(); ++i) {
      EXPECT_LE(recorder.told[i - 1], recorder.told[i]);
    }
  }
}

TEST(FewestPiecesProgress, IsToldOften) {
  Recorder recorder;
  FewestResult result;
  ASSERT_EQ(FewestPieces::Fit(SmallProfile(), {}, &result, &recorder, 100), ErrorCode::Ok);
  EXPECT_GT(recorder.told.size(), 8U);
}

TEST(FewestPiecesProgress, DoesNotChangeTheAnswer) {
  Recorder recorder;
  FewestResult result;
  Scan const scan = SmallProfile();
  ASSERT_EQ(FewestPieces::Fit(scan, {}, &result, &recorder, 100), ErrorCode::Ok);
  ExpectSameResult(result, FitKept(scan));
}

TEST(FewestPiecesProgress, WhatItThrowsEndsTheCallAndTouchesNothing) {
  Recorder recorder;
  FewestResult result;
  Scan const scan = SmallProfile();
  ASSERT_EQ(FewestPieces::Fit(scan, {}, &result, &recorder, 100), ErrorCode::Ok);
  for (std::size_t after = 0; after < recorder.told.size(); ++after) {
    SCOPED_TRACE(testing::Message() << "after " << after << " calls");
    Stopper stopper(after);
    FewestResult untouched = Untouchable();
    EXPECT_THROW(FewestPieces::Fit(scan, {}, &untouched, &stopper, 100), Stopper::Stopped);
    ExpectSameResult(untouched, Untouchable());
  }
}

// --- Centring ------------------------------------------------------------------------------------

/// The largest share of its tolerance by which a point is off each piece.
std::vector<double> RatiosOfPieces(Scan const& scan, FewestResult const& result) {
  std::vector<double> ratios;
  for (std::size_t k = 0; k < result.ranges.size(); ++k) {
    Checker::Piece const piece(Checker::ToVec(result.contour[k].end), result.contour[k + 1]);
    double largest = 0.0;
    for (std::int32_t i = result.ranges[k].first; i <= result.ranges[k].last; ++i) {
      WPoint const& p = scan[static_cast<std::size_t>(i)];
      largest = std::fmax(largest, static_cast<double>(piece.Distance(Checker::ToVec(p)) / p.w));
    }
    ratios.push_back(largest);
  }
  return ratios;
}

TEST(FewestPiecesFit, CentringBringsBackTheTrueLines) {
  for (ProfileStyle const style :
       {ProfileStyle::Smooth, ProfileStyle::Corners, ProfileStyle::Mixed}) {
    FewestResult const result = FitKept(MakeNoisyProfile(1, style, 1, 1000, 0.45));
    EXPECT_EQ(PieceCount(result), 16);
    EXPECT_EQ(ArcCount(result), 8);
    EXPECT_LE(result.largestDeviation, 0.9);
  }
}

// One point that needs nearly all of its tolerance keeps its piece and the joints beside it, and
// none of the others.
TEST(FewestPiecesFit, ATightPlaceLeavesThePiecesFarFromItCentred) {
  Scan scan = MakeNoisyProfile(1, ProfileStyle::Corners, 1, 1000, 0.2);
  auto const before = RatiosOfPieces(scan, FitKept(scan));
  // The middle of the third line, moved across it.
  std::size_t const at = 400;
  double const dx = scan[at + 8].x - scan[at - 8].x;
  double const dy = scan[at + 8].y - scan[at - 8].y;
  double const off = 1.7 * scan[at].w / std::hypot(dx, dy);
  scan[at].x -= off * dy;
  scan[at].y += off * dx;
  FewestResult const result = FitKept(scan);
  auto const after = RatiosOfPieces(scan, result);
  ASSERT_EQ(after.size(), before.size());
  EXPECT_GT(*std::max_element(after.begin(), after.end()), 0.7);
  for (std::size_t k = 0; k < after.size(); ++k) {
    if (result.ranges[k].last + 200 < 400 || result.ranges[k].first - 200 > 400) {
      EXPECT_NEAR(after[k], before[k], 0.1) << "piece " << k;
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
