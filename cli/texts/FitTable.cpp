#include "cli/texts/FitTable.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "cli/texts/Columns.h"
#include "cli/texts/LengthFormat.h"
#include "cli/texts/MeasureTable.h"
#include "cli/texts/Relative.h"
#include "cli/texts/ScatterText.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

Row Header() {
  return {"no",       "kind",   "start x",   "start y", "end x",  "end y", "centre x",
          "centre y", "radius", "direction", "sweep",   "length", "points"};
}

Row PieceRow(FitReport const& report, std::size_t i, LengthFormat const& length) {
  Piece const& piece = report.pieces[i];
  Row row = {std::to_string(i + 1), piece.IsArc() ? "arc" : "line",
             length(piece.start.x), length(piece.start.y),
             length(piece.end.x),   length(piece.end.y)};
  if (piece.IsArc()) {
    double const degrees = piece.sweep * 180.0 / std::numbers::pi;
    row.insert(row.end(), {length(piece.center.x), length(piece.center.y), length(piece.radius),
                           piece.counterClockwise ? "ccw" : "cw", FormatFixed(degrees, 3)});
  } else {
    row.insert(row.end(), 5, "-");
  }
  row.push_back(length(piece.length));
  row.push_back(report.ranges ? std::to_string((*report.ranges)[i].count) : "-");
  return row;
}

std::string WithUnits(std::string const& number, FitReport const& report) {
  return report.file.units.empty() ? number : number + " " + report.file.units;
}

std::string ToleranceText(FitReport const& report) {
  double const smallest = report.SmallestTolerance();
  double const largest = report.LargestTolerance();
  std::string text = FormatShort(smallest);
  if (smallest != largest) text += " to " + FormatShort(largest);
  return WithUnits(text, report) + " (" + report.toleranceSource + ")";
}

std::string ReportedText(FitReport const& report) {
  FitAnswer const& fit = report.fit;
  if (report.isFullCircle) return "nothing: a full circle is fitted by the program itself";
  if (!IsDeviationRelative(report.strategy)) {
    return WithUnits(FormatShort(fit.deviation), report) +
           " as a length (this strategy reports no relative deviation and no point)";
  }
  std::string const text = RelativeText(fit.deviation) + " of the tolerance";
  if (fit.deviationIndex < 0) return text + ", exact by construction";
  return text + " at " + report.file.NameOf(static_cast<std::size_t>(fit.deviationIndex));
}

std::string RemeasuredText(FitReport const& report) {
  PointDeviation const& worst = report.remeasured.Worst();
  return RelativeText(worst.relative) + " of the tolerance at " +
         report.file.NameOf(report.remeasured.worst) + ", " +
         WithUnits(FormatShort(worst.distance), report) + " from piece " +
         std::to_string(worst.piece + 1);
}

std::string LargestText(FitReport const& report) {
  FitReport::Deviation const largest = report.LargestDeviation();
  return RelativeText(largest.relative) + " of the tolerance at " +
         report.file.NameOf(largest.point) + ", the largest that was found";
}

std::string ClosedText(FitReport const& report) {
  Closure const& closure = report.closure;
  if (!closure.isClosed) return "no" + (closure.reason.empty() ? "" : " (" + closure.reason + ")");
  std::string const seam = report.file.NameOf(report.seam);
  std::string const text = "yes (" + closure.reason + "), ";
  if (report.Gap() == 0.0) return text + "joined exactly at " + seam;
  return text + "GAP of " + WithUnits(FormatShort(report.Gap()), report) + " at " + seam;
}

/// "29 (26 at least): 1 line, 28 arcs".
std::string PiecesText(FitReport const& report) {
  std::string text = std::to_string(report.pieces.size());
  if (report.IsFewest()) {
    text += " (proven the fewest)";
  } else if (report.fit.fewestPossible) {
    text += " (" + std::to_string(*report.fit.fewestPossible) + " at least)";
  }
  return text + ": " + Counted(report.LineCount(), "line") + ", " +
         Counted(report.ArcCount(), "arc");
}

std::string CompressionText(FitReport const& report) {
  auto const points = static_cast<double>(report.file.points.size());
  auto const pieces = static_cast<double>(report.pieces.size());
  return FormatFixed(points / pieces, 1) + " points a piece, " +
         FormatFixed(100.0 * pieces / points, 1) + " % of the points";
}

std::string FieldsText(FitReport const& report) {
  std::string text;
  for (ReportField const& field : report.head.fields) {
    // A long name keeps a blank behind it.
    text += Fact(field.name + " ", field.value);
  }
  return text;
}

std::string ScatterOfPoints(FitReport const& report) {
  DeviationSummary const summary = Summarise(report);
  return ScatterText(summary, report.file.units) + ", " +
         OutsideText(summary.outside, report.file.points.size()) + " outside";
}

std::string Summary(FitReport const& report, std::string const& readBack) {
  return FieldsText(report) + "points      " + std::to_string(report.file.points.size()) + "\n" +
         (report.file.columns.empty() ? "" : "columns     " + report.file.columns + "\n") +
         (report.file.skipped.empty() ? "" : Fact("skipped", report.file.skipped)) +
         "tolerance   " + ToleranceText(report) + "\n" + "strategy    " + NameOf(report.strategy) +
         "\n" + "closed      " + ClosedText(report) + "\n" + "pieces      " + PiecesText(report) +
         "\n" + "compression " + CompressionText(report) + "\n" + "reported    " +
         ReportedText(report) + "\n" + "re-measured " + RemeasuredText(report) + "\n" +
         "deviation   " + LargestText(report) + "\n" + "scatter     " + ScatterOfPoints(report) +
         "\n" + (readBack.empty() ? "" : "read back   " + readBack + "\n") + "result      " +
         Describe(report.verdict) + "\n" + "time        " + FormatFixed(report.fit.seconds, 3) +
         " s\n";
}

}  // namespace

std::string ToTable(FitReport const& report, std::optional<int> digits,
                    std::string const& readBack) {
  LengthFormat const length(report.SmallestTolerance(), digits);
  std::vector<Row> rows = {Header()};
  for (std::size_t i = 0; i < report.pieces.size(); ++i) {
    rows.push_back(PieceRow(report, i, length));
  }
  std::string const units = report.file.units.empty() ? "" : ", lengths in " + report.file.units;
  return report.file.path + units + ", sweeps in degrees\n\n" +
         Aligned(rows, {"kind", "direction"}) + "\n" +
         MeasureTable(report.pieces, MeasurePieces(report), length) + "\n" +
         Summary(report, readBack);
}

}  // namespace Vorn::Cli
