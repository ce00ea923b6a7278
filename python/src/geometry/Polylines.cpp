#include "../Errors.h"
#include "../Numbers.h"
#include "Values.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

using Indices = std::vector<std::int32_t>;

std::vector<double> VectorOf(Numbers const& coords) {
  return {coords.data(), coords.data() + coords.size()};
}

bool ContourMeetsItself(Elems const& contour) {
  ErrorCode const code = GeometryUtils::CheckPolySelfIntersection(contour);
  if (code == ErrorCode::SelfIntersection) return true;
  RequireOk(code, "check_poly_self_intersection");
  return false;
}

bool PolylineMeetsItself(Numbers const& coords, Indices const& indices) {
  std::vector<double> vertices = VectorOf(coords);
  bool found = false;
  RequireOk(GeometryUtils::CheckPolySelfIntersection(vertices, indices, &found),
            "check_poly_self_intersection");
  return found;
}

double AreaOfContour(Elems const& contour) {
  double area = 0.0;
  RequireOk(GeometryUtils::GetArea(contour, &area), "get_area");
  return area;
}

double AreaOfPolyline(Numbers const& coords, Indices const& indices) {
  double area = 0.0;
  RequireOk(GeometryUtils::GetArea(VectorOf(coords), indices, &area), "get_area");
  return area;
}

}  // namespace

void BindPolylines(py::module_& module) {
  module.def("check_poly_self_intersection", &ContourMeetsItself, py::arg("contour"), R"(
Whether a contour crosses or touches itself. Raises ContourError where that cannot be told.

>>> tie = [Elem.segment(p) for p in [(0, 0), (2, 2), (2, 0), (0, 2), (0, 0)]]
>>> check_poly_self_intersection(tie)
True
)");
  module.def("check_poly_self_intersection", &PolylineMeetsItself, py::arg("coords"),
             py::arg("indices"), R"(
Whether a flat polyline crosses or touches itself.

Each entry e of indices is one run: abs(e) is the offset in coords of the x of the last vertex of the
run; e >= 1 means plain vertices x, y, else records of eight numbers.

>>> check_poly_self_intersection([0, 0, 1, 0, 1, 1], [4])
False
)");
  module.def("get_area", &AreaOfContour, py::arg("contour"), R"(
Signed area of a contour, positive when it runs clockwise with the y axis pointing up.

Raises SelfIntersectionError when it crosses itself, ContourError when it is empty.

>>> get_area([Elem.segment(p) for p in [(0, 0), (0, 2), (3, 2), (3, 0), (0, 0)]])
6.0
)");
  module.def("get_area", &AreaOfPolyline, py::arg("coords"), py::arg("indices"), R"(
Signed area of a flat polyline, laid out as for check_poly_self_intersection. Batch form:
polygon_areas.

>>> get_area([0, 0, 0, 2, 3, 2, 3, 0, 0, 0], [8])
6.0
)");
}

}  // namespace Vorn::Python
