#include <array>
#include <cmath>
#include <cstdint>
#include <limits>
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

struct Hits {
  int count = kIntSentinel;
  Point a = kPointSentinel;
  Point b = kPointSentinel;
};

Hits SegmentHits(Point const& p, Point const& q, Point const& center, double r) {
  Hits hits;
  hits.count = GeometryUtils::GetLineSegmentAndCircleIntersection(
      p.x, p.y, q.x, q.y, center.x, center.y, r, &hits.a.x, &hits.a.y, &hits.b.x, &hits.b.y);
  return hits;
}

Hits LineHits(double a, double b, double c, Point const& center, double r) {
  Hits hits;
  hits.count = GeometryUtils::GetLineAndCircleIntersection(
      a, b, c, center.x, center.y, r, &hits.a.x, &hits.a.y, &hits.b.x, &hits.b.y);
  return hits;
}

void ExpectNone(Hits const& hits) {
  EXPECT_EQ(hits.count, 0);
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

/// The quadratic along the segment, one operation per line.
std::vector<Point> ReferenceSegmentHits(Point const& p, Point const& q, Point const& center,
                                        double r) {
  double const dx = q.x - p.x;
  double const dy = q.y - p.y;
  double const fx = p.x - center.x;
  double const fy = p.y - center.y;
  double const a = dx * dx + dy * dy;
  double const dot = dx * fx + dy * fy;
  double const b = 2.0 * dot;
  double const f2 = fx * fx + fy * fy;
  double const c = f2 - r * r;
  double const b2 = b * b;
  double const fourAc = 4.0 * a * c;
  double const disc = b2 - fourAc;
  if (disc < 0.0) return {};
  double const root = std::sqrt(disc);
  std::vector<double> parameters{(root - b) / (2.0 * a)};
  if (disc > kEpsilon) parameters.push_back((-b - root) / (2.0 * a));
  std::vector<Point> points;
  for (double const t : parameters) {
    if (0.0 <= t && t <= 1.0) points.push_back({p.x + t * dx, p.y + t * dy});
  }
  return points;
}

// --- GetLineSegmentAndCircleIntersection
// ----------------------------------------------------------

TEST(GetLineSegmentAndCircleIntersection, ThroughTheCircleReportsTheFarPointFirst) {
  ExpectTwo(SegmentHits({-2, 0}, {2, 0}, {0, 0}, 1), {1, 0}, {-1, 0});
  ExpectTwo(SegmentHits({2, 0}, {-2, 0}, {0, 0}, 1), {-1, 0}, {1, 0});
  ExpectTwo(SegmentHits({3, -1}, {3, 11}, {3, 5}, 2), {3, 7}, {3, 3});
}

TEST(GetLineSegmentAndCircleIntersection, InsideTheCircleIsNoHit) {
  ExpectNone(SegmentHits({0, 0}, {0.5, 0}, {0, 0}, 1));
}

TEST(GetLineSegmentAndCircleIntersection, OutsideTheCircleIsNoHit) {
  ExpectNone(SegmentHits({-2, 2}, {2, 2}, {0, 0}, 1));
  ExpectNone(SegmentHits({2, 0}, {4, 0}, {0, 0}, 1));
  ExpectNone(SegmentHits({-4, 0}, {-2, 0}, {0, 0}, 1));
}

TEST(GetLineSegmentAndCircleIntersection, OneEndInsideIsOneHitInTheFirstOutput) {
  ExpectOne(SegmentHits({0, 0}, {2, 0}, {0, 0}, 1), {1, 0});
  ExpectOne(SegmentHits({2, 0}, {0, 0}, {0, 0}, 1), {1, 0});
}

TEST(GetLineSegmentAndCircleIntersection, EndsOnTheCircleCount) {
  ExpectTwo(SegmentHits({-1, 0}, {1, 0}, {0, 0}, 1), {1, 0}, {-1, 0});
  ExpectOne(SegmentHits({1, 0}, {2, 0}, {0, 0}, 1), {1, 0});
  ExpectOne(SegmentHits({0, 0}, {1, 0}, {0, 0}, 1), {1, 0});
  ExpectNone(SegmentHits({Up(1.0), 0}, {2, 0}, {0, 0}, 1));
  ExpectNone(SegmentHits({0, 0}, {Down(1.0), 0}, {0, 0}, 1));
}

TEST(GetLineSegmentAndCircleIntersection, TangentSegmentTouchesOnce) {
  ExpectOne(SegmentHits({-2, 1}, {2, 1}, {0, 0}, 1), {0, 1});
  ExpectOne(SegmentHits({-0.5, 1}, {0.5, 1}, {0, 0}, 1), {0, 1});
  ExpectNone(SegmentHits({-0.5, Up(1.0)}, {0.5, Up(1.0)}, {0, 0}, 1));
  ExpectNone(SegmentHits({1, 1}, {2, 1}, {0, 0}, 1));
}

TEST(GetLineSegmentAndCircleIntersection, DiscriminantUpToEpsilonIsOneTouchingPoint) {
  // Unit segment centred on a tiny circle: the discriminant is 4*r*r, rounded to whole epsilons.
  Hits const touching = SegmentHits({0, 0}, {1, 0}, {0.5, 0}, 0x1p-27);
  ExpectOne(touching, {(1.0 + 0x1p-26) / 2.0, 0});
  Hits const crossing = SegmentHits({0, 0}, {1, 0}, {0.5, 0}, 1.25 * 0x1p-27);
  EXPECT_EQ(crossing.count, 2);
  EXPECT_GT(crossing.a.x, 0.5);
  EXPECT_LT(crossing.b.x, 0.5);
}

TEST(GetLineSegmentAndCircleIntersection, ZeroLengthSegmentIsNoHitEvenOnTheCircle) {
  ExpectNone(SegmentHits({1, 0}, {1, 0}, {0, 0}, 1));
  ExpectNone(SegmentHits({0.5, 0}, {0.5, 0}, {0, 0}, 1));
  ExpectNone(SegmentHits({5, 0}, {5, 0}, {0, 0}, 1));
}

TEST(GetLineSegmentAndCircleIntersection, ZeroRadiusIsTouchedOnce) {
  ExpectOne(SegmentHits({-1, 0}, {1, 0}, {0, 0}, 0), {0, 0});
  ExpectNone(SegmentHits({-1, 1}, {1, 1}, {0, 0}, 0));
}

TEST(GetLineSegmentAndCircleIntersection, OnlyTheSquareOfTheRadiusCounts) {
  ExpectTwo(SegmentHits({-2, 0}, {2, 0}, {0, 0}, -1), {1, 0}, {-1, 0});
}

TEST(GetLineSegmentAndCircleIntersection, NonFiniteInputIsNoHit) {
  for (double const bad : {kNaN, kInf, -kInf}) {
    for (std::size_t i = 0; i < 7; ++i) {
      std::array<double, 7> v{-2, 0.5, 2, 0.25, 0, 0, 1};
      v[i] = bad;
      SCOPED_TRACE(testing::Message() << bad << " at " << i);
      ExpectNone(SegmentHits({v[0], v[1]}, {v[2], v[3]}, {v[4], v[5]}, v[6]));
    }
  }
}

/// How many roots of A*t*t + B*t + C lie in [0, 1], in whole numbers; a double root counts once.
int WholeRoots(std::int64_t a, std::int64_t b, std::int64_t c) {
  std::int64_t const disc = b * b - 4 * a * c;
  if (a == 0 || disc < 0) return 0;
  // Signs of the quadratic at the ends and the place of its lowest point tell everything.
  std::int64_t const atZero = c;
  std::int64_t const atOne = a + b + c;
  bool const lowestInside = b <= 0 && -b <= 2 * a;
  if (disc == 0) return lowestInside ? 1 : 0;
  if (atZero < 0 && atOne < 0) return 0;
  if ((atZero < 0) != (atOne < 0)) return 1;
  return lowestInside ? 2 : (atZero == 0 || atOne == 0 ? 1 : 0);
}

TEST(GetLineSegmentAndCircleIntersection, CountsLikeExactArithmeticOnAGrid) {
  int withTwo = 0;
  int tangent = 0;
  for (int code = 0; code < 7 * 7 * 7 * 7; ++code) {
    int const x1 = code % 7 - 3;
    int const y1 = code / 7 % 7 - 3;
    int const x2 = code / 49 % 7 - 3;
    int const y2 = code / 343 - 3;
    for (int r = 0; r <= 4; ++r) {
      std::int64_t const dx = x2 - x1;
      std::int64_t const dy = y2 - y1;
      std::int64_t const a = dx * dx + dy * dy;
      std::int64_t const b = 2 * (dx * x1 + dy * y1);
      std::int64_t const c = x1 * x1 + y1 * y1 - r * r;
      Hits const hits = SegmentHits({static_cast<double>(x1), static_cast<double>(y1)},
                                    {static_cast<double>(x2), static_cast<double>(y2)}, {0, 0}, r);
      ASSERT_EQ(hits.count, WholeRoots(a, b, c))
          << x1 << ' ' << y1 << ' ' << x2 << ' ' << y2 << " r " << r;
      withTwo += hits.count == 2 ? 1 : 0;
      tangent += hits.count == 1 && b * b == 4 * a * c ? 1 : 0;
    }
  }
  EXPECT_GT(withTwo, 500);
  EXPECT_GT(tangent, 100);
}

TEST(GetLineSegmentAndCircleIntersection, FollowsTheQuadraticBitForBit) {
  constexpr std::uint64_t kSeed = 2201;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  std::array<int, 3> seen{};
  for (int i = 0; i < 20000; ++i) {
    Point const p = random.PointIn(-3, 3);
    Point const q = random.PointIn(-3, 3);
    Point const center = random.PointIn(-1, 1);
    double const r = random.Uniform(0.0, 3.0);
    Hits const hits = SegmentHits(p, q, center, r);
    ExpectPoints(hits, ReferenceSegmentHits(p, q, center, r));
    if (HasFatalFailure()) return;
    ++seen[static_cast<std::size_t>(hits.count)];
    if (hits.count > 0) {
      ASSERT_NEAR(Reference::Distance(hits.a, center), r, 1e-9);
    }
    if (hits.count > 1) {
      ASSERT_NEAR(Reference::Distance(hits.b, center), r, 1e-9);
    }
  }
  for (int const count : seen) EXPECT_GT(count, 1000);
}

TEST(GetLineSegmentAndCircleIntersection, FollowsTheQuadraticOnTinyAndHugeInput) {
  constexpr std::uint64_t kSeed = 2202;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 20000; ++i) {
    std::array<double, 7> v{};
    int const exponent = random.Integer(-540, 510);
    for (double& value : v) value = std::ldexp(random.Integer(-8, 8), exponent);
    ExpectPoints(SegmentHits({v[0], v[1]}, {v[2], v[3]}, {v[4], v[5]}, v[6]),
                 ReferenceSegmentHits({v[0], v[1]}, {v[2], v[3]}, {v[4], v[5]}, v[6]));
    if (HasFatalFailure()) return;
  }
}

TEST(GetLineSegmentAndCircleIntersection, ScalesExactlyByPowersOfTwoAndTurnsWithAQuarterTurn) {
  constexpr std::uint64_t kSeed = 2203;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 3000; ++i) {
    Point const p = random.PointIn(-3, 3);
    Point const q = random.PointIn(-3, 3);
    Hits const plain = SegmentHits(p, q, {0.25, -0.5}, 1.5);
    Hits const scaled = SegmentHits(Scale(p, 16), Scale(q, 16), {4, -8}, 24);
    Hits const turned = SegmentHits(QuarterTurn(p), QuarterTurn(q), {0.5, 0.25}, 1.5);
    ASSERT_EQ(scaled.count, plain.count);
    ASSERT_EQ(turned.count, plain.count);
    if (plain.count == 0) continue;
    ASSERT_TRUE(SameBits(scaled.a, Scale(plain.a, 16)));
    ASSERT_EQ(turned.a.x, -plain.a.y);
    ASSERT_EQ(turned.a.y, plain.a.x);
  }
}

// --- GetLineAndCircleIntersection
// -----------------------------------------------------------------

TEST(GetLineAndCircleIntersection, TangentLineTouchesOnce) {
  ExpectOne(LineHits(0, 1, -1, {0, 0}, 1), {0, 1});
  ExpectOne(LineHits(1, 0, -1, {0, 0}, 1), {1, 0});
  ExpectOne(LineHits(0, -4, 4, {0, 0}, 1), {0, 1});
}

TEST(GetLineAndCircleIntersection, SecantIsWalkedFromThePlusEnd) {
  // The auxiliary segment runs downwards in its dominant coordinate, and the far point comes first.
  ExpectTwo(LineHits(0, 1, 0, {0, 0}, 1), {-1, 0}, {1, 0});
  ExpectTwo(LineHits(0, -1, 0, {0, 0}, 1), {-1, 0}, {1, 0});
  ExpectTwo(LineHits(1, 0, -3, {3, 2}, 2), {3, 0}, {3, 4});
  ExpectTwo(LineHits(-1, 0, 3, {3, 2}, 2), {3, 0}, {3, 4});
}

TEST(GetLineAndCircleIntersection, EqualCoefficientsAreWalkedAlongX) {
  Hits const hits = LineHits(1, 1, 0, {0, 0}, 1);
  ASSERT_EQ(hits.count, 2);
  EXPECT_LT(hits.a.x, 0.0);
  EXPECT_GT(hits.b.x, 0.0);
  Hits const steeper = LineHits(Up(1.0), 1, 0, {0, 0}, 1);
  ASSERT_EQ(steeper.count, 2);
  EXPECT_LT(steeper.a.y, 0.0);
  EXPECT_GT(steeper.b.y, 0.0);
  Hits const negative = LineHits(-Up(1.0), 1, 0, {0, 0}, 1);
  EXPECT_LT(negative.a.y, 0.0);
}

TEST(GetLineAndCircleIntersection, ALineFartherThanTheRadiusIsNoHit) {
  ExpectNone(LineHits(0, 1, -Up(1.0), {0, 0}, 1));
  ExpectNone(LineHits(0, 1, -2, {0, 0}, 1));
  ExpectNone(LineHits(3, 4, -25, {0, 0}, 4.75));
}

TEST(GetLineAndCircleIntersection, NegativeRadiusIsNoHit) {
  ExpectNone(LineHits(0, 1, 0, {0, 0}, -1));
  ExpectNone(LineHits(0, 1, 0, {0, 0}, -std::numeric_limits<double>::denorm_min()));
}

TEST(GetLineAndCircleIntersection, ZeroRadiusIsNoHitEvenThroughTheCentre) {
  ExpectNone(LineHits(0, 1, 0, {0, 0}, 0));
}

TEST(GetLineAndCircleIntersection, ALineWithoutANormalIsNoHit) {
  ExpectNone(LineHits(0, 0, 0, {0, 0}, 1));
  ExpectNone(LineHits(1e-170, 1e-170, 0, {0, 0}, 1));
}

TEST(GetLineAndCircleIntersection, AFootThatCannotBeFoundIsNoHit) {
  // The normal is long enough for a distance, but its square is below the smallest normal double.
  double dev = kSentinel;
  ASSERT_TRUE(GeometryUtils::GetDeviation(0x1p-520, 0, 0, 0, 0, &dev));
  ExpectNone(LineHits(0x1p-520, 0, 0, {0, 0}, 1));
  ExpectTwo(LineHits(0x1p-511, 0, 0, {0, 0}, 1), {0, -1}, {0, 1});
}

TEST(GetLineAndCircleIntersection, NonFiniteInputIsNoHit) {
  for (double const bad : {kNaN, kInf, -kInf}) {
    for (std::size_t i = 0; i < 6; ++i) {
      std::array<double, 6> v{1, 2, 0.5, 0.25, 0.125, 3};
      v[i] = bad;
      SCOPED_TRACE(testing::Message() << bad << " at " << i);
      ExpectNone(LineHits(v[0], v[1], v[2], {v[3], v[4]}, v[5]));
    }
  }
}

TEST(GetLineAndCircleIntersection, FollowsTheReferenceBitForBit) {
  constexpr std::uint64_t kSeed = 2204;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  std::array<int, 3> seen{};
  for (int i = 0; i < 20000; ++i) {
    Reference::Line const line{random.Uniform(-3, 3), random.Uniform(-3, 3), random.Uniform(-3, 3)};
    Point const center = random.PointIn(-2, 2);
    double const r = random.Uniform(0.0, 2.0);
    Hits const hits = LineHits(line.a, line.b, line.c, center, r);
    ExpectPoints(hits, Reference::CrossCircle(line, center, r));
    if (HasFatalFailure()) return;
    ++seen[static_cast<std::size_t>(hits.count)];
    if (hits.count < 2) continue;
    ASSERT_NEAR(Reference::Distance(hits.a, center), r, 1e-9);
    ASSERT_NEAR(Reference::Distance(hits.b, center), r, 1e-9);
    ASSERT_NEAR(line.a * hits.a.x + line.b * hits.a.y + line.c, 0.0, 1e-9);
    ASSERT_NEAR(line.a * hits.b.x + line.b * hits.b.y + line.c, 0.0, 1e-9);
  }
  EXPECT_GT(seen[0], 1000);
  EXPECT_GT(seen[2], 1000);
}

TEST(GetLineAndCircleIntersection, FollowsTheReferenceOnSmallWholeNumbers) {
  constexpr std::uint64_t kSeed = 2205;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int touching = 0;
  for (int i = 0; i < 20000; ++i) {
    std::array<double, 6> v{};
    for (double& value : v) value = random.Integer(-5, 5);
    Hits const hits = LineHits(v[0], v[1], v[2], {v[3], v[4]}, v[5]);
    ExpectPoints(hits, Reference::CrossCircle({v[0], v[1], v[2]}, {v[3], v[4]}, v[5]));
    if (HasFatalFailure()) return;
    touching += hits.count == 1 ? 1 : 0;
  }
  EXPECT_GT(touching, 100);
}

// --- GetNearestPointOnCircle
// ----------------------------------------------------------------------

struct Projection {
  bool ok = false;
  Point point = kPointSentinel;
};

Projection Project(Point const& center, double radius, Point const& p) {
  Projection projection;
  projection.ok = GeometryUtils::GetNearestPointOnCircle(center, radius, p, &projection.point);
  return projection;
}

TEST(GetNearestPointOnCircle, ProjectsAlongTheRayFromTheCentre) {
  Projection const outside = Project({1, 1}, 5, {7, 9});
  EXPECT_TRUE(outside.ok);
  EXPECT_EQ(outside.point.x, 4.0);
  EXPECT_EQ(outside.point.y, 5.0);
  Projection const onCircle = Project({0, 0}, 5, {3, -4});
  EXPECT_EQ(onCircle.point.x, 3.0);
  EXPECT_EQ(onCircle.point.y, -4.0);
}

TEST(GetNearestPointOnCircle, APointCloserThanHalfTheRadiusFails) {
  Projection const inside = Project({0, 0}, 1, {0.4, 0});
  EXPECT_FALSE(inside.ok);
  EXPECT_SAME_POINT(inside.point, kPointSentinel);
  Projection const farEnough = Project({0, 0}, 1, {0.6, 0});
  EXPECT_TRUE(farEnough.ok);
  EXPECT_NEAR(farEnough.point.x, 1.0, 1e-15);
  EXPECT_EQ(farEnough.point.y, 0.0);
}

TEST(GetNearestPointOnCircle, HalfTheRadiusIsTheLimit) {
  EXPECT_TRUE(Project({0, 0}, 4, {2, 0}).ok);
  EXPECT_TRUE(Project({0, 0}, 4, {Up(2.0), 0}).ok);
  EXPECT_FALSE(Project({0, 0}, 4, {Down(2.0), 0}).ok);
}

TEST(GetNearestPointOnCircle, TheCentreItselfFails) {
  Projection const centre = Project({2, 3}, 1, {2, 3});
  EXPECT_FALSE(centre.ok);
  EXPECT_SAME_POINT(centre.point, kPointSentinel);
}

TEST(GetNearestPointOnCircle, ZeroRadiusGivesTheCentre) {
  Projection const centre = Project({2, 3}, 0, {7, 8});
  EXPECT_TRUE(centre.ok);
  EXPECT_EQ(centre.point.x, 2.0);
  EXPECT_EQ(centre.point.y, 3.0);
}

TEST(GetNearestPointOnCircle, NonFiniteInputFails) {
  for (double const bad : {kNaN, kInf, -kInf}) {
    for (std::size_t i = 0; i < 5; ++i) {
      std::array<double, 5> v{0.5, 0.25, 1, 3, 4};
      v[i] = bad;
      Projection const projection = Project({v[0], v[1]}, v[2], {v[3], v[4]});
      EXPECT_FALSE(projection.ok) << bad << " at " << i;
      EXPECT_SAME_POINT(projection.point, kPointSentinel);
    }
  }
}

TEST(GetNearestPointOnCircle, FollowsTheSegmentFormBitForBit) {
  constexpr std::uint64_t kSeed = 2206;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int found = 0;
  int failed = 0;
  for (int i = 0; i < 10000; ++i) {
    Point const center = random.PointIn(-3, 3);
    Point const p = random.PointIn(-3, 3);
    double const radius = random.Uniform(0.0, 8.0);
    Point const far{center.x + 2.0 * (p.x - center.x), center.y + 2.0 * (p.y - center.y)};
    std::vector<Point> const hits = ReferenceSegmentHits(center, far, center, radius);
    Projection const projection = Project(center, radius, p);
    ASSERT_EQ(projection.ok, hits.size() == 1);
    (projection.ok ? found : failed) += 1;
    if (!projection.ok) continue;
    ASSERT_TRUE(SameBits(projection.point, hits[0]));
    double const distance = Reference::Distance(p, center);
    ASSERT_NEAR(projection.point.x, center.x + radius * (p.x - center.x) / distance, 1e-12);
    ASSERT_NEAR(projection.point.y, center.y + radius * (p.y - center.y) / distance, 1e-12);
  }
  EXPECT_GT(found, 1000);
  EXPECT_GT(failed, 1000);
}

}  // namespace
}  // namespace Vorn::Testing
