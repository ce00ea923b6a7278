// Systems of linear equations. The solver works in place, so the copy it needs is part of the time.

#include <benchmark/benchmark.h>

#include "benchmarks/Measure.h"
#include "benchmarks/Registration.h"
#include "benchmarks/Systems.h"
#include "vorn/MathUtils.h"

namespace Vorn::Benchmarks {
namespace {

template <std::size_t kOrder>
void Solve(benchmark::State& state) {
  auto const systems = MakeSystems<kOrder>();
  std::size_t solved = 0;
  for (auto _ : state) {
    solved = 0;
    for (auto const& system : systems) {
      auto scratch = system;
      std::array<double, kOrder> solution;
      if (MathUtils::LinearEquationSystemSolve(static_cast<int>(kOrder), scratch.matrix.data(),
                                               scratch.rhs.data(), solution.data())) {
        ++solved;
      }
      benchmark::DoNotOptimize(solution);
    }
  }
  if (solved != kSystems) state.SkipWithError("a system was not solved");
  CountTimePer(&state, "seconds_per_call", kSystems);
}

}  // namespace

void RegisterSolver() {
  benchmark::RegisterBenchmark("BM_LinearEquationSystemSolve/random_systems/2", Solve<2>)
      ->Repetitions(kRepetitionsOfShortCalls);
  benchmark::RegisterBenchmark("BM_LinearEquationSystemSolve/random_systems/3", Solve<3>)
      ->Repetitions(kRepetitionsOfShortCalls);
  benchmark::RegisterBenchmark("BM_LinearEquationSystemSolve/random_systems/4", Solve<4>)
      ->Repetitions(kRepetitionsOfShortCalls);
}

}  // namespace Vorn::Benchmarks
