// The same outlines of segments with other libraries.

#include <benchmark/benchmark.h>

#include <memory>
#include <string>

#include "benchmarks/Measure.h"
#include "benchmarks/OtherPolygons.h"
#include "benchmarks/OutlineCases.h"
#include "benchmarks/Registration.h"

namespace Vorn::Benchmarks {
namespace {

struct OtherLibrary {
  char const* function;
  std::unique_ptr<OtherPolygon> (*make)(Vertices const& vertices);
};

constexpr OtherLibrary kOtherLibraries[] = {
    {"BM_BoostIntersects", MakeBoostPolygon},
    {"BM_GeosIsSimple", MakeGeosPolygon},
    {"BM_CgalIsSimple", MakeCgalPolygon},
};

void RegisterPolygon(OtherLibrary const& library, OutlineCase const& outline, std::int64_t size,
                     std::shared_ptr<TimeBudget> const& budget) {
  auto const body = [=](benchmark::State& state) {
    if (!IsWithin(*budget, size, &state)) return;
    auto const polygon = library.make(VerticesOf(outline, size));
    bool isSimple = false;
    TimeWithin(budget.get(), size, &state, [&] {
      isSimple = polygon->IsSimple();
      benchmark::DoNotOptimize(isSimple);
    });
    if (!isSimple) state.SkipWithError("found a crossing where there is none");
    CountTimePer(&state, "seconds_per_element", size);
  };
  benchmark::RegisterBenchmark(NameOf(library.function, outline, size).c_str(), body)
      ->Unit(benchmark::kMicrosecond);
}

}  // namespace

void RegisterSelfIntersectionOfOthers(Scale scale) {
  for (OutlineCase const& outline : kOutlineCases) {
    if (outline.hasArcs) continue;
    for (OtherLibrary const& library : kOtherLibraries) {
      auto const budget = std::make_shared<TimeBudget>(SecondsForOutlines(scale));
      for (std::int64_t const size : SizesFor(scale)) {
        RegisterPolygon(library, outline, size, budget);
      }
    }
  }
}

}  // namespace Vorn::Benchmarks
