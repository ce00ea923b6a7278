#include <algorithm>
#include <utility>

#include "io/fit/Assignment.h"
#include "io/fit/Closing.h"
#include "io/fit/Fit.h"
#include "io/fit/MakeReport.h"

namespace Vorn::IO {

namespace {

bool ByTolerance(WPoint const& a, WPoint const& b) { return a.w < b.w; }

/// Written so that a deviation that is not a number is outside.
bool IsWithin(double relative) { return relative <= kLargestRelative; }

Verdict Judge(FitReport const& report, bool reachesLastPoint) {
  if (!reachesLastPoint) return Verdict::StopsEarly;
  if (!IsWithin(report.LargestDeviation().relative)) return Verdict::OutsideTolerance;
  bool const hasGap = report.closure.isClosed && report.Gap() != 0.0;
  return hasGap ? Verdict::NotClosed : Verdict::WithinTolerance;
}

/// The ranges over the points of the circuit as ranges over those of the file. The seam stands at
/// both ends of the circuit; the first piece keeps it.
std::optional<std::vector<PointRange>> RangesInFile(Circuit const& circuit,
                                                    std::vector<Piece> const& pieces) {
  std::optional<std::vector<PointRange>> ranges = AssignPoints(circuit.points, pieces);
  if (!ranges) return ranges;
  for (PointRange& range : *ranges) {
    if (range.first + range.count == circuit.points.size() && range.count > 0) --range.count;
    range.first = circuit.origin[range.first];
  }
  return ranges;
}

/// A report that knows what the fit began with and what it answered, and nothing measured yet.
FitReport ReportOf(FitInput input, Strategy strategy, FitAnswer fit) {
  FitReport report;
  report.file = std::move(input.file);
  report.toleranceSource = std::move(input.toleranceSource);
  report.closure = std::move(input.closure);
  report.strategy = strategy;
  report.fit = std::move(fit);
  return report;
}

}  // namespace

std::size_t FitReport::ArcCount() const {
  return static_cast<std::size_t>(std::count_if(pieces.begin(), pieces.end(),
                                                [](Piece const& piece) { return piece.IsArc(); }));
}

std::size_t FitReport::LineCount() const { return pieces.size() - ArcCount(); }

double FitReport::SmallestTolerance() const {
  return std::min_element(file.points.begin(), file.points.end(), ByTolerance)->w;
}

double FitReport::LargestTolerance() const {
  return std::max_element(file.points.begin(), file.points.end(), ByTolerance)->w;
}

double FitReport::Gap() const { return GapOf(pieces); }

FitReport::Deviation FitReport::LargestDeviation() const {
  bool const reportsRelative = !isFullCircle && IsDeviationRelative(strategy);
  double const measured = remeasured.Worst().relative;
  // Written so that what is not a number counts as the larger.
  if (!reportsRelative || fit.deviation <= measured) return {measured, remeasured.worst};
  if (fit.deviationIndex < 0) return {fit.deviation, remeasured.worst};
  return {fit.deviation, static_cast<std::size_t>(fit.deviationIndex)};
}

bool FitReport::IsFewest() const { return fit.fewestPossible == pieces.size(); }

FitReport MakeReport(FitInput input, Strategy strategy, FitAnswer fit) {
  FitReport report = ReportOf(std::move(input), strategy, std::move(fit));
  report.pieces = PiecesOf(report.fit.contour);
  report.ranges =
      report.fit.ranges ? report.fit.ranges : AssignPoints(report.file.points, report.pieces);
  report.remeasured = Remeasure(report.file.points, report.pieces);
  report.verdict = Judge(report, ReachesLastPoint(report.file.points, report.pieces, strategy));
  return report;
}

FitReport MakeClosedReport(FitInput input, Strategy strategy, FitAnswer fit, Circuit const& circuit,
                           std::optional<std::vector<Piece>> circle) {
  FitReport report = ReportOf(std::move(input), strategy, std::move(fit));
  report.seam = circuit.origin.front();
  report.isFullCircle = circle.has_value();
  report.pieces = circle ? std::move(*circle) : PiecesOf(report.fit.contour);
  bool const reachesLastPoint =
      report.isFullCircle || ReachesLastPoint(circuit.points, report.pieces, strategy);
  if (reachesLastPoint) CloseExactly(circuit.points, &report.pieces);
  report.ranges = RangesInFile(circuit, report.pieces);
  report.remeasured = Remeasure(report.file.points, report.pieces);
  if (report.fit.deviationIndex >= 0) {
    auto const inCircuit = static_cast<std::size_t>(report.fit.deviationIndex);
    report.fit.deviationIndex = static_cast<std::int32_t>(circuit.origin[inCircuit]);
  }
  report.verdict = Judge(report, reachesLastPoint);
  return report;
}

std::vector<PieceMeasure> MeasurePieces(FitReport const& report) {
  return MeasurePieces(report.file.points, report.remeasured.points, report.pieces,
                       report.closure.isClosed);
}

DeviationSummary Summarise(FitReport const& report) {
  return Summarise(report.file.points, report.remeasured.points, true);
}

std::string Describe(Verdict verdict) {
  switch (verdict) {
    case Verdict::WithinTolerance:
      return "within tolerance";
    case Verdict::OutsideTolerance:
      return "OUTSIDE TOLERANCE";
    case Verdict::NotClosed:
      return "NOT CLOSED: the ends of a closed contour do not meet";
    case Verdict::StopsEarly:
      return "NO FIT: the contour stops before the last point";
  }
  return "unknown";
}

}  // namespace Vorn::IO
