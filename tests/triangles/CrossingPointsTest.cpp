#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/CellInputs.h"
#include "support/RandomGeometry.h"
#include "support/ReferenceTriangles.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;
using CrossingPoint = GeometryUtils::CrossingPoint;

std::vector<Point> Plain(Triangle const& first, int startSide, Triangle const& second) {
  std::vector<Point> points;
  EXPECT_TRUE(GeometryUtils::GetCrossingPoints(first, startSide, second, &points));
  return points;
}

std::vector<CrossingPoint> Indexed(Triangle const& first, Triangle const& second) {
  std::vector<CrossingPoint> records;
  GeometryUtils::GetCrossingPoints(first, second, &records);
  return records;
}

bool SameRecord(CrossingPoint const& a, CrossingPoint const& b) {
  return SameBits(a.pt, b.pt) && a.side1 == b.side1 && a.side2 == b.side2;
}

std::string DescribeRecords(std::vector<CrossingPoint> const& records) {
  std::ostringstream out;
  for (auto const& r : records) {
    PrintPoint(out, r.pt);
    out << "{" << r.side1 << "," << r.side2 << "} ";
  }
  return out.str();
}

testing::AssertionResult SameRecords(std::vector<CrossingPoint> const& expected,
                                     std::vector<CrossingPoint> const& actual) {
  if (std::equal(expected.begin(), expected.end(), actual.begin(), actual.end(), SameRecord)) {
    return testing::AssertionSuccess();
  }
  return testing::AssertionFailure()
         << "expected " << DescribeRecords(expected) << "but got " << DescribeRecords(actual);
}

Triangle const kBase{{{0.0, 0.0}, {4.0, 0.0}, {0.0, 3.0}}};
Triangle const kBelowBase{{{0.0, 0.0}, {4.0, 0.0}, {1.0, -3.0}}};

TEST(PlainCrossingPoints, OrdersTwoPointsOfASideFromItsStart) {
  Triangle const first{{{0.0, 0.0}, {8.0, 0.0}, {0.0, -8.0}}};
  Triangle const second{{{6.0, -1.0}, {4.0, 2.0}, {2.0, -1.0}}};
  auto const points = Plain(first, 0, second);
  ASSERT_GE(points.size(), 2U);
  EXPECT_LT(points[0].x, points[1].x);
  EXPECT_NEAR(points[0].x, 8.0 / 3.0, 1e-15);
  EXPECT_NEAR(points[1].x, 16.0 / 3.0, 1e-15);
}

TEST(PlainCrossingPoints, IgnoresOverlapsAlongALineButNotTheTouchingSides) {
  auto const points = Plain(kBase, 0, kBelowBase);
  std::vector<Point> const expected{{0.0, 0.0}, {4.0, 0.0}, {4.0, 0.0},
                                    {4.0, 0.0}, {0.0, 0.0}, {0.0, 0.0}};
  EXPECT_TRUE(SamePoints(expected, points));
}

TEST(PlainCrossingPoints, BeginsAtTheGivenSide) {
  Triangle const second{{{2.0, 1.0}, {-2.0, 2.5}, {1.0, -2.0}}};
  auto const from0 = Plain(kBase, 0, second);
  auto const from1 = Plain(kBase, 1, second);
  ASSERT_EQ(from0.size(), 2U);
  ASSERT_EQ(from1.size(), 2U);
  EXPECT_EQ(from0.front().y, 0.0);
  EXPECT_EQ(from1.front().x, 0.0);
  EXPECT_TRUE(SamePoints(from1, Plain(kBase, 4, second)));
  EXPECT_TRUE(SamePoints(from0, Plain(kBase, 3, second)));
}

TEST(PlainCrossingPoints, AppendsToWhatIsThere) {
  std::vector<Point> points{kPointSentinel};
  EXPECT_TRUE(GeometryUtils::GetCrossingPoints(kBase, 0, kBelowBase, &points));
  ASSERT_EQ(points.size(), 7U);
  EXPECT_SAME_POINT(points[0], kPointSentinel);
}

TEST(PlainCrossingPoints, OfTrianglesApartAreNone) {
  Triangle const far{{{9.0, 9.0}, {9.0, 8.0}, {8.0, 9.0}}};
  EXPECT_TRUE(Plain(kBase, 0, far).empty());
}

TEST(PlainCrossingPoints, SucceedsWithAStartSideOutOfRange) {
  // Nothing outside the three sides is ever read; what is found lies on the first triangle.
  for (int startSide : {-1, -2, -7, std::numeric_limits<int>::min(),
                        std::numeric_limits<int>::max(), std::numeric_limits<int>::max() - 1}) {
    std::vector<Point> points;
    GeometryUtils::GetCrossingPoints(kBase, startSide, kBelowBase, &points);
    for (auto const& p : points) {
      EXPECT_NE(GeometryUtils::GetPointStatus(p, kBase), GeometryUtils::PointStatus::Outside);
    }
  }
}

TEST(PlainCrossingPoints, HaveTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4201;
  SCOPED_TRACE(kSeed);
  for (PairKind kind : kAllPairKinds) {
    RandomGeometry random(kSeed);
    for (int n = 0; n < 4000; ++n) {
      auto const pair = MakePair(random, kind);
      int const startSide = random.Integer(0, 5);
      ASSERT_TRUE(SamePoints(Reference::PlainCrossings(pair.first, startSide, pair.second),
                             Plain(pair.first, startSide, pair.second)))
          << Testing::Describe(pair.first) << " " << Testing::Describe(pair.second);
    }
  }
}

TEST(IndexedCrossingPoints, NameTheSidesOfBothTriangles) {
  Triangle const first{{{0.0, 0.0}, {4.0, 0.0}, {0.0, 4.0}}};
  Triangle const second{{{2.0, 1.0}, {-2.0, 3.0}, {-2.0, 0.0}}};
  std::vector<CrossingPoint> const expected{{{0.0, 2.0}, 2, 0}, {{0.0, 0.5}, 2, 2}};
  EXPECT_TRUE(SameRecords(expected, Indexed(first, second)));
}

TEST(IndexedCrossingPoints, OfASharedSideAreItsTwoEnds) {
  // On side 0 the overlap gives both ends and the two touching sides give them again: only the
  // extreme pair stays.
  std::vector<CrossingPoint> const expected{{{0.0, 0.0}, 0, 0}, {{4.0, 0.0}, 0, 0},
                                            {{4.0, 0.0}, 1, 0}, {{4.0, 0.0}, 1, 1},
                                            {{0.0, 0.0}, 2, 0}, {{0.0, 0.0}, 2, 2}};
  EXPECT_TRUE(SameRecords(expected, Indexed(kBase, kBelowBase)));
}

TEST(IndexedCrossingPoints, ThinningASideOverwritesTheSecondSideOfTheLaterRecord) {
  // The shared side is side 1 here, so the overwritten index shows: the far end gets side2 = 1
  // though it was found on side 0 of the second triangle.
  auto const records = Indexed(Rotated(kBase, 2), kBelowBase);
  std::vector<CrossingPoint> const expected{{{0.0, 0.0}, 0, 0}, {{0.0, 0.0}, 0, 2},
                                            {{0.0, 0.0}, 1, 0}, {{4.0, 0.0}, 1, 1},
                                            {{4.0, 0.0}, 2, 0}, {{4.0, 0.0}, 2, 1}};
  EXPECT_TRUE(SameRecords(expected, records));
}

TEST(IndexedCrossingPoints, OverlapAlongALineDropsThePointHeldBefore) {
  // Side 0 of the second touches at (1, 0) and is held; the overlap of side 1 then drops it. Were
  // it kept, three records would be thinned and the last side2 of side 0 would become 0.
  Triangle const first{{{0.0, 0.0}, {4.0, 0.0}, {0.0, -3.0}}};
  Triangle const second{{{1.5, 1.0}, {1.0, 0.0}, {6.0, 0.0}}};
  std::vector<CrossingPoint> const expected{
      {{1.0, 0.0}, 0, 1}, {{4.0, 0.0}, 0, 1}, {{4.0, 0.0}, 1, 1}};
  EXPECT_TRUE(SameRecords(expected, Indexed(first, second)));
}

TEST(IndexedCrossingPoints, OverlapIsOrderedFromTheStartOfTheSide) {
  // The side runs towards smaller x, the sorted stretch towards greater x.
  Triangle const first{{{4.0, 0.0}, {0.0, 0.0}, {0.0, -3.0}}};
  Triangle const second{{{1.0, 0.0}, {3.0, 0.0}, {2.0, 5.0}}};
  auto const records = Indexed(first, second);
  ASSERT_GE(records.size(), 2U);
  EXPECT_SAME_POINT(records[0].pt, (Point{3.0, 0.0}));
  EXPECT_SAME_POINT(records[1].pt, (Point{1.0, 0.0}));
}

TEST(IndexedCrossingPoints, ParallelLinesOfUnequalConstantsDoNotOverlap) {
  // On one line, but scaled differently: no stretch is seen, only the sides that end on it.
  Triangle const first{{{0.0, 1.0}, {1.0, 2.0}, {5.0, 0.0}}};
  Triangle const second{{{1.0, 2.0}, {3.0, 4.0}, {0.0, 9.0}}};
  std::vector<CrossingPoint> const expected{
      {{1.0, 2.0}, 0, 2}, {{1.0, 2.0}, 1, 0}, {{1.0, 2.0}, 1, 2}};
  EXPECT_TRUE(SameRecords(expected, Indexed(first, second)));
}

TEST(IndexedCrossingPoints, OppositeSidesAroundTheOriginPassForOneLine) {
  // Side 1 of both has the raw constant 36, with opposite normals: two different lines, yet their
  // common stretch is taken. The crossings with the other sides are lost to it.
  Triangle const up{{{-6.0, -3.0}, {6.0, -3.0}, {0.0, 6.0}}};
  Triangle const down{{{6.0, 3.0}, {-6.0, 3.0}, {0.0, -6.0}}};
  std::vector<CrossingPoint> const expected{{{-2.0, -3.0}, 0, 1}, {{2.0, -3.0}, 0, 2},
                                            {{6.0, -3.0}, 1, 1},  {{-6.0, 3.0}, 1, 1},
                                            {{6.0, 3.0}, 2, 2},   {{-6.0, -3.0}, 2, 2}};
  EXPECT_TRUE(SameRecords(expected, Indexed(up, down)));
}

TEST(IndexedCrossingPoints, EqualDistancesKeepTheOrderOfTheSides) {
  // Both sides that end at (2, 0) report it: the side found first comes first.
  Triangle const first{{{0.0, 0.0}, {4.0, 0.0}, {0.0, -3.0}}};
  Triangle const second{{{2.0, 0.0}, {3.0, 2.0}, {1.0, 2.0}}};
  std::vector<CrossingPoint> const expected{{{2.0, 0.0}, 0, 0}, {{2.0, 0.0}, 0, 2}};
  EXPECT_TRUE(SameRecords(expected, Indexed(first, second)));
}

TEST(IndexedCrossingPoints, AppendToWhatIsThere) {
  std::vector<CrossingPoint> records{{kPointSentinel, 7, 8}};
  GeometryUtils::GetCrossingPoints(kBase, kBelowBase, &records);
  ASSERT_EQ(records.size(), 7U);
  EXPECT_SAME_POINT(records[0].pt, kPointSentinel);
  EXPECT_EQ(records[0].side1, 7);
  EXPECT_EQ(records[0].side2, 8);
}

TEST(IndexedCrossingPoints, OldRecordsNeverTakePartInThinning) {
  auto const fresh = Indexed(kBase, kBelowBase);
  std::vector<CrossingPoint> records{{{-100.0, 0.0}, 0, 0}, {{100.0, 0.0}, 0, 0}};
  auto expected = records;
  expected.insert(expected.end(), fresh.begin(), fresh.end());
  GeometryUtils::GetCrossingPoints(kBase, kBelowBase, &records);
  EXPECT_TRUE(SameRecords(expected, records));
}

TEST(IndexedCrossingPoints, ManyStretchesOnOneSideLeaveTheExtremePair) {
  // All three sides of the flat second triangle lie along side 0: six records are found there.
  Triangle const first{{{0.0, 0.0}, {8.0, 0.0}, {0.0, 8.0}}};
  Triangle const second{{{1.0, 0.0}, {3.0, 0.0}, {6.0, 0.0}}};
  std::vector<CrossingPoint> const expected{{{1.0, 0.0}, 0, 0}, {{6.0, 0.0}, 0, 0}};
  EXPECT_TRUE(SameRecords(expected, Indexed(first, second)));
}

TEST(IndexedCrossingPoints, HaveTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4202;
  SCOPED_TRACE(kSeed);
  for (PairKind kind : kAllPairKinds) {
    RandomGeometry random(kSeed);
    for (int n = 0; n < 6000; ++n) {
      auto const pair = MakePair(random, kind);
      ASSERT_TRUE(SameRecords(Reference::Crossings(pair.first, pair.second),
                              Indexed(pair.first, pair.second)))
          << Testing::Describe(pair.first) << " " << Testing::Describe(pair.second);
    }
  }
}

TEST(IndexedCrossingPoints, AreAtMostTwoPerSideInTheOrderOfTheSides) {
  constexpr std::uint64_t kSeed = 4203;
  SCOPED_TRACE(kSeed);
  for (PairKind kind : kAllPairKinds) {
    RandomGeometry random(kSeed);
    for (int n = 0; n < 2000; ++n) {
      auto const pair = MakePair(random, kind);
      int perSide[3] = {0, 0, 0};
      int last = 0;
      for (auto const& record : Indexed(pair.first, pair.second)) {
        ASSERT_GE(record.side1, last);
        ASSERT_LT(record.side1, 3);
        ASSERT_GE(record.side2, 0);
        ASSERT_LT(record.side2, 3);
        last = record.side1;
        ++perSide[record.side1];
      }
      for (int count : perSide) ASSERT_LE(count, 2);
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
