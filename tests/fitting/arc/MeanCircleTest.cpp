#include <cmath>
#include <string>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/FailingAllocation.h"
#include "support/Profiles.h"
#include "support/ReferenceFitting.h"
#include "support/Transcript.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;

/// Distances 5, 10 and 13 from the origin.
std::vector<WPoint> const kPoints = {{3, 4, 4}, {-6, 8, 2}, {5, -12, 4}};

// --- GetRadiusRange with fixed ends -------------------------------------------------------------

struct RangeInput {
  std::vector<WPoint> points = kPoints;
  std::int32_t begin = 0;
  std::int32_t count = 3;
  double tolerance = -1.0;
  bool firstFixed = false;
  Point first;
  bool lastFixed = false;
  Point last;
};

struct RangeOutput {
  bool ok = false;
  std::int32_t failIndex = kIntSentinel;
  double lowest = kSentinel;
  double highest = kSentinel;
};

template <class Library = GeometryUtils>
RangeOutput FindRange(RangeInput const& in) {
  RangeOutput out;
  out.ok = Library::GetRadiusRange(in.points, in.begin, in.count, 0, 0, in.tolerance, in.firstFixed,
                                   &in.first, in.lastFixed, &in.last, &out.failIndex, &out.lowest,
                                   &out.highest);
  return out;
}

TEST(GetRadiusRangeWithEnds, IntersectsTheBands) {
  RangeOutput const out = FindRange(RangeInput{});  // [1,9], [8,12], [9,17]
  EXPECT_TRUE(out.ok);
  EXPECT_EQ(out.failIndex, 3);
  EXPECT_EQ(out.lowest, 9.0);
  EXPECT_EQ(out.highest, 9.0);
}

TEST(GetRadiusRangeWithEnds, FailureNamesThePointAndKeepsTheIntervalBeforeIt) {
  RangeInput in;
  in.points[2].w = 3;
  RangeOutput const out = FindRange(in);
  EXPECT_FALSE(out.ok);
  EXPECT_EQ(out.failIndex, 2);
  EXPECT_EQ(out.lowest, 8.0);
  EXPECT_EQ(out.highest, 9.0);
}

TEST(GetRadiusRangeWithEnds, AToleranceThatReachesTheCentreFails) {
  RangeInput in;
  in.points[1].w = 10;  // exactly as far
  RangeOutput const out = FindRange(in);
  EXPECT_FALSE(out.ok);
  EXPECT_EQ(out.failIndex, 1);
  EXPECT_EQ(out.lowest, 1.0);
  in.points[1].w = Down(10.0);
  EXPECT_EQ(FindRange(in).failIndex, 3);
}

TEST(GetRadiusRangeWithEnds, AFirstPointThatReachesTheCentreWritesNoInterval) {
  RangeInput in;
  in.points[0].w = 5;
  RangeOutput const out = FindRange(in);
  EXPECT_FALSE(out.ok);
  EXPECT_EQ(out.failIndex, 0);
  EXPECT_EQ(out.lowest, kSentinel);
  EXPECT_EQ(out.highest, kSentinel);
}

TEST(GetRadiusRangeWithEnds, AFixedEndSetsTheRadiusAndKeepsTheToleranceOfItsPoint) {
  RangeInput in;
  in.firstFixed = true;
  in.first = {8.5, 0};  // [4.5, 12.5]
  in.points[2].w = 5;   // [8, 18]
  RangeOutput const out = FindRange(in);
  EXPECT_TRUE(out.ok);
  EXPECT_EQ(out.lowest, 8.5);
  EXPECT_EQ(out.highest, 8.5);
}

TEST(GetRadiusRangeWithEnds, TheLastFixedEndCounts) {
  RangeInput in;
  in.points = {{0, 10, 3}, {10, 0, 3}, {0, -10, 3}};
  in.firstFixed = in.lastFixed = true;
  in.first = {0, 9};
  in.last = {0, -11};
  RangeOutput const out = FindRange(in);
  EXPECT_TRUE(out.ok);
  EXPECT_EQ(out.lowest, 11.0);
  EXPECT_EQ(out.highest, 11.0);
}

TEST(GetRadiusRangeWithEnds, AFixedEndOutsideTheIntervalFails) {
  RangeInput in;
  in.points = {{0, 10, 3}, {10, 0, 0.5}};
  in.count = 2;
  in.firstFixed = true;
  in.first = {0, 11};  // [8, 14], then [9.5, 10.5]
  RangeOutput const out = FindRange(in);
  EXPECT_FALSE(out.ok);
  EXPECT_EQ(out.failIndex, 1);
  EXPECT_EQ(out.lowest, 9.5);
  EXPECT_EQ(out.highest, 10.5);
}

TEST(GetRadiusRangeWithEnds, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5601;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int found = 0;
  for (int i = 0; i < 1000; ++i) {
    RangeInput in;
    in.points = MakeArcPoints({0.1, 0}, random.Uniform(0.5, 8), 0, 3, random.Integer(2, 9), 0.5);
    for (WPoint& p : in.points) p.w = random.Uniform(0, 1.0);
    in.begin = random.Integer(0, 1);
    in.count = random.Integer(1, static_cast<std::int32_t>(in.points.size()) - in.begin);
    in.tolerance = random.Flip() ? -1.0 : random.Uniform(0, 0.5);
    in.firstFixed = random.Flip();
    in.lastFixed = random.Flip();
    in.first = {in.points.front().x + random.Uniform(-0.2, 0.2), in.points.front().y};
    in.last = {in.points.back().x + random.Uniform(-0.2, 0.2), in.points.back().y};
    RangeOutput const out = FindRange(in);
    RangeOutput const expected = FindRange<ReferenceFitting>(in);
    found += expected.ok ? 1 : 0;
    EXPECT_EQ(out.ok, expected.ok);
    EXPECT_EQ(out.failIndex, expected.failIndex);
    EXPECT_SAME_BITS(out.lowest, expected.lowest);
    EXPECT_SAME_BITS(out.highest, expected.highest);
  }
  EXPECT_GT(found, 100);
}

// --- AdjustCenter -------------------------------------------------------------------------------

TEST(AdjustCenter, MovesTheCentreStraightOntoTheBisector) {
  Point adjusted = kPointSentinel;
  EXPECT_TRUE(GeometryUtils::AdjustCenter({-2, 1}, {4, 1}, {3, 7}, &adjusted));
  EXPECT_EQ(adjusted.x, 1.0);
  EXPECT_EQ(adjusted.y, 7.0);
}

TEST(AdjustCenter, FailsUntouchedForCoincidingPoints) {
  Point adjusted = kPointSentinel;
  EXPECT_FALSE(GeometryUtils::AdjustCenter({2, 1}, {2, 1}, {3, 7}, &adjusted));
  EXPECT_SAME_POINT(adjusted, kPointSentinel);
}

TEST(AdjustCenter, AgreesWithTheReferenceAndKeepsEqualDistances) {
  constexpr std::uint64_t kSeed = 5602;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 500; ++i) {
    Point const p = random.PointIn(-9, 9);
    Point const q = random.PointIn(-9, 9);
    Point const c = random.PointIn(-9, 9);
    Point adjusted = kPointSentinel;
    Point expected = kPointSentinel;
    EXPECT_EQ(GeometryUtils::AdjustCenter(p, q, c, &adjusted),
              ReferenceFitting::AdjustCenter(p, q, c, &expected));
    EXPECT_SAME_POINT(adjusted, expected);
    EXPECT_NEAR(std::hypot(adjusted.x - p.x, adjusted.y - p.y),
                std::hypot(adjusted.x - q.x, adjusted.y - q.y), 1e-9);
  }
}

// --- IsCcw of a run -----------------------------------------------------------------------------

std::vector<WPoint> const kUpperArc = {
    {10, 0, .1}, {8, 6, .1}, {0, 10, .1}, {-8, 6, .1}, {-10, 0, .1}};

TEST(IsCcwOfARun, ComparesFirstMiddleAndLast) {
  bool ccw = false;
  EXPECT_EQ(GeometryUtils::IsCcw(kUpperArc, 0, 5, false, {}, false, {}, {}, &ccw), ErrorCode::Ok);
  EXPECT_TRUE(ccw);
  std::vector<WPoint> const backwards(kUpperArc.rbegin(), kUpperArc.rend());
  EXPECT_EQ(GeometryUtils::IsCcw(backwards, 1, 4, false, {}, false, {}, {}, &ccw), ErrorCode::Ok);
  EXPECT_FALSE(ccw);
}

TEST(IsCcwOfARun, FixedEndsReplaceTheEnds) {
  bool ccw = true;
  EXPECT_EQ(GeometryUtils::IsCcw(kUpperArc, 0, 5, true, {-10, 0}, true, {10, 0}, {}, &ccw),
            ErrorCode::Ok);
  EXPECT_FALSE(ccw);
}

TEST(IsCcwOfARun, TheMiddleOfAnEvenRunIsTheUpperOne) {
  // Of four points the middle one is at position 2.
  std::vector<WPoint> const points = {{0, 0, 1}, {1, -5, 1}, {2, 5, 1}, {3, 0, 1}};
  bool ccw = true;
  EXPECT_EQ(GeometryUtils::IsCcw(points, 0, 4, false, {}, false, {}, {}, &ccw), ErrorCode::Ok);
  EXPECT_FALSE(ccw);
}

TEST(IsCcwOfARun, FailsUntouchedForShortStraightOrBadRuns) {
  bool ccw = true;
  std::vector<WPoint> const straight = MakeLinePoints({0, 0}, 1, 2, 5, 0.1);
  for (std::int32_t count : {2, 0, -1, 6}) {
    EXPECT_EQ(GeometryUtils::IsCcw(kUpperArc, 0, count, false, {}, false, {}, {}, &ccw),
              ErrorCode::Failed);
  }
  EXPECT_EQ(GeometryUtils::IsCcw(kUpperArc, -1, 3, false, {}, false, {}, {}, &ccw),
            ErrorCode::Failed);
  EXPECT_EQ(GeometryUtils::IsCcw(straight, 0, 5, false, {}, false, {}, {}, &ccw),
            ErrorCode::Failed);
  EXPECT_TRUE(ccw);
}

// --- GetFittingCircle ---------------------------------------------------------------------------

struct CircleInput {
  std::vector<WPoint> points;
  std::int32_t begin = 0;
  std::int32_t count = 0;
  bool firstFixed = false;
  Point first = kPointSentinel;
  bool lastFixed = false;
  Point last = kPointSentinel;
};

struct CircleOutput {
  ErrorCode code = ErrorCode::Ok;
  Point first = kPointSentinel;
  Point last = kPointSentinel;
  std::int32_t fitCount = kIntSentinel;
  Point center = kPointSentinel;
  double radius = kSentinel;
  bool ccw = false;
  double extra = kSentinel;
};

template <class Library = GeometryUtils>
CircleOutput FitCircle(CircleInput const& in) {
  CircleOutput out;
  out.first = in.first;
  out.last = in.last;
  out.code = Library::GetFittingCircle(in.points, in.begin, in.count, in.firstFixed, &out.first,
                                       in.lastFixed, &out.last, &out.fitCount, &out.center,
                                       &out.radius, &out.ccw, &out.extra);
  return out;
}

CircleInput WholeRun(std::vector<WPoint> points) {
  CircleInput in;
  in.count = static_cast<std::int32_t>(points.size());
  in.points = std::move(points);
  return in;
}

std::string Transcribe(CircleOutput const& out) {
  Transcript transcript;
  transcript.Add("code", out.code);
  transcript.Add("first", out.first);
  transcript.Add("last", out.last);
  transcript.Add("fitCount", out.fitCount);
  transcript.Add("center", out.center);
  transcript.Add("radius", out.radius);
  transcript.Add("ccw", out.ccw);
  transcript.Add("extra", out.extra);
  return transcript.Text();
}

void ExpectUntouched(CircleInput const& in, ErrorCode code) {
  CircleOutput untouched;
  untouched.code = code;
  untouched.first = in.first;
  untouched.last = in.last;
  EXPECT_EQ(Transcribe(FitCircle(in)), Transcribe(untouched));
}

TEST(GetFittingCircle, ThreePointsThatFit) {
  CircleOutput const out = FitCircle(WholeRun({{10, 0, .1}, {0, 10, .1}, {-10, 0, .1}}));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.fitCount, 3);
  EXPECT_EQ(out.center.x, 0.0);
  EXPECT_EQ(out.center.y, 0.0);
  EXPECT_EQ(out.radius, 10.0);
  EXPECT_TRUE(out.ccw);
  EXPECT_SAME_POINT(out.first, (Point{10, 0}));
  EXPECT_EQ(out.last.x, -10.0);
  EXPECT_EQ(out.extra, kSentinel);
}

TEST(GetFittingCircle, CoversAWholeArc) {
  CircleOutput const out = FitCircle(WholeRun(MakeArcPoints({3, -2}, 25, 2, -2.5, 30, 0.01)));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.fitCount, 30);
  EXPECT_NEAR(out.center.x, 3.0, 1e-9);
  EXPECT_NEAR(out.center.y, -2.0, 1e-9);
  EXPECT_NEAR(out.radius, 25.0, 1e-9);
  EXPECT_FALSE(out.ccw);
}

TEST(GetFittingCircle, TheFourthPointOutOfToleranceLeavesLengthThree) {
  std::vector<WPoint> points = kUpperArc;
  points[3] = {-12, 12, 0.1};
  CircleOutput const out = FitCircle(WholeRun(points));
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.fitCount, 3);
  EXPECT_NEAR(out.radius, 10.0, 1e-12);
}

TEST(GetFittingCircle, CollinearFirstPointsFailUntouched) {
  // The solver notices a column of zeros; other collinear triples have a centre at no place.
  ExpectUntouched(WholeRun({{2, 0, .1}, {2, 1, .1}, {2, 2, .1}, {3, 3, .1}}), ErrorCode::Failed);
  ExpectUntouched(WholeRun({{0, 0, .1}, {1, 1, .1}, {2, 2, .1}, {3, 4, .1}}), ErrorCode::Failed);
}

TEST(GetFittingCircle, ShortOrBadRunsFailUntouched) {
  CircleInput in = WholeRun(kUpperArc);
  for (auto const& [begin, count] : std::vector<std::pair<std::int32_t, std::int32_t>>{
           {0, 2}, {0, 0}, {0, -1}, {0, 6}, {3, 3}, {-1, 4}, {2147483647, 2147483647}}) {
    in.begin = begin;
    in.count = count;
    ExpectUntouched(in, ErrorCode::Failed);
  }
}

TEST(GetFittingCircle, APointWhoseToleranceReachesTheCentreDoesNotFit) {
  std::vector<WPoint> points = kUpperArc;
  points[1].w = 10;
  ExpectUntouched(WholeRun(points), ErrorCode::Failed);
}

TEST(GetFittingCircle, PassesThroughFixedEnds) {
  CircleInput in = WholeRun(kUpperArc);
  in.firstFixed = in.lastFixed = true;
  in.first = {10.05, 0};
  in.last = {-10.05, 0};
  CircleOutput const out = FitCircle(in);
  EXPECT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(out.fitCount, 5);
  EXPECT_SAME_POINT(out.first, in.first);
  EXPECT_SAME_POINT(out.last, in.last);
  EXPECT_NEAR(std::hypot(out.first.x - out.center.x, out.first.y - out.center.y), out.radius,
              1e-12);
  EXPECT_NEAR(std::hypot(out.last.x - out.center.x, out.last.y - out.center.y), out.radius, 1e-12);
}

/// Deliberate: a later triple without circle is a failure, though a shorter fit was accepted.
TEST(GetFittingCircle, ALaterSingularTripleFailsWithTheShorterFitWritten) {
  std::vector<WPoint> points = {{0, 0, 3}, {4, 4, 0.5}, {8, 0, 0.5}, {8, -1, 3}, {8, -2, 3}};
  CircleOutput const out = FitCircle(WholeRun(points));
  EXPECT_EQ(Transcribe(out), Transcribe(FitCircle<ReferenceFitting>(WholeRun(points))));
  EXPECT_EQ(out.code, ErrorCode::Failed);
  EXPECT_GE(out.fitCount, 3);
}

TEST(GetFittingCircle, RunningOutOfMemoryIsACode) {
  CircleInput const in = WholeRun(MakeArcPoints({3, -2}, 25, 2, -2.5, 12, 0.01));
  int refused = 0;
  for (int number = 0; number < 200; ++number) {
    CircleOutput out;
    bool hasFailed = false;
    {
      FailingAllocation const failing(number);
      out.code = GeometryUtils::GetFittingCircle(in.points, 0, in.count, false, &out.first, false,
                                                 &out.last, &out.fitCount, &out.center, &out.radius,
                                                 &out.ccw, &out.extra);
      hasFailed = failing.HasFailed();
    }
    if (!hasFailed) {
      EXPECT_EQ(out.code, ErrorCode::Ok);
      break;
    }
    ++refused;
    EXPECT_EQ(out.code, ErrorCode::OutOfMemory) << "allocation " << number;
  }
  EXPECT_GT(refused, 0);
  EXPECT_LT(refused, 200);
}

TEST(GetFittingCircle, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5603;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int longer = 0;
  for (int i = 0; i < 1000; ++i) {
    CircleInput in;
    if (random.Flip()) {
      in.points = MakeProfile(&random, random.Integer(3, 16));
    } else {
      in.points = MakeArcPoints(random.PointIn(-20, 20), random.Uniform(2, 30), 1,
                                random.Uniform(-5, 5), random.Integer(3, 16), 0.05);
      for (WPoint& p : in.points) p.x += random.Uniform(-0.01, 0.01);
    }
    if (random.Integer(0, 5) == 0) AddHazard(&random, &in.points);
    in.begin = random.Integer(0, 1);
    in.count = random.Integer(2, static_cast<std::int32_t>(in.points.size()) - in.begin);
    in.firstFixed = random.Integer(0, 2) == 0;
    in.lastFixed = random.Integer(0, 2) == 0;
    WPoint const& front = in.points[static_cast<std::size_t>(in.begin)];
    WPoint const& back = in.points[static_cast<std::size_t>(in.begin + in.count - 1)];
    in.first = {front.x + 0.2 * front.w, front.y};
    in.last = {back.x, back.y - 0.2 * back.w};
    CircleOutput const expected = FitCircle<ReferenceFitting>(in);
    longer += expected.code == ErrorCode::Ok && expected.fitCount > 3 ? 1 : 0;
    ASSERT_EQ(Transcribe(FitCircle(in)), Transcribe(expected)) << "input " << i;
  }
  EXPECT_GT(longer, 100);
}

}  // namespace
}  // namespace Vorn::Testing
