// The area of contours, which includes the test for self-intersection, and of flat polylines.

#include <benchmark/benchmark.h>

#include <memory>
#include <string>

#include "benchmarks/Measure.h"
#include "benchmarks/OutlineCases.h"
#include "benchmarks/Registration.h"

namespace Vorn::Benchmarks {
namespace {

void RegisterContourArea(OutlineCase const& outline, std::int64_t size,
                         std::shared_ptr<TimeBudget> const& budget) {
  auto const body = [=](benchmark::State& state) {
    if (!IsWithin(*budget, size, &state)) return;
    auto const contour = outline.make(size, outline.hasArcs);
    auto code = ErrorCode::Ok;
    TimeWithin(budget.get(), size, &state, [&] {
      double area = 0.0;
      code = GeometryUtils::GetArea(contour, &area);
      benchmark::DoNotOptimize(area);
    });
    if (code != ErrorCode::Ok) state.SkipWithError("no area");
    CountTimePer(&state, "seconds_per_element", size);
  };
  benchmark::RegisterBenchmark(NameOf("BM_GetArea", outline, size).c_str(), body)
      ->Unit(benchmark::kMicrosecond);
}

void RegisterFlatArea(OutlineCase const& outline, std::int64_t size) {
  auto const body = [=](benchmark::State& state) {
    std::vector<double> coords;
    for (auto const& elem : outline.make(size, false)) {
      coords.insert(coords.end(), {elem.end.x, elem.end.y});
    }
    std::vector<std::int32_t> const indices = {static_cast<std::int32_t>(coords.size()) - 2};
    auto code = ErrorCode::Ok;
    for (auto _ : state) {
      double area = 0.0;
      code = GeometryUtils::GetArea(coords, indices, &area);
      benchmark::DoNotOptimize(area);
    }
    if (code != ErrorCode::Ok) state.SkipWithError("no area");
    CountTimePer(&state, "seconds_per_element", size);
  };
  benchmark::RegisterBenchmark(NameOf("BM_GetFlatArea", outline, size).c_str(), body)
      ->Unit(benchmark::kMicrosecond);
}

}  // namespace

void RegisterArea(Scale scale) {
  for (OutlineCase const& outline :
       {OutlineCase{"ring", MakeRing, false}, OutlineCase{"ring_arcs", MakeRing, true}}) {
    auto const budget = std::make_shared<TimeBudget>(SecondsForOutlines(scale));
    for (std::int64_t const size : SizesFor(scale)) {
      RegisterContourArea(outline, size, budget);
      if (!outline.hasArcs) RegisterFlatArea(outline, size);
    }
  }
}

}  // namespace Vorn::Benchmarks
