#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "Bindings.h"
#include "Errors.h"
#include "Keywords.h"
#include "PieceRow.h"
#include "Points.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/Formats.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

IO::Drawing DrawingOf(PieceRows const& rows, bool isClosed, std::string const& units,
                      py::object const& points, py::object const& tolerance) {
  if (points.is_none()) {
    if (rows.size() == 0) Raise({ErrorCode::Failed, "the contour has no pieces", {}});
    return IO::DrawingOf(ContourFrom(rows, isClosed, units));
  }
  PointsInput input = PointsFrom(points, tolerance);
  RequireUsable(input);
  py::gil_scoped_release const unlocked;
  IO::Drawing drawing = IO::MakeDrawing(std::move(input.points), PiecesFrom(rows));
  drawing.units = units;
  return drawing;
}

void SetMagnify(IO::Drawing& drawing, std::optional<double> magnify) {
  if (magnify) AboveZero(py::float_(*magnify), "magnify");
  drawing.magnify = magnify;
}

using Fields = std::vector<std::pair<std::string, std::string>>;

void SetFields(IO::Drawing& drawing, Fields const& fields) {
  drawing.head.fields.clear();
  for (auto const& [name, value] : fields) {
    if (name.empty()) throw py::value_error("a field at the head of a drawing has no name");
    drawing.head.fields.push_back({name, value});
  }
}

IO::PngSize SizeFrom(std::optional<double> dpi, std::optional<int> width) {
  IO::PngSize size;
  if (dpi) size.dpi = AboveZero(py::float_(*dpi), "dpi");
  if (width && *width < 1) throw py::value_error("width must be 1 or more");
  size.width = width;
  return size;
}

/// SVG and HTML as text in UTF-8, PNG as pixels.
py::bytes Draw(IO::Drawing const& drawing, std::string const& format, std::optional<double> dpi,
               std::optional<int> width) {
  std::optional<IO::Format> const wanted = IO::FormatNamed(format);
  if (!wanted || IO::HoldsContour(*wanted)) {
    throw py::value_error("'" + format + "' names no drawing");
  }
  IO::PngSize const size = SizeFrom(dpi, width);
  std::string drawn;
  {
    py::gil_scoped_release const unlocked;
    drawn = IO::Drawn(drawing, *wanted, size);
  }
  return drawn;
}

}  // namespace

void BindDrawings(py::module_& module) {
  py::class_<IO::Drawing>(module, "Drawing", "What is to be drawn.")
      .def(py::init(&DrawingOf))
      .def_readwrite("title", &IO::Drawing::title)
      .def_readwrite("facts", &IO::Drawing::facts)
      .def_property(
          "fields",
          [](IO::Drawing const& drawing) {
            Fields fields;
            for (IO::ReportField const& field : drawing.head.fields) {
              fields.emplace_back(field.name, field.value);
            }
            return fields;
          },
          &SetFields)
      .def_property(
          "magnify", [](IO::Drawing const& drawing) { return drawing.magnify; }, &SetMagnify)
      .def("draw", &Draw);
}

}  // namespace Vorn::Python
