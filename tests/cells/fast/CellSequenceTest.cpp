#include <algorithm>
#include <cmath>
#include <cstddef>
#include <optional>
#include <vector>

#include "geometry/cells/fast/CellSequence.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/CellInputs.h"
#include "support/RandomGeometry.h"

// A cell without copies must be, triangle by triangle and bit by bit, what the plain operations on
// vectors make of the same input.

namespace Vorn::Testing {
namespace {

using Cells::CellSequence;
using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

/// The plain way: every triangle with the whole other cell, all parts in one new vector.
Cell Narrowed(Cell const& cell, Cell const& other) {
  Cell narrowed;
  for (Triangle const& triangle : cell) GeometryUtils::GetOverlapping(triangle, &other, &narrowed);
  return narrowed;
}

/// Within its own error, which is small for what a sum of so many terms can be off.
void ExpectRoughCentreIsNear(Point const& center, CellSequence const& sequence) {
  std::optional<Cells::RoughCentre> const rough = sequence.FindRoughCentre();
  if (!rough) return;
  double const distance = std::hypot(rough->at.x - center.x, rough->at.y - center.y);
  EXPECT_LE(distance, rough->error);
  std::optional<Cells::Rect> const rect = sequence.BoundingRect();
  ASSERT_TRUE(rect);
  double largest = 0.0;
  for (double const bound : {rect->xMin, rect->yMin, rect->xMax, rect->yMax})
    largest = std::max(largest, std::fabs(bound));
  EXPECT_LE(rough->error, 1e-15 * static_cast<double>(sequence.size()) * largest);
}

void ExpectSameSummary(Cell const& plain, CellSequence const& sequence) {
  ASSERT_EQ(sequence.size(), plain.size());
  EXPECT_EQ(sequence.empty(), plain.empty());
  Point plainCentre = kPointSentinel;
  std::optional<Point> const centre = sequence.Centre();
  EXPECT_EQ(centre.has_value(), GeometryUtils::GetCenter(&plain, &plainCentre));
  EXPECT_SAME_POINT(centre.value_or(kPointSentinel), plainCentre);
  ExpectRoughCentreIsNear(plainCentre, sequence);
  double plainRect[4] = {kSentinel, kSentinel, kSentinel, kSentinel};
  std::optional<Cells::Rect> const rect = sequence.BoundingRect();
  ASSERT_EQ(rect.has_value(), GeometryUtils::GetBoundingRect(&plain, plainRect));
  if (!rect) return;
  EXPECT_SAME_BITS(rect->xMin, plainRect[0]);
  EXPECT_SAME_BITS(rect->yMin, plainRect[1]);
  EXPECT_SAME_BITS(rect->xMax, plainRect[2]);
  EXPECT_SAME_BITS(rect->yMax, plainRect[3]);
}

void ExpectSameCentreOfOverlap(Cell const& plain, CellSequence const& sequence,
                               Triangle const& candidate) {
  Cell overlap;
  GeometryUtils::GetOverlapping(candidate, &plain, &overlap);
  Point plainCentre = kPointSentinel;
  bool const plainFound = !overlap.empty() && GeometryUtils::GetCenter(&overlap, &plainCentre);
  std::optional<Point> const centre = sequence.CentreOfOverlapWith(candidate);
  EXPECT_EQ(centre.has_value(), plainFound);
  EXPECT_SAME_POINT(centre.value_or(kPointSentinel), plainCentre);
}

/// Line cells of consecutive pairs, all in the form that the first one chose.
std::vector<Cell> LineCellsOf(std::vector<WPoint> const& points) {
  std::vector<Cell> cells;
  bool formFixed = false;
  bool xOfY = false;
  for (std::size_t i = 1; i < points.size(); ++i) {
    Cell cell;
    if (GeometryUtils::GetLineTriangles(points[i - 1], points[i], &formFixed, &xOfY, &cell) !=
        ErrorCode::Ok) {
      break;
    }
    cells.push_back(cell);
  }
  return cells;
}

/// Circle cells of triples that share the first point.
std::vector<Cell> CircleCellsOf(std::vector<WPoint> const& points) {
  std::vector<Cell> cells;
  for (std::size_t i = 2; i < points.size(); ++i) {
    Cell cell;
    if (GeometryUtils::GetCircleTriangles(points[0], points[i / 2], points[i], false, false, 0,
                                          &cell) == ErrorCode::Ok) {
      cells.push_back(cell);
    }
  }
  return cells;
}

/// Narrows by one cell after another, until nothing or too much is left.
std::size_t NarrowAlong(std::vector<Cell> const& cells) {
  if (cells.empty()) return 0;
  constexpr std::size_t kLargest = 60000;
  Cell plain = cells.front();
  CellSequence sequence(plain);
  std::size_t largest = plain.size();
  for (std::size_t i = 1; i < cells.size() && !plain.empty() && plain.size() < kLargest; ++i) {
    plain = Narrowed(plain, cells[i]);
    sequence.NarrowBy(cells[i]);
    EXPECT_EQ(sequence.Depth(), i + 1);
    ExpectSameSummary(plain, sequence);
    EXPECT_TRUE(SameCell(plain, sequence.Expand()));
    largest = std::max(largest, plain.size());
  }
  if (!plain.empty()) {
    double rect[4];
    GeometryUtils::GetBoundingRect(&plain, rect);
    Triangle chord;
    if (GeometryUtils::GetBoundingCircleAndLineIntersectionTriangle(
            &plain, 1.0, 0.25, -rect[0] - 0.25 * rect[1], &chord)) {
      ExpectSameCentreOfOverlap(plain, sequence, chord);
    }
    ExpectSameCentreOfOverlap(plain, sequence, plain[plain.size() / 2]);
  }
  return largest;
}

TEST(CellSequence, FollowsLineCellsTriangleByTriangle) {
  std::size_t largest = 0;
  for (std::uint64_t seed = 1; seed <= 60; ++seed) {
    SCOPED_TRACE(seed);
    RandomGeometry random(seed);
    largest = std::max(largest, NarrowAlong(LineCellsOf(NoisyLine(random, 14, 0.05))));
  }
  // Else the cells would not have grown by copies, and the test would say nothing.
  EXPECT_GT(largest, 20000U);
}

TEST(CellSequence, FollowsCircleCellsTriangleByTriangle) {
  std::size_t largest = 0;
  for (std::uint64_t seed = 1; seed <= 40; ++seed) {
    SCOPED_TRACE(seed);
    RandomGeometry random(seed);
    largest = std::max(largest, NarrowAlong(CircleCellsOf(NoisyArc(random, 12, 20.0, 0.05))));
  }
  EXPECT_GT(largest, 5000U);
}

TEST(CellSequence, FollowsDegenerateAndNotFiniteTriangles) {
  for (PairKind const kind : kAllPairKinds) {
    for (std::uint64_t seed = 1; seed <= 40; ++seed) {
      SCOPED_TRACE(testing::Message() << "kind " << static_cast<int>(kind) << " seed " << seed);
      RandomGeometry random(seed);
      std::vector<Cell> cells;
      for (int i = 0; i < 4; ++i) {
        TrianglePair const pair = MakePair(random, kind);
        cells.push_back({pair.first, pair.second, pair.first});
      }
      NarrowAlong(cells);
    }
  }
}

TEST(CellSequence, GoesBackToWhatItWasAtADepth) {
  RandomGeometry random(7);
  std::vector<Cell> const cells = LineCellsOf(NoisyLine(random, 9, 0.05));
  ASSERT_EQ(cells.size(), 8U);
  CellSequence sequence(cells[0]);
  std::vector<Cell> states = {sequence.Expand()};
  for (std::size_t i = 1; i < cells.size(); ++i) {
    sequence.NarrowBy(cells[i]);
    states.push_back(sequence.Expand());
  }
  for (std::size_t depth = cells.size(); depth >= 1; --depth) {
    sequence.ReturnTo(depth);
    EXPECT_TRUE(SameCell(states[depth - 1], sequence.Expand()));
    ExpectSameSummary(states[depth - 1], sequence);
  }
}

TEST(CellSequence, EmptyHasNoCentreAndNoBounds) {
  CellSequence const nothing;
  ExpectSameSummary({}, nothing);
  EXPECT_TRUE(nothing.Expand().empty());

  CellSequence const ofNothing{Cell{}};
  ExpectSameSummary({}, ofNothing);
  EXPECT_FALSE(ofNothing.CentreOfOverlapWith(Triangle{}));
  EXPECT_FALSE(CellSequence().CentreOfOverlapWith(Triangle{}));
}

TEST(CellSequence, NarrowedByNothingIsEmpty) {
  CellSequence sequence{Cell{Triangle{{{0, 0}, {1, 0}, {0, 1}}}}};
  sequence.NarrowBy(Cell{});
  EXPECT_TRUE(sequence.empty());
  sequence.NarrowBy(Cell{Triangle{{{0, 0}, {1, 0}, {0, 1}}}});
  EXPECT_TRUE(sequence.empty());
}

TEST(CellSequence, BeginsAnewInTheRoomOfWhatItWas) {
  RandomGeometry random(11);
  std::vector<Cell> const longer = LineCellsOf(NoisyLine(random, 9, 0.05));
  std::vector<Cell> const shorter = CircleCellsOf(NoisyArc(random, 6, 20.0, 0.05));
  CellSequence reused;
  for (std::vector<Cell> const* cells : {&longer, &shorter, &longer}) {
    CellSequence fresh(cells->front());
    reused.Begin(cells->front());
    for (std::size_t i = 1; i < cells->size(); ++i) {
      fresh.NarrowBy((*cells)[i]);
      reused.NarrowBy((*cells)[i]);
    }
    EXPECT_EQ(reused.Depth(), fresh.Depth());
    EXPECT_TRUE(SameCell(fresh.Expand(), reused.Expand()));
    reused.clear();
    EXPECT_TRUE(reused.empty());
    EXPECT_TRUE(reused.Expand().empty());
  }
}

TEST(CellSequence, ProperCellsHaveARoughCentre) {
  RandomGeometry random(12);
  std::vector<Cell> const cells = CircleCellsOf(NoisyArc(random, 9, 20.0, 0.05));
  CellSequence sequence(cells.front());
  EXPECT_TRUE(sequence.FindRoughCentre());
  sequence.NarrowBy(cells[1]);
  EXPECT_TRUE(sequence.FindRoughCentre());
}

TEST(CellSequence, CellsWithoutAProperTriangleOrOfExtremeSizeHaveNoRoughCentre) {
  EXPECT_FALSE(CellSequence().FindRoughCentre());
  EXPECT_FALSE(CellSequence(Cell{Triangle{{{0, 0}, {1, 1}, {1, 1}}}}).FindRoughCentre());
  for (double const size : {1e-130, 1e90, kInf, kNaN}) {
    Cell const cell{Triangle{{{0, 0}, {size, 0}, {0, size}}}};
    EXPECT_FALSE(CellSequence(cell).FindRoughCentre()) << size;
  }
}

TEST(CellSequence, TellsNegativeZeroFromZero) {
  Cell const cell = {Triangle{{{0.0, 0.0}, {1, 0}, {0, 1}}},
                     Triangle{{{-0.0, 0.0}, {1, 0}, {0, 1}}},
                     Triangle{{{0.0, 0.0}, {1, 0}, {0, 1}}}};
  EXPECT_TRUE(SameCell(cell, CellSequence(cell).Expand()));
}

}  // namespace
}  // namespace Vorn::Testing
