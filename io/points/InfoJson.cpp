#include <nlohmann/json.hpp>

#include "vorn/io/InfoReport.h"

namespace Vorn::IO {

namespace {

using Json = nlohmann::ordered_json;

constexpr int kSchemaVersion = 1;

template <typename Value>
Json OrNull(std::optional<Value> const& value) {
  return value ? Json(*value) : Json(nullptr);
}

Json PointName(PointFile const& file, std::size_t point) {
  return {{"point", point}, {"line", OrNull(file.LineOf(point))}};
}

Json PairNames(PointFile const& file, std::size_t first, std::size_t second) {
  return Json::array({PointName(file, first), PointName(file, second)});
}

Json ExtentJson(PointsBox const& box) {
  return {{"x", Json::array({box.lowX, box.highX})}, {"y", Json::array({box.lowY, box.highY})}};
}

Json SpacingJson(InfoReport const& report) {
  SpacingFacts const& spacing = report.info.spacing;
  return {
      {"least",
       {{"distance", spacing.least},
        {"between", PairNames(report.file, spacing.leastSecond - 1, spacing.leastSecond)}}},
      {"median", spacing.median},
      {"most",
       {{"distance", spacing.most},
        {"between", PairNames(report.file, spacing.mostSecond - 1, spacing.mostSecond)}}},
  };
}

Json DuplicatesJson(InfoReport const& report) {
  Json list = Json::array();
  for (Duplicate const& duplicate : report.info.duplicates) {
    Json json = PointName(report.file, duplicate.later);
    json["repeats"] = PointName(report.file, duplicate.earlier);
    json["neighbours"] = duplicate.areNeighbours;
    list.push_back(json);
  }
  return list;
}

Json CornersJson(InfoReport const& report) {
  Json list = Json::array();
  for (Corner const& corner : report.info.corners) {
    Json json = PointName(report.file, corner.point);
    json["degrees"] = corner.isLeft ? corner.degrees : -corner.degrees;
    json["reversal"] = corner.IsReversal();
    list.push_back(json);
  }
  return list;
}

Json RuleJson(InfoReport const& report) {
  if (!report.rule) return nullptr;
  Json broken = Json::array();
  for (ClosePair const& pair : report.rule->broken) {
    broken.push_back({{"between", PairNames(report.file, pair.first, pair.second)},
                      {"distance", pair.distance},
                      {"needed", pair.needed}});
  }
  return {{"source", report.rule->source},
          {"smallest", report.rule->smallest},
          {"largest", report.rule->largest},
          {"tooClose", broken}};
}

Json SuggestionJson(Suggestion const& suggestion) {
  if (suggestion.way == Suggestion::Way::None) return nullptr;
  Json strategy = nullptr;
  if (suggestion.way == Suggestion::Way::Fewest) strategy = "fewest";
  return {{"option", "--tolerance"},
          {"value", suggestion.tolerance},
          {"strategy", strategy},
          {"reason", suggestion.reason}};
}

}  // namespace

std::string ToJson(InfoReport const& report) {
  PointsInfo const& info = report.info;
  Json units = nullptr;
  if (!report.file.units.empty()) units = report.file.units;
  Json const document = {
      {"schemaVersion", kSchemaVersion},
      {"file", report.file.path},
      {"units", units},
      {"points", report.file.points.size()},
      {"extent", ExtentJson(info.box)},
      {"length", info.spacing.length},
      {"spacing", SpacingJson(report)},
      {"duplicates", DuplicatesJson(report)},
      {"closed",
       {{"isClosed", info.closure.isClosed},
        {"reason", info.closure.reason},
        {"gap", info.closure.gap}}},
      {"corners", CornersJson(report)},
      {"largestTolerance", OrNull(info.largestTolerance)},
      {"tolerance", RuleJson(report)},
      {"noise", OrNull(info.noise)},
      {"suggestion", SuggestionJson(info.suggestion)},
  };
  return document.dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
}

}  // namespace Vorn::IO
