#include <cmath>
#include <cstdint>
#include <set>
#include <utility>

#include "geometry/cells/fast/ChordCutter.h"
#include "geometry/cells/fast/Cutter.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/CellInputs.h"
#include "support/RandomGeometry.h"

// Where a cutter answers at once, it must answer what the full overlap answers, bit by bit.

namespace Vorn::Testing {
namespace {

using Cells::BoxedTriangle;
using Cells::Cutter;
using Cells::Magnitude;
using Cells::Sight;
using Triangles::Overlap;
using Triangles::PreparedTriangle;
using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

/// Knows the size of both triangles, as in a cell of one triangle.
Cutter CutterFor(Triangle const& other, Triangle const& cutter) {
  Magnitude magnitude;
  magnitude.Include(other);
  return Cutter(cutter, magnitude);
}

Cutter::Place PlaceOf(Triangle const& other, Triangle const& cutter) {
  Sight sight;
  return CutterFor(other, cutter).PlaceOf(BoxedTriangle(other), &sight);
}

void ExpectSameOverlap(Triangle const& other, Triangle const& cutter) {
  Overlap plain;
  Triangles::FindOverlap(PreparedTriangle(other), PreparedTriangle(cutter), &plain);
  Cell const expected(plain.parts.begin(), plain.parts.end());
  Overlap fast;
  if (CutterFor(other, cutter).Cut(BoxedTriangle(other), &fast) == Cutter::Rest::Whole) {
    EXPECT_EQ(plain.status, GeometryUtils::OverlappingStatus::Overlap);
    EXPECT_TRUE(SameCell(expected, Cell(Triangles::kCopiesOfContained, other)))
        << Describe(other) << " within " << Describe(cutter);
    return;
  }
  Cell const actual(fast.parts.begin(), fast.parts.end());
  EXPECT_EQ(fast.status, plain.status);
  EXPECT_TRUE(SameCell(expected, actual)) << Describe(other) << " cut by " << Describe(cutter);
}

/// How often each answer was given.
struct Tally {
  int within = 0;
  int apart = 0;
  int crossing = 0;
  int unclear = 0;

  void Count(Cutter::Place place) {
    within += place == Cutter::Place::Within ? 1 : 0;
    apart += place == Cutter::Place::Apart ? 1 : 0;
    crossing += place == Cutter::Place::Crossing ? 1 : 0;
    unclear += place == Cutter::Place::Unclear ? 1 : 0;
  }
};

template <typename Make>
Tally CompareOnRandomPairs(std::uint64_t seed, int count, Make const& make) {
  RandomGeometry random(seed);
  Tally tally;
  for (int i = 0; i < count; ++i) {
    SCOPED_TRACE(testing::Message() << "seed " << seed << ", pair " << i);
    TrianglePair const pair = make(random);
    ExpectSameOverlap(pair.first, pair.second);
    ExpectSameOverlap(pair.second, pair.first);
    tally.Count(PlaceOf(pair.first, pair.second));
    if (testing::Test::HasFailure()) break;
  }
  return tally;
}

Triangle Moved(Triangle triangle, Point const& by) {
  for (Point& p : triangle.pts) p = {p.x + by.x, p.y + by.y};
  return triangle;
}

Triangle const kLarge{{{0, 0}, {4, 0}, {0, 4}}};

TEST(Cutter, SeesWhatIsClearlyWithin) {
  Triangle const inside{{{1, 1}, {1.5, 1.25}, {1.125, 1.75}}};
  EXPECT_EQ(PlaceOf(inside, kLarge), Cutter::Place::Within);
  EXPECT_EQ(PlaceOf(Reversed(inside), kLarge), Cutter::Place::Within);
  EXPECT_EQ(PlaceOf(inside, Reversed(kLarge)), Cutter::Place::Within);
  ExpectSameOverlap(inside, kLarge);
  ExpectSameOverlap(inside, Reversed(kLarge));
}

TEST(Cutter, SeesWhatIsClearlyBeyondASide) {
  // Beyond the long side, with boxes that meet.
  Triangle const beyond{{{3, 2}, {2.25, 3}, {3.25, 3.5}}};
  EXPECT_EQ(PlaceOf(beyond, kLarge), Cutter::Place::Apart);
  EXPECT_EQ(PlaceOf(beyond, Reversed(kLarge)), Cutter::Place::Apart);
  ExpectSameOverlap(beyond, kLarge);
}

TEST(Cutter, SeesWhatIsBeyondASideThoughItCrossesTheLinesOfOthers) {
  // Below the lower side; its own sides cross the lines of the two others below their sides.
  Triangle const below{{{-2, -1}, {6, -1.5}, {2, -3}}};
  EXPECT_EQ(PlaceOf(below, kLarge), Cutter::Place::Apart);
  ExpectSameOverlap(below, kLarge);
}

TEST(Cutter, LeavesCrossingSidesToTheFullOverlap) {
  EXPECT_EQ(PlaceOf({{{1, 1}, {5, 1.5}, {1.25, 2}}}, kLarge), Cutter::Place::Crossing);
}

TEST(Cutter, LeavesAVertexOnALineToTheFullOverlap) {
  Triangle const touching{{{1, 0}, {2, 1}, {1, 1.5}}};
  EXPECT_EQ(PlaceOf(touching, kLarge), Cutter::Place::Unclear);
  Triangle almost = touching;
  for (double const y : {1e-15, -1e-15, 5e-324, -5e-324}) {
    almost.pts[0].y = y;
    EXPECT_EQ(PlaceOf(almost, kLarge), Cutter::Place::Unclear) << y;
    ExpectSameOverlap(almost, kLarge);
  }
}

TEST(Cutter, SeesWhatIsNearASideButAcrossNoLine) {
  // A thousand times nearer to the lower side than it is wide.
  Triangle const below{{{0.5, -0.001}, {2.5, -0.002}, {1.5, -0.5}}};
  EXPECT_EQ(PlaceOf(below, kLarge), Cutter::Place::Apart);
  ExpectSameOverlap(below, kLarge);
}

TEST(Cutter, LeavesParallelSidesWithBoxesThatMeetToTheFullOverlap) {
  // A side within, parallel to the long one.
  Triangle const parallel{{{1, 2}, {2, 1}, {1.25, 1.5}}};
  EXPECT_EQ(PlaceOf(parallel, kLarge), Cutter::Place::Unclear);
  ExpectSameOverlap(parallel, kLarge);
}

TEST(Cutter, ParallelSidesWithBoxesApartDoNotMatter) {
  Triangle const parallel{{{1, 1}, {2, 1}, {1.25, 1.5}}};
  EXPECT_EQ(PlaceOf(parallel, kLarge), Cutter::Place::Within);
  ExpectSameOverlap(parallel, kLarge);
}

TEST(Cutter, CutsOffVerticesAsTheFullOverlapDoes) {
  // Small triangles about a point of a side.
  std::set<unsigned> insideSeen;
  CompareOnRandomPairs(4200, 20000, [&insideSeen](RandomGeometry& random) {
    Triangle const cutter = random.TriangleIn(-1.0, 1.0);
    int const side = random.Integer(0, 2);
    Point const middle =
        Lerp(cutter.pts[side], cutter.pts[(side + 1) % 3], random.Uniform(0.1, 0.9));
    Triangle const small = Moved(Scaled(random.TriangleIn(-1.0, 1.0), 0.05), middle);
    Sight sight;
    if (CutterFor(small, cutter).PlaceOf(BoxedTriangle(small), &sight) == Cutter::Place::Crossing &&
        sight.IsOneCut()) {
      insideSeen.insert(sight.inside);
    }
    return TrianglePair{small, cutter};
  });
  // One or two vertices are cut off, each and each pair of them.
  EXPECT_EQ(insideSeen, (std::set<unsigned>{1, 2, 3, 4, 5, 6}));
}

TEST(Cutter, ASideOfNoLengthIsParallelToNothing) {
  EXPECT_EQ(PlaceOf({{{1, 1}, {1.5, 1.75}, {1.5, 1.75}}}, kLarge), Cutter::Place::Within);
  EXPECT_EQ(PlaceOf({{{1, 1.25}, {1, 1.25}, {1, 1.25}}}, kLarge), Cutter::Place::Within);
  ExpectSameOverlap({{{1, 1}, {1.5, 1.75}, {1.5, 1.75}}}, kLarge);
  ExpectSameOverlap({{{1, 1.25}, {1, 1.25}, {1, 1.25}}}, kLarge);
}

TEST(Cutter, LeavesASideTooShortToHaveADirectionToTheFullOverlap) {
  // Products of its length count as zero, so the full overlap takes it for parallel.
  Triangle const cutter{{{-1, -1}, {3, -1}, {-1, 3}}};
  Triangle const alongX{{{0, 0}, {1e-309, 0}, {0.25, 0.5}}};
  Triangle const alongY{{{0, 0}, {0.5, 0.25}, {0, 1e-309}}};
  for (Triangle const& other : {alongX, alongY}) {
    EXPECT_EQ(PlaceOf(other, cutter), Cutter::Place::Unclear);
    ExpectSameOverlap(other, cutter);
  }
}

TEST(Cutter, ATriangleAroundTheCutterIsNotWithin) {
  Triangle const around{{{-9, -8}, {30, -9}, {-7, 31}}};
  EXPECT_EQ(PlaceOf(around, kLarge), Cutter::Place::Crossing);
  ExpectSameOverlap(around, kLarge);
}

TEST(Cutter, KnowsNothingOfCoordinatesThatAreNotFinite) {
  for (double const value : {kNaN, kInf, -kInf}) {
    Triangle odd{{{1, 1}, {1.5, 1}, {1, value}}};
    EXPECT_EQ(PlaceOf(odd, kLarge), Cutter::Place::Unclear);
    EXPECT_EQ(PlaceOf(kLarge, odd), Cutter::Place::Unclear);
    ExpectSameOverlap(odd, kLarge);
    ExpectSameOverlap(kLarge, odd);
  }
}

TEST(Cutter, MeasuresWhatIsClearByTheSizeOfTheTriangles) {
  Triangle const inside{{{1, 1}, {1.5, 1.25}, {1.125, 1.75}}};
  for (double const scale : {1e-100, 1e-12, 1e12, 1e90}) {
    EXPECT_EQ(PlaceOf(Scaled(inside, scale), Scaled(kLarge, scale)), Cutter::Place::Within);
  }
}

TEST(Cutter, KnowsNothingWhereProductsUnderflowOrOverflow) {
  Triangle const inside{{{1, 1}, {1.5, 1.25}, {1.125, 1.75}}};
  ASSERT_EQ(PlaceOf(inside, kLarge), Cutter::Place::Within);
  for (double const scale : {1e-160, 1e-130, 1e155, 1e300}) {
    EXPECT_EQ(PlaceOf(Scaled(inside, scale), Scaled(kLarge, scale)), Cutter::Place::Unclear);
    ExpectSameOverlap(Scaled(inside, scale), Scaled(kLarge, scale));
  }
}

TEST(Cutter, ADegenerateCutterKnowsNothing) {
  Triangle const flat{{{0, 0}, {4, 4}, {4, 4}}};
  EXPECT_EQ(PlaceOf({{{1, 2}, {2, 3}, {1, 3}}}, flat), Cutter::Place::Unclear);
}

TEST(Cutter, AgreesWithTheFullOverlapOnEveryFamilyOfPairs) {
  for (PairKind const kind : kAllPairKinds) {
    SCOPED_TRACE(static_cast<int>(kind));
    CompareOnRandomPairs(4201 + static_cast<std::uint64_t>(kind), 3000,
                         [kind](RandomGeometry& random) { return MakePair(random, kind); });
  }
}

TEST(Cutter, AgreesWithTheFullOverlapFarFromTheOrigin) {
  for (double const distance : {1e2, 1e5, 1e8, 1e12}) {
    SCOPED_TRACE(distance);
    Tally const tally = CompareOnRandomPairs(4220, 4000, [distance](RandomGeometry& random) {
      TrianglePair pair =
          MakePair(random, random.Flip() ? PairKind::kRandom : PairKind::kContained);
      Point const by{distance * random.Uniform(-1.0, 1.0), distance * random.Uniform(-1.0, 1.0)};
      return TrianglePair{Moved(pair.first, by), Moved(pair.second, by)};
    });
    if (distance < 1e6) {
      EXPECT_GT(tally.within, 100);
      EXPECT_GT(tally.apart, 100);
      EXPECT_GT(tally.crossing, 100);
    }
    if (distance > 1e11) {
      EXPECT_EQ(tally.unclear, 4000);
    }
  }
}

TEST(Cutter, AgreesWithTheFullOverlapNextToSidesAndVertices) {
  // Vertices off the lines of the cutter by next to nothing up to clearly, and sides that are
  // nearly parallel to it.
  Tally const tally = CompareOnRandomPairs(4230, 40000, [](RandomGeometry& random) {
    Triangle const cutter = random.TriangleIn(-1.0, 1.0);
    Triangle other;
    for (Point& p : other.pts) {
      p = RelatedPoint(random, cutter);
      double const off = std::pow(10.0, random.Uniform(-17.0, -1.0));
      p = {p.x + off * random.Uniform(-1.0, 1.0), p.y + off * random.Uniform(-1.0, 1.0)};
    }
    return TrianglePair{other, cutter};
  });
  EXPECT_GT(tally.unclear, 1000);
  EXPECT_GT(tally.crossing, 1000);
  EXPECT_GT(tally.apart, 100);
  EXPECT_GT(tally.within, 100);
}

TEST(Cutter, AgreesWithTheFullOverlapOnThinTriangles) {
  Tally const tally = CompareOnRandomPairs(4240, 40000, [](RandomGeometry& random) {
    auto const thin = [&random] {
      Point const p = random.PointIn(-1.0, 1.0);
      Point const q = random.PointIn(-1.0, 1.0);
      Point const r = Lerp(p, q, random.Uniform(-0.2, 1.2));
      double const side = std::pow(10.0, random.Uniform(-13.0, -1.0)) * (random.Flip() ? 1 : -1);
      return Triangle{{p, q, {r.x - (q.y - p.y) * side, r.y + (q.x - p.x) * side}}};
    };
    return TrianglePair{thin(), thin()};
  });
  EXPECT_GT(tally.crossing, 1000);
  EXPECT_GT(tally.apart, 1000);
}

Cells::ChordCutter ChordCutterFor(Triangle const& chord, Triangle const& other) {
  Magnitude magnitude;
  magnitude.Include(other);
  return Cells::ChordCutter(chord, magnitude);
}

void ExpectSameChordOverlap(Triangle const& chord, Triangle const& other) {
  Overlap plain;
  Triangles::FindOverlap(PreparedTriangle(chord), PreparedTriangle(other), &plain);
  Overlap fast;
  ChordCutterFor(chord, other).FindOverlapWith(BoxedTriangle(other), &fast);
  Cell const expected(plain.parts.begin(), plain.parts.end());
  Cell const actual(fast.parts.begin(), fast.parts.end());
  EXPECT_EQ(fast.status, plain.status);
  EXPECT_TRUE(SameCell(expected, actual)) << Describe(chord) << " across " << Describe(other);
}

TEST(ChordCutter, SeesWhatLiesOnOneSide) {
  Triangle const chord{{{-5, 1}, {9, 6}, {9, 6}}};
  Triangle const below{{{0, 0}, {4, 1}, {1, -3}}};
  EXPECT_TRUE(ChordCutterFor(chord, below).IsClearlyApartFrom(BoxedTriangle(below)));
  ExpectSameChordOverlap(chord, below);
  Triangle const crossed{{{0, 0}, {4, 1}, {1, 8}}};
  EXPECT_FALSE(ChordCutterFor(chord, crossed).IsClearlyApartFrom(BoxedTriangle(crossed)));
  ExpectSameChordOverlap(chord, crossed);
}

TEST(ChordCutter, LeavesEverySideAlongTheChordToTheFullOverlap) {
  Triangle const chord{{{-5, 1}, {9, 6}, {9, 6}}};
  // From (0, 0) to (7, 2.5) the side is parallel to the chord, and their boxes meet.
  Point const start{0, 0};
  Point const end{7, 2.5};
  Point const apex{3, -3};
  for (Triangle const& below :
       {Triangle{{start, end, apex}}, Triangle{{apex, start, end}}, Triangle{{end, apex, start}}}) {
    EXPECT_FALSE(ChordCutterFor(chord, below).IsClearlyApartFrom(BoxedTriangle(below)));
    ExpectSameChordOverlap(chord, below);
  }
}

TEST(ChordCutter, LeavesAnEndInTheBoxToTheFullOverlap) {
  Triangle const chord{{{-5, 1}, {2, 3.5}, {2, 3.5}}};
  Triangle const below{{{-1, 0}, {4, 1}, {6, 4.5}}};
  EXPECT_FALSE(ChordCutterFor(chord, below).IsClearlyApartFrom(BoxedTriangle(below)));
  ExpectSameChordOverlap(chord, below);
}

TEST(ChordCutter, AgreesWithTheFullOverlap) {
  RandomGeometry random(4250);
  int apart = 0;
  for (int i = 0; i < 40000 && !testing::Test::HasFailure(); ++i) {
    SCOPED_TRACE(i);
    PairKind const kind = kAllPairKinds[static_cast<std::size_t>(i) % kAllPairKinds.size()];
    TrianglePair pair = MakePair(random, kind);
    if (random.Flip()) {
      double const off = std::pow(10.0, random.Uniform(-17.0, 1.0));
      for (Point& p : pair.first.pts) p = {p.x + off, p.y - off};
    }
    // Mostly chords, and some that are not.
    if (random.Integer(0, 9) != 0) pair.first.pts[1] = pair.first.pts[2];
    ExpectSameChordOverlap(pair.first, pair.second);
    apart += ChordCutterFor(pair.first, pair.second).IsClearlyApartFrom(BoxedTriangle(pair.second));
  }
  EXPECT_GT(apart, 3000);
}

}  // namespace
}  // namespace Vorn::Testing
