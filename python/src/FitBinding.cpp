#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <string>
#include <utility>
#include <vector>

#include "Bindings.h"
#include "Errors.h"
#include "Fit.h"
#include "FitOptions.h"
#include "NoFit.h"
#include "PieceRow.h"
#include "Points.h"
#include "Progress.h"
#include "vorn/io/Closure.h"
#include "vorn/io/FineTolerances.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/SpacingFailure.h"
#include "vorn/io/Tolerances.h"

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

void RequireFittable(IO::PointFile const& file, IO::FitChoice const& choice) {
  if (!file.hasTolerances && !choice.tolerance.cap) {
    Raise({ErrorCode::Failed,
           "the points have no tolerances: say tol=, or give them a column w",
           {}});
  }
  if (file.points.size() < 2) {
    Raise({ErrorCode::Failed, "a contour needs at least two points", {}});
  }
  RequireUsable(file.points, file.hasTolerances);
}

IO::PointFile FileOf(FitCall const& call) {
  PointsInput input = PointsFrom(call.points, call.tolerance);
  IO::PointFile file;
  file.hasTolerances = input.hasTolerances;
  file.points = std::move(input.points);
  file.units = call.units;
  return file;
}

[[noreturn]] void RaiseNoFit(FitCall const& call, IO::FitChoice const& choice,
                             IO::Failure const& failure) {
  IO::PointFile file = FileOf(call);
  IO::AssignTolerances(choice.tolerance, &file,
                       IO::FindClosure(file.points, choice.closed).isClosed);
  py::object const untold = py::none();
  Progress signals(untold);
  Problem problem = {ErrorCode::NoFit, failure.Message(), {}};
  {
    py::gil_scoped_release const unlocked;
    problem = ExplainNoFit(std::move(problem), file.points, choice, &signals);
  }
  Raise(problem);
}

void WarnOfFineTolerance(IO::PointFile const& file, IO::FineTolerance const& fine) {
  std::string const message = "the tolerance of point " + std::to_string(fine.point) + ", " +
                              IO::FormatShort(file.points[fine.point].w) + ", is less than " +
                              IO::FormatShort(IO::kFineTolerance) +
                              " of the extent of the points, " + IO::FormatShort(fine.extent) +
                              ": the fit may take minutes; \"fewest\" does not";
  py::gil_scoped_acquire const lock;
  // The caller of vorn.fit is two frames up.
  if (PyErr_WarnEx(PyExc_UserWarning, message.c_str(), 2) != 0) throw py::error_already_set();
}

IO::FitChoice ChoiceFrom(FitCall const& call) {
  IO::FitChoice choice = FitChoiceFrom(call.options);
  choice.warnOfFineTolerance = &WarnOfFineTolerance;
  if (choice.tolerance.cap && !call.tolerance.is_none()) {
    throw py::type_error("tol and tolerance_per_point cannot both be said");
  }
  return choice;
}

IO::FitReport FitUnlocked(IO::PointFile file, IO::FitChoice const& choice, Progress* progress) {
  py::gil_scoped_release const unlocked;
  return IO::FitContour(std::move(file), choice, progress);
}

}  // namespace

IO::FitReport FitOf(FitCall const& call) {
  Progress progress(call.progress);
  IO::FitChoice const choice = ChoiceFrom(call);
  IO::PointFile file = FileOf(call);
  RequireFittable(file, choice);
  try {
    return FitUnlocked(std::move(file), choice, &progress);
  } catch (IO::SpacingFailure const& failure) {
    Raise(failure);
  } catch (IO::Failure const& failure) {
    if (failure.Kind() == IO::FailureKind::NoFit) RaiseNoFit(call, choice, failure);
    Raise(failure);
  }
}

py::tuple PartsOf(IO::FitReport const& report) {
  return py::make_tuple(RowsOf(report.pieces, CoveredBy(report)), report.closure.isClosed,
                        FactsOf(report));
}

void BindFit(py::module_& module) {
  module.def(
      "fit",
      [](py::object const& points, py::object const& tolerance, py::dict const& options,
         py::object const& progress) {
        return PartsOf(FitOf({points, tolerance, options, progress, ""}));
      },
      py::arg("points"), py::arg("tol"), py::arg("options"), py::arg("progress"),
      "Fits points: the rows of the pieces, whether they are closed, and the facts.");
}

}  // namespace Vorn::Python
