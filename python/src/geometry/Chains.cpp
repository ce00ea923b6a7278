#include <utility>

#include "../Errors.h"
#include "Values.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

Elems AddSegm(Elems contour, Place const& end) {
  RequireSuccess(GeometryUtils::AddSegm(&contour, PointOf(end)), "add_segm");
  return contour;
}

/// The circle of an arc that is added.
using Circle = std::pair<Place, double>;

Elems AddArc(Elems contour, std::pair<Place, Place> const& ends, Circle const& circle,
             bool clockwise) {
  RequireSuccess(GeometryUtils::AddArc(&contour, PointOf(ends.first), PointOf(ends.second),
                                       PointOf(circle.first), circle.second, clockwise),
                 "add_arc");
  return contour;
}

std::pair<Elems, Elem> RemoveElem(Elems contour) {
  Elem removed;
  RequireSuccess(GeometryUtils::RemoveElem(&contour, &removed), "remove_elem");
  return {std::move(contour), removed};
}

Elems ReplaceElem(Elems contour, Elem const& elem) {
  RequireSuccess(GeometryUtils::ReplaceElem(&contour, elem), "replace_elem");
  return contour;
}

Place GetElemPoint(Elems contour) {
  GeometryUtils::Point point;
  RequireSuccess(GeometryUtils::GetElemPoint(&contour, &point), "get_elem_point");
  return PlaceOf(point);
}

Elem ShiftElem(Elem const& elem, Place const& shift) {
  Elem shifted;
  RequireSuccess(GeometryUtils::ShiftElem(elem, {shift.first, shift.second}, &shifted),
                 "shift_elem");
  return shifted;
}

Elems SplitElem(Elem const& elem, int parts, Place const& start) {
  if (parts < 2) RequireSuccess(false, "split_elem");
  Elems pieces(static_cast<std::size_t>(parts));
  RequireSuccess(GeometryUtils::SplitElem(elem, parts, {start.first, start.second}, pieces.data()),
                 "split_elem");
  return pieces;
}

Elems DeleteFittingCurve(Elems contour) {
  GeometryUtils::DeleteFittingCurve(&contour);
  return contour;
}

void BindGrowing(py::module_& module) {
  module.def("add_segm", &AddSegm, py::arg("contour"), py::arg("end"), R"(
The contour with a segment behind it; of an empty contour this is its start.

>>> add_segm(add_segm([], (0, 0)), (1, 0))
[Elem.segment((0.0, 0.0)), Elem.segment((1.0, 0.0))]
)");
  module.def("add_arc", &AddArc, py::arg("contour"), py::arg("ends"), py::arg("circle"),
             py::arg("clockwise"), R"(
The contour with an arc behind it; ends are its start and end, the circle is (center, radius).

>>> add_arc([Elem.segment((1, 0))], ((1, 0), (-1, 0)), ((0, 0), 1.0), clockwise=True)[1].direction
-1.0
)");
  module.def("remove_elem", &RemoveElem, py::arg("contour"), R"(
The contour without its last element, and that element. Raises ContourError for an empty contour.

>>> remove_elem([Elem.segment((0, 0)), Elem.segment((1, 0))])
([Elem.segment((0.0, 0.0))], Elem.segment((1.0, 0.0)))
)");
  module.def("replace_elem", &ReplaceElem, py::arg("contour"), py::arg("elem"), R"(
The contour with another last element; the angles of an arc follow from the element before.

Raises ContourError for an empty contour, and for an arc with no element before it.

>>> replace_elem([Elem.segment((0, 0)), Elem.segment((1, 0))], Elem.segment((2, 0)))[-1]
Elem.segment((2.0, 0.0))
)");
  module.def("delete_fitting_curve", &DeleteFittingCurve, py::arg("contour"), R"(
The contour without its elements.

>>> delete_fitting_curve([Elem.segment((0, 0))])
[]
)");
}

}  // namespace

void BindChains(py::module_& module) {
  BindGrowing(module);
  module.def("get_elem_point", &GetElemPoint, py::arg("contour"), R"(
Where the contour ends. Raises ContourError for an empty contour.

>>> get_elem_point([Elem.segment((3, 4))])
(3.0, 4.0)
)");
  module.def("shift_elem", &ShiftElem, py::arg("elem"), py::arg("shift"), R"(
The element moved by a vector.

>>> shift_elem(Elem.segment((3, 4)), (1, 1)).end
(4.0, 5.0)
)");
  module.def("split_elem", &SplitElem, py::arg("elem"), py::arg("parts"), py::arg("start"), R"(
The element cut into parts of equal length; start is that of a segment.

Raises ContourError for less than two parts.

>>> split_elem(Elem.segment((4, 0)), 2, (0, 0))
[Elem.segment((2.0, 0.0)), Elem.segment((4.0, 0.0))]
)");
}

}  // namespace Vorn::Python
