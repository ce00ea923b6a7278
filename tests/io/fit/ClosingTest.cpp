#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "io/fit/Closing.h"
#include "io/fit/FullCircle.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Deviations.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;

/// Checks what must hold of any arc handed on: ends on the circle, angles and sweep to match.
void ExpectConsistent(Piece const& arc) {
  for (XY const& end : {arc.start, arc.end}) {
    EXPECT_NEAR(std::hypot(end.x - arc.center.x, end.y - arc.center.y), arc.radius,
                1e-12 * arc.radius);
  }
  XY const turned = PointOnArc(arc, arc.sweep);
  EXPECT_NEAR(turned.x, arc.end.x, 1e-12 * arc.radius);
  EXPECT_NEAR(turned.y, arc.end.y, 1e-12 * arc.radius);
  EXPECT_NEAR(arc.length, arc.radius * arc.sweep, 1e-12 * arc.radius);
}

/// A triangle of lines with a gap of (dx, dy) at its seam (0, 0).
std::vector<Piece> Triangle(double dx, double dy) {
  return {MakeLine({0, 0}, {4, 0}), MakeLine({4, 0}, {4, 3}), MakeLine({4, 3}, {dx, dy})};
}

std::vector<WPoint> TrianglePoints(double w) {
  return {{0, 0, w}, {2, 0, w}, {4, 0, w}, {4, 1.5, w}, {4, 3, w}, {2, 1.5, w}, {0, 0, w}};
}

TEST(CloseExactly, LinesMeetInOnePoint) {
  std::vector<Piece> pieces = Triangle(0.01, 0.02);
  EXPECT_NEAR(GapOf(pieces), std::hypot(0.01, 0.02), 1e-17);
  ASSERT_TRUE(CloseExactly(TrianglePoints(0.05), &pieces));
  EXPECT_EQ(GapOf(pieces), 0.0);
  EXPECT_EQ(pieces[0].end.x, 4.0) << "the other joints stay";
  EXPECT_EQ(pieces[2].start.y, 3.0);
  EXPECT_EQ(pieces[2].length, std::hypot(pieces[2].end.x - 4.0, pieces[2].end.y - 3.0));
  EXPECT_LE(Remeasure(TrianglePoints(0.05), pieces).Worst().relative, 1.0);
}

TEST(CloseExactly, CrossingIsTakenWhereItFitsBest) {
  // Both lines are right but stop short of the corner.
  std::vector<Piece> pieces = {MakeLine({0.03, 0}, {4, 0}), MakeLine({4, 0}, {4, 3}),
                               MakeLine({4, 3}, {0.04, 0.03})};
  ASSERT_TRUE(CloseExactly(TrianglePoints(0.05), &pieces));
  EXPECT_NEAR(pieces[0].start.x, 0.0, 1e-15);
  EXPECT_NEAR(pieces[0].start.y, 0.0, 1e-15);
}

TEST(CloseExactly, GapStaysWhereNoCommonPointKeepsTheTolerance) {
  // The contour leaves at (0, 0) and comes back to (0, 1), a tolerance of 0.1 around both.
  std::vector<WPoint> const points = {{0, 0, 0.1}, {2, 0, 0.1}, {4, 0, 0.1},
                                      {4, 1, 0.1}, {2, 1, 0.1}, {0, 1, 0.1}};
  std::vector<Piece> pieces = {MakeLine({0, 0}, {4, 0}), MakeLine({4, 0}, {4, 1}),
                               MakeLine({4, 1}, {0, 1})};
  EXPECT_FALSE(CloseExactly(points, &pieces));
  EXPECT_EQ(GapOf(pieces), 1.0);
  EXPECT_EQ(pieces[2].end.y, 1.0);
}

/// Two lines that end 0.9 of a tolerance to the right and to the left of the seam, with points that
/// let neither turn.
TEST(CloseExactly, EndsBesideEachOtherAreJoinedByOnePieceMore) {
  double const w = 0.1;
  std::vector<WPoint> points;
  for (int i = -20; i <= 20; ++i) {
    double const side = i < 0 ? -0.18 : 0.18;
    points.push_back({1.0 * i, i % 2 == 0 ? 0.0 : side, w});
  }
  std::vector<Piece> pieces = {MakeLine({0, 0.09}, {20, 0.09}), MakeLine({20, 0.09}, {20, 9}),
                               MakeLine({20, 9}, {-20, 9}), MakeLine({-20, 9}, {-20, -0.09}),
                               MakeLine({-20, -0.09}, {0, -0.09})};
  // From the seam (0, 0) round to it again.
  std::vector<WPoint> circuit(points.begin() + 20, points.end());
  circuit.insert(circuit.end(), points.begin(), points.begin() + 21);
  ASSERT_TRUE(CloseExactly(circuit, &pieces));
  ASSERT_EQ(pieces.size(), 6u);
  EXPECT_EQ(GapOf(pieces), 0.0);
  EXPECT_GT(pieces.back().end.x, pieces.back().start.x) << "the line goes on, not back";
  EXPECT_EQ(pieces[4].end.x, pieces[5].start.x);
  EXPECT_EQ(pieces[4].end.y, pieces[5].start.y);
  EXPECT_LE(Remeasure(circuit, pieces).Worst().relative, kLargestRelative);
}

TEST(CloseExactly, ArcsKeepTheirMiddleAndStayCircles) {
  // A lens of two arcs through (0, 0) and (2, 0), whose second stops off the seam.
  auto const arc = [](XY const& from, XY const& to, double centerY) {
    double const radius = std::hypot(from.x - 1.0, from.y - centerY);
    return MakeArc(from, to, {1.0, centerY}, radius, true);
  };
  double const radius = std::hypot(1.0, 2.0);
  double const angle = std::atan2(2.0, -1.0) + 0.004;
  std::vector<Piece> pieces = {
      arc({0, 0}, {2, 0}, 2.0),
      arc({2, 0}, {1.0 + radius * std::cos(angle), -2.0 + radius * std::sin(angle)}, -2.0)};
  double const w = 0.01;
  std::vector<WPoint> points = {{0, 0, w}};
  for (Piece const& piece : pieces) {
    for (int i = 1; i <= 8; ++i) {
      XY const p = PointOnArc(piece, piece.sweep * i / 8.0);
      points.push_back({p.x, p.y, w});
    }
  }
  points.back() = points.front();
  ASSERT_GT(GapOf(pieces), 0.005);
  ASSERT_TRUE(CloseExactly(points, &pieces));
  EXPECT_EQ(GapOf(pieces), 0.0);
  for (Piece const& piece : pieces) ExpectConsistent(piece);
  EXPECT_LE(Remeasure(points, pieces).Worst().relative, 1.0);
}

TEST(CloseExactly, SmoothSeamIsClosedWithoutASpike) {
  // Two half circles of slightly different size meet tangentially, off by 0.004.
  std::vector<Piece> pieces = {MakeArc({1, 0}, {-1, 0}, {0, 0}, 1.0, true),
                               MakeArc({-1, 0}, {1.004, 0}, {0.002, 0}, 1.002, true)};
  std::vector<WPoint> points;
  for (int i = 0; i <= 40; ++i) {
    points.push_back({std::cos(i * pi / 20.0), std::sin(i * pi / 20.0), 0.01});
  }
  points.back() = points.front();
  ASSERT_TRUE(CloseExactly(points, &pieces));
  EXPECT_NEAR(pieces[0].start.x, 1.0, 0.01);
  EXPECT_NEAR(pieces[0].start.y, 0.0, 0.01);
  for (Piece const& piece : pieces) ExpectConsistent(piece);
  EXPECT_LE(Remeasure(points, pieces).Worst().relative, 1.0);
}

TEST(CloseExactly, PointsAlreadyOutsideMayNotGetWorse) {
  std::vector<WPoint> points = TrianglePoints(0.05);
  points[1].y = 0.2;
  std::vector<Piece> pieces = Triangle(0.01, 0.02);
  double const before = Remeasure(points, pieces).Worst().relative;
  ASSERT_TRUE(CloseExactly(points, &pieces));
  EXPECT_LE(Remeasure(points, pieces).Worst().relative, before);
}

TEST(CloseExactly, ContourOfOnePieceStaysOpen) {
  std::vector<Piece> pieces = {MakeLine({0, 0}, {4, 0})};
  EXPECT_FALSE(CloseExactly({{0, 0, 1}, {4, 0, 1}, {0, 0, 1}}, &pieces));
}

/// Points around a circle about (5, -3) of radius 2, from and to the seam, off by up to `noise`.
std::vector<WPoint> CirclePoints(int count, double turn, double noise, double w) {
  std::vector<WPoint> points;
  for (int i = 0; i <= count; ++i) {
    double const angle = 1.0 + turn * 2.0 * pi * i / count;
    double const radius = 2.0 + (i % 3 - 1) * noise;
    points.push_back({5.0 + radius * std::cos(angle), -3.0 + radius * std::sin(angle), w});
  }
  points.back() = points.front();
  return points;
}

TEST(FitFullCircle, GivesTwoHalvesInTheSenseOfThePoints) {
  for (double const turn : {1.0, -1.0}) {
    std::vector<WPoint> const points = CirclePoints(60, turn, 0.001, 0.002);
    auto const arcs = FitFullCircle(points);
    ASSERT_TRUE(arcs.has_value());
    ASSERT_EQ(arcs->size(), 2u);
    EXPECT_EQ(GapOf(*arcs), 0.0);
    for (Piece const& arc : *arcs) {
      ExpectConsistent(arc);
      EXPECT_NEAR(arc.sweep, pi, 1e-12);
      EXPECT_EQ(arc.counterClockwise, turn > 0.0);
      EXPECT_NEAR(arc.center.x, 5.0, 1e-4);
      EXPECT_NEAR(arc.center.y, -3.0, 1e-4);
      EXPECT_NEAR(arc.radius, 2.0, 1e-4);
    }
    EXPECT_LE(Remeasure(points, *arcs).Worst().relative, 1.0);
  }
}

TEST(FitFullCircle, RefusesWhatIsNotOneCircle) {
  EXPECT_FALSE(FitFullCircle(CirclePoints(60, 1.0, 0.01, 0.002))) << "outside tolerance";
  EXPECT_FALSE(FitFullCircle(CirclePoints(60, 2.0, 0.0, 0.002))) << "twice around";
  EXPECT_FALSE(FitFullCircle(CirclePoints(8, 1.0, 0.0, 0.002))) << "an octagon";
  EXPECT_TRUE(FitFullCircle(CirclePoints(13, 1.0, 0.0, 0.002)));
  EXPECT_FALSE(FitFullCircle(TrianglePoints(0.05)));
}

TEST(FullCircleOf, TakesTheCircleOfTheWidestArc) {
  std::vector<WPoint> const points = CirclePoints(60, 1.0, 0.001, 0.002);
  XY const start = {points.front().x, points.front().y};
  XY const end = {points[50].x, points[50].y};
  Piece const wide = MakeArc(start, end, {5.0, -3.0}, 2.0005, true);
  auto const arcs = FullCircleOf({wide, MakeLine(end, start)}, points);
  ASSERT_TRUE(arcs.has_value());
  EXPECT_EQ(arcs->front().radius, 2.0005);
  EXPECT_FALSE(FullCircleOf({MakeLine(end, start)}, points));
  Piece const small = MakeArc(start, end, {5.0, -3.0}, 2.0005, false);
  EXPECT_FALSE(FullCircleOf({small, MakeLine(end, start)}, points));
}

}  // namespace
}  // namespace Vorn::IO
