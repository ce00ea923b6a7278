#include <algorithm>

#include "io/formats/GeoJson.h"
#include "io/pieces/Flattening.h"
#include "io/pieces/Nesting.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Failure.h"

namespace Vorn::IO {

namespace {

using Json = nlohmann::ordered_json;

/// Writes the outlines of one contour.
class Writer {
 public:
  Writer(ContourFile const& contour, std::optional<double> chords)
      : contour_(contour), runs_(RunsOf(contour)), flattening_{chords} {
    // Without arcs there is nothing to tell.
    bool const hasArcs = std::any_of(contour.pieces.begin(), contour.pieces.end(),
                                     [](Piece const& piece) { return piece.IsArc(); });
    if (!hasArcs) flattening_.tolerance.reset();
  }

  Json Document() {
    Json features = Json::array();
    std::vector<Face> const faces = FacesOf(runs_);
    auto next = faces.begin();
    for (std::size_t i = 0; i < runs_.size(); ++i) {
      if (!runs_[i].isClosed) features.push_back(Feature("LineString", PointsOf(runs_[i])));
      if (next == faces.end() || next->outer != i) continue;
      features.push_back(Feature("Polygon", RingsOf(*next)));
      ++next;
    }
    return {{"type", "FeatureCollection"}, {"features", features}};
  }

 private:
  [[noreturn]] void Refuse(std::string const& message) const {
    throw Failure(FailureKind::BadArgument, {contour_.path}, message);
  }

  Json Feature(char const* type, Json coordinates) const {
    Json properties = Json::object();
    if (!contour_.units.empty()) properties["units"] = contour_.units;
    if (flattening_.tolerance) properties["chordTolerance"] = *flattening_.tolerance;
    return {{"type", "Feature"},
            {"properties", properties},
            {"geometry", {{"type", type}, {"coordinates", std::move(coordinates)}}}};
  }

  std::vector<XY> PlacesOf(ContourFile const& run) {
    std::vector<XY> places = {run.pieces.front().start};
    for (Piece const& piece : run.pieces) {
      piece.IsArc() ? AddChords(piece, &places) : places.push_back(piece.end);
    }
    if (run.isClosed) places.back() = places.front();
    return places;
  }

  void AddChords(Piece const& arc, std::vector<XY>* places) {
    if (!flattening_.tolerance) {
      throw Failure(FailureKind::BadArgument, {contour_.path}, "GeoJSON has no arcs",
                    Remedy::GiveChords);
    }
    std::size_t const before = places->size();
    if (!AppendChords(arc, *flattening_.tolerance, flattening_.chordsLeft, places)) {
      Refuse("arcs flattened so finely have more than " + std::to_string(kMostChords) + " chords");
    }
    flattening_.chordsLeft -= places->size() - before;
  }

  static Json Coordinates(std::vector<XY> const& places) {
    Json list = Json::array();
    for (XY const& place : places) list.push_back({place.x, place.y});
    return list;
  }

  Json PointsOf(ContourFile const& run) { return Coordinates(PlacesOf(run)); }

  /// The outer ring runs counter-clockwise, holes run clockwise.
  Json RingsOf(Face const& face) {
    Json rings = Json::array({Ring(runs_[face.outer], true)});
    for (std::size_t const hole : face.holes) rings.push_back(Ring(runs_[hole], false));
    return rings;
  }

  Json Ring(ContourFile const& run, bool isCounterClockwise) {
    std::vector<XY> places = PlacesOf(run);
    if ((TwiceArea(places) > 0.0) != isCounterClockwise) std::reverse(places.begin(), places.end());
    return Coordinates(places);
  }

  static double TwiceArea(std::vector<XY> const& ring) {
    double sum = 0.0;
    for (std::size_t i = 1; i < ring.size(); ++i) {
      XY const a = {ring[i - 1].x - ring[0].x, ring[i - 1].y - ring[0].y};
      XY const b = {ring[i].x - ring[0].x, ring[i].y - ring[0].y};
      sum += a.x * b.y - a.y * b.x;
    }
    return sum;
  }

  ContourFile const& contour_;
  std::vector<ContourFile> runs_;
  Flattening flattening_;
};

}  // namespace

std::string ToGeoJson(ContourFile const& contour, std::optional<double> chords) {
  return Writer(contour, chords).Document().dump(-1, ' ', false, Json::error_handler_t::replace) +
         "\n";
}

}  // namespace Vorn::IO
