// The same rotations with Eigen.

#include <benchmark/benchmark.h>

#include <Eigen/Geometry>
#include <vector>

#include "benchmarks/Angles.h"
#include "benchmarks/Measure.h"
#include "benchmarks/Registration.h"

namespace Vorn::Benchmarks {
namespace {

Eigen::Matrix3d MakeRotation(AxisAngles const& angles) {
  using Eigen::AngleAxisd;
  using Eigen::Vector3d;
  return AngleAxisd(angles.x, Vector3d::UnitX()).toRotationMatrix() *
         AngleAxisd(angles.y, Vector3d::UnitY()).toRotationMatrix() *
         AngleAxisd(angles.z, Vector3d::UnitZ()).toRotationMatrix();
}

std::vector<Eigen::Matrix3d> MakeRotations() {
  std::vector<Eigen::Matrix3d> rotations;
  for (AxisAngles const& angles : MakeAngles()) rotations.push_back(MakeRotation(angles));
  return rotations;
}

void FromAngles(benchmark::State& state) {
  auto const all = MakeAngles();
  for (auto _ : state) {
    for (AxisAngles const& angles : all) {
      Eigen::Matrix3d const rotation = MakeRotation(angles);
      benchmark::DoNotOptimize(rotation);
    }
  }
  CountTimePer(&state, "seconds_per_call", kRotations);
}

void Multiply(benchmark::State& state) {
  auto const rotations = MakeRotations();
  Eigen::Matrix3d const& last = rotations.back();
  for (auto _ : state) {
    for (Eigen::Matrix3d const& rotation : rotations) {
      Eigen::Matrix3d const product = rotation * last;
      benchmark::DoNotOptimize(product);
    }
  }
  CountTimePer(&state, "seconds_per_call", kRotations);
}

void Apply(benchmark::State& state) {
  auto const rotations = MakeRotations();
  Eigen::Vector3d const vector(1.0, 2.0, 3.0);
  for (auto _ : state) {
    for (Eigen::Matrix3d const& rotation : rotations) {
      Eigen::Vector3d const turned = rotation * vector;
      benchmark::DoNotOptimize(turned);
    }
  }
  CountTimePer(&state, "seconds_per_call", kRotations);
}

}  // namespace

void RegisterRotationOfOthers() {
  benchmark::RegisterBenchmark("BM_EigenFromAngles/random_rotations", FromAngles)
      ->Repetitions(kRepetitionsOfShortCalls);
  benchmark::RegisterBenchmark("BM_EigenProduct/random_rotations", Multiply)
      ->Repetitions(kRepetitionsOfShortCalls);
  benchmark::RegisterBenchmark("BM_EigenTimesVector/random_rotations", Apply)
      ->Repetitions(kRepetitionsOfShortCalls);
}

}  // namespace Vorn::Benchmarks
