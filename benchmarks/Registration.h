#pragma once

#include "benchmarks/Scale.h"

/// Each part of the program adds its benchmarks, named BM_<Function>/<Profile>/<n>.
namespace Vorn::Benchmarks {

void RegisterFitting(Scale scale);
void RegisterFewest(Scale scale);
void RegisterSelfIntersection(Scale scale);
void RegisterArea(Scale scale);
void RegisterIntersections();
void RegisterSolver();
void RegisterRotation();

#if defined(VORN_BENCHMARK_PROGRAM)
/// The program's own work on large files.
void RegisterProgram(Scale scale);
#endif

#if defined(VORN_BENCHMARK_COMPARISONS)
/// Other libraries on the same data.
void RegisterSelfIntersectionOfOthers(Scale scale);
void RegisterSolverOfOthers();
void RegisterRotationOfOthers();
#endif

}  // namespace Vorn::Benchmarks
