#include <array>
#include <cmath>
#include <string>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/Profiles.h"
#include "support/ReferenceFitting.h"
#include "support/Transcript.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;
using IndexedPoint = GeometryUtils::IndexedPoint;
using Samples = std::vector<IndexedPoint>;
using Triple = std::array<int, 3>;

// --- GetTriPointIndices -------------------------------------------------------------------------

Triple Indices(int step, int size, int mirror) {
  Triple i = {kIntSentinel, kIntSentinel, kIntSentinel};
  GeometryUtils::GetTriPointIndices(step, size, mirror, &i[0], &i[1], &i[2]);
  return i;
}

TEST(GetTriPointIndices, TakesInnerTriplesBelowAThirdAndTheFirstPointAbove) {
  EXPECT_EQ(Indices(1, 10, 0), (Triple{1, 5, 9}));
  EXPECT_EQ(Indices(2, 10, 0), (Triple{2, 5, 9}));
  EXPECT_EQ(Indices(3, 10, 0), (Triple{0, 3, 9}));
  EXPECT_EQ(Indices(4, 10, 0), (Triple{0, 4, 9}));
}

TEST(GetTriPointIndices, MirrorReflectsTheTriple) {
  EXPECT_EQ(Indices(1, 10, 1), (Triple{0, 4, 8}));
  EXPECT_EQ(Indices(3, 10, 1), (Triple{0, 6, 9}));
}

TEST(GetTriPointIndices, OnlyOneMirrors) {
  EXPECT_EQ(Indices(1, 10, 2), Indices(1, 10, 0));
  EXPECT_EQ(Indices(1, 10, -1), Indices(1, 10, 0));
}

TEST(GetTriPointIndices, ThreeSamplesGiveTheOneTriple) {
  EXPECT_EQ(Indices(1, 3, 0), (Triple{0, 1, 2}));
  EXPECT_EQ(Indices(1, 3, 1), (Triple{0, 1, 2}));
}

TEST(GetTriPointIndices, StepsBelowHalfGiveAscendingPositionsInTheList) {
  for (int size = 3; size < 80; ++size) {
    for (int step = 1; step <= (size - 1) / 2; ++step) {
      for (int mirror : {0, 1}) {
        Triple const i = Indices(step, size, mirror);
        EXPECT_TRUE(0 <= i[0] && i[0] < i[1] && i[1] < i[2] && i[2] < size)
            << size << ' ' << step << ' ' << mirror;
        Triple expected{};
        ReferenceFitting::GetTriPointIndices(step, size, mirror, &expected[0], &expected[1],
                                             &expected[2]);
        EXPECT_EQ(i, expected);
      }
    }
  }
}

// --- TriPointsCoordsToArray ---------------------------------------------------------------------

struct TripleCoords {
  std::array<double, 6> coords{};
  bool usedFirst = false;
  bool usedLast = false;
};

Samples const kFourSamples = {
    {{0, 1}, 0.1, 5}, {{2, 3}, 0.1, 6}, {{4, 5}, 0.1, 7}, {{6, 7}, 0.1, 8}};

TripleCoords Coords(int i0, int i1, int i2, bool firstFixed, bool lastFixed) {
  TripleCoords t;
  t.usedFirst = !firstFixed;
  t.usedLast = !lastFixed;
  GeometryUtils::TriPointsCoordsToArray(&kFourSamples, i0, i1, i2, firstFixed, {-1, -2}, lastFixed,
                                        {-3, -4}, &t.usedFirst, &t.usedLast, t.coords.data());
  return t;
}

TEST(TriPointsCoordsToArray, TakesTheSamplesWithoutFixedEnds) {
  TripleCoords const t = Coords(0, 1, 3, false, false);
  EXPECT_EQ(t.coords, (std::array<double, 6>{0, 1, 2, 3, 6, 7}));
  EXPECT_FALSE(t.usedFirst);
  EXPECT_FALSE(t.usedLast);
}

TEST(TriPointsCoordsToArray, FixedEndsReplaceTheEndsOfTheRun) {
  TripleCoords const t = Coords(0, 1, 3, true, true);
  EXPECT_EQ(t.coords, (std::array<double, 6>{-1, -2, 2, 3, -3, -4}));
  EXPECT_TRUE(t.usedFirst);
  EXPECT_TRUE(t.usedLast);
}

TEST(TriPointsCoordsToArray, FixedEndsReplaceNothingInside) {
  TripleCoords const t = Coords(1, 2, 3, true, false);
  EXPECT_EQ(t.coords, (std::array<double, 6>{2, 3, 4, 5, 6, 7}));
  EXPECT_FALSE(t.usedFirst);
  TripleCoords const u = Coords(0, 1, 2, false, true);
  EXPECT_EQ(u.coords, (std::array<double, 6>{0, 1, 2, 3, 4, 5}));
  EXPECT_FALSE(u.usedLast);
}

// --- ReduceCircleArcPoints ----------------------------------------------------------------------

struct ReduceInput {
  Samples samples;
  std::vector<Triangle> cell;
  int steps = 0;
  bool firstFixed = false;
  Point first;
  bool lastFixed = false;
  Point last;
  std::vector<WPoint> points;
  std::int32_t begin = 0;
  std::int32_t count = 0;
  bool ccw = true;
};

struct ReduceOutput {
  ErrorCode code;
  Samples samples;
  std::vector<Triangle> cell;
  Point first;
  Point last;
};

template <class Library>
ReduceOutput Reduce(ReduceInput const& in) {
  ReduceOutput out{ErrorCode::Ok, in.samples, in.cell, in.first, in.last};
  out.code = Library::ReduceCircleArcPoints(&out.samples, &out.cell, in.steps, in.firstFixed,
                                            &out.first, in.lastFixed, &out.last, in.points,
                                            in.begin, in.count, in.ccw);
  return out;
}

std::string Transcribe(ReduceOutput const& out) {
  Transcript transcript;
  transcript.Add("code", out.code);
  transcript.Add("samples", out.samples);
  transcript.Add("cell", out.cell);
  transcript.Add("first", out.first);
  transcript.Add("last", out.last);
  return transcript.Text();
}

Samples SamplesOf(std::vector<WPoint> const& points) {
  Samples samples;
  for (std::size_t i = 0; i < points.size(); ++i) {
    samples.push_back({{points[i].x, points[i].y}, points[i].w, static_cast<std::int32_t>(i)});
  }
  return samples;
}

/// A cell around a centre estimate.
std::vector<Triangle> CellAround(Point const& c, double size) {
  return {{{{c.x - size, c.y - size}, {c.x + size, c.y - size}, {c.x, c.y + 2 * size}}}};
}

/// Seven points on the unit circle from 30 to 150 degrees, every 20; two stick out radially, and no
/// two tolerances are the same.
ReduceInput SevenPoints() {
  ReduceInput in;
  double const degree = std::acos(-1.0) / 180.0;
  for (int i = 0; i < 7; ++i) {
    double const radius = i == 1 ? 0.9 : (i == 5 ? 1.1 : 1.0);
    double const angle = (30 + 20 * i) * degree;
    in.points.push_back({radius * std::cos(angle), radius * std::sin(angle), 0.01 * (i + 1)});
  }
  in.samples = SamplesOf(in.points);
  in.cell = CellAround({0, 0}, 0.001);
  in.steps = 3;
  in.count = 7;
  return in;
}

void ExpectUntouchedFailure(ReduceInput const& in) {
  ReduceOutput const out = Reduce<GeometryUtils>(in);
  EXPECT_EQ(out.code, ErrorCode::Failed);
  ReduceOutput const untouched{ErrorCode::Failed, in.samples, in.cell, in.first, in.last};
  EXPECT_EQ(Transcribe(out), Transcribe(untouched));
}

/// Triples of 7: (1,3,6), (0,3,5), (0,2,6), (0,4,6), (0,3,6): all positions are used.
TEST(ReduceCircleArcPoints, KeepsEndsNearestFarthestAndTheMeasuredMiddle) {
  ReduceInput const in = SevenPoints();
  ReduceOutput const out = Reduce<GeometryUtils>(in);
  ASSERT_EQ(out.code, ErrorCode::Ok);
  EXPECT_TRUE(out.cell.empty());
  ASSERT_EQ(out.samples.size(), 5U);
  EXPECT_EQ(out.samples[0].index, 0);
  EXPECT_EQ(out.samples[2].index, 3);
  EXPECT_EQ(out.samples[2].w, in.points[3].w);
  EXPECT_EQ(out.samples[4].index, 6);
  EXPECT_SAME_POINT(out.samples[1].pt, in.samples[1].pt);
  EXPECT_SAME_POINT(out.samples[3].pt, in.samples[5].pt);
}

/// The triple (0,3,6) of step 3 is used up already; the last one entered is (0,4,6) mirrored from
/// (0,2,6), so the tolerance last entered is that of position 6.
TEST(ReduceCircleArcPoints, NearestAndFarthestCarryTheLastToleranceAndNoIndex) {
  ReduceInput const in = SevenPoints();
  ReduceOutput const out = Reduce<GeometryUtils>(in);
  ASSERT_EQ(out.samples.size(), 5U);
  for (std::size_t i : {std::size_t{1}, std::size_t{3}}) {
    EXPECT_EQ(out.samples[i].w, in.points[6].w);
    EXPECT_EQ(out.samples[i].index, 0);
  }
}

TEST(ReduceCircleArcPoints, FixedEndsDoNotMoveTheSamplesOfTheEnds) {
  ReduceInput in = SevenPoints();
  in.firstFixed = in.lastFixed = true;
  in.first = {0.85, 0.55};
  in.last = {-0.85, 0.55};
  ReduceOutput const out = Reduce<GeometryUtils>(in);
  ASSERT_EQ(out.code, ErrorCode::Ok);
  EXPECT_SAME_POINT(out.samples.front().pt, in.samples.front().pt);
  EXPECT_SAME_POINT(out.samples.back().pt, in.samples.back().pt);
  EXPECT_SAME_POINT(out.first, in.first);
  EXPECT_SAME_POINT(out.last, in.last);
}

TEST(ReduceCircleArcPoints, EqualDistancesTakeTheThirdsOfTheMap) {
  ReduceInput in = SevenPoints();
  // Whole-number points on a circle of radius 25 about the origin: all distances are equal.
  in.points = {{24, 7, .1},  {20, 15, .1},  {15, 20, .1}, {7, 24, .1},
               {-7, 24, .1}, {-15, 20, .1}, {-24, 7, .1}};
  in.samples = SamplesOf(in.points);
  in.cell = {{{{0, 0}, {0, 0}, {0, 0}}}};
  ReduceOutput const out = Reduce<GeometryUtils>(in);
  ASSERT_EQ(out.code, ErrorCode::Ok);
  // Seven entries: (7 - 1) / 3 = 2, so positions 2 and 4; between them the measured middle.
  ASSERT_EQ(out.samples.size(), 5U);
  EXPECT_SAME_POINT(out.samples[1].pt, (Point{15, 20}));
  EXPECT_SAME_POINT(out.samples[2].pt, (Point{7, 24}));
  EXPECT_SAME_POINT(out.samples[3].pt, (Point{-7, 24}));
  EXPECT_EQ(out.samples[2].index, 3);
}

TEST(ReduceCircleArcPoints, FindsTheMiddleAcrossTheAngleSeam) {
  ReduceInput in = SevenPoints();
  for (WPoint& p : in.points) p = {-p.y, p.x, p.w};  // 120 to 240 degrees
  in.samples = SamplesOf(in.points);
  ReduceOutput const out = Reduce<GeometryUtils>(in);
  ASSERT_EQ(out.code, ErrorCode::Ok);
  ASSERT_EQ(out.samples.size(), 5U);
  EXPECT_EQ(out.samples[2].index, 3);
}

TEST(ReduceCircleArcPoints, DirectionSaysWhichMiddleIsMeant) {
  ReduceInput in = SevenPoints();
  in.ccw = false;  // the middle is then the bottom of the circle; all points are far from it
  ReduceOutput const out = Reduce<GeometryUtils>(in);
  ASSERT_EQ(out.code, ErrorCode::Ok);
  EXPECT_EQ(Transcribe(out), Transcribe(Reduce<ReferenceFitting>(in)));
  int middles = 0;
  for (IndexedPoint const& s : out.samples) middles += s.index == 3 ? 1 : 0;
  EXPECT_EQ(middles, 0);
}

/// Only the first step of 9 samples: (1,4,8) and (0,4,7). The middle point 3 is in no triple.
TEST(ReduceCircleArcPoints, AMiddleSampleOutsideTheMapOccursTwice) {
  ReduceInput in;
  in.points = MakeArcPoints({0, 0}, 10, 0.5, 1.6, 9, 0.01);
  in.points[3] = in.points[4];  // now as near to the middle direction, and first
  in.samples = SamplesOf(in.points);
  in.cell = CellAround({0, 0}, 0.001);
  in.steps = 1;
  in.count = 9;
  ReduceOutput const out = Reduce<GeometryUtils>(in);
  ASSERT_EQ(out.code, ErrorCode::Ok);
  std::vector<std::int32_t> indices;
  for (IndexedPoint const& s : out.samples) indices.push_back(s.index);
  int middles = 0;
  for (std::int32_t index : indices) middles += index == 3 ? 1 : 0;
  EXPECT_EQ(middles, 2);
  EXPECT_EQ(Transcribe(out), Transcribe(Reduce<ReferenceFitting>(in)));
}

TEST(ReduceCircleArcPoints, FailsUntouchedWithoutSteps) {
  ReduceInput in = SevenPoints();
  in.steps = 0;
  ExpectUntouchedFailure(in);
  in.steps = -4;
  ExpectUntouchedFailure(in);
}

TEST(ReduceCircleArcPoints, FailsUntouchedForABadRunOrCell) {
  ReduceInput in = SevenPoints();
  in.begin = -1;
  ExpectUntouchedFailure(in);
  in = SevenPoints();
  in.count = 0;
  ExpectUntouchedFailure(in);
  in = SevenPoints();
  in.cell.clear();
  ExpectUntouchedFailure(in);
}

TEST(ReduceCircleArcPoints, FailsUntouchedForARunThatLeavesTheVector) {
  ReduceInput in = SevenPoints();
  in.count = 8;
  ExpectUntouchedFailure(in);
  in.begin = 2147483647;
  ExpectUntouchedFailure(in);
}

TEST(ReduceCircleArcPoints, FailsUntouchedWithFewerThanFiveUsedSamples) {
  ReduceInput in = SevenPoints();
  in.points.resize(4);
  in.samples.resize(4);
  in.count = 4;
  in.steps = 1;
  ExpectUntouchedFailure(in);
  in.samples.clear();
  ExpectUntouchedFailure(in);
}

TEST(ReduceCircleArcPoints, FailsUntouchedWhereTheRunCloses) {
  ReduceInput in = SevenPoints();
  in.points.back().x = in.points.front().x;
  in.points.back().y = in.points.front().y;
  ExpectUntouchedFailure(in);
}

TEST(ReduceCircleArcPoints, FailsUntouchedWhereTheNormalMissesTheCircle) {
  ReduceInput in = SevenPoints();
  in.cell = {{{{kNaN, 0}, {1, 0}, {0, 1}}}};
  ExpectUntouchedFailure(in);
}

TEST(ReduceCircleArcPoints, StepsBeyondTheListReadNothingOutside) {
  ReduceInput in = SevenPoints();
  in.steps = 1000;
  ExpectUntouchedFailure(in);
}

TEST(ReduceCircleArcPoints, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5401;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int reduced = 0;
  for (int i = 0; i < 1500; ++i) {
    ReduceInput in;
    std::int32_t const size = random.Integer(3, 24);
    Point const center = random.PointIn(-20, 20);
    double const sweep = random.Uniform(-6, 6);
    in.points =
        MakeArcPoints(center, random.Uniform(1, 30), random.Uniform(-3, 3), sweep, size, 0.1);
    for (WPoint& p : in.points) {
      p.w = random.Uniform(0.01, 0.2);
      p.x += random.Uniform(-0.1, 0.1);
    }
    in.begin = random.Integer(0, 1) * random.Integer(0, size / 3);
    in.count = random.Integer(1, size - in.begin);
    for (std::int32_t k = in.begin; k < in.begin + in.count; ++k) {
      WPoint const& p = in.points[static_cast<std::size_t>(k)];
      if (random.Integer(0, 5) != 0) in.samples.push_back({{p.x, p.y}, p.w, k});
    }
    // What an earlier thinning leaves: records without index.
    if (!in.samples.empty() && random.Flip()) in.samples[in.samples.size() / 2].index = 0;
    in.cell = CellAround(random.Integer(0, 5) == 0 ? random.PointIn(-20, 20) : center, 0.05);
    in.steps = random.Integer(0, std::max(0, (static_cast<int>(in.samples.size()) - 1) / 2));
    in.firstFixed = random.Flip();
    in.lastFixed = random.Flip();
    in.first = {in.points[0].x + 0.01, in.points[0].y};
    in.last = {in.points.back().x, in.points.back().y - 0.01};
    in.ccw = random.Integer(0, 3) == 0 ? sweep < 0 : sweep > 0;
    ReduceOutput const expected = Reduce<ReferenceFitting>(in);
    reduced += expected.code == ErrorCode::Ok ? 1 : 0;
    ASSERT_EQ(Transcribe(Reduce<GeometryUtils>(in)), Transcribe(expected)) << "input " << i;
  }
  EXPECT_GT(reduced, 500);
}

}  // namespace
}  // namespace Vorn::Testing
