#include <pybind11/operators.h>

#include <string>

#include "Values.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

using Type = GeometryUtils::ElemType;

/// All fields of an element, for comparing, pickling and showing it.
py::tuple FieldsOf(Elem const& elem) {
  return py::make_tuple(elem.type, PlaceOf(elem.end), PlaceOf(elem.center), elem.radius,
                        elem.direction, elem.startAngle, elem.endAngle);
}

Elem FromFields(py::tuple const& fields) {
  Elem elem;
  elem.type = fields[0].cast<Type>();
  elem.end = PointOf(fields[1].cast<Place>());
  elem.center = PointOf(fields[2].cast<Place>());
  elem.radius = fields[3].cast<double>();
  elem.direction = fields[4].cast<double>();
  elem.startAngle = fields[5].cast<double>();
  elem.endAngle = fields[6].cast<double>();
  return elem;
}

Elem Segment(Place const& end) {
  Elem elem;
  elem.end = PointOf(end);
  return elem;
}

Elem ArcElem(Place const& end, Place const& center, double radius, double direction,
             Place const& angles) {
  Elem elem;
  elem.type = Type::Arc;
  elem.end = PointOf(end);
  elem.center = PointOf(center);
  elem.radius = radius;
  elem.direction = direction;
  elem.startAngle = angles.first;
  elem.endAngle = angles.second;
  return elem;
}

std::string Shown(Elem const& elem) {
  py::tuple const fields = FieldsOf(elem);
  auto const text = [&](int i) { return std::string(py::repr(fields[static_cast<size_t>(i)])); };
  if (elem.type == Type::Segment) return "Elem.segment(" + text(1) + ")";
  return "Elem.arc(" + text(1) + ", " + text(2) + ", " + text(3) + ", " + text(4) + ", (" +
         text(5) + ", " + text(6) + "))";
}

/// What an element holds.
void BindFields(py::class_<Elem>* elem) {
  (*elem)
      .def_property_readonly(
          "type", [](Elem const& e) { return e.type; }, R"(
Whether it is a segment or an arc.

>>> Elem.segment((1, 2)).type == ElemType.SEGMENT
True
)")
      .def_property_readonly(
          "end", [](Elem const& e) { return PlaceOf(e.end); }, R"(
Where it ends, (x, y).

>>> Elem.segment((1, 2)).end
(1.0, 2.0)
)")
      .def_property_readonly(
          "center", [](Elem const& e) { return PlaceOf(e.center); }, R"(
The center (x, y) of the circle of an arc.

>>> Elem.arc((0, 2), (1, 2), 1.0, -1.0, (0.0, 3.0)).center
(1.0, 2.0)
)")
      .def_property_readonly(
          "radius", [](Elem const& e) { return e.radius; }, R"(
The radius of the circle of an arc, in the unit of its ends.

>>> Elem.arc((0, 2), (1, 2), 1.0, -1.0, (0.0, 3.0)).radius
1.0
)")
      .def_property_readonly(
          "direction", [](Elem const& e) { return e.direction; },
          R"(
How an arc runs: +1 counter-clockwise, -1 clockwise.

>>> Elem.arc((0, 2), (1, 2), 1.0, -1.0, (0.0, 3.0)).direction
-1.0
)")
      .def_property_readonly(
          "start_angle", [](Elem const& e) { return e.startAngle; },
          R"(
Polar angle of the start of an arc from its center, radians.

>>> Elem.arc((0, 2), (1, 2), 1.0, -1.0, (0.0, 3.0)).start_angle
0.0
)")
      .def_property_readonly(
          "end_angle", [](Elem const& e) { return e.endAngle; },
          R"(
Polar angle of the end of an arc from its center, radians.

>>> Elem.arc((0, 2), (1, 2), 1.0, -1.0, (0.0, 3.0)).end_angle
3.0
)");
}

void BindElem(py::module_& module) {
  py::class_<Elem> type(module, "Elem", R"(
One element of a contour: a segment or an arc from the end of the element before to its own end.

A contour is a list of them; its first one is a segment whose end is the start of the contour.

>>> Elem.segment((1, 2)).end
(1.0, 2.0)
)");
  type.def_static("segment", &Segment, py::arg("end"), R"(
A straight element that ends there, at (x, y).

>>> Elem.segment((1, 2))
Elem.segment((1.0, 2.0))
)")
      .def_static("arc", &ArcElem, py::arg("end"), py::arg("center"), py::arg("radius"),
                  py::arg("direction"), py::arg("angles"),
                  R"(
An arc that ends there; direction is +1 counter-clockwise, -1 clockwise, and angles are the polar
angles of start and end in radians. Nothing is checked.

>>> get_arc_length(Elem.arc((0, 2), (0, 0), 2.0, 1.0, (0.0, 1.5)))
3.0
)")
      .def(
          "__eq__", [](Elem const& a, Elem const& b) { return FieldsOf(a).equal(FieldsOf(b)); },
          py::is_operator())
      .def("__hash__", [](Elem const& elem) { return py::hash(FieldsOf(elem)); })
      .def("__repr__", &Shown)
      .def(py::pickle(&FieldsOf, &FromFields));
  BindFields(&type);
}

}  // namespace

void BindElements(py::module_& module) {
  py::enum_<Type>(module, "ElemType", R"(
Kind of a contour element.

>>> ElemType.ARC == Elem.arc((0, 2), (0, 0), 2.0, 1.0, (0.0, 1.5)).type
True
)")
      .value("SEGMENT", Type::Segment)
      .value("ARC", Type::Arc);
  py::enum_<GeometryUtils::FittingStrategy>(module, "FittingStrategy",
                                            R"(
How create_fitting_curve cuts the points.

>>> curve = create_fitting_curve([(1, 0, 0.1), (0, 1, 0.1), (-1, 0, 0.1)],
...                              FittingStrategy.SINGLE_ARC)
>>> curve[0][1].type
<ElemType.ARC: 1>
)")
      .value("MIXED", GeometryUtils::FittingStrategy::Mixed)
      .value("MIXED_CELLS", GeometryUtils::FittingStrategy::MixedCells)
      .value("SINGLE_ARC", GeometryUtils::FittingStrategy::SingleArc);
  py::enum_<SegmentsRelPosition>(module, "SegmentsRelPosition",
                                 R"(
How two segments lie to each other.

>>> SegmentsRelPosition(2)
<SegmentsRelPosition.INTERSECTING: 2>
)")
      .value("DISJOINT", SegmentsRelPosition::Disjoint)
      .value("PARALLEL", SegmentsRelPosition::Parallel)
      .value("COLLINEAR", SegmentsRelPosition::Collinear)
      .value("INTERSECTING", SegmentsRelPosition::Intersecting);
  BindElem(module);
  module.def(
      "get_arc_length", [](Elem const& arc) { return GeometryUtils::GetArcLength(arc); },
      py::arg("arc"), R"(
Length of an arc: its sweep times its radius.

>>> round(get_arc_length(Elem.arc((0, 2), (0, 0), 2.0, 1.0, (0.0, 1.5))), 6)
3.0
)");
  module.def(
      "get_arc_angle_rad", [](Elem const& arc) { return GeometryUtils::GetArcAngleRad(arc); },
      py::arg("arc"), R"(
Sweep of an arc in radians; 0.0 when its radius is not above zero.

>>> round(get_arc_angle_rad(Elem.arc((0, 2), (0, 0), 2.0, 1.0, (0.0, 1.5))), 6)
1.5
)");
}

}  // namespace Vorn::Python
