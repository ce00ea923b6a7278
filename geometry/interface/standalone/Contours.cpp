// Standalone members: no other operation of the library uses them. Steps of the walk over a
// contour, on iterators; Walk has the same on pointers.

#include "geometry/contours/Elements.h"
#include "geometry/contours/Walk.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

ErrorCode GeometryUtils::GetElemPoint(std::vector<Elem>::const_iterator& it,
                                      Point2D<double>* point) {
  if (!Contours::IsKnown(*it)) return ErrorCode::Failed;
  *point = {it->end.x, it->end.y};
  return ErrorCode::Ok;
}

ErrorCode GeometryUtils::CheckLength(std::vector<Elem>::const_iterator& prev,
                                     std::vector<Elem>::const_iterator& elem, bool* zeroLength) {
  if (!Contours::IsKnown(*prev) || !Contours::IsKnown(*elem)) return ErrorCode::Failed;
  *zeroLength = Contours::IsSamePlace(prev->end, elem->end);
  return ErrorCode::Ok;
}

ErrorCode GeometryUtils::GetNextIter(std::vector<Elem> const& contour,
                                     std::vector<Elem>::const_iterator& it,
                                     std::vector<Elem>::const_iterator* next) {
  if (it == contour.end()) return ErrorCode::Failed;
  Elem const* const found = Contours::Walk(contour).Next(&*it);
  if (found == nullptr) return ErrorCode::Failed;
  *next = contour.begin() + (found - contour.data());
  return ErrorCode::Ok;
}

}  // namespace Vorn
