// What fits cost, in steps that are the same on every machine, over the inputs that were found to
// cost most.

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <functional>
#include <random>
#include <string>
#include <vector>

#include "support/CountedSteps.h"
#include "vorn/FewestPieces.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Points = std::vector<WPoint>;
using Strategy = GeometryUtils::FittingStrategy;

/// Points of one kind, as many as wanted.
struct Family {
  std::string name;
  std::function<Points(int count)> make;
};

/// Numbers in [-size, size].
std::vector<double> Noise(int count, double size) {
  constexpr std::uint32_t kSeed = 7;
  std::mt19937 random(kSeed);
  std::uniform_real_distribution<double> within(-size, size);
  std::vector<double> noise;
  for (int i = 0; i < count; ++i) noise.push_back(within(random));
  return noise;
}

/// A straight line in steps of 1 with a noise across it, in parts of the tolerance 0.01.
Points NoisyLine(int count, double noise) {
  std::vector<double> const across = Noise(count, 0.01 * noise);
  Points points;
  for (int i = 0; i < count; ++i) points.push_back({1.0 * i, across[i], 0.01});
  return points;
}

/// 258 degrees of a circle of radius 100 with a noise across it, in parts of the tolerance 0.001.
Points NoisyArc(int count, double noise) {
  std::vector<double> const across = Noise(count, 0.001 * noise);
  Points points;
  for (int i = 0; i < count; ++i) {
    double const angle = 4.5 * i / count;
    double const radius = 100.0 + across[i];
    points.push_back({radius * std::cos(angle), radius * std::sin(angle), 0.001});
  }
  return points;
}

/// Steps of 1 along (0.8, 0.6), exactly straight but for rounding.
Points StraightLine(int count, double tolerance) {
  Points points;
  for (int i = 0; i < count; ++i) points.push_back({0.8 * i, 0.6 * i, tolerance});
  return points;
}

Points Spiral(int count) {
  Points points;
  for (int i = 0; i < count; ++i) {
    double const angle = 0.05 * i;
    double const radius = 10.0 + 0.01 * i;
    points.push_back({radius * std::cos(angle), radius * std::sin(angle), 0.001});
  }
  return points;
}

/// To and fro between the borders of a band.
Points Zigzag(int count) {
  Points points;
  for (int i = 0; i < count; ++i) points.push_back({1.0 * i, i % 2 == 0 ? 0.01 : -0.01, 0.01});
  return points;
}

/// An arc whose tolerances spread over six orders of magnitude.
Points SpreadTolerances(int count) {
  std::vector<double> const exponents = Noise(count, 3.0);
  Points points = NoisyArc(count, 0.0);
  for (int i = 0; i < count; ++i) {
    points[i] = {10.0 * points[i].x, 10.0 * points[i].y, 1e-5 * std::pow(10.0, exponents[i])};
  }
  return points;
}

Points LineWithOutlier(int count) {
  Points points = NoisyLine(count, 0.0);
  points[count / 2].y = 1e6;
  return points;
}

/// What a measuring machine may deliver, and worse.
std::vector<Family> Families() {
  return {{"exact line", [](int n) { return StraightLine(n, 1e-3); }},
          {"noisy line", [](int n) { return NoisyLine(n, 0.9); }},
          {"line noisier than its tolerance", [](int n) { return NoisyLine(n, 1.5); }},
          {"exact arc", [](int n) { return NoisyArc(n, 0.0); }},
          {"noisy arc", [](int n) { return NoisyArc(n, 0.9); }},
          {"arc noisier than its tolerance", [](int n) { return NoisyArc(n, 1.3); }},
          {"spiral", Spiral},
          {"zigzag", Zigzag},
          {"spread tolerances", SpreadTolerances},
          {"outlier", LineWithOutlier}};
}

Steps StepsOf(Points const& points, Strategy strategy) {
  std::vector<GeometryUtils::Elem> contour;
  double deviation = 0.0;
  std::int32_t index = -1;
  ResetSteps();
  GeometryUtils::CreateFittingCurve(points, strategy, &contour, &deviation, &index, nullptr, 100);
  return CountedSteps();
}

Steps StepsOfFewest(Points const& points) {
  FewestPieces::Result result;
  ResetSteps();
  FewestPieces::Fit(points, {}, &result, nullptr, 100);
  return CountedSteps();
}

// Numbers of points at which the families are tried.
constexpr int kCounts[] = {25, 50, 100, 200};

TEST(StepsOfMixed, FiveNarrowingsAPointAtMost) {
  for (Family const& family : Families()) {
    for (int const count : kCounts) {
      Steps const steps = StepsOf(family.make(count), Strategy::Mixed);
      EXPECT_GT(steps.narrowings, count / 2) << family.name;
      EXPECT_LE(steps.narrowings, 5 * count) << family.name << ' ' << count;
      EXPECT_LE(steps.overlaps, 3500 * count) << family.name << ' ' << count;
    }
  }
}

TEST(StepsOfMixed, AnExactLineIsGrownOnce) {
  // One narrowing for each point after the second, and the arc that competes with the line.
  for (int const count : kCounts) {
    Steps const steps = StepsOf(StraightLine(count, 1e-3), Strategy::Mixed);
    EXPECT_GE(steps.narrowings, count - 2);
    EXPECT_LE(steps.narrowings, count + count / 10);
  }
}

TEST(StepsOfMixed, FineTolerancesCostHalfAsManyNarrowingsAPointAsThereArePoints) {
  for (int const count : {25, 50, 100}) {
    Steps const steps = StepsOf(StraightLine(count, 1e-9), Strategy::Mixed);
    EXPECT_LE(2 * steps.narrowings, count * count) << count;
  }
}

TEST(StepsOfMixedCells, FewerNarrowingsAPointThanThereArePoints) {
  for (Family const& family : Families()) {
    for (int const count : {25, 50, 100}) {
      Steps const steps = StepsOf(family.make(count), Strategy::MixedCells);
      EXPECT_GT(steps.narrowings, count / 2) << family.name;
      EXPECT_LE(steps.narrowings, count * count) << family.name << ' ' << count;
    }
  }
}

TEST(StepsOfMixedCells, ToleranceZeroOnALineIsGrownAgainForEveryLength) {
  Points points;
  for (int i = 0; i < 25; ++i) points.push_back({1.0 * i, 0.5 * i, 0.0});
  Steps const steps = StepsOf(points, Strategy::MixedCells);
  EXPECT_GT(steps.narrowings, 200);
  EXPECT_LE(steps.narrowings, 25 * 25);
}

TEST(StepsOfSingleArc, AHandfulOfNarrowings) {
  for (Family const& family : Families()) {
    for (int const count : kCounts) {
      EXPECT_LE(StepsOf(family.make(count), Strategy::SingleArc).narrowings, 10) << family.name;
    }
  }
}

TEST(StepsOfFewestPieces, TenThousandMeasurementsAPointAtMost) {
  for (Family const& family : Families()) {
    for (int const count : kCounts) {
      Steps const steps = StepsOfFewest(family.make(count));
      EXPECT_GE(steps.measurements, count) << family.name;
      EXPECT_LE(steps.measurements, 10000 * count) << family.name << ' ' << count;
    }
  }
}

TEST(StepsOfFewestPieces, NoiseWithinTheToleranceCostsTheSameForEachPointOfAnyNumber) {
  for (int const count : {100, 1000, 10000}) {
    EXPECT_LE(StepsOfFewest(NoisyLine(count, 0.9)).measurements, 100 * count) << count;
    EXPECT_LE(StepsOfFewest(NoisyArc(count, 0.9)).measurements, 800 * count) << count;
  }
}

}  // namespace
}  // namespace Vorn::Testing
