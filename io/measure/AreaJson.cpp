#include <cmath>
#include <nlohmann/json.hpp>

#include "vorn/io/ContourArea.h"

namespace Vorn::IO {

namespace {

using Json = nlohmann::ordered_json;

constexpr int kSchemaVersion = 1;

Json PointJson(XY const& point) { return {{"x", point.x}, {"y", point.y}}; }

Json AreaJson(ContourArea const& area) {
  Json gaps = Json::array();
  for (Gap const& gap : area.gaps) {
    gaps.push_back({{"before", gap.before + 1}, {"after", gap.after + 1}, {"size", gap.size}});
  }
  std::string const& units = area.contour.units;
  return {
      {"file", area.contour.path},
      {"units", units.empty() ? Json(nullptr) : Json(units)},
      {"pieces", area.contour.pieces.size()},
      {"area", std::fabs(area.signedArea)},
      {"signedArea", area.signedArea},
      {"sense", SenseOf(area)},
      {"perimeter", area.perimeter},
      {"centroid", area.centroid ? PointJson(*area.centroid) : Json(nullptr)},
      {"box", {{"low", PointJson(area.extent.low)}, {"high", PointJson(area.extent.high)}}},
      {"crossesItself", area.crossesItself},
      {"gaps", gaps},
      {"outline", area.outline == 0 ? Json(nullptr) : Json(area.outline)},
      {"isHole", area.IsHole()},
  };
}

}  // namespace

std::string ToJson(std::vector<ContourArea> const& areas) {
  Json list = Json::array();
  for (ContourArea const& area : areas) list.push_back(AreaJson(area));
  Json const document = {
      {"schemaVersion", kSchemaVersion}, {"contours", list}, {"netArea", NetArea(areas)}};
  // A file name need not be UTF-8; a replacement character is better than no document.
  return document.dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
}

}  // namespace Vorn::IO
