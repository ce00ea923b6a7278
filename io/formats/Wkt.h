#pragma once

#include <string>
#include <string_view>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {

/// The contour as well-known text: LINESTRING, CIRCULARSTRING or COMPOUNDCURVE, and a MULTICURVE
/// of these when it has gaps. Arcs are told by start, middle and end, in two halves above 315
/// degrees. A closed contour is a curve that ends where it starts, not a CURVEPOLYGON: a contour is
/// a curve with a start and a sense, which a polygon need not keep. There are no units.
std::string ToWkt(ContourFile const& contour);

/// Reads what ToWkt writes, MULTILINESTRING, POLYGON, CURVEPOLYGON and MULTIPOLYGON:
/// every ring of a polygon is a closed outline.
/// @throws Failure (FailureKind::File) naming file, line, column and offending text.
ContourFile ParseWkt(std::string_view text, std::string const& path, ArcUse arcs = ArcUse::Keep);

}  // namespace Vorn::IO
