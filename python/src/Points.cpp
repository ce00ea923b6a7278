#include "Points.h"

#include <cmath>
#include <cstdint>
#include <string>

#include "Errors.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

constexpr py::ssize_t kLengthOfPoint = 3;

/// Some of the columns x, y, w of the points, for NumPy to write to. The points must outlive it.
struct Columns {
  py::ssize_t first = 0;
  py::ssize_t count = 1;
};

py::array ViewOf(std::vector<WPoint>* points, Columns const& columns) {
  static_assert(sizeof(WPoint) == kLengthOfPoint * sizeof(double));
  double* const data = reinterpret_cast<double*>(points->data()) + columns.first;
  std::vector<py::ssize_t> shape = {static_cast<py::ssize_t>(points->size())};
  std::vector<py::ssize_t> strides = {sizeof(WPoint)};
  if (columns.count > 1) {
    shape.push_back(columns.count);
    strides.push_back(sizeof(double));
  }
  return {py::dtype::of<double>(), shape, strides, data, py::none()};
}

py::object AsArray(py::object const& points) {
  return py::module_::import("numpy").attr("asarray")(points);
}

/// What is masked has no value, which an array of the same numbers would not tell.
void RefuseMasked(py::object const& source) {
  if (py::module_::import("numpy").attr("ma").attr("is_masked")(source).cast<bool>()) {
    throw py::value_error("some values are masked; leave those points out");
  }
}

/// NumPy converts and walks the strides; it refuses what does not become a number, and shapes that
/// do not fit. Objects are taken where each of them is a number.
void Copy(py::object const& source, std::vector<WPoint>* points, Columns const& columns) {
  if (points->empty()) return;
  RefuseMasked(source);
  py::array const array = AsArray(source);
  char const* const casting = array.dtype().kind() == 'O' ? "unsafe" : "same_kind";
  py::module_::import("numpy").attr("copyto")(ViewOf(points, columns), array, casting);
}

bool IsFrame(py::object const& points) {
  return py::hasattr(points, "columns") && py::hasattr(points, "__getitem__");
}

PointsInput FromFrame(py::object const& frame) {
  for (char const* name : {"x", "y"}) {
    if (!frame.attr("columns").contains(name)) {
      throw py::value_error(std::string("the frame has no column '") + name + "'");
    }
  }
  PointsInput input;
  input.points.resize(py::len(frame));
  Copy(frame["x"], &input.points, {0});
  Copy(frame["y"], &input.points, {1});
  input.hasTolerances = frame.attr("columns").contains("w");
  if (input.hasTolerances) Copy(frame["w"], &input.points, {2});
  return input;
}

PointsInput FromArray(py::object const& points) {
  py::array const array = AsArray(points);
  py::ssize_t const width = array.ndim() == 2 ? array.shape(1) : 0;
  if (width != 2 && width != kLengthOfPoint) {
    throw py::value_error("points must have the shape (n, 2) or (n, 3), not " +
                          std::string(py::str(array.attr("shape"))));
  }
  PointsInput input;
  input.points.resize(static_cast<std::size_t>(array.shape(0)));
  Copy(points, &input.points, {0, width});
  input.hasTolerances = width == kLengthOfPoint;
  return input;
}

[[noreturn]] void Refuse(std::size_t index, std::string const& complaint) {
  Raise({ErrorCode::Failed,
         "point " + std::to_string(index) + ": " + complaint,
         {static_cast<std::int64_t>(index)}});
}

}  // namespace

PointsInput PointsFrom(py::object const& points, py::object const& tolerance) {
  PointsInput input = IsFrame(points) ? FromFrame(points) : FromArray(points);
  if (!tolerance.is_none()) {
    Copy(tolerance, &input.points, {2});
    input.hasTolerances = true;
  }
  return input;
}

void RequireUsable(PointsInput const& input) {
  for (std::size_t i = 0; i < input.points.size(); ++i) {
    WPoint const& point = input.points[i];
    if (!std::isfinite(point.x) || !std::isfinite(point.y)) Refuse(i, "x or y is not finite");
    if (!input.hasTolerances) continue;
    if (!(point.w > 0.0) || !std::isfinite(point.w)) {
      Refuse(i, "the tolerance is not a number above 0");
    }
  }
}

}  // namespace Vorn::Python
