#include <cmath>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/FittingCalls.h"
#include "support/Profiles.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Strategy = GeometryUtils::FittingStrategy;

CurveFitOutput Fit(std::vector<WPoint> const& points) {
  return FitCurve<GeometryUtils>(points, Strategy::MixedCells);
}

/// What every answer has in common, whatever the walk does.
void ExpectSoundAnswer(std::vector<WPoint> const& points, CurveFitOutput const& out) {
  if (out.code != ErrorCode::Ok) {
    EXPECT_EQ(out.maxDeviation, kSentinel);
    EXPECT_EQ(out.maxDeviationIndex, kIntSentinel);
    return;
  }
  ASSERT_GE(out.contour.size(), 2U);
  EXPECT_EQ(out.contour[0].type, ElemType::Segment);
  EXPECT_GE(out.maxDeviation, 0.0);
  EXPECT_GE(out.maxDeviationIndex, 0);
  EXPECT_LT(out.maxDeviationIndex, static_cast<std::int32_t>(points.size()));
  for (std::size_t k = 1; k < out.contour.size(); ++k) {
    Elem const& e = out.contour[k];
    Point const& start = out.contour[k - 1].end;
    if (e.type == ElemType::Segment) continue;
    ASSERT_EQ(e.type, ElemType::Arc);
    EXPECT_GT(e.radius, 0.0);
    EXPECT_EQ(std::fabs(e.direction), 1.0);
    EXPECT_EQ(e.startAngle, std::atan2(start.y - e.center.y, start.x - e.center.x));
    EXPECT_EQ(e.endAngle, std::atan2(e.end.y - e.center.y, e.end.x - e.center.x));
    double const scale = 1e-9 * (1 + e.radius + std::hypot(e.center.x, e.center.y));
    EXPECT_NEAR(std::hypot(start.x - e.center.x, start.y - e.center.y), e.radius, scale);
    EXPECT_NEAR(std::hypot(e.end.x - e.center.x, e.end.y - e.center.y), e.radius, scale);
  }
  // The contour begins and ends at the ends of the run, within their tolerances.
  auto const distance = [](Point const& p, WPoint const& q) {
    return std::hypot(p.x - q.x, p.y - q.y);
  };
  EXPECT_LE(distance(out.contour.front().end, points.front()), points.front().w * (1 + 1e-9));
  EXPECT_LE(distance(out.contour.back().end, points.back()), points.back().w * (1 + 1e-9));
}

TEST(CreateFittingCurveMixedCells, ALineIsOneSegment) {
  CurveFitOutput const out = Fit(MakeLinePoints({0, 0}, 1, 0.3, 20, 0.1));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  ASSERT_EQ(out.contour.size(), 2U);
  EXPECT_EQ(out.contour[1].type, ElemType::Segment);
  EXPECT_LE(out.maxDeviation, 1.0);
}

TEST(CreateFittingCurveMixedCells, ALineAnArcAndALineComeInThatOrder) {
  std::vector<WPoint> points = MakeLinePoints({0, 0}, 1, 0, 12, 0.02);
  double const quarter = std::acos(-1.0) / 2;
  auto const arc = MakeArcPoints({11, 6}, 6, -quarter, quarter, 12, 0.02);
  points.insert(points.end(), arc.begin() + 1, arc.end());
  auto const line = MakeLinePoints({17, 6}, 0, 1, 12, 0.02);
  points.insert(points.end(), line.begin() + 1, line.end());
  // No three points are exactly in line: such a triple has no arc at all.
  constexpr std::uint64_t kSeed = 5112;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (WPoint& p : points) {
    p.x += random.Uniform(-0.002, 0.002);
    p.y += random.Uniform(-0.002, 0.002);
  }
  CurveFitOutput const out = Fit(points);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  ExpectSoundAnswer(points, out);
  ASSERT_GE(out.contour.size(), 4U);
  EXPECT_EQ(out.contour[1].type, ElemType::Segment);
  EXPECT_EQ(out.contour.back().type, ElemType::Segment);
  int arcs = 0;
  for (Elem const& e : out.contour) {
    if (e.type != ElemType::Arc) continue;
    ++arcs;
    EXPECT_NEAR(e.radius, 6.0, 1.0);
    EXPECT_EQ(e.direction, 1.0);
  }
  EXPECT_GE(arcs, 1);
}

TEST(CreateFittingCurveMixedCells, ThreePointsOfACornerComeToAnAnswer) {
  std::vector<WPoint> const points = {{0, 0, .1}, {2, 0, .1}, {2, 2, .1}};
  ExpectSoundAnswer(points, Fit(points));
}

TEST(CreateFittingCurveMixedCells, ASegmentOfThreePointsGivesUpItsLastOneToTheClosingArc) {
  CurveFitOutput const out = Fit({{0, 0, .1}, {2, 0, .1}, {4, 0, .1}, {4, 2, .1}});
  EXPECT_EQ(out.code, ErrorCode::Ok);
  ASSERT_EQ(out.contour.size(), 3U);
  EXPECT_EQ(out.contour[1].type, ElemType::Segment);
  EXPECT_EQ(out.contour[1].end.x, 2.0);
  EXPECT_EQ(out.contour[1].end.y, 0.0);
  EXPECT_EQ(out.contour[2].type, ElemType::Arc);
}

TEST(CreateFittingCurveMixedCells, AnswersAreSound) {
  constexpr std::uint64_t kSeed = 5110;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int fitted = 0;
  for (int i = 0; i < 200; ++i) {
    SCOPED_TRACE(i);
    std::vector<WPoint> const points = MakeProfile(&random, random.Integer(3, 30));
    CurveFitOutput const out = Fit(points);
    ExpectSoundAnswer(points, out);
    fitted += out.code == ErrorCode::Ok ? 1 : 0;
  }
  EXPECT_GT(fitted, 100);
}

TEST(CreateFittingCurveMixedCells, TwoRunsAreIdentical) {
  constexpr std::uint64_t kSeed = 5111;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 30; ++i) {
    std::vector<WPoint> points = MakeProfile(&random, random.Integer(3, 25));
    if (random.Flip()) AddHazard(&random, &points);
    EXPECT_EQ(Transcribe(Fit(points)), Transcribe(Fit(points)));
  }
}

TEST(CreateFittingCurveMixedCells, ReportsThePercentageOfTheLineSearch) {
  CurveFitOutput const out = Fit(MakeLinePoints({0, 0}, 1, 0.3, 20, 0.1));
  ASSERT_FALSE(out.progress.empty());
  EXPECT_EQ(out.progress.back(), 100);
}

}  // namespace
}  // namespace Vorn::Testing
