#include <pybind11/numpy.h>
#include <pybind11/stl.h>

#include <optional>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "Bindings.h"
#include "Errors.h"
#include "Fit.h"
#include "FitOptions.h"
#include "PieceRow.h"
#include "Points.h"
#include "vorn/io/CheckReport.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/FitSummary.h"
#include "vorn/io/InfoReport.h"
#include "vorn/io/LeastSquares.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

constexpr char const* kGiven = "given";

IO::PointFile FileFrom(py::object const& points, py::object const& tolerance,
                       std::string const& units, std::size_t least) {
  PointsInput input = PointsFrom(points, tolerance);
  RequireUsable(input);
  if (input.points.size() < least) {
    Raise({ErrorCode::Failed, "there are fewer than " + std::to_string(least) + " points", {}});
  }
  IO::PointFile file;
  file.points = std::move(input.points);
  file.hasTolerances = input.hasTolerances;
  file.units = units;
  return file;
}

std::string InfoJson(py::object const& points, py::object const& tolerance,
                     std::string const& units, py::object const& closed) {
  IO::InfoReport report;
  report.file = FileFrom(points, tolerance, units, 2);
  IO::ClosedChoice const choice = ClosedFrom(closed);
  py::gil_scoped_release const unlocked;
  report.info = IO::Analyse(report.file.points, choice);
  if (report.file.hasTolerances) {
    report.rule = IO::CheckRule(report.file.points, report.info.closure, kGiven);
  }
  return IO::ToJson(report);
}

IO::CheckReport Check(py::object const& points, py::object const& tolerance,
                      std::string const& units,
                      std::tuple<PieceRows, bool, std::string> const& contour) {
  IO::PointFile file = FileFrom(points, tolerance, units, 1);
  IO::ContourFile against =
      ContourFrom(std::get<0>(contour), std::get<1>(contour), std::get<2>(contour));
  if (against.pieces.empty()) Raise({ErrorCode::Failed, "the contour has no pieces", {}});
  std::string source = file.hasTolerances ? kGiven : "";
  py::gil_scoped_release const unlocked;
  return IO::MakeCheckReport(std::move(file), std::move(source), std::move(against));
}

IO::FitReport Report(py::object const& points, py::object const& tolerance,
                     std::string const& units, py::dict const& options,
                     py::object const& progress) {
  IO::FitReport report = FitOf({points, tolerance, options, progress, units});
  // What the library takes for a column of a file.
  if (!options.contains("tolerance_per_point")) report.toleranceSource = kGiven;
  return report;
}

IO::ReportHead HeadFrom(std::vector<std::pair<std::string, std::string>> const& fields) {
  IO::ReportHead head;
  for (auto const& [name, value] : fields) head.fields.push_back({name, value});
  return head;
}

std::string JsonWithFields(IO::FitReport const& report,
                           std::vector<std::pair<std::string, std::string>> const& fields) {
  IO::FitReport named = report;
  named.head = HeadFrom(fields);
  return IO::ToJson(named);
}

using Named = std::pair<std::string, IO::FitReport const*>;

/// A table as text, or a page with pictures; the names stand for the paths of files.
std::string Summary(std::vector<Named> const& reports,
                    std::vector<std::pair<std::string, std::string>> const& fields, bool asPage) {
  std::vector<IO::SummaryRow> rows;
  for (auto const& [name, report] : reports) {
    rows.push_back(IO::SummaryRowOf(*report, report->verdict));
    rows.back().path = name;
  }
  return asPage ? IO::SummaryHtml(std::move(rows), HeadFrom(fields))
                : IO::SummaryCsv(std::move(rows));
}

std::vector<IO::XY> PlacesFrom(py::object const& points) {
  PointsInput const input = PointsFrom(points, py::none());
  RequireUsable(input.points, false);
  std::vector<IO::XY> places;
  for (WPoint const& point : input.points) places.push_back({point.x, point.y});
  return places;
}

/// In the order of the fields of LeastSquaresLine in Python.
py::tuple LeastSquaresLine(py::object const& points) {
  std::optional<IO::LeastSquaresLine> const line = IO::FitLine(PlacesFrom(points));
  if (!line) Raise({ErrorCode::Failed, "a line needs two different points", {}});
  return py::make_tuple(py::make_tuple(line->at.x, line->at.y), line->direction,
                        line->scatter.formError, line->scatter.standardDeviation,
                        line->directionDeviation);
}

/// In the order of the fields of LeastSquaresCircle in Python.
py::tuple LeastSquaresCircle(py::object const& points) {
  std::optional<IO::LeastSquaresCircle> const circle = IO::FitCircle(PlacesFrom(points));
  if (!circle) {
    Raise({ErrorCode::Failed, "a circle needs three points that are not on one line", {}});
  }
  return py::make_tuple(py::make_tuple(circle->center.x, circle->center.y), circle->radius,
                        circle->scatter.formError, circle->scatter.standardDeviation,
                        circle->radiusDeviation);
}

}  // namespace

void BindReports(py::module_& module) {
  module.def("info_json", &InfoJson, "All that can be said about points without a fit.");
  module.def("least_squares_line", &LeastSquaresLine, "The line nearest to points.");
  module.def("least_squares_circle", &LeastSquaresCircle, "The circle nearest to points.");
  module.def("summary", &Summary, "Many fits as a table or a page.");
  py::class_<IO::CheckReport>(module, "CheckReport", "Points measured against a contour.")
      .def(py::init(&Check))
      .def("outside", [](IO::CheckReport const& report) { return report.outside; })
      .def("worst_first", &IO::CheckReport::WorstFirst)
      .def("to_json", [](IO::CheckReport const& report) { return IO::ToJson(report); })
      .def("to_csv", [](IO::CheckReport const& report) { return IO::ToCsv(report); });
  py::class_<IO::FitReport>(module, "FitReport", "All that is told about one fit.")
      .def(py::init(&Report))
      .def("parts", &PartsOf)
      .def("to_json", &JsonWithFields)
      .def("drawing", [](IO::FitReport const& report) { return IO::DrawingOf(report); });
}

}  // namespace Vorn::Python
