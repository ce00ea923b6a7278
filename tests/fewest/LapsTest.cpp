#include <algorithm>
#include <cmath>
#include <cstddef>
#include <numbers>

#include "geometry/fewest/Assembly.h"
#include "geometry/fewest/Laps.h"
#include "gtest/gtest.h"

namespace Vorn::Fewest {
namespace {

constexpr double kRadius = 5.0;
constexpr double kTolerance = 0.1;

/// The circle in the middle of the tolerances is found up to a term of second order.
constexpr double kSecondOrder = 1.1 * kTolerance * kTolerance / (2.0 * kRadius);

/// Points on a circle about (2, 1), counter-clockwise.
Path CirclePath(double turns, std::int32_t count) {
  Path path;
  for (std::int32_t i = 0; i < count; ++i) {
    double const angle = 2.0 * std::numbers::pi * turns * i / (count - 1);
    path.points.push_back(
        {2.0 + kRadius * std::cos(angle), 1.0 + kRadius * std::sin(angle), kTolerance});
  }
  path.leastTolerance = kTolerance;
  return path;
}

/// The circle of the points about its middle.
PlacedCircle const kCovering{{0.5 / kRadius, 0.0, 0.0, -0.5 * kRadius}, {2.0, 1.0}};

TEST(WindLaps, LessThanATurnIsEmpty) {
  EXPECT_TRUE(WindLaps(CirclePath(0.9, 100), kCovering, false).chain.pieces.empty());
  PlacedCircle const line{{0.0, 0.0, 1.0, 0.0}, {}};
  EXPECT_TRUE(WindLaps(CirclePath(2.0, 100), line, false).chain.pieces.empty());
}

TEST(WindLaps, AnArcWithoutPointsIsNone) {
  // Three points are two thirds of a turn apart from one another twice.
  EXPECT_TRUE(WindLaps(CirclePath(40.0, 3), kCovering, false).chain.pieces.empty());
}

TEST(WindLaps, OpenLapsWindOutwardsByEqualSteps) {
  Path const path = CirclePath(2.5, 1001);
  Laps const laps = WindLaps(path, kCovering, false);
  ASSERT_EQ(laps.chain.pieces.size(), 3U);
  EXPECT_TRUE(laps.start.isFree);
  EXPECT_TRUE(laps.finish.isFree);
  std::int32_t next = 0;
  for (ChainPiece const& piece : laps.chain.pieces) {
    EXPECT_EQ(piece.first, next);
    next = piece.end;
  }
  EXPECT_EQ(next, 1001);
  auto const distanceOf = [&](std::size_t k) {
    Gate const& gate = laps.chain.gates[k];
    return std::hypot(gate.origin.x - 2.0, gate.origin.y - 1.0);
  };
  double const gain = distanceOf(1) - distanceOf(0);
  EXPECT_GT(gain, 1e-4);
  EXPECT_LT(gain, kTolerance / 32.0);
  EXPECT_NEAR(distanceOf(0) + distanceOf(1), 2.0 * kRadius, 2.0 * kSecondOrder);
  for (std::size_t k = 0; k < 3; ++k) {
    ChainPiece const& piece = laps.chain.pieces[k];
    // Counter-clockwise paths have their middle on the left, where f grows.
    EXPECT_LT(piece.circle.about.a, 0.0);
    // Joints lie on both of their circles but for terms of second order.
    for (std::size_t joint = std::max<std::size_t>(k, 1) - 1;
         joint < std::min<std::size_t>(k + 1, 2); ++joint) {
      EXPECT_NEAR(ValueAt(piece.circle, laps.chain.gates[joint].origin), 0.0, 1e-2 * gain);
    }
  }
}

TEST(WindLaps, ClosedLapsLieOnOneCircleAndEndWhereTheyBegin) {
  Path path = CirclePath(2.0, 401);
  path.points.pop_back();
  Laps const laps = WindLaps(path, kCovering, true);
  ASSERT_EQ(laps.chain.pieces.size(), 3U);
  path.start = laps.start;
  path.finish = laps.finish;
  auto const pieces = BuildPieces(path, laps.chain);
  EXPECT_EQ(pieces.front().start.x, pieces.back().elem.end.x);
  EXPECT_EQ(pieces.front().start.y, pieces.back().elem.end.y);
  for (BuiltPiece const& piece : pieces) {
    EXPECT_NEAR(piece.elem.radius, kRadius, kSecondOrder);
    EXPECT_NEAR(piece.elem.center.x, 2.0, 1e-9);
    EXPECT_NEAR(piece.elem.center.y, 1.0, 1e-9);
  }
}

}  // namespace
}  // namespace Vorn::Fewest
