#include <algorithm>
#include <nlohmann/json.hpp>

#include "vorn/io/Intersections.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

using Json = nlohmann::ordered_json;

constexpr int kSchemaVersion = 1;

std::string KindOfPiece(ContourFile const& contour, std::size_t piece) {
  return contour.pieces[piece].IsArc() ? "arc" : "line";
}

Json PlaceJson(ContourFile const& contour, OnContour const& place) {
  return {{"piece", place.piece + 1},
          {"kind", KindOfPiece(contour, place.piece)},
          {"position", place.position}};
}

Json PointJson(XY const& point) { return {{"x", point.x}, {"y", point.y}}; }

}  // namespace

IntersectionTally Tally(std::vector<Intersection> const& found) {
  auto const countOf = [&found](Intersection::Kind kind) {
    return static_cast<std::size_t>(std::count_if(
        found.begin(), found.end(), [kind](Intersection const& one) { return one.kind == kind; }));
  };
  return {countOf(Intersection::Kind::Crossing), countOf(Intersection::Kind::Touching),
          countOf(Intersection::Kind::Overlap)};
}

std::string Describe(IntersectionTally const& tally) {
  return Counted(tally.crossings, "crossing") + ", " + std::to_string(tally.touches) +
         " touching, " + Counted(tally.overlaps, "overlap");
}

std::string NameOf(Intersection::Kind kind) {
  switch (kind) {
    case Intersection::Kind::Crossing:
      return "crossing";
    case Intersection::Kind::Touching:
      return "touching";
    case Intersection::Kind::Overlap:
      return "overlap";
  }
  return "unknown";
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

}  // namespace Vorn::IO
