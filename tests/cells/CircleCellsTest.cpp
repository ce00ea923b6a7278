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

struct Triple {
  WPoint first;
  WPoint middle;
  WPoint last;
};

/// One call for a polygon and what it leaves in every output.
struct CirclePolygonCall {
  CirclePolygonCall(Triple const& t, bool firstFixed, bool lastFixed, int orientation) {
    vertices.fill({kSentinel, kSentinel});
    code = GeometryUtils::GetCirclePolygon(t.first, t.middle, t.last, firstFixed, lastFixed,
                                           orientation, &count, vertices.data());
  }

  std::vector<Point> Polygon() const {
    std::vector<Point> points;
    for (int i = 0; i < count; ++i) points.push_back({vertices[i].x, vertices[i].y});
    return points;
  }

  bool Untouched() const {
    for (auto const& v : vertices) {
      if (!SameBits(Point{v.x, v.y}, kPointSentinel)) return false;
    }
    return count == kIntSentinel;
  }

  int count = kIntSentinel;
  std::array<Point2D<double>, 6> vertices;
  ErrorCode code;
};

/// Counter-clockwise on a circle of radius 10 about the origin.
Triple const kArc{{10.0, 0.0, 0.1}, {6.0, 8.0, 0.1}, {-6.0, 8.0, 0.1}};

Triple Backwards(Triple const& t) { return {t.last, t.middle, t.first}; }

TEST(GetCirclePolygon, HasSixVerticesWithFreeEnds) {
  for (int orientation : {0, -1}) {
    CirclePolygonCall const call(kArc, false, false, orientation);
    EXPECT_EQ(call.code, ErrorCode::Ok);
    EXPECT_EQ(call.count, 6);
  }
  // Counter-clockwise rows have a negative area, clockwise ones a positive.
  CirclePolygonCall const back(Backwards(kArc), false, false, 1);
  EXPECT_EQ(back.code, ErrorCode::Ok);
  EXPECT_EQ(back.count, 6);
}

TEST(GetCirclePolygon, FailsWhenTheWantedTurnIsTheOtherOne) {
  CirclePolygonCall const call(kArc, false, false, 1);
  EXPECT_EQ(call.code, ErrorCode::OrientationMismatch);
  EXPECT_TRUE(call.Untouched());
  CirclePolygonCall const back(Backwards(kArc), false, false, -1);
  EXPECT_EQ(back.code, ErrorCode::OrientationMismatch);
  EXPECT_TRUE(back.Untouched());
}

TEST(GetCirclePolygon, HasFourVerticesWithOneFixedEnd) {
  for (bool firstFixed : {true, false}) {
    CirclePolygonCall const call(kArc, firstFixed, !firstFixed, 0);
    EXPECT_EQ(call.code, ErrorCode::Ok);
    EXPECT_EQ(call.count, 4);
    EXPECT_TRUE(SameBits(Point{call.vertices[4].x, call.vertices[4].y}, kPointSentinel));
  }
}

TEST(GetCirclePolygon, RepeatsTheSecondVertexWithBothEndsFixed) {
  CirclePolygonCall const call(kArc, true, true, 0);
  ASSERT_EQ(call.code, ErrorCode::Ok);
  ASSERT_EQ(call.count, 3);
  auto const p = call.Polygon();
  EXPECT_SAME_POINT(p[1], p[2]);
  EXPECT_FALSE(SameBits(p[0], p[1]));
}

TEST(GetCirclePolygon, IgnoresTheOrientationWithAFixedEnd) {
  for (int ends = 1; ends < 4; ++ends) {
    CirclePolygonCall const reference(kArc, (ends & 1) != 0, (ends & 2) != 0, 0);
    ASSERT_EQ(reference.code, ErrorCode::Ok);
    for (int orientation : {1, -1, 5}) {
      CirclePolygonCall const call(kArc, (ends & 1) != 0, (ends & 2) != 0, orientation);
      EXPECT_EQ(call.code, ErrorCode::Ok);
      EXPECT_TRUE(SamePoints(reference.Polygon(), call.Polygon()));
    }
  }
}

TEST(GetCirclePolygon, IgnoresTheToleranceOfAFixedEnd) {
  for (double w : {1e6, -3.0, 0.0, kNaN, kInf}) {
    Triple loose = kArc;
    loose.first.w = w;
    EXPECT_TRUE(SamePoints(CirclePolygonCall(kArc, true, false, 0).Polygon(),
                           CirclePolygonCall(loose, true, false, 0).Polygon()));
    loose.last.w = w;
    EXPECT_TRUE(SamePoints(CirclePolygonCall(kArc, true, true, 0).Polygon(),
                           CirclePolygonCall(loose, true, true, 0).Polygon()));
    loose.first.w = kArc.first.w;
    EXPECT_TRUE(SamePoints(CirclePolygonCall(kArc, false, true, 0).Polygon(),
                           CirclePolygonCall(loose, false, true, 0).Polygon()));
  }
}

TEST(GetCirclePolygon, OfOneUprightLineFails) {
  CirclePolygonCall const call({{1.0, 0.0, 0.1}, {1.0, 1.0, 0.1}, {1.0, 5.0, 0.1}}, false, false,
                               0);
  EXPECT_EQ(call.code, ErrorCode::Failed);
  EXPECT_TRUE(call.Untouched());
}

TEST(GetCirclePolygon, OfAnyLineFailsOnAGrid) {
  // The second pivot becomes exactly zero too, since the padding columns repeat the first two.
  RandomGeometry random(4601);
  for (int n = 0; n < 500; ++n) {
    Point const start = random.GridPoint(20);
    Point const step = random.GridPoint(5);
    int const k = random.Integer(-4, 4);
    Triple const t{Weighted(start, 0.1),
                   {start.x + step.x, start.y + step.y, 0.1},
                   {start.x + k * step.x, start.y + k * step.y, 0.1}};
    CirclePolygonCall const call(t, false, false, 0);
    EXPECT_NE(call.code, ErrorCode::Ok);
    EXPECT_TRUE(call.Untouched());
  }
}

TEST(GetCirclePolygon, OfEqualPointsFails) {
  CirclePolygonCall const call({{1.0, 2.0, 0.1}, {1.0, 2.0, 0.1}, {1.0, 2.0, 0.1}}, false, false,
                               0);
  EXPECT_EQ(call.code, ErrorCode::Failed);
  EXPECT_TRUE(call.Untouched());
}

TEST(GetCirclePolygon, OfZeroTolerancesIsTheCircumcentreSixTimes) {
  Triple t = kArc;
  t.first.w = t.middle.w = t.last.w = 0.0;
  CirclePolygonCall const call(t, false, false, 0);
  ASSERT_EQ(call.code, ErrorCode::Ok);
  ASSERT_EQ(call.count, 6);
  for (auto const& p : call.Polygon()) {
    EXPECT_NEAR(p.x, 0.0, 1e-14);
    EXPECT_NEAR(p.y, 0.0, 1e-14);
  }
}

TEST(GetCirclePolygon, TakesToleranceBeyondTheRadiusByTheSameFormula) {
  Triple t = kArc;
  t.middle.w = 12.0;
  for (int orientation : {0, 1, -1}) {
    std::vector<Point> expected;
    auto const code =
        Reference::CirclePolygon(t.first, t.middle, t.last, false, false, orientation, &expected);
    CirclePolygonCall const call(t, false, false, orientation);
    EXPECT_EQ(call.code, code);
    if (code == ErrorCode::Ok) {
      EXPECT_TRUE(SamePoints(expected, call.Polygon()));
    } else {
      EXPECT_TRUE(call.Untouched());
    }
  }
}

TEST(GetCirclePolygon, WantsThreeRowsOfTheGivenTurn) {
  // Nearly straight triples, whose rows turn both ways: with the wanted turn, rows of the other one
  // are skipped until fewer than three are left.
  constexpr std::uint64_t kSeed = 4602;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int rows[7] = {};
  int onlyTwoPositive = 0;
  for (int n = 0; n < 20000; ++n) {
    Triple const t{{0.0, 0.0, random.Uniform(0.0, 0.3)},
                   {5.0, random.Uniform(-0.3, 0.3), random.Uniform(0.0, 0.3)},
                   {10.0, 0.0, random.Uniform(0.0, 0.3)}};
    std::vector<Point> either;
    bool const sameTurn = Reference::CirclePolygon(t.first, t.middle, t.last, false, false, 0,
                                                   &either) == ErrorCode::Ok;
    CirclePolygonCall const positive(t, false, false, 1);
    CirclePolygonCall const negative(t, false, false, -1);
    CirclePolygonCall const any(t, false, false, 0);
    ASSERT_EQ(any.code, sameTurn ? ErrorCode::Ok : ErrorCode::OrientationMismatch);
    int const kept = (positive.code == ErrorCode::Ok ? positive.count : 0) +
                     (negative.code == ErrorCode::Ok ? negative.count : 0);
    ASSERT_GE(kept, 3);
    ASSERT_LE(kept, 6);
    if (sameTurn) {
      ASSERT_EQ(kept, 6);
    }
    ++rows[kept];
    if (!sameTurn && negative.count == 4) {
      ++onlyTwoPositive;
      ASSERT_EQ(positive.code, ErrorCode::OrientationMismatch);
      ASSERT_TRUE(positive.Untouched());
    }
  }
  // Splits into four and two, five and one, and three and three or none all occur.
  EXPECT_GT(onlyTwoPositive, 0);
  EXPECT_GT(rows[4], 0);
  EXPECT_GT(rows[5], 0);
  EXPECT_GT(rows[6], 0);
}

TEST(GetCirclePolygon, HoldsOnlyCentresWithinTheTolerances) {
  constexpr std::uint64_t kSeed = 4603;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int built = 0;
  for (int n = 0; n < 3000; ++n) {
    auto const points = NoisyArc(random, 3, random.Uniform(2.0, 50.0), 0.02);
    int const ends = n % 4;
    bool const firstFixed = (ends & 1) != 0;
    bool const lastFixed = (ends & 2) != 0;
    CirclePolygonCall const call({points[0], points[1], points[2]}, firstFixed, lastFixed, 0);
    if (call.code != ErrorCode::Ok) continue;
    ++built;
    auto const polygon = call.Polygon();
    Point center{};
    double sum = 0.0;
    for (auto const& p : polygon) {
      double const weight = random.Unit();
      center = {center.x + weight * p.x, center.y + weight * p.y};
      sum += weight;
    }
    center = {center.x / sum, center.y / sum};
    // Some radius must bring all three points within their tolerance, fixed ones exactly.
    double low = 0.0;
    double high = kInf;
    for (int k = 0; k < 3; ++k) {
      bool const fixed = (k == 0 && firstFixed) || (k == 2 && lastFixed);
      double const w = fixed ? 0.0 : points[k].w;
      double const distance = Reference::Distance({points[k].x, points[k].y}, center);
      low = std::max(low, distance - w);
      high = std::min(high, distance + w);
    }
    EXPECT_LE(low, high + 1e-8) << n;
  }
  EXPECT_GT(built, 2000);
}

Triple RandomTriple(RandomGeometry& random, int variant) {
  if (variant == 0) {
    auto const make = [&] { return Weighted(random.GridPoint(3), 0.25 * random.Integer(-1, 8)); };
    return {make(), make(), make()};
  }
  if (variant == 1) {
    auto const points = NoisyArc(random, 3, random.Uniform(0.5, 50.0), 0.05);
    return {points[0], points[1], points[2]};
  }
  if (variant == 2) {
    auto const points = NoisyLine(random, 3, 0.05);
    return {points[0], points[1], points[2]};
  }
  Triple t{Weighted(random.GridPoint(3), 0.1), Weighted(random.GridPoint(3), 0.1),
           Weighted(random.PointIn(-3.0, 3.0), 0.1)};
  double* const fields[] = {&t.first.x, &t.first.w, &t.middle.y, &t.middle.w, &t.last.x, &t.last.w};
  *fields[random.Integer(0, 5)] = variant == 3 ? SpecialNumber(random) : random.Wide(-300, 300);
  return t;
}

TEST(GetCirclePolygon, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4604;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int built = 0;
  for (int n = 0; n < 60000; ++n) {
    Triple const t = RandomTriple(random, n % 5);
    int const ends = random.Integer(0, 3);
    int const orientation = random.Integer(-1, 2);
    std::vector<Point> expected;
    auto const code = Reference::CirclePolygon(t.first, t.middle, t.last, (ends & 1) != 0,
                                               (ends & 2) != 0, orientation, &expected);
    CirclePolygonCall const call(t, (ends & 1) != 0, (ends & 2) != 0, orientation);
    ASSERT_EQ(call.code, code) << n;
    if (code == ErrorCode::Ok) {
      ASSERT_TRUE(SamePoints(expected, call.Polygon())) << n;
      ++built;
    } else {
      ASSERT_TRUE(call.Untouched()) << n;
    }
  }
  EXPECT_GT(built, 15000);
}

TEST(GetCircleTriangles, AreTheFanOfThePolygonAndAreAppended) {
  for (int ends = 0; ends < 4; ++ends) {
    bool const firstFixed = (ends & 1) != 0;
    bool const lastFixed = (ends & 2) != 0;
    auto const p = CirclePolygonCall(kArc, firstFixed, lastFixed, 0).Polygon();
    Cell expected{SentinelTriangle()};
    for (std::size_t k = 1; k + 1 < p.size(); ++k) expected.push_back({{p[0], p[k], p[k + 1]}});
    Cell cell{SentinelTriangle()};
    ASSERT_EQ(GeometryUtils::GetCircleTriangles(kArc.first, kArc.middle, kArc.last, firstFixed,
                                                lastFixed, 0, &cell),
              ErrorCode::Ok);
    EXPECT_TRUE(SameCell(expected, cell));
  }
}

TEST(GetCircleTriangles, LeaveTheCellOnFailure) {
  Cell cell{SentinelTriangle()};
  EXPECT_EQ(GeometryUtils::GetCircleTriangles({1.0, 0.0, 0.1}, {1.0, 1.0, 0.1}, {1.0, 5.0, 0.1},
                                              false, false, 0, &cell),
            ErrorCode::Failed);
  EXPECT_EQ(
      GeometryUtils::GetCircleTriangles(kArc.first, kArc.middle, kArc.last, false, false, 1, &cell),
      ErrorCode::OrientationMismatch);
  EXPECT_TRUE(SameCell({SentinelTriangle()}, cell));
}

TEST(GetCircleTriangles, HaveTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4605;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 30000; ++n) {
    Triple const t = RandomTriple(random, n % 5);
    int const ends = random.Integer(0, 3);
    int const orientation = random.Integer(-1, 1);
    std::vector<Point> polygon;
    auto code = Reference::CirclePolygon(t.first, t.middle, t.last, (ends & 1) != 0,
                                         (ends & 2) != 0, orientation, &polygon);
    Cell expected{SentinelTriangle()};
    if (code == ErrorCode::Ok &&
        !Reference::Divide(polygon, 0, static_cast<int>(polygon.size()), &expected)) {
      code = ErrorCode::Failed;
    }
    Cell cell{SentinelTriangle()};
    ASSERT_EQ(GeometryUtils::GetCircleTriangles(t.first, t.middle, t.last, (ends & 1) != 0,
                                                (ends & 2) != 0, orientation, &cell),
              code)
        << n;
    ASSERT_TRUE(SameCell(expected, cell)) << n;
  }
}

}  // namespace
}  // namespace Vorn::Testing
