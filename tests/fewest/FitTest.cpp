#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>
#include <stdexcept>

#include "support/Profiles.h"
#include "vorn/FewestPieces.h"

namespace Vorn {
namespace {

using Testing::MakeArcPoints;
using Testing::MakeLinePoints;

ErrorCode FitPlain(std::vector<WPoint> const& points, FewestPieces::Result* result) {
  return FewestPieces::Fit(points, FewestPieces::Options(), result, nullptr, 100);
}

std::vector<WPoint> LineArcLine() {
  std::vector<WPoint> points = MakeLinePoints({-10.0, 0.0}, 0.5, 0.0, 20, 0.01);
  auto const arc = MakeArcPoints({0.0, 8.0}, 8.0, -0.5 * std::acos(-1.0), 1.2, 20, 0.01);
  points.insert(points.end(), arc.begin(), arc.end());
  double const x = 8.0 * std::sin(1.2);
  double const y = 8.0 - 8.0 * std::cos(1.2);
  for (int i = 1; i < 20; ++i) {
    points.push_back({x + 0.5 * i * std::cos(1.2), y + 0.5 * i * std::sin(1.2), 0.01});
  }
  return points;
}

TEST(FewestPieces, TwoPointsGiveOneSegmentThroughThem) {
  FewestPieces::Result result;
  ASSERT_EQ(FitPlain({{1.0, 2.0, 0.1}, {4.0, 6.0, 0.1}}, &result), ErrorCode::Ok);
  ASSERT_EQ(result.contour.size(), 2u);
  EXPECT_EQ(result.contour[1].type, GeometryUtils::ElemType::Segment);
  EXPECT_EQ(result.fewestPossible, 1);
  EXPECT_TRUE(result.isFewest);
}

TEST(FewestPieces, ALineAnArcAndALineAreThreePieces) {
  FewestPieces::Result result;
  ASSERT_EQ(FitPlain(LineArcLine(), &result), ErrorCode::Ok);
  ASSERT_EQ(result.ranges.size(), 3u);
  EXPECT_EQ(result.fewestPossible, 3);
  EXPECT_TRUE(result.isFewest);
  EXPECT_LE(result.largestDeviation, 1.0);
}

TEST(FewestPieces, RangesHoldEveryPointOnce) {
  FewestPieces::Result result;
  ASSERT_EQ(FitPlain(LineArcLine(), &result), ErrorCode::Ok);
  std::int32_t next = 0;
  for (FewestPieces::Range const& range : result.ranges) {
    EXPECT_EQ(range.first, next);
    next = range.last + 1;
  }
  EXPECT_EQ(next, 59);
}

TEST(FewestPieces, BadInputFailsAndLeavesTheResult) {
  double const nan = std::numeric_limits<double>::quiet_NaN();
  double const infinity = std::numeric_limits<double>::infinity();
  std::vector<std::vector<WPoint>> const bad = {
      {},
      {{0.0, 0.0, 1.0}},
      {{0.0, 0.0, 1.0}, {nan, 0.0, 1.0}},
      {{0.0, 0.0, 1.0}, {5.0, infinity, 1.0}},
      {{0.0, 0.0, 1.0}, {5.0, 0.0, 0.0}},
      {{0.0, 0.0, 1.0}, {5.0, 0.0, -1.0}},
      {{0.0, 0.0, nan}, {5.0, 0.0, 1.0}},
      {{0.0, 0.0, infinity}, {5.0, 0.0, 1.0}},
  };
  for (auto const& points : bad) {
    FewestPieces::Result result;
    result.fewestPossible = -7;
    EXPECT_EQ(FitPlain(points, &result), ErrorCode::Failed);
    EXPECT_EQ(result.fewestPossible, -7);
    EXPECT_TRUE(result.contour.empty());
  }
  EXPECT_EQ(FitPlain(LineArcLine(), nullptr), ErrorCode::Failed);
}

TEST(FewestPieces, BadOptionsFail) {
  double const nan = std::numeric_limits<double>::quiet_NaN();
  std::vector<FewestPieces::Options> bad(8);
  bad[0].largestStep = 0.0;
  bad[1].largestStep = 3.2;
  bad[2].largestStep = nan;
  bad[3].smallestRadius = -1.0;
  bad[4].smallestRadius = nan;
  bad[5].largestRadius = 0.0;
  bad[6].smallestRadius = 2.0;
  bad[6].largestRadius = 1.0;
  bad[7].farthestBetweenPoints = -1.0;
  for (FewestPieces::Options const& options : bad) {
    FewestPieces::Result result;
    EXPECT_EQ(FewestPieces::Fit(LineArcLine(), options, &result, nullptr, 100), ErrorCode::Failed);
  }
}

TEST(FewestPieces, StepsMayBeHalfATurnButNoMore) {
  FewestPieces::Options options;
  options.largestStep = std::numbers::pi;
  FewestPieces::Result result;
  EXPECT_EQ(FewestPieces::Fit(LineArcLine(), options, &result, nullptr, 100), ErrorCode::Ok);
  options.largestStep = std::nextafter(std::numbers::pi, 4.0);
  EXPECT_EQ(FewestPieces::Fit(LineArcLine(), options, &result, nullptr, 100), ErrorCode::Failed);
}

TEST(FewestPieces, PointsThatCoincideHaveNoFit) {
  FewestPieces::Result result;
  EXPECT_EQ(FitPlain({{1.0, 1.0, 0.1}, {1.0, 1.0, 0.1}, {1.0, 1.0, 0.1}}, &result),
            ErrorCode::NoFit);
  EXPECT_EQ(FitPlain({{1.0, 1.0, 0.1}, {1.05, 1.0, 0.1}, {1.0, 1.02, 0.1}}, &result),
            ErrorCode::NoFit);
}

TEST(FewestPieces, PointsCoincideWhenTheTightestLiesWithinEveryTolerance) {
  EXPECT_TRUE(DoPointsCoincide({}));
  EXPECT_TRUE(DoPointsCoincide({{1.0, 1.0, 0.1}, {1.05, 1.0, 0.1}, {1.0, 1.02, 0.1}}));
  EXPECT_TRUE(DoPointsCoincide({{0.0, 0.0, 5.0}, {3.0, 4.0, 0.1}}));
  EXPECT_FALSE(DoPointsCoincide({{0.0, 0.0, 4.9}, {3.0, 4.0, 0.1}}));
  EXPECT_FALSE(DoPointsCoincide({{0.0, 0.0, 0.1}, {0.0, 0.0, 0.1}, {1e300, 1e300, 0.1}}));
}

TEST(FewestPieces, ScalingByAPowerOfTwoScalesTheBits) {
  FewestPieces::Result one;
  FewestPieces::Result other;
  std::vector<WPoint> points = LineArcLine();
  ASSERT_EQ(FitPlain(points, &one), ErrorCode::Ok);
  for (WPoint& p : points) p = {p.x * 1024.0, p.y * 1024.0, p.w * 1024.0};
  ASSERT_EQ(FitPlain(points, &other), ErrorCode::Ok);
  ASSERT_EQ(one.contour.size(), other.contour.size());
  for (std::size_t i = 0; i < one.contour.size(); ++i) {
    EXPECT_EQ(one.contour[i].end.x * 1024.0, other.contour[i].end.x);
    EXPECT_EQ(one.contour[i].radius * 1024.0, other.contour[i].radius);
  }
}

TEST(FewestPieces, CentringBringsBackTheLinesAndLowersTheDeviation) {
  FewestPieces::Options options;
  options.centre = false;
  FewestPieces::Result plain;
  FewestPieces::Result centred;
  ASSERT_EQ(FewestPieces::Fit(LineArcLine(), options, &plain, nullptr, 100), ErrorCode::Ok);
  ASSERT_EQ(FitPlain(LineArcLine(), &centred), ErrorCode::Ok);
  ASSERT_EQ(centred.ranges.size(), 3u);
  EXPECT_EQ(centred.contour[1].type, GeometryUtils::ElemType::Segment);
  EXPECT_EQ(centred.contour[2].type, GeometryUtils::ElemType::Arc);
  EXPECT_EQ(centred.contour[3].type, GeometryUtils::ElemType::Segment);
  EXPECT_NEAR(centred.contour[2].radius, 8.0, 0.2);
  EXPECT_LT(centred.largestDeviation, plain.largestDeviation);
}

TEST(FewestPieces, LimitsOfTheRadiusHold) {
  std::vector<FewestPieces::Options> options(3);
  options[0].smallestRadius = 9.0;
  options[1].largestRadius = 5.0;
  options[2].segmentsOnly = true;
  for (FewestPieces::Options const& limits : options) {
    FewestPieces::Result result;
    ASSERT_EQ(FewestPieces::Fit(LineArcLine(), limits, &result, nullptr, 100), ErrorCode::Ok);
    EXPECT_GE(result.ranges.size(), 4u);
    EXPECT_LE(result.largestDeviation, 1.0);
    for (GeometryUtils::Elem const& elem : result.contour) {
      if (elem.type == GeometryUtils::ElemType::Segment) continue;
      EXPECT_FALSE(limits.segmentsOnly);
      EXPECT_GE(elem.radius, limits.smallestRadius * (1.0 - 1e-9));
      EXPECT_LE(elem.radius, limits.largestRadius * (1.0 + 1e-9));
    }
  }
}

TEST(FewestPieces, AHarderLookGivesNoMorePieces) {
  Testing::RandomGeometry random(31);
  for (int trial = 0; trial < 10; ++trial) {
    std::vector<WPoint> const points = Testing::MakeProfile(&random, 60);
    std::size_t before = points.size();
    for (auto effort : {FewestPieces::Effort::Quick, FewestPieces::Effort::Wide}) {
      FewestPieces::Options options;
      options.effort = effort;
      options.centre = false;
      FewestPieces::Result result;
      ErrorCode const code = FewestPieces::Fit(points, options, &result, nullptr, 100);
      if (code != ErrorCode::Ok) continue;
      EXPECT_LE(result.ranges.size(), before) << "trial " << trial;
      before = result.ranges.size();
    }
  }
}

FewestPieces::Result FitClosed(std::vector<WPoint> const& points) {
  FewestPieces::Options options;
  options.closed = true;
  FewestPieces::Result result;
  EXPECT_EQ(FewestPieces::Fit(points, options, &result, nullptr, 100), ErrorCode::Ok);
  return result;
}

/// The outline of a square of side 10, beginning in the middle of a side.
std::vector<WPoint> Square() {
  std::vector<WPoint> points;
  for (int i = 0; i < 40; ++i) {
    double const s = 0.5 + 5.0 + i;
    double const along = std::fmod(s, 10.0);
    int const side = static_cast<int>(s / 10.0) % 4;
    if (side == 0) points.push_back({along, 0.0, 0.01});
    if (side == 1) points.push_back({10.0, along, 0.01});
    if (side == 2) points.push_back({10.0 - along, 10.0, 0.01});
    if (side == 3) points.push_back({0.0, 10.0 - along, 0.01});
  }
  return points;
}

TEST(FewestPieces, AClosedSquareHasFourSidesWhereverTheInputBegins) {
  std::vector<WPoint> points = Square();
  for (int turn = 0; turn < 40; turn += 7) {
    FewestPieces::Result const result = FitClosed(points);
    ASSERT_EQ(result.ranges.size(), 4u) << "beginning " << turn;
    EXPECT_EQ(result.contour.front().end.x, result.contour.back().end.x);
    EXPECT_EQ(result.contour.front().end.y, result.contour.back().end.y);
    EXPECT_LE(result.fewestPossible, 4);
    std::rotate(points.begin(), points.begin() + 7, points.end());
  }
}

TEST(FewestPieces, AClosedCircleComesAsTwoArcs) {
  FewestPieces::Result const result =
      FitClosed(MakeArcPoints({3.0, 4.0}, 10.0, 0.3, 2.0 * std::acos(-1.0), 61, 0.01));
  ASSERT_EQ(result.ranges.size(), 2u);
  for (std::size_t k = 1; k < 3; ++k) {
    EXPECT_EQ(result.contour[k].type, GeometryUtils::ElemType::Arc);
    EXPECT_NEAR(result.contour[k].radius, 10.0, 0.01);
  }
}

TEST(FewestPieces, AScanDenserThanItsToleranceKeepsItsPieces) {
  Testing::RandomGeometry random(21);
  std::vector<WPoint> points;
  for (int i = 0; i < 4000; ++i) {
    double const s = 0.001 * i;
    double const x = s < 2.0 ? s : 2.0 + (s - 2.0) * std::cos(1.0);
    double const y = s < 2.0 ? 0.0 : (s - 2.0) * std::sin(1.0);
    points.push_back({x + random.Uniform(-0.005, 0.005), y + random.Uniform(-0.005, 0.005), 0.01});
  }
  FewestPieces::Result result;
  ASSERT_EQ(FitPlain(points, &result), ErrorCode::Ok);
  EXPECT_EQ(result.ranges.size(), 2u);
  EXPECT_EQ(result.fewestPossible, 2);
}

class Listener : public ExecutionState {
 public:
  void SetProgress(std::int32_t percent) override {
    told.push_back(percent);
    if (told.size() == throwAfter) throw std::runtime_error("stop");
  }
  std::vector<std::int32_t> told;
  std::size_t throwAfter = 0;
};

TEST(FewestPieces, ProgressRisesToTheMaximum) {
  Listener listener;
  FewestPieces::Result result;
  ASSERT_EQ(FewestPieces::Fit(LineArcLine(), FewestPieces::Options(), &result, &listener, 80),
            ErrorCode::Ok);
  ASSERT_FALSE(listener.told.empty());
  EXPECT_GE(listener.told.front(), 1);
  EXPECT_EQ(listener.told.back(), 80);
  for (std::size_t i = 1; i < listener.told.size(); ++i) {
    EXPECT_GT(listener.told[i], listener.told[i - 1]);
  }
}

TEST(FewestPieces, AListenerThatThrowsEndsTheCallAndLeavesTheResult) {
  Listener listener;
  listener.throwAfter = 2;
  FewestPieces::Result result;
  EXPECT_THROW(FewestPieces::Fit(LineArcLine(), FewestPieces::Options(), &result, &listener, 100),
               std::runtime_error);
  EXPECT_TRUE(result.contour.empty());
}

}  // namespace
}  // namespace Vorn
