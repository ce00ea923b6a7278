#include <pybind11/numpy.h>

#include <algorithm>
#include <optional>
#include <tuple>

#include "../Errors.h"
#include "../Numbers.h"
#include "Values.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

double Deviation(double a, double b, double c, double x, double y) {
  double deviation = 0.0;
  RequireSuccess(GeometryUtils::GetDeviation(a, b, c, x, y, &deviation), "get_deviation");
  return deviation;
}

double DeviationOfThird(std::array<double, 6> const& coords) {
  double deviation = 0.0;
  RequireSuccess(GeometryUtils::GetDeviation(coords.data(), &deviation), "get_deviation");
  return deviation;
}

double SignedDeviation(double a, double b, double c, double x, double y) {
  double deviation = 0.0;
  RequireSuccess(GeometryUtils::GetSignedDeviation(a, b, c, x, y, &deviation),
                 "get_signed_deviation");
  return deviation;
}

bool IsValidToFit(Triple const& a, Triple const& b) {
  return GeometryUtils::IsPointValidToFit(WPointOf(a), WPointOf(b));
}

/// The moved points are preloaded with the measured ones, which the case of equal tolerances reads.
py::tuple Circle(Triple const& a, Triple const& b, Triple const& c) {
  WPoint circle;
  GeometryUtils::Point points[] = {{a[0], a[1]}, {b[0], b[1]}, {c[0], c[1]}};
  bool ccw = false;
  RequireSuccess(GeometryUtils::GetCircle(WPointOf(a), WPointOf(b), WPointOf(c), &circle,
                                          &points[0], &points[1], &points[2], &ccw),
                 "get_circle");
  return py::make_tuple(Place(circle.x, circle.y), circle.w,
                        py::make_tuple(PlaceOf(points[0]), PlaceOf(points[1]), PlaceOf(points[2])),
                        ccw);
}

using Segment = std::array<double, 4>;

std::pair<SegmentsRelPosition, std::optional<Place>> SegmentsIntersection(Segment const& first,
                                                                          Segment const& second) {
  Place at;
  SegmentsRelPosition const relation = GeometryUtils::GetLineSegmentsIntersection(
      first[0], first[1], first[2], first[3], second[0], second[1], second[2], second[3], &at.first,
      &at.second);
  bool const hasPlace =
      relation == SegmentsRelPosition::Intersecting || relation == SegmentsRelPosition::Collinear;
  return {relation, hasPlace ? std::optional(at) : std::nullopt};
}

void BindAngles(py::module_& module) {
  module.def(
      "get_natural_angle",
      [](Numbers const& dy, Numbers const& dx) {
        return py::vectorize(&GeometryUtils::GetNaturalAngle)(dy, dx);
      },
      py::arg("dy"), py::arg("dx"), R"(
Polar angle of a displacement in an image, whose y axis points down.

Takes numbers or arrays; answers radians in [-pi, pi].

>>> round(float(get_natural_angle(-1.0, 0.0)), 6)
1.570796
)");
  module.def(
      "natural_angle_to_azimuth_rad",
      [](Numbers const& angle) {
        return py::vectorize(&GeometryUtils::NaturalAngleToAzimuthRad)(angle);
      },
      py::arg("angle"), R"(
Azimuth, clockwise from the positive y axis, of a polar angle.

Takes numbers or arrays in radians; answers radians, pi / 2 - angle wrapped once.

>>> round(float(natural_angle_to_azimuth_rad(0.0)), 6)
1.570796
)");
  module.def(
      "natural_angle_to_tangential_azimuth_rad",
      [](Numbers const& angle, py::array_t<bool> const& flag) {
        return py::vectorize(&GeometryUtils::NaturalAngleToTangentialAzimuthRad)(angle, flag);
      },
      py::arg("angle"), py::arg("flag"), R"(
Azimuth of the tangent that belongs to a polar angle.

Takes numbers or arrays in radians; answers pi - angle where flag is true, else the angle negated
and wrapped once.

>>> round(float(natural_angle_to_tangential_azimuth_rad(1.0, True)), 6)
2.141593
)");
}

void BindDeviations(py::module_& module) {
  module.def("get_deviation", &Deviation, py::arg("a"), py::arg("b"), py::arg("c"), py::arg("x"),
             py::arg("y"), R"(
Distance of the point (x, y) from the line a*x + b*y + c = 0, which need not be normalised.

Raises ContourError when a and b are both zero. Batch form: line_deviations.

>>> get_deviation(3.0, 4.0, 0.0, 5.0, 0.0)
3.0
)");
  module.def("get_deviation", &DeviationOfThird, py::arg("coords"), R"(
Distance of a third point from the line through two others; coords are x1, y1, x2, y2, x3, y3.

Raises ContourError when the first two points coincide.

>>> get_deviation([0.0, 0.0, 2.0, 0.0, 1.0, 3.0])
3.0
)");
  module.def("get_signed_deviation", &SignedDeviation, py::arg("a"), py::arg("b"), py::arg("c"),
             py::arg("x"), py::arg("y"), R"(
Distance of the point (x, y) from a line, negative on the side of the origin.

Raises ContourError when a and b are both zero. Batch form: line_deviations with signed=True.

>>> get_signed_deviation(0.0, 1.0, -2.0, 7.0, 0.5)
-1.5
)");
  module.def("is_point_valid_to_fit", &IsValidToFit, py::arg("a"), py::arg("b"), R"(
Whether two measured points (x, y, tolerance) are far enough apart to be neighbours in a fit: by
more than 1.5 times the sum of their tolerances. Batch form: are_points_valid_to_fit.

>>> is_point_valid_to_fit((0, 0, 0.1), (1, 0, 0.1))
True
)");
}

}  // namespace

void BindElementary(py::module_& module) {
  BindAngles(module);
  BindDeviations(module);
  module.def("get_circle", &Circle, py::arg("a"), py::arg("b"), py::arg("c"), R"(
Circle through three measured points (x, y, tolerance), pushed outward by their tolerances.

Answers (center, radius, points, ccw): the center as (x, y), the three points as they were moved for
different tolerances, and whether they run counter-clockwise. Raises ContourError when the points
admit no circle.

>>> get_circle((3, 2, 0), (2, 3, 0), (1, 2, 0))
((2.0, 2.0), 1.0, ((3.0, 2.0), (2.0, 3.0), (1.0, 2.0)), True)
)");
  module.def("get_line_segments_intersection", &SegmentsIntersection, py::arg("first"),
             py::arg("second"), R"(
How two segments (x1, y1, x2, y2) lie to each other, end points included.

Answers (relation, place): the place is the common point of intersecting segments, the middle of the
common part of collinear ones, else None. Batch form: line_segments_intersections.

>>> get_line_segments_intersection((0, 0, 2, 2), (0, 2, 2, 0))
(<SegmentsRelPosition.INTERSECTING: 2>, (1.0, 1.0))
)");
}

}  // namespace Vorn::Python
