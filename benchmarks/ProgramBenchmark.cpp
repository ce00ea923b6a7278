// What the program does with large files besides the fit itself.

#include <benchmark/benchmark.h>

#include <cmath>
#include <numbers>
#include <string>

#include "benchmarks/Measure.h"
#include "benchmarks/Registration.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Points.h"

namespace Vorn::Benchmarks {
namespace {

/// A circle of radius 100, all digits written.
std::string PointsText(std::int64_t count) {
  std::string text = "x,y\n";
  for (std::int64_t i = 0; i < count; ++i) {
    double const angle =
        2.0 * std::numbers::pi * static_cast<double>(i) / static_cast<double>(count);
    text += IO::FormatExact(100.0 * std::cos(angle)) + "," +
            IO::FormatExact(100.0 * std::sin(angle)) + "\n";
  }
  return text;
}

void ReadPoints(benchmark::State& state, std::int64_t count) {
  std::string const text = PointsText(count);
  std::size_t read = 0;
  for (auto _ : state) {
    IO::PointFile const file = IO::ParsePoints(text, "points.csv", {});
    read = file.points.size();
    benchmark::DoNotOptimize(file.points.data());
  }
  if (read != static_cast<std::size_t>(count)) state.SkipWithError("points are missing");
  CountTimePer(&state, "seconds_per_point", count);
}

std::vector<IO::Piece> Polygon(int corners) {
  auto const corner = [corners](int i) {
    double const angle = 2.0 * std::numbers::pi * i / corners;
    return GeometryUtils::Point{100.0 * std::cos(angle), 100.0 * std::sin(angle)};
  };
  std::vector<IO::Piece> pieces;
  for (int i = 0; i < corners; ++i) pieces.push_back(IO::MakeLine(corner(i), corner(i + 1)));
  return pieces;
}

/// Against a polygon of a thousand sides.
void MeasurePoints(benchmark::State& state, std::int64_t count) {
  constexpr int kSides = 1000;
  std::vector<IO::Piece> const pieces = Polygon(kSides);
  std::vector<WPoint> points = IO::ParsePoints(PointsText(count), "points.csv", {}).points;
  for (WPoint& point : points) point.w = 0.01;
  double worst = 0.0;
  for (auto _ : state) {
    worst = IO::Remeasure(points, pieces).Worst().distance;
    benchmark::DoNotOptimize(worst);
  }
  double const rise = 100.0 * (1.0 - std::cos(std::numbers::pi / kSides));
  if (!(worst <= rise * 1.000001)) state.SkipWithError("a point is too far from the polygon");
  CountTimePer(&state, "seconds_per_point", count);
}

}  // namespace

void RegisterProgram(Scale scale) {
  std::int64_t const count = scale == Scale::Smoke ? 40 : 1'000'000;
  benchmark::RegisterBenchmark(("BM_ReadPoints/circle/" + std::to_string(count)).c_str(),
                               [count](benchmark::State& state) { ReadPoints(state, count); })
      ->Unit(benchmark::kMillisecond);
  benchmark::RegisterBenchmark(("BM_MeasurePoints/polygon/" + std::to_string(count)).c_str(),
                               [count](benchmark::State& state) { MeasurePoints(state, count); })
      ->Unit(benchmark::kMillisecond);
}

}  // namespace Vorn::Benchmarks
