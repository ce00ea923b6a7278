#include <algorithm>
#include <cmath>
#include <nlohmann/json.hpp>

#include "io/measure/MeasureJson.h"
#include "vorn/io/CheckReport.h"
#include "vorn/io/PieceMeasures.h"

namespace Vorn::IO {

namespace {

using Json = nlohmann::ordered_json;

constexpr int kSchemaVersion = 1;

Json TextOrNull(std::string const& text) { return text.empty() ? Json(nullptr) : Json(text); }

Json PointsJson(CheckReport const& report) {
  return {{"file", report.file.path},
          {"count", report.file.points.size()},
          {"units", TextOrNull(report.file.units)}};
}

Json ContourJson(CheckReport const& report) {
  std::vector<Piece> const& pieces = report.contour.pieces;
  auto const arcs = static_cast<std::size_t>(std::count_if(
      pieces.begin(), pieces.end(), [](Piece const& piece) { return piece.IsArc(); }));
  double length = 0.0;
  for (Piece const& piece : pieces) length += piece.length;
  return {{"file", report.contour.path},
          {"pieces", pieces.size()},
          {"lines", pieces.size() - arcs},
          {"arcs", arcs},
          {"length", length},
          {"closed", report.contour.isClosed},
          {"units", TextOrNull(report.contour.units)}};
}

Json ToleranceJson(CheckReport const& report) {
  if (!report.HasTolerances()) return nullptr;
  auto const [smallest, largest] =
      std::minmax_element(report.file.points.begin(), report.file.points.end(),
                          [](WPoint const& a, WPoint const& b) { return a.w < b.w; });
  return {{"source", report.toleranceSource}, {"smallest", smallest->w}, {"largest", largest->w}};
}

Json DeviationJson(CheckReport const& report, std::size_t point) {
  WPoint const& measured = report.file.points[point];
  PointDeviation const& deviation = report.deviations[point];
  Json line = nullptr;
  if (std::optional<std::size_t> const known = report.file.LineOf(point)) line = *known;
  Json json = {{"point", point},
               {"line", line},
               {"x", measured.x},
               {"y", measured.y},
               {"deviation", SignedDistance(deviation)},
               {"piece", deviation.piece + 1}};
  if (!report.HasTolerances()) return json;
  json["tolerance"] = measured.w;
  json["relative"] = deviation.relative;
  return json;
}

/// What the points of each piece say by themselves.
Json MeasuresJson(CheckReport const& report) {
  ContourFile const& contour = report.contour;
  Json pieces = Json::array();
  for (PieceMeasure const& measure :
       MeasurePieces(report.file.points, report.deviations, contour.pieces, contour.isClosed)) {
    pieces.push_back({{"piece", pieces.size() + 1},
                      {"points", measure.points},
                      {"leastSquares", LeastSquaresJson(measure)},
                      {"turn", OrNull(measure.turn)}});
  }
  return pieces;
}

Json ScatterJson(CheckReport const& report) {
  DeviationSummary const summary =
      Summarise(report.file.points, report.deviations, report.HasTolerances());
  return {{"mean", summary.mean},
          {"rootMeanSquare", summary.rootMeanSquare},
          {"histogram", HistogramJson(summary)}};
}

Json GapsJson(CheckReport const& report) {
  Json gaps = Json::array();
  for (Gap const& gap : report.gaps) {
    gaps.push_back({{"before", gap.before + 1}, {"after", gap.after + 1}, {"size", gap.size}});
  }
  return gaps;
}

Json MeetingsJson(CheckReport const& report) {
  Json meetings = Json::array();
  for (Intersection const& one : report.meetings) {
    meetings.push_back({{"kind", NameOf(one.kind)},
                        {"x", one.at.x},
                        {"y", one.at.y},
                        {"pieces", {one.a.piece + 1, one.b.piece + 1}}});
  }
  return meetings;
}

Json AreaJson(CheckReport const& report) {
  if (!report.signedArea) return nullptr;
  return {{"value", std::fabs(*report.signedArea)},
          {"direction", *report.signedArea > 0.0 ? "ccw" : "cw"}};
}

char const* ResultName(CheckReport const& report) {
  if (!report.HasTolerances()) return "measured";
  return report.outside.empty() ? "within tolerance" : "outside tolerance";
}

}  // namespace

std::string ToJson(CheckReport const& report) {
  Json worst = nullptr;
  Json outside = nullptr;
  if (report.HasTolerances()) {
    worst = DeviationJson(report, report.worst);
    outside = report.outside;
  }
  Json deviations = Json::array();
  for (std::size_t i = 0; i < report.deviations.size(); ++i) {
    deviations.push_back(DeviationJson(report, i));
  }
  Json const document = {
      {"schemaVersion", kSchemaVersion},
      {"points", PointsJson(report)},
      {"contour", ContourJson(report)},
      {"tolerance", ToleranceJson(report)},
      {"result", ResultName(report)},
      {"largest", DeviationJson(report, report.furthest)},
      {"relative", worst},
      {"outside", outside},
      {"scatter", ScatterJson(report)},
      {"pieces", MeasuresJson(report)},
      {"gaps", GapsJson(report)},
      {"crosses", !report.meetings.empty()},
      {"meetings", MeetingsJson(report)},
      {"area", AreaJson(report)},
      {"deviations", deviations},
  };
  // A file name need not be UTF-8; a replacement character is better than no document.
  return document.dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
}

}  // namespace Vorn::IO
