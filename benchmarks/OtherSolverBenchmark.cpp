// The same systems of linear equations with Eigen.

#include <benchmark/benchmark.h>

#include <Eigen/Dense>

#include "benchmarks/Measure.h"
#include "benchmarks/Registration.h"
#include "benchmarks/Systems.h"

namespace Vorn::Benchmarks {
namespace {

template <std::size_t kOrder>
void Solve(benchmark::State& state) {
  constexpr int kRows = static_cast<int>(kOrder);
  using Square = Eigen::Matrix<double, kRows, kRows, Eigen::RowMajor>;
  using Column = Eigen::Matrix<double, kRows, 1>;
  auto const systems = MakeSystems<kOrder>();
  for (auto _ : state) {
    for (auto const& system : systems) {
      Eigen::Map<Square const> const matrix(system.matrix.data());
      Eigen::Map<Column const> const rhs(system.rhs.data());
      Column const solution = matrix.partialPivLu().solve(rhs);
      benchmark::DoNotOptimize(solution);
    }
  }
  CountTimePer(&state, "seconds_per_call", kSystems);
}

}  // namespace

void RegisterSolverOfOthers() {
  benchmark::RegisterBenchmark("BM_EigenPartialPivLu/random_systems/2", Solve<2>)
      ->Repetitions(kRepetitionsOfShortCalls);
  benchmark::RegisterBenchmark("BM_EigenPartialPivLu/random_systems/3", Solve<3>)
      ->Repetitions(kRepetitionsOfShortCalls);
  benchmark::RegisterBenchmark("BM_EigenPartialPivLu/random_systems/4", Solve<4>)
      ->Repetitions(kRepetitionsOfShortCalls);
}

}  // namespace Vorn::Benchmarks
