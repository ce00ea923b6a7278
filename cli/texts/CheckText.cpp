#include "cli/texts/CheckText.h"

#include <algorithm>
#include <cmath>

#include "cli/texts/Columns.h"
#include "cli/texts/LengthFormat.h"
#include "cli/texts/MeasureTable.h"
#include "cli/texts/Relative.h"
#include "cli/texts/ScatterText.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/PieceMeasures.h"

namespace Vorn::Cli {

namespace {

/// Gaps and places where the contour meets itself are listed up to here.
constexpr std::size_t kMostPlaces = 10;

/// Of the contour, what its lengths are told as finely as a tolerance of this size would ask.
constexpr double kFineness = 1e-3;

std::string PlaceOf(CheckReport const& report, std::size_t point) {
  PointDeviation const& deviation = report.deviations[point];
  return report.file.NameOf(point) + ", to the " + (deviation.isLeft ? "left" : "right") +
         " of piece " + std::to_string(deviation.piece + 1);
}

double LengthOf(CheckReport const& report) {
  double length = 0.0;
  for (Piece const& piece : report.contour.pieces) length += piece.length;
  return length;
}

std::string PiecesText(CheckReport const& report) {
  std::vector<Piece> const& pieces = report.contour.pieces;
  auto const arcs = static_cast<std::size_t>(std::count_if(
      pieces.begin(), pieces.end(), [](Piece const& piece) { return piece.IsArc(); }));
  return std::to_string(pieces.size()) + ": " + Counted(pieces.size() - arcs, "line") + ", " +
         Counted(arcs, "arc") + ", " + FormatShort(LengthOf(report)) + " long, " +
         (report.contour.isClosed ? "closed" : "open");
}

std::string DeviationFacts(CheckReport const& report) {
  std::string text = Fact("largest", FormatShort(report.deviations[report.furthest].distance) +
                                         " at " + PlaceOf(report, report.furthest));
  DeviationSummary const summary =
      Summarise(report.file.points, report.deviations, report.HasTolerances());
  text += Fact("scatter", ScatterText(summary, report.file.units));
  if (!report.HasTolerances()) return text;
  text += Fact("relative", RelativeText(report.deviations[report.worst].relative) +
                               " of the tolerance at " + PlaceOf(report, report.worst));
  return text + Fact("outside", OutsideText(report.outside.size(), report.file.points.size()));
}

bool HasSmallerTolerance(WPoint const& a, WPoint const& b) { return a.w < b.w; }

std::string ToleranceText(CheckReport const& report) {
  if (!report.HasTolerances()) return "none given: deviations are lengths";
  auto const [smallest, largest] = std::minmax_element(
      report.file.points.begin(), report.file.points.end(), HasSmallerTolerance);
  std::string text = FormatShort(smallest->w);
  if (smallest->w != largest->w) text += " to " + FormatShort(largest->w);
  return text + " (" + report.toleranceSource + ")";
}

/// A line for each, aligned below a fact; the last one counts what is left out.
template <typename T, typename ToLine>
std::string Listed(std::vector<T> const& places, ToLine const& toLine) {
  std::string text;
  for (std::size_t i = 0; i < std::min(places.size(), kMostPlaces); ++i) {
    text += Fact("", toLine(places[i]));
  }
  if (places.size() > kMostPlaces) {
    text += Fact("", "and " + std::to_string(places.size() - kMostPlaces) + " more");
  }
  return text;
}

std::string JointFacts(CheckReport const& report) {
  std::vector<Gap> const& gaps = report.gaps;
  if (gaps.empty()) return Fact("joints", "the pieces meet");
  return Fact("joints", Counted(gaps.size(), "gap")) +
         Listed(gaps, [](Gap const& gap) { return Describe(gap); });
}

std::string PlaceOf(Intersection const& one) {
  return NameOf(one.kind) + " at (" + FormatShort(one.at.x) + ", " + FormatShort(one.at.y) +
         ") of pieces " + std::to_string(one.a.piece + 1) + " and " +
         std::to_string(one.b.piece + 1);
}

std::string CrossingFacts(CheckReport const& report) {
  std::vector<Intersection> const& meetings = report.meetings;
  if (meetings.empty()) return Fact("crossing", "the contour does not cross itself");
  return Fact("crossing", "THE CONTOUR CROSSES OR TOUCHES ITSELF: " + Describe(Tally(meetings))) +
         Listed(meetings, [](Intersection const& one) { return PlaceOf(one); });
}

std::string AreaText(CheckReport const& report) {
  if (!report.contour.isClosed) return "none: the contour is open";
  if (!report.signedArea) return "none: the contour crosses itself";
  return FormatShort(std::fabs(*report.signedArea)) + ", " +
         (*report.signedArea > 0.0 ? "counter-clockwise" : "clockwise") + " (y up)";
}

std::string ResultText(CheckReport const& report) {
  if (!report.HasTolerances()) return "measured";
  return report.outside.empty() ? "within tolerance" : "OUTSIDE TOLERANCE";
}

std::string Summary(CheckReport const& report) {
  std::string const& columns = report.file.columns;
  return Fact("points", std::to_string(report.file.points.size())) +
         (columns.empty() ? "" : Fact("columns", columns)) +
         (report.file.skipped.empty() ? "" : Fact("skipped", report.file.skipped)) +
         Fact("pieces", PiecesText(report)) + Fact("tolerance", ToleranceText(report)) +
         DeviationFacts(report) + JointFacts(report) + CrossingFacts(report) +
         Fact("area", AreaText(report)) + Fact("result", ResultText(report));
}

Row Header(CheckReport const& report) {
  Row row = {"point", "line", "x", "y", "deviation", "piece"};
  if (report.HasTolerances()) row.insert(row.end(), {"tolerance", "relative"});
  return row;
}

Row PointRow(CheckReport const& report, std::size_t point) {
  WPoint const& measured = report.file.points[point];
  PointDeviation const& deviation = report.deviations[point];
  std::optional<std::size_t> const line = report.file.LineOf(point);
  Row row = {std::to_string(point),
             line ? std::to_string(*line) : "-",
             FormatShort(measured.x),
             FormatShort(measured.y),
             FormatShort(SignedDistance(deviation)),
             std::to_string(deviation.piece + 1)};
  if (report.HasTolerances()) {
    row.push_back(FormatShort(measured.w));
    row.push_back(RelativeText(deviation.relative));
  }
  return row;
}

/// Lengths to a hundredth of the smallest tolerance, without one of a thousandth of the contour.
LengthFormat LengthFormatOf(CheckReport const& report) {
  if (!report.HasTolerances()) return LengthFormat(kFineness * LengthOf(report));
  std::vector<WPoint> const& points = report.file.points;
  return LengthFormat(std::min_element(points.begin(), points.end(), HasSmallerTolerance)->w);
}

std::string Measures(CheckReport const& report) {
  ContourFile const& contour = report.contour;
  std::vector<PieceMeasure> const measures =
      MeasurePieces(report.file.points, report.deviations, contour.pieces, contour.isClosed);
  return MeasureTable(contour.pieces, measures, LengthFormatOf(report));
}

}  // namespace

std::string ToText(CheckReport const& report, std::vector<std::size_t> const& order,
                   std::size_t rows) {
  std::vector<Row> table = {Header(report)};
  for (std::size_t i = 0; i < std::min(rows, order.size()); ++i) {
    table.push_back(PointRow(report, order[i]));
  }
  std::string const& units = report.file.units;
  return report.file.path + " against " + report.contour.path +
         (units.empty() ? "" : ", lengths in " + units) + "\n\n" + Summary(report) + "\n" +
         Aligned(table) + "\n" + Measures(report);
}

}  // namespace Vorn::Cli
