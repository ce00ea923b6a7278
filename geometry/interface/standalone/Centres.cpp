// Standalone member: no other operation of the library uses it. A centre of a cell that is equally
// far from two points.

#include "geometry/cells/Centres.h"

#include <optional>
#include <vector>

#include "geometry/cells/Bounds.h"
#include "geometry/elementary/ImplicitLine.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

bool GeometryUtils::GetCenterForCircle(Point const& p1, Point const& p2,
                                       std::vector<Triangle> const* cell, Point* center) {
  std::optional<Elementary::ImplicitLine> const bisector =
      Elementary::PerpendicularBisector(p1, p2);
  std::optional<Cells::Rect> const rect = Cells::BoundingRect(*cell);
  if (!bisector || !rect) return false;
  std::optional<Triangle> const chord = Cells::ChordAcross(*rect, *bisector);
  if (!chord) return false;
  std::optional<Point> const found = Cells::PlainCell{*cell}.CentreOfOverlapWith(*chord);
  if (found) *center = *found;
  return found.has_value();
}

}  // namespace Vorn
