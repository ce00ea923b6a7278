#pragma once

#include <optional>
#include <string>

#include "io/formats/JsonFields.h"
#include "vorn/io/ContourFile.h"

namespace Vorn::IO {

/// The contour as a collection of features: a Polygon with its holes for closed outlines, a
/// LineString for others. Arcs become chords no further than `chords` from them, which the features
/// say as `chordTolerance`. Coordinates are those of the contour, not of the globe.
/// @throws Failure (FailureKind::BadArgument) when there are arcs and `chords` is not given or
/// would
///         make too many.
std::string ToGeoJson(ContourFile const& contour, std::optional<double> chords);

/// Whether the document says what kind of GeoJSON it is.
bool IsGeoJson(JsonField const& document);

/// The lines of LineString, MultiLineString, Polygon and MultiPolygon, alone, in collections and in
/// features, in the order of the document; each ring of a polygon is a closed outline. Points are
/// passed over, and so are heights.
/// @throws Failure (FailureKind::File) naming the place and the path of the bad field.
ContourFile GeoJsonContour(JsonField const& document);

}  // namespace Vorn::IO
