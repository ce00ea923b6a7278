#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <limits>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "support/ReferencePrimitives.h"
#include "support/ReferenceTriangles.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;

constexpr double kSmallestNormal = 2.2250738585072014e-308;
constexpr double kDenormMin = std::numeric_limits<double>::denorm_min();

struct ExactCircle {
  long double x = 0.0L;
  long double y = 0.0L;
  long double r = 0.0L;
};

/// Circumcircle by the determinant formula about the first point, in long double: a route with no
/// linear system in it.
ExactCircle Circumcircle(Point const& a, Point const& b, Point const& c) {
  long double const bx = Extended(b.x) - Extended(a.x);
  long double const by = Extended(b.y) - Extended(a.y);
  long double const cx = Extended(c.x) - Extended(a.x);
  long double const cy = Extended(c.y) - Extended(a.y);
  long double const d = 2.0L * (bx * cy - by * cx);
  long double const b2 = bx * bx + by * by;
  long double const c2 = cx * cx + cy * cy;
  long double const ux = (cy * b2 - by * c2) / d;
  long double const uy = (bx * c2 - cx * b2) / d;
  return {ux + Extended(a.x), uy + Extended(a.y), std::sqrt(ux * ux + uy * uy)};
}

/// Far enough from a straight line for a tight comparison with the long double circle.
bool IsWellShaped(Point const& a, Point const& b, Point const& c) {
  double const cross = (b.x - a.x) * (c.y - a.y) - (b.y - a.y) * (c.x - a.x);
  return std::fabs(cross) > 5.0;
}

// --- GetCircle of six coordinates ---------------------------------------------------------------

struct CoordCircle {
  ErrorCode code = ErrorCode::Ok;
  double cx = kSentinel;
  double cy = kSentinel;
  double r = kSentinel;
};

CoordCircle CircleOfCoords(Point const& a, Point const& b, Point const& c) {
  CoordCircle circle;
  circle.code =
      GeometryUtils::GetCircle(a.x, a.y, b.x, b.y, c.x, c.y, &circle.cx, &circle.cy, &circle.r);
  return circle;
}

TEST(GetCircleOfCoords, FindsTheCircleThroughThreePoints) {
  CoordCircle const unit = CircleOfCoords({1.0, 0.0}, {0.0, 1.0}, {-1.0, 0.0});
  EXPECT_EQ(unit.code, ErrorCode::Ok);
  EXPECT_EQ(unit.cx, 0.0);
  EXPECT_EQ(unit.cy, 0.0);
  EXPECT_EQ(unit.r, 1.0);
  CoordCircle const shifted = CircleOfCoords({7.0, -3.0}, {6.0, 0.0}, {2.0, 2.0});
  EXPECT_EQ(shifted.code, ErrorCode::Ok);
  EXPECT_EQ(shifted.cx, 2.0);
  EXPECT_EQ(shifted.cy, -3.0);
  EXPECT_EQ(shifted.r, 5.0);
}

TEST(GetCircleOfCoords, PointsOnOneVerticalLineFailAndWriteNothing) {
  CoordCircle const circle = CircleOfCoords({2.0, 0.0}, {2.0, 1.0}, {2.0, 5.0});
  EXPECT_EQ(circle.code, ErrorCode::Failed);
  EXPECT_SAME_BITS(circle.cx, kSentinel);
  EXPECT_SAME_BITS(circle.cy, kSentinel);
  EXPECT_SAME_BITS(circle.r, kSentinel);
  EXPECT_EQ(CircleOfCoords({2.0, 1.0}, {2.0, 1.0}, {2.0, 1.0}).code, ErrorCode::Failed);
}

TEST(GetCircleOfCoords, AHairOffTheVerticalLineIsAccepted) {
  EXPECT_EQ(CircleOfCoords({Up(2.0), 0.0}, {2.0, 1.0}, {2.0, 5.0}).code, ErrorCode::Ok);
  EXPECT_EQ(CircleOfCoords({2.0, 0.0}, {Up(2.0), 1.0}, {2.0, 5.0}).code, ErrorCode::Ok);
  EXPECT_EQ(CircleOfCoords({2.0, 0.0}, {2.0, 1.0}, {Up(2.0), 5.0}).code, ErrorCode::Ok);
}

TEST(GetCircleOfCoords, PointsOnASlantedLineGiveAnInfiniteCircle) {
  CoordCircle const circle = CircleOfCoords({0.0, 0.0}, {1.0, 1.0}, {2.0, 2.0});
  EXPECT_EQ(circle.code, ErrorCode::Ok);
  EXPECT_FALSE(std::isfinite(circle.cx));
  EXPECT_FALSE(std::isfinite(circle.cy));
  EXPECT_FALSE(std::isfinite(circle.r));
}

TEST(GetCircleOfCoords, PointsOnAHorizontalLineGiveANonFiniteCircle) {
  CoordCircle const circle = CircleOfCoords({0.0, 3.0}, {1.0, 3.0}, {2.0, 3.0});
  EXPECT_EQ(circle.code, ErrorCode::Ok);
  EXPECT_FALSE(std::isfinite(circle.cx));
  EXPECT_FALSE(std::isfinite(circle.cy));
  EXPECT_FALSE(std::isfinite(circle.r));
}

TEST(GetCircleOfCoords, TwoEqualPointsAreNotRejected) {
  EXPECT_EQ(CircleOfCoords({0.0, 0.0}, {0.0, 0.0}, {1.0, 2.0}).code, ErrorCode::Ok);
  EXPECT_FALSE(std::isfinite(CircleOfCoords({0.0, 0.0}, {0.0, 0.0}, {1.0, 2.0}).cy));
}

TEST(GetCircleOfCoords, PairsNeighboursAndMeasuresTheRadiusAtTheFirstPoint) {
  constexpr std::uint64_t kSeed = 1301;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 3000; ++i) {
    Point const a = random.PointIn(-10.0, 10.0);
    Point const b = random.PointIn(-10.0, 10.0);
    Point const c = random.PointIn(-10.0, 10.0);
    std::array<double, 2> center{};
    ASSERT_TRUE((Reference::Solve<2>(
        {{{2.0 * (a.x - b.x), 2.0 * (a.y - b.y)}, {2.0 * (b.x - c.x), 2.0 * (b.y - c.y)}}},
        {(a.x + b.x) * (a.x - b.x) + (a.y + b.y) * (a.y - b.y),
         (b.x + c.x) * (b.x - c.x) + (b.y + c.y) * (b.y - c.y)},
        &center)));
    CoordCircle const circle = CircleOfCoords(a, b, c);
    ASSERT_EQ(circle.code, ErrorCode::Ok);
    ASSERT_EQ(Bits(circle.cx), Bits(center[0]));
    ASSERT_EQ(Bits(circle.cy), Bits(center[1]));
    ASSERT_EQ(Bits(circle.r), Bits(Reference::Distance(a, {center[0], center[1]})));
    if (!IsWellShaped(a, b, c)) continue;
    ExactCircle const exact = Circumcircle(a, b, c);
    ASSERT_NEAR(circle.cx, static_cast<double>(exact.x), 1e-9);
    ASSERT_NEAR(circle.cy, static_cast<double>(exact.y), 1e-9);
    ASSERT_NEAR(circle.r, static_cast<double>(exact.r), 1e-9);
  }
}

TEST(GetCircleOfCoords, NotANumberIsNotRejected) {
  for (std::size_t i = 0; i < 6; ++i) {
    std::array<double, 6> v{1.0, 0.0, 0.0, 1.0, -1.0, 0.5};
    v[i] = kNaN;
    CoordCircle const circle = CircleOfCoords({v[0], v[1]}, {v[2], v[3]}, {v[4], v[5]});
    EXPECT_EQ(circle.code, ErrorCode::Ok) << i;
    EXPECT_TRUE(std::isnan(circle.r)) << i;
  }
}

// --- GetCircle of three points ------------------------------------------------------------------

struct PointCircle {
  bool ok = false;
  Point center = kPointSentinel;
  double radius = kSentinel;
};

PointCircle CircleOfPoints(Point const& a, Point const& b, Point const& c) {
  PointCircle circle;
  circle.ok = GeometryUtils::GetCircle(a, b, c, &circle.center, &circle.radius);
  return circle;
}

TEST(GetCircleOfPoints, FindsTheCircleThroughThreePoints) {
  PointCircle const circle = CircleOfPoints({7.0, -3.0}, {6.0, 0.0}, {2.0, 2.0});
  EXPECT_TRUE(circle.ok);
  EXPECT_EQ(circle.center.x, 2.0);
  EXPECT_EQ(circle.center.y, -3.0);
  EXPECT_EQ(circle.radius, 5.0);
}

TEST(GetCircleOfPoints, PointsOnOneVerticalLineFailAndWriteNothing) {
  PointCircle const circle = CircleOfPoints({2.0, 0.0}, {2.0, 1.0}, {2.0, 5.0});
  EXPECT_FALSE(circle.ok);
  EXPECT_SAME_POINT(circle.center, kPointSentinel);
  EXPECT_SAME_BITS(circle.radius, kSentinel);
}

TEST(GetCircleOfPoints, PointsOnASlantedLineGiveAnInfiniteCircle) {
  PointCircle const circle = CircleOfPoints({0.0, 0.0}, {1.0, 1.0}, {2.0, 2.0});
  EXPECT_TRUE(circle.ok);
  EXPECT_FALSE(std::isfinite(circle.radius));
}

TEST(GetCircleOfPoints, PairsTheFirstPointWithBothOthersAndAveragesTheDistances) {
  constexpr std::uint64_t kSeed = 1302;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int differsFromCoords = 0;
  for (int i = 0; i < 3000; ++i) {
    Point const a = random.PointIn(-10.0, 10.0);
    Point const b = random.PointIn(-10.0, 10.0);
    Point const c = random.PointIn(-10.0, 10.0);
    std::array<double, 2> center{};
    ASSERT_TRUE((Reference::Solve<2>(
        {{{2.0 * (a.x - b.x), 2.0 * (a.y - b.y)}, {2.0 * (a.x - c.x), 2.0 * (a.y - c.y)}}},
        {(b.x + a.x) * (a.x - b.x) + (b.y + a.y) * (a.y - b.y),
         (c.x + a.x) * (a.x - c.x) + (c.y + a.y) * (a.y - c.y)},
        &center)));
    Point const m{center[0], center[1]};
    double const sum =
        Reference::Distance(a, m) + Reference::Distance(b, m) + Reference::Distance(c, m);
    PointCircle const circle = CircleOfPoints(a, b, c);
    ASSERT_TRUE(circle.ok);
    ASSERT_TRUE(SameBits(circle.center, m));
    ASSERT_EQ(Bits(circle.radius), Bits(sum / 3.0));
    differsFromCoords += Bits(CircleOfCoords(a, b, c).cx) != Bits(m.x) ? 1 : 0;
    if (!IsWellShaped(a, b, c)) continue;
    ExactCircle const exact = Circumcircle(a, b, c);
    ASSERT_NEAR(circle.center.x, static_cast<double>(exact.x), 1e-9);
    ASSERT_NEAR(circle.center.y, static_cast<double>(exact.y), 1e-9);
    ASSERT_NEAR(circle.radius, static_cast<double>(exact.r), 1e-9);
  }
  EXPECT_GT(differsFromCoords, 100) << "the two forms must not share one system";
}

TEST(GetCircleOfPoints, ScalesExactlyByPowersOfTwo) {
  constexpr std::uint64_t kSeed = 1303;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 1000; ++i) {
    Point const a = random.PointIn(-10.0, 10.0);
    Point const b = random.PointIn(-10.0, 10.0);
    Point const c = random.PointIn(-10.0, 10.0);
    PointCircle const plain = CircleOfPoints(a, b, c);
    PointCircle const scaled = CircleOfPoints(Scale(a, 0x1p12), Scale(b, 0x1p12), Scale(c, 0x1p12));
    ASSERT_TRUE(SameBits(scaled.center, Scale(plain.center, 0x1p12)));
    ASSERT_EQ(scaled.radius, plain.radius * 0x1p12);
  }
}

// --- IsCcw ------------------------------------------------------------------------------------

struct Sense {
  ErrorCode code = ErrorCode::OutOfMemory;
  bool ccw = false;
};

Sense SenseOf(Point const& a, Point const& b, Point const& c, bool preset) {
  Sense sense;
  sense.ccw = preset;
  sense.code = GeometryUtils::IsCcw(a, b, c, &sense.ccw);
  return sense;
}

TEST(IsCcw, TurnsCounterClockwiseWithTheYAxisUp) {
  Sense const left = SenseOf({0.0, 0.0}, {1.0, 0.0}, {0.0, 1.0}, false);
  EXPECT_EQ(left.code, ErrorCode::Ok);
  EXPECT_TRUE(left.ccw);
  Sense const right = SenseOf({0.0, 0.0}, {0.0, 1.0}, {1.0, 0.0}, true);
  EXPECT_EQ(right.code, ErrorCode::Ok);
  EXPECT_FALSE(right.ccw);
}

TEST(IsCcw, CollinearPointsFailAndLeaveTheSenseUntouched) {
  for (bool const preset : {false, true}) {
    Sense const sense = SenseOf({0.0, 0.0}, {1.0, 1.0}, {3.0, 3.0}, preset);
    EXPECT_EQ(sense.code, ErrorCode::Failed);
    EXPECT_EQ(sense.ccw, preset);
    EXPECT_EQ(SenseOf({1.0, 2.0}, {1.0, 2.0}, {4.0, 7.0}, preset).code, ErrorCode::Failed);
  }
}

TEST(IsCcw, HasNoToleranceButThatOfUnderflow) {
  Sense const hair = SenseOf({0.0, 0.0}, {1.0, 0.0}, {2.0, 1e-300}, false);
  EXPECT_EQ(hair.code, ErrorCode::Ok);
  EXPECT_TRUE(hair.ccw);
  // Halving the smallest subnormal rounds to zero.
  EXPECT_EQ(SenseOf({0.0, 0.0}, {1.0, 0.0}, {2.0, kDenormMin}, false).code, ErrorCode::Failed);
  EXPECT_EQ(SenseOf({0.0, 0.0}, {1.0, 0.0}, {2.0, 2.0 * kDenormMin}, false).code, ErrorCode::Ok);
  EXPECT_EQ(SenseOf({0.0, 0.0}, {1e-170, 0.0}, {0.0, 1e-170}, false).code, ErrorCode::Failed);
}

TEST(IsCcw, NotANumberIsClockwise) {
  Sense const sense = SenseOf({0.0, 0.0}, {kNaN, 0.0}, {0.0, 1.0}, true);
  EXPECT_EQ(sense.code, ErrorCode::Ok);
  EXPECT_FALSE(sense.ccw);
}

TEST(IsCcw, AgreesWithWholeNumbersOnEveryTripleOfASmallGrid) {
  for (int code = 0; code < 729 * 729; code += 7) {
    int rest = code;
    std::array<int, 6> v{};
    for (int& coordinate : v) {
      coordinate = rest % 9 - 4;
      rest /= 9;
    }
    int const cross = (v[2] - v[0]) * (v[5] - v[1]) - (v[3] - v[1]) * (v[4] - v[0]);
    Sense const sense = SenseOf({static_cast<double>(v[0]), static_cast<double>(v[1])},
                                {static_cast<double>(v[2]), static_cast<double>(v[3])},
                                {static_cast<double>(v[4]), static_cast<double>(v[5])}, cross <= 0);
    ASSERT_EQ(sense.code, cross == 0 ? ErrorCode::Failed : ErrorCode::Ok) << code;
    ASSERT_EQ(sense.ccw, cross >= 0) << code;
  }
}

TEST(IsCcw, FollowsTheSignOfTheNegatedShoelaceSum) {
  constexpr std::uint64_t kSeed = 1304;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int collinear = 0;
  for (int i = 0; i < 5000; ++i) {
    Point const a = random.PointIn(-1.0, 1.0);
    Point const b = random.PointIn(-1.0, 1.0);
    double const t = random.Uniform(-1.0, 2.0);
    Point const c{a.x + t * (b.x - a.x), a.y + t * (b.y - a.y)};
    double const area = Reference::Area({{a, b, c}});
    Sense const sense = SenseOf(a, b, c, false);
    collinear += area == 0.0 ? 1 : 0;
    ASSERT_EQ(sense.code, area == 0.0 ? ErrorCode::Failed : ErrorCode::Ok);
    ASSERT_EQ(sense.ccw, area < 0.0);
  }
  EXPECT_GT(collinear, 100);
}

// --- GetCircle of three measured points ---------------------------------------------------------

struct ShiftedCircle {
  bool ok = false;
  WPoint circle{kSentinel, kSentinel, kSentinel};
  Point pa = kPointSentinel;
  Point pb = kPointSentinel;
  Point pc = kPointSentinel;
  bool ccw = false;
};

ShiftedCircle ShiftedCircleOf(WPoint const& a, WPoint const& b, WPoint const& c,
                              ShiftedCircle preset = {}) {
  preset.ok = GeometryUtils::GetCircle(a, b, c, &preset.circle, &preset.pa, &preset.pb, &preset.pc,
                                       &preset.ccw);
  return preset;
}

Point Bare(WPoint const& p) { return {p.x, p.y}; }

/// Outputs that hold the measured points, as a caller prepares them for equal tolerances.
ShiftedCircle Preloaded(WPoint const& a, WPoint const& b, WPoint const& c) {
  ShiftedCircle preset;
  preset.pa = Bare(a);
  preset.pb = Bare(b);
  preset.pc = Bare(c);
  return preset;
}

/// The measured point's place on the ray from the centre: farther out for w >= 0, nearer for w < 0.
/// Counts the cases in which rounding makes both places equally far.
bool Moved(Point const& center, Point const& p, double w, Point* moved, int* ties = nullptr) {
  Reference::Line line;
  if (!Reference::LineThrough(center.x, center.y, p.x, p.y, &line)) return false;
  std::vector<Point> const hits = Reference::CrossCircle(line, p, std::fabs(w));
  if (hits.size() != 2) return false;
  double const first = Reference::SquaredDistance(hits[0], center);
  double const second = Reference::SquaredDistance(hits[1], center);
  bool const takeFirst = w >= 0.0 ? first >= second : first < second;
  *moved = takeFirst ? hits[0] : hits[1];
  if (ties != nullptr && first == second) ++*ties;
  return true;
}

struct ReferenceShift {
  ShiftedCircle result;
  int flips = 0;
  int ties = 0;
};

/// The three rounds for different tolerances.
ReferenceShift ReferenceRounds(WPoint const& a, WPoint const& b, WPoint const& c) {
  ReferenceShift reference;
  std::array<Point, 3> const measured{Bare(a), Bare(b), Bare(c)};
  std::array<double, 3> w{a.w, b.w, c.w};
  std::array<Point, 3> working = measured;
  Point center;
  double radius = 0.0;
  auto const area = [](std::array<Point, 3> const& p) {
    return Reference::Area({{p[0], p[1], p[2]}});
  };
  if (!Reference::CircleThrough(working[0], working[1], working[2], &center, &radius)) {
    return reference;
  }
  if (area(measured) == 0.0) return reference;
  bool sense = area(measured) < 0.0;
  for (int round = 0; round < 3; ++round) {
    if (!Reference::CircleThrough(working[0], working[1], working[2], &center, &radius)) {
      return reference;
    }
    for (std::size_t k = 0; k < 3; ++k) {
      if (!Moved(center, measured[k], w[k], &working[k], &reference.ties)) return reference;
    }
    if (!Reference::CircleThrough(working[0], working[1], working[2], &center, &radius)) {
      return reference;
    }
    if (area(working) == 0.0) return reference;
    bool const turned = area(working) < 0.0;
    if (turned == sense) continue;
    ++reference.flips;
    for (double& tolerance : w) tolerance = -tolerance;
    sense = turned;
  }
  reference.result.ok = true;
  reference.result.circle = {center.x, center.y, radius};
  reference.result.pa = working[0];
  reference.result.pb = working[1];
  reference.result.pc = working[2];
  reference.result.ccw = area(working) < 0.0;
  return reference;
}

void ExpectSame(ShiftedCircle const& actual, ShiftedCircle const& expected) {
  EXPECT_SAME_BITS(actual.circle.x, expected.circle.x);
  EXPECT_SAME_BITS(actual.circle.y, expected.circle.y);
  EXPECT_SAME_BITS(actual.circle.w, expected.circle.w);
  EXPECT_SAME_POINT(actual.pa, expected.pa);
  EXPECT_SAME_POINT(actual.pb, expected.pb);
  EXPECT_SAME_POINT(actual.pc, expected.pc);
  EXPECT_EQ(actual.ccw, expected.ccw);
}

TEST(GetCircleOfMeasuredPoints, EqualTolerancesGrowTheCircle) {
  WPoint const a{7.0, -3.0, 0.5};
  WPoint const b{6.0, 0.0, 0.5};
  WPoint const c{2.0, 2.0, 0.5};
  ShiftedCircle const result = ShiftedCircleOf(a, b, c, Preloaded(a, b, c));
  EXPECT_TRUE(result.ok);
  EXPECT_EQ(result.circle.x, 2.0);
  EXPECT_EQ(result.circle.y, -3.0);
  EXPECT_EQ(result.circle.w, 5.5);
  EXPECT_TRUE(result.ccw);
  EXPECT_SAME_POINT(result.pa, Bare(a));
  EXPECT_SAME_POINT(result.pb, Bare(b));
  EXPECT_SAME_POINT(result.pc, Bare(c));
}

TEST(GetCircleOfMeasuredPoints, EqualNegativeTolerancesShrinkTheCircle) {
  WPoint const a{7.0, -3.0, -0.5};
  WPoint const b{6.0, 0.0, -0.5};
  WPoint const c{2.0, 2.0, -0.5};
  EXPECT_EQ(ShiftedCircleOf(a, b, c, Preloaded(a, b, c)).circle.w, 4.5);
}

TEST(GetCircleOfMeasuredPoints, EqualTolerancesTakeTheSenseFromTheCallersPoints) {
  WPoint const a{7.0, -3.0, 0.5};
  WPoint const b{6.0, 0.0, 0.5};
  WPoint const c{2.0, 2.0, 0.5};
  ShiftedCircle preset = Preloaded(c, b, a);  // the other way round
  preset.ccw = true;
  ShiftedCircle const result = ShiftedCircleOf(a, b, c, preset);
  EXPECT_TRUE(result.ok);
  EXPECT_FALSE(result.ccw);
  EXPECT_SAME_POINT(result.pa, Bare(c));
  EXPECT_SAME_POINT(result.pb, Bare(b));
  EXPECT_SAME_POINT(result.pc, Bare(a));
}

TEST(GetCircleOfMeasuredPoints, EqualTolerancesWithoutASenseFailAfterWritingTheCircle) {
  for (bool const preset : {false, true}) {
    ShiftedCircle outputs;  // three equal points: no sense
    outputs.ccw = preset;
    ShiftedCircle const result =
        ShiftedCircleOf({7.0, -3.0, 0.5}, {6.0, 0.0, 0.5}, {2.0, 2.0, 0.5}, outputs);
    EXPECT_FALSE(result.ok);
    EXPECT_EQ(result.circle.x, 2.0);
    EXPECT_EQ(result.circle.y, -3.0);
    EXPECT_EQ(result.circle.w, 5.5);
    EXPECT_EQ(result.ccw, preset);
    EXPECT_SAME_POINT(result.pa, kPointSentinel);
  }
}

TEST(GetCircleOfMeasuredPoints, TolerancesOfPointsOnOneVerticalLineFailAndWriteNothing) {
  for (double const w : {0.1, 0.3}) {
    ShiftedCircle const result = ShiftedCircleOf({2.0, 0.0, 0.1}, {2.0, 1.0, 0.1}, {2.0, 5.0, w});
    EXPECT_FALSE(result.ok);
    ExpectSame(result, {});
  }
}

TEST(GetCircleOfMeasuredPoints, DifferentTolerancesOfCollinearPointsFail) {
  EXPECT_FALSE(ShiftedCircleOf({0.0, 0.0, 0.1}, {1.0, 1.0, 0.1}, {2.0, 2.0, 0.2}).ok);
  EXPECT_FALSE(ShiftedCircleOf({0.0, 0.0, 0.1}, {1.0, 0.0, 0.1}, {2.0, 0.0, 0.2}).ok);
}

TEST(GetCircleOfMeasuredPoints, TolerancesCountAsEqualUpToTheSmallestNormal) {
  // A zero tolerance can never be moved by, so the form for different tolerances fails here.
  WPoint const a{7.0, -3.0, 0.0};
  WPoint const b{6.0, 0.0, 0.0};
  for (std::array<double, 3> const& w :
       {std::array<double, 3>{0.0, 0.0, 1.0}, {0.0, 1.0, 0.0}, {1.0, 0.0, 0.0}}) {
    for (double const sign : {1.0, -1.0}) {
      double const bound = sign * kSmallestNormal;
      WPoint p{7.0, -3.0, w[0] * bound};
      WPoint q{6.0, 0.0, w[1] * bound};
      WPoint r{2.0, 2.0, w[2] * bound};
      EXPECT_TRUE(ShiftedCircleOf(p, q, r, Preloaded(p, q, r)).ok);
      for (WPoint* point : {&p, &q, &r}) point->w *= 1.0 + 0x1p-52;
      EXPECT_FALSE(ShiftedCircleOf(p, q, r, Preloaded(p, q, r)).ok);
    }
  }
  ShiftedCircle const zero = ShiftedCircleOf(a, b, {2.0, 2.0, 0.0}, Preloaded(a, b, {2, 2, 0}));
  EXPECT_TRUE(zero.ok);
  EXPECT_EQ(zero.circle.w, 5.0);
}

TEST(GetCircleOfMeasuredPoints, AZeroToleranceAmongDifferentOnesFails) {
  EXPECT_FALSE(ShiftedCircleOf({7.0, -3.0, 0.0}, {6.0, 0.0, 0.1}, {2.0, 2.0, 0.2}).ok);
  EXPECT_FALSE(ShiftedCircleOf({7.0, -3.0, 0.1}, {6.0, 0.0, 0.0}, {2.0, 2.0, 0.2}).ok);
  EXPECT_FALSE(ShiftedCircleOf({7.0, -3.0, 0.1}, {6.0, 0.0, 0.2}, {2.0, 2.0, 0.0}).ok);
}

TEST(GetCircleOfMeasuredPoints, DifferentTolerancesMoveEachPointOutwardByItsOwn) {
  WPoint const a{10.0, 0.0, 0.1};
  WPoint const b{6.0, 8.0, 0.2};
  WPoint const c{0.0, 10.0, 0.3};
  ShiftedCircle const result = ShiftedCircleOf(a, b, c);
  ASSERT_TRUE(result.ok);
  EXPECT_TRUE(result.ccw);
  ReferenceShift const reference = ReferenceRounds(a, b, c);
  ASSERT_TRUE(reference.result.ok);
  ExpectSame(result, reference.result);
  std::array<WPoint, 3> const measured{a, b, c};
  std::array<Point, 3> const moved{result.pa, result.pb, result.pc};
  for (std::size_t k = 0; k < 3; ++k) {
    EXPECT_NEAR(Reference::Distance(Bare(measured[k]), moved[k]), measured[k].w, 1e-12);
    EXPECT_GT(std::hypot(moved[k].x, moved[k].y), 10.0);
    EXPECT_NEAR(Reference::Distance({result.circle.x, result.circle.y}, moved[k]), result.circle.w,
                1e-12);
  }
}

TEST(GetCircleOfMeasuredPoints, ANegativeToleranceMovesItsPointInward) {
  WPoint const a{10.0, 0.0, -0.1};
  WPoint const b{6.0, 8.0, 0.2};
  WPoint const c{0.0, 10.0, -0.3};
  ShiftedCircle const result = ShiftedCircleOf(a, b, c);
  ASSERT_TRUE(result.ok);
  ExpectSame(result, ReferenceRounds(a, b, c).result);
  EXPECT_LT(std::hypot(result.pa.x, result.pa.y), 10.0);
  EXPECT_GT(std::hypot(result.pb.x, result.pb.y), 10.0);
  EXPECT_LT(std::hypot(result.pc.x, result.pc.y), 10.0);
  EXPECT_NEAR(Reference::Distance(Bare(a), result.pa), 0.1, 1e-12);
}

TEST(GetCircleOfMeasuredPoints, MakesThreeRounds) {
  // Each round brings the centre nearer to where it stays; the second and fourth differ.
  WPoint const a{10.0, 0.0, 1.0};
  WPoint const b{6.0, 8.0, -1.0};
  WPoint const c{0.0, 10.0, 2.0};
  std::array<Point, 3> working{Bare(a), Bare(b), Bare(c)};
  std::vector<Point> centers;
  for (int round = 0; round < 4; ++round) {
    Point center;
    double radius = 0.0;
    ASSERT_TRUE(Reference::CircleThrough(working[0], working[1], working[2], &center, &radius));
    ASSERT_TRUE(Moved(center, Bare(a), a.w, &working[0]));
    ASSERT_TRUE(Moved(center, Bare(b), b.w, &working[1]));
    ASSERT_TRUE(Moved(center, Bare(c), c.w, &working[2]));
    ASSERT_TRUE(Reference::CircleThrough(working[0], working[1], working[2], &center, &radius));
    centers.push_back(center);
  }
  ShiftedCircle const result = ShiftedCircleOf(a, b, c);
  ASSERT_TRUE(result.ok);
  EXPECT_SAME_POINT((Point{result.circle.x, result.circle.y}), centers[2]);
  EXPECT_FALSE(SameBits(centers[1], centers[2]));
  EXPECT_FALSE(SameBits(centers[3], centers[2]));
}

TEST(GetCircleOfMeasuredPoints, FollowsTheReferenceBitForBit) {
  constexpr std::uint64_t kSeed = 1305;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int succeeded = 0;
  int failed = 0;
  int flipped = 0;
  for (int i = 0; i < 6000; ++i) {
    SCOPED_TRACE(i);
    double const reach = i % 2 == 0 ? 0.5 : 20.0;  // large ones push the points past each other
    WPoint const a = Weighted(random.PointIn(-10.0, 10.0), random.Uniform(-reach, reach));
    WPoint const b = Weighted(random.PointIn(-10.0, 10.0), random.Uniform(-reach, reach));
    WPoint const c = Weighted(random.PointIn(-10.0, 10.0), random.Uniform(-reach, reach));
    ReferenceShift const reference = ReferenceRounds(a, b, c);
    ShiftedCircle const result = ShiftedCircleOf(a, b, c);
    ASSERT_EQ(result.ok, reference.result.ok);
    flipped += reference.flips > 0 ? 1 : 0;
    failed += result.ok ? 0 : 1;
    if (!result.ok) continue;
    ++succeeded;
    ExpectSame(result, reference.result);
    if (HasFailure()) return;
  }
  EXPECT_GT(succeeded, 3000);
  EXPECT_GT(flipped, 200);
  RecordProperty("failed", failed);
}

TEST(GetCircleOfMeasuredPoints, FollowsTheReferenceOnAGrid) {
  constexpr std::uint64_t kSeed = 1306;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int succeeded = 0;
  int failed = 0;
  for (int i = 0; i < 6000; ++i) {
    SCOPED_TRACE(i);
    WPoint const a = Weighted(random.GridPoint(3), random.Integer(-2, 2));
    WPoint const b = Weighted(random.GridPoint(3), random.Integer(-2, 2));
    WPoint const c = Weighted(random.GridPoint(3), random.Integer(-2, 2));
    if (a.w == b.w && b.w == c.w) continue;
    ReferenceShift const reference = ReferenceRounds(a, b, c);
    ShiftedCircle const result = ShiftedCircleOf(a, b, c);
    ASSERT_EQ(result.ok, reference.result.ok);
    (result.ok ? succeeded : failed) += 1;
    if (!result.ok) continue;
    ExpectSame(result, reference.result);
    if (HasFailure()) return;
  }
  EXPECT_GT(succeeded, 500);
  EXPECT_GT(failed, 500);
}

TEST(GetCircleOfMeasuredPoints, OnEqualDistancesTakesTheFirstPlaceOutwardAndTheSecondInward) {
  // Almost straight: the centre is so far away that the tolerance is lost in the distances.
  constexpr std::uint64_t kSeed = 1307;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int tied = 0;
  for (int i = 0; i < 3000; ++i) {
    SCOPED_TRACE(i);
    double const sagitta = random.Wide(-60, -50);
    WPoint const a = Weighted({-1.0, random.Uniform(-1e-16, 1e-16)}, random.Uniform(-0.01, 0.01));
    WPoint const b = Weighted({random.Uniform(-0.5, 0.5), sagitta}, random.Uniform(-0.01, 0.01));
    WPoint const c = Weighted({1.0, 0.0}, random.Uniform(-0.01, 0.01));
    ReferenceShift const reference = ReferenceRounds(a, b, c);
    ShiftedCircle const result = ShiftedCircleOf(a, b, c);
    ASSERT_EQ(result.ok, reference.result.ok);
    if (!result.ok) continue;
    tied += reference.ties > 0 ? 1 : 0;
    ExpectSame(result, reference.result);
    if (HasFailure()) return;
  }
  EXPECT_GT(tied, 100);
}

TEST(GetCircleOfMeasuredPoints, NeverChangesTheCallersPoints) {
  WPoint const a{10.0, 0.0, -3.0};
  WPoint const b{6.0, 8.0, 9.0};
  WPoint const c{0.0, 10.0, -5.0};
  WPoint const a2 = a;
  WPoint const b2 = b;
  WPoint const c2 = c;
  ShiftedCircleOf(a, b, c);
  EXPECT_EQ(a.w, a2.w);
  EXPECT_EQ(b.w, b2.w);
  EXPECT_EQ(c.w, c2.w);
}

TEST(GetCircleOfMeasuredPoints, NonFiniteInputEndsWithAnAnswer) {
  for (double const bad : {kNaN, kInf, -kInf}) {
    for (std::size_t i = 0; i < 9; ++i) {
      std::array<double, 9> v{10.0, 0.0, 0.1, 6.0, 8.0, 0.2, 0.0, 10.0, 0.3};
      v[i] = bad;
      ShiftedCircle const result =
          ShiftedCircleOf({v[0], v[1], v[2]}, {v[3], v[4], v[5]}, {v[6], v[7], v[8]});
      EXPECT_FALSE(result.ok) << bad << ' ' << i;
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
