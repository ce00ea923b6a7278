#include "io/formats/JsonPieces.h"

#include <numbers>
#include <optional>

#include "io/formats/GeoJson.h"
#include "io/formats/JsonFields.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

using OrderedJson = nlohmann::ordered_json;
using Field = JsonField;

/// Files with as many digits as this keep a full turn below it.
constexpr double kLargestSweep = 2.0 * std::numbers::pi * (1.0 + 1e-6);

OrderedJson PointJson(XY const& point) { return {{"x", point.x}, {"y", point.y}}; }

XY PointAt(Field const& point) { return {point["x"].Number(), point["y"].Number()}; }

void RequireVersion(Field const& document) {
  Field const version = document["schemaVersion"];
  if (version.Number() != kJsonSchemaVersion) {
    version.Refuse(version.Text() + " is not the version that is read here, which is " +
                   std::to_string(kJsonSchemaVersion));
  }
}

bool IsCounterClockwise(Field const& direction) {
  std::string const word = direction.Word();
  if (word != "ccw" && word != "cw") direction.Refuse(Quoted(word) + " is neither ccw nor cw");
  return word == "ccw";
}

Piece ArcOf(Field const& element) {
  // One by one, so that the first bad field is the one that is named.
  auto const start = PointAt(element["start"]);
  auto const end = PointAt(element["end"]);
  auto const centre = PointAt(element["center"]);
  double const radius = element["radius"].Number();
  Piece arc = MakeArc(start, end, centre, radius, IsCounterClockwise(element["direction"]));
  arc.startAngle = element.NumberOr("startAngle", arc.startAngle);
  arc.endAngle = element.NumberOr("endAngle", arc.endAngle);
  arc.sweep = element.NumberOr("sweep", arc.sweep);
  arc.length = element.NumberOr("length", arc.radius * arc.sweep);
  if (!(arc.sweep >= 0.0 && arc.sweep <= kLargestSweep)) {
    element["sweep"].Refuse(FormatExact(arc.sweep) + " is no turn from 0 to a full one");
  }
  if (auto const fault = FaultOf(arc)) element.Refuse("is no arc: " + *fault);
  return arc;
}

Piece LineOf(Field const& element) {
  auto const start = PointAt(element["start"]);
  Piece line = MakeLine(start, PointAt(element["end"]));
  line.length = element.NumberOr("length", line.length);
  return line;
}

Piece PieceOf(Field const& element, ArcUse arcs) {
  Field const kind = element["kind"];
  std::string const word = kind.Word();
  if (word == "line") return LineOf(element);
  if (word == "arc") {
    Piece const arc = ArcOf(element);
    if (arcs == ArcUse::Refuse) element.Refuse(DescribeArc(arc), Remedy::FlattenCurves);
    return arc;
  }
  kind.Refuse(Quoted(word) + " is neither line nor arc");
}

std::string UnitsOf(Field const& document) {
  if (!document.Has("input")) return {};
  Field const input = document["input"];
  return input.Has("units") ? input["units"].Word() : "";
}

}  // namespace

OrderedJson PieceJson(Piece const& piece, std::size_t number, OrderedJson const& points) {
  OrderedJson json = {
      {"number", number},
      {"kind", piece.IsArc() ? "arc" : "line"},
      {"start", PointJson(piece.start)},
      {"end", PointJson(piece.end)},
      {"length", piece.length},
      {"points", points},
  };
  if (!piece.IsArc()) return json;
  json["center"] = PointJson(piece.center);
  json["radius"] = piece.radius;
  json["direction"] = piece.counterClockwise ? "ccw" : "cw";
  json["startAngle"] = piece.startAngle;
  json["endAngle"] = piece.endAngle;
  json["sweep"] = piece.sweep;
  return json;
}

std::string ToJson(ContourFile const& contour) {
  OrderedJson units = nullptr;
  if (!contour.units.empty()) units = contour.units;
  std::size_t arcs = 0;
  OrderedJson elements = OrderedJson::array();
  for (Piece const& piece : contour.pieces) {
    elements.push_back(PieceJson(piece, elements.size() + 1, nullptr));
    if (piece.IsArc()) ++arcs;
  }
  OrderedJson const document = {
      {"schemaVersion", kJsonSchemaVersion},
      {"input", {{"file", contour.path}, {"units", units}}},
      {"closed", contour.isClosed},
      {"counts",
       {{"elements", elements.size()}, {"lines", elements.size() - arcs}, {"arcs", arcs}}},
      {"elements", elements},
  };
  // A file name need not be UTF-8; a replacement character is better than no document.
  return document.dump(2, ' ', false, OrderedJson::error_handler_t::replace) + "\n";
}

ContourFile ParseJsonPieces(std::string_view text, std::string const& path, ArcUse arcs) {
  nlohmann::json const value = ParsedJson(text, path);
  JsonSource const source = {path, text};
  Field const document(value, "", source);
  if (!value.is_object()) document.Refuse("is not an object but " + document.Text());
  if (IsGeoJson(document)) return GeoJsonContour(document);
  RequireVersion(document);
  ContourFile contour;
  contour.units = UnitsOf(document);
  Field const elements = document["elements"];
  for (std::size_t i = 0; i < elements.Count(); ++i) {
    contour.pieces.push_back(PieceOf(elements.Item(i), arcs));
  }
  contour.isClosed =
      document.Has("closed") ? document["closed"].Truth() : ReturnsToStart(contour.pieces);
  return contour;
}

}  // namespace Vorn::IO
