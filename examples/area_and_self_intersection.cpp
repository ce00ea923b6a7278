// Area and self-intersection, of contours and of flat coordinate arrays.

#include <cstdint>
#include <cstdio>
#include <vector>

#include "vorn/GeometryUtils.h"

using Vorn::GeometryUtils;

namespace {

using Contour = std::vector<GeometryUtils::Elem>;

void Report(char const* name, Contour const& contour) {
  double area = 0.0;
  switch (GeometryUtils::GetArea(contour, &area)) {
    case Vorn::ErrorCode::Ok:
      std::printf("%-32s area %+.4f (%s)\n", name, area,
                  area > 0.0 ? "clockwise" : "counter-clockwise");
      break;
    case Vorn::ErrorCode::SelfIntersection:
      std::printf("%-32s crosses itself\n", name);
      break;
    default:
      std::printf("%-32s is no contour\n", name);
  }
}

// The first segment only places the start; the last one ends on it and closes the contour.
Contour Polygon(std::vector<GeometryUtils::Point> const& corners) {
  Contour contour;
  for (GeometryUtils::Point const& corner : corners) GeometryUtils::AddSegm(&contour, corner);
  GeometryUtils::AddSegm(&contour, corners.front());
  return contour;
}

// A slot: two straight sides of length 4 joined by half circles of radius 1.
Contour Slot() {
  Contour contour;
  GeometryUtils::AddSegm(&contour, {0.0, 0.0});
  GeometryUtils::AddSegm(&contour, {4.0, 0.0});
  GeometryUtils::AddArc(&contour, {4.0, 0.0}, {4.0, 2.0}, {4.0, 1.0}, 1.0, false);
  GeometryUtils::AddSegm(&contour, {0.0, 2.0});
  GeometryUtils::AddArc(&contour, {0.0, 2.0}, {0.0, 0.0}, {0.0, 1.0}, 1.0, false);
  return contour;
}

}  // namespace

int main() {
  // Clockwise contours have a positive area in a frame whose y axis points up.
  Report("rectangle, counter-clockwise", Polygon({{0.0, 0.0}, {3.0, 0.0}, {3.0, 2.0}, {0.0, 2.0}}));
  Report("rectangle, clockwise", Polygon({{0.0, 0.0}, {0.0, 2.0}, {3.0, 2.0}, {3.0, 0.0}}));
  Report("slot (8 + pi)", Slot());
  Report("figure eight", Polygon({{0.0, 0.0}, {2.0, 2.0}, {2.0, 0.0}, {0.0, 2.0}}));
  Report("a single segment", {GeometryUtils::Elem(), GeometryUtils::Elem()});

  // The flat form: coordinates, and one index entry per run with the offset of its last vertex.
  std::vector<double> coords = {0.0, 0.0, 3.0, 0.0, 3.0, 2.0, 0.0, 2.0, 0.0, 0.0};
  std::vector<std::int32_t> const closed = {8};
  double area = 0.0;
  if (GeometryUtils::GetArea(coords, closed, &area) != Vorn::ErrorCode::Ok) return 1;
  std::printf("%-32s area %+.4f\n", "flat rectangle", area);

  // An open run of plain vertices, which must not touch itself.
  std::vector<std::int32_t> const open = {6};
  bool found = true;
  if (GeometryUtils::CheckPolySelfIntersection(coords, open, &found) != Vorn::ErrorCode::Ok) {
    return 1;
  }
  std::printf("%-32s %s\n", "its first three sides", found ? "cross" : "do not cross");
  return 0;
}
