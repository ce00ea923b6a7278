// Times in C++ what compare.py times in Python, on the same points: least seconds of a fit, and
// least nanoseconds of an element for the operations that have batch forms. A line for each.
//
// usage: python_benchmark POINTS.csv TOLERANCE

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <iostream>
#include <limits>
#include <string>
#include <vector>

#include "vorn/GeometryUtils.h"
#include "vorn/io/Files.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/Points.h"

namespace {

using Vorn::GeometryUtils;

constexpr int kRepeats = 15;
constexpr std::size_t kElements = 200000;

/// The least of some runs: what else the machine does only adds to a time.
double LeastSeconds(std::function<void()> const& run) {
  using Clock = std::chrono::steady_clock;
  double least = std::numeric_limits<double>::infinity();
  for (int i = 0; i < kRepeats; ++i) {
    Clock::time_point const begin = Clock::now();
    run();
    least = std::min(least, std::chrono::duration<double>(Clock::now() - begin).count());
  }
  return least;
}

/// The same numbers as compare.py makes.
double Sample(std::size_t i) { return std::fmod(static_cast<double>(i) * 0.6180339887, 1.0); }

void TimeFit(std::string const& path, double tolerance) {
  Vorn::IO::PointFile const file =
      Vorn::IO::ParsePoints(Vorn::IO::ReadTextFile(path, std::cin), path, {});
  Vorn::IO::FitChoice choice;
  choice.tolerance.same = tolerance;
  choice.strategy = Vorn::IO::Strategy::Mixed;
  std::size_t pieces = 0;
  double const seconds =
      LeastSeconds([&] { pieces = Vorn::IO::FitContour(file, choice, nullptr).pieces.size(); });
  std::printf("fit %.9g %zu\n", seconds, pieces);
}

void Report(char const* name, double seconds, double check) {
  std::printf("%s %.4f %.17g\n", name, seconds / static_cast<double>(kElements) * 1e9, check);
}

void TimeDeviations(std::vector<double> const& numbers) {
  std::vector<double> answers(kElements);
  double const seconds = LeastSeconds([&] {
    for (std::size_t i = 0; i < kElements; ++i) {
      GeometryUtils::GetDeviation(0.6, 0.8, -1.0, numbers[2 * i], numbers[2 * i + 1], &answers[i]);
    }
  });
  Report("line_deviations", seconds, answers.back());
}

void TimeIntersections(std::vector<double> const& numbers) {
  std::vector<double> answers(2 * kElements);
  double const seconds = LeastSeconds([&] {
    for (std::size_t i = 0; i < kElements; ++i) {
      double const* const s = &numbers[4 * i];
      GeometryUtils::GetLineSegmentsIntersection(0.0, 0.0, 1.0, 1.0, s[0], s[1], s[2], s[3],
                                                 &answers[2 * i], &answers[2 * i + 1]);
    }
  });
  Report("line_segments_intersections", seconds, answers.back());
}

void TimeArea(std::vector<double> const& numbers) {
  std::vector<double> ring(numbers.begin(), numbers.begin() + 2 * kElements);
  ring.insert(ring.end(), numbers.begin(), numbers.begin() + 2);
  std::vector<std::int32_t> const indices = {static_cast<std::int32_t>(2 * kElements)};
  double area = 0.0;
  double const seconds = LeastSeconds([&] { GeometryUtils::GetArea(ring, indices, &area); });
  Report("polygon_areas", seconds, area);
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 3) {
    std::fprintf(stderr, "usage: python_benchmark POINTS.csv TOLERANCE\n");
    return 2;
  }
  TimeFit(argv[1], std::atof(argv[2]));
  std::vector<double> numbers(4 * kElements);
  for (std::size_t i = 0; i < numbers.size(); ++i) numbers[i] = Sample(i);
  TimeDeviations(numbers);
  TimeIntersections(numbers);
  TimeArea(numbers);
}
