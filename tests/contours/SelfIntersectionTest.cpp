#include <cmath>
#include <limits>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/ContourBuilder.h"
#include "support/GridCrossings.h"
#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Arc = GeometryUtils::Arc;
using Elem = GeometryUtils::Elem;
using Point = GeometryUtils::Point;

ErrorCode Check(std::vector<Elem> const& contour) {
  return GeometryUtils::CheckPolySelfIntersection(contour);
}

ErrorCode Check(ContourBuilder const& builder) { return Check(builder.Build()); }

/// About the unit circle at the origin, between the given angles; the end lies at (endX, endY),
/// wherever that is, for nothing checks it.
Arc UnitArc(double startAngle, double endAngle, double endX, double endY, Point center = {0, 0}) {
  return {{endX, endY}, center, 1.0, 1.0, startAngle, endAngle};
}

// What is too short or not a contour.

TEST(CheckContour, NeedsAContourThatCanBeTested) {
  EXPECT_EQ(Check(std::vector<Elem>{}), ErrorCode::Failed);
  EXPECT_EQ(Check(ContourBuilder(0, 0)), ErrorCode::Failed);
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(1, 0)), ErrorCode::Failed);
  EXPECT_EQ(Check(ContourBuilder(0, 0).Arc(UnitArc(0, 1, 1, 1))), ErrorCode::Failed);
  EXPECT_EQ(Check(ContourBuilder(0, 0).Stay().Stay().Stay()), ErrorCode::Failed);
}

TEST(CheckContour, TwoSegmentsAloneHaveNoCandidate) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(1, 0).To(1, 1)), ErrorCode::Failed);
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(1, 0).To(1, 1).To(0, 1)), ErrorCode::Ok);
  // A segment and an arc are tested against each other.
  EXPECT_EQ(Check(ContourBuilder(-5, 0).To(-4, 0).Arc(UnitArc(0, 1, 1, 1))), ErrorCode::Ok);
  EXPECT_EQ(Check(ContourBuilder(-5, 0).Arc(UnitArc(0, 1, 1, 1)).To(9, 9)), ErrorCode::Ok);
}

TEST(CheckContour, FirstElementMustBeASegment) {
  auto contour = ContourBuilder(0, 0).To(3, 0).To(3, 3).To(0, 3).Build();
  for (int const type : {1, 2, -1}) {
    contour[0].type = static_cast<GeometryUtils::ElemType>(type);
    EXPECT_EQ(Check(contour), ErrorCode::Failed);
  }
}

TEST(CheckContour, InvalidElementCutsTheFirstPassShort) {
  for (int const type : {2, -1, std::numeric_limits<int>::max()}) {
    for (std::size_t at = 1; at < 5; ++at) {
      auto contour = ContourBuilder(0, 0).To(3, 0).To(3, 3).To(0, 3).To(0, 0).Build();
      contour[at].type = static_cast<GeometryUtils::ElemType>(type);
      EXPECT_EQ(Check(contour), ErrorCode::Failed) << "type " << type << " at " << at;
    }
  }
}

TEST(CheckContour, CrossingAheadOfAnInvalidElementIsReportedFirst) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(2, 2).To(2, 0).To(0, 2).OfType(2, 5, 5)),
            ErrorCode::SelfIntersection);
}

// Segments.

TEST(CheckContour, SquareIsFree) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(1, 0).To(1, 1).To(0, 1).To(0, 0)), ErrorCode::Ok);
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(0, 1).To(1, 1).To(1, 0).To(0, 0)), ErrorCode::Ok);
}

TEST(CheckContour, FigureEightCrosses) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(2, 2).To(2, 0).To(0, 2).To(0, 0)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, ClosingSegmentIsNotTestedAgainstTheFirst) {
  // Not even where it crosses it outright.
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(4, 0).To(4, 2).To(2, -2)), ErrorCode::Ok);
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(4, 0).To(4, 2).To(2, -2).To(2, -3)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, ClosingSegmentIsTestedAgainstTheOthers) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(4, 0).To(4, 4).To(0, 4).To(5, 2)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, TouchOfAVertexAndASideIsACrossing) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(4, 0).To(4, 4).To(2, 0).To(0, 4).To(0, 0)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, ConsecutiveSegmentsMayFoldBack) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(4, 0).To(2, 0).To(2, 3).To(0, 3)),
            ErrorCode::SelfIntersection);
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(4, 0).To(2, 0).To(1, 0)), ErrorCode::Ok);
}

TEST(CheckContour, OverlapOnOneLineIsNoCrossing) {
  // On a line through the origin the overlap is seen as collinear, on another as parallel.
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(4, 0).To(6, 0).To(1, 0).To(3, 0)), ErrorCode::Ok);
  EXPECT_EQ(Check(ContourBuilder(0, 1).To(4, 1).To(6, 1).To(1, 1).To(3, 1)), ErrorCode::Ok);
}

TEST(CheckContour, ZeroLengthSegmentsAreSkipped) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).Stay().To(1, 0).Stay().Stay().To(1, 1).To(0, 1).To(0, 0)),
            ErrorCode::Ok);
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(2, 2).Stay().To(2, 0).Stay().To(0, 2).To(0, 0)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, ZeroLengthElementAtTheEndFailsTheFirstPass) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(1, 0).To(1, 1).To(0, 1).Stay()), ErrorCode::Failed);
  // The last proper element is then not the last one, so it has no closing exemption either.
  EXPECT_EQ(Check(ContourBuilder(0, 0).To(1, 0).To(1, 1).To(0, 1).To(0, 0).Stay()),
            ErrorCode::SelfIntersection);
}

// Segment first, arc later.

TEST(CheckContour, SegmentAndArcWithOneCommonPointCross) {
  // The segment y = 0.5 from x = 0 leaves the circle once; the arc covers that point.
  ContourBuilder builder(0, 0.5);
  builder.To(5, 0.5).To(5, 9).Arc(UnitArc(-1, 1, 0, 9));
  // As the last element of the first pass the arc may touch.
  EXPECT_EQ(Check(builder), ErrorCode::Ok);
  EXPECT_EQ(Check(builder.To(0, 12)), ErrorCode::SelfIntersection);
}

TEST(CheckContour, SegmentAndNextArcWithOneCommonPointCross) {
  ContourBuilder builder(0, 0.5);
  builder.To(5, 0.5).Arc(UnitArc(-1, 1, 0, 9));
  EXPECT_EQ(Check(builder), ErrorCode::Ok);
  EXPECT_EQ(Check(builder.To(0, 12)), ErrorCode::SelfIntersection);
}

TEST(CheckContour, ClosingTouchIsAcceptedInTheFirstPassOnly) {
  EXPECT_EQ(Check(ContourBuilder(-9, -9).To(0, 0.5).To(5, 0.5).To(5, 9).Arc(UnitArc(-1, 1, 0, 9))),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, SegmentAndArcWithTwoCommonPointsAlwaysCross) {
  EXPECT_EQ(Check(ContourBuilder(-5, 0.5).To(5, 0.5).To(5, 9).Arc(UnitArc(-0.5, 3.5, 0, 9))),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, SegmentAndArcThatOnlyShareTheArcsEndAreFree) {
  // The hit at angle 0 is the arc's start, which never counts.
  EXPECT_EQ(Check(ContourBuilder(5, 0).To(1, 0).Arc(UnitArc(0, 1.5, 0, 1)).To(0, 5).To(3, 9)),
            ErrorCode::Ok);
}

TEST(CheckContour, SegmentAgainstAnArcOfEqualAnglesFails) {
  EXPECT_EQ(Check(ContourBuilder(-9, 0).To(-8, 0).Arc(UnitArc(0.5, 0.5, 3, 3)).To(9, 9)),
            ErrorCode::Failed);
  EXPECT_EQ(Check(ContourBuilder(-9, 0).To(-8, 0).To(-8, 5).Arc(UnitArc(0.5, 0.5, 3, 3))),
            ErrorCode::Failed);
}

// Arc first, segment later.

TEST(CheckContour, ArcOfEqualAnglesIsPassedOverByLaterSegments) {
  EXPECT_EQ(Check(ContourBuilder(0, 0).Arc(UnitArc(0.5, 0.5, -3, 0)).To(3, 0).To(3, 3)),
            ErrorCode::Ok);
}

TEST(CheckContour, ArcAndItsFirstCandidateMayTouch) {
  // From inside the circle out through the arc: one common point.
  ContourBuilder touching(9, 9);
  touching.Arc(UnitArc(-1, 1, 0, 0.5)).To(5, 0.5).To(5, 9);
  EXPECT_EQ(Check(touching), ErrorCode::Ok);
  // An element of zero length in between changes nothing: the candidate is still the first.
  ContourBuilder delayed(9, 9);
  delayed.Arc(UnitArc(-1, 1, 0, 0.5)).Stay().To(5, 0.5).To(5, 9);
  EXPECT_EQ(Check(delayed), ErrorCode::Ok);
}

TEST(CheckContour, ArcAndALaterSegmentMayNotTouch) {
  ContourBuilder builder(9, 9);
  builder.Arc(UnitArc(-1, 1, 0, 4)).To(0, 0.5).To(5, 0.5);
  // The last element of the first pass may.
  EXPECT_EQ(Check(builder), ErrorCode::Ok);
  EXPECT_EQ(Check(builder.To(5, 9)), ErrorCode::SelfIntersection);
  // In a later pass the last element may not.
  EXPECT_EQ(Check(ContourBuilder(20, 9).To(9, 9).Arc(UnitArc(-1, 1, 0, 4)).To(0, 0.5).To(5, 0.5)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, ArcAndASegmentWithTwoCommonPointsCross) {
  EXPECT_EQ(Check(ContourBuilder(9, 9).Arc(UnitArc(-0.5, 3.5, -5, 0.5)).To(5, 0.5).To(5, 9)),
            ErrorCode::SelfIntersection);
  EXPECT_EQ(Check(ContourBuilder(9, 9).Arc(UnitArc(-0.5, 3.5, -5, 0.5)).To(5, 0.5)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, AcceptedTouchOfAnArcAndASegmentDoesNotEndTheScan) {
  EXPECT_EQ(Check(ContourBuilder(9, 9)
                      .Arc(UnitArc(-1, 1, 0, 0.5))
                      .To(5, 0.5)
                      .To(5, -0.5)
                      .To(0, -0.5)
                      .To(-5, -0.5)),
            ErrorCode::SelfIntersection);
}

// Arc and arc. The unit circles about (0, 0) and (1, 0) meet at (0.5, +-sqrt(0.75)), which are the
// angles +-1.047 on the first and +-2.094 on the second.

Arc const kUpperOfFirst = UnitArc(0.5, 1.5, 0, 0);
Arc const kBothOfFirst = UnitArc(-1.5, 1.5, 0, 0);
Arc const kUpperOfSecond = UnitArc(1.5, 2.5, 9, 9, {1, 0});
Arc const kBothOfSecond = UnitArc(1.5, -1.5, 9, 9, {1, 0});

TEST(CheckContour, NeighbouringArcsMayTouchOnce) {
  EXPECT_EQ(Check(ContourBuilder(5, 5).Arc(kUpperOfFirst).Arc(kUpperOfSecond).To(20, 9)),
            ErrorCode::Ok);
  // The same in a later pass.
  EXPECT_EQ(Check(ContourBuilder(30, 5).To(5, 5).Arc(kUpperOfFirst).Arc(kUpperOfSecond).To(20, 9)),
            ErrorCode::Ok);
}

TEST(CheckContour, NeighbouringArcsMayNotMeetTwice) {
  EXPECT_EQ(Check(ContourBuilder(5, 5).Arc(kBothOfFirst).Arc(kBothOfSecond).To(20, 9)),
            ErrorCode::SelfIntersection);
  EXPECT_EQ(Check(ContourBuilder(5, 5).Arc(kBothOfFirst).Arc(kBothOfSecond)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, ArcsThatAreNotPhysicallyNeighboursMayNotTouch) {
  // An element of zero length between them takes the exemption away.
  EXPECT_EQ(Check(ContourBuilder(5, 5).Arc(kUpperOfFirst).Stay().Arc(kUpperOfSecond).To(20, 9)),
            ErrorCode::SelfIntersection);
  EXPECT_EQ(Check(ContourBuilder(5, 5).Arc(kUpperOfFirst).To(-9, 0).Arc(kUpperOfSecond).To(20, 9)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, ClosingArcMayTouchTheFirstArc) {
  EXPECT_EQ(Check(ContourBuilder(5, 5).Arc(kUpperOfFirst).To(-9, 0).To(-9, 9).Arc(kUpperOfSecond)),
            ErrorCode::Ok);
  EXPECT_EQ(Check(ContourBuilder(30, 30)
                      .To(5, 5)
                      .Arc(kUpperOfFirst)
                      .To(-9, 0)
                      .To(-9, 9)
                      .Arc(kUpperOfSecond)),
            ErrorCode::SelfIntersection);
}

TEST(CheckContour, AcceptedTouchOfArcsEndsTheScan) {
  // The last segment runs through the first arc twice, but the touch of the arcs hides it.
  auto const withSecond = [](Arc const& second) {
    return Check(
        ContourBuilder(5, 5).Arc(kBothOfFirst).Arc(second).To(0.6, 9).To(0.6, -9).To(9, -9));
  };
  Arc touching = UnitArc(1.5, 2.5, 9, 9, {1, 0});
  Arc apart = UnitArc(0.1, 0.2, 9, 9, {1, 0});
  // Both second arcs are kept clear of the last segments by their own angles.
  touching.endAngle = 2.2;
  touching.startAngle = 2.05;
  EXPECT_EQ(withSecond(touching), ErrorCode::Ok);
  EXPECT_EQ(withSecond(apart), ErrorCode::SelfIntersection);
}

TEST(CheckContour, ArcsWithoutAPositiveRadiusFail) {
  for (double const radius : {0.0, -0.0, -1.0}) {
    Arc flat = UnitArc(0, 1, 9, 9, {5, 5});
    flat.radius = radius;
    EXPECT_EQ(Check(ContourBuilder(5, 5).Arc(kUpperOfFirst).Arc(flat).To(20, 9)),
              ErrorCode::Failed);
    EXPECT_EQ(Check(ContourBuilder(5, 5).Arc(flat).Arc(kUpperOfFirst).To(20, 9)),
              ErrorCode::Failed);
  }
}

TEST(CheckContour, CircleOfTwoHalvesIsFree) {
  for (double const direction : {1.0, -1.0}) {
    EXPECT_EQ(
        Check(
            ContourBuilder(2, 0).Around({0, 0}, -2, 0, direction).Around({0, 0}, 2, 0, direction)),
        ErrorCode::Ok);
  }
}

TEST(CheckContour, RingOfSegmentsWithRoundedCornersIsFree) {
  EXPECT_EQ(Check(ContourBuilder(1, 0)
                      .To(7, 0)
                      .Around({7, 1}, 8, 1, 1.0)
                      .To(8, 3)
                      .Around({7, 3}, 7, 4, 1.0)
                      .To(1, 4)
                      .Around({1, 3}, 0, 3, 1.0)
                      .To(0, 1)
                      .Around({1, 1}, 1, 0, 1.0)),
            ErrorCode::Ok);
}

// Random contours.

/// What the check must say of segments between grid points, consecutive ones different: pairs as
/// Boost.Geometry sees them. Documented differences from a plain test for simplicity: parallel
/// segments never cross, consecutive segments are not tested, and neither is the last one against
/// the first.
ErrorCode ExpectedOfGridPath(std::vector<Point> const& points) {
  std::size_t const count = points.size() - 1;
  if (count < 3) return ErrorCode::Failed;
  for (std::size_t i = 0; i < count; ++i) {
    for (std::size_t k = i + 2; k < count; ++k) {
      if (i == 0 && k == count - 1) continue;
      if (MeetAtAnAngle({points[i], points[i + 1]}, {points[k], points[k + 1]})) {
        return ErrorCode::SelfIntersection;
      }
    }
  }
  return ErrorCode::Ok;
}

std::vector<Point> RandomGridPath(RandomGeometry* random, int reach, int maxPoints) {
  std::vector<Point> points;
  auto const count = static_cast<std::size_t>(random->Integer(1, maxPoints));
  while (points.size() < count) {
    Point const p = random->GridPoint(reach);
    if (!points.empty() && p.x == points.back().x && p.y == points.back().y) continue;
    points.push_back(p);
  }
  return points;
}

TEST(CheckContour, AgreesWithAGeometryLibraryOnGridPaths) {
  RandomGeometry random(41);
  int byCode[20] = {};
  for (int round = 0; round < 20000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 41, round " << round);
    auto points = RandomGridPath(&random, round % 2 == 0 ? 3 : 12, 8);
    bool const close = random.Flip() && points.size() > 2 &&
                       (points.front().x != points.back().x || points.front().y != points.back().y);
    if (close) points.push_back(points.front());
    ContourBuilder plain(points[0].x, points[0].y);
    ContourBuilder padded(points[0].x, points[0].y);
    for (std::size_t i = 1; i < points.size(); ++i) {
      if (random.Flip()) padded.Stay();
      plain.To(points[i].x, points[i].y);
      padded.To(points[i].x, points[i].y);
    }
    ErrorCode const expected = ExpectedOfGridPath(points);
    ++byCode[static_cast<int>(expected)];
    ASSERT_EQ(Check(plain), expected);
    // Elements of zero length are skipped.
    ASSERT_EQ(Check(padded), expected);
  }
  EXPECT_GT(byCode[0], 2000);
  EXPECT_GT(byCode[2], 2000);
  EXPECT_GT(byCode[19], 2000);
}

/// Pieces with joints that are clear of each other: the angles of the arcs stop short of their
/// ends.
struct SampledPiece {
  bool isArc = false;
  std::vector<Point> chain;
};

/// How often two chains of chords cross; -1 when that is too close to call.
int CountCrossings(SampledPiece const& first, SampledPiece const& second, double clearance) {
  auto const side = [](Point const& a, Point const& b, Point const& p) {
    return (b.x - a.x) * (p.y - a.y) - (b.y - a.y) * (p.x - a.x);
  };
  int count = 0;
  for (std::size_t m = 0; m + 1 < first.chain.size(); ++m) {
    Point const& a = first.chain[m];
    Point const& b = first.chain[m + 1];
    for (std::size_t n = 0; n + 1 < second.chain.size(); ++n) {
      Point const& c = second.chain[n];
      Point const& d = second.chain[n + 1];
      if ((side(a, b, c) > 0) == (side(a, b, d) > 0)) continue;
      if ((side(c, d, a) > 0) == (side(c, d, b) > 0)) continue;
      ++count;
    }
  }
  // Too close: an end of one piece near the other, or a near tangency, seen as a small distance
  // between the pieces without a matching pair of clear crossings.
  auto const distanceToChain = [](Point const& p, std::vector<Point> const& chain) {
    double best = std::numeric_limits<double>::infinity();
    for (std::size_t m = 0; m + 1 < chain.size(); ++m) {
      double const dx = chain[m + 1].x - chain[m].x;
      double const dy = chain[m + 1].y - chain[m].y;
      double t = ((p.x - chain[m].x) * dx + (p.y - chain[m].y) * dy) / (dx * dx + dy * dy);
      t = std::fmin(1.0, std::fmax(0.0, t));
      best = std::fmin(best, std::hypot(p.x - chain[m].x - t * dx, p.y - chain[m].y - t * dy));
    }
    return best;
  };
  for (auto const* pair : {&first, &second}) {
    auto const& other = pair == &first ? second : first;
    for (Point const& end : {pair->chain.front(), pair->chain.back()}) {
      if (distanceToChain(end, other.chain) < clearance) return -1;
    }
  }
  if (count == 1) return 1;
  double nearest = std::numeric_limits<double>::infinity();
  for (Point const& p : first.chain) nearest = std::fmin(nearest, distanceToChain(p, second.chain));
  return count == 0 && nearest < clearance ? -1 : count;
}

/// The walk's rules over a table of counts, one line per rule.
ErrorCode ExpectedFromCounts(std::vector<SampledPiece> const& pieces,
                             std::vector<std::vector<int>> const& counts) {
  std::size_t const last = pieces.size() - 1;
  for (std::size_t i = 0; i <= last; ++i) {
    for (std::size_t k = i + 1; k <= last; ++k) {
      bool const closing = i == 0 && k == last;
      bool const neighbours = k == i + 1;
      int const n = counts[i][k];
      if (!pieces[i].isArc && !pieces[k].isArc) {
        if (neighbours) continue;
        if (closing) break;
        if (n > 0) return ErrorCode::SelfIntersection;
      } else if (n == 2) {
        return ErrorCode::SelfIntersection;
      } else if (n == 1) {
        bool const accepted = pieces[i].isArc ? neighbours || closing : closing;
        if (!accepted) return ErrorCode::SelfIntersection;
        if (pieces[i].isArc && pieces[k].isArc) break;
      }
    }
  }
  return ErrorCode::Ok;
}

TEST(CheckContour, AgreesWithSampledCrossingsOfArcsAndSegments) {
  // Arcs are cut short at both ends, which nothing checks, so that joints are not near any piece
  // but a segment's neighbour.
  constexpr int kChords = 48;
  constexpr double kClearance = 0.02;
  RandomGeometry random(42);
  int free = 0;
  int crossing = 0;
  for (int round = 0; round < 2000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 42, round " << round);
    Point const start = random.PointIn(-5, 5);
    ContourBuilder builder(start.x, start.y);
    std::vector<SampledPiece> pieces;
    int const count = random.Integer(3, 5);
    for (int i = 0; i < count; ++i) {
      SampledPiece piece;
      Point const from = builder.Build().back().end;
      if (random.Flip()) {
        Point const to = random.PointIn(-5, 5);
        builder.To(to.x, to.y);
        piece.chain = {from, to};
      } else {
        piece.isArc = true;
        Point const center = random.PointIn(-4, 4);
        double const radius = random.Uniform(0.5, 4);
        double const startAngle = random.Uniform(-3.1, 3.1);
        double const sweep = random.Uniform(0.5, 5.5);
        double const direction = random.Flip() ? 1.0 : -1.0;
        double const endAngle =
            std::remainder(startAngle + direction * sweep, 2.0 * std::acos(-1.0));
        for (int step = 0; step <= kChords; ++step) {
          double const angle = startAngle + direction * sweep * step / kChords;
          piece.chain.push_back(
              {center.x + radius * std::cos(angle), center.y + radius * std::sin(angle)});
        }
        Point const to = random.PointIn(-5, 5);
        builder.Arc({to, center, radius, direction, startAngle, endAngle});
      }
      pieces.push_back(piece);
    }
    std::vector<std::vector<int>> counts(pieces.size(), std::vector<int>(pieces.size(), 0));
    bool isClear = true;
    for (std::size_t i = 0; i < pieces.size(); ++i) {
      for (std::size_t k = i + 1; k < pieces.size(); ++k) {
        bool const joined = k == i + 1 && !pieces[i].isArc && !pieces[k].isArc;
        counts[i][k] = joined ? 0 : CountCrossings(pieces[i], pieces[k], kClearance);
        isClear = isClear && counts[i][k] >= 0;
      }
    }
    if (!isClear) continue;
    ErrorCode const expected = ExpectedFromCounts(pieces, counts);
    ASSERT_EQ(Check(builder), expected);
    ++(expected == ErrorCode::Ok ? free : crossing);
  }
  EXPECT_GT(free, 100);
  EXPECT_GT(crossing, 500);
}

// Wrong input.

TEST(CheckContour, AnyBitsEndInADocumentedCode) {
  RandomGeometry random(43);
  for (int round = 0; round < 5000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 43, round " << round);
    std::vector<Elem> contour;
    int const count = random.Integer(0, 7);
    double const odd[] = {kNaN, kInf, -kInf, 0.0, -0.0, 1e308, 5e-324, 1.0, -1.0, 3.0};
    auto const value = [&] {
      return random.Flip() ? odd[random.Integer(0, 9)] : random.AnyDouble();
    };
    bool hasInvalidStart = count == 0;
    for (int i = 0; i < count; ++i) {
      Elem elem;
      elem.type = static_cast<GeometryUtils::ElemType>(
          random.Integer(0, 9) == 0 ? random.Integer(-1, 2) : random.Integer(0, 1));
      if (i == 0) hasInvalidStart = elem.type != GeometryUtils::ElemType::Segment;
      elem.end = {value(), value()};
      elem.center = {value(), value()};
      elem.radius = value();
      elem.direction = value();
      elem.startAngle = value();
      elem.endAngle = value();
      contour.push_back(elem);
    }
    ErrorCode const code = Check(contour);
    EXPECT_TRUE(code == ErrorCode::Ok || code == ErrorCode::Failed ||
                code == ErrorCode::SelfIntersection);
    if (hasInvalidStart || count < 2) {
      EXPECT_EQ(code, ErrorCode::Failed);
    }
    double area = kSentinel;
    ErrorCode const areaCode = GeometryUtils::GetArea(contour, &area);
    if (code != ErrorCode::Ok) {
      EXPECT_EQ(areaCode, code);
    }
    if (areaCode != ErrorCode::Ok) {
      EXPECT_SAME_BITS(area, kSentinel);
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
