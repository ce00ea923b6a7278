// Memory runs out at every allocation of each operation that fills a list, in turn: std::bad_alloc
// comes out and the next call answers as ever. The whole fits are in AllocationTest.cpp.
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "determinism/Digest.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/FittingCalls.h"
#include "support/Profiles.h"
#include "support/RefusedAllocations.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Elem = GeometryUtils::Elem;
using IndexedPoint = GeometryUtils::IndexedPoint;
using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

/// An operation with its arguments, and what it answers as text.
struct Operation {
  char const* name;
  std::function<std::string()> call;
};

std::string TextOf(Digest const& digest) { return std::to_string(digest.Value()); }

std::vector<WPoint> NoisyLine() {
  return {{0, 0, 0.5}, {1, 0.25, 0.5}, {2, -0.25, 0.5}, {3, 0.125, 0.5}, {4, 0, 0.5}};
}

constexpr std::int32_t kArcPoints = 6;

std::vector<WPoint> SomeArc() { return MakeArcPoints({3, -2}, 25, 2, -2.5, kArcPoints, 0.05); }

LineFitInput LineRun() {
  LineFitInput in;
  in.points = NoisyLine();
  in.count = static_cast<std::int32_t>(in.points.size());
  return in;
}

ArcFitInput ArcOf(std::vector<WPoint> points) {
  ArcFitInput in;
  in.points = std::move(points);
  in.maxCount = static_cast<std::int32_t>(in.points.size());
  in.minCount = 3;
  return in;
}

std::string Arcs() {
  std::vector<Elem> contour;
  GeometryUtils::AddSegm(&contour, {1, 0});
  GeometryUtils::AddArc(&contour, {1, 0}, {0, 1}, {0, 0}, 1, false);
  GeometryUtils::ReplaceElem(&contour, contour.back());
  Digest digest;
  digest.Add(contour);
  return TextOf(digest);
}

std::string FlatArea() {
  double area = 0.0;
  Digest digest;
  digest.Add(GeometryUtils::GetArea({0, 0, 4, 0, 4, 3}, {6}, &area));
  digest.Add(area);
  return TextOf(digest);
}

std::string CircleTriangles() {
  std::vector<Triangle> cell;
  Digest digest;
  digest.Add(GeometryUtils::GetCircleTriangles({-5, 0, 0.1}, {0, 5, 0.1}, {5, 0, 0.1}, false, false,
                                               0, &cell));
  digest.Add(cell);
  return TextOf(digest);
}

std::string Crossings() {
  std::vector<GeometryUtils::CrossingPoint> points;
  std::vector<Point> ofOneSide;
  Triangle const first{{{0, 0}, {4, 0}, {0, 4}}};
  Triangle const second{{{1, -1}, {3, 3}, {-1, 2}}};
  GeometryUtils::GetCrossingPoints(first, second, &points);
  GeometryUtils::GetCrossingPoints(first, 0, second, &ofOneSide);
  return std::to_string(points.size()) + " " + std::to_string(ofOneSide.size());
}

std::string Division() {
  std::vector<Triangle> triangles;
  Digest digest;
  digest.Add(GeometryUtils::ConvexPolygonDivide({{0, 0}, {4, 0}, {5, 3}, {2, 5}, {-1, 3}}, 0, 5,
                                                &triangles));
  digest.Add(triangles);
  return TextOf(digest);
}

std::string LeastAndGreatest() {
  std::vector<std::int32_t> indices;
  Digest digest;
  digest.Add(
      GeometryUtils::GetDeviationFromLineParameters({0, 0}, {4, 0.1}, NoisyLine(), 0, 5, &indices));
  digest.Add(indices);
  return TextOf(digest);
}

std::string CurveOfDeviations() {
  std::vector<WPoint2> curve;
  bool const isOk =
      GeometryUtils::CalcDeviationCurve(SomeArc(), 0, kArcPoints, {3, -2}, 25, &curve);
  return std::to_string(isOk) + " " + std::to_string(curve.size());
}

std::string Thinning() {
  std::vector<WPoint> const points = SomeArc();
  std::vector<IndexedPoint> samples;
  for (std::int32_t i = 0; i < kArcPoints; ++i) {
    WPoint const& p = points[static_cast<std::size_t>(i)];
    samples.push_back({{p.x, p.y}, p.w, i});
  }
  std::vector<Triangle> cell(2, Triangle{{{2.9, -2.1}, {3.1, -2.1}, {3, -1.9}}});
  Point first{};
  Point last{};
  ErrorCode const code = GeometryUtils::ReduceCircleArcPoints(
      &samples, &cell, 3, false, &first, false, &last, points, 0, kArcPoints, false);
  return std::to_string(static_cast<int>(code)) + " " + std::to_string(samples.size());
}

std::string Estimate() {
  Point centre{};
  double radius = 0.0;
  double tolerance = 0.5;
  std::vector<std::int32_t> excluded;
  Digest digest;
  digest.Add(GeometryUtils::GetEstimatedDeviationForCircle(SomeArc(), &tolerance, &excluded,
                                                           &centre, &radius));
  digest.Add(excluded, radius, tolerance);
  return TextOf(digest);
}

Operation const kOperations[] = {
    {"Arcs", Arcs},
    {"FlatArea", FlatArea},
    {"CircleTriangles", CircleTriangles},
    {"Crossings", Crossings},
    {"Division", Division},
    {"LineRun", [] { return Transcribe(FitLine<GeometryUtils>(LineRun())); }},
    {"LeastAndGreatest", LeastAndGreatest},
    {"ArcRun", [] { return Transcribe(FitArcRun<GeometryUtils>(ArcOf(SomeArc()))); }},
    {"LongestArc", [] { return Transcribe(GrowArc<GeometryUtils>(ArcOf(SomeArc()))); }},
    {"CurveOfDeviations", CurveOfDeviations},
    {"Thinning", Thinning},
    {"Estimate", Estimate},
};

void PrintTo(Operation const& operation, std::ostream* out) { *out << operation.name; }

class StepWithoutMemory : public testing::TestWithParam<Operation> {};

TEST_P(StepWithoutMemory, ThrowsAndAnswersAsEverAfterwards) {
  std::string const expected = GetParam().call();
  std::string found;
  int const count =
      RefuseEachAllocation([&] { found = GetParam().call(); }, [&] { EXPECT_EQ(found, ""); });
  EXPECT_GT(count, 0);
  EXPECT_EQ(found, expected);
}

INSTANTIATE_TEST_SUITE_P(Operations, StepWithoutMemory, testing::ValuesIn(kOperations),
                         [](auto const& operation) { return std::string(operation.param.name); });

}  // namespace
}  // namespace Vorn::Testing
