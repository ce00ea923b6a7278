#include <cmath>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/FittingCalls.h"
#include "support/Profiles.h"
#include "support/ReferenceFitting.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Strategy = GeometryUtils::FittingStrategy;

CurveFitOutput Fit(std::vector<WPoint> const& points) {
  return FitCurve<GeometryUtils>(points, Strategy::SingleArc);
}

void ExpectUntouchedFailure(std::vector<WPoint> const& points, ErrorCode code) {
  CurveFitOutput untouched;
  untouched.code = code;
  EXPECT_EQ(Transcribe(Fit(points)), Transcribe(untouched));
}

TEST(CreateFittingCurveSingleArc, NeedsThreePoints) {
  ExpectUntouchedFailure({{0, 0, .1}, {1, 0, .1}}, ErrorCode::Failed);
}

TEST(CreateFittingCurveSingleArc, ThreePointsGiveTheirArc) {
  CurveFitOutput const ccw = Fit({{10, 0, .1}, {0, 10, .1}, {-10, 0, .1}});
  EXPECT_EQ(ccw.code, ErrorCode::Ok);
  ASSERT_EQ(ccw.contour.size(), 2U);
  EXPECT_SAME_POINT(ccw.contour[0].end, (Point{10, 0}));
  Elem const& arc = ccw.contour[1];
  EXPECT_EQ(arc.type, ElemType::Arc);
  EXPECT_SAME_POINT(arc.end, (Point{-10, 0}));
  EXPECT_EQ(arc.center.x, 0.0);
  EXPECT_EQ(arc.center.y, 0.0);
  EXPECT_EQ(arc.radius, 10.0);
  EXPECT_EQ(arc.direction, 1.0);
  EXPECT_EQ(arc.startAngle, std::atan2(0.0 - arc.center.y, 10.0 - arc.center.x));
  EXPECT_EQ(arc.endAngle, std::atan2(0.0 - arc.center.y, -10.0 - arc.center.x));
  EXPECT_EQ(ccw.maxDeviation, 0.0);
  EXPECT_EQ(ccw.maxDeviationIndex, -1);
  EXPECT_TRUE(ccw.progress.empty());
  EXPECT_EQ(Fit({{-10, 0, .1}, {0, 10, .1}, {10, 0, .1}}).contour.at(1).direction, -1.0);
}

TEST(CreateFittingCurveSingleArc, SpacingIsNotChecked) {
  EXPECT_EQ(Fit({{10, 0, 50}, {0, 10, 50}, {-10, 0, 50}}).code, ErrorCode::Ok);
}

TEST(CreateFittingCurveSingleArc, ThreeCollinearPointsFail) {
  ExpectUntouchedFailure({{2, 0, .1}, {2, 1, .1}, {2, 5, .1}}, ErrorCode::Failed);  // no circle
  ExpectUntouchedFailure({{0, 0, .1}, {1, 1, .1}, {2, 2, .1}}, ErrorCode::Failed);  // no sense
}

TEST(CreateFittingCurveSingleArc, RefinesTheCircleOfAllPoints) {
  for (double sweep : {3.0, -3.5}) {
    std::vector<WPoint> const points = MakeArcPoints({5, 5}, 20, 0.4, sweep, 25, 0.05);
    CurveFitOutput const out = Fit(points);
    EXPECT_EQ(out.code, ErrorCode::Ok);
    ASSERT_EQ(out.contour.size(), 2U);
    Elem const& arc = out.contour[1];
    EXPECT_NEAR(arc.center.x, 5.0, 1e-9);
    EXPECT_NEAR(arc.center.y, 5.0, 1e-9);
    EXPECT_NEAR(arc.radius, 20.0, 1e-9);
    EXPECT_EQ(arc.direction, sweep > 0 ? 1.0 : -1.0);
    EXPECT_NEAR(out.maxDeviation, 0.0, 1e-9);
    EXPECT_EQ(out.maxDeviationIndex, -1);
    EXPECT_NEAR(out.contour[0].end.x, points.front().x, 1e-9);
    EXPECT_NEAR(arc.end.x, points.back().x, 1e-9);
  }
}

/// The deviation of this strategy is a distance, and the tolerances of the points play a part as
/// weights only.
TEST(CreateFittingCurveSingleArc, ReportsTheLargestDistanceFromTheCircle) {
  constexpr std::uint64_t kSeed = 5106;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 30; ++i) {
    std::vector<WPoint> points = MakeArcPoints({5, 5}, 20, 0.4, 3.0, 20, 0.05);
    for (WPoint& p : points) p.x += random.Uniform(-0.02, 0.02);
    CurveFitOutput const out = Fit(points);
    ASSERT_EQ(out.code, ErrorCode::Ok);
    ASSERT_EQ(out.contour.size(), 2U);
    Elem const& arc = out.contour[1];
    double largest = 0.0;
    for (WPoint const& p : points) {
      double const d = std::hypot(p.x - arc.center.x, p.y - arc.center.y);
      largest = std::max(largest, std::fabs(d - arc.radius));
    }
    EXPECT_NEAR(out.maxDeviation, largest, 1e-12);
    EXPECT_LT(out.maxDeviation, 0.04);
  }
}

TEST(CreateFittingCurveSingleArc, EmptiesTheContourBeforeItWritesTheArc) {
  std::vector<Elem> contour(5);
  double deviation = kSentinel;
  std::int32_t index = kIntSentinel;
  EXPECT_EQ(GeometryUtils::CreateFittingCurve(MakeArcPoints({5, 5}, 20, 0.4, 3, 25, 0.05),
                                              Strategy::SingleArc, &contour, &deviation, &index,
                                              nullptr, 100),
            ErrorCode::Ok);
  EXPECT_EQ(contour.size(), 2U);
}

TEST(CreateFittingCurveSingleArc, CoincidingPointsFail) {
  std::vector<WPoint> points = MakeArcPoints({5, 5}, 20, 0.4, 2, 12, 0.05);
  points.push_back(points.front());
  ExpectUntouchedFailure(points, ErrorCode::Failed);
}

/// A flat arc leaves the first centre so much room that the refinement may leave the tolerance. The
/// first circle and its measurement then stay.
TEST(CreateFittingCurveSingleArc, AFailingRefinementLeavesTheFirstArcAndItsMeasurement) {
  std::vector<WPoint> const points = MakeArcPoints({5, 5}, 20, 0.4, 2.0, 25, 0.05);
  CurveFitOutput const out = Fit(points);
  EXPECT_EQ(out.code, ErrorCode::NoFit);
  ASSERT_EQ(out.contour.size(), 2U);
  Elem const& arc = out.contour[1];
  EXPECT_EQ(arc.type, ElemType::Arc);
  double largest = 0.0;
  for (WPoint const& p : points) {
    double const d = std::hypot(p.x - arc.center.x, p.y - arc.center.y);
    largest = std::max(largest, std::fabs(d - arc.radius));
  }
  EXPECT_NEAR(out.maxDeviation, largest, 1e-9);
}

TEST(CreateFittingCurveSingleArc, FailuresLeaveNothingOrOneArc) {
  constexpr std::uint64_t kSeed = 5107;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int noFit = 0;
  for (int i = 0; i < 300; ++i) {
    std::vector<WPoint> const points = MakeProfile(&random, random.Integer(4, 14));
    CurveFitOutput const out = Fit(points);
    if (out.code != ErrorCode::NoFit || out.maxDeviation == kSentinel) continue;
    ++noFit;
    EXPECT_GT(out.maxDeviation, 0.0);
    EXPECT_TRUE(out.contour.empty() || out.contour.size() == 2U);
  }
  EXPECT_GT(noFit, 5);
}

TEST(CreateFittingCurveSingleArc, ScalingByAPowerOfTwoScalesTheResultExactly) {
  constexpr double kFactor = 0x1p-5;
  constexpr std::uint64_t kSeed = 5108;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 20; ++i) {
    std::vector<WPoint> points = MakeArcPoints({5, 5}, 20, 0.4, 3.0, 16, 0.05);
    for (WPoint& p : points) p.x += random.Uniform(-0.05, 0.05);
    std::vector<WPoint> scaled;
    for (WPoint const& p : points) scaled.push_back({p.x * kFactor, p.y * kFactor, p.w * kFactor});
    CurveFitOutput const out = Fit(points);
    CurveFitOutput const small = Fit(scaled);
    ASSERT_EQ(out.code, ErrorCode::Ok);
    ASSERT_EQ(small.code, ErrorCode::Ok);
    EXPECT_SAME_POINT(Scale(out.contour[1].center, kFactor), small.contour[1].center);
    EXPECT_SAME_BITS(out.contour[1].radius * kFactor, small.contour[1].radius);
    EXPECT_SAME_BITS(out.maxDeviation * kFactor, small.maxDeviation);
    EXPECT_SAME_BITS(out.contour[1].startAngle, small.contour[1].startAngle);
  }
}

TEST(CreateFittingCurveSingleArc, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5109;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int fitted = 0;
  int failed = 0;
  for (int i = 0; i < 400; ++i) {
    std::vector<WPoint> points;
    if (random.Integer(0, 2) == 0) {
      points = MakeProfile(&random, random.Integer(2, 14));
    } else {
      double const radius = random.Uniform(2, 40);
      points = MakeArcPoints(random.PointIn(-20, 20), radius, 1, random.Uniform(-5.5, 5.5),
                             random.Integer(3, 14), 0.05);
      double const noise = radius * random.Uniform(0, 0.02);
      for (WPoint& p : points) {
        p.x += noise * random.Uniform(-1, 1);
        p.w = random.Uniform(0.01, 0.1);
      }
    }
    if (random.Integer(0, 3) == 0) AddHazard(&random, &points);
    CurveFitOutput const expected = FitCurve<ReferenceFitting>(points, Strategy::SingleArc);
    (expected.code == ErrorCode::Ok ? fitted : failed) += 1;
    ASSERT_EQ(Transcribe(Fit(points)), Transcribe(expected)) << "input " << i;
  }
  EXPECT_GT(fitted, 100);
  EXPECT_GT(failed, 20);
}

}  // namespace
}  // namespace Vorn::Testing
