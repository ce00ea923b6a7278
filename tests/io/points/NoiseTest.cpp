#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <random>

#include "io/points/Noise.h"

namespace Vorn::IO {
namespace {

using Curve = std::function<WPoint(double place)>;

WPoint OnLine(double place) { return {0.8 * place, 0.6 * place, 0.0}; }

WPoint OnCircle(double place) {
  constexpr double kRadius = 40.0;
  return {kRadius * std::cos(place / kRadius), kRadius * std::sin(place / kRadius), 0.0};
}

/// A wave of 60 in length and 3 in height, about.
WPoint OnWave(double place) { return {place, 3.0 * std::sin(place / 10.0), 0.0}; }

/// Normal noise in both coordinates, `sigma` as a standard deviation.
std::vector<WPoint> Sampled(Curve const& curve, int count, double unevenness, double sigma,
                            std::uint64_t seed) {
  std::mt19937_64 engine(seed);
  std::normal_distribution<double> noise;
  std::uniform_real_distribution<double> step(1.0 - unevenness, 1.0 + unevenness);
  std::vector<WPoint> points;
  double place = 0.0;
  for (int i = 0; i < count; ++i) {
    WPoint point = curve(place);
    if (sigma > 0.0) {
      point.x += sigma * noise(engine);
      point.y += sigma * noise(engine);
    }
    points.push_back(point);
    place += step(engine);
  }
  return points;
}

struct NoiseCase {
  char const* name;
  Curve curve;
  double unevenness;
};

class KnownNoise : public testing::TestWithParam<NoiseCase> {};

TEST_P(KnownNoise, IsFoundWithinTheStatedBounds) {
  struct Level {
    double sigma;
    double bound;
  };
  for (Level const level :
       {Level{0.001, 0.15}, Level{0.01, 0.15}, Level{0.1, 0.15}, Level{0.33, 0.3}}) {
    for (std::uint64_t seed = 1; seed <= 5; ++seed) {
      auto const points = Sampled(GetParam().curve, 2000, GetParam().unevenness, level.sigma, seed);
      std::optional<double> const noise = EstimateNoise(points);
      ASSERT_TRUE(noise.has_value());
      EXPECT_NEAR(*noise / level.sigma, 1.0, level.bound)
          << "sigma " << level.sigma << ", seed " << seed;
    }
  }
}

INSTANTIATE_TEST_SUITE_P(EstimateNoise, KnownNoise,
                         testing::Values(NoiseCase{"Line", OnLine, 0.0},
                                         NoiseCase{"UnevenLine", OnLine, 0.5},
                                         NoiseCase{"Circle", OnCircle, 0.0},
                                         NoiseCase{"UnevenCircle", OnCircle, 0.5}),
                         [](auto const& instance) { return instance.param.name; });

TEST(EstimateNoise, OfASmoothWaveIsFoundWhereTheNoiseExceedsWhatTheCurveLeaves) {
  // The wave itself leaves a residual of about 1e-3 / sqrt(20).
  for (double const sigma : {0.01, 0.1}) {
    double const noise = EstimateNoise(Sampled(OnWave, 2000, 0.3, sigma, 3)).value();
    EXPECT_NEAR(noise / sigma, 1.0, 0.1) << sigma;
  }
}

TEST(EstimateNoise, OfExactPointsIsTheirRounding) {
  EXPECT_LT(EstimateNoise(Sampled(OnLine, 500, 0.0, 0.0, 1)).value(), 1e-12);
  EXPECT_LT(EstimateNoise(Sampled(OnCircle, 500, 0.0, 0.0, 1)).value(), 1e-12);
}

TEST(EstimateNoise, FollowsTheScaleAndNotThePlace) {
  std::vector<WPoint> points = Sampled(OnCircle, 1000, 0.4, 0.05, 9);
  double const noise = EstimateNoise(points).value();
  for (WPoint& point : points) point = {1024.0 * point.x, 1024.0 * point.y, 0.0};
  EXPECT_NEAR(EstimateNoise(points).value() / noise, 1024.0, 1e-6);
  for (WPoint& point : points) point.x += 1e6;
  EXPECT_NEAR(EstimateNoise(points).value() / noise, 1024.0, 1e-4);
  for (WPoint& point : points) point = {-point.y, point.x, 0.0};
  EXPECT_NEAR(EstimateNoise(points).value() / noise, 1024.0, 1e-4);
}

/// A stair: up and to the right by turns, 100 long each.
WPoint OnStair(double place) {
  constexpr double kStep = 100.0;
  double const steps = std::floor(place / kStep);
  double const within = place - steps * kStep;
  double const across = std::ceil(steps / 2.0) * kStep;
  double const up = std::floor(steps / 2.0) * kStep;
  bool const isAcross = std::fmod(steps, 2.0) == 0.0;
  return {across + (isAcross ? within : 0.0), up + (isAcross ? 0.0 : within), 0.0};
}

TEST(EstimateNoise, FewCornersAndOutliersDoNotCount) {
  std::vector<WPoint> points = Sampled(OnStair, 2000, 0.2, 0.01, 4);
  for (std::size_t i = 50; i < points.size(); i += 100) points[i].y += 5.0;
  EXPECT_NEAR(EstimateNoise(points).value() / 0.01, 1.0, 0.15);
}

TEST(EstimateNoise, NeedsElevenPointsThatDoNotCoincide) {
  EXPECT_FALSE(EstimateNoise(Sampled(OnLine, 10, 0.0, 0.1, 1)).has_value());
  EXPECT_TRUE(EstimateNoise(Sampled(OnLine, 11, 0.0, 0.1, 1)).has_value());
  EXPECT_FALSE(EstimateNoise(std::vector<WPoint>(100, WPoint{1, 2, 0})).has_value());
}

TEST(EstimateNoise, AnswersForCoordinatesAtTheEndsOfTheRange) {
  for (double const scale : {1e-300, 1e300}) {
    std::vector<WPoint> points = Sampled(OnCircle, 200, 0.2, 0.01, 2);
    for (WPoint& point : points) point = {scale * point.x, scale * point.y, 0.0};
    EXPECT_NEAR(EstimateNoise(points).value() / scale, 0.01, 0.003) << scale;
  }
}

}  // namespace
}  // namespace Vorn::IO
