#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/CellInputs.h"
#include "support/ConvexClipping.h"
#include "support/RandomGeometry.h"
#include "support/ReferenceCells.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;
using OverlappingStatus = GeometryUtils::OverlappingStatus;

OverlappingStatus OverlapOf(Triangle const& first, Triangle const& second, Cell* result) {
  return GeometryUtils::GetOverlapping(first, second, result);
}

OverlappingStatus OverlapOf(Triangle const& first, Cell const& cell, Cell* result) {
  return GeometryUtils::GetOverlapping(first, &cell, result);
}

Triangle const kOuter{{{0.0, 0.0}, {8.0, 0.0}, {0.0, 8.0}}};
Triangle const kInner{{{1.0, 1.0}, {3.0, 1.0}, {1.0, 3.0}}};
Triangle const kFar{{{20.0, 20.0}, {21.0, 20.0}, {20.0, 21.0}}};

TEST(GetOverlapping, RepeatsAContainedTriangleThreeTimes) {
  for (Triangle const& inner : {kInner, Reversed(kInner)}) {
    Cell expected(3, inner);
    Cell result;
    EXPECT_EQ(OverlapOf(inner, kOuter, &result), OverlappingStatus::Overlap);
    EXPECT_TRUE(SameCell(expected, result));
    result.clear();
    EXPECT_EQ(OverlapOf(kOuter, inner, &result), OverlappingStatus::Overlap);
    EXPECT_TRUE(SameCell(expected, result));
  }
}

TEST(GetOverlapping, RepeatsAContainedPointTriangleThreeTimes) {
  Point const p{2.0, 3.0};
  Triangle const point{{p, p, p}};
  Cell result;
  EXPECT_EQ(OverlapOf(point, kOuter, &result), OverlappingStatus::Overlap);
  EXPECT_TRUE(SameCell(Cell(3, point), result));
}

TEST(GetOverlapping, OfTrianglesApartIsNothing) {
  Cell result{SentinelTriangle()};
  EXPECT_EQ(OverlapOf(kOuter, kFar, &result), OverlappingStatus::NoOverlap);
  EXPECT_TRUE(SameCell({SentinelTriangle()}, result));
}

TEST(GetOverlapping, OfTrianglesThatTouchInOnePointIsDegenerate) {
  // A touching vertex is reported by three pairs of sides: polygon and triangle shrink to a point.
  Triangle const touching{{{8.0, 0.0}, {9.0, -1.0}, {9.0, 1.0}}};
  Cell expected;
  auto const status = Reference::Overlap(kOuter, touching, &expected);
  Cell result;
  EXPECT_EQ(OverlapOf(kOuter, touching, &result), status);
  EXPECT_TRUE(SameCell(expected, result));
  EXPECT_EQ(TotalArea(result), 0.0L);
}

TEST(GetOverlapping, WalksTheBoundaryOfTheCommonPart) {
  Triangle const first{{{0.0, 0.0}, {4.0, 0.0}, {0.0, 4.0}}};
  Triangle const second{{{2.0, 1.0}, {-2.0, 3.0}, {-2.0, 0.0}}};
  Cell result{SentinelTriangle()};
  EXPECT_EQ(OverlapOf(first, second, &result), OverlappingStatus::Overlap);
  EXPECT_TRUE(SameCell({SentinelTriangle(), {{{0.0, 2.0}, {0.0, 0.5}, {2.0, 1.0}}}}, result));
}

TEST(GetOverlapping, OfAHexagramIsAHexagonInFourTriangles) {
  // Away from the origin, where opposite sides would pass for one line.
  Triangle const up{{{4.0, 17.0}, {16.0, 17.0}, {10.0, 26.0}}};
  Triangle const down{{{16.0, 23.0}, {4.0, 23.0}, {10.0, 14.0}}};
  Cell result;
  EXPECT_EQ(OverlapOf(up, down, &result), OverlappingStatus::Overlap);
  EXPECT_EQ(result.size(), 4U);
  EXPECT_NEAR(static_cast<double>(TotalArea(result)), 36.0, 1e-13);
}

TEST(GetOverlapping, OfIdenticalTrianglesHasItsAreaWithTheSameVertexOrder) {
  RandomGeometry random(4401);
  for (int n = 0; n < 1000; ++n) {
    Triangle const t = random.TriangleIn(-1.0, 1.0);
    long double const area = std::fabs(SignedArea(ToLong(t)));
    if (area < 1e-3L) continue;
    Cell result;
    ASSERT_EQ(OverlapOf(t, t, &result), OverlappingStatus::Overlap);
    long double const copies = std::round(TotalArea(result) / area);
    EXPECT_TRUE(copies == 1.0L || copies == 3.0L) << Describe(t);
    EXPECT_NEAR(static_cast<double>(TotalArea(result) / area), static_cast<double>(copies), 1e-12);
  }
}

TEST(GetOverlapping, OfACellThatTakesTheResultReadsWhatItHeldBefore) {
  Cell const cell{kInner, kFar, kInner};
  Cell expected = cell;
  OverlapOf(kOuter, cell, &expected);
  Cell both = cell;
  both.shrink_to_fit();
  EXPECT_EQ(OverlapOf(kOuter, both, &both), OverlappingStatus::Overlap);
  EXPECT_TRUE(SameCell(expected, both));
}

TEST(GetOverlapping, LeavesTheResultWhenItFails) {
  // Found by search: four vertices lie on the other triangle by rounding, yet no sides meet.
  RandomGeometry random(4402);
  int failures = 0;
  for (int n = 0; n < 40000; ++n) {
    auto const pair = MakePair(random, PairKind::kSharedParts);
    Cell result{SentinelTriangle()};
    auto const status = OverlapOf(pair.first, pair.second, &result);
    if (status == OverlappingStatus::Overlap) continue;
    EXPECT_TRUE(SameCell({SentinelTriangle()}, result));
    if (status == OverlappingStatus::OverlapFailed) ++failures;
  }
  EXPECT_GT(failures, 10);
}

TEST(GetOverlapping, OfACellWithoutTrianglesIsNothing) {
  Cell result{SentinelTriangle()};
  EXPECT_EQ(OverlapOf(kOuter, Cell{}, &result), OverlappingStatus::NoOverlap);
  EXPECT_TRUE(SameCell({SentinelTriangle()}, result));
}

TEST(GetOverlapping, OfACellCollectsThePartsInOrder) {
  Triangle const half{{{1.0, 1.0}, {20.0, 1.0}, {1.0, 20.0}}};
  Cell const cell{kInner, kFar, half};
  Cell expected{SentinelTriangle()};
  for (auto const& t : cell) OverlapOf(kOuter, t, &expected);
  Cell result{SentinelTriangle()};
  EXPECT_EQ(OverlapOf(kOuter, cell, &result), OverlappingStatus::Overlap);
  EXPECT_TRUE(SameCell(expected, result));
  EXPECT_GT(result.size(), 4U);
}

TEST(GetOverlapping, OfACellIsNothingWhenNoTriangleOverlaps) {
  Cell result;
  EXPECT_EQ(OverlapOf(kOuter, Cell{kFar, kFar}, &result), OverlappingStatus::NoOverlap);
  EXPECT_TRUE(result.empty());
}

TEST(GetOverlapping, OfACellDoesNotPassAFailureOn) {
  RandomGeometry random(4403);
  int failures = 0;
  for (int n = 0; n < 40000 && failures < 10; ++n) {
    auto const pair = MakePair(random, PairKind::kSharedParts);
    Cell result;
    if (OverlapOf(pair.first, pair.second, &result) != OverlappingStatus::OverlapFailed) continue;
    ++failures;
    EXPECT_EQ(OverlapOf(pair.first, Cell{pair.second}, &result), OverlappingStatus::NoOverlap);
    EXPECT_TRUE(result.empty());
    Triangle const around{{{-100.0, -100.0}, {100.0, -100.0}, {0.0, 200.0}}};
    EXPECT_EQ(OverlapOf(pair.first, Cell{pair.second, around}, &result),
              OverlappingStatus::Overlap);
    EXPECT_TRUE(SameCell(Cell(3, pair.first), result));
  }
  EXPECT_EQ(failures, 10);
}

TEST(GetOverlapping, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4404;
  SCOPED_TRACE(kSeed);
  for (PairKind kind : kAllPairKinds) {
    SCOPED_TRACE(static_cast<int>(kind));
    RandomGeometry random(kSeed);
    for (int n = 0; n < 10000; ++n) {
      auto const pair = MakePair(random, kind);
      Cell expected;
      Cell result;
      auto const status = Reference::Overlap(pair.first, pair.second, &expected);
      ASSERT_EQ(OverlapOf(pair.first, pair.second, &result), status)
          << Describe(pair.first) << " " << Describe(pair.second);
      ASSERT_TRUE(SameCell(expected, result))
          << Describe(pair.first) << " " << Describe(pair.second);
    }
  }
}

TEST(GetOverlapping, HasTheBitsOfTheReferenceOnRandomBits) {
  constexpr std::uint64_t kSeed = 4405;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 10000; ++n) {
    TrianglePair pair;
    for (auto* t : {&pair.first, &pair.second}) {
      for (auto& p : t->pts) p = {random.AnyDouble(), random.AnyDouble()};
    }
    Cell expected;
    Cell result;
    auto const status = Reference::Overlap(pair.first, pair.second, &expected);
    ASSERT_EQ(OverlapOf(pair.first, pair.second, &result), status);
    ASSERT_TRUE(SameCell(expected, result)) << Describe(pair.first) << Describe(pair.second);
  }
}

TEST(GetOverlapping, HasTheBitsOfTheReferenceForEveryPairOfATinyGrid) {
  // All pairs of triangles with vertices on a 2 x 2 grid.
  int wrong = 0;
  auto const make = [](int code) {
    Triangle t;
    for (auto& p : t.pts) {
      p = {double(code % 2), double(code / 2 % 2)};
      code /= 4;
    }
    return t;
  };
  for (int a = 0; a < 64; ++a) {
    for (int b = 0; b < 64; ++b) {
      Cell expected;
      Cell result;
      auto const status = Reference::Overlap(make(a), make(b), &expected);
      if (OverlapOf(make(a), make(b), &result) != status || !SameCell(expected, result)) ++wrong;
    }
  }
  EXPECT_EQ(wrong, 0);
}

TEST(GetOverlapping, HasTheAreaOfTheCommonPartForEquallyTurningTriangles) {
  constexpr std::uint64_t kSeed = 4406;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int overlapping = 0;
  for (int n = 0; n < 20000; ++n) {
    auto pair = MakePair(random, n % 10 == 0 ? PairKind::kContained : PairKind::kRandom);
    bool const turnsDiffer =
        (Reference::Area(pair.first) > 0.0) != (Reference::Area(pair.second) > 0.0);
    if (turnsDiffer) pair.second = Reversed(pair.second);
    long double const clipped = SignedArea(ClipTriangles(pair.first, pair.second));
    if (clipped > 0.0L && clipped < 1e-9L) continue;
    Cell result;
    auto const status = OverlapOf(pair.first, pair.second, &result);
    if (clipped <= 0.0L) {
      EXPECT_EQ(status, OverlappingStatus::NoOverlap);
      continue;
    }
    ++overlapping;
    ASSERT_EQ(status, OverlappingStatus::Overlap);
    bool const contained = result.size() == 3 && SameBits(result[0], result[1]);
    long double const copies = contained ? 3.0L : 1.0L;
    EXPECT_NEAR(static_cast<double>(TotalArea(result)), static_cast<double>(copies * clipped),
                1e-12)
        << Describe(pair.first) << " " << Describe(pair.second);
  }
  EXPECT_GT(overlapping, 5000);
}

TEST(GetOverlapping, StaysWithinBothTrianglesWhateverTheirTurn) {
  // Triangles of opposite turn may lose a part of their overlap, but they never gain one.
  constexpr std::uint64_t kSeed = 4407;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 5000; ++n) {
    auto const pair = MakePair(random, PairKind::kRandom);
    Cell result;
    OverlapOf(pair.first, pair.second, &result);
    for (auto const& part : result) {
      Point const middle = Reference::Center(part);
      for (auto const& owner : {pair.first, pair.second}) {
        LongPolygon const sides = ToLong(owner);
        for (std::size_t i = 0; i < 3; ++i) {
          ASSERT_GT(Cross(sides[i], sides[(i + 1) % 3], {middle.x, middle.y}), -1e-13L);
        }
      }
    }
  }
}

/// Overlap of a whole cell with another one, as a growing run does it; empty when there is none.
template <typename OverlapFunction>
Cell Narrow(Cell const& cell, Cell const& other, OverlapFunction const& overlap) {
  Cell narrowed;
  for (auto const& t : cell) overlap(t, other, &narrowed);
  return narrowed;
}

Cell NarrowByLibrary(Cell const& cell, Cell const& other) {
  return Narrow(cell, other, [](Triangle const& t, Cell const& o, Cell* result) {
    return GeometryUtils::GetOverlapping(t, &o, result);
  });
}

Cell NarrowByReference(Cell const& cell, Cell const& other) {
  return Narrow(cell, other, [](Triangle const& t, Cell const& o, Cell* result) {
    return Reference::Overlap(t, o, result);
  });
}

TEST(GetOverlapping, HasTheBitsOfTheReferenceAlongRunsOfLineCells) {
  constexpr std::uint64_t kSeed = 4408;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  std::size_t longest = 0;
  for (int run = 0; run < 60; ++run) {
    auto const points = NoisyLine(random, 25, random.Flip() ? 0.05 : 0.002);
    bool formFixed = false;
    bool xOfY = false;
    Cell current;
    for (std::size_t i = 0; i + 1 < points.size(); ++i) {
      Cell next;
      if (Reference::LineCell(points[i], points[i + 1], &formFixed, &xOfY, &next) !=
          ErrorCode::Ok) {
        break;
      }
      Cell const narrowed = i == 0 ? next : NarrowByReference(current, next);
      if (i > 0) {
        ASSERT_TRUE(SameCell(narrowed, NarrowByLibrary(current, next))) << "run " << run;
      }
      current = narrowed;
      longest = std::max(longest, i);
      if (current.empty() || current.size() > 150) break;
    }
  }
  EXPECT_GE(longest, 5U);
}

TEST(GetOverlapping, HasTheBitsOfTheReferenceAlongRunsOfCircleCells) {
  constexpr std::uint64_t kSeed = 4409;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  std::size_t most = 0;
  for (int run = 0; run < 60; ++run) {
    auto const points = NoisyArc(random, 16, random.Uniform(1.0, 30.0), 0.01);
    int const orientation = random.Integer(0, 3) == 0 ? 1 : 0;
    Cell current;
    std::size_t steps = 0;
    for (std::size_t i = 0; i < 20; ++i) {
      std::size_t const a = static_cast<std::size_t>(random.Integer(0, 4));
      std::size_t const b = static_cast<std::size_t>(random.Integer(6, 9));
      std::size_t const c = static_cast<std::size_t>(random.Integer(11, 15));
      std::vector<Point> polygon;
      if (Reference::CirclePolygon(points[a], points[b], points[c], false, false, orientation,
                                   &polygon) != ErrorCode::Ok) {
        continue;
      }
      Cell const next = Reference::FanOf(polygon);
      if (current.empty()) {
        current = next;
        continue;
      }
      Cell const narrowed = NarrowByReference(current, next);
      ASSERT_TRUE(SameCell(narrowed, NarrowByLibrary(current, next))) << "run " << run;
      current = narrowed;
      most = std::max(most, ++steps);
      if (current.empty() || current.size() > 200) break;
    }
  }
  EXPECT_GE(most, 4U);
}

}  // namespace
}  // namespace Vorn::Testing
