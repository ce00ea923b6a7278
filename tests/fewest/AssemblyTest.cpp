#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "geometry/fewest/Assembly.h"

namespace Vorn::Fewest {
namespace {

using Point = GeometryUtils::Point;

double Distance(BuiltPiece const& piece, double x, double y) {
  return DistanceToPiece(piece, {x, y, 1.0});
}

TEST(DistanceToPiece, OfASegmentIsToItsNearestPoint) {
  BuiltPiece const segment = BuildSegment({0, 0}, {4, 0});
  EXPECT_EQ(Distance(segment, 1, 3), 3.0);
  EXPECT_EQ(Distance(segment, 1, -3), 3.0);
  EXPECT_EQ(Distance(segment, -3, 4), 5.0) << "before the start";
  EXPECT_EQ(Distance(segment, 7, 4), 5.0) << "behind the end";
  EXPECT_EQ(Distance(segment, 4, 0), 0.0);
  EXPECT_EQ(Distance(BuildSegment({1, 1}, {1, 1}), 4, 5), 5.0) << "without length";
}

TEST(DistanceToPiece, OfAnArcIsToItsCircleBesideItAndElseToItsEnds) {
  // The upper half of the circle of radius 5 about the origin, either way round.
  for (double const direction : {1.0, -1.0}) {
    Point const start{direction * 5.0, 0};
    Point const end{-direction * 5.0, 0};
    BuiltPiece const arc = BuildArc(start, end, {0, 0}, direction);
    EXPECT_EQ(arc.elem.radius, 5.0);
    EXPECT_NEAR(Distance(arc, 0, 7), 2.0, 1e-14);
    EXPECT_NEAR(Distance(arc, 0, 1), 4.0, 1e-14);
    EXPECT_NEAR(Distance(arc, 3, 4), 0.0, 1e-14);
    EXPECT_NEAR(Distance(arc, 5, -2), 2.0, 1e-14) << "below one end";
    EXPECT_NEAR(Distance(arc, -5, -2), 2.0, 1e-14) << "below the other end";
    EXPECT_NEAR(Distance(arc, 0, -5), std::sqrt(50.0), 1e-14) << "where the other half would be";
  }
}

TEST(DistanceToPiece, OfAnArcOfMoreThanHalfATurnLeavesOutTheGap) {
  // From 45 degrees counter-clockwise to -45 degrees: the gap is around (5, 0).
  double const c = 5.0 * std::sqrt(0.5);
  BuiltPiece const arc = BuildArc({c, c}, {c, -c}, {0, 0}, 1.0);
  EXPECT_NEAR(Distance(arc, -6, 0), 1.0, 1e-14);
  EXPECT_NEAR(Distance(arc, 0, 6), 1.0, 1e-14);
  EXPECT_NEAR(Distance(arc, 0, -4), 1.0, 1e-14);
  EXPECT_NEAR(Distance(arc, 5, 0), std::hypot(5.0 - c, c), 1e-14);
}

TEST(BuildAlong, CircleWithoutCurvatureGivesASegment) {
  PlacedCircle const line{{0.0, 0.0, 1.0, 0.0}, {0.0, 0.0}};
  EXPECT_EQ(BuildAlong(line, {0, 0}, {4, 0}).elem.type, GeometryUtils::ElemType::Segment);
}

TEST(BuildAlong, CentreLiesOnTheBisectorOfTheEnds) {
  // a (x^2 + y^2) - r / 2 with a = 1 / (2 r), r = 5: the circle about the origin.
  PlacedCircle const circle{{0.1, 0.0, 0.0, -2.5}, {0.0, 0.0}};
  BuiltPiece const arc = BuildAlong(circle, {5, 0}, {0, 5});
  ASSERT_EQ(arc.elem.type, GeometryUtils::ElemType::Arc);
  EXPECT_NEAR(arc.elem.center.x, 0.0, 1e-14);
  EXPECT_NEAR(arc.elem.center.y, 0.0, 1e-14);
  EXPECT_NEAR(arc.elem.radius, 5.0, 1e-14);
  EXPECT_EQ(std::fabs(arc.elem.direction), 1.0);
}

TEST(BuildArcNear, MovesTheCentreToTheSameDistanceFromBothEnds) {
  BuiltPiece const arc = BuildArcNear({5, 0}, {0, 5}, {0.5, -0.5}, 1.0);
  EXPECT_NEAR(arc.elem.center.x, 0.0, 1e-15);
  EXPECT_NEAR(arc.elem.center.y, 0.0, 1e-15);
  EXPECT_NEAR(arc.elem.radius, 5.0, 1e-15);
}

TEST(BuildArcNear, KeepsTheCentreOfEndsThatCoincide) {
  BuiltPiece const arc = BuildArcNear({5, 0}, {5, 0}, {1, 2}, 1.0);
  EXPECT_EQ(arc.elem.center.x, 1.0);
  EXPECT_EQ(arc.elem.center.y, 2.0);
}

TEST(BuildArc, LengthsWhoseSquaresAreNoDoublesHaveARadius) {
  EXPECT_DOUBLE_EQ(BuildArc({3e200, 0}, {0, 3e200}, {0, 0}, 1.0).elem.radius, 3e200);
  EXPECT_DOUBLE_EQ(BuildArc({3e-200, 4e-200}, {0, 5e-200}, {0, 0}, 1.0).elem.radius, 5e-200);
}

TEST(MeasurePiece, FindsTheLargestShareOfATolerance) {
  Path path;
  path.points = {{1, 0.5, 1.0}, {2, -0.2, 0.1}, {3, 1.0, 4.0}, {9, 9, 1e-9}};
  BuiltPiece const segment = BuildSegment({0, 0}, {4, 0});
  PieceDeviation const largest = MeasurePiece(path, segment, 0, 3);
  EXPECT_EQ(largest.index, 1);
  EXPECT_DOUBLE_EQ(largest.value, 2.0);
  EXPECT_EQ(MeasurePiece(path, segment, 2, 2).index, -1) << "no points, no deviation";
}

}  // namespace
}  // namespace Vorn::Fewest
