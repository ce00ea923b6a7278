#include <cmath>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/CellInputs.h"
#include "support/FittingCalls.h"
#include "support/Profiles.h"
#include "support/ReferenceFitting.h"
#include "support/Remeasure.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;
using Indices = std::vector<std::int32_t>;

ArcFitInput WholeRun(std::vector<WPoint> points) {
  ArcFitInput in;
  in.maxCount = static_cast<std::int32_t>(points.size());
  in.minCount = 3;
  in.points = std::move(points);
  return in;
}

ArcFitInput RandomArcInput(RandomGeometry* random, std::int32_t maxSize) {
  std::vector<WPoint> points;
  switch (random->Integer(0, 3)) {
    case 0:
      points = MakeArcWithFewTightPoints(random, random->Integer(3, maxSize));
      break;
    case 1:
      points = MakeArcPoints(random->PointIn(-20, 20), random->Uniform(2, 40), 1,
                             random->Uniform(-5, 5), random->Integer(3, maxSize), 0.05);
      for (WPoint& p : points) p.y += random->Uniform(-0.04, 0.04);
      break;
    default:
      points = MakeProfile(random, random->Integer(3, maxSize));
      break;
  }
  if (random->Integer(0, 4) == 0) AddHazard(random, &points);
  ArcFitInput in = WholeRun(std::move(points));
  in.first = random->Integer(0, 2) == 0 ? random->Integer(0, in.maxCount - 3) : 0;
  in.maxCount -= in.first;
  if (random->Integer(0, 3) == 0) in.maxCount = random->Integer(3, in.maxCount);
  in.minCount = random->Integer(0, 2) == 0 ? random->Integer(3, in.maxCount) : 3;
  in.startFixed = random->Flip();
  in.endFixed = random->Integer(0, 3) == 0;
  WPoint const& front = in.points[static_cast<std::size_t>(in.first)];
  WPoint const& back = in.points[static_cast<std::size_t>(in.first + in.maxCount - 1)];
  in.start = {front.x + front.w * random->Uniform(-0.6, 0.6), front.y};
  in.end = {back.x, back.y + back.w * random->Uniform(-0.6, 0.6)};
  in.cells = {{{{1, 2}, {3, 4}, {5, 7}}}};
  return in;
}

void ExpectOnCircle(ArcFitOutput const& out, Point const& p) {
  EXPECT_NEAR(std::hypot(p.x - out.centre.x, p.y - out.centre.y), out.radius,
              1e-12 * (1 + out.radius));
}

// --- GetFittingCircleO --------------------------------------------------------------------------

TEST(GetFittingCircleO, FindsTheCircleOfAnExactArc) {
  ArcFitOutput const out =
      FitArcRun<GeometryUtils>(WholeRun(MakeArcPoints({3, -2}, 25, 0.2, 1.5, 15, 0.01)));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 15);
  EXPECT_TRUE(out.ccw);
  EXPECT_NEAR(out.centre.x, 3.0, 0.05);
  EXPECT_NEAR(out.centre.y, -2.0, 0.05);
  EXPECT_NEAR(out.radius, 25.0, 0.05);
  EXPECT_LE(out.deviation, 1.0);
  EXPECT_GE(out.deviationIndex, 0);
  ExpectOnCircle(out, out.start);
  ExpectOnCircle(out, out.end);
}

TEST(GetFittingCircleO, ClockwisePointsTurnClockwise) {
  ArcFitOutput const out =
      FitArcRun<GeometryUtils>(WholeRun(MakeArcPoints({3, -2}, 25, 0.2, -1.5, 15, 0.01)));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_FALSE(out.ccw);
}

TEST(GetFittingCircleO, ThreeCollinearPointsFail) {
  ArcFitInput const in = WholeRun({{0, 0, .1}, {1, 1, .1}, {2, 2, .1}});
  ArcFitOutput expected = PresetArcFitOutput(in);
  expected.deviationIndex = -1;
  EXPECT_EQ(Transcribe(FitArcRun<GeometryUtils>(in)), Transcribe(expected));
}

TEST(GetFittingCircleO, AnEndThatACircleWithoutCentreCannotTakeFails) {
  // Rounding keeps the area of the three points from being zero, but not the pivot that their
  // circumcentre is divided by.
  ArcFitInput in = WholeRun({{-1.6314705975158141, 1.6314705975158144, 0.15},
                             {-3.2629411950316283, 3.2629411950316287, 0.15},
                             {-4.8944117925474426, 4.8944117925474426, 0.15}});
  bool ccw = false;
  auto const at = [&in](std::size_t i) { return Point{in.points[i].x, in.points[i].y}; };
  ASSERT_EQ(GeometryUtils::IsCcw(at(0), at(1), at(2), &ccw), ErrorCode::Ok);
  EXPECT_EQ(FitArcRun<GeometryUtils>(in).code, ErrorCode::Failed);
  in.startFixed = true;
  in.start = at(0);
  EXPECT_EQ(FitArcRun<GeometryUtils>(in).code, ErrorCode::Failed);
}

TEST(GetFittingCircleO, ShortRunsAndRunsThatLeaveTheVectorFail) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 5, 0, 1, 6, 0.01));
  in.cells = {{{{1, 2}, {3, 4}, {5, 7}}}};
  for (auto const& [first, count] : std::vector<std::pair<std::int32_t, std::int32_t>>{
           {0, 2}, {0, 0}, {0, -1}, {0, 7}, {4, 3}, {-1, 4}, {2147483647, 2147483647}}) {
    in.first = first;
    in.maxCount = count;
    ArcFitOutput expected = PresetArcFitOutput(in);
    expected.deviationIndex = -1;
    EXPECT_EQ(Transcribe(FitArcRun<GeometryUtils>(in)), Transcribe(expected));
  }
}

TEST(GetFittingCircleO, TakesEveryPointAsSample) {
  ArcFitInput const in = WholeRun(MakeArcPoints({0, 0}, 5, 0, 1, 6, 0.01));
  ArcFitOutput const out = FitArcRun<GeometryUtils>(in);
  ASSERT_EQ(out.indexedPoints.size(), 6U);
  for (std::size_t i = 0; i < 6; ++i) {
    EXPECT_EQ(out.indexedPoints[i].index, static_cast<std::int32_t>(i));
    EXPECT_EQ(out.indexedPoints[i].pt.x, in.points[i].x);
    EXPECT_EQ(out.indexedPoints[i].w, 0.01);
  }
  EXPECT_FALSE(out.cells.empty());
}

/// Between two tries the samples keep what an earlier thinning left of them.
TEST(GetFittingCircleO, AddsTheNewEndToTheSamplesOfAnEarlierTry) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 5, 0, 1, 8, 0.01));
  in.indexedPoints = {{{9, 9}, 9, 9}, {{in.points[3].x, in.points[3].y}, 0.02, 0}};
  ArcFitOutput const out = FitArcRun<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 8);
  ASSERT_EQ(out.indexedPoints.size(), 3U);
  EXPECT_EQ(out.indexedPoints[0].index, 0);
  EXPECT_EQ(out.indexedPoints[0].pt.x, in.points[0].x);
  EXPECT_EQ(out.indexedPoints[1].index, 0);
  EXPECT_EQ(out.indexedPoints[1].w, 0.02);
  EXPECT_EQ(out.indexedPoints[2].index, 7);
}

TEST(GetFittingCircleO, IgnoresTheCellsOnEntry) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 5, 0, 1, 8, 0.01));
  ArcFitOutput const clean = FitArcRun<GeometryUtils>(in);
  in.cells = {{{{100, 100}, {101, 100}, {100, 101}}}};
  EXPECT_EQ(Transcribe(FitArcRun<GeometryUtils>(in)), Transcribe(clean));
}

TEST(GetFittingCircleO, NullCellsChangeNothingElse) {
  std::vector<WPoint> const points = MakeArcPoints({1, 2}, 20, 1, 0.3, 24, 0.05);
  auto const count = static_cast<std::int32_t>(points.size());
  std::vector<Triangle> cells;
  std::vector<Triangle>* const handedOut[] = {&cells, nullptr};
  Point start[2];
  Point end[2];
  Point centre[2];
  double radius[2] = {kSentinel, kSentinel};
  double deviation[2] = {kSentinel, kSentinel};
  for (int i = 0; i < 2; ++i) {
    std::vector<GeometryUtils::IndexedPoint> samples;
    std::int32_t arcCount = 0;
    std::int32_t deviationIndex = 0;
    bool ccw = false;
    ASSERT_EQ(GeometryUtils::GetFittingCircleO(points, 0, count, false, &start[i], false, &end[i],
                                               &samples, handedOut[i], &arcCount, &centre[i],
                                               &radius[i], &ccw, &deviation[i], &deviationIndex),
              ErrorCode::Ok);
  }
  EXPECT_FALSE(cells.empty());
  EXPECT_SAME_POINT(start[0], start[1]);
  EXPECT_SAME_POINT(end[0], end[1]);
  EXPECT_SAME_POINT(centre[0], centre[1]);
  EXPECT_SAME_BITS(radius[0], radius[1]);
  EXPECT_SAME_BITS(deviation[0], deviation[1]);
}

TEST(GetFittingCircleO, KeepsAFixedStart) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 1.5, 9, 0.05));
  in.startFixed = true;
  in.start = {10.02, 0};
  ArcFitOutput const out = FitArcRun<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_SAME_POINT(out.start, in.start);
  ExpectOnCircle(out, out.start);
  ExpectOnCircle(out, out.end);
}

TEST(GetFittingCircleO, KeepsAFixedEnd) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 1.5, 9, 0.05));
  in.endFixed = true;
  in.end = {in.points.back().x, in.points.back().y + 0.02};
  ArcFitOutput const out = FitArcRun<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_SAME_POINT(out.end, in.end);
  ExpectOnCircle(out, out.end);
}

TEST(GetFittingCircleO, KeepsBothFixedEnds) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 1.5, 9, 0.05));
  in.startFixed = in.endFixed = true;
  in.start = {10.02, 0};
  in.end = {in.points.back().x, in.points.back().y + 0.02};
  ArcFitOutput const out = FitArcRun<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_SAME_POINT(out.start, in.start);
  EXPECT_SAME_POINT(out.end, in.end);
  ExpectOnCircle(out, out.start);
  ExpectOnCircle(out, out.end);
  EXPECT_LE(out.deviation, 1.0 + 1e-12);
}

TEST(GetFittingCircleO, FixedEndsInOnePlaceHaveNoBisectorAndFail) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 6.0, 13, 0.5));
  in.startFixed = in.endFixed = true;
  in.start = in.end = {10, 0};
  EXPECT_EQ(FitArcRun<GeometryUtils>(in).code, ErrorCode::Failed);
  in.end = {10, -0.5};
  EXPECT_EQ(FitArcRun<GeometryUtils>(in).code, ErrorCode::Ok);
}

TEST(GetFittingCircleO, FixedEndsInOnePlaceFail) {
  // The cell of the centres is there, but no bisector of the ends to move the centre to.
  ArcFitInput in = WholeRun(MakeArcPoints({-10, 0}, 10, 0, 1.5, 6, 0.5));
  in.startFixed = true;
  in.endFixed = true;
  in.start = {0, 0};
  in.end = {0, 0};
  ArcFitOutput const out = FitArcRun<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Failed);
  EXPECT_FALSE(out.cells.empty());
  EXPECT_EQ(Transcribe(out), Transcribe(FitArcRun<ReferenceFitting>(in)));
}

TEST(GetFittingCircleO, CellsWithoutCommonPartAreNoFit) {
  std::vector<WPoint> points = MakeArcPoints({0, 0}, 10, 0, 1.5, 9, 0.02);
  points[6].x *= 1.05;
  points[6].y *= 1.05;
  ArcFitInput const in = WholeRun(points);
  ArcFitOutput const out = FitArcRun<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::NoFit);
  EXPECT_EQ(out.deviationIndex, -1);
  EXPECT_EQ(out.count, kIntSentinel);
  EXPECT_SAME_POINT(out.start, in.start);
  EXPECT_SAME_POINT(out.centre, kPointSentinel);
  EXPECT_EQ(out.radius, kSentinel);
  EXPECT_EQ(out.deviation, kSentinel);
  EXPECT_EQ(out.indexedPoints.size(), 9U);
}

TEST(GetFittingCircleO, TolerancesAboveTheCurvatureAreAnOrientationMismatch) {
  ArcFitOutput const out =
      FitArcRun<GeometryUtils>(WholeRun({{0, 0, .1}, {1, 0.01, .1}, {2, 0, .1}}));
  EXPECT_EQ(out.code, ErrorCode::OrientationMismatch);
}

TEST(GetFittingCircleO, ThinsTheSamplesOfAnOversizedCell) {
  constexpr std::uint64_t kSeed = 5303;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int thinned = 0;
  for (int i = 0; i < 25; ++i) {
    ArcFitInput const in = WholeRun(MakeArcWithFewTightPoints(&random, 30));
    ArcFitOutput const out = FitArcRun<GeometryUtils>(in);
    thinned += out.indexedPoints.size() < in.points.size() ? 1 : 0;
    ASSERT_EQ(Transcribe(out), Transcribe(FitArcRun<ReferenceFitting>(in))) << "input " << i;
  }
  EXPECT_GT(thinned, 3);
}

TEST(GetFittingCircleO, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5304;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int fitted = 0;
  for (int i = 0; i < 400; ++i) {
    ArcFitInput in = RandomArcInput(&random, 16);
    if (random.Integer(0, 3) == 0) {
      ArcFitInput shorter = in;
      shorter.maxCount = std::max(3, in.maxCount - 1);
      in.indexedPoints = FitArcRun<ReferenceFitting>(shorter).indexedPoints;
    }
    ArcFitOutput const expected = FitArcRun<ReferenceFitting>(in);
    fitted += expected.code == ErrorCode::Ok ? 1 : 0;
    ASSERT_EQ(Transcribe(FitArcRun<GeometryUtils>(in)), Transcribe(expected)) << "input " << i;
  }
  EXPECT_GT(fitted, 100);
}

TEST(GetFittingCircleO, ScalingByAPowerOfTwoScalesTheResultExactly) {
  constexpr std::uint64_t kSeed = 5305;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  constexpr double kFactor = 0x1p7;
  int fitted = 0;
  for (int i = 0; i < 60; ++i) {
    ArcFitInput in = WholeRun(MakeArcPoints(random.PointIn(-20, 20), random.Uniform(5, 40), 1,
                                            random.Uniform(0.5, 4), 10, 0.05));
    for (WPoint& p : in.points) p.y += random.Uniform(-0.04, 0.04);
    ArcFitInput scaled = in;
    for (WPoint& p : scaled.points) p = {p.x * kFactor, p.y * kFactor, p.w * kFactor};
    ArcFitOutput const out = FitArcRun<GeometryUtils>(in);
    ArcFitOutput const big = FitArcRun<GeometryUtils>(scaled);
    ASSERT_EQ(out.code, big.code);
    if (out.code != ErrorCode::Ok) continue;
    ++fitted;
    EXPECT_SAME_POINT(Scale(out.centre, kFactor), big.centre);
    EXPECT_SAME_POINT(Scale(out.start, kFactor), big.start);
    EXPECT_SAME_POINT(Scale(out.end, kFactor), big.end);
    EXPECT_SAME_BITS(out.radius * kFactor, big.radius);
    EXPECT_SAME_BITS(out.deviation, big.deviation);
    EXPECT_EQ(out.deviationIndex, big.deviationIndex);
  }
  EXPECT_GT(fitted, 20);
}

// --- GetFittingCircle2 --------------------------------------------------------------------------

TEST(GetFittingCircle2, CoversTheWholeRun) {
  ArcFitInput const in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 2.0, 12, 0.02));
  ArcFitOutput const out = GrowArc<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 12);
  EXPECT_LE(out.deviation, 1.0);
  EXPECT_FALSE(out.cells.empty());
  ExpectOnCircle(out, out.end);
  EXPECT_NEAR(out.end.x, in.points.back().x, 0.03);
}

TEST(GetFittingCircle2, AMinimumAboveTheMaximumFailsUntouched) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 2.0, 12, 0.02));
  in.minCount = 13;
  in.cells = {{{{1, 2}, {3, 4}, {5, 7}}}};
  EXPECT_EQ(Transcribe(GrowArc<GeometryUtils>(in)), Transcribe(PresetArcFitOutput(in)));
}

TEST(GetFittingCircle2, EqualMinimumAndMaximumMakeOneTry) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 2.0, 12, 0.02));
  in.minCount = in.maxCount = 7;
  ArcFitOutput const out = GrowArc<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 7);
  // The one try counts its next point, 8 of 12; the end counts the run, 7 of 12.
  EXPECT_EQ(out.progress, (Indices{67, 59}));
  in.points[5] = {30, 30, 0.02};
  EXPECT_NE(GrowArc<GeometryUtils>(in).code, ErrorCode::Ok);
}

TEST(GetFittingCircle2, StepsPastPointsThatLieStraightAtFirst) {
  // Nearly straight to within the tolerance over the first points, clearly curved over all.
  ArcFitInput const in = WholeRun(MakeArcPoints({0, 0}, 100, 0, 0.6, 16, 0.3));
  ArcFitInput three = in;
  three.maxCount = 3;
  ASSERT_EQ(FitArcRun<GeometryUtils>(three).code, ErrorCode::OrientationMismatch);
  ArcFitOutput const out = GrowArc<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 16);
}

TEST(GetFittingCircle2, PointsThatStayStraightAreAnOrientationMismatch) {
  std::vector<WPoint> points = MakeLinePoints({0, 0}, 1, 0, 8, 0.1);
  for (std::size_t i = 0; i < points.size(); ++i) points[i].y = i % 2 == 0 ? 0.0 : 0.01;
  // First, middle and last are never exactly in line.
  for (std::size_t i = 2; i < points.size(); ++i) points[i].y += 0.001 * static_cast<double>(i * i);
  ArcFitOutput const out = GrowArc<GeometryUtils>(WholeRun(points));
  EXPECT_EQ(out.code, ErrorCode::OrientationMismatch);
  EXPECT_EQ(out.count, kIntSentinel);
  EXPECT_TRUE(out.cells.empty());
}

TEST(GetFittingCircle2, StraightPointsThatTurnBackAreASelfIntersection) {
  ArcFitOutput const out =
      GrowArc<GeometryUtils>(WholeRun({{0, 0, .3}, {4, 0.01, .3}, {2, 0.03, .3}, {6, 0, .3}}));
  EXPECT_EQ(out.code, ErrorCode::SelfIntersection);
}

TEST(GetFittingCircle2, AReversedTurnEndsTheArcAtTheLastSuccess) {
  std::vector<WPoint> points = MakeArcPoints({0, 0}, 10, 3.0, -1.5, 8, 0.02);
  // An S: the same circle mirrored at the last point.
  for (int i = 6; i >= 0; --i) {
    WPoint const& p = points[static_cast<std::size_t>(i)];
    points.push_back({2 * points[7].x - p.x, 2 * points[7].y - p.y, 0.02});
  }
  ArcFitOutput const out = GrowArc<GeometryUtils>(WholeRun(points));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_GE(out.count, 8);
  EXPECT_LT(out.count, 11);
  EXPECT_FALSE(out.ccw);
  EXPECT_LE(out.deviation, 1.0);
}

TEST(GetFittingCircle2, PointsThatRunBackOnTheCircleEndTheArc) {
  std::vector<WPoint> points = MakeArcPoints({0, 0}, 10, 0, 1.6, 9, 0.02);
  points.push_back({10 * std::cos(1.1), 10 * std::sin(1.1), 0.02});
  points.push_back({10 * std::cos(0.7), 10 * std::sin(0.7), 0.02});
  ArcFitOutput const out = GrowArc<GeometryUtils>(WholeRun(points));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 9);
  EXPECT_EQ(Transcribe(out), Transcribe(GrowArc<ReferenceFitting>(WholeRun(points))));
}

TEST(GetFittingCircle2, NoArcBeginsWithStepsOfARightAngle) {
  double const third = 2 * std::acos(-1.0) / 3;
  std::vector<WPoint> const triangle = MakeArcPoints({0, 0}, 10, 0, 2 * third, 3, 0.02);
  ASSERT_EQ(FitArcRun<GeometryUtils>(WholeRun(triangle)).code, ErrorCode::Ok);
  EXPECT_EQ(GrowArc<GeometryUtils>(WholeRun(triangle)).code, ErrorCode::SelfIntersection);
  // One wide step, the first or the second, is enough.
  std::vector<WPoint> points = MakeArcPoints({0, 0}, 10, 0, 2.4, 3, 0.02);
  EXPECT_EQ(GrowArc<GeometryUtils>(WholeRun(points)).code, ErrorCode::Ok);
  for (double const angle : {0.7, 1.7}) {
    points[1] = {10 * std::cos(angle), 10 * std::sin(angle), 0.02};
    EXPECT_EQ(GrowArc<GeometryUtils>(WholeRun(points)).code, ErrorCode::SelfIntersection);
  }
}

TEST(GetFittingCircle2, CollinearPointsFail) {
  ArcFitOutput const out = GrowArc<GeometryUtils>(WholeRun(MakeLinePoints({0, 0}, 1, 2, 8, 0.1)));
  EXPECT_EQ(out.code, ErrorCode::Failed);
}

TEST(GetFittingCircle2, BadRunsFailWithoutReadingOutside) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 2.0, 12, 0.02));
  in.minCount = 2;
  EXPECT_EQ(GrowArc<GeometryUtils>(in).code, ErrorCode::Failed);
  in.minCount = -2147483647;
  EXPECT_EQ(GrowArc<GeometryUtils>(in).code, ErrorCode::Failed);
  in.minCount = 3;
  in.first = -1;
  EXPECT_EQ(GrowArc<GeometryUtils>(in).code, ErrorCode::Failed);
  in.first = 10;
  EXPECT_EQ(GrowArc<GeometryUtils>(in).code, ErrorCode::Failed);
  in.first = 0;
  in.maxCount = 2147483647;  // more than there are: the run ends where the points end
  ArcFitOutput const out = GrowArc<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 12);
}

TEST(GetFittingCircle2, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5306;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int fitted = 0;
  int partly = 0;
  for (int i = 0; i < 250; ++i) {
    ArcFitInput const in = RandomArcInput(&random, 14);
    ArcFitOutput const expected = GrowArc<ReferenceFitting>(in);
    fitted += expected.code == ErrorCode::Ok ? 1 : 0;
    partly += expected.code == ErrorCode::Ok && expected.count < in.maxCount ? 1 : 0;
    ASSERT_EQ(Transcribe(GrowArc<GeometryUtils>(in)), Transcribe(expected)) << "input " << i;
  }
  EXPECT_GT(fitted, 50);
  EXPECT_GT(partly, 20);
}

TEST(GetFittingCircle2, NullCellsChangeNothingElse) {
  // Without cells to hand out, tries that end without one are cut short.
  constexpr std::uint64_t kSeed = 5309;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int stretched = 0;
  for (int i = 0; i < 60; ++i) {
    SCOPED_TRACE(i);
    std::vector<WPoint> const points =
        NoisyArc(random, 60, random.Uniform(8, 60), random.Uniform(0.01, 0.1));
    auto const count = static_cast<std::int32_t>(points.size());
    std::vector<Triangle> cells;
    std::vector<Triangle>* const handedOut[] = {&cells, nullptr};
    std::string transcripts[2];
    for (int k = 0; k < 2; ++k) {
      ArcFitOutput out;
      ProgressRecorder state;
      out.code = GeometryUtils::GetFittingCircle2(points, 0, count, 3, false, &out.start, false,
                                                  &out.end, handedOut[k], &out.count, &out.centre,
                                                  &out.radius, &out.ccw, &out.deviation,
                                                  &out.deviationIndex, {&state, 100, count});
      out.progress = state.percents;
      stretched += out.count > 10 ? 1 : 0;
      transcripts[k] = Transcribe(out);
    }
    EXPECT_EQ(transcripts[0], transcripts[1]);
  }
  EXPECT_GT(stretched, 20);
}

// --- GetFittingCircle1 --------------------------------------------------------------------------

TEST(GetFittingCircle1, TakesTheLongestRunFirst) {
  ArcFitInput const in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 2.0, 12, 0.02));
  ArcFitOutput const out = ShrinkArc<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 12);
}

TEST(GetFittingCircle1, ShortensUntilTheRunFits) {
  std::vector<WPoint> points = MakeArcPoints({0, 0}, 10, 0, 2.0, 12, 0.02);
  points[9] = {20, 20, 0.02};
  ArcFitInput const in = WholeRun(points);
  ArcFitOutput const out = ShrinkArc<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 9);
  EXPECT_NEAR(out.end.x, points[8].x, 0.03);
}

TEST(GetFittingCircle1, AFixedEndCountsForTheFirstTryOnly) {
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 2.0, 12, 0.02));
  in.endFixed = true;
  in.end = {in.points.back().x + 0.01, in.points.back().y};
  EXPECT_SAME_POINT(ShrinkArc<GeometryUtils>(in).end, in.end);
  in.end = {in.points.back().x + 5, in.points.back().y};
  ArcFitOutput const out = ShrinkArc<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 11);
  ExpectOnCircle(out, out.end);
}

TEST(GetFittingCircle1, NoFitWhenNoLengthSucceeds) {
  ArcFitOutput const line = ShrinkArc<GeometryUtils>(WholeRun(MakeLinePoints({0, 0}, 1, 2, 6, .1)));
  EXPECT_EQ(line.code, ErrorCode::NoFit);
  EXPECT_EQ(line.count, kIntSentinel);
  ArcFitInput in = WholeRun(MakeArcPoints({0, 0}, 10, 0, 2.0, 12, 0.02));
  in.minCount = 13;
  EXPECT_EQ(ShrinkArc<GeometryUtils>(in).code, ErrorCode::NoFit);
  in.minCount = 0;
  in.maxCount = 2;
  EXPECT_EQ(ShrinkArc<GeometryUtils>(in).code, ErrorCode::NoFit);
  in.maxCount = 12;
  in.first = -5;
  EXPECT_EQ(ShrinkArc<GeometryUtils>(in).code, ErrorCode::NoFit);
}

TEST(GetFittingCircle1, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5307;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int shortened = 0;
  for (int i = 0; i < 150; ++i) {
    ArcFitInput const in = RandomArcInput(&random, 12);
    ArcFitOutput const expected = ShrinkArc<ReferenceFitting>(in);
    shortened += expected.code == ErrorCode::Ok && expected.count < in.maxCount ? 1 : 0;
    ASSERT_EQ(Transcribe(ShrinkArc<GeometryUtils>(in)), Transcribe(expected)) << "input " << i;
  }
  EXPECT_GT(shortened, 10);
}

}  // namespace
}  // namespace Vorn::Testing
