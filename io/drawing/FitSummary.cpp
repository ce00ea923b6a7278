#include "vorn/io/FitSummary.h"

#include <algorithm>
#include <cmath>

#include "SummaryParts.h"
#include "io/drawing/Layout.h"
#include "io/drawing/SvgElements.h"
#include "io/drawing/SvgPaths.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr double kPictureWidth = 132.0;
constexpr double kPictureHeight = 84.0;

/// What is not a number is larger than all.
bool IsLarger(double a, double b) { return std::isnan(a) ? !std::isnan(b) : a > b; }

/// Without a contour first, then the largest deviation.
bool IsWorse(SummaryRow const& a, SummaryRow const& b) {
  if (!a.isFitted || !b.isFitted) return !a.isFitted && b.isFitted;
  if (a.isWithin != b.isWithin) return b.isWithin;
  return IsLarger(a.deviation, b.deviation);
}

/// All rows together; its deviation is the largest one.
SummaryRow TotalOf(std::vector<SummaryRow> const& rows) {
  SummaryRow total;
  total.path = "total";
  std::size_t within = 0;
  for (SummaryRow const& row : rows) {
    if (row.isWithin) ++within;
    if (!row.isFitted) continue;
    total.isFitted = true;
    total.points += row.points;
    total.lines += row.lines;
    total.arcs += row.arcs;
    total.outside += row.outside;
    if (IsLarger(row.deviation, total.deviation)) total.deviation = row.deviation;
  }
  total.isWithin = within == rows.size();
  total.result =
      std::to_string(within) + " of " + Counted(rows.size(), "file") + " within tolerance";
  return total;
}

std::string CsvField(std::string const& text) {
  if (text.find_first_of(",\"\r\n") == std::string::npos) return text;
  std::string quoted = "\"";
  for (char const c : text) quoted += c == '"' ? "\"\"" : std::string(1, c);
  return quoted + "\"";
}

std::string CsvRow(SummaryRow const& row, bool isTotal) {
  std::string text = CsvField(row.path) + "," + CsvField(row.result);
  if (!row.isFitted) return text + ",,,,,,\n";
  return text + "," + std::to_string(row.points) + "," + std::to_string(row.lines) + "," +
         std::to_string(row.arcs) + "," + FormatExact(row.deviation) + "," +
         std::to_string(row.outside) + "," + (isTotal ? "" : FormatExact(row.rootMeanSquare)) +
         "\n";
}

std::string Cell(std::string const& text) { return "<td>" + Svg::Escaped(text) + "</td>"; }

std::string HtmlRow(SummaryRow const& row, bool isTotal) {
  std::string html = row.isWithin ? "<tr>" : "<tr class=\"bad\">";
  html += "<td>" + row.picture + "</td>" + Cell(Printable(row.path)) + Cell(Printable(row.result));
  if (!row.isFitted)
    return html + std::string("<td></td><td></td><td></td><td></td><td></td><td></td></tr>\n");
  for (std::size_t const count : {row.points, row.lines, row.arcs})
    html += Cell(std::to_string(count));
  return html + Cell(FormatRelative(row.deviation)) + Cell(std::to_string(row.outside)) +
         Cell(isTotal ? "" : FormatShort(row.rootMeanSquare, 4)) + "</tr>\n";
}

std::string HeadHtml(ReportHead const& head) {
  std::string html;
  for (ReportField const& field : head.fields) {
    html +=
        "<span>" + Svg::Escaped(field.name) + " <b>" + Svg::Escaped(field.value) + "</b></span>\n";
  }
  return html;
}

std::string Replaced(std::string text, std::string const& mark, std::string const& by) {
  std::size_t const at = text.find(mark);
  return text.replace(at, mark.size(), by);
}

std::string PictureOf(FitReport const& report) {
  Svg::View const view(Svg::BoxAround(MakeDrawing({}, report.pieces)), 0.0, 0.0, kPictureWidth,
                       kPictureHeight, kPictureHeight);
  return "<svg viewBox=\"0 0 " + Svg::Px(kPictureWidth) + " " + Svg::Px(kPictureHeight) + "\">" +
         Svg::PathElement(Svg::PathData(report.pieces, view), "class=\"contour\"") + "</svg>";
}

}  // namespace

SummaryRow SummaryRowOf(FitReport const& report, Verdict verdict) {
  DeviationSummary const summary = Summarise(report);
  SummaryRow row;
  row.path = report.file.path;
  row.result = Describe(verdict);
  row.isFitted = true;
  row.isWithin = verdict == Verdict::WithinTolerance;
  row.points = report.file.points.size();
  row.lines = report.LineCount();
  row.arcs = report.ArcCount();
  row.outside = summary.outside;
  row.deviation = report.LargestDeviation().relative;
  row.rootMeanSquare = summary.rootMeanSquare;
  row.picture = PictureOf(report);
  return row;
}

std::string SummaryCsv(std::vector<SummaryRow> rows) {
  std::stable_sort(rows.begin(), rows.end(), IsWorse);
  std::string csv = "file,result,points,lines,arcs,largest_deviation,outside,root_mean_square\n";
  for (SummaryRow const& row : rows) csv += CsvRow(row, false);
  return csv + CsvRow(TotalOf(rows), true);
}

std::string SummaryHtml(std::vector<SummaryRow> rows, ReportHead const& head) {
  std::stable_sort(rows.begin(), rows.end(), IsWorse);
  std::string body;
  for (SummaryRow const& row : rows) body += HtmlRow(row, false);
  // From the last mark of the page to the first, so that no mark is looked for behind a text of the
  // user, which may hold one as well.
  std::string page = Replaced(Html::kSummary, "{{rows}}", body);
  page = Replaced(std::move(page), "{{total}}", HtmlRow(TotalOf(rows), true));
  page = Replaced(std::move(page), "{{program}}", Svg::Escaped(head.program));
  return Replaced(std::move(page), "{{fields}}", HeadHtml(head));
}

}  // namespace Vorn::IO
