// Rotations: made from angles, multiplied, applied to a vector.

#include <benchmark/benchmark.h>

#include <vector>

#include "benchmarks/Angles.h"
#include "benchmarks/Measure.h"
#include "benchmarks/Registration.h"
#include "vorn/Matrix.h"

namespace Vorn::Benchmarks {
namespace {

std::vector<Matrix> MakeRotations() {
  std::vector<Matrix> rotations;
  for (AxisAngles const& angles : MakeAngles()) {
    rotations.emplace_back().InitMxMyMz(angles.x, angles.y, angles.z);
  }
  return rotations;
}

void FromAngles(benchmark::State& state) {
  auto const all = MakeAngles();
  for (auto _ : state) {
    for (AxisAngles const& angles : all) {
      Matrix rotation;
      rotation.InitMxMyMz(angles.x, angles.y, angles.z);
      benchmark::DoNotOptimize(rotation);
    }
  }
  CountTimePer(&state, "seconds_per_call", kRotations);
}

void Multiply(benchmark::State& state) {
  auto rotations = MakeRotations();
  Matrix const& last = rotations.back();
  for (auto _ : state) {
    for (Matrix& rotation : rotations) {
      Matrix const product = rotation * last;
      benchmark::DoNotOptimize(product);
    }
  }
  CountTimePer(&state, "seconds_per_call", kRotations);
}

void Apply(benchmark::State& state) {
  auto rotations = MakeRotations();
  SpatVector vector{{1.0, 2.0, 3.0, 0.0, 0.0}};
  for (auto _ : state) {
    for (Matrix& rotation : rotations) {
      SpatVector const turned = rotation.MxV(vector);
      benchmark::DoNotOptimize(turned);
    }
  }
  CountTimePer(&state, "seconds_per_call", kRotations);
}

}  // namespace

void RegisterRotation() {
  benchmark::RegisterBenchmark("BM_MatrixFromAngles/random_rotations", FromAngles)
      ->Repetitions(kRepetitionsOfShortCalls);
  benchmark::RegisterBenchmark("BM_MatrixProduct/random_rotations", Multiply)
      ->Repetitions(kRepetitionsOfShortCalls);
  benchmark::RegisterBenchmark("BM_MatrixTimesVector/random_rotations", Apply)
      ->Repetitions(kRepetitionsOfShortCalls);
}

}  // namespace Vorn::Benchmarks
