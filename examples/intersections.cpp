// Where straight lines meet, how far points lie from them, and circles through measured points.

#include <cstdio>

#include "vorn/GeometryUtils.h"
#include "vorn/MathUtils.h"

using Vorn::GeometryUtils;
using Vorn::MathUtils;
using Vorn::SegmentsRelPosition;

namespace {

struct Segment {
  double x1, y1, x2, y2;
};

void Meet(char const* name, Segment const& a, Segment const& b) {
  double x = 0.0;
  double y = 0.0;
  switch (GeometryUtils::GetLineSegmentsIntersection(a.x1, a.y1, a.x2, a.y2, b.x1, b.y1, b.x2, b.y2,
                                                     &x, &y)) {
    case SegmentsRelPosition::Intersecting:
      std::printf("%-18s meet at (%.2f, %.2f)\n", name, x, y);
      break;
    case SegmentsRelPosition::Collinear:
      std::printf("%-18s overlap around (%.2f, %.2f)\n", name, x, y);
      break;
    case SegmentsRelPosition::Parallel:
      std::printf("%-18s are parallel\n", name);
      break;
    case SegmentsRelPosition::Disjoint:
      std::printf("%-18s have no common point\n", name);
      break;
  }
}

}  // namespace

int main() {
  Meet("crossing", {0.0, 0.0, 2.0, 2.0}, {0.0, 2.0, 2.0, 0.0});
  Meet("sharing an end", {0.0, 0.0, 1.0, 0.0}, {1.0, 0.0, 2.0, 5.0});
  Meet("overlapping", {0.0, 0.0, 2.0, 0.0}, {1.0, 0.0, 3.0, 0.0});
  Meet("side by side", {0.0, 0.0, 2.0, 2.0}, {0.0, 1.0, 1.0, 2.0});
  Meet("far apart", {0.0, 0.0, 1.0, 1.0}, {2.0, 2.0, 3.0, 3.0});

  // Endless lines in slope form: y = x and y = 2 - x.
  double x = 0.0;
  double y = 0.0;
  if (!MathUtils::GetLinesIntersection(1.0, 0.0, -1.0, 2.0, x, y)) return 1;
  std::printf("lines meet at (%.2f, %.2f)\n", x, y);

  // Distance of (3, 1) from the line x + y - 2 = 0; positive means away from the origin.
  double distance = 0.0;
  if (!GeometryUtils::GetSignedDeviation(1.0, 1.0, -2.0, 3.0, 1.0, &distance)) return 1;
  std::printf("point lies %+.4f from the line\n", distance);

  // The circle through three measured points grows by their common tolerance. The three moved
  // points are read for the turning sense then, so they are preloaded with the measured ones.
  Vorn::WPoint const a = {5.0, 0.0, 0.5};
  Vorn::WPoint const b = {0.0, 5.0, 0.5};
  Vorn::WPoint const c = {-5.0, 0.0, 0.5};
  GeometryUtils::Point pa = {a.x, a.y};
  GeometryUtils::Point pb = {b.x, b.y};
  GeometryUtils::Point pc = {c.x, c.y};
  Vorn::WPoint circle;
  bool ccw = false;
  if (!GeometryUtils::GetCircle(a, b, c, &circle, &pa, &pb, &pc, &ccw)) return 1;
  std::printf("circle of radius %.2f, %s\n", circle.w, ccw ? "counter-clockwise" : "clockwise");
  return 0;
}
