// Runs the benchmarks:
//
//   benchmarks [--scale=smoke|quick|standard|full] [options of Google Benchmark]
//
// VORN_DATA_DIR may name a folder with measured contours; without it they are left out.

#include <benchmark/benchmark.h>

#include <cstdio>
#include <optional>
#include <string_view>

#include "benchmarks/Registration.h"

namespace Vorn::Benchmarks {
namespace {

std::optional<Scale> ParseScale(std::string_view name) {
  if (name == "smoke") return Scale::Smoke;
  if (name == "quick") return Scale::Quick;
  if (name == "standard") return Scale::Standard;
  if (name == "full") return Scale::Full;
  return std::nullopt;
}

/// Takes --scale out of the arguments, which Google Benchmark does not know.
std::optional<Scale> TakeScale(int* argc, char** argv) {
  constexpr std::string_view kOption = "--scale=";
  std::optional<Scale> scale = Scale::Standard;
  int kept = 0;
  for (int i = 0; i < *argc; ++i) {
    std::string_view const argument = argv[i];
    if (argument.substr(0, kOption.size()) == kOption) {
      scale = ParseScale(argument.substr(kOption.size()));
    } else {
      argv[kept++] = argv[i];
    }
  }
  *argc = kept;
  return scale;
}

void RegisterAll(Scale scale) {
  RegisterIntersections();
  RegisterSolver();
  RegisterRotation();
#if defined(VORN_BENCHMARK_COMPARISONS)
  RegisterSolverOfOthers();
  RegisterRotationOfOthers();
#endif
  RegisterArea(scale);
  RegisterSelfIntersection(scale);
#if defined(VORN_BENCHMARK_COMPARISONS)
  RegisterSelfIntersectionOfOthers(scale);
#endif
  RegisterFitting(scale);
  RegisterFewest(scale);
#if defined(VORN_BENCHMARK_PROGRAM)
  RegisterProgram(scale);
#endif
}

}  // namespace
}  // namespace Vorn::Benchmarks

int main(int argc, char** argv) {
  auto const scale = Vorn::Benchmarks::TakeScale(&argc, argv);
  if (!scale) {
    std::fputs("benchmarks: --scale is one of smoke, quick, standard, full\n", stderr);
    return 2;
  }
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 2;
  Vorn::Benchmarks::RegisterAll(*scale);
  benchmark::RunSpecifiedBenchmarks();
  benchmark::Shutdown();
  return 0;
}
