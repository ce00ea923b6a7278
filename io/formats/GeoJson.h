#pragma once

#include "io/formats/JsonFields.h"
#include "vorn/io/ContourFile.h"

namespace Vorn::IO {

/// Whether the document says what kind of GeoJSON it is.
bool IsGeoJson(JsonField const& document);

/// The lines of LineString, MultiLineString, Polygon and MultiPolygon, alone, in collections and in
/// features, in the order of the document; each ring of a polygon is a closed outline. Points are
/// passed over, and so are heights.
/// @throws Failure (FailureKind::File) naming the file and the path of the bad field.
ContourFile GeoJsonContour(JsonField const& document);

}  // namespace Vorn::IO
