#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numbers>

#include "support/RandomGeometry.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;
using Testing::RandomGeometry;

/// A quarter of the unit circle, counter-clockwise from (1, 0) to (0, 1).
Piece Quarter() { return MakeArc({1, 0}, {0, 1}, {0, 0}, 1.0, true); }

TEST(MakeArc, KnowsSweepAndLengthOfParts) {
  EXPECT_DOUBLE_EQ(Quarter().sweep, pi / 2);
  EXPECT_DOUBLE_EQ(Quarter().length, pi / 2);
  EXPECT_DOUBLE_EQ(MakeArc({1, 0}, {0, 1}, {0, 0}, 1.0, false).sweep, 3 * pi / 2);
  EXPECT_DOUBLE_EQ(MakeArc({2, 5}, {-2, 5}, {0, 5}, 2.0, true).length, 2 * pi);
}

TEST(MakeArc, EndsInOneDirectionMeanNoSweep) {
  EXPECT_EQ(MakeArc({1, 0}, {1, 0}, {0, 0}, 1.0, true).sweep, 0.0);
  EXPECT_EQ(MakeArc({1, 0}, {1, 0}, {0, 0}, 1.0, false).length, 0.0);
}

TEST(MakeCircle, IsTwoHalvesThatMeet) {
  for (bool const isCounterClockwise : {true, false}) {
    std::vector<Piece> const halves = MakeCircle({3, 4}, {0, 4}, 3.0, isCounterClockwise);
    ASSERT_EQ(halves.size(), 2u);
    EXPECT_DOUBLE_EQ(halves[0].length + halves[1].length, 6 * pi);
    EXPECT_EQ(halves[0].end.x, halves[1].start.x);
    EXPECT_EQ(halves[0].end.y, halves[1].start.y);
    EXPECT_EQ(halves[1].end.x, 3.0);
    EXPECT_EQ(halves[1].end.y, 4.0);
    EXPECT_EQ(halves[0].counterClockwise, isCounterClockwise);
  }
}

TEST(PointOnArc, GoesTheArcsOwnWay) {
  XY const left = PointOnArc(Quarter(), pi / 4);
  EXPECT_NEAR(left.x, std::sqrt(0.5), 1e-15);
  EXPECT_NEAR(left.y, std::sqrt(0.5), 1e-15);
  XY const right = PointOnArc(MakeArc({1, 0}, {0, 1}, {0, 0}, 1.0, false), pi / 2);
  EXPECT_NEAR(right.x, 0.0, 1e-15);
  EXPECT_NEAR(right.y, -1.0, 1e-15);
}

TEST(DistanceToPiece, OfALineEndsAtItsEnds) {
  Piece const line = MakeLine({0, 0}, {10, 0});
  EXPECT_EQ(DistanceTo(line, 5, 2), 2.0);
  EXPECT_EQ(DistanceTo(line, -3, 4), 5.0);
  EXPECT_EQ(DistanceTo(line, 13, -4), 5.0);
  EXPECT_EQ(DistanceTo(MakeLine({1, 1}, {1, 1}), 4, 5), 5.0) << "a line of no length";
}

TEST(DistanceToPiece, OfAnArcIsToItsCircleWithinTheSweepOnly) {
  EXPECT_NEAR(DistanceTo(Quarter(), 3, 4), 4.0, 1e-15);
  EXPECT_NEAR(DistanceTo(Quarter(), 0.3, 0.4), 0.5, 1e-15);
  EXPECT_NEAR(DistanceTo(Quarter(), -3, -0.0), std::sqrt(10.0), 1e-15) << "to the end (0, 1)";
  EXPECT_EQ(DistanceTo(Quarter(), 0, 0), 1.0) << "from the centre";
}

TEST(FootOn, NamesThePlaceAndTheWayToIt) {
  Foot const onLine = FootOn(MakeLine({0, 0}, {6, 8}), 3, 4);
  EXPECT_DOUBLE_EQ(onLine.along, 5.0);
  Foot const before = FootOn(MakeLine({0, 0}, {6, 8}), -3, -4);
  EXPECT_EQ(before.along, 0.0);
  EXPECT_EQ(before.at.x, 0.0);
  Foot const onArc = FootOn(Quarter(), 7, 7);
  EXPECT_NEAR(onArc.along, pi / 4, 1e-15);
}

TEST(FootOn, IsNoFurtherThanAnyOtherPlace) {
  RandomGeometry random(11);
  for (int round = 0; round < 300; ++round) {
    XY const center = {random.Uniform(-5, 5), random.Uniform(-5, 5)};
    double const radius = random.Uniform(0.1, 5);
    double const from = random.Uniform(-3, 3);
    double const to = random.Uniform(-3, 3);
    Piece const arc =
        MakeArc({center.x + radius * std::cos(from), center.y + radius * std::sin(from)},
                {center.x + radius * std::cos(to), center.y + radius * std::sin(to)}, center,
                radius, random.Flip());
    XY const p = {random.Uniform(-9, 9), random.Uniform(-9, 9)};
    Foot const foot = FootOn(arc, p.x, p.y);
    EXPECT_NEAR(Distance(foot.at, p), DistanceTo(arc, p.x, p.y), 1e-12) << round;
    for (int step = 0; step <= 200; ++step) {
      XY const place = PointOnArc(arc, arc.sweep * step / 200);
      EXPECT_LE(Distance(foot.at, p), Distance(place, p) + 1e-12) << round;
    }
  }
}

TEST(Reversed, TwiceIsThePieceItself) {
  for (Piece const& piece : {Quarter(), MakeLine({1, 2}, {3, 5})}) {
    Piece const back = Reversed(piece);
    EXPECT_EQ(back.start.x, piece.end.x);
    EXPECT_EQ(back.end.y, piece.start.y);
    EXPECT_EQ(back.length, piece.length);
    Piece const again = Reversed(back);
    EXPECT_EQ(again.counterClockwise, piece.counterClockwise);
    EXPECT_EQ(again.startAngle, piece.startAngle);
    EXPECT_EQ(again.endAngle, piece.endAngle);
  }
}

TEST(ExtentOf, HoldsWhatAnArcBulgesOut) {
  Extent const upper = ExtentOf({MakeArc({3, 0}, {-3, 0}, {0, 0}, 3.0, true)});
  EXPECT_EQ(upper.high.y, 3.0);
  EXPECT_EQ(upper.low.y, 0.0);
  Extent const lower = ExtentOf({MakeArc({3, 0}, {-3, 0}, {0, 0}, 3.0, false)});
  EXPECT_EQ(lower.low.y, -3.0);
  EXPECT_EQ(lower.high.y, 0.0);
}

TEST(ExtentOf, HoldsEveryPlaceOfRandomArcs) {
  RandomGeometry random(12);
  for (int round = 0; round < 300; ++round) {
    double const from = random.Uniform(-3.1, 3.1);
    double const to = random.Uniform(-3.1, 3.1);
    Piece const arc = MakeArc({2 * std::cos(from), 2 * std::sin(from)},
                              {2 * std::cos(to), 2 * std::sin(to)}, {0, 0}, 2.0, random.Flip());
    Extent const box = ExtentOf({arc});
    for (int step = 0; step <= 100; ++step) {
      XY const place = PointOnArc(arc, arc.sweep * step / 100);
      EXPECT_GE(place.x, box.low.x - 1e-14) << round;
      EXPECT_LE(place.x, box.high.x + 1e-14) << round;
      EXPECT_GE(place.y, box.low.y - 1e-14) << round;
      EXPECT_LE(place.y, box.high.y + 1e-14) << round;
    }
  }
}

TEST(PiecesOf, EachBeginsWhereTheOneBeforeEnds) {
  std::vector<GeometryUtils::Elem> contour;
  GeometryUtils::AddSegm(&contour, {0, 0});
  GeometryUtils::AddSegm(&contour, {1, 0});
  GeometryUtils::AddArc(&contour, {1, 0}, {0, 1}, {0, 0}, 1.0, false);
  std::vector<Piece> const pieces = PiecesOf(contour);
  ASSERT_EQ(pieces.size(), 2u);
  EXPECT_FALSE(pieces[0].IsArc());
  EXPECT_EQ(pieces[0].length, 1.0);
  ASSERT_TRUE(pieces[1].IsArc());
  EXPECT_EQ(pieces[1].start.x, 1.0);
  EXPECT_NEAR(pieces[1].sweep, pi / 2, 1e-15);
}

TEST(PiecesOf, NothingAndAStartAloneHaveNone) {
  EXPECT_TRUE(PiecesOf({}).empty());
  std::vector<GeometryUtils::Elem> start;
  GeometryUtils::AddSegm(&start, {5, 5});
  EXPECT_TRUE(PiecesOf(start).empty());
}

TEST(PiecesOf, AnUnknownElementIsADefect) {
  std::vector<GeometryUtils::Elem> contour;
  GeometryUtils::AddSegm(&contour, {0, 0});
  GeometryUtils::AddSegm(&contour, {1, 0});
  contour.back().type = static_cast<GeometryUtils::ElemType>(77);
  try {
    PiecesOf(contour);
    FAIL();
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::Internal);
  }
}

}  // namespace
}  // namespace Vorn::IO
