// Elementary intersections of random pairs. Each repetition answers a whole batch of them, so that
// the processor cannot predict the branches from one pair.

#include <benchmark/benchmark.h>

#include <array>
#include <cmath>
#include <cstdint>
#include <random>
#include <utility>

#include "benchmarks/Measure.h"
#include "benchmarks/Registration.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Benchmarks {
namespace {

constexpr std::size_t kPairs = 1024;

struct Segment {
  double x1, y1, x2, y2;
};

struct Circle {
  double x, y, r;
};

struct Arc {
  Circle circle;
  double direction, startAngle, endAngle;
};

/// Shapes whose size is like that of the square in which they lie, so that some of the pairs meet.
class RandomShapes {
 public:
  Segment MakeSegment() { return {Coordinate(), Coordinate(), Coordinate(), Coordinate()}; }

  Circle MakeCircle() {
    return {Coordinate(), Coordinate(), Uniform(kSmallestRadius, kLargestRadius)};
  }

  Arc MakeArc() {
    Circle const circle = MakeCircle();
    double const direction = Uniform(-1.0, 1.0) < 0.0 ? -1.0 : 1.0;
    return {circle, direction, Angle(), Angle()};
  }

  /// All but the smallest gap of a circle.
  Arc MakeFullTurn() {
    double const almostHalfTurn = std::nextafter(std::acos(-1.0), 0.0);
    return {MakeCircle(), 1.0, -almostHalfTurn, almostHalfTurn};
  }

 private:
  static constexpr std::uint64_t kSeed = 11;
  static constexpr double kHalfWidth = 10.0;
  static constexpr double kSmallestRadius = 1.0;
  static constexpr double kLargestRadius = 8.0;
  static constexpr double kLargestAngle = 3.14;

  double Uniform(double from, double to) {
    return std::uniform_real_distribution<double>(from, to)(random_);
  }
  double Coordinate() { return Uniform(-kHalfWidth, kHalfWidth); }
  double Angle() { return Uniform(-kLargestAngle, kLargestAngle); }

  std::mt19937_64 random_{kSeed};
};

struct Output {
  double ax = 0.0, ay = 0.0, bx = 0.0, by = 0.0;
};

template <typename First, typename Second, typename Cut>
void Register(char const* name, First (RandomShapes::*makeFirst)(),
              Second (RandomShapes::*makeSecond)(), Cut cut) {
  auto const body = [=](benchmark::State& state) {
    RandomShapes shapes;
    std::array<std::pair<First, Second>, kPairs> pairs;
    for (auto& [first, second] : pairs) {
      first = (shapes.*makeFirst)();
      second = (shapes.*makeSecond)();
    }
    std::size_t hits = 0;
    for (auto _ : state) {
      hits = 0;
      for (auto const& [first, second] : pairs) {
        Output out;
        if (cut(first, second, &out)) ++hits;
        benchmark::DoNotOptimize(out);
      }
    }
    CountTimePer(&state, "seconds_per_call", kPairs);
    state.counters["share_that_meets"] = static_cast<double>(hits) / kPairs;
  };
  benchmark::RegisterBenchmark(name, body)->Repetitions(kRepetitionsOfShortCalls);
}

bool CutSegments(Segment const& a, Segment const& b, Output* out) {
  return GeometryUtils::GetLineSegmentsIntersection(a.x1, a.y1, a.x2, a.y2, b.x1, b.y1, b.x2, b.y2,
                                                    &out->ax,
                                                    &out->ay) == SegmentsRelPosition::Intersecting;
}

bool TestSegments(Segment const& a, Segment const& b, Output*) {
  return GeometryUtils::AreLineSegmentsIntersect(a.x1, a.y1, a.x2, a.y2, b.x1, b.y1, b.x2, b.y2);
}

bool CutSegmentAndCircle(Segment const& s, Circle const& c, Output* out) {
  return GeometryUtils::GetLineSegmentAndCircleIntersection(
             s.x1, s.y1, s.x2, s.y2, c.x, c.y, c.r, &out->ax, &out->ay, &out->bx, &out->by) > 0;
}

bool CutSegmentAndArc(Segment const& s, Arc const& a, Output* out) {
  return GeometryUtils::GetLineSegmentAndCircleArcIntersection(
             s.x1, s.y1, s.x2, s.y2, a.circle.x, a.circle.y, a.circle.r, a.direction, a.startAngle,
             a.endAngle, &out->ax, &out->ay, &out->bx, &out->by) > 0;
}

bool CutArcs(Arc const& a, Arc const& b, Output* out) {
  return GeometryUtils::GetCircleArcAndCircleArcIntersection(
             a.circle.x, a.circle.y, a.circle.r, a.direction, a.startAngle, a.endAngle, b.circle.x,
             b.circle.y, b.circle.r, b.direction, b.startAngle, b.endAngle, &out->ax, &out->ay,
             &out->bx, &out->by) > 0;
}

}  // namespace

void RegisterIntersections() {
  using Shapes = RandomShapes;
  Register("BM_GetLineSegmentsIntersection/random_pairs", &Shapes::MakeSegment,
           &Shapes::MakeSegment, CutSegments);
  Register("BM_AreLineSegmentsIntersect/random_pairs", &Shapes::MakeSegment, &Shapes::MakeSegment,
           TestSegments);
  Register("BM_GetLineSegmentAndCircleIntersection/random_pairs", &Shapes::MakeSegment,
           &Shapes::MakeCircle, CutSegmentAndCircle);
  // No member cuts two circles alone: two arcs that go all the way round stand for them.
  Register("BM_GetCircleArcAndCircleArcIntersection/full_circles", &Shapes::MakeFullTurn,
           &Shapes::MakeFullTurn, CutArcs);
  Register("BM_GetLineSegmentAndCircleArcIntersection/random_pairs", &Shapes::MakeSegment,
           &Shapes::MakeArc, CutSegmentAndArc);
  Register("BM_GetCircleArcAndCircleArcIntersection/random_pairs", &Shapes::MakeArc,
           &Shapes::MakeArc, CutArcs);
}

}  // namespace Vorn::Benchmarks
