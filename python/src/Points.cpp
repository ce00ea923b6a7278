#include "Points.h"

#include <cmath>
#include <cstdint>
#include <string>

#include "Errors.h"
#include "Numbers.h"

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

/// NumPy converts and walks the strides; it refuses shapes that do not fit.
void Copy(py::array const& numbers, std::vector<WPoint>* points, Columns const& columns) {
  if (points->empty()) return;
  py::module_::import("numpy").attr("copyto")(ViewOf(points, columns), numbers, "same_kind");
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
  Copy(NumbersFrom(frame["x"], "x"), &input.points, {0});
  Copy(NumbersFrom(frame["y"], "y"), &input.points, {1});
  input.hasTolerances = frame.attr("columns").contains("w");
  if (input.hasTolerances) Copy(NumbersFrom(frame["w"], "w"), &input.points, {2});
  return input;
}

PointsInput FromArray(py::object const& points) {
  py::array const array = NumbersFrom(points, "points");
  py::ssize_t const width = array.ndim() == 2 ? array.shape(1) : 0;
  if (width != 2 && width != kLengthOfPoint) {
    throw py::value_error("points must have the shape (n, 2) or (n, 3), not " +
                          std::string(py::str(array.attr("shape"))));
  }
  PointsInput input;
  input.points.resize(static_cast<std::size_t>(array.shape(0)));
  Copy(array, &input.points, {0, width});
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
    Copy(NumbersFrom(tolerance, "tolerances"), &input.points, {2});
    input.hasTolerances = true;
  }
  return input;
}

py::array_t<double> ArrayOf(PointsInput const& input) {
  auto const count = static_cast<py::ssize_t>(input.points.size());
  py::array_t<double> array({count, input.hasTolerances ? kLengthOfPoint : py::ssize_t{2}});
  double* out = array.mutable_data();
  for (WPoint const& point : input.points) {
    *out++ = point.x;
    *out++ = point.y;
    if (input.hasTolerances) *out++ = point.w;
  }
  return array;
}

void RequireUsable(PointsInput const& input) { RequireUsable(input.points, input.hasTolerances); }

void RequireUsable(std::vector<WPoint> const& points, bool haveTolerances) {
  for (std::size_t i = 0; i < points.size(); ++i) {
    WPoint const& point = points[i];
    if (!std::isfinite(point.x) || !std::isfinite(point.y)) Refuse(i, "x or y is not finite");
    if (!haveTolerances) continue;
    if (!(point.w > 0.0) || !std::isfinite(point.w)) {
      Refuse(i, "the tolerance is not a number above 0");
    }
  }
}

}  // namespace Vorn::Python
