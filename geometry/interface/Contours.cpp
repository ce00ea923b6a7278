// Members for contours: building and editing at the end, single elements, area, self-intersection.

#include <optional>

#include "geometry/contours/Area.h"
#include "geometry/contours/Elements.h"
#include "geometry/contours/SelfIntersection.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

bool GeometryUtils::AddSegm(std::vector<Elem>* contour, Point end) {
  contour->push_back(Contours::SegmentTo(end));
  return true;
}

bool GeometryUtils::AddArc(std::vector<Elem>* contour, Point const& start, Point const& end,
                           Point const& center, double radius, bool clockwise) {
  contour->push_back(Contours::ArcElement({start, end, center, radius, clockwise}));
  return true;
}

bool GeometryUtils::RemoveElem(std::vector<Elem>* contour, Elem* removed) {
  if (contour->empty()) return false;
  *removed = contour->back();
  contour->pop_back();
  return true;
}

bool GeometryUtils::ReplaceElem(std::vector<Elem>* contour, Elem const& elem) {
  if (contour->empty() || !Contours::IsKnown(elem)) return false;
  if (Contours::IsSegment(elem)) {
    contour->back() = Contours::SegmentTo(elem.end);
    return true;
  }
  if (contour->size() < 2) return false;
  Elem const& before = *(contour->end() - 2);
  if (!Contours::IsKnown(before)) return false;
  contour->back() =
      Contours::ArcElement({before.end, elem.end, elem.center, elem.radius, elem.direction < 0.0});
  return true;
}

bool GeometryUtils::GetElemPoint(std::vector<Elem>* contour, Point* point) {
  if (contour->empty() || !Contours::IsKnown(contour->back())) return false;
  *point = contour->back().end;
  return true;
}

bool GeometryUtils::ShiftElem(Elem const& elem, Point2D<double> const& shift, Elem* shifted) {
  if (!Contours::IsKnown(elem)) return false;
  *shifted = Contours::Moved(elem, {shift.x, shift.y});
  return true;
}

bool GeometryUtils::SplitElem(Elem const& elem, int parts, Point2D<double> const& start,
                              Elem* pieces) {
  if (parts < 2 || !Contours::IsKnown(elem)) return false;
  Contours::Split(elem, parts, {start.x, start.y}, pieces);
  return true;
}

void GeometryUtils::DeleteFittingCurve(std::vector<Elem>* contour) { contour->clear(); }

ErrorCode GeometryUtils::CheckPolySelfIntersection(std::vector<Elem> const& contour) {
  return Contours::CheckContour(contour, Contours::kPlainSize);
}

ErrorCode GeometryUtils::GetArea(std::vector<Elem> const& contour, double* area) {
  ErrorCode const check = Contours::CheckContour(contour, Contours::kPlainSize);
  if (check != ErrorCode::Ok) return check;
  // The check walks up to an element of an unknown kind and may end there without complaint.
  std::optional<double> const signedArea = Contours::SignedArea(contour);
  if (!signedArea || area == nullptr) return ErrorCode::Failed;
  *area = *signedArea;
  return ErrorCode::Ok;
}

}  // namespace Vorn
