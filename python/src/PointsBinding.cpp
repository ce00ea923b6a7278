#include <pybind11/numpy.h>

#include <iostream>

#include "Bindings.h"
#include "vorn/io/Files.h"
#include "vorn/io/Points.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

/// (n, 3), or (n, 2) for points without tolerances.
py::array_t<double> ArrayOf(IO::PointFile const& file, bool withTolerances) {
  auto const count = static_cast<py::ssize_t>(file.points.size());
  py::array_t<double> array({count, withTolerances ? py::ssize_t{3} : py::ssize_t{2}});
  auto out = array.mutable_unchecked<2>();
  for (py::ssize_t i = 0; i < count; ++i) {
    WPoint const& point = file.points[static_cast<std::size_t>(i)];
    out(i, 0) = point.x;
    out(i, 1) = point.y;
    if (withTolerances) out(i, 2) = file.hasTolerances ? point.w : *file.tolerance;
  }
  return array;
}

IO::PointFile Read(std::string const& path, std::string const& columns) {
  py::gil_scoped_release const unlocked;
  IO::ColumnChoice choice;
  if (!columns.empty()) {
    auto const parsed = IO::ParseColumnChoice(columns);
    if (!parsed) throw py::value_error("columns must be 'x,y' or 'x,y,w', all different");
    choice = *parsed;
  }
  IO::ToleranceColumn const tolerance = {IO::ToleranceColumn::Use::IfPresent, "w"};
  return IO::ParsePoints(IO::ReadTextFile(path, std::cin), path, tolerance, choice);
}

py::tuple ReadPoints(std::string const& path, std::string const& columns) {
  IO::PointFile const file = Read(path, columns);
  bool const withTolerances = file.hasTolerances || file.tolerance.has_value();
  return py::make_tuple(ArrayOf(file, withTolerances), file.units);
}

}  // namespace

void BindPoints(py::module_& module) {
  module.def("read_points", &ReadPoints, py::arg("path"), py::arg("columns"),
             "Reads a file of points: the array and the units.");
}

}  // namespace Vorn::Python
