#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <random>

#include "io/Contours.h"
#include "io/fit/Assignment.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Failure.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;

double Uniform(std::mt19937_64* engine, double low, double high) {
  return low + (high - low) * static_cast<double>((*engine)() >> 11) * 0x1p-53;
}

TEST(PiecesOf, StartsEachPieceWhereTheOneBeforeEnds) {
  std::vector<Piece> const pieces = PiecesOf(Contours::LineAndArc());
  ASSERT_EQ(pieces.size(), 2u);
  EXPECT_FALSE(pieces[0].IsArc());
  EXPECT_EQ(pieces[0].start.x, 0.0);
  EXPECT_EQ(pieces[0].length, 4.0);
  EXPECT_TRUE(pieces[1].IsArc());
  EXPECT_EQ(pieces[1].start.x, 4.0);
  EXPECT_FALSE(pieces[1].counterClockwise);
  EXPECT_NEAR(pieces[1].sweep, 1.5 * pi, 1e-15);
  EXPECT_NEAR(pieces[1].length, 1.5 * pi, 1e-15);
}

TEST(PiecesOf, ArcWithEqualAnglesHasNoSweep) {
  for (double const direction : {1.0, -1.0}) {
    auto const pieces =
        PiecesOf({Contours::Segment(1, 0), Contours::Arc(0, 0, 1, 0.5, 0.5, direction)});
    EXPECT_EQ(pieces.front().sweep, 0.0);
  }
}

TEST(PiecesOf, ContourOfOneElementHasNoPieces) {
  EXPECT_TRUE(PiecesOf({}).empty());
  EXPECT_TRUE(PiecesOf({Contours::Segment(1, 2)}).empty());
}

TEST(PiecesOf, RefusesElementsOfUnknownKind) {
  for (int const type : {2, -1}) {
    std::vector<GeometryUtils::Elem> contour = Contours::LineAndArc();
    contour[1].type = static_cast<GeometryUtils::ElemType>(type);
    EXPECT_THROW(PiecesOf(contour), Failure) << type;
  }
}

TEST(DistanceTo, LineIsClippedAtItsEnds) {
  Piece const line = PiecesOf(Contours::LineAndArc()).front();
  EXPECT_EQ(DistanceTo(line, 2.0, 3.0), 3.0);
  EXPECT_EQ(DistanceTo(line, -3.0, 4.0), 5.0);
  EXPECT_EQ(DistanceTo(line, 7.0, -4.0), 5.0);
}

TEST(DistanceTo, LineWithoutLengthIsAPoint) {
  Piece const line = PiecesOf({Contours::Segment(1, 1), Contours::Segment(1, 1)}).front();
  EXPECT_EQ(DistanceTo(line, 4.0, 5.0), 5.0);
}

TEST(DistanceTo, ArcIsClippedAtItsEnds) {
  Piece const arc = PiecesOf(Contours::LineAndArc()).back();
  EXPECT_NEAR(DistanceTo(arc, 7.0, -1.0), 2.0, 1e-15);  // right: on the swept side
  EXPECT_NEAR(DistanceTo(arc, 4.0, -1.5), 0.5, 1e-15);  // inside
  EXPECT_NEAR(DistanceTo(arc, 4.0, -1.0), 1.0, 1e-15);  // the centre
  // The open quarter is up left: there the ends (4, 0) and (3, -1) are nearest.
  EXPECT_NEAR(DistanceTo(arc, 3.0, 0.0), 1.0, 1e-15);
  EXPECT_NEAR(DistanceTo(arc, 4.0 - std::sqrt(0.5), -1.0 + std::sqrt(0.5)),
              std::hypot(std::sqrt(0.5), 1.0 - std::sqrt(0.5)), 1e-15);
}

TEST(DistanceTo, AgreesWithFineSamplesOfAnyArc) {
  constexpr std::uint64_t kSeed = 5;
  SCOPED_TRACE(kSeed);
  std::mt19937_64 engine(kSeed);
  constexpr int kSamples = 2000;
  for (int round = 0; round < 300; ++round) {
    double const from = Uniform(&engine, -pi, pi);
    double const to = Uniform(&engine, -pi, pi);
    double const turn = round % 2 == 0 ? 1.0 : -1.0;
    double const radius = Uniform(&engine, 0.5, 3.0);
    GeometryUtils::Elem const elem = Contours::Arc(1.0, 2.0, radius, from, to, turn);
    GeometryUtils::Elem const start = Contours::Arc(1.0, 2.0, radius, to, from, turn);
    Piece const arc = PiecesOf({start, elem}).front();
    double const sweep = std::fmod(turn * (to - from) + 2.0 * pi, 2.0 * pi);
    double const x = Uniform(&engine, -4.0, 6.0);
    double const y = Uniform(&engine, -3.0, 7.0);
    double nearest = 1e300;
    for (int i = 0; i <= kSamples; ++i) {
      double const angle = from + turn * sweep * i / kSamples;
      nearest = std::min(nearest, std::hypot(x - 1.0 - radius * std::cos(angle),
                                             y - 2.0 - radius * std::sin(angle)));
    }
    // Between two samples the distance falls by less than half their spacing.
    EXPECT_LE(DistanceTo(arc, x, y), nearest + 1e-12) << round;
    EXPECT_GE(DistanceTo(arc, x, y), nearest - 0.5 * radius * sweep / kSamples - 1e-12) << round;
  }
}

TEST(Remeasure, DividesByEachPointsOwnTolerance) {
  std::vector<Piece> const pieces = PiecesOf(Contours::LineAndArc());
  Remeasured const result = Remeasure({{1, 0.5, 1.0}, {2, -0.25, 0.1}, {3, 0.25, 0.1}}, pieces);
  EXPECT_EQ(result.points[0].distance, 0.5);
  EXPECT_EQ(result.points[0].relative, 0.5);
  EXPECT_EQ(result.points[1].relative, 2.5);
  EXPECT_EQ(result.worst, 1u) << "the first of equals";
  EXPECT_TRUE(result.points[0].isLeft);
  EXPECT_FALSE(result.points[1].isLeft);
}

TEST(Remeasure, TellsTheSidesOfArcs) {
  std::vector<Piece> const pieces = PiecesOf(Contours::LineAndArc());
  // Clockwise: the centre is to the right.
  Remeasured const result = Remeasure({{5.1, -1, 1}, {4.9, -1, 1}}, pieces);
  EXPECT_EQ(result.points[0].piece, 1u);
  EXPECT_TRUE(result.points[0].isLeft);
  EXPECT_FALSE(result.points[1].isLeft);
}

TEST(AssignPoints, DealsPointsOutInOrder) {
  FitReport const report = Contours::LineAndArcReport();
  ASSERT_TRUE(report.ranges.has_value());
  ASSERT_EQ(report.ranges->size(), 2u);
  EXPECT_EQ((*report.ranges)[0].first, 0u);
  EXPECT_EQ((*report.ranges)[0].count, 3u) << "the joint belongs to the earlier piece";
  EXPECT_EQ((*report.ranges)[1].first, 3u);
  EXPECT_EQ((*report.ranges)[1].count, 4u);
}

TEST(AssignPoints, KeepsTheOrderWhereAnotherPieceHappensToBeNearer) {
  auto const pieces =
      PiecesOf({Contours::Segment(0, 0), Contours::Segment(10, 0), Contours::Segment(0, 1)});
  std::vector<WPoint> const points = {{0, 0, 1},   {5, 0, 1},   {10, 0, 1},  {9, 0.1, 1},
                                      {8, 0.2, 1}, {7, 0.3, 1}, {6, 0.4, 1}, {5, 0.1, 1},
                                      {2, 0.8, 1}, {0, 1, 1}};
  EXPECT_EQ(Remeasure(points, pieces).points[7].piece, 0u) << "the way there is nearer";
  auto const ranges = AssignPoints(points, pieces);
  ASSERT_TRUE(ranges.has_value());
  EXPECT_EQ((*ranges)[0].count, 3u);
  EXPECT_EQ((*ranges)[1].first, 3u);
  EXPECT_EQ((*ranges)[1].count, 7u) << "but its neighbours are on the way back";
}

TEST(AssignPoints, GivesUpOnAbsurdSizes) {
  std::vector<WPoint> const points(5000, {0, 0, 1});
  std::vector<Piece> const pieces(5000);
  EXPECT_FALSE(AssignPoints(points, pieces).has_value());
  EXPECT_FALSE(AssignPoints(points, {}).has_value());
}

}  // namespace
}  // namespace Vorn::IO
