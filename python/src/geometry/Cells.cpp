#include <optional>

#include "../Errors.h"
#include "Values.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

using Places = std::vector<Place>;

Places PlacesOf(Point2D<double> const* points, std::size_t count) {
  Places places;
  for (std::size_t i = 0; i < count; ++i) places.emplace_back(points[i].x, points[i].y);
  return places;
}

Places PermissibleRect(Triple const& a, Triple const& b) {
  double rect[8] = {};
  RequireSuccess(GeometryUtils::GetPermissibleRect(WPointOf(a), WPointOf(b), rect),
                 "get_permissible_rect");
  Places places;
  for (double const* corner = rect; corner != rect + 8; corner += 2) {
    places.emplace_back(corner[0], corner[1]);
  }
  return places;
}

std::pair<Places, bool> LinePolygon(Triple const& a, Triple const& b,
                                    std::optional<bool> const& form) {
  bool formFixed = form.has_value();
  bool xOfY = form.value_or(false);
  Point2D<double> polygon[4];
  RequireOk(GeometryUtils::GetLinePolygon(WPointOf(a), WPointOf(b), &formFixed, &xOfY, polygon),
            "get_line_polygon");
  return {PlacesOf(polygon, 4), xOfY};
}

Places CirclePolygon(std::array<Triple, 3> const& points, bool firstFixed, bool lastFixed,
                     int orientation) {
  int count = 0;
  Point2D<double> vertices[6];
  RequireOk(
      GeometryUtils::GetCirclePolygon(WPointOf(points[0]), WPointOf(points[1]), WPointOf(points[2]),
                                      firstFixed, lastFixed, orientation, &count, vertices),
      "get_circle_polygon");
  return PlacesOf(vertices, static_cast<std::size_t>(count));
}

}  // namespace

void BindCells(py::module_& module) {
  module.def("get_permissible_rect", &PermissibleRect, py::arg("a"), py::arg("b"), R"(
The four places where the crossing common tangents touch the tolerance circles of two measured
points (x, y, tolerance): two on the circle of b, then two on that of a.

Raises ContourError when the circles overlap.

>>> len(get_permissible_rect((0, 0, 0.1), (1, 0, 0.1)))
4
)");
  module.def("get_line_polygon", &LinePolygon, py::arg("a"), py::arg("b"),
             py::arg("x_of_y") = py::none(), R"(
The lines that pass between two measured points (x, y, tolerance), as a quadrilateral in the plane of
line parameters.

A vertex (u, v) is the line v*x + y + u = 0, or v*y + x + u = 0 where x_of_y. Answers (vertices,
x_of_y); without x_of_y the form is chosen. Raises ContourError when the circles overlap or the form
cannot hold the lines.

>>> get_line_polygon((0, 0, 0.1), (1, 0, 0.1))[1]
False
)");
  module.def("get_circle_polygon", &CirclePolygon, py::arg("points"),
             py::arg("first_fixed") = false, py::arg("last_fixed") = false,
             py::arg("orientation") = 0, R"(
The centers of the circles that pass three measured points (x, y, tolerance) within their tolerances,
as the vertices of a polygon.

A fixed end is passed exactly. The orientation wanted is +1 clockwise, -1 counter-clockwise, 0 any.
Raises ContourError when the points are collinear or do not turn one way.

>>> len(get_circle_polygon([(1, 0, 0.01), (0, 1, 0.01), (-1, 0, 0.01)]))
6
)");
}

}  // namespace Vorn::Python
