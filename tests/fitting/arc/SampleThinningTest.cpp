#include <cmath>
#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/fitting/arc/SampleThinning.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/CellInputs.h"
#include "support/RandomGeometry.h"
#include "support/Transcript.h"

// A rough centre must thin the samples as the true one does, or not at all.

namespace Vorn::Testing {
namespace {

using Cells::RoughCentre;
using Fitting::ArcRun;
using Fitting::ThinSamples;
using Point = GeometryUtils::Point;
using Samples = std::vector<GeometryUtils::IndexedPoint>;

Samples SamplesOf(std::vector<WPoint> const& points) {
  Samples samples;
  for (std::size_t i = 0; i < points.size(); ++i) {
    samples.push_back({{points[i].x, points[i].y}, points[i].w, static_cast<std::int32_t>(i)});
  }
  return samples;
}

ArcRun RunOver(std::vector<WPoint> const& points) { return {Fitting::RunOverAll(points), {}}; }

std::string Transcribe(ErrorCode code, Samples const& samples) {
  Transcript transcript;
  transcript.Add("code", code);
  transcript.Add("samples", samples);
  return transcript.Text();
}

struct Thinned {
  std::optional<ErrorCode> code;
  Samples samples;
};

Thinned ThinRoughly(std::vector<WPoint> const& points, RoughCentre const& centre, int steps) {
  Thinned thinned{{}, SamplesOf(points)};
  ArcRun const run = RunOver(points);
  thinned.code = ThinSamples({run, true, steps}, centre, &thinned.samples);
  return thinned;
}

std::string ThinExactly(std::vector<WPoint> const& points, Point const& centre, int steps) {
  Samples samples = SamplesOf(points);
  ArcRun const run = RunOver(points);
  ErrorCode const code = ThinSamples({run, true, steps}, centre, &samples);
  return Transcribe(code, samples);
}

TEST(ThinSamples, RoughCentresThinAsTheTrueOneOrNotAtAll) {
  int clear = 0;
  int unclear = 0;
  for (std::uint64_t seed = 1; seed <= 4000; ++seed) {
    SCOPED_TRACE(seed);
    RandomGeometry random(seed);
    int const count = random.Integer(5, 40);
    std::vector<WPoint> const points = NoisyArc(random, count, 20.0, 0.05);
    // From next to the points to several radii away.
    Point const& near = {points[static_cast<std::size_t>(count) / 2].x, points.front().y};
    double const spread = std::pow(10.0, random.Uniform(-1.0, 2.0));
    Point const centre{near.x + spread * random.Uniform(-1.0, 1.0),
                       near.y + spread * random.Uniform(-1.0, 1.0)};
    double const error = std::pow(10.0, random.Uniform(-13.0, 0.0));
    double const direction = random.Uniform(-3.0, 3.0);
    RoughCentre const rough{
        {centre.x + error * std::cos(direction), centre.y + error * std::sin(direction)},
        error * 1.001};
    int const steps = random.Integer(1, (count - 1) / 2);

    Thinned const thinned = ThinRoughly(points, rough, steps);
    if (thinned.code) {
      ++clear;
      EXPECT_EQ(Transcribe(*thinned.code, thinned.samples), ThinExactly(points, centre, steps));
    } else {
      ++unclear;
      EXPECT_EQ(Transcribe(ErrorCode::Ok, thinned.samples),
                Transcribe(ErrorCode::Ok, SamplesOf(points)));
    }
  }
  EXPECT_GT(clear, 1000);
  EXPECT_GT(unclear, 500);
}

/// Seven points of whole numbers on a circle of radius 25 about the origin.
std::vector<WPoint> const kEquallyFar = {{24, 7, .1},  {20, 15, .1},  {15, 20, .1}, {7, 24, .1},
                                         {-7, 24, .1}, {-15, 20, .1}, {-24, 7, .1}};

TEST(ThinSamples, EqualDistancesAreUnclearWithAnyError) {
  EXPECT_FALSE(ThinRoughly(kEquallyFar, {{0, 0}, 1e-300}, 3).code);
  EXPECT_EQ(ThinRoughly(kEquallyFar, {{0, 0}, 0.0}, 3).code, ErrorCode::Ok);
}

TEST(ThinSamples, AMiddleBetweenTwoPointsIsUnclear) {
  // Symmetric about the y axis, so that the two innermost points are equally near to the middle.
  std::vector<WPoint> points = {{24, 7, .1},  {19, 15, .1},  {15, 21, .1},  {7, 24, .1},
                                {-7, 24, .1}, {-15, 20, .1}, {-21, 14, .1}, {-24, 7, .1}};
  EXPECT_FALSE(ThinRoughly(points, {{0, 0}, 1e-12}, 3).code);
  EXPECT_EQ(ThinRoughly(points, {{0, 0}, 0.0}, 3).code, ErrorCode::Ok);
  points[3].x = 6.5;
  EXPECT_EQ(ThinRoughly(points, {{0, 0}, 1e-12}, 3).code, ErrorCode::Ok);
}

TEST(ThinSamples, ACentreThatMayLieOnAPointIsUnclear) {
  std::vector<WPoint> const points = {{24, 7, .1},   {19, 15, .1},  {15, 21, .1},
                                      {6.5, 24, .1}, {-15, 20, .1}, {-24, 7, .1}};
  EXPECT_FALSE(ThinRoughly(points, {{6.5, 23.9}, 0.2}, 2).code);
}

}  // namespace
}  // namespace Vorn::Testing
