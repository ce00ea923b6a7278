// Members for the bounds and centres of cells.

#include "geometry/cells/Centres.h"

#include <optional>
#include <vector>

#include "geometry/cells/Bounds.h"
#include "geometry/cells/FixedPoints.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

bool GeometryUtils::GetBoundingRect(std::vector<Triangle> const* cell, double* rect) {
  std::optional<Cells::Rect> const found = Cells::BoundingRect(*cell);
  if (!found) return false;
  rect[0] = found->xMin;
  rect[1] = found->yMin;
  rect[2] = found->xMax;
  rect[3] = found->yMax;
  return true;
}

bool GeometryUtils::GetBoundingCircleAndLineIntersectionTriangle(std::vector<Triangle> const* cell,
                                                                 double a, double b, double c,
                                                                 Triangle* chord) {
  std::optional<Cells::Rect> const rect = Cells::BoundingRect(*cell);
  if (!rect) return false;
  std::optional<Triangle> const found = Cells::ChordAcross(*rect, {a, b, c});
  if (found) *chord = *found;
  return found.has_value();
}

bool GeometryUtils::GetCenter(std::vector<Triangle> const* cell, Point* center) {
  std::optional<Point> const found = Cells::CentreOf(*cell);
  if (found) *center = *found;
  return found.has_value();
}

bool GeometryUtils::GetCenterForLine(bool hasP1, Point const& p1, bool hasP2, Point const& p2,
                                     bool swapped, std::vector<Triangle> const* cell,
                                     Point* center) {
  std::optional<Point> const found =
      Cells::CentreForLine({hasP1, p1, hasP2, p2, swapped}, Cells::PlainCell{*cell});
  if (found) *center = *found;
  return found.has_value();
}

}  // namespace Vorn
