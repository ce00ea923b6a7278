#include <nlohmann/json.hpp>

#include "io/formats/JsonPieces.h"
#include "io/measure/MeasureJson.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/Formats.h"
#include "vorn/io/JoinedFit.h"

namespace Vorn::IO {

namespace {

using Json = nlohmann::ordered_json;

Json InputJson(FitReport const& report) {
  Json units = nullptr;
  if (!report.file.units.empty()) units = report.file.units;
  Json json = {
      {"file", report.file.path},
      {"points", report.file.points.size()},
      {"columns", report.file.columns},
      {"units", units},
      {"tolerance",
       {{"source", report.toleranceSource},
        {"smallest", report.SmallestTolerance()},
        {"largest", report.LargestTolerance()}}},
  };
  if (!report.file.skipped.empty()) json["skipped"] = report.file.skipped;
  return json;
}

Json RangeJson(std::optional<std::vector<PointRange>> const& ranges, std::size_t piece) {
  if (!ranges) return nullptr;
  PointRange const& range = (*ranges)[piece];
  Json first = nullptr;
  if (range.count > 0) first = range.first;
  return {{"first", first}, {"count", range.count}};
}

/// How few pieces there can be at least; null where nobody has proven it.
Json FewestJson(FitReport const& report) {
  if (!report.fit.fewestPossible) return nullptr;
  return *report.fit.fewestPossible;
}

Json ReportedJson(FitReport const& report) {
  bool const hasIndex = report.fit.deviationIndex >= 0;
  Json index = nullptr;
  if (hasIndex) index = report.fit.deviationIndex;
  return {
      {"value", report.fit.deviation},
      {"kind", IsDeviationRelative(report.strategy) ? "relative" : "absolute"},
      {"point", index},
  };
}

/// The larger of the two.
Json LargestJson(FitReport const& report) {
  FitReport::Deviation const largest = report.LargestDeviation();
  return {{"value", largest.relative}, {"kind", "relative"}, {"point", largest.point}};
}

Json RemeasuredJson(FitReport const& report) {
  PointDeviation const& worst = report.remeasured.Worst();
  return {
      {"value", worst.relative},          {"kind", "relative"},
      {"point", report.remeasured.worst}, {"distance", worst.distance},
      {"element", worst.piece + 1},
  };
}

Json ClosureJson(FitReport const& report) {
  bool const isClosed = report.closure.isClosed;
  Json seam = nullptr;
  if (isClosed) seam = report.seam;
  return {{"closed", isClosed}, {"seam", seam}, {"gap", report.Gap()}};
}

char const* VerdictName(Verdict verdict) {
  switch (verdict) {
    case Verdict::WithinTolerance:
      return "within tolerance";
    case Verdict::OutsideTolerance:
      return "outside tolerance";
    case Verdict::NotClosed:
      return "not closed";
    case Verdict::StopsEarly:
      return "stops early";
  }
  return "unknown";
}

Json DeviationsJson(FitReport const& report) {
  DeviationSummary const summary = Summarise(report);
  return {
      {"largest", LargestJson(report)},           {"reported", ReportedJson(report)},
      {"remeasured", RemeasuredJson(report)},     {"mean", summary.mean},
      {"rootMeanSquare", summary.rootMeanSquare}, {"outside", summary.outside},
      {"histogram", HistogramJson(summary)},
  };
}

Json ElementsJson(FitReport const& report) {
  std::vector<PieceMeasure> const measures = MeasurePieces(report);
  Json elements = Json::array();
  for (std::size_t i = 0; i < report.pieces.size(); ++i) {
    Json element = PieceJson(report.pieces[i], i + 1, RangeJson(report.ranges, i));
    element["leastSquares"] = LeastSquaresJson(measures[i]);
    element["turn"] = OrNull(measures[i].turn);
    elements.push_back(std::move(element));
  }
  return elements;
}

Json ProgramJson(FitReport const& report) {
  return report.head.program.empty() ? Json(nullptr) : Json(report.head.program);
}

Json CountsJson(FitReport const& report) {
  return {{"elements", report.pieces.size()},
          {"lines", report.LineCount()},
          {"arcs", report.ArcCount()},
          {"fewestPossible", FewestJson(report)},
          {"isFewest", report.IsFewest()}};
}

Json DocumentJson(FitReport const& report) {
  Json document = {
      {"schemaVersion", kJsonSchemaVersion},
      {"program", ProgramJson(report)},
      {"fields", FieldsJson(report.head)},
      {"input", InputJson(report)},
      {"strategy", NameOf(report.strategy)},
      {"code", static_cast<std::int32_t>(report.fit.code)},
      {"verdict", VerdictName(report.verdict)},
      {"counts", CountsJson(report)},
      {"deviation", DeviationsJson(report)},
  };
  document.update(ClosureJson(report));
  document["elements"] = ElementsJson(report);
  return document;
}

/// A file name need not be UTF-8; a replacement character is better than no document.
std::string TextOf(Json const& document) {
  return document.dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
}

/// What is known of one outline beside the elements, which stand in the list of all.
Json OutlineJson(FitReport const& report, std::size_t firstPoint, std::size_t firstPiece) {
  Json outline = {
      {"points", {{"first", firstPoint}, {"count", report.file.points.size()}}},
      {"elements", {{"first", firstPiece + 1}, {"count", report.pieces.size()}}},
      {"verdict", VerdictName(report.verdict)},
      {"counts", CountsJson(report)},
      {"deviation", DeviationsJson(report)},
  };
  outline.update(ClosureJson(report));
  return outline;
}

}  // namespace

std::string ToJson(FitReport const& report) { return TextOf(DocumentJson(report)); }

std::string ToJson(std::vector<FitReport> const& outlines) {
  Json document = DocumentJson(Joined(outlines));
  Json records = Json::array();
  std::size_t firstPoint = 0;
  std::size_t firstPiece = 0;
  for (FitReport const& outline : outlines) {
    records.push_back(OutlineJson(outline, firstPoint, firstPiece));
    firstPoint += outline.file.points.size();
    firstPiece += outline.pieces.size();
  }
  document["outlines"] = std::move(records);
  return TextOf(document);
}

}  // namespace Vorn::IO
