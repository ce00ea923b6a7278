#include "../Errors.h"
#include "../Points.h"
#include "../Progress.h"
#include "Values.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

struct Curve {
  Elems contour;
  double maxDeviation = 0.0;
  std::int32_t maxDeviationIndex = -1;
};

ErrorCode Create(std::vector<WPoint> const& points, GeometryUtils::FittingStrategy strategy,
                 Progress* progress, Curve* curve) {
  constexpr std::int32_t kAll = 100;
  py::gil_scoped_release const unlocked;
  return GeometryUtils::CreateFittingCurve(points, strategy, &curve->contour, &curve->maxDeviation,
                                           &curve->maxDeviationIndex, progress, kAll);
}

/// The first neighbours that are too close, as the core tests them.
std::vector<std::int64_t> ClosePoints(std::vector<WPoint> const& points) {
  for (std::size_t i = 1; i < points.size(); ++i) {
    if (GeometryUtils::IsPointValidToFit(points[i - 1], points[i])) continue;
    return {static_cast<std::int64_t>(i) - 1, static_cast<std::int64_t>(i)};
  }
  return {};
}

py::tuple CreateFittingCurve(py::object const& points, GeometryUtils::FittingStrategy strategy,
                             py::object const& progress) {
  PointsInput const input = PointsFrom(points, py::none());
  if (!input.hasTolerances) throw py::value_error("the points need a third column: tolerances");
  Progress sink(progress);
  Curve curve;
  ErrorCode const code = Create(input.points, strategy, &sink, &curve);
  if (code == ErrorCode::PointsTooClose) {
    Raise({code, "create_fitting_curve: two points are too close for their tolerances",
           ClosePoints(input.points)});
  }
  RequireOk(code, "create_fitting_curve");
  return py::make_tuple(curve.contour, curve.maxDeviation, curve.maxDeviationIndex);
}

}  // namespace

void BindCurves(py::module_& module) {
  module.def("create_fitting_curve", &CreateFittingCurve, py::arg("points"),
             py::arg("strategy") = GeometryUtils::FittingStrategy::Mixed,
             py::arg("progress") = py::none(), R"(
Turns measured points, (n, 3) with x, y and tolerance, into a contour of segments and arcs. vorn.fit
is the comfortable form: this one closes no contour and measures nothing.

Answers (contour, largest deviation, its point). The deviation is in units of the tolerance of the
point, with SINGLE_ARC a length; the point is -1 where there is none. The progress is a callable
that is told the percentage that is done. Raises PointsTooCloseError, NoFitError or ContourError.

>>> contour, deviation, point = create_fitting_curve([(0, 0, 0.01), (1, 0, 0.01), (2, 0, 0.01)])
>>> len(contour), deviation <= 1
(2, True)
)");
}

}  // namespace Vorn::Python
