#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <numbers>
#include <vector>

#include "geometry/fewest/promises/Promises.h"
#include "gtest/gtest.h"
#include "support/ContourBuilder.h"
#include "support/Profiles.h"
#include "support/RandomGeometry.h"

// Contours that keep every promise but one, with coordinates for which the border is exact.

namespace Vorn::Testing {
namespace {

using Promises::Chain;
using Promises::kNone;
using Promises::Measure;
using Promises::PieceRange;
using Promises::Promise;
using Promises::Report;
using Promises::Violation;
using Elem = GeometryUtils::Elem;
using Point = GeometryUtils::Point;

constexpr double kPi = std::numbers::pi;

struct Case {
  std::vector<WPoint> points;
  std::vector<Elem> contour;
  std::vector<PieceRange> ranges;
  bool isClosed = false;
  double largestStep = std::numeric_limits<double>::infinity();
  double farthest = std::numeric_limits<double>::infinity();
};

Report MeasureCase(Case const& c) {
  return Measure({c.points, c.contour, c.ranges, c.isClosed, c.largestStep, c.farthest});
}

std::vector<Promise> BrokenIn(Case const& c) {
  std::vector<Promise> broken;
  for (Violation const& violation : MeasureCase(c).violations) broken.push_back(violation.promise);
  return broken;
}

std::vector<Promise> Only(Promise promise) { return {promise}; }

/// Points with the tolerance w.
std::vector<WPoint> Points(std::vector<Point> const& points, double w) {
  std::vector<WPoint> weighted;
  for (Point const& p : points) weighted.push_back({p.x, p.y, w});
  return weighted;
}

std::vector<PieceRange> RangesUpTo(std::vector<std::int32_t> const& lasts) {
  std::vector<PieceRange> ranges;
  std::int32_t first = 0;
  for (std::int32_t const last : lasts) {
    ranges.push_back({first, last});
    first = last + 1;
  }
  return ranges;
}

Case Straight(std::vector<Point> const& points, double w, Point const& end) {
  auto const last = static_cast<std::int32_t>(points.size()) - 1;
  return {Points(points, w), ContourBuilder(0, 0).To(end.x, end.y).Build(), RangesUpTo({last})};
}

// --- Well formed ---------------------------------------------------------------------------------

Case TwoSides() {
  return {Points({{0, 0}, {2, 0}, {4, 0}, {4, 2}, {4, 4}}, 0.5),
          ContourBuilder(0, 0).To(4, 0).To(4, 4).Build(), RangesUpTo({2, 4})};
}

TEST(MeasurePromises, FindsNothingOnAContourThroughItsPoints) {
  Report const report = MeasureCase(TwoSides());
  EXPECT_TRUE(report.violations.empty());
  EXPECT_EQ(report.largestRatio, 0.0);
  EXPECT_EQ(report.largestIndex, 0U);
}

TEST(MeasurePromises, RangesHoldEveryPointOnceInOrder) {
  Case c = TwoSides();
  for (auto const& ranges : std::vector<std::vector<PieceRange>>{{{0, 2}},
                                                                 {{0, 1}, {3, 4}},
                                                                 {{0, 2}, {2, 4}},
                                                                 {{1, 2}, {3, 4}},
                                                                 {{0, 2}, {3, 3}},
                                                                 {{0, 2}, {3, 5}},
                                                                 {{0, 2}, {4, 3}},
                                                                 {{-1, 2}, {3, 4}},
                                                                 {{3, 4}, {0, 2}},
                                                                 {{0, 2}, {3, 4}, {5, 5}}}) {
    c.ranges = ranges;
    EXPECT_EQ(BrokenIn(c), Only(Promise::WellFormed));
  }
}

TEST(MeasurePromises, RangesOfAClosedContourStartAnywhere) {
  Case c{Points({{4, 0}, {4, 4}, {0, 4}, {0, 0}, {2, 0}}, 0.5),
         ContourBuilder(0, 0).To(4, 0).To(4, 4).To(0, 4).To(0, 0).Build(),
         {{3, 4}, {0, 0}, {1, 1}, {2, 2}},
         true};
  EXPECT_TRUE(BrokenIn(c).empty());
  c.ranges = {{3, 0}, {1, 1}, {2, 2}, {2, 2}};
  EXPECT_EQ(BrokenIn(c), Only(Promise::WellFormed));
  c.ranges = {{3, 0}, {1, 1}, {2, 2}, {3, 3}};
  EXPECT_EQ(BrokenIn(c), Only(Promise::WellFormed));
}

TEST(MeasurePromises, ElementsAreFiniteAndOfAKnownType) {
  double const nan = std::numeric_limits<double>::quiet_NaN();
  Case c = TwoSides();
  auto const isMalformed = [&c](auto const& change) {
    Case changed = c;
    change(&changed.contour);
    return BrokenIn(changed) == Only(Promise::WellFormed);
  };
  EXPECT_TRUE(isMalformed([](auto* contour) { contour->pop_back(); }));
  EXPECT_TRUE(isMalformed([](auto* contour) { contour->clear(); }));
  EXPECT_TRUE(isMalformed([nan](auto* contour) { contour->back().end.x = nan; }));
  EXPECT_TRUE(isMalformed(
      [](auto* contour) { contour->back().type = static_cast<GeometryUtils::ElemType>(2); }));
  EXPECT_TRUE(
      isMalformed([](auto* contour) { contour->front().type = GeometryUtils::ElemType::Arc; }));
  c.contour = ContourBuilder(0, 0).To(4, 0).Around({4, 2}, 4, 4, 1).Build();
  c.points = Points({{0, 0}, {2, 0}, {4, 0}, {6, 2}, {4, 4}}, 0.5);
  EXPECT_TRUE(BrokenIn(c).empty());
  EXPECT_TRUE(isMalformed([](auto* contour) { contour->back().radius = 0.0; }));
  EXPECT_TRUE(isMalformed([](auto* contour) { contour->back().radius = -2.0; }));
  EXPECT_TRUE(isMalformed([](auto* contour) { contour->back().direction = 0.0; }));
  EXPECT_TRUE(isMalformed([nan](auto* contour) { contour->back().startAngle = nan; }));
  EXPECT_TRUE(isMalformed([nan](auto* contour) { contour->back().center.y = nan; }));
}

TEST(MeasurePromises, NoPointsIsMalformed) {
  EXPECT_EQ(BrokenIn({{}, ContourBuilder(0, 0).To(1, 0).Build(), {{0, 0}}}),
            Only(Promise::WellFormed));
}

// --- Within tolerance ----------------------------------------------------------------------------

TEST(MeasurePromises, APointAtItsToleranceFromASegmentIsWithin) {
  // A slope of 3 to 4: distances are exact fifths, and 0.5 is one of the points' tolerances.
  Case c = Straight({{0, 0}, {4 - 0.3, 3 + 0.4}, {8, 6}}, 0.5, {8, 6});
  c.points[1] = {3.625, 3.34375, 0.5};
  // cross = 8 * 3.34375 - 6 * 3.625 = 5 = 0.5 * 10
  EXPECT_TRUE(BrokenIn(c).empty());
  EXPECT_EQ(MeasureCase(c).largestRatio, 1.0);
  EXPECT_EQ(MeasureCase(c).largestIndex, 1U);
  c.points[1].y = std::nextafter(3.34375, 4.0);
  EXPECT_EQ(BrokenIn(c), Only(Promise::WithinTolerance));
}

TEST(MeasurePromises, APointAtItsToleranceFromAnArcIsWithin) {
  // (3, 4) directions about the centre (0, 0): |(6, 8)| = 10, |(7.5, 10)| = 12.5.
  auto const contour = ContourBuilder(10, 0).Around({0, 0}, 0, 10, 1).Build();
  Case c{{{10, 0, 0.1}, {7.5, 10, 2.5}, {0, 10, 0.1}}, contour, RangesUpTo({2})};
  EXPECT_TRUE(BrokenIn(c).empty());
  EXPECT_EQ(MeasureCase(c).largestRatio, 1.0);
  c.points[1].w = std::nextafter(2.5, 0.0);
  EXPECT_EQ(BrokenIn(c), Only(Promise::WithinTolerance));
  c.points[1] = {4.5, 6, 2.5};
  EXPECT_TRUE(BrokenIn(c).empty());
  c.points[1].x = std::nextafter(4.5, 0.0);
  EXPECT_EQ(BrokenIn(c), Only(Promise::WithinTolerance));
}

TEST(MeasurePromises, APointBeyondTheEndIsMeasuredToTheEnd) {
  Case c = Straight({{-3, 4}, {2, 0}, {11, 0}}, 5.0, {8, 0});
  c.points[2].w = 3.0;
  EXPECT_TRUE(BrokenIn(c).empty());
  EXPECT_EQ(MeasureCase(c).largestRatio, 1.0);
  c.points[0].w = std::nextafter(5.0, 0.0);
  EXPECT_EQ(BrokenIn(c), Only(Promise::WithinTolerance));
  c.points[0].w = 5.0;
  c.points[2].w = std::nextafter(3.0, 0.0);
  EXPECT_EQ(BrokenIn(c), Only(Promise::WithinTolerance));
}

TEST(MeasurePromises, APointInTheGapOfAnArcIsMeasuredToItsNearerEnd) {
  auto const contour = ContourBuilder(5, 0).Around({0, 0}, 0, -5, 1).Build();
  Case c{{{5, 0, 0.1}, {0, 5, 0.1}, {-5, 0, 0.1}, {0, -5, 0.1}}, contour, RangesUpTo({3})};
  EXPECT_TRUE(BrokenIn(c).empty());
  c.points[0] = {5, -3, 3.0};  // on the side of the start: 3 away
  c.points[3] = {3, -5, 3.0};  // on the side of the end
  EXPECT_TRUE(BrokenIn(c).empty());
  c.points[3].w = 2.9375;
  Report const report = MeasureCase(c);
  ASSERT_EQ(report.violations.size(), 1U);
  EXPECT_EQ(report.violations[0].promise, Promise::WithinTolerance);
  EXPECT_EQ(report.violations[0].piece, 0U);
  EXPECT_EQ(report.violations[0].index, 3U);
  EXPECT_EQ(report.violations[0].at.x, 3.0);
  EXPECT_EQ(report.violations[0].amount, 3.0 / 2.9375);
  EXPECT_EQ(report.largestRatio, 3.0 / 2.9375);
  EXPECT_EQ(report.largestIndex, 3U);
}

TEST(MeasurePromises, APieceReportsItsWorstPointOnly) {
  Case c = Straight({{0, 0}, {2, 1}, {4, 2}, {6, 1}, {8, 0}}, 0.5, {8, 0});
  Report const report = MeasureCase(c);
  ASSERT_EQ(report.violations.size(), 1U);
  EXPECT_EQ(report.violations[0].index, 2U);
  EXPECT_EQ(report.violations[0].amount, 4.0);
}

TEST(MeasurePromises, ASegmentOfNoLengthIsAPoint) {
  Case c = Straight({{0, 3}, {4, 0}, {0, -5}}, 5.0, {0, 0});
  EXPECT_TRUE(BrokenIn(c).empty());
  EXPECT_EQ(MeasureCase(c).largestRatio, 1.0);
}

TEST(MeasurePromises, AFlatArcLosesNothingToItsFarCentre) {
  // Radius 1e9, points within 1e-3 of the x axis near the origin: the sagitta at 10 is 5e-8.
  double const r = 1e9;
  Point const centre{0, r};
  Case c{{{0, 0, 1e-9}, {10, 1e-9, 5e-8}, {20, 2e-7, 1e-9}}, {}, RangesUpTo({2})};
  c.contour = ContourBuilder(0, 0).Around(centre, 20, 2e-7, 1).Build();
  Report const report = MeasureCase(c);
  // 4.9e-8 of 5e-8; through the centre the distance would be a multiple of 1.2e-7.
  EXPECT_NEAR(report.largestRatio, 0.98, 1e-6);
  EXPECT_EQ(report.largestIndex, 1U);
}

// --- Order ---------------------------------------------------------------------------------------

TEST(MeasurePromises, AStepBackWithinTheNoiseIsInOrder) {
  // 1.65 * (1 + 1) = 3.3
  Case c = Straight({{0, 0}, {9, 0}, {5.75, 0}, {16, 0}}, 1.0, {16, 0});
  EXPECT_TRUE(BrokenIn(c).empty());
  c.points[2].x = 5.5;
  Report const report = MeasureCase(c);
  ASSERT_EQ(report.violations.size(), 1U);
  EXPECT_EQ(report.violations[0].promise, Promise::InOrder);
  EXPECT_EQ(report.violations[0].index, 2U);
  EXPECT_NEAR(report.violations[0].amount, 0.2, 1e-12);
}

TEST(MeasurePromises, OrderHoldsBetweenAllEarlierPoints) {
  // Each step back is small, the sum is not.
  Case c = Straight({{0, 0}, {12, 0}, {10, 0}, {8, 0}, {16, 0}}, 1.0, {16, 0});
  EXPECT_EQ(BrokenIn(c), Only(Promise::InOrder));
  // A wide tolerance in front does not excuse what a narrow one farther back shows.
  c.points = {{0, 0, 1}, {12, 0, 0.5}, {12, 0, 100}, {8, 0, 0.5}, {16, 0, 1}};
  EXPECT_EQ(BrokenIn(c), Only(Promise::InOrder));
  c.points[3].w = 2.0;
  EXPECT_TRUE(BrokenIn(c).empty());
}

TEST(MeasurePromises, OrderAlongAnArcIsAlongItsLength) {
  auto const contour = ContourBuilder(5, 0).Around({0, 0}, -5, 0, 1).Build();
  Case c{Points({{5, 0}, {0, 5}, {4, 3}, {-5, 0}}, 1.0), contour, RangesUpTo({3})};
  // From (0, 5) back to (4, 3): 5 * atan(4 / 3) = 4.64 > 3.3.
  Report const report = MeasureCase(c);
  ASSERT_EQ(report.violations.size(), 1U);
  EXPECT_EQ(report.violations[0].promise, Promise::InOrder);
  EXPECT_NEAR(report.violations[0].amount, 5 * std::atan2(4.0, 3.0) - 3.3, 1e-12);
  c.points[2] = {3, 4, 1.0};  // 5 * atan(3 / 4) = 3.22
  EXPECT_TRUE(BrokenIn(c).empty());
}

TEST(MeasurePromises, APointInTheGapOfAnAlmostFullCircleIsWhereThePathIs) {
  // The last point repeats the first, which is nearer to the start of the arc.
  Point const end{std::sqrt(25 - 1e-4), -0.01};
  Case c{Points({{5, 0.001}, {0, 5}, {-5, 0}, {0, -5}, {5, 0.001}}, 0.0125),
         ContourBuilder(5, 0).Around({0, 0}, end.x, end.y, 1).Build(), RangesUpTo({4})};
  c.largestStep = 2.0;
  EXPECT_TRUE(BrokenIn(c).empty());
  c.points.push_back({0, 5, 0.0125});
  c.ranges = RangesUpTo({5});
  EXPECT_EQ(BrokenIn(c), (std::vector<Promise>{Promise::InOrder, Promise::SmallSteps}));
}

// --- Steps ---------------------------------------------------------------------------------------

TEST(MeasurePromises, NeighboursOnAnArcAreAtMostTheStepApart) {
  auto const contour = ContourBuilder(5, 0).Around({0, 0}, -5, 0, 1).Build();
  Case c{Points({{5, 0}, {0, 5}, {-5, 0}}, 0.5), contour, RangesUpTo({2})};
  c.largestStep = 0.5 * kPi;
  EXPECT_TRUE(BrokenIn(c).empty());
  c.largestStep = 0.49 * kPi;
  Report const report = MeasureCase(c);
  ASSERT_EQ(report.violations.size(), 1U);
  EXPECT_EQ(report.violations[0].promise, Promise::SmallSteps);
  EXPECT_NEAR(report.violations[0].amount, 0.5 * kPi, 1e-15);
}

TEST(MeasurePromises, JointsCountAsNeighbours) {
  auto const contour = ContourBuilder(5, 0).Around({0, 0}, -5, 0, 1).Build();
  Case c{Points({{0, 5}, {-3, 4}, {-5, 0}}, 0.5), contour, RangesUpTo({2})};
  c.largestStep = 0.4 * kPi;
  EXPECT_EQ(BrokenIn(c), Only(Promise::SmallSteps));
  c.points = Points({{5, 0}, {3, 4}, {0, 5}}, 0.5);
  EXPECT_EQ(BrokenIn(c), Only(Promise::SmallSteps));
}

TEST(MeasurePromises, PointsWithinTheirTolerancesAreNoStep) {
  auto const contour = ContourBuilder(1, 0).Around({0, 0}, 0, 1, 1).Build();
  Case c{Points({{1, 0}, {0, 1}}, 0.75), contour, RangesUpTo({1})};
  c.largestStep = 1.0;
  EXPECT_TRUE(BrokenIn(c).empty());
  c.points = Points({{1, 0}, {0, 1}}, 0.6875);  // 1.375 < sqrt(2)
  EXPECT_EQ(BrokenIn(c), Only(Promise::SmallSteps));
}

TEST(MeasurePromises, AnArcStaysNearTheStraightPathWhereAsked) {
  auto const contour = ContourBuilder(5, 0).Around({0, 0}, -5, 0, 1).Build();
  Case c{Points({{5, 0}, {3, 4}, {-3, 4}, {-5, 0}}, 0.25), contour, RangesUpTo({3})};
  c.farthest = 0.75;  // (0, 5) is 1 above the path from (3, 4) to (-3, 4)
  EXPECT_TRUE(BrokenIn(c).empty());
  c.farthest = 0.6875;
  Report const report = MeasureCase(c);
  ASSERT_EQ(report.violations.size(), 1U);
  EXPECT_EQ(report.violations[0].promise, Promise::NearPath);
  EXPECT_NEAR(report.violations[0].amount, 1.0, 1e-15);
}

// --- Joints, closing, full turns -----------------------------------------------------------------

Case HalfCircle() {
  return {Points({{5, 0}, {0, 5}, {-5, 0}}, 0.5),
          ContourBuilder(5, 0).Around({0, 0}, -5, 0, 1).Build(), RangesUpTo({2})};
}

TEST(MeasurePromises, ArcsAgreeWithTheirJoints) {
  EXPECT_TRUE(BrokenIn(HalfCircle()).empty());
  auto const isApart = [](auto const& change) {
    Case c = HalfCircle();
    change(&c.contour.back());
    auto const broken = BrokenIn(c);
    return !broken.empty() && std::all_of(broken.begin(), broken.end(),
                                          [](Promise p) { return p == Promise::Joined; });
  };
  EXPECT_TRUE(isApart([](Elem* arc) { arc->radius += 1e-9; }));
  EXPECT_TRUE(isApart([](Elem* arc) { arc->center.x += 1e-9; }));
  EXPECT_TRUE(isApart([](Elem* arc) { arc->startAngle += 1e-9; }));
  EXPECT_TRUE(isApart([](Elem* arc) { arc->endAngle -= 1e-9; }));
  EXPECT_FALSE(isApart([](Elem* arc) { arc->endAngle = -arc->endAngle; }));
}

TEST(MeasurePromises, AClosedContourEndsExactlyWhereItBegins) {
  Case c{Points({{0, 0}, {4, 0}, {4, 4}}, 0.5),
         ContourBuilder(0, 0).To(4, 0).To(4, 4).To(0, 0).Build(), RangesUpTo({0, 1, 2}), true};
  EXPECT_TRUE(BrokenIn(c).empty());
  c.contour.back().end.x = 0x1p-60;
  Report const report = MeasureCase(c);
  ASSERT_EQ(report.violations.size(), 1U);
  EXPECT_EQ(report.violations[0].promise, Promise::Closed);
  EXPECT_EQ(report.violations[0].amount, 0x1p-60);
}

TEST(MeasurePromises, WhatIsMissingToCloseIsALengthAtAnyScale) {
  for (double const factor : {1.0, 0x1p-900, 0x1p900}) {
    Case c{Points({{0, 0}, {4, 0}, {4, 4}}, 0.5),
           ContourBuilder(0, 2).To(4, 0).To(4, 4).To(0.375, 1.5).Build(), RangesUpTo({0, 1, 2}),
           true};
    for (WPoint& p : c.points) p = {p.x * factor, p.y * factor, p.w * factor};
    for (Elem& elem : c.contour) elem.end = Scale(elem.end, factor);
    Report const report = MeasureCase(c);
    auto const closed =
        std::find_if(report.violations.begin(), report.violations.end(),
                     [](Violation const& v) { return v.promise == Promise::Closed; });
    ASSERT_NE(closed, report.violations.end());
    EXPECT_EQ(closed->amount, 0.625 * factor);
  }
}

TEST(MeasurePromises, AnArcOfEqualAnglesIsAFullTurn) {
  Case c = HalfCircle();
  c.contour = ContourBuilder(5, 0).Around({0, 0}, 5, 0, 1).Build();
  auto const broken = BrokenIn(c);
  EXPECT_TRUE(std::count(broken.begin(), broken.end(), Promise::BelowFullTurn) == 1);
}

TEST(MeasurePromises, AnArcThatComesBackWithinRoundingIsAFullTurn) {
  Case c = HalfCircle();
  c.points = Points({{5, 0}, {0, 5}, {-5, 0}, {0, -5}}, 0.5);
  c.ranges = RangesUpTo({3});
  c.contour = ContourBuilder(5, 0).Around({0, 0}, 5, -1e-16, 1).Build();
  EXPECT_EQ(BrokenIn(c), Only(Promise::BelowFullTurn));
  c.contour = ContourBuilder(5, 0).Around({0, 0}, std::sqrt(25 - 1e-4), -0.01, 1).Build();
  EXPECT_TRUE(BrokenIn(c).empty());
}

TEST(MeasurePromises, AFullCircleComesAsTwoArcs) {
  Case c{Points({{5, 0}, {0, 5}, {-5, 0}, {0, -5}}, 0.5),
         ContourBuilder(5, 0).Around({0, 0}, -5, 0, 1).Around({0, 0}, 5, 0, 1).Build(),
         RangesUpTo({1, 3}), true};
  EXPECT_TRUE(BrokenIn(c).empty());
}

// --- Scale ---------------------------------------------------------------------------------------

TEST(MeasurePromises, ScalesByPowersOfTwo) {
  Case c{Points({{0, 0}, {3, 4.5}, {8, 0}, {8, -8}}, 0.5),
         ContourBuilder(0, 0).To(8, 0).To(8, -8).Build(), RangesUpTo({2, 3})};
  for (double const factor : {1.0, 0x1p-900, 0x1p-300, 0x1p300, 0x1p900}) {
    Case scaled = c;
    for (WPoint& p : scaled.points) p = {p.x * factor, p.y * factor, p.w * factor};
    for (Elem& elem : scaled.contour) elem.end = Scale(elem.end, factor);
    Report const report = MeasureCase(scaled);
    ASSERT_EQ(report.violations.size(), 1U);
    EXPECT_EQ(report.violations[0].promise, Promise::WithinTolerance);
    EXPECT_EQ(report.violations[0].amount, 9.0);
    EXPECT_EQ(report.violations[0].at.x, 3.0 * factor);
    EXPECT_EQ(report.largestRatio, 9.0);
  }
}

}  // namespace
}  // namespace Vorn::Testing
