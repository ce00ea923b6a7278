#include <cmath>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/FittingCalls.h"
#include "support/Profiles.h"
#include "support/ReferenceFitting.h"
#include "support/Remeasure.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Strategy = GeometryUtils::FittingStrategy;

CurveFitOutput Fit(std::vector<WPoint> const& points, Strategy strategy = Strategy::Mixed) {
  return FitCurve<GeometryUtils>(points, strategy);
}

void ExpectUntouchedFailure(std::vector<WPoint> const& points, Strategy strategy, ErrorCode code) {
  CurveFitOutput untouched;
  untouched.code = code;
  EXPECT_EQ(Transcribe(Fit(points, strategy)), Transcribe(untouched));
}

// --- Checks of the input ------------------------------------------------------------------------

TEST(CreateFittingCurve, ANullContourFailsBeforeAnythingElse) {
  double deviation = kSentinel;
  std::int32_t index = kIntSentinel;
  for (Strategy strategy :
       {Strategy::Mixed, Strategy::MixedCells, Strategy::SingleArc, Strategy{9}}) {
    EXPECT_EQ(
        GeometryUtils::CreateFittingCurve({}, strategy, nullptr, &deviation, &index, nullptr, 100),
        ErrorCode::Failed);
    EXPECT_EQ(GeometryUtils::CreateFittingCurve({{0, 0, 5}, {1, 0, 5}, {2, 0, 5}}, strategy,
                                                nullptr, &deviation, &index, nullptr, 100),
              ErrorCode::Failed);
  }
  EXPECT_EQ(deviation, kSentinel);
  EXPECT_EQ(index, kIntSentinel);
}

TEST(CreateFittingCurve, FewerThanTwoPointsFail) {
  for (Strategy strategy :
       {Strategy::Mixed, Strategy::MixedCells, Strategy::SingleArc, Strategy{9}}) {
    ExpectUntouchedFailure({}, strategy, ErrorCode::Failed);
    ExpectUntouchedFailure({{1, 2, 0.1}}, strategy, ErrorCode::Failed);
  }
}

TEST(CreateFittingCurve, NeighboursTooCloseAreRefused) {
  for (Strategy strategy : {Strategy::Mixed, Strategy::MixedCells, Strategy{9}}) {
    // Exactly 1.5 times the sum of the tolerances is not enough.
    ExpectUntouchedFailure({{0, 0, 1}, {3, 0, 1}}, strategy, ErrorCode::PointsTooClose);
    ExpectUntouchedFailure({{0, 0, 1}, {9, 0, 1}, {9, 0, 0}}, strategy, ErrorCode::PointsTooClose);
  }
}

TEST(CreateFittingCurve, TwoPointsGiveOneExactSegment) {
  for (Strategy strategy : {Strategy::Mixed, Strategy::MixedCells, Strategy{9}}) {
    CurveFitOutput const out = Fit({{0, 0, 1}, {Up(3.0), 0, 1}}, strategy);
    EXPECT_EQ(out.code, ErrorCode::Ok);
    ASSERT_EQ(out.contour.size(), 2U);
    EXPECT_EQ(out.contour[0].type, ElemType::Segment);
    EXPECT_EQ(out.contour[1].type, ElemType::Segment);
    EXPECT_SAME_POINT(out.contour[0].end, (Point{0, 0}));
    EXPECT_SAME_POINT(out.contour[1].end, (Point{Up(3.0), 0}));
    EXPECT_EQ(out.maxDeviation, 0.0);
    EXPECT_EQ(out.maxDeviationIndex, -1);
    EXPECT_TRUE(out.progress.empty());
  }
}

TEST(CreateFittingCurve, AnUnknownStrategyFailsWithMoreThanTwoPoints) {
  std::vector<WPoint> const points = MakeLinePoints({0, 0}, 1, 0, 5, 0.1);
  for (std::int32_t value : {3, -1, 2147483647}) {
    ExpectUntouchedFailure(points, Strategy{value}, ErrorCode::Failed);
  }
}

TEST(CreateFittingCurve, ProgressIsOptional) {
  std::vector<Elem> contour;
  double deviation = kSentinel;
  std::int32_t index = kIntSentinel;
  EXPECT_EQ(GeometryUtils::CreateFittingCurve(MakeLinePoints({0, 0}, 1, 0, 5, 0.1), Strategy::Mixed,
                                              &contour, &deviation, &index, nullptr, 100),
            ErrorCode::Ok);
  EXPECT_EQ(contour.size(), 2U);
}

// --- Mixed: segments and arcs -------------------------------------------------------------------

TEST(CreateFittingCurveMixed, ALineIsOneSegment) {
  CurveFitOutput const out = Fit(MakeLinePoints({0, 0}, 1, 0.3, 25, 0.1));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  ASSERT_EQ(out.contour.size(), 2U);
  EXPECT_EQ(out.contour[1].type, ElemType::Segment);
  EXPECT_LE(out.maxDeviation, 1.0);
  EXPECT_GE(out.maxDeviationIndex, 0);
}

TEST(CreateFittingCurveMixed, AnArcIsOneArc) {
  for (double sweep : {2.0, -2.0}) {
    CurveFitOutput const out = Fit(MakeArcPoints({5, 5}, 20, 0.4, sweep, 25, 0.05));
    EXPECT_EQ(out.code, ErrorCode::Ok);
    ASSERT_EQ(out.contour.size(), 2U);
    Elem const& arc = out.contour[1];
    Point const& start = out.contour[0].end;
    EXPECT_EQ(arc.type, ElemType::Arc);
    EXPECT_EQ(arc.direction, sweep > 0 ? 1.0 : -1.0);
    EXPECT_NEAR(arc.radius, 20.0, 0.1);
    EXPECT_EQ(arc.startAngle, std::atan2(start.y - arc.center.y, start.x - arc.center.x));
    EXPECT_EQ(arc.endAngle, std::atan2(arc.end.y - arc.center.y, arc.end.x - arc.center.x));
  }
}

TEST(CreateFittingCurveMixed, TheStartElementIsZeroButForItsEnd) {
  CurveFitOutput const out = Fit(MakeArcPoints({5, 5}, 20, 0.4, 2.0, 25, 0.05));
  ASSERT_FALSE(out.contour.empty());
  Elem const& first = out.contour[0];
  EXPECT_EQ(first.type, ElemType::Segment);
  EXPECT_SAME_POINT(first.center, (Point{0, 0}));
  EXPECT_EQ(first.radius, 0.0);
  EXPECT_EQ(first.direction, 0.0);
  EXPECT_EQ(first.startAngle, 0.0);
  EXPECT_EQ(first.endAngle, 0.0);
}

TEST(CreateFittingCurveMixed, FindsASlotOfTwoLinesAndTwoArcs) {
  std::vector<WPoint> points = MakeLinePoints({0, 0}, 1, 0, 20, 0.05);
  auto const append = [&points](std::vector<WPoint> const& more) {
    points.insert(points.end(), more.begin() + 1, more.end());
  };
  double const half = std::acos(-1.0);
  append(MakeArcPoints({19, 6}, 6, -half / 2, half, 20, 0.05));
  append(MakeLinePoints({19, 12}, -1, 0, 20, 0.05));
  append(MakeArcPoints({0, 6}, 6, half / 2, half * 0.9, 18, 0.05));
  CurveFitOutput const out = Fit(points);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  ASSERT_EQ(out.contour.size(), 5U);
  EXPECT_EQ(out.contour[1].type, ElemType::Segment);
  EXPECT_EQ(out.contour[2].type, ElemType::Arc);
  EXPECT_EQ(out.contour[3].type, ElemType::Segment);
  EXPECT_EQ(out.contour[4].type, ElemType::Arc);
  EXPECT_NEAR(out.contour[2].radius, 6.0, 0.1);
  EXPECT_NEAR(out.contour[4].radius, 6.0, 0.1);
  EXPECT_EQ(out.contour[2].direction, 1.0);
}

/// Over three points both kinds reach equally far: the deviations decide.
TEST(CreateFittingCurveMixed, EqualReachGoesToTheArcOnlyIfItIsNoWorse) {
  constexpr std::uint64_t kSeed = 5101;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int arcs = 0;
  int lines = 0;
  for (int i = 0; i < 6000; ++i) {
    auto const w = [&random] { return random.Uniform(0.05, 0.5); };
    std::vector<WPoint> const points = {
        {0, 0, w()}, {2, random.Uniform(0.2, 0.6), w()}, {4, random.Uniform(-0.1, 0.1), w()}};
    if (!GeometryUtils::IsPointValidToFit(points[0], points[1]) ||
        !GeometryUtils::IsPointValidToFit(points[1], points[2])) {
      continue;
    }
    LineFitInput line;
    line.points = points;
    line.count = 3;
    ArcFitInput arc;
    arc.points = points;
    arc.maxCount = arc.minCount = 3;
    LineFitOutput const bestLine = FitLine<ReferenceFitting>(line);
    ArcFitOutput const bestArc = GrowArc<ReferenceFitting>(arc);
    if (bestLine.count != 3 || bestArc.code != ErrorCode::Ok) continue;
    CurveFitOutput const out = Fit(points);
    ASSERT_EQ(out.code, ErrorCode::Ok);
    ASSERT_EQ(out.contour.size(), 2U);
    bool const isArc = out.contour[1].type == ElemType::Arc;
    EXPECT_EQ(isArc, bestArc.deviation <= bestLine.deviation);
    EXPECT_EQ(out.maxDeviation, std::min(bestArc.deviation, bestLine.deviation));
    (isArc ? arcs : lines) += 1;
  }
  EXPECT_GT(arcs, 10);
  EXPECT_GT(lines, 10);
}

TEST(CreateFittingCurveMixed, PointsThatTurnBackGiveASegmentOfTwo) {
  std::vector<WPoint> const points = {{0, 0, .1}, {4, 0, .1}, {2, 0.5, .1}, {0, 1.5, .1}};
  CurveFitOutput const out = Fit(points);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  ASSERT_GE(out.contour.size(), 2U);
  EXPECT_EQ(out.contour[1].type, ElemType::Segment);
  EXPECT_SAME_POINT(out.contour[0].end, (Point{0, 0}));
  EXPECT_SAME_POINT(out.contour[1].end, (Point{4, 0}));
}

TEST(CreateFittingCurveMixed, AppendsToAContourThatIsNotEmptyWithoutAStartElement) {
  std::vector<Elem> contour(1);
  contour[0].end = {-1, -1};
  double deviation = kSentinel;
  std::int32_t index = kIntSentinel;
  EXPECT_EQ(GeometryUtils::CreateFittingCurve(MakeLinePoints({0, 0}, 1, 0, 5, 0.1), Strategy::Mixed,
                                              &contour, &deviation, &index, nullptr, 100),
            ErrorCode::Ok);
  ASSERT_EQ(contour.size(), 2U);
  EXPECT_SAME_POINT(contour[0].end, (Point{-1, -1}));
}

TEST(CreateFittingCurveMixed, ProgressEndsAtTheWholePercentage) {
  CurveFitOutput const out = Fit(MakeArcPoints({5, 5}, 20, 0.4, 2.0, 25, 0.05));
  ASSERT_FALSE(out.progress.empty());
  EXPECT_EQ(out.progress.back(), 100);
  for (std::int32_t percent : out.progress) {
    EXPECT_GE(percent, 1);
    EXPECT_LE(percent, 100);
  }
}

TEST(CreateFittingCurveMixed, EveryPointLiesWithinItsToleranceAndTheCountsAddUp) {
  constexpr std::uint64_t kSeed = 5102;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int pieces = 0;
  for (int i = 0; i < 150; ++i) {
    SCOPED_TRACE(i);
    std::vector<WPoint> const points = MakeProfile(&random, random.Integer(3, 40));
    CurveFitOutput const out = Fit(points);
    ASSERT_EQ(out.code, ErrorCode::Ok);
    auto const measured = Remeasure(points, out.contour);
    ASSERT_TRUE(measured);
    EXPECT_LE(measured->largest, kWithinTolerance);
    EXPECT_NEAR(measured->largest, out.maxDeviation, 1e-7);
    std::int32_t sum = 0;
    for (std::int32_t count : PieceCounts(*measured)) sum += count;
    auto const k = static_cast<std::int32_t>(out.contour.size()) - 1;
    EXPECT_EQ(sum, static_cast<std::int32_t>(points.size()) + k - 1);
    pieces += k;
    // Backwards the cuts fall elsewhere, but the tolerances hold as well.
    std::vector<WPoint> const backwards(points.rbegin(), points.rend());
    CurveFitOutput const back = Fit(backwards);
    ASSERT_EQ(back.code, ErrorCode::Ok);
    auto const measuredBack = Remeasure(backwards, back.contour);
    ASSERT_TRUE(measuredBack);
    EXPECT_LE(measuredBack->largest, kWithinTolerance);
  }
  EXPECT_GT(pieces, 300);
}

TEST(CreateFittingCurveMixed, TwoRunsAreIdentical) {
  constexpr std::uint64_t kSeed = 5103;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 20; ++i) {
    std::vector<WPoint> const points = MakeProfile(&random, 30);
    EXPECT_EQ(Transcribe(Fit(points)), Transcribe(Fit(points)));
  }
}

TEST(CreateFittingCurveMixed, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5104;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int fitted = 0;
  for (int i = 0; i < 250; ++i) {
    std::vector<WPoint> points = random.Integer(0, 4) == 0
                                     ? MakeArcWithFewTightPoints(&random, random.Integer(3, 14))
                                     : MakeProfile(&random, random.Integer(2, 32));
    if (random.Integer(0, 3) == 0) AddHazard(&random, &points);
    CurveFitOutput const expected = FitCurve<ReferenceFitting>(points, Strategy::Mixed);
    fitted += expected.code == ErrorCode::Ok ? 1 : 0;
    ASSERT_EQ(Transcribe(Fit(points)), Transcribe(expected)) << "input " << i;
  }
  EXPECT_GT(fitted, 150);
}

/// A circle drawn whole, closed or with its last point once more.
TEST(CreateFittingCurveMixed, ClosedCirclesAgreeWithTheReference) {
  double const turn = 2 * std::acos(-1.0);
  for (std::int32_t count : {5, 12, 25}) {
    for (double sweep : {turn, -turn, 1.5 * turn}) {
      std::vector<WPoint> const points = MakeArcPoints({1, 2}, 10, 0.3, sweep, count, 0.05);
      CurveFitOutput const out = Fit(points);
      EXPECT_EQ(out.code, ErrorCode::Ok);
      EXPECT_EQ(Transcribe(out), Transcribe(FitCurve<ReferenceFitting>(points, Strategy::Mixed)));
    }
  }
}

// --- Input that is no contour at all ------------------------------------------------------------

TEST(CreateFittingCurve, EveryStrategyEndsOnBadNumbers) {
  constexpr std::uint64_t kSeed = 5105;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  constexpr double kHuge = std::numeric_limits<double>::max();
  constexpr double kBad[] = {kNaN, kInf, -kInf, kHuge, -kHuge, 1e-320, -0.0, 1e160};
  for (int i = 0; i < 200; ++i) {
    std::vector<WPoint> points = MakeProfile(&random, random.Integer(3, 14));
    for (int k = random.Integer(1, 3); k > 0; --k) {
      auto const last = static_cast<std::int32_t>(points.size()) - 1;
      WPoint& p = points[static_cast<std::size_t>(random.Integer(0, last))];
      double const bad = kBad[random.Integer(0, 7)];
      switch (random.Integer(0, 2)) {
        case 0:
          p.x = bad;
          break;
        case 1:
          p.y = bad;
          break;
        default:
          p.w = bad;
          break;
      }
    }
    for (Strategy strategy : {Strategy::Mixed, Strategy::MixedCells, Strategy::SingleArc}) {
      CurveFitOutput const out = Fit(points, strategy);
      auto const code = static_cast<std::int32_t>(out.code);
      EXPECT_TRUE(code == 0 || code == 2 || code == 19 || code == 20 || code == 21 || code == 23 ||
                  code == 24)
          << code;
      if (strategy != Strategy::SingleArc && out.code != ErrorCode::Ok) {
        EXPECT_EQ(out.maxDeviation, kSentinel);
        EXPECT_EQ(out.maxDeviationIndex, kIntSentinel);
      }
    }
  }
}

TEST(CreateFittingCurve, EveryStrategyEndsWhereAllPointsAreTheSame) {
  std::vector<WPoint> const points(12, WPoint{3, 4, 0});
  EXPECT_EQ(Fit(points, Strategy::Mixed).code, ErrorCode::PointsTooClose);
  EXPECT_EQ(Fit(points, Strategy::MixedCells).code, ErrorCode::PointsTooClose);
  EXPECT_EQ(Fit(points, Strategy::SingleArc).code, ErrorCode::Failed);
}

TEST(CreateFittingCurve, NegativeTolerancesAreTakenAsTheyAre) {
  std::vector<WPoint> const points = MakeLinePoints({0, 0}, 1, 0, 6, -0.1);
  EXPECT_EQ(Transcribe(Fit(points)),
            Transcribe(FitCurve<ReferenceFitting>(points, Strategy::Mixed)));
}

}  // namespace
}  // namespace Vorn::Testing
