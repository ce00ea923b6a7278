#include <algorithm>
#include <limits>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/CellInputs.h"
#include "support/ConvexClipping.h"
#include "support/RandomGeometry.h"
#include "support/ReferenceOverlap.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;
using Polygon = std::vector<Point>;

constexpr int kIntMin = std::numeric_limits<int>::min();
constexpr int kIntMax = std::numeric_limits<int>::max();

int CountOf(Polygon const& polygon) { return static_cast<int>(polygon.size()); }

Polygon RegularPolygon(int n, double radius) {
  Polygon polygon;
  for (int i = 0; i < n; ++i) {
    double const angle = 2.0 * 3.1415926535 * i / n;
    polygon.push_back({radius * std::cos(angle), radius * std::sin(angle)});
  }
  return polygon;
}

Polygon RandomConvexPolygon(RandomGeometry& random, int n) {
  std::vector<double> angles;
  for (int i = 0; i < n; ++i) angles.push_back(random.Uniform(-3.1, 3.1));
  std::sort(angles.begin(), angles.end());
  Polygon polygon;
  double const skew = random.Uniform(-2.0, 2.0);
  for (double angle : angles) {
    double const y = std::sin(angle);
    polygon.push_back({std::cos(angle) + skew * y, y});
  }
  if (random.Flip()) std::reverse(polygon.begin(), polygon.end());
  return polygon;
}

long double PolygonArea(Polygon const& polygon) {
  LongPolygon points;
  for (auto const& p : polygon) points.push_back({p.x, p.y});
  return std::fabs(SignedArea(points));
}

Cell FanFromFirst(Polygon const& polygon) {
  Cell fan;
  for (std::size_t k = 1; k + 1 < polygon.size(); ++k) {
    fan.push_back({{polygon[0], polygon[k], polygon[k + 1]}});
  }
  return fan;
}

TEST(ConvexPolygonDivide, RefusesFewerThanThreeVertices) {
  Polygon const square{{0.0, 0.0}, {1.0, 0.0}, {1.0, 1.0}, {0.0, 1.0}};
  for (int count : {2, 1, 0, -1, kIntMin}) {
    Cell cell{SentinelTriangle()};
    EXPECT_FALSE(GeometryUtils::ConvexPolygonDivide(square, 0, count, &cell));
    EXPECT_TRUE(SameCell({SentinelTriangle()}, cell));
  }
}

TEST(ConvexPolygonDivide, RefusesAnEmptyPolygon) {
  Cell cell;
  EXPECT_FALSE(GeometryUtils::ConvexPolygonDivide({}, 0, 0, &cell));
  EXPECT_FALSE(GeometryUtils::ConvexPolygonDivide({}, 0, 3, &cell));
  EXPECT_FALSE(GeometryUtils::ConvexPolygonDivide({}, 0, 4, &cell));
  EXPECT_TRUE(cell.empty());
}

TEST(ConvexPolygonDivide, RefusesRunsThatLeaveThePolygon) {
  Polygon const square{{0.0, 0.0}, {1.0, 0.0}, {1.0, 1.0}, {0.0, 1.0}};
  Cell cell;
  EXPECT_FALSE(GeometryUtils::ConvexPolygonDivide(square, 0, 5, &cell));
  EXPECT_FALSE(GeometryUtils::ConvexPolygonDivide(square, 0, kIntMax, &cell));
  for (int first : {-1, 2, 4, kIntMin, kIntMax, kIntMax - 1, kIntMax - 2}) {
    EXPECT_FALSE(GeometryUtils::ConvexPolygonDivide(square, first, 3, &cell)) << first;
  }
  EXPECT_TRUE(cell.empty());
}

TEST(ConvexPolygonDivide, TakesThreeVerticesFromTheGivenFirst) {
  Polygon const square{{0.0, 0.0}, {1.0, 0.0}, {1.0, 1.0}, {0.0, 1.0}};
  Cell cell{SentinelTriangle()};
  ASSERT_TRUE(GeometryUtils::ConvexPolygonDivide(square, 1, 3, &cell));
  EXPECT_TRUE(SameCell({SentinelTriangle(), {{square[1], square[2], square[3]}}}, cell));
}

TEST(ConvexPolygonDivide, IgnoresTheGivenFirstForMoreThanThreeVertices) {
  Polygon const square{{0.0, 0.0}, {1.0, 0.0}, {1.0, 1.0}, {0.0, 1.0}};
  for (int first : {0, 1, 3}) {
    Cell cell;
    ASSERT_TRUE(GeometryUtils::ConvexPolygonDivide(square, first, 4, &cell));
    EXPECT_TRUE(SameCell(FanFromFirst(square), cell));
  }
}

TEST(ConvexPolygonDivide, CutsFourVerticesIntoExactlyTwoTriangles) {
  Polygon const w{{0.0, 0.0}, {2.0, 0.0}, {3.0, 2.0}, {-1.0, 1.0}};
  Cell cell;
  ASSERT_TRUE(GeometryUtils::ConvexPolygonDivide(w, 0, 4, &cell));
  EXPECT_TRUE(SameCell({{{w[0], w[1], w[2]}}, {{w[0], w[2], w[3]}}}, cell));
}

TEST(ConvexPolygonDivide, UsesOnlyTheFirstCountVertices) {
  Polygon const hexagon = RegularPolygon(6, 2.0);
  Cell cell;
  ASSERT_TRUE(GeometryUtils::ConvexPolygonDivide(hexagon, 0, 4, &cell));
  EXPECT_TRUE(SameCell(FanFromFirst({hexagon.begin(), hexagon.begin() + 4}), cell));
}

TEST(ConvexPolygonDivide, IsTheFanOfTheFirstVertexForConvexPolygons) {
  constexpr std::uint64_t kSeed = 4301;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 3000; ++n) {
    Polygon const polygon = RandomConvexPolygon(random, random.Integer(3, 9));
    Cell cell;
    ASSERT_TRUE(GeometryUtils::ConvexPolygonDivide(polygon, 0, CountOf(polygon), &cell));
    ASSERT_TRUE(SameCell(FanFromFirst(polygon), cell)) << Describe(polygon);
    ASSERT_NEAR(static_cast<double>(TotalArea(cell)), static_cast<double>(PolygonArea(polygon)),
                1e-14);
  }
}

TEST(ConvexPolygonDivide, LeavesThePolygonAsItIs) {
  Polygon const original = RegularPolygon(7, 1.0);
  Polygon const polygon = original;
  Cell cell;
  ASSERT_TRUE(GeometryUtils::ConvexPolygonDivide(polygon, 0, 7, &cell));
  EXPECT_TRUE(SamePoints(original, polygon));
}

TEST(ConvexPolygonDivide, PassesDegeneratePolygonsOn) {
  Polygon const flat{{0.0, 0.0}, {1.0, 1.0}, {2.0, 2.0}, {3.0, 3.0}};
  Cell cell;
  ASSERT_TRUE(GeometryUtils::ConvexPolygonDivide(flat, 0, 4, &cell));
  EXPECT_EQ(cell.size(), 2U);
  Polygon const onePoint(5, Point{0.5, 0.25});
  cell.clear();
  ASSERT_TRUE(GeometryUtils::ConvexPolygonDivide(onePoint, 0, 5, &cell));
  EXPECT_EQ(cell.size(), 3U);
}

TEST(ConvexPolygonDivide, AgreesWithTheReferenceOnAnyPolygon) {
  // Self-crossing, repeated and not-a-number vertices included. The test of an ear at position 2
  // always succeeds, so no ear is ever tested whose vertices lie past the live ones.
  constexpr std::uint64_t kSeed = 4302;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int earsElsewhere = 0;
  for (int n = 0; n < 30000; ++n) {
    Polygon polygon;
    int const count = random.Integer(4, 9);
    for (int k = 0; k < count; ++k) {
      polygon.push_back(random.Flip() ? random.GridPoint(2) : random.PointIn(-2.0, 2.0));
    }
    if (n % 10 == 0) polygon[random.Integer(0, count - 1)].y = SpecialNumber(random);
    Cell expected;
    bool earPastEnd = false;
    bool const divided = Reference::Divide(polygon, 0, count, &expected, &earPastEnd);
    ASSERT_FALSE(earPastEnd) << Describe(polygon);
    Cell cell;
    ASSERT_EQ(GeometryUtils::ConvexPolygonDivide(polygon, 0, count, &cell), divided);
    ASSERT_TRUE(SameCell(expected, cell)) << Describe(polygon);
    if (!SameCell(FanFromFirst(polygon), cell)) ++earsElsewhere;
  }
  EXPECT_GT(earsElsewhere, 1000);
}

bool IsValid(Polygon const& polygon, int start, int count, int size) {
  return GeometryUtils::SimplePolygonIsValid(polygon, start, count, size);
}

TEST(SimplePolygonIsValid, ChecksTheSizesFirst) {
  Polygon const hexagon = RegularPolygon(6, 1.0);
  EXPECT_FALSE(IsValid(hexagon, 0, 4, 5));
  EXPECT_FALSE(IsValid(hexagon, 0, 6, 2));
  EXPECT_FALSE(IsValid(hexagon, 0, 6, 0));
  EXPECT_FALSE(IsValid(hexagon, 0, 6, -3));
  EXPECT_FALSE(IsValid(hexagon, 0, 2, 2));
  EXPECT_TRUE(IsValid(hexagon, 0, 6, 6));
}

TEST(SimplePolygonIsValid, AcceptsAnEarThatHoldsNoOtherVertex) {
  EXPECT_TRUE(IsValid(RegularPolygon(6, 1.0), 0, 6, 3));
  EXPECT_TRUE(IsValid(RegularPolygon(6, 1.0), 0, 6, 4));
}

TEST(SimplePolygonIsValid, RejectsAnEarThatHoldsAnotherVertex) {
  Polygon const dart{{0.0, 0.0}, {4.0, 0.0}, {4.0, 4.0}, {3.0, 1.0}};
  EXPECT_FALSE(IsValid(dart, 0, 4, 3));
}

TEST(SimplePolygonIsValid, LooksOnlyAtTheFirstCountVertices) {
  Polygon const polygon{{0.0, 0.0}, {4.0, 0.0}, {4.0, 4.0}, {0.0, 4.0}, {3.0, 1.0}};
  EXPECT_TRUE(IsValid(polygon, 0, 4, 3));
  EXPECT_FALSE(IsValid(polygon, 0, 5, 3));
}

TEST(SimplePolygonIsValid, TakesStartAndSizeAsTheBoundsOfTheTestedPart) {
  // From position 3 the tested part [3, 3) is empty, so nothing lies in it.
  Polygon const polygon{{3.0, 1.0}, {3.1, 1.0}, {3.2, 1.0}, {0.0, 0.0}, {4.0, 0.0}, {4.0, 4.0}};
  EXPECT_TRUE(IsValid(polygon, 3, 6, 3));
  EXPECT_FALSE(IsValid({polygon[3], polygon[4], polygon[5], polygon[0]}, 0, 4, 3));
}

TEST(SimplePolygonIsValid, AgreesWithTheReferenceForAllPositions) {
  constexpr std::uint64_t kSeed = 4303;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int rejected = 0;
  for (int n = 0; n < 3000; ++n) {
    Polygon polygon;
    int const count = random.Integer(3, 8);
    for (int k = 0; k < count; ++k) polygon.push_back(random.GridPoint(3));
    for (int start = 0; start < count; ++start) {
      for (int size = 2; size <= count + 1; ++size) {
        bool const expected = Reference::EarIsFree(polygon, start, count, size);
        ASSERT_EQ(IsValid(polygon, start, count, size), expected)
            << Describe(polygon) << " " << start << " " << size;
        if (size >= 3 && size < count && !expected) ++rejected;
      }
    }
  }
  EXPECT_GT(rejected, 1000);
}

TEST(SimplePolygonIsValid, RefusesRunsThatLeaveThePolygon) {
  Polygon const square{{0.0, 0.0}, {1.0, 0.0}, {1.0, 1.0}, {0.0, 1.0}};
  EXPECT_FALSE(IsValid(square, 0, 9, 3));
  EXPECT_FALSE(IsValid(square, 0, kIntMax, 3));
  EXPECT_FALSE(IsValid(square, 0, kIntMax, kIntMax - 1));
  EXPECT_FALSE(IsValid(square, -1, 4, 3));
  EXPECT_FALSE(IsValid(square, kIntMin, 4, 3));
  EXPECT_FALSE(IsValid(square, 9, 4, 3));
  EXPECT_FALSE(IsValid(square, kIntMax, 4, 3));
  EXPECT_FALSE(IsValid({}, 0, 5, 3));
}

bool IsInside(Point const& p, Polygon const& polygon, int begin, int end) {
  return GeometryUtils::PointIsInsideOfPolygon(p, polygon, begin, end);
}

TEST(PointIsInsideOfPolygon, IsFalseForAnEmptyRange) {
  Polygon const square{{0.0, 0.0}, {2.0, 0.0}, {2.0, 2.0}, {0.0, 2.0}};
  EXPECT_FALSE(IsInside({1.0, 1.0}, square, 0, 0));
  EXPECT_FALSE(IsInside({1.0, 1.0}, square, 3, 2));
  EXPECT_FALSE(IsInside({1.0, 1.0}, square, kIntMax, kIntMin));
  EXPECT_FALSE(IsInside({1.0, 1.0}, {}, 0, 0));
}

TEST(PointIsInsideOfPolygon, IsFalseForARangeThatLeavesThePolygon) {
  Polygon const square{{0.0, 0.0}, {2.0, 0.0}, {2.0, 2.0}, {0.0, 2.0}};
  EXPECT_FALSE(IsInside({1.0, 1.0}, square, 0, 5));
  EXPECT_FALSE(IsInside({1.0, 1.0}, square, -1, 4));
  EXPECT_FALSE(IsInside({1.0, 1.0}, square, kIntMin, kIntMax));
  EXPECT_FALSE(IsInside({1.0, 1.0}, {}, 0, 1));
}

TEST(PointIsInsideOfPolygon, TellsInsideFromOutsideInBothOrientations) {
  Polygon polygon{{0.0, 0.0}, {4.0, 0.0}, {4.0, 4.0}, {2.0, 1.0}, {0.0, 4.0}};
  for (int turn = 0; turn < 2; ++turn) {
    EXPECT_TRUE(IsInside({1.0, 1.0}, polygon, 0, 5));
    EXPECT_TRUE(IsInside({3.5, 3.0}, polygon, 0, 5));
    EXPECT_FALSE(IsInside({2.0, 2.0}, polygon, 0, 5));
    EXPECT_FALSE(IsInside({5.0, 1.0}, polygon, 0, 5));
    EXPECT_FALSE(IsInside({-1.0, 4.0}, polygon, 0, 5));
    std::reverse(polygon.begin(), polygon.end());
  }
}

TEST(PointIsInsideOfPolygon, ClosesTheGivenRangeOnly) {
  Polygon const polygon{{9.0, 9.0}, {0.0, 0.0}, {4.0, 0.0}, {0.0, 4.0}, {9.0, -9.0}};
  EXPECT_TRUE(IsInside({1.0, 1.0}, polygon, 1, 4));
  EXPECT_FALSE(IsInside({3.0, 3.0}, polygon, 1, 4));
}

TEST(PointIsInsideOfPolygon, IsEvenOddForSelfCrossingPolygons) {
  // The middle of a pentagram is wound twice.
  Polygon const corners = RegularPolygon(5, 1.0);
  Polygon const star{corners[0], corners[2], corners[4], corners[1], corners[3]};
  EXPECT_FALSE(IsInside({0.0, 0.0}, star, 0, 5));
  EXPECT_TRUE(IsInside({0.8, 0.0}, star, 0, 5));
}

TEST(PointIsInsideOfPolygon, IsTrueOrFalseOnTheBoundaryDependingOnTheEdge) {
  Polygon square{{0.0, 0.0}, {2.0, 0.0}, {2.0, 2.0}, {0.0, 2.0}};
  EXPECT_FALSE(IsInside({1.0, 0.0}, square, 0, 4));
  EXPECT_TRUE(IsInside({1.0, 2.0}, square, 0, 4));
  EXPECT_TRUE(IsInside({2.0, 1.0}, square, 0, 4));
  EXPECT_TRUE(IsInside({0.0, 1.0}, square, 0, 4));
  // Run the other way, the same upright side loses its points.
  std::reverse(square.begin(), square.end());
  EXPECT_FALSE(IsInside({2.0, 1.0}, square, 0, 4));
}

TEST(PointIsInsideOfPolygon, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 4304;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 20000; ++n) {
    Polygon polygon;
    int const count = random.Integer(1, 8);
    for (int k = 0; k < count; ++k) polygon.push_back(random.GridPoint(3));
    Point p = random.GridPoint(3);
    if (n % 20 == 0) p.y = SpecialNumber(random);
    int const begin = random.Integer(0, count);
    int const end = random.Integer(0, count);
    ASSERT_EQ(IsInside(p, polygon, begin, end), Reference::InPolygon(p, polygon, begin, end))
        << Describe(polygon);
  }
}

TEST(PointIsInsideOfPolygon, IsFalseForNotANumber) {
  Polygon const square{{0.0, 0.0}, {2.0, 0.0}, {2.0, 2.0}, {0.0, 2.0}};
  EXPECT_FALSE(IsInside({1.0, kNaN}, square, 0, 4));
}

}  // namespace
}  // namespace Vorn::Testing
