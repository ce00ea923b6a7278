#include "io/formats/GeoJson.h"

#include <optional>

#include "io/pieces/Shapes.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

using Field = JsonField;

constexpr std::size_t kFewestInLine = 2;
constexpr std::size_t kFewestInRing = 4;

/// Goes through the geometries of a document.
class Reader {
 public:
  ContourFile Read(Field const& document) {
    Take(document);
    contour_.isClosed = ReturnsToStart(contour_.pieces);
    return contour_;
  }

 private:
  void Take(Field const& object) {
    std::string const type = object["type"].Word();
    if (type == "FeatureCollection") return TakeEach(object["features"], &Reader::Take);
    if (type == "GeometryCollection") return TakeEach(object["geometries"], &Reader::Take);
    if (type == "Feature") return TakeFeature(object);
    if (type == "Point" || type == "MultiPoint") return;
    TakeCurves(type, object);
  }

  void TakeFeature(Field const& feature) {
    if (feature.Has("properties") && feature["properties"].Has("units")) {
      contour_.units = feature["properties"]["units"].Word();
    }
    if (feature.Has("geometry")) Take(feature["geometry"]);
  }

  void TakeCurves(std::string const& type, Field const& object) {
    if (type == "LineString") return TakeLine(object["coordinates"]);
    if (type == "MultiLineString") return TakeEach(object["coordinates"], &Reader::TakeLine);
    if (type == "Polygon") return TakePolygon(object["coordinates"]);
    if (type == "MultiPolygon") return TakeEach(object["coordinates"], &Reader::TakePolygon);
    object["type"].Refuse(Quoted(type) + " is no kind of GeoJSON");
  }

  void TakeEach(Field const& list, void (Reader::*take)(Field const&)) {
    for (std::size_t i = 0; i < list.Count(); ++i) (this->*take)(list.Item(i));
  }

  void TakePolygon(Field const& rings) { TakeEach(rings, &Reader::TakeRing); }

  void TakeRing(Field const& points) {
    if (points.Count() < kFewestInRing) points.Refuse("a ring needs at least four points");
    if (!AreEqual(PointAt(points.Item(0)), PointAt(points.Item(points.Count() - 1)))) {
      points.Refuse("the last point of a ring is not its first one again");
    }
    TakeLine(points);
  }

  void TakeLine(Field const& points) {
    if (points.Count() < kFewestInLine) points.Refuse("a line needs at least two points");
    XY from = PointAt(points.Item(0));
    for (std::size_t i = 1; i < points.Count(); ++i) {
      XY const to = PointAt(points.Item(i));
      contour_.pieces.push_back(MakeLine(from, to));
      from = to;
    }
  }

  /// A contour lies in a plane: further coordinates are dropped.
  XY PointAt(Field const& point) {
    if (point.Count() < 2) point.Refuse("is no place but " + point.Text());
    contour_.hadHeights = contour_.hadHeights || point.Count() > 2;
    return {point.Item(0).Number(), point.Item(1).Number()};
  }

  ContourFile contour_;
};

}  // namespace

bool IsGeoJson(JsonField const& document) {
  return document.Has("type") && !document.Has("schemaVersion");
}

ContourFile GeoJsonContour(JsonField const& document) { return Reader().Read(document); }

}  // namespace Vorn::IO
