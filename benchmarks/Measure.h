#pragma once

#include <benchmark/benchmark.h>

#include <chrono>
#include <cstdint>

#include "benchmarks/TimeBudget.h"

namespace Vorn::Benchmarks {

/// Calls of a few nanoseconds are measured several times; the report takes the fastest.
constexpr int kRepetitionsOfShortCalls = 5;

/// Adds a counter with the time that each of `count` items took.
inline void CountTimePer(benchmark::State* state, char const* name, std::int64_t count) {
  state->counters[name] =
      benchmark::Counter(static_cast<double>(count), benchmark::Counter::kIsIterationInvariantRate |
                                                         benchmark::Counter::kInvert);
}

/// The timed loop of one size of a series.
template <typename Work>
void TimeWithin(TimeBudget* budget, std::int64_t size, benchmark::State* state, Work const& work) {
  using Clock = std::chrono::steady_clock;
  auto const start = Clock::now();
  for (auto _ : *state) work();
  std::chrono::duration<double> const taken = Clock::now() - start;
  budget->Note(size, taken.count() / static_cast<double>(state->iterations()));
}

/// Marks a size as left out unless the budget of its series allows it.
inline bool IsWithin(TimeBudget const& budget, std::int64_t size, benchmark::State* state) {
  if (budget.Allows(size)) return true;
  state->SkipWithError("left out: one run would exceed the time limit");
  return false;
}

}  // namespace Vorn::Benchmarks
