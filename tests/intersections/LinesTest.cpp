#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <limits>
#include <ostream>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "support/ReferencePrimitives.h"
#include "vorn/GeometryUtils.h"
#include "vorn/MathUtils.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using enum SegmentsRelPosition;

constexpr double kSmallestNormal = 2.2250738585072014e-308;
constexpr double kEpsilon = 2.220446049250313e-16;

// --- GetLinesIntersection of implicit lines -----------------------------------------------------

struct Meeting {
  SegmentsRelPosition relation = Disjoint;
  Point point = kPointSentinel;
};

Meeting MeetLines(double a1, double b1, double c1, double a2, double b2, double c2) {
  Meeting meeting;
  meeting.relation = GeometryUtils::GetLinesIntersection(a1, b1, c1, a2, b2, c2, &meeting.point.x,
                                                         &meeting.point.y);
  return meeting;
}

TEST(GetLinesIntersection, FindsTheCommonPoint) {
  Meeting const meeting = MeetLines(1.0, 1.0, -3.0, 1.0, -1.0, 1.0);  // x + y = 3, x - y = -1
  EXPECT_EQ(meeting.relation, Intersecting);
  EXPECT_EQ(meeting.point.x, 1.0);
  EXPECT_EQ(meeting.point.y, 2.0);
}

TEST(GetLinesIntersection, ParallelAndCoincidentLinesAreBothParallel) {
  for (double const c2 : {-6.0, -7.0}) {
    Meeting const meeting = MeetLines(1.0, 2.0, -3.0, 2.0, 4.0, c2);
    EXPECT_EQ(meeting.relation, Parallel);
    EXPECT_SAME_POINT(meeting.point, kPointSentinel);
  }
  EXPECT_EQ(MeetLines(0.0, 0.0, 1.0, 1.0, 1.0, 1.0).relation, Parallel);
}

TEST(GetLinesIntersection, DeterminantOfTheSmallestNormalIsStillAnIntersection) {
  EXPECT_EQ(MeetLines(kSmallestNormal, 0.0, 0.0, 0.0, 1.0, 0.0).relation, Intersecting);
  EXPECT_EQ(MeetLines(-kSmallestNormal, 0.0, 0.0, 0.0, 1.0, 0.0).relation, Intersecting);
  EXPECT_EQ(MeetLines(Down(kSmallestNormal), 0.0, 0.0, 0.0, 1.0, 0.0).relation, Parallel);
  EXPECT_EQ(MeetLines(-Down(kSmallestNormal), 0.0, 0.0, 0.0, 1.0, 0.0).relation, Parallel);
}

TEST(GetLinesIntersection, NotANumberDeterminantIsNotParallel) {
  Meeting const meeting = MeetLines(kNaN, 1.0, 1.0, 1.0, 2.0, 3.0);
  EXPECT_EQ(meeting.relation, Intersecting);
  EXPECT_TRUE(std::isnan(meeting.point.x));
  EXPECT_TRUE(std::isnan(meeting.point.y));
}

TEST(GetLinesIntersection, FollowsTheFormulaBitForBit) {
  constexpr std::uint64_t kSeed = 2101;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 3000; ++i) {
    std::array<double, 6> v{};
    for (double& value : v) value = random.Uniform(-10.0, 10.0);
    Point expected = kPointSentinel;
    ASSERT_TRUE(Reference::MeetingPoint({v[0], v[1], v[2]}, {v[3], v[4], v[5]}, &expected));
    Meeting const meeting = MeetLines(v[0], v[1], v[2], v[3], v[4], v[5]);
    ASSERT_EQ(meeting.relation, Intersecting);
    ASSERT_TRUE(SameBits(meeting.point, expected));
    Meeting const swapped = MeetLines(v[3], v[4], v[5], v[0], v[1], v[2]);
    ASSERT_EQ(swapped.point.x, meeting.point.x);
    ASSERT_EQ(swapped.point.y, meeting.point.y);
  }
}

// --- GetLineAndSegmentIntersection --------------------------------------------------------------

struct Hit {
  bool ok = false;
  Point point = kPointSentinel;
};

Hit LineAndSegment(Reference::Line const& line, Point const& p, Point const& q) {
  Hit hit;
  hit.ok = GeometryUtils::GetLineAndSegmentIntersection(line.a, line.b, line.c, p.x, p.y, q.x, q.y,
                                                        &hit.point.x, &hit.point.y);
  return hit;
}

TEST(GetLineAndSegmentIntersection, FindsThePointOnTheSegment) {
  Hit const hit = LineAndSegment({1.0, -1.0, 0.0}, {0.0, 2.0}, {2.0, 0.0});
  EXPECT_TRUE(hit.ok);
  EXPECT_EQ(hit.point.x, 1.0);
  EXPECT_EQ(hit.point.y, 1.0);
}

TEST(GetLineAndSegmentIntersection, IncludesTheEndsOfTheSegment) {
  EXPECT_TRUE(LineAndSegment({1.0, 0.0, -2.0}, {0.0, 0.0}, {2.0, 0.0}).ok);
  EXPECT_TRUE(LineAndSegment({1.0, 0.0, 0.0}, {0.0, 0.0}, {2.0, 0.0}).ok);
  EXPECT_FALSE(LineAndSegment({1.0, 0.0, -Up(2.0)}, {0.0, 0.0}, {2.0, 0.0}).ok);
  EXPECT_FALSE(LineAndSegment({1.0, 0.0, 0x1p-60}, {0.0, 0.0}, {2.0, 0.0}).ok);
}

TEST(GetLineAndSegmentIntersection, MissesDegenerateSegmentsAndParallelLines) {
  for (Hit const& hit : {LineAndSegment({1.0, -1.0, 0.0}, {1.0, 1.0}, {1.0, 1.0}),
                         LineAndSegment({1.0, -1.0, 0.0}, {1.0, 1.0}, {2.0, 2.0}),
                         LineAndSegment({1.0, -1.0, 1.0}, {1.0, 1.0}, {2.0, 2.0}),
                         LineAndSegment({1.0, -1.0, 0.0}, {2.0, 1.0}, {5.0, 2.0}),
                         LineAndSegment({0.0, 0.0, 0.0}, {2.0, 1.0}, {5.0, 2.0})}) {
    EXPECT_FALSE(hit.ok);
    EXPECT_SAME_POINT(hit.point, kPointSentinel);
  }
}

TEST(GetLineAndSegmentIntersection, NotANumberLiesInNoBox) {
  EXPECT_FALSE(LineAndSegment({kNaN, -1.0, 0.0}, {0.0, 2.0}, {2.0, 0.0}).ok);
  EXPECT_FALSE(LineAndSegment({1.0, -1.0, kNaN}, {0.0, 2.0}, {2.0, 0.0}).ok);
  EXPECT_FALSE(LineAndSegment({1.0, -1.0, 0.0}, {0.0, kNaN}, {2.0, 0.0}).ok);
}

TEST(GetLineAndSegmentIntersection, FollowsTheReferenceBitForBit) {
  constexpr std::uint64_t kSeed = 2102;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int found = 0;
  for (int i = 0; i < 10000; ++i) {
    Reference::Line const line{static_cast<double>(random.Integer(-3, 3)),
                               static_cast<double>(random.Integer(-3, 3)),
                               static_cast<double>(random.Integer(-3, 3))};
    Point const p = i % 2 == 0 ? random.GridPoint(3) : random.PointIn(-3.0, 3.0);
    Point const q = random.GridPoint(3);
    Reference::Line through;
    Point expected = kPointSentinel;
    bool const ok = Reference::LineThrough(p.x, p.y, q.x, q.y, &through) &&
                    Reference::MeetingPoint(line, through, &expected) &&
                    Reference::InBoxOf(expected, p, q);
    Hit const hit = LineAndSegment(line, p, q);
    ASSERT_EQ(hit.ok, ok);
    ASSERT_TRUE(SameBits(hit.point, ok ? expected : kPointSentinel));
    found += ok ? 1 : 0;
  }
  EXPECT_GT(found, 2000);
}

// --- GetLineSegmentsIntersection ----------------------------------------------------------------

struct Segments {
  Point p1;
  Point p2;
  Point p3;
  Point p4;
};

std::ostream& operator<<(std::ostream& out, Segments const& s) {
  out.precision(17);
  return out << '(' << s.p1.x << ", " << s.p1.y << ")-(" << s.p2.x << ", " << s.p2.y << ") with ("
             << s.p3.x << ", " << s.p3.y << ")-(" << s.p4.x << ", " << s.p4.y << ')';
}

Meeting Meet(Segments const& s) {
  Meeting meeting;
  meeting.relation = GeometryUtils::GetLineSegmentsIntersection(s.p1.x, s.p1.y, s.p2.x, s.p2.y,
                                                                s.p3.x, s.p3.y, s.p4.x, s.p4.y,
                                                                &meeting.point.x, &meeting.point.y);
  return meeting;
}

bool DoMeet(Segments const& s) {
  return GeometryUtils::AreLineSegmentsIntersect(s.p1.x, s.p1.y, s.p2.x, s.p2.y, s.p3.x, s.p3.y,
                                                 s.p4.x, s.p4.y);
}

void ExpectMeeting(Segments const& segments, SegmentsRelPosition relation, Point const& point) {
  SCOPED_TRACE(testing::Message() << segments);
  Meeting const meeting = Meet(segments);
  EXPECT_EQ(meeting.relation, relation);
  EXPECT_EQ(meeting.point.x, point.x);
  EXPECT_EQ(meeting.point.y, point.y);
}

void ExpectNoMeeting(Segments const& segments, SegmentsRelPosition relation) {
  ExpectMeeting(segments, relation, kPointSentinel);
}

TEST(GetLineSegmentsIntersection, CrossingDiagonalsMeetInTheMiddle) {
  ExpectMeeting({{0, 0}, {2, 2}, {0, 2}, {2, 0}}, Intersecting, {1, 1});
}

TEST(GetLineSegmentsIntersection, ASharedEndCounts) {
  ExpectMeeting({{0, 0}, {1, 0}, {1, 0}, {2, 5}}, Intersecting, {1, 0});
}

TEST(GetLineSegmentsIntersection, AnEndTouchingAnInteriorCounts) {
  ExpectMeeting({{0, 0}, {4, 0}, {1, 0}, {2, 5}}, Intersecting, {1, 0});
  ExpectMeeting({{1, 0}, {2, 5}, {0, 0}, {4, 0}}, Intersecting, {1, 0});
}

TEST(GetLineSegmentsIntersection, OverlapOnALineThroughTheOriginIsCollinearInItsMiddle) {
  ExpectMeeting({{0, 0}, {2, 0}, {1, 0}, {3, 0}}, Collinear, {1.5, 0});
  ExpectMeeting({{3, 0}, {1, 0}, {2, 0}, {0, 0}}, Collinear, {1.5, 0});
  ExpectMeeting({{1, 2}, {3, 6}, {2, 4}, {8, 16}}, Collinear, {2.5, 5});
}

TEST(GetLineSegmentsIntersection, TouchingEndsOnALineThroughTheOriginAreCollinear) {
  ExpectMeeting({{0, 0}, {1, 1}, {1, 1}, {3, 3}}, Collinear, {1, 1});
}

TEST(GetLineSegmentsIntersection, OneLineWithDifferentRawConstantsIsParallel) {
  // Deliberate: the constants -1 and -2 are compared without normalising the lines.
  ExpectNoMeeting({{0, 1}, {1, 2}, {1, 2}, {3, 4}}, Parallel);
}

TEST(GetLineSegmentsIntersection, OneLineWithEqualRawConstantsIsCollinear) {
  ExpectMeeting({{0, 1}, {2, 3}, {1, 2}, {3, 4}}, Collinear, {1.5, 2.5});
  // The same overlap with the second segment reversed has constants -2 and +2.
  ExpectNoMeeting({{0, 1}, {2, 3}, {3, 4}, {1, 2}}, Parallel);
}

TEST(GetLineSegmentsIntersection, DistinctParallelsWhoseBoxesMeetAreParallel) {
  ExpectNoMeeting({{0, 0}, {2, 2}, {0, 1}, {1, 2}}, Parallel);
}

TEST(GetLineSegmentsIntersection, BoxesApartAreDisjoint) {
  ExpectNoMeeting({{0, 0}, {1, 0}, {0, 1}, {1, 1}}, Disjoint);
  ExpectNoMeeting({{0, 0}, {1, 1}, {2, 2}, {3, 3}}, Disjoint);
  ExpectNoMeeting({{0, 0}, {1, 1}, {3, 3}, {2, 2}}, Disjoint);
  ExpectNoMeeting({{2, 2}, {3, 3}, {0, 0}, {1, 1}}, Disjoint);
  ExpectNoMeeting({{0, 0}, {1, 1}, {Up(1.0), 0}, {Up(1.0), 5}}, Disjoint);
}

TEST(GetLineSegmentsIntersection, LinesThatCrossOutsideTheSegmentsAreDisjoint) {
  ExpectNoMeeting({{0, 0}, {4, 4}, {3, 0}, {4, 3}}, Disjoint);
  ExpectNoMeeting({{0, 0}, {1, 1}, {0, 4}, {4, 0}}, Disjoint);
}

TEST(GetLineSegmentsIntersection, APointOnASegmentMeetsIt) {
  ExpectMeeting({{1, 1}, {1, 1}, {0, 0}, {2, 2}}, Intersecting, {1, 1});
  ExpectMeeting({{0, 0}, {2, 2}, {1, 1}, {1, 1}}, Intersecting, {1, 1});
  ExpectMeeting({{2, 3}, {2, 3}, {2, 3}, {2, 3}}, Intersecting, {2, 3});
}

TEST(GetLineSegmentsIntersection, APointBesideASegmentIsDisjoint) {
  ExpectNoMeeting({{1, 0.5}, {1, 0.5}, {0, 0}, {2, 2}}, Disjoint);
  ExpectNoMeeting({{0, 0}, {2, 2}, {1, 0.5}, {1, 0.5}}, Disjoint);
}

TEST(GetLineSegmentsIntersection, DeterminantOfTheSmallestNormalCountsAsParallel) {
  // The second segment is as short as a point; as such it is met at its own first end, as a
  // proper segment it would be met on the first segment's line.
  double const m = kSmallestNormal;
  ExpectMeeting({{0, 0}, {1, 0}, {0.5, m}, {0.5, 0}}, Intersecting, {0.5, m});
  Meeting const proper = Meet({{0, 0}, {1, 0}, {0.5, Up(m)}, {0.5, 0}});
  EXPECT_EQ(proper.relation, Intersecting);
  EXPECT_EQ(proper.point.y, 0.0);
  EXPECT_NEAR(proper.point.x, 0.5, 1e-15);
}

TEST(GetLineSegmentsIntersection, RawConstantsMayDifferByTheSmallestNormal) {
  double const m = kSmallestNormal;
  ExpectMeeting({{0, 0}, {1, 1}, {0, m}, {1, 1}}, Collinear, {0.5, 0.5});
  ExpectNoMeeting({{0, 0}, {1, 1}, {0, Up(m)}, {1, 1}}, Parallel);
  ExpectMeeting({{0, m}, {1, 1}, {0, 0}, {1, 1}}, Collinear, {0.5, 0.5});
  ExpectNoMeeting({{0, Up(m)}, {1, 1}, {0, 0}, {1, 1}}, Parallel);
}

TEST(GetLineSegmentsIntersection, SegmentsTooShortForALineAreTakenAsTheirFirstEnds) {
  double const m = kSmallestNormal;
  // Second segment short, its first end a hair off the first segment's box.
  ExpectMeeting({{0, 0}, {1, 0}, {-0.5 * m, 0}, {0.5 * m, 0}}, Intersecting, {-0.5 * m, 0});
  // First segment short.
  ExpectMeeting({{-0.5 * m, 0}, {0.5 * m, 0}, {0, 0}, {1, 0}}, Intersecting, {-0.5 * m, 0});
  // Both short: first ends within the smallest normal of each other, then farther apart.
  ExpectMeeting({{0, 0}, {0.5 * m, 0.5 * m}, {0.75 * m, 0.25 * m}, {0.25 * m, 0.25 * m}},
                Intersecting, {0, 0});
  ExpectNoMeeting({{0, 0}, {m, m}, {1.5 * m, 0.5 * m}, {0.5 * m, 0.5 * m}}, Disjoint);
  ExpectNoMeeting({{0, 0}, {m, m}, {0.5 * m, 1.5 * m}, {0.5 * m, 0.5 * m}}, Disjoint);
}

TEST(GetLineSegmentsIntersection, APointMayLieTheSmallestNormalOffTheLineForm) {
  double const m = kSmallestNormal;
  ExpectMeeting({{0, 0}, {1, 1}, {0, m}, {0, m}}, Intersecting, {0, m});
  ExpectMeeting({{0, m}, {0, m}, {0, 0}, {1, 1}}, Intersecting, {0, m});
  ExpectNoMeeting({{0, 0}, {1, 1}, {0, Up(m)}, {0, Up(m)}}, Disjoint);
  ExpectNoMeeting({{0, Up(m)}, {0, Up(m)}, {0, 0}, {1, 1}}, Disjoint);
}

using Whole = std::array<std::int64_t, 2>;

/// Twice the signed area, in whole numbers.
std::int64_t Turn(Whole const& a, Whole const& b, Whole const& c) {
  return (b[0] - a[0]) * (c[1] - a[1]) - (b[1] - a[1]) * (c[0] - a[0]);
}

bool Opposite(std::int64_t a, std::int64_t b) { return (a >= 0 && b <= 0) || (a <= 0 && b >= 0); }

bool BoxesMeet(Whole const& a, Whole const& b, Whole const& c, Whole const& d) {
  for (std::size_t k : {0U, 1U}) {
    if (std::max(a[k], b[k]) < std::min(c[k], d[k])) return false;
    if (std::max(c[k], d[k]) < std::min(a[k], b[k])) return false;
  }
  return true;
}

bool OnSegment(Whole const& p, Whole const& a, Whole const& b) {
  return Turn(a, b, p) == 0 && BoxesMeet(p, p, a, b);
}

struct WholeMeeting {
  SegmentsRelPosition relation = Disjoint;
  double x = kSentinel;
  double y = kSentinel;
};

WholeMeeting At(SegmentsRelPosition relation, Whole const& p) {
  return {relation, static_cast<double>(p[0]), static_cast<double>(p[1])};
}

/// Exact answer for whole coordinates: orientation tests decide, not parameters along the segments.
WholeMeeting MeetWhole(Whole const& a, Whole const& b, Whole const& c, Whole const& d) {
  std::int64_t const dx1 = b[0] - a[0];
  std::int64_t const dy1 = b[1] - a[1];
  std::int64_t const dx2 = d[0] - c[0];
  std::int64_t const dy2 = d[1] - c[1];
  std::int64_t const cross = dx1 * dy2 - dy1 * dx2;
  if (!BoxesMeet(a, b, c, d)) return {};
  if (cross != 0) {
    if (!Opposite(Turn(a, b, c), Turn(a, b, d)) || !Opposite(Turn(c, d, a), Turn(c, d, b))) {
      return {};
    }
    std::int64_t const numerator = (c[0] - a[0]) * dy2 - (c[1] - a[1]) * dx2;
    double const t = static_cast<double>(numerator) / static_cast<double>(cross);
    return {Intersecting, static_cast<double>(a[0]) + t * static_cast<double>(dx1),
            static_cast<double>(a[1]) + t * static_cast<double>(dy1)};
  }
  if (a == b) {
    if (OnSegment(a, c, d)) return At(Intersecting, a);
    return {};
  }
  if (c == d) {
    if (OnSegment(c, a, b)) return At(Intersecting, c);
    return {};
  }
  // Raw constants of the two lines, not normalised.
  if (a[0] * b[1] - a[1] * b[0] != c[0] * d[1] - c[1] * d[0])
    return {Parallel, kSentinel, kSentinel};
  std::array<std::int64_t, 2> sum{};
  for (std::size_t k : {0U, 1U}) {
    sum[k] = std::max(std::min(a[k], b[k]), std::min(c[k], d[k])) +
             std::min(std::max(a[k], b[k]), std::max(c[k], d[k]));
  }
  return {Collinear, static_cast<double>(sum[0]) / 2.0, static_cast<double>(sum[1]) / 2.0};
}

Point AsPoint(Whole const& p) { return {static_cast<double>(p[0]), static_cast<double>(p[1])}; }

void CheckWhole(Whole const& a, Whole const& b, Whole const& c, Whole const& d) {
  WholeMeeting const exact = MeetWhole(a, b, c, d);
  Segments const segments{AsPoint(a), AsPoint(b), AsPoint(c), AsPoint(d)};
  Meeting const meeting = Meet(segments);
  ASSERT_EQ(meeting.relation, exact.relation) << segments;
  std::int64_t const cross = (b[0] - a[0]) * (d[1] - c[1]) - (b[1] - a[1]) * (d[0] - c[0]);
  ASSERT_EQ(DoMeet(segments), exact.relation == Intersecting && cross != 0) << segments;
  if (exact.relation == Disjoint || exact.relation == Parallel) {
    ASSERT_TRUE(SameBits(meeting.point, kPointSentinel)) << segments;
    return;
  }
  ASSERT_NEAR(meeting.point.x, exact.x, 1e-14) << segments;
  ASSERT_NEAR(meeting.point.y, exact.y, 1e-14) << segments;
}

TEST(GetLineSegmentsIntersection, AgreesWithExactArithmeticOnEveryPairOfAGrid) {
  // All pairs of segments, points included, on a 5 x 5 grid that holds the origin off-centre.
  auto const grid = [](int code) { return Whole{code % 5 - 1, code / 5 - 2}; };
  for (int a = 0; a < 25; ++a) {
    for (int b = 0; b < 25; ++b) {
      for (int c = 0; c < 25; ++c) {
        for (int d = 0; d < 25; ++d) {
          CheckWhole(grid(a), grid(b), grid(c), grid(d));
          if (HasFatalFailure()) return;
        }
      }
    }
  }
}

TEST(GetLineSegmentsIntersection, AgreesWithExactArithmeticOnLargeWholeNumbers) {
  constexpr std::uint64_t kSeed = 2103;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int meetings = 0;
  for (int i = 0; i < 20000; ++i) {
    // Products stay below 2^53, so every decision of the floating-point code is exact too. One
    // end in three is put onto the other segment.
    constexpr std::int32_t kReach = 1 << 24;
    auto const draw = [&random] {
      return Whole{random.Integer(-kReach, kReach), random.Integer(-kReach, kReach)};
    };
    Whole const a = draw();
    Whole const direction{random.Integer(-1000, 1000), random.Integer(-1000, 1000)};
    std::int64_t const steps = random.Integer(1, 5000);
    Whole const b{a[0] + steps * direction[0], a[1] + steps * direction[1]};
    std::int64_t const at = random.Integer(-5, 5005);
    Whole c = draw();
    if (i % 3 == 0) c = {a[0] + at * direction[0], a[1] + at * direction[1]};
    Whole const d = draw();
    WholeMeeting const exact = MeetWhole(a, b, c, d);
    Segments const segments{AsPoint(a), AsPoint(b), AsPoint(c), AsPoint(d)};
    ASSERT_EQ(Meet(segments).relation, exact.relation) << segments;
    ASSERT_EQ(DoMeet(segments), exact.relation == Intersecting) << segments;
    meetings += exact.relation == Intersecting ? 1 : 0;
  }
  EXPECT_GT(meetings, 3000);
}

void ExpectLikeReference(Segments const& s) {
  Meeting expected;
  expected.relation = Reference::MeetSegments(s.p1, s.p2, s.p3, s.p4, &expected.point);
  Meeting const meeting = Meet(s);
  ASSERT_EQ(meeting.relation, expected.relation) << s;
  ASSERT_TRUE(SameBits(meeting.point, expected.point)) << s;
}

TEST(GetLineSegmentsIntersection, FollowsTheReferenceBitForBit) {
  constexpr std::uint64_t kSeed = 2104;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  std::array<int, 4> seen{};
  for (int i = 0; i < 40000; ++i) {
    Segments s{random.PointIn(-1, 1), random.PointIn(-1, 1), random.PointIn(-1, 1),
               random.PointIn(-1, 1)};
    // Every second pair is nearly or exactly on one line.
    if (i % 2 == 0) {
      double const t = random.Uniform(-1.0, 2.0);
      s.p3 = {s.p1.x + t * (s.p2.x - s.p1.x), s.p1.y + t * (s.p2.y - s.p1.y)};
    }
    if (i % 4 == 0) {
      double const t = random.Uniform(-1.0, 2.0);
      s.p4 = {s.p1.x + t * (s.p2.x - s.p1.x), s.p1.y + t * (s.p2.y - s.p1.y)};
    }
    if (i % 8 == 0) s.p1 = {0.0, 0.0};
    ExpectLikeReference(s);
    if (HasFatalFailure()) return;
    ++seen[static_cast<std::size_t>(static_cast<int>(Meet(s).relation) + 1)];
  }
  EXPECT_GT(seen[0], 1000);
  EXPECT_GT(seen[1], 100);
  EXPECT_GT(seen[3], 1000);
}

TEST(GetLineSegmentsIntersection, FollowsTheReferenceNextToTheSmallestNormal) {
  constexpr std::uint64_t kSeed = 2105;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  auto const coordinate = [&random] {
    double const unit = random.Flip() ? kSmallestNormal * 0.25 : 0.5;
    return unit * random.Integer(-3, 3);
  };
  for (int i = 0; i < 60000; ++i) {
    Segments s;
    for (Point* p : {&s.p1, &s.p2, &s.p3, &s.p4}) {
      p->x = coordinate();
      p->y = coordinate();
    }
    ExpectLikeReference(s);
    if (HasFatalFailure()) return;
  }
}

TEST(GetLineSegmentsIntersection, FollowsTheReferenceOnNotANumberAndInfinity) {
  constexpr std::uint64_t kSeed = 2106;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  std::array<double, 6> const values{kNaN, kInf, -kInf, 0.0, 1.0, -0.0};
  auto const coordinate = [&] { return values[static_cast<std::size_t>(random.Integer(0, 5))]; };
  for (int i = 0; i < 20000; ++i) {
    Segments s;
    for (Point* p : {&s.p1, &s.p2, &s.p3, &s.p4}) {
      p->x = coordinate();
      p->y = coordinate();
    }
    ExpectLikeReference(s);
    if (HasFatalFailure()) return;
  }
}

TEST(GetLineSegmentsIntersection, QuarterTurnTurnsThePointAndPowersOfTwoScaleIt) {
  constexpr std::uint64_t kSeed = 2107;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 5000; ++i) {
    Segments const s{random.PointIn(-1, 1), random.PointIn(-1, 1), random.PointIn(-1, 1),
                     random.PointIn(-1, 1)};
    Meeting const plain = Meet(s);
    Meeting const turned =
        Meet({QuarterTurn(s.p1), QuarterTurn(s.p2), QuarterTurn(s.p3), QuarterTurn(s.p4)});
    Meeting const scaled =
        Meet({Scale(s.p1, 0x1p30), Scale(s.p2, 0x1p30), Scale(s.p3, 0x1p30), Scale(s.p4, 0x1p30)});
    ASSERT_EQ(turned.relation, plain.relation) << s;
    ASSERT_EQ(scaled.relation, plain.relation) << s;
    if (plain.relation != Intersecting) continue;
    ASSERT_EQ(turned.point.x, -plain.point.y) << s;
    ASSERT_EQ(turned.point.y, plain.point.x) << s;
    ASSERT_EQ(scaled.point.x, plain.point.x * 0x1p30) << s;
    ASSERT_EQ(scaled.point.y, plain.point.y * 0x1p30) << s;
  }
}

// --- AreLineSegmentsIntersect -------------------------------------------------------------------

TEST(AreLineSegmentsIntersect, CountsCrossingsAndTouchingEnds) {
  EXPECT_TRUE(DoMeet({{0, 0}, {2, 2}, {0, 2}, {2, 0}}));
  EXPECT_TRUE(DoMeet({{0, 0}, {1, 0}, {1, 0}, {2, 5}}));
  EXPECT_TRUE(DoMeet({{0, 0}, {4, 0}, {1, 0}, {2, 5}}));
  EXPECT_FALSE(DoMeet({{0, 0}, {1, 1}, {0, 4}, {4, 0}}));
}

TEST(AreLineSegmentsIntersect, NeverCountsCollinearOverlapsOrPoints) {
  EXPECT_FALSE(DoMeet({{0, 0}, {2, 0}, {1, 0}, {3, 0}}));
  EXPECT_FALSE(DoMeet({{0, 0}, {1, 1}, {1, 1}, {3, 3}}));
  EXPECT_FALSE(DoMeet({{1, 1}, {1, 1}, {0, 0}, {2, 2}}));
  EXPECT_FALSE(DoMeet({{1, 1}, {1, 1}, {1, 1}, {1, 1}}));
}

TEST(AreLineSegmentsIntersect, DeterminantUpToEpsilonCountsAsParallel) {
  auto const crossing = [](double length) {
    return Segments{{0, 0}, {1, 0}, {0.5, length}, {0.5, 0}};
  };
  for (double const length : {kEpsilon, Down(kEpsilon), -kEpsilon}) {
    EXPECT_FALSE(DoMeet(crossing(length))) << length;
    EXPECT_EQ(Meet(crossing(length)).relation, Intersecting) << length;
  }
  EXPECT_TRUE(DoMeet(crossing(Up(kEpsilon))));
  EXPECT_TRUE(DoMeet(crossing(-Up(kEpsilon))));
}

TEST(AreLineSegmentsIntersect, NotANumberNeverIntersects) {
  for (int i = 0; i < 8; ++i) {
    std::array<double, 8> v{0, 0, 2, 2, 0, 2, 2, 0};
    v[static_cast<std::size_t>(i)] = kNaN;
    EXPECT_FALSE(DoMeet({{v[0], v[1]}, {v[2], v[3]}, {v[4], v[5]}, {v[6], v[7]}})) << i;
  }
}

TEST(AreLineSegmentsIntersect, AgreesWithThePointFormAboveEpsilon) {
  constexpr std::uint64_t kSeed = 2108;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int crossings = 0;
  for (int i = 0; i < 10000; ++i) {
    Segments const s{random.PointIn(-1, 1), random.PointIn(-1, 1), random.PointIn(-1, 1),
                     random.PointIn(-1, 1)};
    double const d = (s.p2.y - s.p1.y) * (s.p3.x - s.p4.x) - (s.p3.y - s.p4.y) * (s.p2.x - s.p1.x);
    if (std::fabs(d) <= kEpsilon) continue;
    ASSERT_EQ(DoMeet(s), Meet(s).relation == Intersecting) << s;
    crossings += DoMeet(s) ? 1 : 0;
  }
  EXPECT_GT(crossings, 1000);
}

// --- MathUtils::GetLinesIntersection of lines in slope form -------------------------------------

struct SlopeHit {
  bool ok = false;
  double x = kSentinel;
  double y = kSentinel;
};

SlopeHit MeetSlopes(double k1, double m1, double k2, double m2) {
  SlopeHit hit;
  hit.ok = MathUtils::GetLinesIntersection(k1, m1, k2, m2, hit.x, hit.y);
  return hit;
}

void ExpectUntouched(SlopeHit const& hit) {
  EXPECT_FALSE(hit.ok);
  EXPECT_SAME_BITS(hit.x, kSentinel);
  EXPECT_SAME_BITS(hit.y, kSentinel);
}

TEST(GetLinesIntersectionOfSlopes, FindsTheCommonPoint) {
  SlopeHit const hit = MeetSlopes(1.0, 0.0, -1.0, 2.0);
  EXPECT_TRUE(hit.ok);
  EXPECT_SAME_BITS(hit.x, 1.0);
  EXPECT_SAME_BITS(hit.y, 1.0);
}

TEST(GetLinesIntersectionOfSlopes, TakesYFromTheFirstLine) {
  constexpr std::uint64_t kSeed = 2109;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int differ = 0;
  for (int i = 0; i < 2000; ++i) {
    double const k1 = random.Uniform(-5, 5);
    double const m1 = random.Uniform(-5, 5);
    double const k2 = random.Uniform(-5, 5);
    double const m2 = random.Uniform(-5, 5);
    SlopeHit const hit = MeetSlopes(k1, m1, k2, m2);
    double const x = (m2 - m1) / (k1 - k2);
    double const rise = k1 * x;
    ASSERT_TRUE(hit.ok);
    ASSERT_EQ(hit.x, x);
    ASSERT_EQ(hit.y, rise + m1);
    double const otherRise = k2 * x;
    differ += hit.y != otherRise + m2 ? 1 : 0;
  }
  EXPECT_GT(differ, 100);
}

TEST(GetLinesIntersectionOfSlopes, SlopesUpToEpsilonApartAreParallel) {
  ExpectUntouched(MeetSlopes(1.0, 0.0, 1.0, 0.0));
  ExpectUntouched(MeetSlopes(kEpsilon, 0.0, 0.0, 1.0));
  ExpectUntouched(MeetSlopes(-kEpsilon, 0.0, 0.0, 1.0));
  EXPECT_TRUE(MeetSlopes(Up(kEpsilon), 0.0, 0.0, 1.0).ok);
  EXPECT_TRUE(MeetSlopes(-Up(kEpsilon), 0.0, 0.0, 1.0).ok);
  ExpectUntouched(MeetSlopes(1.0 + kEpsilon, 0.0, 1.0, 1.0));
  EXPECT_TRUE(MeetSlopes(1.0 + 2.0 * kEpsilon, 0.0, 1.0, 1.0).ok);
}

TEST(GetLinesIntersectionOfSlopes, ResidualOfOneHalfIsTheLimit) {
  // Steep, nearly parallel lines: the rises differ by whole units of rounding.
  constexpr std::uint64_t kSeed = 2110;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int accepted = 0;
  int rejected = 0;
  int exactlyOneHalf = 0;
  for (int i = 0; i < 20000; ++i) {
    double const k1 = std::ldexp(1.0 + random.Unit(), random.Integer(42, 51));
    double const k2 = k1 + random.Integer(1, 100);
    double const m1 = random.Integer(-200, 200) * 0.25;
    double const m2 = random.Integer(-200, 200) * 0.25;
    double const x = (m2 - m1) / (k1 - k2);
    double const rise1 = k1 * x;
    double const rise2 = k2 * x;
    double const residual = std::fabs((rise2 + m2) - (rise1 + m1));
    SlopeHit const hit = MeetSlopes(k1, m1, k2, m2);
    ASSERT_EQ(hit.ok, residual <= 0.5) << residual;
    accepted += hit.ok && residual > 0.0 ? 1 : 0;
    exactlyOneHalf += residual == 0.5 ? 1 : 0;
    if (hit.ok) continue;
    ++rejected;
    ASSERT_EQ(Bits(hit.x), Bits(kSentinel));
    ASSERT_EQ(Bits(hit.y), Bits(kSentinel));
  }
  EXPECT_GT(accepted, 100);
  EXPECT_GT(rejected, 100);
  EXPECT_GT(exactlyOneHalf, 100);
}

TEST(GetLinesIntersectionOfSlopes, NotANumberIsNotRejected) {
  SlopeHit const hit = MeetSlopes(kNaN, 0.0, 1.0, 1.0);
  EXPECT_TRUE(hit.ok);
  EXPECT_TRUE(std::isnan(hit.x));
  EXPECT_TRUE(std::isnan(hit.y));
}

// --- GetNearestPointOnLine ----------------------------------------------------------------------

struct Foot {
  bool ok = false;
  Point point = kPointSentinel;
};

Foot FootOn(double a, double b, double c, Point const& p) {
  Foot foot;
  foot.ok = GeometryUtils::GetNearestPointOnLine(a, b, c, p, &foot.point);
  return foot;
}

TEST(GetNearestPointOnLine, IsTheFootOfThePerpendicular) {
  Foot const foot = FootOn(1.0, 1.0, -2.0, {3.0, 3.0});
  EXPECT_TRUE(foot.ok);
  EXPECT_EQ(foot.point.x, 1.0);
  EXPECT_EQ(foot.point.y, 1.0);
  Foot const onLine = FootOn(0.0, 2.0, -6.0, {5.0, 3.0});
  EXPECT_EQ(onLine.point.x, 5.0);
  EXPECT_EQ(onLine.point.y, 3.0);
}

TEST(GetNearestPointOnLine, ANormalWhoseSquareIsBelowTheSmallestNormalFails) {
  EXPECT_TRUE(FootOn(0x1p-511, 0.0, 0.0, {3.0, 4.0}).ok);
  for (Foot const& foot :
       {FootOn(Down(0x1p-511), 0.0, 0.0, {3.0, 4.0}), FootOn(0.0, Down(0x1p-511), 0.0, {3.0, 4.0}),
        FootOn(0.0, 0.0, 1.0, {3.0, 4.0}), FootOn(1e-200, 1e-200, 1.0, {3.0, 4.0})}) {
    EXPECT_FALSE(foot.ok);
    EXPECT_SAME_POINT(foot.point, kPointSentinel);
  }
}

TEST(GetNearestPointOnLine, FollowsNormalAndIntersectionBitForBit) {
  constexpr std::uint64_t kSeed = 2111;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 3000; ++i) {
    Reference::Line const line{random.Uniform(-5, 5), random.Uniform(-5, 5), random.Uniform(-5, 5)};
    Point const p = random.PointIn(-10.0, 10.0);
    Point expected = kPointSentinel;
    ASSERT_TRUE(Reference::MeetingPoint(line, Reference::NormalAt(line, p), &expected));
    Foot const foot = FootOn(line.a, line.b, line.c, p);
    ASSERT_TRUE(foot.ok);
    ASSERT_TRUE(SameBits(foot.point, expected));
    // Independent of the determinant route: projection along the normal, in long double.
    long double const a = Extended(line.a);
    long double const b = Extended(line.b);
    long double const norm2 = a * a + b * b;
    if (norm2 < 1.0L) continue;
    long double const form = a * Extended(p.x) + b * Extended(p.y) + Extended(line.c);
    long double const off = form / norm2;
    ASSERT_NEAR(foot.point.x, static_cast<double>(Extended(p.x) - off * a), 1e-12);
    ASSERT_NEAR(foot.point.y, static_cast<double>(Extended(p.y) - off * b), 1e-12);
  }
}

}  // namespace
}  // namespace Vorn::Testing
