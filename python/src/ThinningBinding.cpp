#include <pybind11/numpy.h>
#include <pybind11/stl.h>

#include <algorithm>
#include <limits>
#include <optional>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "Bindings.h"
#include "Errors.h"
#include "FitOptions.h"
#include "Keywords.h"
#include "Points.h"
#include "vorn/io/Closure.h"
#include "vorn/io/Thinning.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

using Indices = py::array_t<std::int64_t>;

Indices IndicesOf(std::vector<std::size_t> const& indices) {
  Indices array(static_cast<py::ssize_t>(indices.size()));
  std::transform(indices.begin(), indices.end(), array.mutable_data(),
                 [](std::size_t index) { return static_cast<std::int64_t>(index); });
  return array;
}

PointsInput UsablePoints(py::object const& points, std::size_t least) {
  PointsInput input = PointsFrom(points, py::none());
  RequireUsable(input);
  if (input.points.size() >= least) return input;
  Raise({ErrorCode::Failed, "there are fewer than " + std::to_string(least) + " points", {}});
}

/// Index, distance and standard deviations of each outlier.
std::vector<std::tuple<std::size_t, double, double>> FindOutliers(py::object const& points,
                                                                  double deviations) {
  PointsInput const input = UsablePoints(points, 0);
  AboveZero(py::float_(deviations), "outliers");
  std::vector<std::tuple<std::size_t, double, double>> found;
  for (IO::Outlier const& outlier : IO::FindOutliers(input.points, deviations)) {
    found.emplace_back(outlier.point, outlier.distance, outlier.deviations);
  }
  return found;
}

Indices KeepEvery(py::object const& points, double spacing) {
  PointsInput const input = UsablePoints(points, 1);
  return IndicesOf(IO::KeepEvery(input.points, AboveZero(py::float_(spacing), "spacing")));
}

/// By the tolerances of the points, or where these follow the spacing by their cap.
Indices KeepSpaced(py::object const& points, std::optional<double> cap, py::object const& closed) {
  PointsInput const input = UsablePoints(points, 2);
  bool const goesByTolerances = !cap && input.hasTolerances;
  IO::TooClose const rule =
      goesByTolerances ? IO::RuleOfTolerances()
                       : IO::RuleOfSpacing(cap.value_or(std::numeric_limits<double>::infinity()));
  std::vector<std::size_t> kept = IO::KeepSpaced(input.points, rule);
  IO::Closure const closure = IO::FindClosure(input.points, ClosedFrom(closed));
  if (closure.isClosed && !closure.repeatsFirst) {
    IO::DropCloseToFirst(input.points, rule, &kept);
  }
  if (kept.size() >= 2) return IndicesOf(kept);
  Raise({ErrorCode::PointsTooClose,
         "fewer than two points would be left: all lie too close to point 0",
         {0}});
}

/// The means, and how the points of the windows scatter.
py::tuple AverageAlong(py::object const& points, double window) {
  PointsInput const input = UsablePoints(points, 2);
  IO::Averages averages = IO::AverageAlong(input.points, AboveZero(py::float_(window), "spacing"));
  return py::make_tuple(ArrayOf({std::move(averages.points), input.hasTolerances}),
                        averages.meanDeviation, averages.largestDeviation, averages.fewest,
                        averages.most);
}

}  // namespace

void BindThinning(py::module_& module) {
  module.def("find_outliers", &FindOutliers, "Points that their neighbours do not bear out.");
  module.def("keep_every", &KeepEvery, "The points at least `spacing` apart along the path.");
  module.def("keep_spaced", &KeepSpaced, "The points that are not too close to the one before.");
  module.def("average_along", &AverageAlong, "The means of the points in windows of the path.");
}

}  // namespace Vorn::Python
