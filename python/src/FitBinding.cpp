#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <string>
#include <utility>
#include <vector>

#include "Bindings.h"
#include "Errors.h"
#include "FitOptions.h"
#include "PieceRow.h"
#include "Points.h"
#include "Progress.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/SpacingFailure.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

std::string NameOf(IO::Verdict verdict) {
  switch (verdict) {
    case IO::Verdict::WithinTolerance:
      return "within tolerance";
    case IO::Verdict::OutsideTolerance:
      return "outside tolerance";
    case IO::Verdict::NotClosed:
      return "not closed";
    case IO::Verdict::StopsEarly:
      break;
  }
  return "stops early";
}

/// The points of each piece; of a closed contour that does not repeat its first point the count
/// leads on from the last point to the first.
std::vector<CoveredPoints> CoveredBy(IO::FitReport const& report) {
  std::vector<CoveredPoints> covered;
  if (!report.ranges) return covered;
  std::size_t const total = report.file.points.size() - (report.closure.repeatsFirst ? 1 : 0);
  for (IO::PointRange const& range : *report.ranges) {
    if (range.count == 0) {
      covered.emplace_back();
      continue;
    }
    std::size_t const last = range.first + range.count - 1;
    bool const isAcross = last >= total && report.closure.isClosed;
    covered.push_back({static_cast<std::int64_t>(range.first),
                       static_cast<std::int64_t>(isAcross ? last % total : last)});
  }
  return covered;
}

/// In the order of the fields of FitFacts in Python.
py::tuple FactsOf(IO::FitReport const& report) {
  IO::FitReport::Deviation const largest = report.LargestDeviation();
  py::object fewest = py::none();
  if (report.fit.fewestPossible) fewest = py::cast(*report.fit.fewestPossible);
  return py::make_tuple(largest.relative, largest.point, fewest, NameOf(report.verdict),
                        IO::NameOf(report.strategy));
}

void RequireFittable(PointsInput const& input) {
  if (!input.hasTolerances) {
    Raise({ErrorCode::Failed,
           "the points have no tolerances: say tol=, or give them a column w",
           {}});
  }
  if (input.points.size() < 2) {
    Raise({ErrorCode::Failed, "a contour needs at least two points", {}});
  }
  RequireUsable(input);
}

/// What the caller handed over; the points are copied from there.
struct Call {
  py::object const& points;
  py::object const& tolerance;
  IO::FitChoice choice;
};

/// The message of the library names points by what the file calls them; here they come as numbers.
[[noreturn]] void RaiseTooClose(IO::ClosePair const& pair) {
  std::string const message =
      "points " + std::to_string(pair.first) + " and " + std::to_string(pair.second) + " are " +
      std::string(py::repr(py::float_(pair.distance))) + " apart, which must be more than " +
      std::string(py::repr(py::float_(pair.needed))) +
      " for their tolerances; the strategy \"fewest\" takes points of any density";
  Raise({ErrorCode::PointsTooClose,
         message,
         {static_cast<std::int64_t>(pair.first), static_cast<std::int64_t>(pair.second)}});
}

IO::FitReport FitUnlocked(IO::PointFile file, IO::FitChoice const& choice, Progress* progress) {
  py::gil_scoped_release const unlocked;
  return IO::FitContour(std::move(file), choice, progress);
}

IO::FitReport FitPoints(Call const& call, Progress* progress) {
  PointsInput input = PointsFrom(call.points, call.tolerance);
  RequireFittable(input);
  IO::PointFile file;
  file.points = std::move(input.points);
  file.hasTolerances = true;
  try {
    return FitUnlocked(std::move(file), call.choice, progress);
  } catch (IO::SpacingFailure const& failure) {
    RaiseTooClose(failure.Neighbours().pair);
  } catch (IO::Failure const& failure) {
    Raise(failure);
  }
}

py::tuple Fit(py::object const& points, py::object const& tolerance, py::dict const& options,
              py::object const& progress) {
  Progress sink(progress);
  IO::FitReport const report = FitPoints({points, tolerance, FitChoiceFrom(options)}, &sink);
  return py::make_tuple(RowsOf(report.pieces, CoveredBy(report)), report.closure.isClosed,
                        FactsOf(report));
}

}  // namespace

void BindFit(py::module_& module) {
  module.def("fit", &Fit, py::arg("points"), py::arg("tol"), py::arg("options"),
             py::arg("progress"),
             "Fits points: the rows of the pieces, whether they are closed, and the facts.");
}

}  // namespace Vorn::Python
