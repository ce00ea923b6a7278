#include <array>
#include <limits>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/CellInputs.h"
#include "support/RandomGeometry.h"
#include "support/ReferenceCells.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;
using Rect = std::array<double, 8>;
using Quad = std::array<Point2D<double>, 4>;

Rect SentinelRect() {
  Rect rect;
  rect.fill(kSentinel);
  return rect;
}

Quad SentinelQuad() {
  Quad quad;
  quad.fill({kSentinel, kSentinel});
  return quad;
}

std::vector<Point> ToPoints(Rect const& rect) {
  std::vector<Point> points;
  for (std::size_t i = 0; i < 8; i += 2) points.push_back({rect[i], rect[i + 1]});
  return points;
}

std::vector<Point> ToPoints(Quad const& quad) {
  std::vector<Point> points;
  for (auto const& p : quad) points.push_back({p.x, p.y});
  return points;
}

std::vector<Point> ToPoints(std::array<Point, 4> const& quad) { return {quad.begin(), quad.end()}; }

bool IsUntouched(Rect const& rect) { return SamePoints(ToPoints(SentinelRect()), ToPoints(rect)); }

bool IsUntouched(Quad const& quad) { return SamePoints(ToPoints(SentinelQuad()), ToPoints(quad)); }

bool RectOf(WPoint const& a, WPoint const& b, Rect* rect) {
  return GeometryUtils::GetPermissibleRect(a, b, rect->data());
}

bool RectOf(Point const& a, Point const& b, double r, Rect* rect) {
  return GeometryUtils::GetPermissibleRect(a.x, a.y, b.x, b.y, r, rect->data());
}

/// One call for a polygon and what it leaves in every output.
struct LinePolygonCall {
  explicit LinePolygonCall(WPoint const& a, WPoint const& b, bool fixed = false, bool form = false)
      : formFixed(fixed), xOfY(form) {
    code = GeometryUtils::GetLinePolygon(a, b, &formFixed, &xOfY, quad.data());
  }

  bool formFixed;
  bool xOfY;
  Quad quad = SentinelQuad();
  ErrorCode code;
};

double DistanceFromLine(Point const& parameters, bool xOfY, WPoint const& p) {
  double const x = xOfY ? p.y : p.x;
  double const y = xOfY ? p.x : p.y;
  return std::fabs(parameters.y * x + y + parameters.x) / std::hypot(parameters.y, 1.0);
}

TEST(GetPermissibleRect, JoinsTheTouchingPointsOfTheInnerTangents) {
  Rect rect = SentinelRect();
  ASSERT_TRUE(RectOf(WPoint{0.0, 0.0, 1.0}, WPoint{2.0, 2.0, 1.0}, &rect));
  EXPECT_TRUE(SamePoints({{1.0, 2.0}, {2.0, 1.0}, {1.0, 0.0}, {0.0, 1.0}}, ToPoints(rect)));
}

TEST(GetPermissibleRect, OfZeroTolerancesPutsTheFirstPointFirst) {
  Rect rect = SentinelRect();
  ASSERT_TRUE(RectOf(WPoint{1.0, 2.0, 0.0}, WPoint{5.0, 7.0, 0.0}, &rect));
  std::vector<Point> const expected{{1.0, 2.0}, {1.0, 2.0}, {5.0, 7.0}, {5.0, 7.0}};
  EXPECT_TRUE(SamePoints(expected, ToPoints(rect)));
  rect = SentinelRect();
  ASSERT_TRUE(RectOf(Point{1.0, 2.0}, Point{5.0, 7.0}, 0.0, &rect));
  EXPECT_TRUE(SamePoints(expected, ToPoints(rect)));
}

TEST(GetPermissibleRect, CountsASumOfTolerancesNotAboveTheSmallestNormalAsZero) {
  double const smallest = std::numeric_limits<double>::min();
  std::vector<Point> const zeroForm{{1.0, 2.0}, {1.0, 2.0}, {5.0, 7.0}, {5.0, 7.0}};
  for (double w : {smallest, smallest / 2, -1.0, -kInf}) {
    Rect rect = SentinelRect();
    ASSERT_TRUE(RectOf(WPoint{1.0, 2.0, w}, WPoint{5.0, 7.0, 0.0}, &rect));
    EXPECT_TRUE(SamePoints(zeroForm, ToPoints(rect))) << w;
  }
  // Tolerances of opposite sign cancel.
  Rect rect = SentinelRect();
  ASSERT_TRUE(RectOf(WPoint{1.0, 2.0, 0.5}, WPoint{5.0, 7.0, -0.5}, &rect));
  EXPECT_TRUE(SamePoints(zeroForm, ToPoints(rect)));
}

TEST(GetPermissibleRect, OfOverlappingCirclesFailsAndWritesNothing) {
  Rect rect = SentinelRect();
  EXPECT_FALSE(RectOf(WPoint{0.0, 0.0, 1.0}, WPoint{1.9, 0.0, 1.0}, &rect));
  EXPECT_FALSE(RectOf(WPoint{3.0, 3.0, 1.0}, WPoint{3.0, 3.0, 1.0}, &rect));
  EXPECT_FALSE(RectOf(Point{0.0, 0.0}, Point{1.9, 0.0}, 1.0, &rect));
  EXPECT_FALSE(RectOf(Point{0.0, 0.0}, Point{1.9, 0.0}, -1.0, &rect));
  EXPECT_FALSE(RectOf(Point{3.0, 3.0}, Point{3.0, 3.0}, 1.0, &rect));
  EXPECT_TRUE(IsUntouched(rect));
}

TEST(GetPermissibleRect, AllowsCirclesThatJustTouch) {
  Rect rect = SentinelRect();
  ASSERT_TRUE(RectOf(WPoint{0.0, 0.0, 1.0}, WPoint{2.0, 0.0, 1.0}, &rect));
  for (auto const& p : ToPoints(rect)) EXPECT_TRUE(p.x == 1.0 && p.y == 0.0);
  rect = SentinelRect();
  ASSERT_TRUE(RectOf(WPoint{0.0, 0.0, 3.0}, WPoint{0.0, 4.0, 1.0}, &rect));
  for (auto const& p : ToPoints(rect)) EXPECT_TRUE(p.x == 0.0 && p.y == 3.0);
  EXPECT_TRUE(RectOf(Point{0.0, 0.0}, Point{2.0, 0.0}, 1.0, &rect));
  EXPECT_FALSE(RectOf(WPoint{0.0, 0.0, 1.0}, WPoint{Down(2.0), 0.0, 1.0}, &rect));
  EXPECT_FALSE(RectOf(Point{0.0, 0.0}, Point{Down(2.0), 0.0}, 1.0, &rect));
}

TEST(GetPermissibleRect, OfEqualTolerancesHasBothAxisForms) {
  // The same tangents as above, once solved along x and once along y.
  Rect rect = SentinelRect();
  ASSERT_TRUE(RectOf(Point{0.0, 0.0}, Point{2.0, 2.0}, 1.0, &rect));
  EXPECT_TRUE(SamePoints({{1.0, 2.0}, {2.0, 1.0}, {1.0, 0.0}, {0.0, 1.0}}, ToPoints(rect)));
  RandomGeometry random(4501);
  for (int n = 0; n < 2000; ++n) {
    Point const a = random.PointIn(-10.0, 10.0);
    Point const b = random.PointIn(-10.0, 10.0);
    double const r = random.Uniform(0.0, 0.3) * Reference::Distance(a, b);
    Rect byPoints = SentinelRect();
    Rect byTolerances = SentinelRect();
    ASSERT_TRUE(RectOf(a, b, r, &byPoints));
    ASSERT_TRUE(RectOf(Weighted(a, r), Weighted(b, r), &byTolerances));
    for (std::size_t i = 0; i < 8; ++i) EXPECT_NEAR(byPoints[i], byTolerances[i], 1e-10);
  }
}

TEST(GetPermissibleRect, PutsItsPointsOnTheCirclesAndItsDiagonalsAcross) {
  constexpr std::uint64_t kSeed = 4502;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 2000; ++n) {
    WPoint const a = Weighted(random.PointIn(-10.0, 10.0), random.Uniform(0.01, 0.5));
    WPoint const b = Weighted(random.PointIn(-10.0, 10.0), random.Uniform(0.01, 0.5));
    Rect rect = SentinelRect();
    if (!RectOf(a, b, &rect)) continue;
    auto const p = ToPoints(rect);
    EXPECT_NEAR(Reference::Distance(p[0], {b.x, b.y}), b.w, 1e-12);
    EXPECT_NEAR(Reference::Distance(p[1], {b.x, b.y}), b.w, 1e-12);
    EXPECT_NEAR(Reference::Distance(p[2], {a.x, a.y}), a.w, 1e-12);
    EXPECT_NEAR(Reference::Distance(p[3], {a.x, a.y}), a.w, 1e-12);
    // A tangent is perpendicular to the radius at its touching point.
    double const along = (p[2].x - p[0].x) * (p[0].x - b.x) + (p[2].y - p[0].y) * (p[0].y - b.y);
    EXPECT_NEAR(along, 0.0, 1e-11);
    double const other = (p[3].x - p[1].x) * (p[3].x - a.x) + (p[3].y - p[1].y) * (p[3].y - a.y);
    EXPECT_NEAR(other, 0.0, 1e-11);
  }
}

WPoint RandomWPoint(RandomGeometry& random, int variant) {
  if (variant == 0) return Weighted(random.GridPoint(3), 0.25 * random.Integer(-1, 6));
  if (variant == 1) return Weighted(random.PointIn(-10.0, 10.0), random.Uniform(0.0, 3.0));
  if (variant == 2) return {random.Wide(-300, 300), random.Wide(-300, 300), random.Wide(-300, 300)};
  WPoint p = Weighted(random.GridPoint(3), random.Uniform(0.0, 1.0));
  double* const fields[] = {&p.x, &p.y, &p.w};
  *fields[random.Integer(0, 2)] = SpecialNumber(random);
  return p;
}

constexpr int kVariants = 4;

TEST(GetPermissibleRect, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4503;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 40000; ++n) {
    WPoint const a = RandomWPoint(random, n % kVariants);
    WPoint const b = RandomWPoint(random, n % kVariants);
    std::array<Point, 4> expected;
    Rect rect = SentinelRect();
    bool const found = Reference::Rect(a, b, &expected);
    ASSERT_EQ(RectOf(a, b, &rect), found) << n;
    ASSERT_TRUE(found ? SamePoints(ToPoints(expected), ToPoints(rect))
                      : SamePoints(ToPoints(SentinelRect()), ToPoints(rect)))
        << n;

    Rect equal = SentinelRect();
    bool const foundEqual = Reference::RectOfEqual(a.x, a.y, b.x, b.y, a.w, &expected);
    ASSERT_EQ(RectOf(Point{a.x, a.y}, Point{b.x, b.y}, a.w, &equal), foundEqual) << n;
    ASSERT_TRUE(foundEqual ? SamePoints(ToPoints(expected), ToPoints(equal))
                           : SamePoints(ToPoints(SentinelRect()), ToPoints(equal)))
        << n;
  }
}

bool IsBunch(std::vector<double> const& den, std::vector<double> const& num) {
  return GeometryUtils::IsValidBunch(den.data(), num.data(), static_cast<int>(den.size()));
}

TEST(IsValidBunch, WantsDenominatorsOfOneSignAtBothEnds) {
  EXPECT_TRUE(IsBunch({1.0, 1.0, 1.0, 1.0}, {0.0, 5.0, -5.0, 1.0}));
  EXPECT_TRUE(IsBunch({-1.0, -1.0, -1.0, -1.0}, {0.0, 5.0, -5.0, 1.0}));
  EXPECT_FALSE(IsBunch({1.0, 1.0, 1.0, -1.0}, {0.0, 5.0, -5.0, 1.0}));
  EXPECT_FALSE(IsBunch({-1.0, 1.0, 1.0, 1.0}, {0.0, 5.0, -5.0, 1.0}));
}

TEST(IsValidBunch, ComparesOnlyTheFirstAndTheFourthEntry) {
  EXPECT_TRUE(IsBunch({1.0, -1.0, -1.0, 1.0}, {0.0, 0.0, 0.0, 0.0}));
  EXPECT_TRUE(IsBunch({1.0, -1.0, -1.0, 1.0, -1.0, -1.0}, {0.0, 0.0, 0.0, 0.0, 0.0, 0.0}));
}

TEST(IsValidBunch, RejectsAnyDenominatorNotAboveTheSmallestNormal) {
  double const smallest = std::numeric_limits<double>::min();
  for (std::size_t i = 0; i < 5; ++i) {
    std::vector<double> den(5, 1.0);
    den[i] = smallest;
    EXPECT_FALSE(IsBunch(den, std::vector<double>(5, 0.0)));
    den[i] = 0.0;
    EXPECT_FALSE(IsBunch(den, std::vector<double>(5, 0.0)));
    den[i] = Up(smallest);
    EXPECT_TRUE(IsBunch(den, std::vector<double>(5, 0.0)));
    den[i] = i == 0 || i == 3 ? Up(smallest) : -Up(smallest);
    EXPECT_TRUE(IsBunch(den, std::vector<double>(5, 0.0)));
  }
}

TEST(IsValidBunch, IsFalseForFewerThanFourEntries) {
  for (std::size_t n = 0; n < 4; ++n) {
    EXPECT_FALSE(IsBunch(std::vector<double>(n, 1.0), std::vector<double>(n, 0.0)));
  }
  double const one = 1.0;
  EXPECT_FALSE(GeometryUtils::IsValidBunch(&one, &one, -1));
  EXPECT_FALSE(GeometryUtils::IsValidBunch(&one, &one, std::numeric_limits<int>::min()));
}

TEST(IsValidBunch, ComparesWithARightAngleSlightlyBelowTheExactOne) {
  // The slope num / den as an angle comes to the compared value from below and from above: between
  // it and the exact right angle, a line of positive denominator already counts as steep.
  double const rightAngle = 1.570796326794895;
  double const shallow = 1e14;
  double const steep = 1e15;
  ASSERT_LT(std::atan2(shallow, 1.0), rightAngle);
  ASSERT_GT(std::atan2(steep, 1.0), rightAngle);
  EXPECT_TRUE(IsBunch({1.0, 1.0, 1.0, 1.0}, {0.0, 0.0, 0.0, shallow}));
  EXPECT_FALSE(IsBunch({1.0, 1.0, 1.0, 1.0}, {0.0, 0.0, 0.0, steep}));
  EXPECT_FALSE(IsBunch({1.0, 1.0, 1.0, 1.0}, {0.0, 0.0, 0.0, -steep}));
  EXPECT_TRUE(IsBunch({1.0, 1.0, 1.0, 1.0}, {steep, 0.0, 0.0, -steep}));
  EXPECT_TRUE(IsBunch({1.0, 1.0, 1.0, -1.0}, {steep, 0.0, 0.0, 0.0}));
}

TEST(IsValidBunch, IsFalseForNotANumberAtTheComparedEntries) {
  EXPECT_FALSE(IsBunch({kNaN, 1.0, 1.0, 1.0}, {0.0, 0.0, 0.0, 0.0}));
  EXPECT_FALSE(IsBunch({1.0, 1.0, 1.0, 1.0}, {0.0, 0.0, 0.0, kNaN}));
  EXPECT_TRUE(IsBunch({1.0, kNaN, 1.0, 1.0}, {0.0, 0.0, 0.0, 0.0}));
}

TEST(GetLinePolygon, OfZeroTolerancesIsTheLineFourTimes) {
  // x = y / 2 - 1 / 2, which is the point (1/2, -1/2).
  LinePolygonCall const call({0.0, 1.0, 0.0}, {1.0, 3.0, 0.0});
  EXPECT_EQ(call.code, ErrorCode::Ok);
  EXPECT_TRUE(call.formFixed);
  EXPECT_TRUE(call.xOfY);
  EXPECT_TRUE(SamePoints(std::vector<Point>(4, Point{0.5, -0.5}), ToPoints(call.quad)));
}

TEST(GetLinePolygon, HoldsMinusInterceptAndMinusSlope) {
  // y = 2 x + 3 in the form given by the caller.
  LinePolygonCall const call({0.0, 3.0, 0.0}, {1.0, 5.0, 0.0}, true, false);
  EXPECT_EQ(call.code, ErrorCode::Ok);
  EXPECT_TRUE(SamePoints(std::vector<Point>(4, Point{-3.0, -2.0}), ToPoints(call.quad)));
}

TEST(GetLinePolygon, PrefersTheFormOfTheSteeperDiagonal) {
  EXPECT_TRUE(LinePolygonCall({0.0, 0.0, 0.1}, {0.0, 5.0, 0.1}).xOfY);
  EXPECT_FALSE(LinePolygonCall({0.0, 0.0, 0.1}, {5.0, 0.0, 0.1}).xOfY);
  EXPECT_TRUE(LinePolygonCall({0.0, 0.0, 0.0}, {1.0, Up(1.0), 0.0}).xOfY);
  EXPECT_FALSE(LinePolygonCall({0.0, 0.0, 0.0}, {1.0, 1.0, 0.0}).xOfY);
}

TEST(GetLinePolygon, NeverChangesAFormGivenByTheCaller) {
  WPoint const a{0.0, 0.0, 0.1};
  WPoint const b{0.0, 5.0, 0.1};
  LinePolygonCall const wrong(a, b, true, false);
  EXPECT_EQ(wrong.code, ErrorCode::InvalidLineCell);
  EXPECT_TRUE(wrong.formFixed);
  EXPECT_FALSE(wrong.xOfY);
  EXPECT_TRUE(IsUntouched(wrong.quad));
  LinePolygonCall const right(a, b, true, true);
  EXPECT_EQ(right.code, ErrorCode::Ok);
  EXPECT_TRUE(right.xOfY);
}

TEST(GetLinePolygon, OfOverlappingCirclesFailsBeforeAFormIsChosen) {
  LinePolygonCall const call({0.0, 0.0, 1.0}, {1.0, 0.0, 1.0}, false, true);
  EXPECT_EQ(call.code, ErrorCode::Failed);
  EXPECT_FALSE(call.formFixed);
  EXPECT_TRUE(call.xOfY);
  EXPECT_TRUE(IsUntouched(call.quad));
}

TEST(GetLinePolygon, OfEqualPointsWithoutToleranceHasNoForm) {
  // All coefficients are zero: y-of-x is tried first, then x-of-y.
  LinePolygonCall const call({1.0, 1.0, 0.0}, {1.0, 1.0, 0.0});
  EXPECT_EQ(call.code, ErrorCode::InvalidLineCell);
  EXPECT_TRUE(call.formFixed);
  EXPECT_TRUE(call.xOfY);
  EXPECT_TRUE(IsUntouched(call.quad));
}

TEST(GetLinePolygon, OfPointsExactlyTheirTolerancesApartEndsWithoutAResultOrCrash) {
  // All four tangent points fall together, so there is no direction left.
  LinePolygonCall const exact({0.0, 0.0, 1.0}, {2.0, 0.0, 1.0});
  EXPECT_EQ(exact.code, ErrorCode::InvalidLineCell);
  EXPECT_TRUE(IsUntouched(exact.quad));
}

TEST(GetLinePolygon, WithAnUprightAndALevelTangentFailsInBothFormsAndKeepsTheSecond) {
  // The tangents are x = 1 and y = 1: neither form can hold both. y-of-x is tried first.
  LinePolygonCall const call({0.0, 0.0, 1.0}, {2.0, 2.0, 1.0});
  EXPECT_EQ(call.code, ErrorCode::InvalidLineCell);
  EXPECT_TRUE(call.formFixed);
  EXPECT_TRUE(call.xOfY);
  EXPECT_TRUE(IsUntouched(call.quad));
}

TEST(GetLinePolygon, SwitchesTheFormWhenTheFirstOneIsNoValidBunch) {
  // The diagonal is 40 degrees steep, so y-of-x is tried first. The tangents turn 70 degrees off
  // it, and the compared one passes the vertical on one of the two sides.
  double const x = 1.63;
  double const y = 1.368;
  LinePolygonCall const up({0.0, 0.0, 1.0}, {x, y, 1.0});
  LinePolygonCall const down({0.0, 0.0, 1.0}, {x, -y, 1.0});
  EXPECT_EQ(up.code, ErrorCode::Ok);
  EXPECT_EQ(down.code, ErrorCode::Ok);
  EXPECT_NE(up.xOfY, down.xOfY);
  EXPECT_TRUE(up.formFixed && down.formFixed);
}

TEST(GetLinePolygon, HoldsOnlyLinesThatPassBothPointsWithinTheirTolerance) {
  // Three times the sum of the tolerances apart, no tangent turns past the axis of the form.
  constexpr std::uint64_t kSeed = 4504;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int built = 0;
  for (int n = 0; n < 3000; ++n) {
    WPoint const a = Weighted(random.PointIn(-5.0, 5.0), random.Uniform(0.01, 0.5));
    WPoint const b = Weighted(random.PointIn(-5.0, 5.0), random.Uniform(0.01, 0.5));
    if (std::hypot(b.x - a.x, b.y - a.y) < 3.0 * (a.w + b.w)) continue;
    LinePolygonCall const call(a, b);
    ASSERT_EQ(call.code, ErrorCode::Ok);
    ++built;
    auto const quad = ToPoints(call.quad);
    double weight[4];
    double sum = 0.0;
    for (double& w : weight) sum += w = random.Unit();
    Point mixed{};
    for (int k = 0; k < 4; ++k) {
      mixed.x += weight[k] / sum * quad[k].x;
      mixed.y += weight[k] / sum * quad[k].y;
    }
    EXPECT_LE(DistanceFromLine(mixed, call.xOfY, a), a.w * (1.0 + 1e-9));
    EXPECT_LE(DistanceFromLine(mixed, call.xOfY, b), b.w * (1.0 + 1e-9));
    // Vertices 1 and 3 are the tangents.
    for (int tangent : {1, 3}) {
      EXPECT_NEAR(DistanceFromLine(quad[tangent], call.xOfY, a), a.w, 1e-9);
      EXPECT_NEAR(DistanceFromLine(quad[tangent], call.xOfY, b), b.w, 1e-9);
    }
  }
  EXPECT_GT(built, 1500);
}

TEST(GetLinePolygon, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4505;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int codes[3] = {0, 0, 0};
  int switched = 0;
  for (int n = 0; n < 60000; ++n) {
    WPoint const a = RandomWPoint(random, n % kVariants);
    WPoint b = RandomWPoint(random, n % kVariants);
    if (n % 3 == 0) {
      // Close to the sum of the tolerances.
      double const reach = (a.w + b.w) * random.Uniform(1.0, 1.1);
      double const angle = random.Uniform(-3.1, 3.1);
      b.x = a.x + reach * std::cos(angle);
      b.y = a.y + reach * std::sin(angle);
    }
    bool formFixed = random.Integer(0, 2) == 0;
    bool xOfY = random.Flip();
    bool const chosenHere = !formFixed;
    LinePolygonCall const call(a, b, formFixed, xOfY);
    std::array<Point, 4> expected;
    auto const code = Reference::LinePolygon(a, b, &formFixed, &xOfY, &expected);
    ASSERT_EQ(call.code, code) << n;
    ASSERT_EQ(call.formFixed, formFixed) << n;
    ASSERT_EQ(call.xOfY, xOfY) << n;
    if (code == ErrorCode::Ok) {
      ASSERT_TRUE(SamePoints(ToPoints(expected), ToPoints(call.quad))) << n;
    } else {
      ASSERT_TRUE(IsUntouched(call.quad)) << n;
    }
    ++codes[code == ErrorCode::Ok ? 0 : code == ErrorCode::Failed ? 1 : 2];
    std::array<Point, 4> rect;
    if (chosenHere && code == ErrorCode::Ok && Reference::Rect(a, b, &rect)) {
      double const a4 = rect[3].y - rect[0].y;
      double const b4 = rect[0].x - rect[3].x;
      if (xOfY != (std::fabs(a4) > std::fabs(b4))) ++switched;
    }
  }
  EXPECT_GT(codes[0], 5000);
  EXPECT_GT(codes[1], 1000);
  EXPECT_GT(codes[2], 1000);
  EXPECT_GT(switched, 100);
}

TEST(GetLineTriangles, AreTheFanOfThePolygon) {
  WPoint const a{0.0, 0.0, 0.1};
  WPoint const b{3.0, 1.0, 0.2};
  LinePolygonCall const call(a, b);
  ASSERT_EQ(call.code, ErrorCode::Ok);
  auto const q = ToPoints(call.quad);
  bool formFixed = false;
  bool xOfY = true;
  Cell cell;
  ASSERT_EQ(GeometryUtils::GetLineTriangles(a, b, &formFixed, &xOfY, &cell), ErrorCode::Ok);
  EXPECT_TRUE(formFixed);
  EXPECT_FALSE(xOfY);
  EXPECT_TRUE(SameCell({{{q[0], q[1], q[2]}}, {{q[0], q[2], q[3]}}}, cell));
}

TEST(GetLineTriangles, ReplaceTheCell) {
  bool formFixed = false;
  bool xOfY = false;
  Cell cell(5, SentinelTriangle());
  ASSERT_EQ(GeometryUtils::GetLineTriangles(WPoint{0.0, 0.0, 0.1}, WPoint{3.0, 1.0, 0.2},
                                            &formFixed, &xOfY, &cell),
            ErrorCode::Ok);
  EXPECT_EQ(cell.size(), 2U);
  cell.assign(5, SentinelTriangle());
  ASSERT_EQ(GeometryUtils::GetLineTriangles(0.0, 0.0, 3.0, 1.0, 0.1, &formFixed, &xOfY, &cell),
            ErrorCode::Ok);
  EXPECT_EQ(cell.size(), 2U);
}

TEST(GetLineTriangles, LeaveTheCellOnFailure) {
  Cell const before(2, SentinelTriangle());
  Cell cell = before;
  bool formFixed = false;
  bool xOfY = false;
  EXPECT_EQ(GeometryUtils::GetLineTriangles(WPoint{0.0, 0.0, 1.0}, WPoint{1.0, 0.0, 1.0},
                                            &formFixed, &xOfY, &cell),
            ErrorCode::Failed);
  EXPECT_EQ(GeometryUtils::GetLineTriangles(0.0, 0.0, 1.0, 0.0, 1.0, &formFixed, &xOfY, &cell),
            ErrorCode::Failed);
  EXPECT_FALSE(formFixed);
  formFixed = true;
  EXPECT_EQ(GeometryUtils::GetLineTriangles(WPoint{0.0, 0.0, 0.1}, WPoint{0.0, 5.0, 0.1},
                                            &formFixed, &xOfY, &cell),
            ErrorCode::InvalidLineCell);
  EXPECT_EQ(GeometryUtils::GetLineTriangles(0.0, 0.0, 0.0, 5.0, 0.1, &formFixed, &xOfY, &cell),
            ErrorCode::InvalidLineCell);
  EXPECT_TRUE(SameCell(before, cell));
}

TEST(GetLineTriangles, HaveTheBitsOfTheReferenceInBothForms) {
  constexpr std::uint64_t kSeed = 4506;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 30000; ++n) {
    WPoint const a = RandomWPoint(random, n % kVariants);
    WPoint const b = RandomWPoint(random, n % kVariants);
    bool const fixed = random.Flip();
    bool const form = random.Flip();
    for (bool equal : {false, true}) {
      Cell expected{SentinelTriangle()};
      Cell cell{SentinelTriangle()};
      bool expectedFixed = fixed;
      bool expectedForm = form;
      bool formFixed = fixed;
      bool xOfY = form;
      auto const expectedCode =
          equal ? Reference::LineCellOfEqual(a.x, a.y, b.x, b.y, a.w, &expectedFixed, &expectedForm,
                                             &expected)
                : Reference::LineCell(a, b, &expectedFixed, &expectedForm, &expected);
      auto const code =
          equal ? GeometryUtils::GetLineTriangles(a.x, a.y, b.x, b.y, a.w, &formFixed, &xOfY, &cell)
                : GeometryUtils::GetLineTriangles(a, b, &formFixed, &xOfY, &cell);
      ASSERT_EQ(code, expectedCode) << n;
      ASSERT_EQ(formFixed, expectedFixed) << n;
      ASSERT_EQ(xOfY, expectedForm) << n;
      ASSERT_TRUE(SameCell(expected, cell)) << n;
    }
  }
}

TEST(GetPermissibleHexagon, WantsARadiusStrictlyAboveTheTolerance) {
  Point const a{1.0, 0.0};
  Point const b{0.0, 1.0};
  Point const c{-1.0, 0.0};
  std::array<double, 12> out;
  out.fill(kSentinel);
  EXPECT_FALSE(GeometryUtils::GetPermissibleHexagon(a, b, c, 1.0, out.data()));
  EXPECT_FALSE(GeometryUtils::GetPermissibleHexagon(a, b, c, Up(1.0), out.data()));
  EXPECT_TRUE(GeometryUtils::GetPermissibleHexagon(a, b, c, Down(1.0), out.data()));
  EXPECT_TRUE(GeometryUtils::GetPermissibleHexagon(a, b, c, -1.0, out.data()));
  EXPECT_FALSE(GeometryUtils::GetPermissibleHexagon(a, b, c, kInf, out.data()));
  EXPECT_FALSE(GeometryUtils::GetPermissibleHexagon(a, b, c, kNaN, out.data()));
  for (double value : out) EXPECT_SAME_BITS(value, kSentinel);
}

TEST(GetPermissibleHexagon, NeedsNoRoomForAResult) {
  EXPECT_TRUE(
      GeometryUtils::GetPermissibleHexagon({1.0, 0.0}, {0.0, 1.0}, {-1.0, 0.0}, 0.5, nullptr));
}

TEST(GetPermissibleHexagon, FailsWithoutACircle) {
  EXPECT_FALSE(
      GeometryUtils::GetPermissibleHexagon({1.0, 0.0}, {1.0, 1.0}, {1.0, 7.0}, 0.0, nullptr));
  EXPECT_FALSE(
      GeometryUtils::GetPermissibleHexagon({kNaN, 0.0}, {0.0, 1.0}, {-1.0, 0.0}, 0.0, nullptr));
}

TEST(GetPermissibleHexagon, UsesTheMeanOfTheThreeDistances) {
  constexpr std::uint64_t kSeed = 4507;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 5000; ++n) {
    Point const a = random.PointIn(-3.0, 3.0);
    Point const b = random.PointIn(-3.0, 3.0);
    Point const c = random.PointIn(-3.0, 3.0);
    Point center;
    double radius = 0.0;
    ASSERT_TRUE(Reference::CircleThrough(a, b, c, &center, &radius));
    ASSERT_FALSE(GeometryUtils::GetPermissibleHexagon(a, b, c, radius, nullptr));
    ASSERT_TRUE(GeometryUtils::GetPermissibleHexagon(a, b, c, Down(radius), nullptr));
  }
}

}  // namespace
}  // namespace Vorn::Testing
