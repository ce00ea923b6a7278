#include <algorithm>
#include <cmath>
#include <cstdint>
#include <vector>

#include "geometry/fewest/Backsteps.h"
#include "gtest/gtest.h"
#include "support/RandomGeometry.h"

namespace Vorn::Fewest {
namespace {

constexpr LocalFrame kFrame{0.0, 0.0, 1.0};

/// The line along x, and the circle of this radius about (0, radius), which leaves the origin along
/// x and turns to the left.
constexpr Circle kAlongX{0.0, 0.0, 1.0, 0.0};
Circle TurningLeft(double radius) { return {-0.5 / radius, 0.0, 1.0, 0.0}; }

/// The farthest that a point lies back behind an earlier one along a circle, by looking at all.
double FarthestBack(std::vector<WPoint> const& points, double radius, std::int32_t first,
                    std::int32_t end) {
  double farthest = -1e300;
  double back = 0.0;
  for (std::int32_t i = first; i < end; ++i) {
    WPoint const& p = points[static_cast<std::size_t>(i)];
    double const along = std::isfinite(radius) ? radius * std::atan2(p.x, radius - p.y) : p.x;
    farthest = std::max(farthest, along);
    back = std::max(back, farthest - along);
  }
  return back;
}

/// Points in short steps along a circle with noise, which turn back now and then.
Path MakePath(Testing::RandomGeometry* random, double radius, double turningBack) {
  Path path;
  double along = 0.0;
  double sense = 1.0;
  for (int i = 0; i < 2000; ++i) {
    if (random->Uniform(0.0, 1.0) < turningBack) sense = -sense;
    along += 0.01 * sense;
    double const aside = random->Uniform(-0.02, 0.02);
    double const noisy = along + random->Uniform(-0.02, 0.02);
    if (std::isfinite(radius)) {
      double const angle = noisy / radius;
      path.points.push_back(
          {(radius - aside) * std::sin(angle), radius - (radius - aside) * std::cos(angle), 0.04});
    } else {
      path.points.push_back({noisy, aside, 0.04});
    }
  }
  return path;
}

TEST(Backsteps, OfStraightRunsAreThoseOfTheirPoints) {
  Testing::RandomGeometry random(7001);
  double const radius = INFINITY;
  Path const path = MakePath(&random, radius, 0.01);
  Backsteps backsteps(path);
  for (int round = 0; round < 2000; ++round) {
    std::int32_t const first = random.Integer(0, 1900);
    std::int32_t const end = random.Integer(first + 1, 2000);
    SCOPED_TRACE(testing::Message() << first << " to " << end);
    double const back = FarthestBack(path.points, radius, first, end);
    EXPECT_FALSE(backsteps.AreWithin(back - 1e-9, kAlongX, kFrame, first, end));
    EXPECT_TRUE(backsteps.AreWithin(back + 1e-9, kAlongX, kFrame, first, end));
  }
}

TEST(Backsteps, OfArcsAreNeverMissedAndNoiseIsTold) {
  Testing::RandomGeometry random(7002);
  for (double const radius : {10.0, 40.0}) {
    for (double const turningBack : {0.0, 0.005}) {
      Path const path = MakePath(&random, radius, turningBack);
      Backsteps backsteps(path);
      for (int round = 0; round < 500; ++round) {
        std::int32_t const first = random.Integer(0, 1500);
        std::int32_t const end = random.Integer(first + 300, 2000);
        SCOPED_TRACE(testing::Message() << "radius " << radius << ", " << first << " to " << end);
        double const back = FarthestBack(path.points, radius, first, end);
        double const most = 3.3 * 0.04;
        bool const isSure = backsteps.AreWithin(most, TurningLeft(radius), kFrame, first, end);
        // Directions are those of the middles of blocks, which counts for a hundredth.
        if (back > 1.01 * most) {
          EXPECT_FALSE(isSure);
        }
        if (turningBack == 0.0) {
          EXPECT_TRUE(isSure);
        }
      }
    }
  }
}

TEST(Backsteps, OfATightCircleAreLeftOpen) {
  Testing::RandomGeometry random(7003);
  Path const path = MakePath(&random, 1.0, 0.0);
  EXPECT_FALSE(Backsteps(path).AreWithin(1e9, TurningLeft(1.0), kFrame, 0, 2000));
}

TEST(Backsteps, FollowADirectionThatTurns) {
  Testing::RandomGeometry random(7004);
  Path const path = MakePath(&random, INFINITY, 0.0);
  Backsteps backsteps(path);
  EXPECT_TRUE(backsteps.AreWithin(0.132, kAlongX, kFrame, 0, 2000));
  // Seen the other way round the whole path runs back.
  EXPECT_FALSE(backsteps.AreWithin(0.132, {0.0, 0.0, -1.0, 0.0}, kFrame, 0, 2000));
  EXPECT_TRUE(backsteps.AreWithin(0.132, {0.0, -0.6, 0.8, 0.0}, kFrame, 0, 2000));
}

}  // namespace
}  // namespace Vorn::Fewest
