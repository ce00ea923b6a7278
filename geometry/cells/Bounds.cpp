#include "geometry/cells/Bounds.h"

#include "geometry/intersections/Circles.h"

namespace Vorn::Cells {

std::optional<Rect> BoundingRect(std::span<Triangle const> cell) {
  if (cell.empty()) return std::nullopt;
  Rect rect = Rect::Around(cell.front().pts[0]);
  for (Triangle const& triangle : cell) rect.Include(triangle);
  return rect;
}

std::optional<Triangle> ChordAcross(Rect const& rect, Elementary::ImplicitLine const& line) {
  Point const corner{rect.xMin, rect.yMin};
  Point const middle = Elementary::Middle(corner, {rect.xMax, rect.yMax});
  double const radius = Elementary::Distance(corner, middle);
  Intersections::CirclePoints const found = Intersections::CutCircleByLine({middle, radius}, line);
  if (found.count == 0) return std::nullopt;
  Point const& p1 = found.pts[0];
  Point const& p2 = found.pts[found.count - 1];
  return Triangle{{p1, p2, p2}};
}

}  // namespace Vorn::Cells
