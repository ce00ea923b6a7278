#pragma once

#include <string>
#include <string_view>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {

/// The contour as paths of lines and true arcs, for cutters: a path for each outline, no
/// transforms, and a page that gives the true size, in inches for a contour in inches, else in
/// millimetres. Arcs of more than 120 degrees are divided, so that the radius tells the centre
/// well.
/// @throws Failure (FailureKind::BadArgument) for units other than mm, inch or none.
std::string ToPlainSvg(ContourFile const& contour);

/// Reads path, polyline, polygon, line, rect, circle and ellipse in the order of the file, with
/// their transforms; what is not displayed, texts and pictures are passed over. Arcs of circles
/// stay arcs where the transforms leave them circles; other curves become chords no further than
/// `options.flattening` from them. Y points down in SVG and is turned up.
///
/// Where the page has a width in mm, cm or in, lengths are true to it, in mm or inch; else they are
/// the numbers of the file, of no known unit.
/// @throws Failure (FailureKind::File) naming file, line, column and element; a curve without
///         `options.flattening` is refused as well.
ContourFile ParseSvg(std::string_view text, std::string const& path, ReadOptions const& options);

}  // namespace Vorn::IO
