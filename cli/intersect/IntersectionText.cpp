#include <algorithm>
#include <nlohmann/json.hpp>

#include "cli/Numbers.h"
#include "cli/intersect/Intersections.h"

namespace Vorn::Cli {

namespace {

using Json = nlohmann::ordered_json;
using Row = std::vector<std::string>;

constexpr int kSchemaVersion = 1;
constexpr int kDigits = 10;

std::string Number(double value) { return FormatShort(value, kDigits); }

std::string KindOfPiece(ContourFile const& contour, std::size_t piece) {
  return contour.pieces[piece].IsArc() ? "arc" : "line";
}

std::string PieceText(ContourFile const& contour, OnContour const& place) {
  return std::to_string(place.piece + 1) + " " + KindOfPiece(contour, place.piece);
}

std::size_t CountOf(std::vector<Intersection> const& found, Intersection::Kind kind) {
  return static_cast<std::size_t>(std::count_if(
      found.begin(), found.end(), [kind](Intersection const& one) { return one.kind == kind; }));
}

std::string Heading(std::vector<Intersection> const& found, ContourFile const& a,
                    ContourFile const* b) {
  using Kind = Intersection::Kind;
  std::string const who = b == nullptr ? a.path + " with itself" : a.path + " with " + b->path;
  if (found.empty()) return who + ": no intersections\n";
  return who + ": " + Counted(CountOf(found, Kind::Crossing), "crossing") + ", " +
         std::to_string(CountOf(found, Kind::Touching)) + " touching, " +
         Counted(CountOf(found, Kind::Overlap), "overlap") + "\n";
}

std::string Aligned(std::vector<Row> const& rows) {
  std::vector<std::size_t> widths(rows.front().size());
  for (Row const& row : rows) {
    for (std::size_t i = 0; i < row.size(); ++i) widths[i] = std::max(widths[i], row[i].size());
  }
  std::string text;
  for (Row const& row : rows) {
    for (std::size_t i = 0; i < row.size(); ++i) {
      text += i == 0 ? "" : "  ";
      text.append(widths[i] - row[i].size(), ' ');
      text += row[i];
    }
    text += "\n";
  }
  return text;
}

Json PlaceJson(ContourFile const& contour, OnContour const& place) {
  return {{"piece", place.piece + 1},
          {"kind", KindOfPiece(contour, place.piece)},
          {"position", place.position}};
}

Json PointJson(XY const& point) { return {{"x", point.x}, {"y", point.y}}; }

}  // namespace

std::string ToText(std::vector<Intersection> const& found, ContourFile const& a,
                   ContourFile const* b) {
  std::string const text = Heading(found, a, b);
  if (found.empty()) return text;
  std::vector<Row> rows = {
      {"no", "kind", "x", "y", "to x", "to y", "piece of A", "at", "piece of B", "at"}};
  for (Intersection const& one : found) {
    rows.push_back({std::to_string(rows.size()), NameOf(one.kind), Number(one.at.x),
                    Number(one.at.y), one.until ? Number(one.until->x) : "-",
                    one.until ? Number(one.until->y) : "-", PieceText(a, one.a),
                    Number(one.a.position), PieceText(b == nullptr ? a : *b, one.b),
                    Number(one.b.position)});
  }
  return text + "\n" + Aligned(rows);
}

std::string ToJson(std::vector<Intersection> const& found, ContourFile const& a,
                   ContourFile const* b) {
  Json list = Json::array();
  for (Intersection const& one : found) {
    list.push_back({{"kind", NameOf(one.kind)},
                    {"at", PointJson(one.at)},
                    {"until", one.until ? PointJson(*one.until) : Json(nullptr)},
                    {"a", PlaceJson(a, one.a)},
                    {"b", PlaceJson(b == nullptr ? a : *b, one.b)}});
  }
  Json const document = {{"schemaVersion", kSchemaVersion},
                         {"a", a.path},
                         {"b", b == nullptr ? Json(nullptr) : Json(b->path)},
                         {"intersections", list}};
  // A file name need not be UTF-8; a replacement character is better than no document.
  return document.dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
}

std::string ToCsv(std::vector<Intersection> const& found, ContourFile const& a,
                  ContourFile const* b) {
  std::string text = "kind,x,y,to_x,to_y,piece_a,kind_a,position_a,piece_b,kind_b,position_b\n";
  ContourFile const& second = b == nullptr ? a : *b;
  for (Intersection const& one : found) {
    XY const until = one.until.value_or(one.at);
    text += NameOf(one.kind);
    for (double const value : {one.at.x, one.at.y, until.x, until.y}) {
      text += "," + FormatExact(value);
    }
    text += "," + std::to_string(one.a.piece + 1) + "," + KindOfPiece(a, one.a.piece) + "," +
            FormatExact(one.a.position) + "," + std::to_string(one.b.piece + 1) + "," +
            KindOfPiece(second, one.b.piece) + "," + FormatExact(one.b.position) + "\n";
  }
  return text;
}

}  // namespace Vorn::Cli
