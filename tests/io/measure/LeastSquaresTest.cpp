#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numbers>
#include <random>

#include "vorn/io/LeastSquares.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;

double Uniform(std::mt19937_64* engine, double low, double high) {
  return low + (high - low) * static_cast<double>((*engine)() >> 11) * 0x1p-53;
}

/// Twelve uniform numbers make a normal one, near enough.
double Normal(std::mt19937_64* engine, double deviation) {
  double sum = -6.0;
  for (int i = 0; i < 12; ++i) sum += Uniform(engine, 0.0, 1.0);
  return deviation * sum;
}

struct ArcShape {
  XY center;
  double radius = 1.0;
  double from = 0.0;
  double sweep = 1.0;
};

std::vector<XY> PointsOn(ArcShape const& arc, int count, double noise = 0.0,
                         std::uint64_t seed = 1) {
  std::mt19937_64 engine(seed);
  std::vector<XY> points;
  for (int i = 0; i < count; ++i) {
    double const angle = arc.from + arc.sweep * i / (count - 1);
    double const radius = arc.radius + Normal(&engine, noise);
    points.push_back(
        {arc.center.x + radius * std::cos(angle), arc.center.y + radius * std::sin(angle)});
  }
  return points;
}

TEST(FitCircle, IsThePublishedOneOfSixPoints) {
  // W. Gander, G. H. Golub, R. Strebel, "Least-squares fitting of circles and ellipses", 1994.
  auto const circle = FitCircle({{1, 7}, {2, 6}, {5, 8}, {7, 7}, {9, 5}, {3, 7}});
  ASSERT_TRUE(circle);
  EXPECT_NEAR(circle->center.x, 4.7398, 5e-5);
  EXPECT_NEAR(circle->center.y, 2.9835, 5e-5);
  EXPECT_NEAR(circle->radius, 4.7142, 5e-5);
}

TEST(FitCircle, OfAnExactCircleHasNoScatter) {
  auto const circle = FitCircle({{8, 2}, {3, 7}, {-2, 2}, {3, -3}});
  ASSERT_TRUE(circle);
  EXPECT_NEAR(circle->center.x, 3.0, 1e-14);
  EXPECT_NEAR(circle->center.y, 2.0, 1e-14);
  EXPECT_NEAR(circle->radius, 5.0, 1e-14);
  EXPECT_NEAR(circle->scatter.formError, 0.0, 1e-14);
  EXPECT_NEAR(circle->scatter.standardDeviation.value(), 0.0, 1e-14);
}

TEST(FitCircle, OfPointsByTurnsInsideAndOutsideIsTheOneBetween) {
  // Opposite points at 4 and at 6 about (1, 1): by symmetry the mean radius.
  auto const circle = FitCircle({{5, 1}, {1, 7}, {-3, 1}, {1, -5}});
  ASSERT_TRUE(circle);
  EXPECT_NEAR(circle->center.x, 1.0, 1e-12);
  EXPECT_NEAR(circle->center.y, 1.0, 1e-12);
  EXPECT_NEAR(circle->radius, 5.0, 1e-12);
  EXPECT_NEAR(circle->scatter.formError, 2.0, 1e-12);
  // Four squares of 1 over four points less three parameters.
  EXPECT_NEAR(circle->scatter.standardDeviation.value(), 2.0, 1e-12);
}

TEST(FitCircle, ThroughThreePointsHasNoStandardDeviation) {
  auto const circle = FitCircle({{1, 0}, {0, 1}, {-1, 0}});
  ASSERT_TRUE(circle);
  EXPECT_NEAR(circle->radius, 1.0, 1e-15);
  EXPECT_FALSE(circle->scatter.standardDeviation);
  EXPECT_FALSE(circle->radiusDeviation);
}

TEST(FitCircle, FindsArcsFromFlatToWholeNearAndFarFromTheOrigin) {
  for (double const sweep : {1e-4, 1e-3, 1e-2, 0.1, 1.0, 3.0, 2.0 * pi * 99 / 100}) {
    for (double const offset : {0.0, 1e3, 1e6}) {
      ArcShape const arc = {{offset + 1.0, -offset}, 300.0, 0.3, sweep};
      auto const circle = FitCircle(PointsOn(arc, 100));
      ASSERT_TRUE(circle) << sweep << " at " << offset;
      // The points are rounded to their last places, which the height of a flat arc magnifies.
      double const rounding = 2.3e-16 * (offset + 300.0);
      double const height = 300.0 * (1.0 - std::cos(0.5 * std::min(sweep, pi)));
      EXPECT_NEAR(circle->radius, 300.0, 300.0 * 4.0 * rounding / height)
          << sweep << " at " << offset;
    }
  }
}

/// How much the sum of squares about (a, b) with radius r grows to first order, over the largest
/// that it could: plain formulas, more digits.
long double SlopeAt(LeastSquaresCircle const& circle, std::vector<XY> const& points) {
  long double slopes[3] = {};
  long double total = 0.0L;
  for (XY const& at : points) {
    long double const dx = static_cast<long double>(at.x) - circle.center.x;
    long double const dy = static_cast<long double>(at.y) - circle.center.y;
    long double const reach = hypotl(dx, dy);
    long double const distance = reach - circle.radius;
    slopes[0] += distance * dx / reach;
    slopes[1] += distance * dy / reach;
    slopes[2] += distance;
    total += fabsl(distance);
  }
  return std::max({fabsl(slopes[0]), fabsl(slopes[1]), fabsl(slopes[2])}) / total;
}

TEST(FitCircle, IsWhereTheSumOfSquaresIsLevel) {
  std::mt19937_64 engine(20);
  for (int i = 0; i < 300; ++i) {
    ArcShape const arc = {{Uniform(&engine, -50, 50), Uniform(&engine, -50, 50)},
                          std::pow(10.0, Uniform(&engine, -2, 3)),
                          Uniform(&engine, 0, 6),
                          Uniform(&engine, 0.4, 6.2)};
    auto const seed = engine();
    double const noise = arc.radius * std::pow(10.0, Uniform(&engine, -5, -2));
    std::vector<XY> const points = PointsOn(arc, 40, noise, seed);
    auto const circle = FitCircle(points);
    ASSERT_TRUE(circle) << i;
    // A centre is rounded to its last place, which shifts every distance by as much.
    double const rounding = 2.3e-16 * (50.0 + arc.radius) / noise;
    EXPECT_LT(SlopeAt(*circle, points), 1e-8L + 4.0L * rounding) << "number " << i << ", seed 20";
  }
}

TEST(FitCircle, HasNoBiasWhereAnAlgebraicFitHasOne) {
  // An arc of 10 degrees with a height of 0.38 and a noise of 0.01: the mean of many radii is
  // within three of its own standard deviations of the true one, but for the bias of order noise
  // squared.
  double sum = 0.0;
  double squares = 0.0;
  double reported = 0.0;
  constexpr int kTimes = 400;
  for (int i = 0; i < kTimes; ++i) {
    auto const circle = FitCircle(
        PointsOn({{0, 0}, 100.0, 0.0, pi / 18}, 200, 0.01, 100 + static_cast<unsigned>(i)));
    ASSERT_TRUE(circle);
    sum += circle->radius - 100.0;
    squares += std::pow(circle->radius - 100.0, 2);
    reported += circle->radiusDeviation.value();
  }
  double const deviation = std::sqrt(squares / kTimes);
  EXPECT_LT(std::fabs(sum / kTimes), 3.0 * deviation / std::sqrt(kTimes));
  EXPECT_NEAR(reported / kTimes, deviation, 0.15 * deviation)
      << "the standard deviation told is the one found";
}

TEST(FitCircle, MovedTurnedAndScaledPointsGiveTheSameCircleMovedTurnedAndScaled) {
  std::vector<XY> const points = PointsOn({{3, -2}, 7.0, 0.4, 1.5}, 50, 0.02, 7);
  auto const circle = FitCircle(points);
  ASSERT_TRUE(circle);
  std::vector<XY> turned;
  for (XY const& at : points) turned.push_back({1024.0 - 4.0 * at.y, 4.0 * at.x});
  auto const other = FitCircle(turned);
  ASSERT_TRUE(other);
  EXPECT_NEAR(other->radius, 4.0 * circle->radius, 1e-9);
  EXPECT_NEAR(other->center.x, 1024.0 - 4.0 * circle->center.y, 1e-9);
  EXPECT_NEAR(other->center.y, 4.0 * circle->center.x, 1e-9);
  EXPECT_NEAR(other->scatter.formError, 4.0 * circle->scatter.formError, 1e-9);
  EXPECT_NEAR(*other->scatter.standardDeviation, 4.0 * *circle->scatter.standardDeviation, 1e-9);
}

TEST(FitCircle, KeepsItsDigitsForTinyAndHugeCoordinates) {
  for (double const scale : {1e-150, 1e150, 1e-300, 1e300}) {
    std::vector<XY> points;
    for (XY const& at : PointsOn({{1, 2}, 5.0, 0.0, 2.0}, 30)) {
      points.push_back({scale * at.x, scale * at.y});
    }
    auto const circle = FitCircle(points);
    ASSERT_TRUE(circle) << scale;
    EXPECT_NEAR(circle->radius / scale, 5.0, 1e-12) << scale;
  }
}

TEST(FitCircle, HasNothingToSayAboutPointsWithoutOne) {
  double const nan = std::nan("");
  double const inf = std::numeric_limits<double>::infinity();
  EXPECT_FALSE(FitCircle({}));
  EXPECT_FALSE(FitCircle({{1, 1}}));
  EXPECT_FALSE(FitCircle({{1, 1}, {2, 2}}));
  EXPECT_FALSE(FitCircle({{1, 1}, {2, 2}, {1, 1}, {2, 2}})) << "two places";
  EXPECT_FALSE(FitCircle({{1, 1}, {1, 1}, {1, 1}}));
  EXPECT_FALSE(FitCircle({{0, 0}, {1, 0}, {2, 0}, {3, 0}})) << "a straight line";
  EXPECT_FALSE(FitCircle({{0, 0}, {1, 3}, {2, 6}, {3, 9}}));
  EXPECT_FALSE(FitCircle({{0, 0}, {1, 1}, {nan, 0}}));
  EXPECT_FALSE(FitCircle({{0, 0}, {1, 1}, {inf, 0}}));
  EXPECT_FALSE(FitCircle({{-1.7e308, 0}, {1, 1.7e308}, {1.7e308, 0}})) << "further apart than that";
}

TEST(FitCircle, BearsAPointAtTheCentre) {
  std::vector<XY> points = PointsOn({{0, 0}, 1.0, 0.0, 2.0 * pi * 99 / 100}, 100);
  points.push_back({0, 0});
  auto const circle = FitCircle(points);
  ASSERT_TRUE(circle);
  auto const squares = [&](XY const& center, double radius) {
    double sum = 0.0;
    for (XY const& at : points) sum += std::pow(Distance(at, center) - radius, 2);
    return sum;
  };
  EXPECT_LE(squares(circle->center, circle->radius), squares({0, 0}, 1.0 - 1.0 / 101.0))
      << "no worse than the mean distance about the middle";
}

TEST(FitLine, OfFourPointsByHand) {
  // Two points 1 above and two 1 below y = x, alike at both ends.
  double const side = std::sqrt(0.5);
  auto const line =
      FitLine({{-side, side}, {side, -side}, {10 - side, 10 + side}, {10 + side, 10 - side}});
  ASSERT_TRUE(line);
  EXPECT_NEAR(line->at.x, 5.0, 1e-14);
  EXPECT_NEAR(line->at.y, 5.0, 1e-14);
  EXPECT_NEAR(line->direction, 0.25 * pi, 1e-15);
  EXPECT_NEAR(line->scatter.formError, 2.0, 1e-14);
  EXPECT_NEAR(line->scatter.standardDeviation.value(), std::sqrt(4.0 / 2.0), 1e-14);
  // Along the line the points are sqrt(50) from the mean.
  EXPECT_NEAR(line->directionDeviation.value(), std::sqrt(2.0) / std::sqrt(4.0 * 50.0), 1e-14);
}

TEST(FitLine, ExactDirections) {
  EXPECT_EQ(FitLine({{0, 5}, {1, 5}, {4, 5}})->direction, 0.0);
  EXPECT_DOUBLE_EQ(FitLine({{7, 0}, {7, 3}})->direction, 0.5 * pi);
  EXPECT_DOUBLE_EQ(FitLine({{7, 3}, {7, 0}})->direction, 0.5 * pi);
  EXPECT_DOUBLE_EQ(FitLine({{0, 0}, {1, -1}})->direction, -0.25 * pi);
  EXPECT_FALSE(FitLine({{0, 0}, {1, -1}})->scatter.standardDeviation);
}

TEST(FitLine, IsAsGoodFarFromTheOrigin) {
  for (double const offset : {1e3, 1e6, 1e9}) {
    auto const line =
        FitLine({{offset, -offset}, {offset + 4, 3 - offset}, {offset + 8, 6 - offset}});
    ASSERT_TRUE(line);
    EXPECT_DOUBLE_EQ(line->direction, std::atan2(3.0, 4.0)) << offset;
    EXPECT_EQ(line->at.x, offset + 4);
    EXPECT_EQ(line->at.y, 3 - offset);
    EXPECT_NEAR(line->scatter.formError, 0.0, 1e-14);
  }
}

TEST(FitLine, NoDirectionNearbyHasSmallerSquares) {
  std::mt19937_64 engine(21);
  for (int i = 0; i < 200; ++i) {
    double const direction = Uniform(&engine, -1.5, 1.5);
    std::vector<XY> points;
    for (int k = 0; k < 30; ++k) {
      double const along = Uniform(&engine, -10, 10);
      double const aside = Normal(&engine, 0.1);
      points.push_back({along * std::cos(direction) - aside * std::sin(direction),
                        along * std::sin(direction) + aside * std::cos(direction)});
    }
    auto const line = FitLine(points);
    ASSERT_TRUE(line);
    auto const squares = [&](double angle) {
      double sum = 0.0;
      for (XY const& at : points) {
        sum += std::pow(
            (at.y - line->at.y) * std::cos(angle) - (at.x - line->at.x) * std::sin(angle), 2);
      }
      return sum;
    };
    EXPECT_LT(squares(line->direction), squares(line->direction + 1e-6)) << i << ", seed 21";
    EXPECT_LT(squares(line->direction), squares(line->direction - 1e-6)) << i << ", seed 21";
    EXPECT_NEAR(*line->scatter.standardDeviation, std::sqrt(squares(line->direction) / 28.0),
                1e-12);
  }
}

TEST(FitLine, HasNothingToSayAboutPointsWithoutOne) {
  EXPECT_FALSE(FitLine({}));
  EXPECT_FALSE(FitLine({{1, 1}}));
  EXPECT_FALSE(FitLine({{1, 1}, {1, 1}}));
  EXPECT_FALSE(FitLine({{1, 1}, {std::nan(""), 1}}));
  EXPECT_FALSE(FitLine({{1, 1}, {-std::numeric_limits<double>::infinity(), 1}}));
  EXPECT_EQ(FitLine({{1, 0}, {0, 1}, {-1, 0}, {0, -1}})->direction, 0.0)
      << "no direction stands out";
}

}  // namespace
}  // namespace Vorn::IO
