#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <cmath>
#include <optional>
#include <string>
#include <utility>

#include "Bindings.h"
#include "Errors.h"
#include "PieceRow.h"
#include "Points.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/Formats.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

IO::Drawing DrawingOf(PieceRows const& rows, bool isClosed, std::string const& units,
                      py::object const& points, py::object const& tolerance) {
  if (rows.size() == 0) Raise({ErrorCode::Failed, "the contour has no pieces", {}});
  if (points.is_none()) return IO::DrawingOf(ContourFrom(rows, isClosed, units));
  PointsInput input = PointsFrom(points, tolerance);
  RequireUsable(input);
  py::gil_scoped_release const unlocked;
  IO::Drawing drawing = IO::MakeDrawing(std::move(input.points), PiecesFrom(rows));
  drawing.units = units;
  return drawing;
}

void SetMagnify(IO::Drawing& drawing, std::optional<double> magnify) {
  if (magnify && !(*magnify > 0.0 && std::isfinite(*magnify))) {
    throw py::value_error("magnify must be a number above 0");
  }
  drawing.magnify = magnify;
}

/// SVG and HTML as text in UTF-8, PNG as pixels.
py::bytes Draw(IO::Drawing const& drawing, std::string const& format) {
  std::optional<IO::Format> const wanted = IO::FormatNamed(format);
  if (!wanted || IO::HoldsContour(*wanted)) {
    throw py::value_error("'" + format + "' names no drawing");
  }
  return IO::Drawn(drawing, *wanted);
}

}  // namespace

void BindDrawings(py::module_& module) {
  py::class_<IO::Drawing>(module, "Drawing", "What is to be drawn.")
      .def(py::init(&DrawingOf))
      .def_readwrite("title", &IO::Drawing::title)
      .def_readwrite("facts", &IO::Drawing::facts)
      .def_property(
          "magnify", [](IO::Drawing const& drawing) { return drawing.magnify; }, &SetMagnify)
      .def("draw", &Draw);
}

}  // namespace Vorn::Python
