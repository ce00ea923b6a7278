#include "io/formats/JsonPieces.h"

#include <algorithm>
#include <numbers>
#include <optional>

#include "io/base/Words.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

using OrderedJson = nlohmann::ordered_json;
using nlohmann::json;

/// Files with as many digits as this keep a full turn below it.
constexpr double kLargestSweep = 2.0 * std::numbers::pi * (1.0 + 1e-6);

OrderedJson PointJson(XY const& point) { return {{"x", point.x}, {"y", point.y}}; }

/// The documents read here are five levels deep.
constexpr std::size_t kDeepest = 64;

/// Where brackets are nested deeper than that; nothing in good documents.
std::optional<std::size_t> FindTooDeep(std::string_view text) {
  std::size_t depth = 0;
  bool isInString = false;
  for (std::size_t i = 0; i < text.size(); ++i) {
    char const c = text[i];
    if (c == '"') isInString = !isInString;
    if (isInString && c == '\\') ++i;
    if (isInString) continue;
    if (c == '[' || c == '{') ++depth;
    if ((c == ']' || c == '}') && depth > 0) --depth;
    if (depth > kDeepest) return i;
  }
  return {};
}

std::string ComplaintAt(std::string_view text, std::size_t offset) {
  if (offset >= Trimmed(text).size()) return "is not JSON to the end: the text stops early";
  std::size_t const lineEnd = text.find('\n', offset);
  return "is not JSON from here on: " + Quoted(text.substr(offset, lineEnd - offset));
}

json Parsed(std::string_view text, std::string const& path) {
  if (std::optional<std::size_t> const deep = FindTooDeep(text)) {
    throw Failure(FailureKind::File, PlaceIn(text, *deep, path),
                  "is nested deeper than " + std::to_string(kDeepest) + " brackets");
  }
  try {
    return json::parse(text);
  } catch (json::parse_error const& error) {
    std::size_t const offset = std::min(error.byte > 0 ? error.byte - 1 : 0, text.size());
    throw Failure(FailureKind::File, PlaceIn(text, offset, path), ComplaintAt(text, offset));
  } catch (json::exception const&) {
    RefuseFile(path, "a number is too large for a double");
  }
}

/// The beginning of the value as JSON, a little longer than a message quotes.
std::string BeginningOf(json const& value) {
  constexpr std::size_t kEnough = 64;
  if (!value.is_structured()) return value.dump(-1, ' ', false, json::error_handler_t::replace);
  std::string text(1, value.is_array() ? '[' : '{');
  for (auto const& item : value.items()) {
    if (text.size() > kEnough) return text;
    if (text.size() > 1) text += ',';
    if (value.is_object()) text += '"' + item.key() + "\":";
    text += BeginningOf(item.value());
  }
  return text + (value.is_array() ? ']' : '}');
}

/// One value of the document, with the way to it for messages: `elements[2].end.x`.
class Field {
 public:
  Field(json const& value, std::string name, std::string const& file)
      : value_(value), name_(std::move(name)), file_(file) {}

  [[noreturn]] void Refuse(std::string const& message) const {
    RefuseFile(file_, name_ + ": " + message);
  }

  bool Has(char const* key) const {
    return value_.is_object() && value_.contains(key) && !value_.at(key).is_null();
  }

  Field operator[](char const* key) const {
    if (!value_.is_object()) Refuse("is not an object but " + Text());
    std::string const name = name_.empty() ? key : name_ + "." + key;
    if (!value_.contains(key)) RefuseFile(file_, name + ": is missing");
    return {value_.at(key), name, file_};
  }

  std::vector<Field> Items() const {
    if (!value_.is_array()) Refuse("is not an array but " + Text());
    std::vector<Field> items;
    for (std::size_t i = 0; i < value_.size(); ++i) {
      items.emplace_back(value_.at(i), name_ + "[" + std::to_string(i) + "]", file_);
    }
    return items;
  }

  double Number() const {
    if (!value_.is_number()) Refuse("is not a number but " + Text());
    double const number = value_.get<double>();
    if (!IsUsable(number)) Refuse(Text() + " is too large");
    return number;
  }

  double NumberOr(char const* key, double otherwise) const {
    return Has(key) ? (*this)[key].Number() : otherwise;
  }

  std::string Word() const {
    if (!value_.is_string()) Refuse("is not a text but " + Text());
    return value_.get<std::string>();
  }

  bool Truth() const {
    if (!value_.is_boolean()) Refuse("is neither true nor false but " + Text());
    return value_.get<bool>();
  }

  XY At() const { return {(*this)["x"].Number(), (*this)["y"].Number()}; }

  std::string Text() const { return Quoted(BeginningOf(value_)); }

 private:
  json const& value_;
  std::string name_;
  std::string const& file_;
};

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
  Piece arc = MakeArc(element["start"].At(), element["end"].At(), element["center"].At(),
                      element["radius"].Number(), IsCounterClockwise(element["direction"]));
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
  Piece line = MakeLine(element["start"].At(), element["end"].At());
  line.length = element.NumberOr("length", line.length);
  return line;
}

Piece PieceOf(Field const& element) {
  Field const kind = element["kind"];
  std::string const word = kind.Word();
  if (word == "line") return LineOf(element);
  if (word == "arc") return ArcOf(element);
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

ContourFile ParseJsonPieces(std::string_view text, std::string const& path) {
  json const value = Parsed(text, path);
  Field const document(value, "", path);
  if (!value.is_object()) RefuseFile(path, "is not an object but " + document.Text());
  RequireVersion(document);
  ContourFile contour;
  contour.units = UnitsOf(document);
  for (Field const& element : document["elements"].Items()) {
    contour.pieces.push_back(PieceOf(element));
  }
  contour.isClosed =
      document.Has("closed") ? document["closed"].Truth() : ReturnsToStart(contour.pieces);
  return contour;
}

}  // namespace Vorn::IO
