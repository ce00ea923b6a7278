// Whether an outline crosses itself, on outlines that do not: every pair of pieces has to be ruled
// out.

#include <benchmark/benchmark.h>

#include <memory>
#include <string>

#include "benchmarks/Measure.h"
#include "benchmarks/OutlineCases.h"
#include "benchmarks/Registration.h"

namespace Vorn::Benchmarks {
namespace {

void RegisterContour(OutlineCase const& outline, std::int64_t size,
                     std::shared_ptr<TimeBudget> const& budget) {
  auto const body = [=](benchmark::State& state) {
    if (!IsWithin(*budget, size, &state)) return;
    auto const contour = outline.make(size, outline.hasArcs);
    auto code = ErrorCode::Ok;
    TimeWithin(budget.get(), size, &state, [&] {
      code = GeometryUtils::CheckPolySelfIntersection(contour);
      benchmark::DoNotOptimize(code);
    });
    if (code != ErrorCode::Ok) state.SkipWithError("found a crossing where there is none");
    CountTimePer(&state, "seconds_per_element", size);
  };
  benchmark::RegisterBenchmark(NameOf("BM_CheckPolySelfIntersection", outline, size).c_str(), body)
      ->Unit(benchmark::kMicrosecond);
}

/// The vertices of an outline of segments as an open polyline: a closed one always counts as
/// touching itself.
void RegisterFlatPolyline(OutlineCase const& outline, std::int64_t size,
                          std::shared_ptr<TimeBudget> const& budget) {
  auto const body = [=](benchmark::State& state) {
    if (!IsWithin(*budget, size, &state)) return;
    std::vector<double> coords;
    for (auto const& vertex : VerticesOf(outline, size)) {
      coords.insert(coords.end(), {vertex.x, vertex.y});
    }
    std::vector<std::int32_t> const indices = {static_cast<std::int32_t>(coords.size()) - 2};
    bool found = false;
    auto code = ErrorCode::Ok;
    TimeWithin(budget.get(), size, &state, [&] {
      code = GeometryUtils::CheckPolySelfIntersection(coords, indices, &found);
      benchmark::DoNotOptimize(found);
    });
    if (code != ErrorCode::Ok || found) {
      state.SkipWithError("found a crossing where there is none");
    }
    CountTimePer(&state, "seconds_per_element", size);
  };
  benchmark::RegisterBenchmark(NameOf("BM_CheckFlatSelfIntersection", outline, size).c_str(), body)
      ->Unit(benchmark::kMicrosecond);
}

}  // namespace

void RegisterSelfIntersection(Scale scale) {
  for (OutlineCase const& outline : kOutlineCases) {
    auto const budget = std::make_shared<TimeBudget>(SecondsForOutlines(scale));
    auto const flatBudget = std::make_shared<TimeBudget>(SecondsForOutlines(scale));
    for (std::int64_t const size : SizesFor(scale)) {
      RegisterContour(outline, size, budget);
      if (!outline.hasArcs) RegisterFlatPolyline(outline, size, flatBudget);
    }
  }
}

}  // namespace Vorn::Benchmarks
