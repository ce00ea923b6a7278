#include <pybind11/numpy.h>

#include <algorithm>
#include <iostream>
#include <optional>
#include <string>
#include <vector>

#include "Bindings.h"
#include "FitOptions.h"
#include "Keywords.h"
#include "Numbers.h"
#include "Points.h"
#include "vorn/io/Closure.h"
#include "vorn/io/PointOutlines.h"
#include "vorn/io/Tolerances.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

/// The array of a file, whose tolerance may be one for all.
py::array_t<double> ArrayOfFile(IO::PointFile const& file) {
  PointsInput input = {file.points, file.hasTolerances || file.tolerance};
  if (!file.hasTolerances && file.tolerance) {
    for (WPoint& point : input.points) point.w = *file.tolerance;
  }
  return ArrayOf(input);
}

IO::ColumnChoice ColumnsFrom(py::handle given) {
  auto const parsed = IO::ParseColumnChoice(given.cast<std::string>());
  if (!parsed) throw py::value_error("columns must be 'x,y' or 'x,y,w', all different");
  return *parsed;
}

IO::Format FormatFrom(py::handle given) {
  auto const name = given.cast<std::string>();
  std::optional<IO::Format> const format = IO::FormatNamed(name);
  if (!format) throw py::value_error("'" + name + "' names no format");
  return *format;
}

IO::ToleranceColumn ToleranceColumnFrom(py::handle given) {
  return {IO::ToleranceColumn::Use::Required, given.cast<std::string>()};
}

Takers<IO::PointReading> const& ReadingTakers() {
  using IO::PointReading;
  static Takers<PointReading> const takers = {
      {"columns", [](py::handle g, PointReading* r) { r->columns = ColumnsFrom(g); }},
      {"tolerance_column",
       [](py::handle g, PointReading* r) { r->tolerance = ToleranceColumnFrom(g); }},
      {"format", [](py::handle g, PointReading* r) { r->format = FormatFrom(g); }},
      {"flatten", [](py::handle g, PointReading* r) { r->flattening = AboveZero(g, "flatten"); }},
  };
  return takers;
}

std::vector<IO::PointFile> Read(std::string const& path, IO::PointReading const& reading) {
  py::gil_scoped_release const unlocked;
  return IO::ReadPointOutlines(path, std::cin, reading);
}

/// An array and its units for each outline.
py::list ReadPoints(std::string const& path, py::dict const& options) {
  IO::PointReading reading = Taken(ReadingTakers(), options);
  if (!options.contains("tolerance_column")) reading.tolerance = IO::ColumnFor({});
  py::list outlines;
  for (IO::PointFile const& file : Read(path, reading)) {
    outlines.append(py::make_tuple(ArrayOfFile(file), file.units));
  }
  return outlines;
}

bool IsClosed(std::vector<WPoint> const& points, py::object const& closed) {
  return IO::FindClosure(points, ClosedFrom(closed)).isClosed;
}

py::array_t<double> TolerancePerPoint(py::object const& points, double cap,
                                      py::object const& closed) {
  IO::PointFile file;
  file.points = PointsFrom(points, py::none()).points;
  RequireUsable(file.points, false);
  IO::AssignTolerances({{}, {}, AboveZero(py::float_(cap), "cap")}, &file,
                       IsClosed(file.points, closed));
  py::array_t<double> tolerances(static_cast<py::ssize_t>(file.points.size()));
  std::transform(file.points.begin(), file.points.end(), tolerances.mutable_data(),
                 [](WPoint const& point) { return point.w; });
  return tolerances;
}

/// The points of a caller with their tolerances as a column, after they were found usable.
py::array_t<double> UsablePoints(py::object const& points, py::object const& tolerance) {
  PointsInput const input = PointsFrom(points, tolerance);
  RequireUsable(input);
  return ArrayOf(input);
}

}  // namespace

void BindPoints(py::module_& module) {
  module.def("read_points", &ReadPoints, "The outlines of a file of points: arrays and units.");
  module.def("tolerance_per_point", &TolerancePerPoint, "Tolerances that follow the spacing.");
  module.def("usable_points", &UsablePoints, "The points as an array, all of them usable.");
  module.def(
      "numbers",
      [](py::object const& given, std::string const& name) { return NumbersFrom(given, name); },
      "An array of numbers of whatever was given.");
}

}  // namespace Vorn::Python
