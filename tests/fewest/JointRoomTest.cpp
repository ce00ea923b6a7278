#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numbers>
#include <vector>

#include "geometry/fewest/JointRoom.h"
#include "vorn/GeometryUtils.h"

// Paths of a few points; the gap looked at is that before point 3, between the third and the
// fourth.

namespace Vorn::Fewest {
namespace {

constexpr double kTolerance = 0.01;

/// What an arc of 60 degrees bulges, in chords: tan(15 degrees) / 2.
constexpr double kBulge = 0.13397459621556135;

constexpr double kNoLimit = std::numeric_limits<double>::infinity();

Path PathThrough(std::vector<GeometryUtils::Point> const& points) {
  Path path;
  for (auto const& p : points) path.points.push_back({p.x, p.y, kTolerance});
  path.leastTolerance = kTolerance;
  return path;
}

WPoint PointAt(double x, double y) { return {x, y, kTolerance}; }

void ExpectRoom(Path const& path, double left, double right) {
  JointRoom const room = RoomForJoint(path, 3);
  EXPECT_NEAR(room.left, left, 1e-12);
  EXPECT_NEAR(room.right, right, 1e-12);
}

/// The bulge over a gap, and the noise of its points.
double PlainRoom(double gap) { return kBulge * gap + 2.0 * kTolerance; }

TEST(RoomForJoint, OfAStraightPathIsTheBulgeOfAnArc) {
  Path const path = PathThrough({{-10, 0}, {0, 0}, {10, 0}, {20, 0}, {30, 0}, {40, 0}});
  ExpectRoom(path, PlainRoom(10.0), PlainRoom(10.0));
}

// Lines along x and y that meet at (20, 0), right of the way from (10, 0) to (20, 10).
std::vector<GeometryUtils::Point> const kCorner{{-10, 0}, {0, 0},   {10, 0},
                                                {20, 10}, {20, 20}, {20, 30}};

TEST(RoomForJoint, ReachesToTheCornerOfTheLinesBesideIt) {
  double const room = PlainRoom(10.0 * std::sqrt(2.0));
  double const corner = 5.0 * std::sqrt(2.0);
  ExpectRoom(PathThrough(kCorner), room, corner + room);
  std::vector<GeometryUtils::Point> mirrored = kCorner;
  for (auto& p : mirrored) p.y = -p.y;
  ExpectRoom(PathThrough(mirrored), corner + room, room);
}

TEST(RoomForJoint, HasNoCornerWhereTheLinesMeetElsewhere) {
  double const room = PlainRoom(10.0);
  // The ends of a slot; of one that widens; a step.
  ExpectRoom(PathThrough({{-10, 0}, {0, 0}, {10, 0}, {10, 10}, {0, 10}, {-10, 10}}), room, room);
  ExpectRoom(PathThrough({{-10, 3}, {0, 1.5}, {10, 0}, {10, 10}, {0, 8.5}, {-10, 7}}), room, room);
  ExpectRoom(PathThrough({{-10, 0}, {0, 0}, {10, 0}, {10, 10}, {20, 10}, {30, 10}}), room, room);
}

TEST(RoomForJoint, HasNoCornerThatTurnsByMoreThan150Degrees) {
  double const room = PlainRoom(2.0);
  // Symmetric about x = 0: the lines meet at a depth of the tangent of their slope, 74.5 and 75.5
  // degrees, and turn by twice that.
  double const flat = std::tan(74.5 / 180.0 * std::numbers::pi);
  double const steep = std::tan(75.5 / 180.0 * std::numbers::pi);
  auto const bowl = [](double slope) {
    return PathThrough({{-3, 2 * slope}, {-2, slope}, {-1, 0}, {1, 0}, {2, slope}, {3, 2 * slope}});
  };
  ExpectRoom(bowl(flat), room, flat + room);
  ExpectRoom(bowl(-flat), flat + room, room);
  ExpectRoom(bowl(steep), room, room);
}

TEST(RoomForJoint, HasNoCornerBesideSidesOfTwoPoints) {
  double const room = PlainRoom(10.0 * std::sqrt(2.0));
  // The path turns by 29 and by 31 degrees at the far end of one side.
  auto const turned = [](double degrees) {
    double const angle = degrees / 180.0 * std::numbers::pi;
    std::vector<GeometryUtils::Point> points = kCorner;
    points[0] = {-10.0 * std::cos(angle), 10.0 * std::sin(angle)};
    return PathThrough(points);
  };
  EXPECT_NEAR(RoomForJoint(turned(29.0), 3).right, 5.0 * std::sqrt(2.0) + room, 1e-12);
  EXPECT_NEAR(RoomForJoint(turned(31.0), 3).right, room, 1e-12);
  EXPECT_NEAR(RoomForJoint(turned(-31.0), 3).right, room, 1e-12);
}

TEST(RoomForJoint, LooksPastPointsThatLieClose) {
  std::vector<GeometryUtils::Point> points = kCorner;
  points.insert(points.begin() + 4, {20, 10.001});
  points.insert(points.begin() + 2, {10.0, 0.005});
  Path const path = PathThrough(points);
  EXPECT_NEAR(RoomForJoint(path, 4).right, 5.0 * std::sqrt(2.0) + PlainRoom(10.0 * std::sqrt(2.0)),
              1e-12);
}

TEST(RoomForJoint, KnowsTheNextPointsBeyondTheEndsOfAPath) {
  double const room = PlainRoom(10.0 * std::sqrt(2.0));
  double const corner = 5.0 * std::sqrt(2.0);
  Path path = PathThrough({{10, 0}, {20, 10}});
  EXPECT_NEAR(RoomForJoint(path, 1).right, room, 1e-12) << "the path ends on both sides";
  path.before.Add(PointAt(0, 0));
  path.before.Add(PointAt(-10, 0));
  EXPECT_NEAR(RoomForJoint(path, 1).right, room, 1e-12) << "it ends on one side";
  path.behind.Add(PointAt(20, 20));
  EXPECT_NEAR(RoomForJoint(path, 1).right, room, 1e-12) << "a side of two points";
  path.behind.Add(PointAt(20, 30));
  EXPECT_NEAR(RoomForJoint(path, 1).right, corner + room, 1e-12);
}

TEST(RoomForJoint, IsUnlimitedWhereTolerancesLeaveDirectionsOpen) {
  // 0.16 is the sum of the tolerances eight times.
  auto const gapOf = [](double width) {
    return PathThrough({{-1, 0}, {0, 0}, {1, 0}, {1 + width, 0}, {3, 0}, {4, 0}});
  };
  EXPECT_EQ(RoomForJoint(gapOf(0.159), 3).left, kNoLimit);
  EXPECT_LT(RoomForJoint(gapOf(0.161), 3).left, kNoLimit);
  // A hundred points at one place say nothing of the direction there.
  Path path = PathThrough({{0, 0}});
  for (int k = 0; k < 100; ++k) path.points.push_back(PointAt(10, 0));
  for (double const y : {10.0, 20.0, 30.0}) path.points.push_back(PointAt(20, y));
  EXPECT_EQ(RoomForJoint(path, 101).left, kNoLimit);
}

TEST(RoomForJoint, GrowsWithTheGreatestStep) {
  Path path = PathThrough({{-10, 0}, {0, 0}, {10, 0}, {20, 0}, {30, 0}, {40, 0}});
  path.limits.sineOfHalfStep = 1.0;  // half a turn: the bulge is a radius
  ExpectRoom(path, 5.0 + 2.0 * kTolerance, 5.0 + 2.0 * kTolerance);
}

TEST(RoomForJoint, IsNoLargerThanPiecesMayLeaveThePath) {
  Path path = PathThrough(kCorner);
  path.limits.farthestBetweenPoints = 0.5;
  ExpectRoom(path, 0.5 + kTolerance, 0.5 + kTolerance);
  Path dense = PathThrough({{-0.1, 0}, {0, 0}, {0.1, 0}, {0.2, 0}, {0.3, 0}});
  dense.limits.farthestBetweenPoints = 0.5;
  ExpectRoom(dense, 0.5 + kTolerance, 0.5 + kTolerance);
}

}  // namespace
}  // namespace Vorn::Fewest
