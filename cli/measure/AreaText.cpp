#include <algorithm>
#include <cmath>
#include <nlohmann/json.hpp>

#include "cli/Numbers.h"
#include "cli/measure/ContourArea.h"

namespace Vorn::Cli {

namespace {

using Json = nlohmann::ordered_json;

constexpr int kSchemaVersion = 1;
constexpr int kDigits = 10;
constexpr std::size_t kNameWidth = 12;

std::string Number(double value) { return FormatShort(value, kDigits); }

std::string Fact(std::string name, std::string const& text) {
  name.resize(kNameWidth, ' ');
  return name + text + "\n";
}

std::string PointText(XY const& point) {
  return "(" + Number(point.x) + ", " + Number(point.y) + ")";
}

std::string SenseOf(ContourArea const& area) {
  if (area.signedArea == 0.0) return "none";
  return area.signedArea > 0.0 ? "counter-clockwise" : "clockwise";
}

std::string Heading(ContourArea const& area) {
  std::vector<Piece> const& pieces = area.contour.pieces;
  auto const arcs = static_cast<std::size_t>(std::count_if(
      pieces.begin(), pieces.end(), [](Piece const& piece) { return piece.IsArc(); }));
  std::string const& units = area.contour.units;
  return area.contour.path + ": " + Counted(pieces.size(), "piece") + ", " +
         Counted(pieces.size() - arcs, "line") + ", " + Counted(arcs, "arc") +
         (units.empty() ? "" : ", lengths in " + units) + "\n";
}

std::string CrossingText(ContourArea const& area) {
  std::string const text = Describe(area.crossing);
  if (area.crossing != Crossing::Found) return text;
  return text + ": the area is the sum of its loops, each with its sign";
}

Json PointJson(XY const& point) { return {{"x", point.x}, {"y", point.y}}; }

/// Whether it crosses itself, as far as that is known.
Json CrossesJson(Crossing crossing) {
  if (crossing == Crossing::Found) return true;
  if (crossing == Crossing::None) return false;
  return nullptr;
}

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
      {"crossesItself", CrossesJson(area.crossing)},
      {"gaps", gaps},
  };
}

}  // namespace

std::string ToText(ContourArea const& area) {
  std::string text = Heading(area);
  text += Fact("area", Number(std::fabs(area.signedArea)));
  text += Fact("signed", Number(area.signedArea) + ", positive counter-clockwise with y up");
  text += Fact("sense", SenseOf(area));
  text += Fact("perimeter", Number(area.perimeter));
  text += Fact("centroid", area.centroid ? PointText(*area.centroid) : "none");
  text += Fact("box", PointText(area.extent.low) + " to " + PointText(area.extent.high));
  text += Fact("crossing", CrossingText(area));
  for (Gap const& gap : area.gaps) text += Fact("gap", Describe(gap) + ", bridged");
  return text;
}

std::string ToJson(std::vector<ContourArea> const& areas) {
  Json list = Json::array();
  for (ContourArea const& area : areas) list.push_back(AreaJson(area));
  Json const document = {{"schemaVersion", kSchemaVersion}, {"contours", list}};
  // A file name need not be UTF-8; a replacement character is better than no document.
  return document.dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
}

}  // namespace Vorn::Cli
