#include <array>
#include <cmath>
#include <cstdint>
#include <limits>
#include <numbers>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "support/ReferencePrimitives.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;

constexpr double kEpsilon = 2.220446049250313e-16;
constexpr double kSplitPi = 3.1415926535897905;
constexpr double kHalfPi = std::numbers::pi / 2;

struct ArcData {
  Point center;
  double r = 1.0;
  double d = 1.0;
  double start = 0.0;
  double end = 0.0;
};

/// Counter-clockwise, all but a sliver at the given angle.
ArcData NearlyFull(Point const& center, double r, double gapAngle) {
  return {center, r, 1.0, gapAngle, Down(gapAngle)};
}

struct Hits {
  int count = kIntSentinel;
  Point a = kPointSentinel;
  Point b = kPointSentinel;
};

Hits SegmentHits(Point const& p, Point const& q, ArcData const& arc) {
  Hits hits;
  hits.count = GeometryUtils::GetLineSegmentAndCircleArcIntersection(
      p.x, p.y, q.x, q.y, arc.center.x, arc.center.y, arc.r, arc.d, arc.start, arc.end, &hits.a.x,
      &hits.a.y, &hits.b.x, &hits.b.y);
  return hits;
}

Hits ArcHits(ArcData const& first, ArcData const& second) {
  Hits hits;
  hits.count = GeometryUtils::GetCircleArcAndCircleArcIntersection(
      first.center.x, first.center.y, first.r, first.d, first.start, first.end, second.center.x,
      second.center.y, second.r, second.d, second.start, second.end, &hits.a.x, &hits.a.y,
      &hits.b.x, &hits.b.y);
  return hits;
}

void ExpectCountOnly(Hits const& hits, int count) {
  EXPECT_EQ(hits.count, count);
  EXPECT_SAME_POINT(hits.a, kPointSentinel);
  EXPECT_SAME_POINT(hits.b, kPointSentinel);
}

void ExpectOne(Hits const& hits, Point const& a) {
  EXPECT_EQ(hits.count, 1);
  EXPECT_EQ(hits.a.x, a.x);
  EXPECT_EQ(hits.a.y, a.y);
  EXPECT_SAME_POINT(hits.b, kPointSentinel);
}

void ExpectTwo(Hits const& hits, Point const& a, Point const& b) {
  EXPECT_EQ(hits.count, 2);
  EXPECT_EQ(hits.a.x, a.x);
  EXPECT_EQ(hits.a.y, a.y);
  EXPECT_EQ(hits.b.x, b.x);
  EXPECT_EQ(hits.b.y, b.y);
}

void ExpectPoints(Hits const& hits, std::vector<Point> const& expected) {
  ASSERT_EQ(hits.count, static_cast<int>(expected.size()));
  ASSERT_TRUE(SameBits(hits.a, !expected.empty() ? expected[0] : kPointSentinel));
  ASSERT_TRUE(SameBits(hits.b, expected.size() > 1 ? expected[1] : kPointSentinel));
}

/// Whether a point's polar angle lies strictly within the arc's range, seam included.
bool InRange(ArcData const& arc, Point const& p) {
  double const angle = std::atan2(p.y - arc.center.y, p.x - arc.center.x);
  double const lo = arc.d > 0.0 ? arc.start : arc.end;
  double const hi = arc.d > 0.0 ? arc.end : arc.start;
  if (hi > lo) return lo < angle && angle < hi;
  bool const beforeSeam = lo < angle && angle < kSplitPi;
  bool const afterSeam = -kSplitPi < angle && angle < hi;
  return beforeSeam || afterSeam;
}

// --- GetLineSegmentAndCircleArcIntersection -----------------------------------------------------

TEST(GetLineSegmentAndCircleArcIntersection, EqualAnglesAreInvalid) {
  ExpectCountOnly(SegmentHits({-2, 0.5}, {2, 0.5}, {{0, 0}, 1, 1, 1.5, 1.5}), -1);
  ExpectCountOnly(SegmentHits({-2, 0.5}, {2, 0.5}, {{0, 0}, 1, -1, 1.5, 1.5}), -1);
  ExpectCountOnly(SegmentHits({-2, 0.5}, {2, 0.5}, {{0, 0}, 1, 1, 0.0, -0.0}), -1);
  ExpectCountOnly(SegmentHits({9, 9}, {9, 9}, {{0, 0}, -1, 1, 2, 2}), -1);
}

TEST(GetLineSegmentAndCircleArcIntersection, AnEndOfTheArcDoesNotCount) {
  ExpectCountOnly(SegmentHits({0, 0}, {2, 0}, {{0, 0}, 1, 1, 0, kHalfPi}), 0);
  ExpectCountOnly(SegmentHits({0, 0}, {0, 2}, {{0, 0}, 1, 1, 0, kHalfPi}), 0);
  ExpectOne(SegmentHits({0, 0}, {2, 0}, {{0, 0}, 1, 1, Down(0.0), kHalfPi}), {1, 0});
  ExpectOne(SegmentHits({0, 0}, {0, 2}, {{0, 0}, 1, 1, 0, Up(kHalfPi)}), {0, 1});
}

TEST(GetLineSegmentAndCircleArcIntersection, BothHitsOnTheArcKeepTheOrderOfTheCircleForm) {
  ArcData const arc = NearlyFull({0, 0}, 1, 1.0);
  ExpectTwo(SegmentHits({0, -2}, {0, 2}, arc), {0, 1}, {0, -1});
  ExpectTwo(SegmentHits({0, 2}, {0, -2}, arc), {0, -1}, {0, 1});
}

TEST(GetLineSegmentAndCircleArcIntersection, TheSecondHitMovesUpWhenTheFirstIsOffTheArc) {
  // The upper half only, counter-clockwise; the lower hit comes first along this segment.
  ArcData const upper{{0, 0}, 1, 1, 0, 3.0};
  ExpectOne(SegmentHits({0, 2}, {0, -2}, upper), {0, 1});
  ExpectOne(SegmentHits({0, -2}, {0, 2}, upper), {0, 1});
  ArcData const lower{{0, 0}, 1, -1, 0, -3.0};
  ExpectOne(SegmentHits({0, 2}, {0, -2}, lower), {0, -1});
  ExpectOne(SegmentHits({0, -2}, {0, 2}, lower), {0, -1});
}

TEST(GetLineSegmentAndCircleArcIntersection, TheDirectionChoosesBetweenARangeAndItsComplement) {
  Point const at0{1, 0};
  ArcData const clockwise{{0, 0}, 1, -1, 0.5, -0.5};
  ExpectOne(SegmentHits({0, 0}, {2, 0}, clockwise), at0);
  ExpectCountOnly(SegmentHits({0, 0}, {0, 2}, clockwise), 0);
  ArcData const counterClockwise{{0, 0}, 1, 1, 0.5, -0.5};
  ExpectCountOnly(SegmentHits({0, 0}, {2, 0}, counterClockwise), 0);
  ExpectOne(SegmentHits({0, 0}, {0, 2}, counterClockwise), {0, 1});
  ExpectOne(SegmentHits({0, 0}, {0, -2}, counterClockwise), {0, -1});
}

TEST(GetLineSegmentAndCircleArcIntersection, OnlyASignAboveZeroIsCounterClockwise) {
  double const tiny = std::numeric_limits<double>::denorm_min();
  EXPECT_EQ(SegmentHits({0, 0}, {2, 0}, {{0, 0}, 1, tiny, -0.5, 0.5}).count, 1);
  for (double const d : {0.0, -0.0, -tiny, kNaN}) {
    EXPECT_EQ(SegmentHits({0, 0}, {2, 0}, {{0, 0}, 1, d, 0.5, -0.5}).count, 1) << d;
    EXPECT_EQ(SegmentHits({0, 0}, {2, 0}, {{0, 0}, 1, d, -0.5, 0.5}).count, 0) << d;
  }
}

TEST(GetLineSegmentAndCircleArcIntersection, TheSeamItselfNeverCounts) {
  // The hit at (-1, 0) has the angle pi, or -pi when its y is a negative zero.
  ArcData const acrossTheSeam{{0, 0}, 1, 1, 2.0, -2.0};
  ExpectCountOnly(SegmentHits({0, 0}, {-2, 0}, acrossTheSeam), 0);
  ExpectCountOnly(SegmentHits({0, -0.0}, {-2, -0.0}, acrossTheSeam), 0);
  EXPECT_EQ(SegmentHits({0, 0x1p-40}, {-2, 0x1p-40}, acrossTheSeam).count, 1);
  EXPECT_EQ(SegmentHits({0, -0x1p-40}, {-2, -0x1p-40}, acrossTheSeam).count, 1);
}

TEST(GetLineSegmentAndCircleArcIntersection, AnglesBetweenTheSplitAndPiDoNotCountAcrossTheSeam) {
  // With x = -1, the angle of a small y is pi - y: 6 ulp of pi separate the split from pi.
  ArcData const acrossTheSeam{{0, 0}, 1, 1, 2.0, -2.0};
  int inside = 0;
  int outside = 0;
  for (int i = 1; i <= 40; ++i) {
    for (double const sign : {1.0, -1.0}) {
      double const y = sign * i * 1e-16;
      double const angle = std::atan2(y, -1.0);
      int const expected = std::fabs(angle) < kSplitPi ? 1 : 0;
      EXPECT_EQ(SegmentHits({0, y}, {-2, y}, acrossTheSeam).count, expected) << y;
      (expected == 1 ? inside : outside) += 1;
    }
  }
  EXPECT_GT(inside, 0);
  EXPECT_GT(outside, 0);
}

TEST(GetLineSegmentAndCircleArcIntersection, MissingTheCircleIsNoHit) {
  ArcData const arc = NearlyFull({0, 0}, 1, 1.0);
  ExpectCountOnly(SegmentHits({-2, 2}, {2, 2}, arc), 0);
  ExpectCountOnly(SegmentHits({0, 0}, {0.5, 0}, arc), 0);
  ExpectCountOnly(SegmentHits({1, 0}, {1, 0}, arc), 0);
}

TEST(GetLineSegmentAndCircleArcIntersection, TangentSegmentTouchesOnce) {
  ExpectOne(SegmentHits({-2, 1}, {2, 1}, NearlyFull({0, 0}, 1, 1.0)), {0, 1});
  ExpectCountOnly(SegmentHits({-2, 1}, {2, 1}, NearlyFull({0, 0}, 1, kHalfPi)), 0);
}

TEST(GetLineSegmentAndCircleArcIntersection, NotANumberAnglesBoundNothing) {
  ArcData const noAngles{{0, 0}, 1, 1, kNaN, kNaN};
  ExpectCountOnly(SegmentHits({0, 0}, {0, 2}, noAngles), 0);
  // Taken as a range across the seam, of which only the half with a good bound is left.
  ArcData const noEnd{{0, 0}, 1, 1, 0.0, kNaN};
  ExpectOne(SegmentHits({0, 0}, {0, 2}, noEnd), {0, 1});
  ExpectCountOnly(SegmentHits({0, 0}, {0, -2}, noEnd), 0);
}

TEST(GetLineSegmentAndCircleArcIntersection, NonFiniteInputIsNoHit) {
  for (double const bad : {kNaN, kInf, -kInf}) {
    for (std::size_t i = 0; i < 7; ++i) {
      std::array<double, 7> v{-2, 0.5, 2, 0.25, 0, 0, 1};
      v[i] = bad;
      SCOPED_TRACE(testing::Message() << bad << " at " << i);
      ExpectCountOnly(SegmentHits({v[0], v[1]}, {v[2], v[3]}, {{v[4], v[5]}, v[6], 1.0, -3.0, 3.0}),
                      0);
    }
  }
}

TEST(GetLineSegmentAndCircleArcIntersection, FiltersTheHitsOfTheCircleFormBitForBit) {
  constexpr std::uint64_t kSeed = 2211;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  std::array<int, 3> seen{};
  int filtered = 0;
  for (int i = 0; i < 20000; ++i) {
    Point const p = random.PointIn(-3, 3);
    Point const q = random.PointIn(-3, 3);
    ArcData const arc{random.PointIn(-1, 1), random.Uniform(0.1, 3.0), random.Flip() ? 1.0 : -1.0,
                      random.Uniform(-3.14, 3.14), random.Uniform(-3.14, 3.14)};
    Hits circle;
    circle.count = GeometryUtils::GetLineSegmentAndCircleIntersection(
        p.x, p.y, q.x, q.y, arc.center.x, arc.center.y, arc.r, &circle.a.x, &circle.a.y,
        &circle.b.x, &circle.b.y);
    std::vector<Point> expected;
    if (circle.count > 0 && InRange(arc, circle.a)) expected.push_back(circle.a);
    if (circle.count > 1 && InRange(arc, circle.b)) expected.push_back(circle.b);
    Hits const hits = SegmentHits(p, q, arc);
    ExpectPoints(hits, expected);
    if (HasFatalFailure()) return;
    ++seen[static_cast<std::size_t>(hits.count)];
    filtered += hits.count < circle.count ? 1 : 0;
    ArcData const reversed{arc.center, arc.r, -arc.d, arc.end, arc.start};
    ExpectPoints(SegmentHits(p, q, reversed), expected);
    if (HasFatalFailure()) return;
  }
  for (int const count : seen) EXPECT_GT(count, 500);
  EXPECT_GT(filtered, 1000);
}

// --- GetCircleArcAndCircleArcIntersection -------------------------------------------------------

TEST(GetCircleArcAndCircleArcIntersection, RadiusNotAboveZeroIsInvalid) {
  ArcData const good = NearlyFull({0, 0}, 1, 1.0);
  for (double const r : {0.0, -0.0, -1.0, -kInf, -std::numeric_limits<double>::denorm_min()}) {
    ArcData bad = good;
    bad.r = r;
    ExpectCountOnly(ArcHits(good, bad), -1);
    ExpectCountOnly(ArcHits(bad, good), -1);
  }
}

TEST(GetCircleArcAndCircleArcIntersection, UnitCirclesOneApartMeetAboveFirst) {
  ArcData const first = NearlyFull({0, 0}, 1, 2.0);
  ArcData const second = NearlyFull({1, 0}, 1, 0.5);
  double const h = std::sqrt(0.75);
  ExpectTwo(ArcHits(first, second), {0.5, h}, {0.5, -h});
  // From the other circle the first point lies to the left of the way back.
  ExpectTwo(ArcHits(second, first), {0.5, -h}, {0.5, h});
}

TEST(GetCircleArcAndCircleArcIntersection, TheBiggerCircleLeadsWhateverItsPlace) {
  ArcData const big = NearlyFull({0, 0}, 5, 2.5);
  ArcData const small = NearlyFull({5, 0}, 6.0 / 1.5, 0.25);
  Hits const forward = ArcHits(big, small);
  Hits const backward = ArcHits(small, big);
  ASSERT_EQ(forward.count, 2);
  ASSERT_EQ(backward.count, 2);
  EXPECT_SAME_POINT(forward.a, backward.a);
  EXPECT_SAME_POINT(forward.b, backward.b);
  EXPECT_GT(forward.a.y, 0.0);
  // q = (25 + 25 - 16) / 10.
  EXPECT_EQ(forward.a.x, 3.4);
}

TEST(GetCircleArcAndCircleArcIntersection, CirclesApartOrInsideEachOtherDoNotMeet) {
  ArcData const unit = NearlyFull({0, 0}, 1, 1.0);
  ExpectCountOnly(ArcHits(unit, NearlyFull({0, Up(2.0)}, 1, 1.0)), 0);
  ExpectCountOnly(ArcHits(unit, NearlyFull({5, 5}, 1, 1.0)), 0);
  ExpectCountOnly(ArcHits(unit, NearlyFull({0, 0.25}, 0.5, 1.0)), 0);
  ExpectCountOnly(ArcHits(NearlyFull({0, 0.25}, 0.5, 1.0), unit), 0);
  ExpectCountOnly(ArcHits(unit, NearlyFull({0, 0}, 0.5, 1.0)), 0);
}

TEST(GetCircleArcAndCircleArcIntersection, TouchingFromOutsideIsOnePoint) {
  ArcData const unit = NearlyFull({0, 0}, 1, 1.0);
  ExpectOne(ArcHits(unit, NearlyFull({0, 2}, 1, 1.0)), {0, 1});
  ExpectOne(ArcHits(unit, NearlyFull({0, 4}, 3, 1.0)), {0, 1});
  ExpectOne(ArcHits(NearlyFull({0, 4}, 3, 1.0), unit), {0, 1});
}

TEST(GetCircleArcAndCircleArcIntersection, TouchingFromInsideIsOnePoint) {
  ArcData const big = NearlyFull({0, 0}, 2, 1.0);
  ArcData const small = NearlyFull({0, 1}, 1, 1.0);
  ExpectOne(ArcHits(big, small), {0, 2});
  ExpectOne(ArcHits(small, big), {0, 2});
}

TEST(GetCircleArcAndCircleArcIntersection, TouchingOnTheSeamNeverCounts) {
  // Seen from the right circle the point lies at the angle pi.
  ExpectCountOnly(ArcHits(NearlyFull({0, 0}, 1, 1.0), NearlyFull({2, 0}, 1, 1.0)), 0);
}

TEST(GetCircleArcAndCircleArcIntersection, CoincidentCirclesAreNoHit) {
  ArcData const arc = NearlyFull({3, 4}, 2, 1.0);
  ExpectCountOnly(ArcHits(arc, arc), 0);
  ExpectCountOnly(ArcHits(arc, NearlyFull({3, 4}, 2, -2.0)), 0);
}

TEST(GetCircleArcAndCircleArcIntersection, TheCommonPointMustLieOnBothArcs) {
  ArcData const full = NearlyFull({0, 0}, 1, 2.5);
  ArcData const fullRight = NearlyFull({1, 0}, 1, 0.25);
  ArcData const upperLeft{{0, 0}, 1, 1, 0.0, 3.0};
  ArcData const upperRight{{1, 0}, 1, 1, 0.0, 3.0};
  ArcData const lowerRight{{1, 0}, 1, -1, 0.0, -3.0};
  double const h = std::sqrt(0.75);
  ExpectOne(ArcHits(upperLeft, fullRight), {0.5, h});
  ExpectOne(ArcHits(full, upperRight), {0.5, h});
  ExpectOne(ArcHits(full, lowerRight), {0.5, -h});
  ExpectCountOnly(ArcHits(upperLeft, lowerRight), 0);
}

TEST(GetCircleArcAndCircleArcIntersection, EndsOfTheArcsDoNotCount) {
  double const h = std::sqrt(0.75);
  double const leftAngle = std::atan2(h, 0.5);
  ArcData const right = NearlyFull({1, 0}, 1, 0.25);
  ExpectCountOnly(ArcHits({{0, 0}, 1, 1, leftAngle, 3.0}, right), 0);
  ExpectOne(ArcHits({{0, 0}, 1, 1, Down(leftAngle), 3.0}, right), {0.5, h});
  ExpectCountOnly(ArcHits({{0, 0}, 1, 1, 0.0, leftAngle}, right), 0);
  ExpectOne(ArcHits({{0, 0}, 1, 1, 0.0, Up(leftAngle)}, right), {0.5, h});
}

TEST(GetCircleArcAndCircleArcIntersection, EqualAnglesStandForTheWholeCircle) {
  ArcData const whole{{0, 0}, 1, 1, 0.25, 0.25};
  ArcData const other{{1, 0}, 1, -1, 0.5, 0.5};
  double const h = std::sqrt(0.75);
  ExpectTwo(ArcHits(whole, other), {0.5, h}, {0.5, -h});
}

TEST(GetCircleArcAndCircleArcIntersection, NonFiniteInputIsNoHit) {
  for (double const bad : {kNaN, kInf}) {
    for (std::size_t i = 0; i < 6; ++i) {
      std::array<double, 6> v{0, 0, 1, 0.75, 0.25, 1.5};
      v[i] = bad;
      SCOPED_TRACE(testing::Message() << bad << " at " << i);
      ExpectCountOnly(
          ArcHits({{v[0], v[1]}, v[2], 1, -3.0, 3.0}, {{v[3], v[4]}, v[5], 1, -3.0, 3.0}), 0);
    }
  }
}

/// The two circles' common points before any arc is looked at.
std::vector<Point> ReferenceCandidates(ArcData const& big, ArcData const& small) {
  double const dx = small.center.x - big.center.x;
  double const dy = small.center.y - big.center.y;
  double const dx2 = dx * dx;
  double const dy2 = dy * dy;
  double const dist = std::sqrt(dx2 + dy2);
  double const distSquared = dist * dist;
  if (dist > big.r + small.r || small.r > dist + big.r || big.r > dist + small.r) return {};
  double const big2 = big.r * big.r;
  double const small2 = small.r * small.r;
  double const q = (big2 + distSquared - small2) / (2.0 * dist);
  double const q2 = q * q;
  double const h2 = big2 - q2;
  if (h2 < 0.0) return {};
  double const h = std::sqrt(h2);
  if (h <= kEpsilon) {
    double const rx = dx * big.r;
    double const ry = dy * big.r;
    return {{big.center.x + rx / dist, big.center.y + ry / dist}};
  }
  double const ex = dx / dist;
  double const ey = dy / dist;
  double const mx = big.center.x + q * ex;
  double const my = big.center.y + q * ey;
  return {{mx - ey * h, my + ex * h}, {mx + ey * h, my - ex * h}};
}

std::vector<Point> ReferenceArcHits(ArcData const& first, ArcData const& second) {
  ArcData const& big = first.r >= second.r ? first : second;
  ArcData const& small = first.r >= second.r ? second : first;
  std::vector<Point> points;
  for (Point const& p : ReferenceCandidates(big, small)) {
    if (InRange(big, p) && InRange(small, p)) points.push_back(p);
  }
  return points;
}

ArcData RandomArc(RandomGeometry* random) {
  return {random->PointIn(-2, 2), random->Uniform(0.1, 3.0), random->Flip() ? 1.0 : -1.0,
          random->Uniform(-3.14, 3.14), random->Uniform(-3.14, 3.14)};
}

TEST(GetCircleArcAndCircleArcIntersection, FollowsTheReferenceBitForBit) {
  constexpr std::uint64_t kSeed = 2212;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  std::array<int, 3> seen{};
  for (int i = 0; i < 40000; ++i) {
    ArcData const first = RandomArc(&random);
    ArcData const second = RandomArc(&random);
    Hits const hits = ArcHits(first, second);
    ExpectPoints(hits, ReferenceArcHits(first, second));
    if (HasFatalFailure()) return;
    ++seen[static_cast<std::size_t>(hits.count)];
    for (Point const& p : {hits.a, hits.b}) {
      if (p.x == kSentinel) continue;
      ASSERT_NEAR(Reference::Distance(p, first.center), first.r, 1e-9);
      ASSERT_NEAR(Reference::Distance(p, second.center), second.r, 1e-9);
    }
  }
  for (int const count : seen) EXPECT_GT(count, 500);
}

TEST(GetCircleArcAndCircleArcIntersection, FollowsTheReferenceOnTouchingCircles) {
  constexpr std::uint64_t kSeed = 2213;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  std::array<int, 3> seen{};
  for (int i = 0; i < 40000; ++i) {
    ArcData first = RandomArc(&random);
    ArcData second = RandomArc(&random);
    double const angle = random.Uniform(-3.14, 3.14);
    double const gap = random.Flip() ? first.r + second.r : std::fabs(first.r - second.r);
    second.center = {first.center.x + gap * std::cos(angle),
                     first.center.y + gap * std::sin(angle)};
    Hits const hits = ArcHits(first, second);
    ExpectPoints(hits, ReferenceArcHits(first, second));
    if (HasFatalFailure()) return;
    ++seen[static_cast<std::size_t>(hits.count)];
  }
  for (int const count : seen) EXPECT_GT(count, 100);
}

TEST(GetCircleArcAndCircleArcIntersection, CountsLikeExactArithmeticOnAGrid) {
  // Nearly full arcs whose gaps no common point of these circles falls into; only points on the
  // seam of either circle are lost, and they are told apart exactly.
  int two = 0;
  int touching = 0;
  for (int x = -4; x <= 4; ++x) {
    for (int y = 1; y <= 4; ++y) {
      for (int r1 = 1; r1 <= 4; ++r1) {
        for (int r2 = 1; r2 <= 4; ++r2) {
          int const dist2 = x * x + y * y;
          int const sum2 = (r1 + r2) * (r1 + r2);
          int const difference2 = (r1 - r2) * (r1 - r2);
          Hits const hits = ArcHits({{0, 0}, static_cast<double>(r1), 1, 0.0123, 0.0122},
                                    {{static_cast<double>(x), static_cast<double>(y)},
                                     static_cast<double>(r2),
                                     1,
                                     0.0123,
                                     0.0122});
          SCOPED_TRACE(testing::Message() << x << ' ' << y << ' ' << r1 << ' ' << r2);
          if (dist2 > sum2 || dist2 < difference2) {
            ExpectCountOnly(hits, 0);
            continue;
          }
          if (x == 0 && (dist2 == sum2 || dist2 == difference2)) {
            // Tangent right above or below, where every step of the computation is exact.
            EXPECT_EQ(hits.count, 1);
            ++touching;
            continue;
          }
          if (dist2 == sum2 || dist2 == difference2) continue;
          // A common point lies on a seam when it is the leftmost point of a circle.
          bool const onSeam =
              (x + r1) * (x + r1) + y * y == r2 * r2 || (x - r2) * (x - r2) + y * y == r1 * r1;
          if (onSeam) continue;
          EXPECT_EQ(hits.count, 2);
          ++two;
        }
      }
    }
  }
  EXPECT_GT(two, 100);
  EXPECT_GT(touching, 10);
}

TEST(GetCircleArcAndCircleArcIntersection, ScalesExactlyByPowersOfTwo) {
  constexpr std::uint64_t kSeed = 2214;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 5000; ++i) {
    ArcData first = RandomArc(&random);
    ArcData second = RandomArc(&random);
    Hits const plain = ArcHits(first, second);
    for (ArcData* arc : {&first, &second}) {
      arc->center = Scale(arc->center, 1024);
      arc->r *= 1024;
    }
    Hits const scaled = ArcHits(first, second);
    ASSERT_EQ(scaled.count, plain.count);
    if (plain.count == 0) continue;
    ASSERT_TRUE(SameBits(scaled.a, Scale(plain.a, 1024)));
  }
}

}  // namespace
}  // namespace Vorn::Testing
