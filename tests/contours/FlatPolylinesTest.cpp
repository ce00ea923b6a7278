#include <cmath>
#include <cstdint>
#include <limits>
#include <new>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/FailingAllocation.h"
#include "support/FlatPolylineOracle.h"
#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Coords = std::vector<double>;
using Indices = std::vector<std::int32_t>;

constexpr double kPiLiteral = 3.14159265358979;
constexpr std::int32_t kLowest = std::numeric_limits<std::int32_t>::min();
constexpr std::int32_t kHighest = std::numeric_limits<std::int32_t>::max();

void ExpectArea(double expected, Coords const& coords, Indices const& indices) {
  double area = kSentinel;
  EXPECT_EQ(GeometryUtils::GetArea(coords, indices, &area), ErrorCode::Ok);
  EXPECT_SAME_BITS(area, expected);
}

void ExpectNoArea(Coords const& coords, Indices const& indices) {
  double area = kSentinel;
  EXPECT_EQ(GeometryUtils::GetArea(coords, indices, &area), ErrorCode::Failed);
  EXPECT_SAME_BITS(area, kSentinel);
}

/// Runs the check for both presets of found and holds it to leave coords alone.
void ExpectCheck(ErrorCode code, bool expected, Coords const& coords, Indices const& indices) {
  for (bool const preset : {false, true}) {
    Coords working = coords;
    bool found = preset;
    EXPECT_EQ(GeometryUtils::CheckPolySelfIntersection(working, indices, &found), code);
    EXPECT_EQ(found, code == ErrorCode::Ok ? expected : preset);
    ASSERT_EQ(working.size(), coords.size());
    for (std::size_t i = 0; i < coords.size(); ++i) EXPECT_SAME_BITS(working[i], coords[i]);
  }
}

void ExpectCrossing(Coords const& coords, Indices const& indices) {
  ExpectCheck(ErrorCode::Ok, true, coords, indices);
}
void ExpectFree(Coords const& coords, Indices const& indices) {
  ExpectCheck(ErrorCode::Ok, false, coords, indices);
}
void ExpectCheckFails(ErrorCode code, Coords const& coords, Indices const& indices) {
  ExpectCheck(code, false, coords, indices);
}

// Layout.

TEST(GetPolylineParam, SignOfTheEntryChoosesTheLayout) {
  for (std::int32_t const entry : {1, 2, 8, kHighest}) {
    PolylineParam param{-5, -5};
    EXPECT_TRUE(GeometryUtils::GetPolylineParam(entry, &param));
    EXPECT_EQ(param.kind, 0);
    EXPECT_EQ(param.stride, 2);
    EXPECT_EQ(GeometryUtils::GetIncrement(entry), 2U);
  }
  for (std::int32_t const entry : {0, -1, -8, kLowest}) {
    PolylineParam param{-5, -5};
    EXPECT_TRUE(GeometryUtils::GetPolylineParam(entry, &param));
    EXPECT_EQ(param.kind, 1);
    EXPECT_EQ(param.stride, 8);
    EXPECT_EQ(GeometryUtils::GetIncrement(entry), 8U);
  }
}

TEST(GetIndicesIndex, IsTheFirstEntryBeyondTheOffset) {
  Indices const indices{4, -12, 14};
  for (auto const& [offset, expected] :
       {std::pair{0U, 0U}, {3U, 0U}, {4U, 1U}, {11U, 1U}, {12U, 2U}, {13U, 2U}}) {
    std::uint32_t k = 77;
    EXPECT_TRUE(GeometryUtils::GetIndicesIndex(indices, offset, &k)) << offset;
    EXPECT_EQ(k, expected) << offset;
  }
}

TEST(GetIndicesIndex, TakesTheFirstEvenWhereEntriesShrink) {
  std::uint32_t k = 77;
  EXPECT_TRUE(GeometryUtils::GetIndicesIndex({2, 9, 3, 9}, 5, &k));
  EXPECT_EQ(k, 1U);
}

TEST(GetIndicesIndex, FailureLeavesOutputUntouched) {
  std::uint32_t k = 77;
  EXPECT_FALSE(GeometryUtils::GetIndicesIndex({}, 0, &k));
  EXPECT_FALSE(GeometryUtils::GetIndicesIndex({0}, 0, &k));
  EXPECT_FALSE(GeometryUtils::GetIndicesIndex({4, -12, 14}, 14, &k));
  EXPECT_FALSE(GeometryUtils::GetIndicesIndex({kHighest}, 0x7fffffffU, &k));
  EXPECT_FALSE(GeometryUtils::GetIndicesIndex({kLowest}, 0x80000000U, &k));
  EXPECT_FALSE(GeometryUtils::GetIndicesIndex({kLowest}, 0xffffffffU, &k));
  EXPECT_EQ(k, 77U);
}

TEST(GetIndicesIndex, KnowsTheMagnitudeOfTheLowestEntry) {
  std::uint32_t k = 77;
  EXPECT_TRUE(GeometryUtils::GetIndicesIndex({kHighest, kLowest}, 0x7fffffffU, &k));
  EXPECT_EQ(k, 1U);
}

// Area.

TEST(GetAreaOfFlatPolyline, SumsTheEdgesUpToTheLastVertexOfTheRun) {
  // The square without its closing edge, which passes through the origin and adds nothing.
  ExpectArea(-1.0, {0, 0, 1, 0, 1, 1, 0, 1}, {6});
  ExpectArea(1.0, {0, 0, 0, 1, 1, 1, 1, 0}, {6});
  // Two edges only.
  ExpectArea(-0.5, {0, 0, 1, 0, 1, 1, 0, 1}, {4});
}

TEST(GetAreaOfFlatPolyline, IsPositiveClockwise) {
  ExpectArea(-9.0, {1, 1, 4, 1, 4, 4, 1, 4, 1, 1}, {8});
  ExpectArea(9.0, {1, 1, 1, 4, 4, 4, 4, 1, 1, 1}, {8});
}

TEST(GetAreaOfFlatPolyline, RunsShareTheirJunction) {
  ExpectArea(-9.0, {1, 1, 4, 1, 4, 4, 1, 4, 1, 1}, {2, 6, 8});
  // An odd entry: the run passes it, the next one starts at it.
  ExpectArea(0.5 * (5 * 2 - 7 * 1), {1, 2, 5, 7}, {1});
}

TEST(GetAreaOfFlatPolyline, NothingToSumIsZero) {
  ExpectArea(0.0, {}, {});
  ExpectArea(0.0, {1, 2, 3}, {});
  ExpectArea(0.0, {}, {0});
  ExpectArea(0.0, {}, {0, 0, 0});
}

TEST(GetAreaOfFlatPolyline, RunThatGoesBackAddsNothing) {
  ExpectArea(-1.0, {0, 0, 1, 0, 1, 1, 0, 1}, {6, 2});
  // The run after it starts where the entry points, over edges that were counted before.
  ExpectArea(-1.5, {0, 0, 1, 0, 1, 1, 0, 1}, {6, 2, 4});
}

TEST(GetAreaOfFlatPolyline, RecordAddsChordsAndTwiceItsSector) {
  // From (1, 0) about the origin to (0, 1); one step only, which reads nine doubles further.
  Coords const quarter{1, 0, 0, 0, 2, 1, 0.25, 1.5, 0, 1};
  ExpectArea(0.5 * (4.0 * (0.25 - 1.5)), quarter, {-1});
  Coords const shifted{3, 5, 2, 7, 1, 1, 1.5, 0.25, 4, 9};
  double const chords = (4.0 - 2.0) * 9.0 + (4.0 - 3.0) * 7.0 + (2.0 - 3.0) * 5.0;
  ExpectArea(0.5 * (chords + (1.5 - 0.25)), shifted, {-1});
}

TEST(GetAreaOfFlatPolyline, DirectionOfARecordIsNotRead) {
  for (double const direction : {1.0, -1.0, 0.0, kNaN, kInf}) {
    ExpectArea(0.5 * (4.0 * (0.25 - 1.5)), {1, 0, 0, 0, 2, direction, 0.25, 1.5, 0, 1}, {-1});
  }
}

TEST(GetAreaOfFlatPolyline, WideAnglesAreTurnedByAFullCircle) {
  auto const quarterOf = [](double start, double end) {
    return Coords{1, 0, 0, 0, 3, 1, start, end, 0, 1};
  };
  double const turn = 2.0 * 9.0 * kPiLiteral;
  ExpectArea(0.5 * (9.0 * (2.0 - -2.0) - turn), quarterOf(2, -2), {-1});
  ExpectArea(0.5 * (9.0 * (-2.0 - 2.0) + turn), quarterOf(-2, 2), {-1});
  // From the literal on, not below it.
  ExpectArea(0.5 * (9.0 * kPiLiteral - turn), quarterOf(kPiLiteral, 0), {-1});
  ExpectArea(0.5 * (9.0 * -kPiLiteral + turn), quarterOf(0, kPiLiteral), {-1});
  ExpectArea(0.5 * (9.0 * Down(kPiLiteral)), quarterOf(Down(kPiLiteral), 0), {-1});
  ExpectArea(0.5 * (9.0 * -Down(kPiLiteral)), quarterOf(0, Down(kPiLiteral)), {-1});
}

TEST(GetAreaOfFlatPolyline, RecordsAreSteppedThroughDoubleByDouble) {
  // Three offsets are visited although only one record fits in.
  Coords const coords{1, -2, 3, 4, 0.5, 1, 0.25, 1.5, 2, -1, 0.75, 6};
  double sum = 0.0;
  for (std::size_t p = 0; p < 3; ++p) {
    double const* v = &coords[p];
    double const span = v[6] - v[7];
    sum += (v[8] - v[2]) * v[9] + (v[8] - v[0]) * v[3] + (v[2] - v[0]) * v[1] + v[4] * v[4] * span;
    if (std::fabs(span) >= kPiLiteral) {
      sum += (v[6] > v[7] ? -1.0 : 1.0) * (2.0 * (v[4] * v[4]) * kPiLiteral);
    }
  }
  ExpectArea(0.5 * sum, coords, {-3});
  // The first visit alone gives something else.
  double single = kSentinel;
  ASSERT_EQ(GeometryUtils::GetArea(coords, {-1}, &single), ErrorCode::Ok);
  EXPECT_NE(single, 0.5 * sum);
}

TEST(GetAreaOfFlatPolyline, TermOfARecordIsFormedBeforeItIsAdded) {
  // The straight run leaves 2^53, to which adding 1 twice is lost but adding 2 is not.
  Coords coords{-0x1p53, 0, 0, 1, 1, 1, 0, 1, 0.5, 0.5, 1, 1};
  // Run 1, one edge: 0*0 - 1*(-2^53). Run 2, one record at offset 2: (0, 1), centre (1, 1),
  // radius 0; its next vertex is (1, 1): 0*1 + 1*1 + 1*1.
  ExpectArea(0.5 * (0x1p53 + 2.0), coords, {2, -3});
}

TEST(GetAreaOfFlatPolyline, NeverReadsPastTheData) {
  ExpectNoArea({}, {1});
  ExpectNoArea({0, 0}, {2});
  ExpectNoArea({0, 0, 1}, {2});
  ExpectArea(0.0, {0, 0, 1, 0}, {2});
  ExpectNoArea({0, 0, 1, 0}, {4});
  ExpectNoArea({0, 0, 1, 0}, {3});
  // A record run of magnitude 1 reads up to offset 9, one of magnitude 2 up to 10.
  ExpectNoArea(Coords(9, 0.0), {-1});
  ExpectArea(0.0, Coords(10, 0.0), {-1});
  ExpectNoArea(Coords(10, 0.0), {-2});
  ExpectArea(0.0, Coords(11, 0.0), {-2});
  ExpectNoArea(Coords(16, 0.0), {-8});
  ExpectArea(0.0, Coords(17, 0.0), {-8});
  for (std::int32_t const entry : {kLowest, kLowest + 1, -kHighest + 1, kHighest - 1, kHighest}) {
    ExpectNoArea({0, 0, 1, 0, 1, 1, 0, 1}, {entry});
    ExpectNoArea({0, 0, 1, 0, 1, 1, 0, 1}, {6, entry});
    ExpectNoArea({0, 0, 1, 0, 1, 1, 0, 1}, {entry, 6});
  }
}

TEST(GetAreaOfFlatPolyline, NotANumberPropagates) {
  double area = kSentinel;
  EXPECT_EQ(GeometryUtils::GetArea({0, 0, kNaN, 0, 1, 1}, {4}, &area), ErrorCode::Ok);
  EXPECT_TRUE(std::isnan(area));
  area = kSentinel;
  EXPECT_EQ(GeometryUtils::GetArea({1, 0, 0, 0, 2, 1, kNaN, 1.5, 0, 1}, {-1}, &area),
            ErrorCode::Ok);
  EXPECT_TRUE(std::isnan(area));
  area = kSentinel;
  EXPECT_EQ(GeometryUtils::GetArea({1, 0, 0, 0, 2, 1, kInf, 1.5, 0, 1}, {-1}, &area),
            ErrorCode::Ok);
  EXPECT_EQ(area, kInf);
}

TEST(GetAreaOfFlatPolyline, NullOutputFails) {
  EXPECT_EQ(GeometryUtils::GetArea({0, 0, 1, 0}, {2}, nullptr), ErrorCode::Failed);
}

TEST(GetAreaOfFlatPolyline, IsExactOnGridPolygons) {
  RandomGeometry random(51);
  for (int round = 0; round < 1000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 51, round " << round);
    Coords coords;
    int const count = random.Integer(2, 9);
    for (int i = 0; i < count; ++i) {
      auto const p = random.GridPoint(50);
      coords.insert(coords.end(), {p.x, p.y});
    }
    double shoelace = 0.0;
    for (std::size_t i = 0; i + 3 < coords.size(); i += 2) {
      shoelace += coords[i + 2] * coords[i + 1] - coords[i] * coords[i + 3];
    }
    auto const last = static_cast<std::int32_t>(coords.size()) - 2;
    double area = kSentinel;
    ASSERT_EQ(GeometryUtils::GetArea(coords, {last}, &area), ErrorCode::Ok);
    EXPECT_EQ(area, 0.5 * shoelace);
    std::int32_t const cut = 2 * random.Integer(1, last / 2);
    ASSERT_EQ(GeometryUtils::GetArea(coords, {cut, last}, &area), ErrorCode::Ok);
    EXPECT_EQ(area, 0.5 * shoelace);
  }
}

// Orientation.

PolyOrientation Orientation(Coords const& coords, Indices const& indices) {
  return GeometryUtils::GetPolyOrientation(coords, indices);
}

TEST(GetPolyOrientation, FollowsTheTurnAtTheLowestVertex) {
  // Lowest in the middle, one neighbour on either side.
  EXPECT_EQ(Orientation({0, 5, 3, 0, 6, 5, 3, 9, 0, 5}, {8}), PolyOrientation::Ccw);
  EXPECT_EQ(Orientation({6, 5, 3, 0, 0, 5, 3, 9, 6, 5}, {8}), PolyOrientation::Cw);
}

TEST(GetPolyOrientation, ComparesSlopesWhenBothNeighboursLieOnOneSide) {
  // Both to the right of (0, 0), then both to the left.
  EXPECT_EQ(Orientation({4, 8, 0, 0, 4, 2, 4, 8}, {6}), PolyOrientation::Ccw);
  EXPECT_EQ(Orientation({4, 2, 0, 0, 4, 8, 4, 2}, {6}), PolyOrientation::Cw);
  EXPECT_EQ(Orientation({-4, 2, 0, 0, -4, 8, -4, 2}, {6}), PolyOrientation::Ccw);
  EXPECT_EQ(Orientation({-4, 8, 0, 0, -4, 2, -4, 8}, {6}), PolyOrientation::Cw);
  // Equal slopes count as clockwise.
  EXPECT_EQ(Orientation({4, 8, 0, 0, 2, 4, 4, 8}, {6}), PolyOrientation::Cw);
}

TEST(GetPolyOrientation, OneNeighbourStraightAboveIsNotDegenerate) {
  EXPECT_EQ(Orientation({0, 8, 0, 0, 4, 2, 0, 8}, {6}), PolyOrientation::Ccw);
  EXPECT_EQ(Orientation({4, 2, 0, 0, 0, 8, 4, 2}, {6}), PolyOrientation::Cw);
}

TEST(GetPolyOrientation, BothNeighboursStraightAboveAreDegenerate) {
  EXPECT_EQ(Orientation({3, 8, 3, 0, 3, 4, 3, 8}, {6}), PolyOrientation::OrientationDegenerate);
}

TEST(GetPolyOrientation, FirstOfEquallyLowVerticesDecides) {
  // (2, 0) and (4, 0) are equally low; at the first the polyline turns left, at the second the
  // other neighbour lies level.
  EXPECT_EQ(Orientation({0, 5, 2, 0, 4, 0, 6, 5, 0, 5}, {8}), PolyOrientation::Ccw);
  // A spike at the first, a plain turn at the second.
  EXPECT_EQ(Orientation({2, 5, 2, 0, 2, 6, 4, 0, 6, 5, 2, 5}, {10}),
            PolyOrientation::OrientationDegenerate);
}

TEST(GetPolyOrientation, ShrinkingYOfTheLastVertexOfARunIsNotSeen) {
  // The vertex at the last entry is not a start of a piece; in a closed polyline it is the first.
  EXPECT_EQ(Orientation({0, 5, 3, 0, 6, 5, 3, -9}, {6}), PolyOrientation::Ccw);
}

TEST(GetPolyOrientation, FirstVertexLooksBackOverTheEnd) {
  // Two runs: the wrap test uses 2, so the vertex before the last wraps to the first.
  EXPECT_EQ(Orientation({3, 0, 6, 5, 3, 9, 0, 5, 3, 0}, {4, 8}), PolyOrientation::Ccw);
  EXPECT_EQ(Orientation({3, 0, 0, 5, 3, 9, 6, 5, 3, 0}, {4, 8}), PolyOrientation::Cw);
}

TEST(GetPolyOrientation, VertexBeforeTheEndWrapsToTheFirstWithSeveralRuns) {
  // (3, 0) at offset 6 of length 8: the first vertex is next, not the one at offset 8.
  EXPECT_EQ(Orientation({6, 5, 3, 9, 0, 5, 3, 0, -50, -50}, {4, 8}), PolyOrientation::Ccw);
}

TEST(GetPolyOrientation, SingleRunWrapsEightDoublesBeforeItsEnd) {
  // Length 8: the first vertex, if lowest, takes itself for its next vertex.
  EXPECT_EQ(Orientation({3, 0, 6, 5, 3, 9, 0, 5, 3, 0}, {8}), PolyOrientation::Ccw);
  EXPECT_EQ(Orientation({3, 0, 0, 5, 3, 9, 6, 5, 3, 0}, {8}), PolyOrientation::Cw);
  EXPECT_EQ(Orientation({0, 0, 1, 0, 1, 1, 0, 1, 0, 0}, {8}),
            PolyOrientation::OrientationDegenerate);
  // Length 10: the lowest vertex at offset 2 takes the first vertex, on the left, for its next; its
  // true next vertex lies on the right.
  EXPECT_EQ(Orientation({0, 5, 3, 0, 6, 5, 6, 9, 0, 9, 0, 5}, {10}), PolyOrientation::Cw);
}

TEST(GetPolyOrientation, StrideComesFromTheRunThatHoldsTheOffset) {
  // A record run of one record, then a straight run: the lowest vertex is the junction at offset 8,
  // whose previous vertex lies a whole record before it.
  Coords const coords{0, 5, 9, 9, 1, 1, 0, 1, 3, 0, 6, 5, 3, 9, 0, 5};
  EXPECT_EQ(Orientation(coords, {-8, 14}), PolyOrientation::Ccw);
  // Straight run first: the lowest vertex, a record, has its next vertex a record further on.
  Coords const mirrored{0, 5, 3, 0, 9, 9, 1, 1, 0, 1, 6, 5, 0, 5};
  EXPECT_EQ(Orientation(mirrored, {2, -10, 12}), PolyOrientation::Ccw);
}

TEST(GetPolyOrientation, InconsistentArraysAreUnknown) {
  EXPECT_EQ(Orientation({}, {}), PolyOrientation::OrientationUnknown);
  EXPECT_EQ(Orientation({0, 5, 3, 0, 6, 5}, {}), PolyOrientation::OrientationUnknown);
  EXPECT_EQ(Orientation({0, 5, 3, 0, 6, 5}, {0}), PolyOrientation::OrientationUnknown);
  EXPECT_EQ(Orientation({}, {2}), PolyOrientation::OrientationUnknown);
  EXPECT_EQ(Orientation({0}, {2}), PolyOrientation::OrientationUnknown);
  EXPECT_EQ(Orientation({0, 5, 3, 0}, {8}), PolyOrientation::OrientationUnknown);
  // A single vertex, whose previous one would lie before the array.
  EXPECT_EQ(Orientation({0, 5, 3, 0, 6, 5}, {1}), PolyOrientation::OrientationUnknown);
  EXPECT_EQ(Orientation({0, 5, 9, 9, 1, 1, 0, 1, 3, 3}, {-1}), PolyOrientation::OrientationUnknown);
  // The lowest vertex at offset 2 is the last of its run, and no vertex follows in the array.
  EXPECT_EQ(Orientation({0, 5, 3, 0}, {3}), PolyOrientation::OrientationUnknown);
  for (std::int32_t const entry : {kLowest, kLowest + 1, kHighest}) {
    EXPECT_EQ(Orientation({0, 5, 3, 0, 6, 5, 3, 9}, {entry}), PolyOrientation::OrientationUnknown);
    EXPECT_EQ(Orientation({0, 5, 3, 0, 6, 5, 3, 9}, {6, entry}),
              PolyOrientation::OrientationUnknown);
  }
}

TEST(GetPolyOrientation, NotANumberCountsAsToTheRight) {
  EXPECT_EQ(Orientation({0, 5, 3, 0, kNaN, 5, 3, 9, 0, 5}, {8}), PolyOrientation::Ccw);
  EXPECT_EQ(Orientation({kNaN, 5, 3, 0, 0, 5, 3, 9, 0, 5}, {8}), PolyOrientation::Cw);
}

TEST(GetPolyOrientation, MatchesTheSignOfTheAreaOfSimplePolygons) {
  RandomGeometry random(52);
  int ccw = 0;
  for (int round = 0; round < 1000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 52, round " << round);
    // Star-shaped about the origin, with the lowest vertex neither first nor in the wrap's way.
    int const count = random.Integer(5, 9);
    double const sense = random.Flip() ? 1.0 : -1.0;
    Coords coords;
    for (int i = 0; i <= count; ++i) {
      double const angle = 0.3 + sense * (i % count) * 6.2 / count;
      double const radius = i % count == 0 ? 4.0 : random.Uniform(1, 6);
      coords.insert(coords.end(), {radius * std::cos(angle), radius * std::sin(angle)});
    }
    // The closing vertex repeats the first; two runs make the wrap test right for straight runs.
    coords[2 * static_cast<std::size_t>(count)] = coords[0];
    coords[2 * static_cast<std::size_t>(count) + 1] = coords[1];
    Indices const indices{4, 2 * count};
    double area = kSentinel;
    ASSERT_EQ(GeometryUtils::GetArea(coords, indices, &area), ErrorCode::Ok);
    ASSERT_NE(area, 0.0);
    EXPECT_EQ(Orientation(coords, indices),
              area < 0.0 ? PolyOrientation::Ccw : PolyOrientation::Cw);
    ccw += area < 0.0 ? 1 : 0;
  }
  EXPECT_GT(ccw, 300);
  EXPECT_LT(ccw, 700);
}

// Self-intersection.

TEST(CheckFlatPolyline, EmptyArraysFail) {
  ExpectCheckFails(ErrorCode::Failed, {}, {});
  ExpectCheckFails(ErrorCode::Failed, {}, {2});
  ExpectCheckFails(ErrorCode::Failed, {}, {0});
  ExpectCheckFails(ErrorCode::Failed, {0, 0, 1, 0}, {});
}

TEST(CheckFlatPolyline, OpenPolylineIsFree) {
  ExpectFree({0, 0, 1, 0, 1, 1, 0, 1}, {6});
  ExpectFree({0, 0, 1, 0}, {2});
}

TEST(CheckFlatPolyline, FigureEightCrosses) {
  ExpectCrossing({0, 0, 2, 2, 2, 0, 0, 2, 0, 0}, {8});
  ExpectCrossing({0, 0, 2, 2, 2, 0, 0, 2}, {6});
}

TEST(CheckFlatPolyline, ClosedPolylineTouchesItselfAtItsFirstVertex) {
  // Closed by the caller, closed for the call, and a triangle.
  ExpectCrossing({0, 0, 1, 0, 1, 1, 0, 1, 0, 0}, {8});
  ExpectCrossing({0, 0, 1, 0, 1, 1, 0, 1}, {8});
  ExpectCrossing({0, 0, 1, 0, 1, 1}, {6});
  // Two pieces there and back have no pair to test.
  ExpectFree({0, 0, 1, 0}, {4});
}

TEST(CheckFlatPolyline, LastEntryIsComparedBySign) {
  // Equal to the size: closed for the call. Larger: not valid. Negative: taken as it is.
  ExpectCheckFails(ErrorCode::Failed, {0, 0, 1, 0, 1, 1}, {7});
  // Also where no pair of pieces would be read at all.
  ExpectCheckFails(ErrorCode::Failed, {0, 0}, {3});
  ExpectCheckFails(ErrorCode::Failed, {0, 0, 1, 0, 1, 1}, {kHighest});
  ExpectCheckFails(ErrorCode::Failed, {0, 0, 1, 0, 1, 1}, {2, 8});
  ExpectFree({0, 0, 1, 0, 1, 1}, {-6});
  ExpectFree(Coords(16, 1.0), {-8});
  ExpectFree({0, 0, 1, 0, 1, 1}, {0});
}

TEST(CheckFlatPolyline, SingleDoubleCannotBeClosed) {
  ExpectCheckFails(ErrorCode::Failed, {5}, {1});
}

TEST(CheckFlatPolyline, ClosingVertexIsTakenBackWithItsCapacityToSpare) {
  Coords coords{0, 0, 1, 0, 1, 1, 0, 1};
  coords.reserve(64);
  double const* const data = coords.data();
  bool found = false;
  EXPECT_EQ(GeometryUtils::CheckPolySelfIntersection(coords, {8}, &found), ErrorCode::Ok);
  EXPECT_TRUE(found);
  EXPECT_EQ(coords, (Coords{0, 0, 1, 0, 1, 1, 0, 1}));
  EXPECT_EQ(coords.data(), data);
}

TEST(CheckFlatPolyline, ClosingVertexIsTakenBackOnFailure) {
  // The record run between leads to a radius of zero; the last run closes the polyline.
  Coords coords{0, 0, 5, 5, 0, 1, 0, 1, 9, 9, 5, 5, 0, 1, 0, 1, 20, 20};
  ExpectCheckFails(ErrorCode::InvalidArcRadius, coords, {-16, 18});
}

TEST(CheckFlatPolyline, ClosingVertexIsTakenBackWhenMemoryRunsOut) {
  Indices const indices{2, 4, 6, 8};
  Coords const original{0, 0, 1, 0, 1, 1, 0, 1};
  int failures = 0;
  for (int allocation = 0; allocation < 20; ++allocation) {
    Coords coords = original;
    bool found = false;
    bool hasThrown = false;
    {
      FailingAllocation const failing(allocation);
      try {
        GeometryUtils::CheckPolySelfIntersection(coords, indices, &found);
      } catch (std::bad_alloc const&) {
        hasThrown = true;
      }
    }
    EXPECT_EQ(coords, original);
    // The polyline is closed, so found tells whether the check came to its end.
    EXPECT_EQ(found, !hasThrown);
    failures += hasThrown ? 1 : 0;
  }
  EXPECT_GT(failures, 0);
  EXPECT_LT(failures, 20);
}

TEST(CheckFlatPolyline, ConsecutivePiecesOfARunAreNotTested) {
  ExpectFree({0, 0, 4, 0, 2, 0, 3, 3}, {4});
}

TEST(CheckFlatPolyline, ConsecutivePiecesOfTwoRunsAreTested) {
  // They share the junction, and sharing a vertex is touching.
  ExpectCrossing({0, 0, 1, 0, 1, 1, 0, 1}, {2, 6});
  // On one line they are parallel or collinear, which is no crossing.
  ExpectFree({0, 0, 1, 0, 2, 0}, {2, 4});
}

TEST(CheckFlatPolyline, OverlapOnOneLineIsNoCrossing) {
  ExpectFree({0, 0, 4, 0, 6, 0, 1, 0, 3, 0}, {8});
}

// Straight pieces and arcs. A record run needs its records only; what lies between them is skipped.

TEST(CheckFlatPolyline, StraightPieceAgainstALaterArcMayTouchOnce) {
  // The straight piece y = 0.5 from inside the unit circle outwards, then the arc about the origin.
  auto const polyline = [](double startX, double startAngle, double endAngle) {
    return FlatPolyline()
        .Vertex(startX, 0.5)
        .EndRunHere(1)
        .Record({5, 0.5}, {0, 0}, 1.0, 1.0, startAngle, endAngle)
        .EndRunHere(-1)
        .Vertex(9, 9);
  };
  auto const once = polyline(0, -1, 1);
  ExpectFree(once.coords, once.indices);
  auto const twice = polyline(-5, -0.5, 3.5 - 2 * kPiLiteral);
  ExpectCrossing(twice.coords, twice.indices);
  auto const degenerate = polyline(0, 1, 1);
  ExpectCheckFails(ErrorCode::Failed, degenerate.coords, degenerate.indices);
}

TEST(CheckFlatPolyline, ArcAgainstALaterStraightPieceMayNotTouch) {
  auto const polyline = [](double endX, double startAngle, double endAngle) {
    return FlatPolyline()
        .Record({9, 9}, {0, 0}, 1.0, 1.0, startAngle, endAngle)
        .EndRunHere(-1)
        .Vertex(0, 0.5)
        .EndRunHere(1)
        .Vertex(endX, 0.5);
  };
  auto const once = polyline(5, -1, 1);
  ExpectCrossing(once.coords, once.indices);
  auto const none = polyline(0.25, -1, 1);
  ExpectFree(none.coords, none.indices);
  auto const degenerate = polyline(5, 1, 1);
  ExpectCheckFails(ErrorCode::Failed, degenerate.coords, degenerate.indices);
}

// The unit circles about (0, 0) and (1, 0) meet at the angles +-1.047 of the first and +-2.094 of
// the second.
struct TwoArcs {
  double firstStart = -1.5;
  double secondEnd = -1.5;
  double secondRadius = 1.0;
};

FlatPolyline& AddArcs(FlatPolyline* polyline, TwoArcs const& arcs, bool areAdjacent) {
  polyline->Record({9, 9}, {0, 0}, 1.0, 1.0, arcs.firstStart, 1.5);
  if (!areAdjacent) polyline->Record({9, 9}, {50, 50}, 1.0, 1.0, 0.0, 1.0);
  return polyline->Record({9, 9}, {1, 0}, arcs.secondRadius, 1.0, 1.5, arcs.secondEnd);
}

TEST(CheckFlatPolyline, NeighbouringArcsMayTouchOnce) {
  FlatPolyline once;
  AddArcs(&once, {.firstStart = 0.5, .secondEnd = 2.5}, true).EndRunHere(-1).Vertex(20, 20);
  ExpectFree(once.coords, once.indices);
  FlatPolyline twice;
  AddArcs(&twice, {}, true).EndRunHere(-1).Vertex(20, 20);
  ExpectCrossing(twice.coords, twice.indices);
}

TEST(CheckFlatPolyline, ArcsFurtherApartMayNotTouch) {
  FlatPolyline once;
  AddArcs(&once, {.firstStart = 0.5, .secondEnd = 2.5}, false).EndRunHere(-1).Vertex(20, 20);
  ExpectCrossing(once.coords, once.indices);
  FlatPolyline none;
  AddArcs(&none, {.firstStart = 1.2, .secondEnd = 2.5}, false).EndRunHere(-1).Vertex(20, 20);
  ExpectFree(none.coords, none.indices);
}

TEST(CheckFlatPolyline, NeighboursAcrossTwoRunsOfRecordsMayTouchOnceToo) {
  FlatPolyline polyline;
  polyline.Record({9, 9}, {0, 0}, 1.0, 1.0, 0.5, 1.5).EndRunHere(-1);
  polyline.Record({9, 9}, {1, 0}, 1.0, 1.0, 1.5, 2.5).EndRunHere(-1).Vertex(20, 20);
  ExpectFree(polyline.coords, polyline.indices);
}

TEST(CheckFlatPolyline, ArcWithoutAPositiveRadiusIsNamed) {
  for (double const radius : {0.0, -0.0, -1.0}) {
    FlatPolyline polyline;
    AddArcs(&polyline, {.secondRadius = radius}, true).EndRunHere(-1).Vertex(20, 20);
    ExpectCheckFails(ErrorCode::InvalidArcRadius, polyline.coords, polyline.indices);
  }
}

TEST(CheckFlatPolyline, LaterRunsAreReadFromTheEndOfThisRunOn) {
  // Runs: straight, records, straight. The data of the records is read again as straight pieces for
  // the third run: a centre and a radius become vertices there. The piece from (30, 7) to (1, 0),
  // made of centre, radius and direction, crosses the first piece on the line y = 5.
  FlatPolyline polyline;
  polyline.Vertex(0, 5)
      .EndRunHere(1)
      .Record({40, 5}, {30, 7}, 1.0, 0.0, 0.25, 0.5)
      .EndRunHere(-1)
      .Vertex(40, 30)
      .EndRunHere(1)
      .Vertex(41, 31);
  ExpectCrossing(polyline.coords, polyline.indices);
  // Without the third run nothing is read that way.
  Indices const firstTwo{polyline.indices[0], polyline.indices[1]};
  ExpectFree(polyline.coords, firstTwo);
}

TEST(CheckFlatPolyline, FirstCrossingEndsTheCheck) {
  // An arc of equal angles is invalid for a straight piece.
  FlatPolyline polyline;
  polyline.Vertex(0, 0).Vertex(2, 2).EndRunHere(1);
  polyline.Record({2, 0}, {5, 5}, 0.0, 1.0, 1.0, 1.0).EndRunHere(-1).Vertex(9, 9);
  ExpectCheckFails(ErrorCode::Failed, polyline.coords, polyline.indices);
  // One more piece crosses the first one, ahead of the arc.
  FlatPolyline crossing;
  crossing.Vertex(0, 0).Vertex(2, 2).Vertex(2, 0).EndRunHere(1);
  crossing.Record({0, 2}, {5, 5}, 0.0, 1.0, 1.0, 1.0).EndRunHere(-1).Vertex(9, 9);
  ExpectCrossing(crossing.coords, crossing.indices);
}

TEST(CheckFlatPolyline, NeverReadsPastTheData) {
  // The third piece has no end in the data.
  ExpectCheckFails(ErrorCode::Failed, {0, 0, 1, 0, 1, 1, 7}, {6});
  ExpectCheckFails(ErrorCode::Failed, Coords(15, 1.0), {-16});
  ExpectFree({0, 0, 9, 9, 1, 1, 0, 1, 5, 5, 30, 30, 1, 1, 0, 1}, {-16});
  ExpectCheckFails(ErrorCode::Failed, {0, 0, 9, 9, 1, 1, 0, 1, 5, 5, 30, 30, 1, 1, 0}, {-16});
  for (std::int32_t const entry : {kLowest, kLowest + 1, -kHighest + 7}) {
    ExpectCheckFails(ErrorCode::Failed, {0, 0, 1, 0, 1, 1, 0, 1}, {entry});
    ExpectCheckFails(ErrorCode::Failed, {0, 0, 1, 0, 1, 1, 0, 1}, {2, entry});
    ExpectCheckFails(ErrorCode::Failed, {0, 0, 1, 0, 1, 1, 0, 1}, {entry, 6});
  }
  ExpectCheckFails(ErrorCode::Failed, {0, 0, 1, 0, 1, 1, 0, 1}, {kHighest, 6});
}

TEST(CheckFlatPolyline, NullOutputFails) {
  Coords coords{0, 0, 1, 0, 1, 1};
  EXPECT_EQ(GeometryUtils::CheckPolySelfIntersection(coords, {6}, nullptr), ErrorCode::Failed);
  EXPECT_EQ(coords, (Coords{0, 0, 1, 0, 1, 1}));
}

TEST(CheckFlatPolyline, AgreesWithAGeometryLibraryOnGridPolylines) {
  RandomGeometry random(53);
  int crossing = 0;
  int free = 0;
  for (int round = 0; round < 20000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 53, round " << round);
    Coords coords;
    int const count = random.Integer(2, 7);
    double lastX = kNaN;
    double lastY = kNaN;
    while (static_cast<int>(coords.size()) < 2 * count) {
      auto const p = random.GridPoint(round % 2 == 0 ? 3 : 15);
      if (p.x == lastX && p.y == lastY) continue;
      lastX = p.x;
      lastY = p.y;
      coords.insert(coords.end(), {p.x, p.y});
    }
    Indices indices;
    std::int32_t const last = 2 * count - 2;
    bool const isCut = last > 2 && random.Integer(0, 3) == 0;
    if (isCut) indices.push_back(2 * random.Integer(1, last / 2 - 1));
    indices.push_back(last);
    bool const expected = StraightRunsCross(coords, indices);
    ++(expected ? crossing : free);
    ExpectCheck(ErrorCode::Ok, expected, coords, indices);
  }
  EXPECT_GT(crossing, 3000);
  EXPECT_GT(free, 3000);
}

// Wrong input of every kind.

TEST(FlatPolylines, AnyArraysEndInADocumentedAnswer) {
  RandomGeometry random(54);
  int areas = 0;
  int checks = 0;
  double const odd[] = {kNaN, kInf, -kInf, 0.0, -0.0, 1e308, 5e-324, 1.0, -1.0, 3.0};
  std::int32_t const limits[] = {kLowest, kLowest + 1, -1, 0, 1, kHighest - 1, kHighest};
  for (int round = 0; round < 20000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 54, round " << round);
    Coords coords(static_cast<std::size_t>(random.Integer(0, 40)));
    for (double& value : coords) {
      value = random.Flip() ? odd[random.Integer(0, 9)] : random.AnyDouble();
    }
    Indices indices(static_cast<std::size_t>(random.Integer(0, 4)));
    for (std::int32_t& entry : indices) {
      entry = random.Integer(0, 5) == 0 ? limits[random.Integer(0, 6)] : random.Integer(-45, 45);
    }
    double area = kSentinel;
    ErrorCode const areaCode = GeometryUtils::GetArea(coords, indices, &area);
    if (areaCode == ErrorCode::Ok) {
      ++areas;
    } else {
      EXPECT_EQ(areaCode, ErrorCode::Failed);
      EXPECT_SAME_BITS(area, kSentinel);
    }
    Coords working = coords;
    bool found = true;
    ErrorCode const code = GeometryUtils::CheckPolySelfIntersection(working, indices, &found);
    EXPECT_TRUE(code == ErrorCode::Ok || code == ErrorCode::Failed ||
                code == ErrorCode::InvalidArcRadius);
    if (code == ErrorCode::Ok) {
      ++checks;
    } else {
      EXPECT_TRUE(found);
    }
    ASSERT_EQ(working.size(), coords.size());
    for (std::size_t i = 0; i < coords.size(); ++i) EXPECT_SAME_BITS(working[i], coords[i]);
    auto const orientation = static_cast<int>(GeometryUtils::GetPolyOrientation(coords, indices));
    EXPECT_GE(orientation, 0);
    EXPECT_LE(orientation, 3);
    if (indices.empty()) {
      EXPECT_EQ(orientation, 2);
    }
  }
  EXPECT_GT(areas, 1000);
  EXPECT_GT(checks, 1000);
}

}  // namespace
}  // namespace Vorn::Testing
