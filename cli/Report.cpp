#include "cli/Report.h"

#include <algorithm>
#include <utility>

namespace Vorn::Cli {

namespace {

bool ByTolerance(WPoint const& a, WPoint const& b) { return a.w < b.w; }

/// Written so that a deviation that is not a number is outside.
bool IsWithin(double relative) { return relative <= kLargestRelative; }

Verdict Judge(Report const& report) {
  if (!ReachesLastPoint(report.file.points, report.pieces, report.strategy)) {
    return Verdict::StopsEarly;
  }
  bool const reportedWithin =
      !IsDeviationRelative(report.strategy) || IsWithin(report.fit.deviation);
  bool const within = reportedWithin && IsWithin(report.remeasured.Worst().relative);
  return within ? Verdict::WithinTolerance : Verdict::OutsideTolerance;
}

}  // namespace

std::size_t Report::ArcCount() const {
  return static_cast<std::size_t>(std::count_if(pieces.begin(), pieces.end(),
                                                [](Piece const& piece) { return piece.IsArc(); }));
}

std::size_t Report::LineCount() const { return pieces.size() - ArcCount(); }

double Report::SmallestTolerance() const {
  return std::min_element(file.points.begin(), file.points.end(), ByTolerance)->w;
}

double Report::LargestTolerance() const {
  return std::max_element(file.points.begin(), file.points.end(), ByTolerance)->w;
}

Report MakeReport(PointFile file, std::string toleranceSource,
                  GeometryUtils::FittingStrategy strategy, FitAnswer fit) {
  Report report;
  report.file = std::move(file);
  report.toleranceSource = std::move(toleranceSource);
  report.strategy = strategy;
  report.fit = std::move(fit);
  report.pieces = PiecesOf(report.fit.contour);
  report.ranges = AssignPoints(report.file.points, report.pieces);
  report.remeasured = Remeasure(report.file.points, report.pieces);
  report.verdict = Judge(report);
  return report;
}

std::string Describe(Verdict verdict) {
  switch (verdict) {
    case Verdict::WithinTolerance:
      return "within tolerance";
    case Verdict::OutsideTolerance:
      return "OUTSIDE TOLERANCE";
    case Verdict::StopsEarly:
      return "NO FIT: the contour stops before the last point";
  }
  return "unknown";
}

ExitCode ExitCodeOf(Verdict verdict) {
  switch (verdict) {
    case Verdict::WithinTolerance:
      return ExitCode::Ok;
    case Verdict::OutsideTolerance:
      return ExitCode::OutsideTolerance;
    case Verdict::StopsEarly:
      return ExitCode::NoFit;
  }
  return ExitCode::Internal;
}

}  // namespace Vorn::Cli
