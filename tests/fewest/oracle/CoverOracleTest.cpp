#include <algorithm>
#include <boost/multiprecision/cpp_int.hpp>
#include <cmath>
#include <cstdint>
#include <vector>

#include "fewest/oracle/CoverOracle.h"
#include "gtest/gtest.h"
#include "support/RandomGeometry.h"

// The oracle itself: its covers are measured by plain distances, and where it finds none neither do
// many descents from random circles.

namespace Vorn::Testing {
namespace {

using Exact = boost::multiprecision::cpp_rational;

bool IsExactlyCoverable(std::vector<WPoint> const& points, Exact const& factor) {
  return IsCoverableIn<Exact>(points, factor);
}

/// Points about an arc or a line, at distances of about their tolerances.
std::vector<WPoint> RandomSet(RandomGeometry* random) {
  std::vector<WPoint> points;
  double const radius = std::exp2(random->Uniform(0.0, 8.0));
  double const sweep = random->Uniform(0.2, 5.0) * std::fmin(1.0, 4.0 / radius);
  double const w = radius * sweep * std::exp2(random->Uniform(-10.0, -3.0));
  double const reach = random->Uniform(0.8, 2.5);
  std::int32_t const count = random->Integer(4, 9);
  for (std::int32_t i = 0; i < count; ++i) {
    double const angle = sweep * (i + random->Uniform(-0.3, 0.3)) / count;
    double const own = w * random->Uniform(0.5, 1.5);
    double const r = radius + reach * own * random->Uniform(-1.0, 1.0);
    points.push_back({r * std::cos(angle), r * std::sin(angle), own});
  }
  return points;
}

/// Largest relative distance from the circle or line of four coefficients, through the centre.
long double LargestRatio(std::vector<WPoint> const& points,
                         std::array<long double, 4> const& circle) {
  auto const [a, bx, by, d] = circle;
  long double const form = std::sqrt(bx * bx + by * by - 4 * a * d);
  long double largest = 0.0L;
  for (WPoint const& p : points) {
    long double const x = static_cast<long double>(p.x) - points.front().x;
    long double const y = static_cast<long double>(p.y) - points.front().y;
    long double const f = (a * (x * x + y * y) + bx * x + by * y + d) / form;
    long double const root = 1 + 4 * (a / form) * f;
    long double const e = root < 0 ? form / (2 * a) : 2 * f / (1 + std::sqrt(root));
    largest = std::max(largest, std::fabs(e) / p.w);
  }
  return largest;
}

TEST(CoverOracle, ItsCoversAreWithinTolerance) {
  RandomGeometry random(5101);
  int covered = 0;
  for (int round = 0; round < 5000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 5101, round " << round);
    auto const points = RandomSet(&random);
    auto const cover = CoverOracle<long double>(points, 1.0L).FindCover();
    if (!cover) continue;
    ++covered;
    EXPECT_LE(LargestRatio(points, *cover), 1.0L + 1e-9L);
  }
  EXPECT_GT(covered, 1000);
  EXPECT_LT(covered, 4500);
}

TEST(CoverOracle, NoDescentFindsACoverWhereItFindsNone) {
  RandomGeometry random(5102);
  int tried = 0;
  for (int round = 0; round < 600; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 5102, round " << round);
    auto const points = RandomSet(&random);
    if (IsCoverable(points)) continue;
    ++tried;
    // Circles through three of the points, each moved by up to its tolerance.
    for (int trial = 0; trial < 2000; ++trial) {
      std::array<long double, 4> circle{};
      std::array<std::array<long double, 3>, 3> rows{};
      for (int k = 0; k < 3; ++k) {
        auto const& p = points[static_cast<std::size_t>(
            random.Integer(0, static_cast<std::int32_t>(points.size()) - 1))];
        long double const x = p.x - points.front().x + p.w * random.Uniform(-1.0, 1.0);
        long double const y = p.y - points.front().y + p.w * random.Uniform(-1.0, 1.0);
        rows[static_cast<std::size_t>(k)] = {x * x + y * y, x, y};
      }
      auto const det = [&](int i, int j) {
        auto const minor = [&](int r, int s) {
          auto const& m = rows[static_cast<std::size_t>(r)];
          auto const& n = rows[static_cast<std::size_t>(s)];
          return m[static_cast<std::size_t>(i)] * n[static_cast<std::size_t>(j)] -
                 m[static_cast<std::size_t>(j)] * n[static_cast<std::size_t>(i)];
        };
        return minor(0, 1) + minor(1, 2) + minor(2, 0);
      };
      circle[0] = det(1, 2);
      circle[1] = -det(0, 2);
      circle[2] = det(0, 1);
      circle[3] = -(circle[0] * rows[0][0] + circle[1] * rows[0][1] + circle[2] * rows[0][2]);
      if (!(circle[1] * circle[1] + circle[2] * circle[2] > 4 * circle[0] * circle[3])) continue;
      EXPECT_GT(LargestRatio(points, circle), 1.0L);
    }
  }
  EXPECT_GT(tried, 100);
}

TEST(CoverOracle, IsExactAtItsBorder) {
  // Points in turn 1 above and 1 below a line are covered at w = 1 and not below it. Parabolas have
  // no third difference, and that of 1, -1, 1, -1 is 8 times what the weights 1, 3, 3, 1 allow.
  std::vector<WPoint> const points{{0, 1, 1}, {4, -1, 1}, {8, 1, 1}, {12, -1, 1}, {16, 1, 1}};
  EXPECT_TRUE(IsExactlyCoverable(points, 1));
  EXPECT_FALSE(IsExactlyCoverable(points, Exact(1) - Exact(1, 1000000000000LL)));
}

TEST(CoverOracle, PointsOnOneCircleOrLineAreCovered) {
  EXPECT_TRUE(IsExactlyCoverable({{3, -2, 1}, {3, 0, 1}, {3, 2, 1}, {3, -3, 1}}, 1));
  EXPECT_TRUE(IsExactlyCoverable({{5, 0, 1}, {3, 4, 1}, {0, 5, 1}, {-4, 3, 1}, {4, -3, 1}}, 1));
  EXPECT_TRUE(IsExactlyCoverable({{0, 0, 1}, {0, 0, 1}, {9, 1, 1}, {9, 1, 1}, {4, 4, 1}}, 1));
  EXPECT_FALSE(IsExactlyCoverable({{0, 0, 1}, {9, 0, 1}, {18, 0, 1}, {9, 9, 1}, {18, 9, 1}}, 1));
}

TEST(CoverOracle, ExtendedPrecisionAgreesWithExactNumbers) {
  RandomGeometry random(5103);
  for (int round = 0; round < 60; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 5103, round " << round);
    auto points = RandomSet(&random);
    if (points.size() > 6) points.resize(6);
    EXPECT_EQ(IsCoverable(points), IsExactlyCoverable(points, 1));
  }
}

}  // namespace
}  // namespace Vorn::Testing
