#include "vorn/io/Drawing.h"

#include <algorithm>
#include <filesystem>
#include <utility>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

namespace {

bool ByTolerance(WPoint const& a, WPoint const& b) { return a.w < b.w; }

std::string WithUnits(std::string text, Drawing const& drawing) {
  return drawing.units.empty() ? text : std::move(text) + " " + drawing.units;
}

std::string DescribeBound(FitReport const& report) {
  std::string const pieces = Counted(report.pieces.size(), "piece");
  if (report.IsFewest()) return pieces + ", proven the fewest";
  return pieces + ", " + std::to_string(*report.fit.fewestPossible) + " at least";
}

}  // namespace

bool Drawing::HasTolerances() const {
  return !points.empty() &&
         std::all_of(points.begin(), points.end(), [](WPoint const& point) { return point.w > 0; });
}

bool Drawing::IsToleranceUniform() const { return SmallestTolerance() == LargestTolerance(); }

double Drawing::SmallestTolerance() const {
  return std::min_element(points.begin(), points.end(), ByTolerance)->w;
}

double Drawing::LargestTolerance() const {
  return std::max_element(points.begin(), points.end(), ByTolerance)->w;
}

std::size_t Drawing::ArcCount() const {
  return static_cast<std::size_t>(std::count_if(pieces.begin(), pieces.end(),
                                                [](Piece const& piece) { return piece.IsArc(); }));
}

bool Drawing::IsClosed() const { return HasContour() && ReturnsToStart(pieces); }

void Drawing::RequireContent() const {
  if (!points.empty() || HasContour()) return;
  throw Failure(FailureKind::BadArgument, "there is nothing to draw: no points and no pieces");
}

std::size_t Drawing::Worst() const {
  bool const isRelative = HasTolerances();
  auto const largest = std::max_element(
      deviations.begin(), deviations.end(), [&](PointDeviation const& a, PointDeviation const& b) {
        return isRelative ? a.relative < b.relative : a.distance < b.distance;
      });
  return static_cast<std::size_t>(largest - deviations.begin());
}

Drawing DrawingOf(FitReport const& report) {
  Drawing drawing;
  drawing.title = std::filesystem::path(report.file.path).filename().string();
  drawing.units = report.file.units;
  drawing.points = report.file.points;
  drawing.pieces = report.pieces;
  drawing.deviations = report.remeasured.points;
  drawing.verdict = report.verdict;
  drawing.head = report.head;
  drawing.facts = {DescribeTolerance(drawing), "strategy " + NameOf(report.strategy)};
  if (report.fit.fewestPossible) drawing.facts.push_back(DescribeBound(report));
  if (report.closure.isClosed && report.Gap() != 0.0) {
    drawing.facts.push_back(WithUnits("GAP of " + FormatShort(report.Gap()), drawing) + " at " +
                            report.file.NameOf(report.seam));
  }
  return drawing;
}

Drawing DrawingOf(ContourFile const& contour) {
  Drawing drawing = MakeDrawing({}, contour.pieces);
  drawing.title = contour.path == kStandardInput
                      ? kStandardInputName
                      : std::filesystem::path(contour.path).filename().string();
  drawing.units = contour.units;
  std::string const gaps = DescribeGaps(contour);
  if (!gaps.empty()) drawing.facts.push_back(gaps);
  return drawing;
}

Drawing MakeDrawing(std::vector<WPoint> points, std::vector<Piece> pieces) {
  Drawing drawing;
  drawing.points = std::move(points);
  drawing.pieces = std::move(pieces);
  if (drawing.HasTolerances()) drawing.facts = {DescribeTolerance(drawing)};
  if (drawing.points.empty() || !drawing.HasContour()) return drawing;
  Remeasured measured = Remeasure(drawing.points, drawing.pieces);
  if (drawing.HasTolerances()) {
    bool const isWithin = AreWithinTolerance(measured, drawing.points);
    drawing.verdict = isWithin ? Verdict::WithinTolerance : Verdict::OutsideTolerance;
  }
  drawing.deviations = std::move(measured.points);
  return drawing;
}

std::string DescribeGaps(ContourFile const& contour) {
  std::vector<Gap> const gaps = FindGaps(contour);
  if (gaps.empty()) return "";
  Gap const& widest = *std::max_element(gaps.begin(), gaps.end(),
                                        [](Gap const& a, Gap const& b) { return a.size < b.size; });
  std::string const units = contour.units.empty() ? "" : " " + contour.units;
  std::string const text = "GAP of " + FormatShort(widest.size) + units + " between pieces " +
                           std::to_string(widest.before + 1) + " and " +
                           std::to_string(widest.after + 1);
  return gaps.size() == 1 ? text : text + ", the widest of " + std::to_string(gaps.size());
}

std::string Drawn(Drawing const& drawing, Format format, PngSize const& size) {
  if (format == Format::Html) return ToHtml(drawing);
  return format == Format::Png ? ToPng(drawing, size) : ToSvg(drawing);
}

std::string DescribeTolerance(Drawing const& drawing) {
  if (!drawing.HasTolerances()) return "";
  std::string range = FormatShort(drawing.SmallestTolerance());
  if (!drawing.IsToleranceUniform()) range += " to " + FormatShort(drawing.LargestTolerance());
  return WithUnits("tolerance " + range, drawing);
}

}  // namespace Vorn::IO
