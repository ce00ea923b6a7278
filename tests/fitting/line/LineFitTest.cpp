#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/FittingCalls.h"
#include "support/Profiles.h"
#include "support/ReferenceFitting.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;
using Indices = std::vector<std::int32_t>;

LineFitInput WholeRun(std::vector<WPoint> points) {
  LineFitInput in;
  in.count = static_cast<std::int32_t>(points.size());
  in.points = std::move(points);
  return in;
}

// --- GetOptimalLineSegment ----------------------------------------------------------------------

struct Segment {
  bool ok = false;
  double sx = kSentinel;
  double sy = kSentinel;
  double ex = kSentinel;
  double ey = kSentinel;
};

Segment Cut(std::vector<Triangle> const& cell, Point const& from, Point const& to, bool xOfY,
            bool startFixed = false, Point const& start = {}, bool endFixed = false,
            Point const& end = {}) {
  Segment s;
  s.ok = GeometryUtils::GetOptimalLineSegment(&cell, from.x, from.y, to.x, to.y, xOfY, startFixed,
                                              start, endFixed, end, &s.sx, &s.sy, &s.ex, &s.ey);
  return s;
}

/// A cell of one parameter point: the line y = 2 (u = -2, v = 0), or x = 2 in the other form.
Triangle const kHorizontal = {{{-2, 0}, {-2, 0}, {-2, 0}}};

TEST(GetOptimalLineSegment, ProjectsTheFreeEndsOnTheLineOfTheCell) {
  Segment const s = Cut({kHorizontal}, {1, 5}, {7, -3}, false);
  EXPECT_TRUE(s.ok);
  EXPECT_EQ(s.sx, 1.0);
  EXPECT_EQ(s.sy, 2.0);
  EXPECT_EQ(s.ex, 7.0);
  EXPECT_EQ(s.ey, 2.0);
}

TEST(GetOptimalLineSegment, ExchangesTheAxesInTheOtherForm) {
  Segment const s = Cut({kHorizontal}, {5, 1}, {-3, 7}, true);
  EXPECT_TRUE(s.ok);
  EXPECT_EQ(s.sx, 2.0);
  EXPECT_EQ(s.sy, 1.0);
  EXPECT_EQ(s.ex, 2.0);
  EXPECT_EQ(s.ey, 7.0);
}

TEST(GetOptimalLineSegment, KeepsFixedEndsAsGiven) {
  Triangle const wide = {{{-3, -1}, {-1, -1}, {-2, 2}}};
  Segment const start = Cut({wide}, {0, 0}, {4, 2}, false, true, {0.1, 2.05});
  EXPECT_TRUE(start.ok);
  EXPECT_EQ(start.sx, 0.1);
  EXPECT_EQ(start.sy, 2.05);
  Segment const both = Cut({wide}, {0, 0}, {4, 2}, false, true, {0, 2}, true, {4, 2.5});
  EXPECT_TRUE(both.ok);
  EXPECT_EQ(both.sy, 2.0);
  EXPECT_EQ(both.ex, 4.0);
  EXPECT_EQ(both.ey, 2.5);
}

TEST(GetOptimalLineSegment, FailsUntouchedWithoutACentre) {
  for (Segment const& s :
       {Cut({}, {0, 0}, {1, 0}, false), Cut({kHorizontal}, {0, 0}, {1, 0}, false, true, {0, 50})}) {
    EXPECT_FALSE(s.ok);
    EXPECT_EQ(s.sx, kSentinel);
    EXPECT_EQ(s.sy, kSentinel);
    EXPECT_EQ(s.ex, kSentinel);
    EXPECT_EQ(s.ey, kSentinel);
  }
}

TEST(GetOptimalLineSegment, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5206;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 500; ++i) {
    std::vector<Triangle> cell;
    for (int k = random.Integer(0, 3); k > 0; --k) cell.push_back(random.TriangleIn(-2, 2));
    Point const from = random.PointIn(-9, 9);
    Point const to = random.PointIn(-9, 9);
    bool const xOfY = random.Flip();
    bool const startFixed = random.Integer(0, 2) == 0;
    bool const endFixed = random.Integer(0, 2) == 0;
    Point const start = random.PointIn(-2, 2);
    Point const end = random.PointIn(-2, 2);
    Segment const s = Cut(cell, from, to, xOfY, startFixed, start, endFixed, end);
    Segment e;
    e.ok =
        ReferenceFitting::GetOptimalLineSegment(&cell, from.x, from.y, to.x, to.y, xOfY, startFixed,
                                                start, endFixed, end, &e.sx, &e.sy, &e.ex, &e.ey);
    EXPECT_EQ(s.ok, e.ok);
    EXPECT_SAME_BITS(s.sx, e.sx);
    EXPECT_SAME_BITS(s.sy, e.sy);
    EXPECT_SAME_BITS(s.ex, e.ex);
    EXPECT_SAME_BITS(s.ey, e.ey);
  }
}

// --- GetFittingLine -----------------------------------------------------------------------------

TEST(GetFittingLine, BadArgumentsFailAndWriteNothing) {
  std::vector<WPoint> const points = MakeLinePoints({0, 0}, 1, 0, 5, 0.1);
  for (auto const& [start, count] : std::vector<std::pair<std::int32_t, std::int32_t>>{
           {0, 1}, {0, 0}, {0, -3}, {-1, 3}, {0, 6}, {4, 2}, {2147483647, 2147483647}}) {
    SCOPED_TRACE(testing::Message() << start << ' ' << count);
    LineFitInput in;
    in.points = points;
    in.start = start;
    in.count = count;
    in.indexList = {7};
    LineFitOutput const out = FitLine<GeometryUtils>(in);
    EXPECT_EQ(out.code, ErrorCode::Failed);
    EXPECT_EQ(out.count, kIntSentinel);
    EXPECT_EQ(out.deviation, kSentinel);
    EXPECT_EQ(out.deviationIndex, kIntSentinel);
    EXPECT_EQ(out.lineCode, ErrorCode{kIntSentinel});
    EXPECT_SAME_POINT(out.startPoint, kPointSentinel);
    EXPECT_SAME_POINT(out.endPoint, kPointSentinel);
    EXPECT_EQ(out.indexList, Indices{7});
    EXPECT_TRUE(out.progress.empty());
  }
}

TEST(GetFittingLine, TwoPointsAreJoinedHoweverCloseTheyAre) {
  LineFitInput in = WholeRun({{0, 0, 10}, {1, 0, 10}});
  in.indexList = {0, 1};
  LineFitOutput const out = FitLine<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 2);
  EXPECT_SAME_POINT(out.startPoint, (Point{0, 0}));
  EXPECT_SAME_POINT(out.endPoint, (Point{1, 0}));
  EXPECT_EQ(out.deviation, 0.0);
  EXPECT_EQ(out.deviationIndex, 0);
  EXPECT_EQ(out.lineCode, ErrorCode::Ok);
  EXPECT_TRUE(out.indexList.empty());
  EXPECT_EQ(out.progress, Indices{100});
}

TEST(GetFittingLine, TwoPointsKeepTheFixedEnds) {
  LineFitInput in = WholeRun({{0, 0, 0.5}, {4, 0, 0.5}});
  in.startFixed = in.endFixed = true;
  in.startPoint = {0, 1};
  in.endPoint = {4, 1};
  LineFitOutput const out = FitLine<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_SAME_POINT(out.startPoint, in.startPoint);
  EXPECT_SAME_POINT(out.endPoint, in.endPoint);
  EXPECT_EQ(out.deviation, 2.0);  // measured all the same, but nothing is made of it
}

TEST(GetFittingLine, TwoCoincidingPointsHaveNoDeviation) {
  LineFitOutput const out = FitLine<GeometryUtils>(WholeRun({{3, 3, 1}, {3, 3, 1}}));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 2);
  EXPECT_EQ(out.deviation, 0.0);
  EXPECT_EQ(out.deviationIndex, -1);
}

TEST(GetFittingLine, CollinearPointsAreCoveredWhole) {
  LineFitInput in = WholeRun(MakeLinePoints({0, 0}, 1, 0.5, 20, 0.1));
  in.indexList = {3};
  LineFitOutput const out = FitLine<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 20);
  EXPECT_LE(out.deviation, 1.0);
  EXPECT_TRUE(out.indexList.empty());
  EXPECT_EQ(out.lineCode, ErrorCode::Ok);
  EXPECT_NEAR(out.endPoint.x, 19.0, 0.1);
  EXPECT_NEAR(out.endPoint.y, 9.5, 0.1);
}

TEST(GetFittingLine, CoversVerticalRuns) {
  LineFitOutput const out =
      FitLine<GeometryUtils>(WholeRun(MakeLinePoints({5, 0}, 0, -1, 12, 0.1)));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 12);
  EXPECT_NEAR(out.startPoint.x, 5.0, 1e-12);
  EXPECT_NEAR(out.endPoint.y, -11.0, 1e-12);
}

TEST(GetFittingLine, ReportsEveryAcceptedPointAndTheEnd) {
  LineFitOutput const out = FitLine<GeometryUtils>(WholeRun(MakeLinePoints({0, 0}, 1, 0, 5, 0.1)));
  // Points 1, 2, 3 and 4 of 5 as they are taken, then the count.
  EXPECT_EQ(out.progress, (Indices{20, 40, 60, 80, 100}));
}

TEST(GetFittingLine, StopsBeforeACorner) {
  std::vector<WPoint> points = MakeLinePoints({0, 0}, 1, 0, 6, 0.1);
  for (int i = 1; i <= 5; ++i) points.push_back({5.0 + 0.7 * i, 0.9 * i, 0.1});
  LineFitOutput const out = FitLine<GeometryUtils>(WholeRun(points));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 6);
  EXPECT_LE(out.deviation, 1.0);
  EXPECT_EQ(out.lineCode, ErrorCode::Ok);
}

TEST(GetFittingLine, StopsWhereThePointsTurnBack) {
  std::vector<WPoint> points = MakeLinePoints({0, 0}, 1, 0, 5, 0.1);
  points.push_back({3.5, 0, 0.1});
  points.push_back({2.5, 0, 0.1});
  LineFitOutput const out = FitLine<GeometryUtils>(WholeRun(points));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 5);
  EXPECT_EQ(out.lineCode, ErrorCode::SelfIntersection);
  EXPECT_NEAR(out.endPoint.x, 4.0, 1e-12);
}

TEST(GetFittingLine, TurningBackAtOnceLeavesTwoPoints) {
  LineFitOutput const out =
      FitLine<GeometryUtils>(WholeRun({{0, 0, 0.1}, {4, 0, 0.1}, {2, 0, 0.1}, {0, 0, 0.1}}));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 2);
  EXPECT_EQ(out.lineCode, ErrorCode::SelfIntersection);
  EXPECT_SAME_POINT(out.startPoint, (Point{0, 0}));
  EXPECT_SAME_POINT(out.endPoint, (Point{4, 0}));
  EXPECT_EQ(out.deviation, 0.0);
}

TEST(GetFittingLine, KeepsAFixedStart) {
  LineFitInput in = WholeRun(MakeLinePoints({0, 0}, 1, 0, 10, 0.1));
  in.startFixed = true;
  in.startPoint = {0.0, 0.05};
  LineFitOutput const out = FitLine<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_SAME_POINT(out.startPoint, in.startPoint);
  EXPECT_EQ(out.count, 10);
  EXPECT_LE(out.deviation, 1.0);
}

TEST(GetFittingLine, AFixedEndOutOfReachShortensTheRun) {
  LineFitInput in = WholeRun(MakeLinePoints({0, 0}, 1, 0, 6, 0.1));
  in.endFixed = true;
  in.endPoint = {5, 3};
  LineFitOutput const out = FitLine<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_SAME_POINT(out.endPoint, in.endPoint);
  EXPECT_EQ(out.count, 2);
}

/// Neighbours closer than the sum of their tolerances have no pair cell.
TEST(GetFittingLine, ClosesBeforeAPairWithoutCell) {
  std::vector<WPoint> points = MakeLinePoints({0, 0}, 1, 0, 6, 0.1);
  points[4].w = 3.0;
  LineFitOutput const out = FitLine<GeometryUtils>(WholeRun(points));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 4);
  EXPECT_LE(out.deviation, 1.0);
}

TEST(GetFittingLine, WithoutAFirstCellTwoPointsAreLeft) {
  LineFitOutput const out =
      FitLine<GeometryUtils>(WholeRun({{0, 0, 5}, {1, 0, 5}, {2, 0, 0.1}, {3, 0, 0.1}}));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 2);
  EXPECT_EQ(out.lineCode, ErrorCode::Ok);
}

TEST(GetFittingLine, NotANumberEndsTheRun) {
  std::vector<WPoint> points = MakeLinePoints({0, 0}, 1, 0, 6, 0.1);
  points[3].y = kNaN;
  LineFitOutput const out = FitLine<GeometryUtils>(WholeRun(points));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.count, 3);
}

/// Above some size the running cell is rebuilt from the points that deviate most. Only then can a
/// whole run come out of tolerance: the points left out no longer bound it.
TEST(GetFittingLine, RebuildsAnOversizedCell) {
  constexpr std::uint64_t kSeed = 5207;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int outOfTolerance = 0;
  for (int i = 0; i < 6; ++i) {
    LineFitInput in = WholeRun(MakeLineWithTightStart(&random, 18));
    in.lastAttempt = i == 1;
    if (i == 2) in.indexList = {3, 5, 5, 900, -4, 4};
    LineFitOutput const out = FitLine<GeometryUtils>(in);
    EXPECT_EQ(Transcribe(out), Transcribe(FitLine<ReferenceFitting>(in)));
    if (out.deviation > 1.0) {
      ++outOfTolerance;
      EXPECT_FALSE(in.lastAttempt);
      EXPECT_EQ(out.count, 18);
      ASSERT_FALSE(out.indexList.empty());
      // A further attempt takes the points found into account.
      LineFitInput again = in;
      again.indexList = out.indexList;
      again.lastAttempt = true;
      LineFitOutput const second = FitLine<GeometryUtils>(again);
      EXPECT_LE(second.deviation, 1.0);
      EXPECT_EQ(Transcribe(second), Transcribe(FitLine<ReferenceFitting>(again)));
    }
  }
  EXPECT_GT(outOfTolerance, 0);
}

LineFitInput RandomLineInput(RandomGeometry* random) {
  LineFitInput in;
  in.points = MakeProfile(random, random->Integer(2, 30));
  if (random->Integer(0, 4) == 0) AddHazard(random, &in.points);
  auto const size = static_cast<std::int32_t>(in.points.size());
  in.start = random->Integer(0, 2) == 0 ? random->Integer(0, size - 2) : 0;
  in.count = random->Integer(0, 2) == 0 ? random->Integer(2, size - in.start) : size - in.start;
  auto const near = [random](WPoint const& p) {
    return Point{p.x + p.w * random->Uniform(-0.8, 0.8), p.y + p.w * random->Uniform(-0.8, 0.8)};
  };
  in.startFixed = random->Integer(0, 2) == 0;
  in.endFixed = random->Integer(0, 3) == 0;
  in.startPoint = near(in.points[static_cast<std::size_t>(in.start)]);
  in.endPoint = near(in.points[static_cast<std::size_t>(in.start + in.count - 1)]);
  in.lastAttempt = random->Flip();
  if (random->Integer(0, 3) == 0) in.indexList = {1, 2};
  return in;
}

TEST(GetFittingLine, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5208;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int turnedBack = 0;
  for (int i = 0; i < 300; ++i) {
    LineFitInput const in = RandomLineInput(&random);
    LineFitOutput const expected = FitLine<ReferenceFitting>(in);
    turnedBack += expected.lineCode == ErrorCode::SelfIntersection ? 1 : 0;
    ASSERT_EQ(Transcribe(FitLine<GeometryUtils>(in)), Transcribe(expected)) << "input " << i;
  }
  EXPECT_GT(turnedBack, 5);
}

TEST(GetFittingLine, LastAttemptEndsWithinToleranceOrAtTwoPoints) {
  constexpr std::uint64_t kSeed = 5209;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 80; ++i) {
    LineFitInput in = RandomLineInput(&random);
    in.lastAttempt = true;
    LineFitOutput const out = FitLine<GeometryUtils>(in);
    ASSERT_EQ(out.code, ErrorCode::Ok);
    ASSERT_GE(out.count, 2);
    ASSERT_LE(out.count, in.count);
    if (out.count > 2) {
      ASSERT_LE(out.deviation, 1.0);
    }
    ASSERT_TRUE(out.indexList.empty());
  }
}

// --- ReduceOverlappedTrianglesQuantityForStraightLine -------------------------------------------

TEST(ReduceOverlappedTrianglesQuantityForStraightLine, EmptiesTheCellAndFitsAShortRun) {
  std::vector<WPoint> const points = MakeLinePoints({0, 0}, 1, 0.25, 9, 0.1);
  std::vector<Triangle> cell = {kHorizontal, kHorizontal};
  EXPECT_TRUE(
      GeometryUtils::ReduceOverlappedTrianglesQuantityForStraightLine(points, 1, 7, 0.1, &cell));
  EXPECT_TRUE(cell.empty());
}

TEST(ReduceOverlappedTrianglesQuantityForStraightLine, NeedsFourPoints) {
  std::vector<WPoint> const points = MakeLinePoints({0, 0}, 1, 0.25, 9, 0.1);
  std::vector<Triangle> cell = {kHorizontal};
  for (int count : {3, 2, 0, -5}) {
    EXPECT_FALSE(GeometryUtils::ReduceOverlappedTrianglesQuantityForStraightLine(points, 0, count,
                                                                                 0.1, &cell));
  }
  EXPECT_EQ(cell.size(), 1U);
}

TEST(ReduceOverlappedTrianglesQuantityForStraightLine, FailsWithTheCellKeptWhereThereIsNoChord) {
  std::vector<WPoint> const closed = {{0, 0, 0.1}, {1, 0, 0.1}, {1, 1, 0.1}, {0, 0, 0.1}};
  std::vector<Triangle> cell = {kHorizontal};
  EXPECT_FALSE(
      GeometryUtils::ReduceOverlappedTrianglesQuantityForStraightLine(closed, 0, 4, 0.1, &cell));
  EXPECT_EQ(cell.size(), 1U);
}

TEST(ReduceOverlappedTrianglesQuantityForStraightLine, RefusesRunsThatLeaveTheVector) {
  std::vector<WPoint> const points = MakeLinePoints({0, 0}, 1, 0.25, 9, 0.1);
  std::vector<Triangle> cell = {kHorizontal};
  for (auto const& [start, count] :
       std::vector<std::pair<int, int>>{{0, 10}, {6, 4}, {-1, 5}, {2147483647, 2147483647}}) {
    EXPECT_FALSE(GeometryUtils::ReduceOverlappedTrianglesQuantityForStraightLine(
        points, start, count, 0.1, &cell));
  }
}

TEST(ReduceOverlappedTrianglesQuantityForStraightLine, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5210;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 200; ++i) {
    std::vector<WPoint> points = MakeProfile(&random, random.Integer(4, 15));
    if (random.Integer(0, 2) == 0) AddHazard(&random, &points);
    int const count = random.Integer(2, static_cast<int>(points.size()));
    double const tolerance = random.AnyDouble();  // plays no part
    std::vector<Triangle> cell = {kHorizontal};
    std::vector<Triangle> expectedCell = cell;
    bool const ok = GeometryUtils::ReduceOverlappedTrianglesQuantityForStraightLine(
        points, 0, count, tolerance, &cell);
    EXPECT_EQ(ok, ReferenceFitting::ReduceOverlappedTrianglesQuantityForStraightLine(
                      points, 0, count, 0.0, &expectedCell));
    EXPECT_EQ(cell.size(), expectedCell.size());
  }
}

}  // namespace
}  // namespace Vorn::Testing
