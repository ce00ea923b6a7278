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

Cell const kEmpty;
Triangle const kRight{{{0.0, 0.0}, {4.0, 0.0}, {0.0, 3.0}}};

bool RectOf(Cell const& cell, std::array<double, 4>* rect) {
  return GeometryUtils::GetBoundingRect(&cell, rect->data());
}

bool ChordOf(Cell const& cell, double a, double b, double c, Triangle* chord) {
  return GeometryUtils::GetBoundingCircleAndLineIntersectionTriangle(&cell, a, b, c, chord);
}

bool CenterOf(Cell const& cell, Point* center) { return GeometryUtils::GetCenter(&cell, center); }

/// A cell of one to six triangles of every kind.
Cell RandomCell(RandomGeometry& random) {
  Cell cell;
  auto const kind = kAllPairKinds[random.Integer(0, std::size(kAllPairKinds) - 1)];
  int const pairs = random.Integer(1, 3);
  for (int k = 0; k < pairs; ++k) {
    auto const pair = MakePair(random, kind);
    cell.push_back(pair.first);
    if (random.Flip()) cell.push_back(pair.second);
  }
  return cell;
}

Cell FanOfRing(RandomGeometry& random, Point const& middle, double radius) {
  std::vector<Point> ring;
  int const n = random.Integer(4, 7);
  for (int k = 0; k < n; ++k) {
    double const angle = 6.28 * (k + random.Uniform(0.1, 0.9)) / n;
    ring.push_back({middle.x + radius * std::cos(angle), middle.y + radius * std::sin(angle)});
  }
  return Reference::FanOf(ring);
}

TEST(GetBoundingRect, HoldsTheExtremesOfAllVertices) {
  std::array<double, 4> rect;
  rect.fill(kSentinel);
  Cell const cell{kRight, {{{1.0, 1.0}, {-2.0, 0.5}, {0.5, 7.0}}}, {{{9.0, -1.0}, {1, 1}, {1, 1}}}};
  ASSERT_TRUE(RectOf(cell, &rect));
  EXPECT_EQ(rect, (std::array<double, 4>{-2.0, -1.0, 9.0, 7.0}));
}

TEST(GetBoundingRect, OfAnEmptyCellFailsAndWritesNothing) {
  std::array<double, 4> rect;
  rect.fill(kSentinel);
  EXPECT_FALSE(RectOf(kEmpty, &rect));
  for (double value : rect) EXPECT_SAME_BITS(value, kSentinel);
}

TEST(GetBoundingRect, KeepsTheFirstOfEqualExtremes) {
  std::array<double, 4> rect{};
  ASSERT_TRUE(RectOf({{{{-0.0, 0.0}, {0.0, -0.0}, {0.0, 0.0}}}}, &rect));
  EXPECT_SAME_BITS(rect[0], -0.0);
  EXPECT_SAME_BITS(rect[1], 0.0);
  EXPECT_SAME_BITS(rect[2], -0.0);
  EXPECT_SAME_BITS(rect[3], 0.0);
}

TEST(GetBoundingRect, SkipsNotANumberExceptInTheFirstVertex) {
  std::array<double, 4> rect{};
  ASSERT_TRUE(RectOf({{{{1.0, 2.0}, {kNaN, 5.0}, {3.0, kNaN}}}}, &rect));
  EXPECT_EQ(rect, (std::array<double, 4>{1.0, 2.0, 3.0, 5.0}));
  ASSERT_TRUE(RectOf({{{{kNaN, 2.0}, {1.0, 5.0}, {3.0, 4.0}}}}, &rect));
  EXPECT_TRUE(std::isnan(rect[0]) && std::isnan(rect[2]));
  EXPECT_EQ(rect[1], 2.0);
  EXPECT_EQ(rect[3], 5.0);
}

TEST(GetBoundingRect, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4701;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 5000; ++n) {
    Cell const cell = RandomCell(random);
    Reference::Box box;
    std::array<double, 4> rect;
    rect.fill(kSentinel);
    ASSERT_EQ(RectOf(cell, &rect), Reference::BoxOf(cell, &box));
    ASSERT_PRED_FORMAT2(DoubleBitsEqual, rect[0], box.minX);
    ASSERT_PRED_FORMAT2(DoubleBitsEqual, rect[1], box.minY);
    ASSERT_PRED_FORMAT2(DoubleBitsEqual, rect[2], box.maxX);
    ASSERT_PRED_FORMAT2(DoubleBitsEqual, rect[3], box.maxY);
  }
}

TEST(BoundingCircleChord, RepeatsTheSecondPoint) {
  // Bounding circle: centre (2, 1.5), radius 2.5. The line y = 1.5 gives the smaller x first.
  Triangle chord = SentinelTriangle();
  ASSERT_TRUE(ChordOf({kRight}, 0.0, 1.0, -1.5, &chord));
  EXPECT_SAME_POINT(chord.pts[0], (Point{-0.5, 1.5}));
  EXPECT_SAME_POINT(chord.pts[1], (Point{4.5, 1.5}));
  EXPECT_SAME_POINT(chord.pts[2], chord.pts[1]);
}

TEST(BoundingCircleChord, OfATangentIsOnePointThreeTimes) {
  Triangle chord = SentinelTriangle();
  ASSERT_TRUE(ChordOf({kRight}, 0.0, 1.0, -4.0, &chord));
  EXPECT_SAME_POINT(chord.pts[0], (Point{2.0, 4.0}));
  EXPECT_SAME_POINT(chord.pts[1], chord.pts[0]);
  EXPECT_SAME_POINT(chord.pts[2], chord.pts[0]);
}

TEST(BoundingCircleChord, FailsAndWritesNothingWithoutAChord) {
  Triangle chord = SentinelTriangle();
  EXPECT_FALSE(ChordOf({kRight}, 0.0, 1.0, -4.5, &chord));
  EXPECT_FALSE(ChordOf({kRight}, 0.0, 1.0, -Up(4.0), &chord));
  EXPECT_FALSE(ChordOf({kRight}, 0.0, 0.0, 1.0, &chord));
  EXPECT_FALSE(ChordOf({kRight}, kNaN, 1.0, 1.0, &chord));
  EXPECT_FALSE(ChordOf(kEmpty, 0.0, 1.0, -1.5, &chord));
  EXPECT_TRUE(SameBits(chord, SentinelTriangle()));
}

TEST(BoundingCircleChord, LiesOnLineAndCircle) {
  constexpr std::uint64_t kSeed = 4702;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int found = 0;
  for (int n = 0; n < 3000; ++n) {
    Cell const cell{random.TriangleIn(-3.0, 3.0), random.TriangleIn(-3.0, 3.0)};
    double const angle = random.Uniform(-3.1, 3.1);
    double const a = std::cos(angle);
    double const b = std::sin(angle);
    double const c = random.Uniform(-3.0, 3.0);
    Triangle chord = SentinelTriangle();
    if (!ChordOf(cell, a, b, c, &chord)) continue;
    ++found;
    Reference::Box box;
    ASSERT_TRUE(Reference::BoxOf(cell, &box));
    Point const middle{(box.minX + box.maxX) / 2, (box.minY + box.maxY) / 2};
    for (auto const& p : chord.pts) {
      EXPECT_NEAR(a * p.x + b * p.y + c, 0.0, 1e-13);
      EXPECT_NEAR(Reference::Distance(p, middle), Reference::Distance({box.minX, box.minY}, middle),
                  1e-12);
    }
  }
  EXPECT_GT(found, 1000);
}

TEST(BoundingCircleChord, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4703;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 20000; ++n) {
    Cell const cell = RandomCell(random);
    Reference::Line line{random.Uniform(-1, 1), random.Uniform(-1, 1), random.Uniform(-1, 1)};
    if (n % 3 == 0) line = {1.0, random.Uniform(-5, 5), random.Uniform(-5, 5)};
    if (n % 5 == 0) {
      line = {double(random.Integer(-1, 1)), double(random.Integer(-1, 1)),
              double(random.Integer(-2, 2))};
    }
    Triangle expected = SentinelTriangle();
    Triangle chord = SentinelTriangle();
    ASSERT_EQ(ChordOf(cell, line.a, line.b, line.c, &chord),
              Reference::ChordOf(cell, line, &expected));
    ASSERT_TRUE(SameBits(expected, chord)) << Describe(expected) << " " << Describe(chord);
  }
}

TEST(GetCenter, OfAnEmptyCellFailsAndWritesNothing) {
  Point center = kPointSentinel;
  EXPECT_FALSE(CenterOf(kEmpty, &center));
  EXPECT_SAME_POINT(center, kPointSentinel);
}

TEST(GetCenter, OfOneProperTriangleIsItsCenter) {
  Point center = kPointSentinel;
  ASSERT_TRUE(CenterOf({{{{0.0, 0.0}, {4.0, 0.0}, {0.0, 4.0}}}}, &center));
  EXPECT_NEAR(center.x, 4.0 / 3.0, 1e-15);
  EXPECT_NEAR(center.y, 4.0 / 3.0, 1e-15);
  Point own;
  ASSERT_TRUE(GeometryUtils::CalcCenter(kRight, &own));
  ASSERT_TRUE(CenterOf({kRight}, &center));
  // Weighting by the area and dividing by it again may cost a rounding.
  EXPECT_DOUBLE_EQ(center.x, own.x);
  EXPECT_DOUBLE_EQ(center.y, own.y);
}

TEST(GetCenter, WeightsByAreaWhateverTheTurn) {
  // Areas 2 and 6 with centroids at x = 2/3 and x = 11.
  Triangle const small{{{0.0, 0.0}, {2.0, 0.0}, {0.0, 2.0}}};
  Triangle const big{{{10.0, 0.0}, {10.0, 4.0}, {13.0, 0.0}}};
  Point center = kPointSentinel;
  ASSERT_TRUE(CenterOf({small, big}, &center));
  EXPECT_NEAR(center.x, (2.0 * 2.0 / 3.0 + 6.0 * 11.0) / 8.0, 1e-14);
  EXPECT_NEAR(center.y, (2.0 * 2.0 / 3.0 + 6.0 * 4.0 / 3.0) / 8.0, 1e-14);
}

TEST(GetCenter, OfDegenerateTrianglesIsTheirPlainMean) {
  Point const p{1.0, 2.0};
  Point const q{5.0, 4.0};
  Point center = kPointSentinel;
  ASSERT_TRUE(CenterOf({{{p, q, q}}}, &center));
  EXPECT_SAME_POINT(center, (Point{3.0, 3.0}));
  ASSERT_TRUE(CenterOf({{{p, q, q}}, {{p, p, p}}}, &center));
  EXPECT_SAME_POINT(center, (Point{2.0, 2.5}));
  ASSERT_TRUE(CenterOf({{{p, p, p}}}, &center));
  EXPECT_SAME_POINT(center, p);
}

TEST(GetCenter, IgnoresDegenerateTrianglesBesideAProperOne) {
  Triangle const proper{{{0.0, 0.0}, {3.0, 0.0}, {0.0, 3.0}}};
  Point const far{100.0, 100.0};
  Point alone = kPointSentinel;
  Point beside = kPointSentinel;
  ASSERT_TRUE(CenterOf({proper}, &alone));
  ASSERT_TRUE(CenterOf({{{far, far, far}}, proper, {{far, {0.0, 0.0}, {0.0, 0.0}}}}, &beside));
  EXPECT_SAME_POINT(alone, beside);
}

TEST(GetCenter, CountsAnAreaOfTheSmallestNormalAsDegenerate) {
  // Sides of 2^-511 and 2^-510 enclose exactly 2^-1022, the smallest normal double.
  Triangle const atThreshold{{{0.0, 0.0}, {0x1p-511, 0.0}, {0.0, 0x1p-510}}};
  ASSERT_EQ(std::fabs(Reference::Area(atThreshold)), std::numeric_limits<double>::min());
  Point const far{1.0, 1.0};
  Point center = kPointSentinel;
  ASSERT_TRUE(CenterOf({atThreshold, {{far, far, far}}}, &center));
  EXPECT_NEAR(center.x, 0.5, 1e-15);
  // One step more is a proper triangle that wins over the point.
  Triangle const above{{{0.0, 0.0}, {0x1.0000000000001p-511, 0.0}, {0.0, 0x1p-510}}};
  ASSERT_GT(std::fabs(Reference::Area(above)), std::numeric_limits<double>::min());
  ASSERT_TRUE(CenterOf({above, {{far, far, far}}}, &center));
  EXPECT_LT(center.x, 1e-150);
}

TEST(GetCenter, OfNotANumberAreasIsTheRawWeightedSum) {
  Point center = kPointSentinel;
  ASSERT_TRUE(CenterOf({{{{kNaN, 0.0}, {1.0, 0.0}, {0.0, 1.0}}}}, &center));
  EXPECT_TRUE(std::isnan(center.x));
  // Counted degenerate ones come before the raw sum.
  Point const p{1.0, 2.0};
  ASSERT_TRUE(CenterOf({{{{kNaN, 0.0}, {1.0, 0.0}, {0.0, 1.0}}}, {{p, p, p}}}, &center));
  EXPECT_SAME_POINT(center, p);
}

TEST(GetCenter, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4704;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 20000; ++n) {
    Cell const cell = RandomCell(random);
    Point expected = kPointSentinel;
    Point center = kPointSentinel;
    ASSERT_EQ(CenterOf(cell, &center), Reference::CellCenter(cell, &expected));
    ASSERT_PRED_FORMAT2(PointBitsEqual, center, expected) << Describe(cell);
  }
}

bool ForCircle(Point const& p1, Point const& p2, Cell const& cell, Point* center) {
  return GeometryUtils::GetCenterForCircle(p1, p2, &cell, center);
}

TEST(GetCenterForCircle, IsEquallyFarFromBothPointsAndInTheCell) {
  constexpr std::uint64_t kSeed = 4705;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int found = 0;
  for (int n = 0; n < 3000; ++n) {
    Cell const cell = FanOfRing(random, random.PointIn(-1.0, 1.0), random.Uniform(0.2, 1.0));
    Point const p1 = random.PointIn(-4.0, 4.0);
    Point const p2 = random.PointIn(-4.0, 4.0);
    Point center = kPointSentinel;
    if (!ForCircle(p1, p2, cell, &center)) {
      EXPECT_SAME_POINT(center, kPointSentinel);
      continue;
    }
    ++found;
    EXPECT_NEAR(Reference::Distance(center, p1), Reference::Distance(center, p2), 1e-11);
    std::array<double, 4> rect;
    ASSERT_TRUE(RectOf(cell, &rect));
    EXPECT_TRUE(rect[0] - 1e-9 <= center.x && center.x <= rect[2] + 1e-9);
    EXPECT_TRUE(rect[1] - 1e-9 <= center.y && center.y <= rect[3] + 1e-9);
  }
  EXPECT_GT(found, 300);
}

TEST(GetCenterForCircle, OfEqualPointsFails) {
  Point center = kPointSentinel;
  EXPECT_FALSE(ForCircle({1.0, 1.0}, {1.0, 1.0}, {kRight}, &center));
  EXPECT_SAME_POINT(center, kPointSentinel);
}

TEST(GetCenterForCircle, FailsWhenTheBisectorMissesTheCell) {
  Point center = kPointSentinel;
  // Misses the bounding circle.
  EXPECT_FALSE(ForCircle({20.0, 0.0}, {22.0, 0.0}, {kRight}, &center));
  // Crosses the bounding circle (x = -0.25) but not the triangle.
  EXPECT_FALSE(ForCircle({-1.25, 0.0}, {0.75, 0.0}, {kRight}, &center));
  EXPECT_FALSE(ForCircle({0.0, 0.0}, {1.0, 0.0}, kEmpty, &center));
  EXPECT_FALSE(ForCircle({kNaN, 0.0}, {1.0, 0.0}, {kRight}, &center));
  EXPECT_SAME_POINT(center, kPointSentinel);
}

TEST(GetCenterForCircle, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4706;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int found = 0;
  for (int n = 0; n < 30000; ++n) {
    Cell const cell = n % 2 == 0 ? RandomCell(random) : FanOfRing(random, {0.0, 0.0}, 1.0);
    Point const p1 = n % 3 == 0 ? random.GridPoint(2) : random.PointIn(-2.0, 2.0);
    Point const p2 = n % 3 == 0 ? random.GridPoint(2) : random.PointIn(-2.0, 2.0);
    Point expected = kPointSentinel;
    Point center = kPointSentinel;
    bool const has = Reference::CellCenterForCircle(p1, p2, cell, &expected);
    ASSERT_EQ(ForCircle(p1, p2, cell, &center), has) << Describe(cell);
    ASSERT_PRED_FORMAT2(PointBitsEqual, center, expected) << Describe(cell);
    if (has) ++found;
  }
  EXPECT_GT(found, 3000);
}

bool ForLine(Point const* p1, Point const* p2, bool swapped, Cell const& cell, Point* center) {
  Point const unused{kNaN, kNaN};
  return GeometryUtils::GetCenterForLine(p1 != nullptr, p1 != nullptr ? *p1 : unused, p2 != nullptr,
                                         p2 != nullptr ? *p2 : unused, swapped, &cell, center);
}

TEST(GetCenterForLine, WithoutFixedPointsIsTheCenterOfTheCell) {
  Point expected;
  ASSERT_TRUE(CenterOf({kRight}, &expected));
  for (bool swapped : {false, true}) {
    Point center = kPointSentinel;
    ASSERT_TRUE(ForLine(nullptr, nullptr, swapped, {kRight}, &center));
    EXPECT_SAME_POINT(center, expected);
    center = kPointSentinel;
    EXPECT_FALSE(ForLine(nullptr, nullptr, swapped, kEmpty, &center));
    EXPECT_SAME_POINT(center, kPointSentinel);
  }
}

TEST(GetCenterForLine, ThroughBothPointsIsTheirLine) {
  // v x + y + u = 0 through (1, -2) and (2, -3): v = 1, u = 1. The point lies in the triangle.
  Point const p1{1.0, -2.0};
  Point const p2{2.0, -3.0};
  Point center = kPointSentinel;
  ASSERT_TRUE(ForLine(&p1, &p2, false, {kRight}, &center));
  EXPECT_SAME_POINT(center, (Point{1.0, 1.0}));
  // The same with x and y exchanged.
  Point const s1{-2.0, 1.0};
  Point const s2{-3.0, 2.0};
  ASSERT_TRUE(ForLine(&s1, &s2, true, {kRight}, &center));
  EXPECT_SAME_POINT(center, (Point{1.0, 1.0}));
}

TEST(GetCenterForLine, ThroughBothPointsFailsOutsideTheCell) {
  Point const p1{1.0, 12.0};
  Point const p2{2.0, 11.0};
  Point center = kPointSentinel;
  EXPECT_FALSE(ForLine(&p1, &p2, false, {kRight}, &center));
  EXPECT_FALSE(ForLine(&p1, &p2, false, kEmpty, &center));
  EXPECT_SAME_POINT(center, kPointSentinel);
}

TEST(GetCenterForLine, OfPointsWithOneAbscissaHasNoResult) {
  // The solver does not check the last pivot, so the parameters are infinite rather than refused;
  // no cell holds them.
  Point const p1{1.0, 0.0};
  Point const p2{1.0, 2.0};
  Point const s1{0.0, 1.0};
  Point const s2{2.0, 1.0};
  Point center = kPointSentinel;
  EXPECT_FALSE(ForLine(&p1, &p2, false, {kRight}, &center));
  EXPECT_FALSE(ForLine(&s1, &s2, true, {kRight}, &center));
  EXPECT_SAME_POINT(center, kPointSentinel);
}

TEST(GetCenterForLine, ThroughOnePointStaysOnItsLinesAndInTheCell) {
  constexpr std::uint64_t kSeed = 4707;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int found = 0;
  for (int n = 0; n < 3000; ++n) {
    Cell const cell = FanOfRing(random, random.PointIn(-1.0, 1.0), random.Uniform(0.2, 1.0));
    Point const p = random.PointIn(-3.0, 3.0);
    bool const swapped = random.Flip();
    Point center = kPointSentinel;
    bool const byFirst = random.Flip();
    if (!ForLine(byFirst ? &p : nullptr, byFirst ? nullptr : &p, swapped, cell, &center)) {
      EXPECT_SAME_POINT(center, kPointSentinel);
      continue;
    }
    ++found;
    double const x = swapped ? p.y : p.x;
    double const y = swapped ? p.x : p.y;
    EXPECT_NEAR(center.y * x + y + center.x, 0.0, 1e-11);
    std::array<double, 4> rect;
    ASSERT_TRUE(RectOf(cell, &rect));
    EXPECT_TRUE(rect[0] - 1e-9 <= center.x && center.x <= rect[2] + 1e-9);
    EXPECT_TRUE(rect[1] - 1e-9 <= center.y && center.y <= rect[3] + 1e-9);
  }
  EXPECT_GT(found, 300);
}

TEST(GetCenterForLine, TakesThePointThatIsGiven) {
  Cell const cell{kRight};
  Point const p{0.5, -2.0};
  Point byFirst = kPointSentinel;
  Point bySecond = kPointSentinel;
  ASSERT_TRUE(ForLine(&p, nullptr, false, cell, &byFirst));
  ASSERT_TRUE(ForLine(nullptr, &p, false, cell, &bySecond));
  EXPECT_SAME_POINT(byFirst, bySecond);
}

TEST(GetCenterForLine, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4708;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int found[4] = {};
  for (int n = 0; n < 40000; ++n) {
    Cell const cell = n % 2 == 0 ? RandomCell(random) : FanOfRing(random, {0.0, 0.0}, 1.0);
    bool const hasP1 = random.Flip();
    bool const hasP2 = random.Flip();
    bool const swapped = random.Flip();
    Point p1 = n % 3 == 0 ? random.GridPoint(2) : random.PointIn(-2.0, 2.0);
    Point const p2 = n % 3 == 0 ? random.GridPoint(2) : random.PointIn(-2.0, 2.0);
    if (n % 50 == 0) p1.x = SpecialNumber(random);
    Point expected = kPointSentinel;
    Point center = kPointSentinel;
    bool const has = Reference::CellCenterForLine(hasP1, p1, hasP2, p2, swapped, cell, &expected);
    ASSERT_EQ(GeometryUtils::GetCenterForLine(hasP1, p1, hasP2, p2, swapped, &cell, &center), has)
        << Describe(cell);
    ASSERT_PRED_FORMAT2(PointBitsEqual, center, expected) << Describe(cell);
    if (has) ++found[(hasP1 ? 1 : 0) + (hasP2 ? 2 : 0)];
  }
  for (int count : found) EXPECT_GT(count, 500);
}

TEST(CellCentres, OfALineCellPassBothPointsWithinTheirTolerance) {
  constexpr std::uint64_t kSeed = 4709;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 1000; ++n) {
    auto const points = NoisyLine(random, 2, random.Uniform(0.001, 0.1));
    bool formFixed = false;
    bool xOfY = false;
    Cell cell;
    ASSERT_EQ(GeometryUtils::GetLineTriangles(points[0], points[1], &formFixed, &xOfY, &cell),
              ErrorCode::Ok);
    Point center;
    ASSERT_TRUE(CenterOf(cell, &center));
    for (auto const& p : points) {
      double const x = xOfY ? p.y : p.x;
      double const y = xOfY ? p.x : p.y;
      EXPECT_LE(std::fabs(center.y * x + y + center.x) / std::hypot(center.y, 1.0), p.w);
    }
  }
}

TEST(CellCentres, OfANarrowedLineCellPassEveryPointOfTheRun) {
  constexpr std::uint64_t kSeed = 4710;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int narrowed = 0;
  for (int run = 0; run < 200; ++run) {
    auto const points = NoisyLine(random, 8, 0.02);
    bool formFixed = false;
    bool xOfY = false;
    Cell cell;
    ASSERT_EQ(GeometryUtils::GetLineTriangles(points[0], points[1], &formFixed, &xOfY, &cell),
              ErrorCode::Ok);
    for (std::size_t i = 1; i + 1 < points.size(); ++i) {
      Cell next;
      ASSERT_EQ(GeometryUtils::GetLineTriangles(points[i], points[i + 1], &formFixed, &xOfY, &next),
                ErrorCode::Ok);
      Cell overlap;
      for (auto const& t : cell) GeometryUtils::GetOverlapping(t, &next, &overlap);
      cell = overlap;
      Point center;
      if (!CenterOf(cell, &center)) break;
      ++narrowed;
      for (std::size_t k = 0; k <= i + 1; ++k) {
        double const x = xOfY ? points[k].y : points[k].x;
        double const y = xOfY ? points[k].x : points[k].y;
        double const distance = std::fabs(center.y * x + y + center.x) / std::hypot(center.y, 1.0);
        EXPECT_LE(distance, points[k].w * (1.0 + 1e-6)) << "run " << run << " point " << k;
      }
    }
  }
  EXPECT_GT(narrowed, 500);
}

TEST(CellCentres, OfACircleCellPassAllThreePointsWithinTheirTolerance) {
  constexpr std::uint64_t kSeed = 4711;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int built = 0;
  for (int n = 0; n < 1000; ++n) {
    auto const points = NoisyArc(random, 3, random.Uniform(2.0, 50.0), 0.02);
    Cell cell;
    if (GeometryUtils::GetCircleTriangles(points[0], points[1], points[2], false, false, 0,
                                          &cell) != ErrorCode::Ok) {
      continue;
    }
    ++built;
    Point center;
    ASSERT_TRUE(CenterOf(cell, &center));
    double low = 0.0;
    double high = kInf;
    for (auto const& p : points) {
      double const distance = Reference::Distance({p.x, p.y}, center);
      low = std::max(low, distance - p.w);
      high = std::min(high, distance + p.w);
    }
    EXPECT_LT(low, high);
  }
  EXPECT_GT(built, 900);
}

}  // namespace
}  // namespace Vorn::Testing
