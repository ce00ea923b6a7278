#pragma once

#include <string>
#include <string_view>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {

enum class DxfStyle {
  Polyline,  ///< one POLYLINE with bulges, which keeps the contour connected
  Entities,  ///< a LINE or an ARC for each piece
};

/// The contour as DXF R12 (AC1009). A gap ends one POLYLINE and begins another; the closed flag is
/// theirs (70 = 1) and lost with separate entities unless the ends meet. Units stand in a comment
/// (999), since R12 has no other place for them. Bulges and degrees are rounded once more than the
/// coordinates, so arcs read back to 2e-15 of the largest coordinate or radius. Arcs of more
/// than 315 degrees are written in two halves.
std::string ToDxf(ContourFile const& contour, DxfStyle style = DxfStyle::Polyline);

/// The contour as DXF 2000 (AC1015): an LWPOLYLINE with bulges for each outline, closed where its
/// ends meet, or LINE and ARC. Units stand in $INSUNITS, and in a comment as in R12. Outlines that
/// lie in an odd number of others are on a layer of holes.
std::string ToDxf2000(ContourFile const& contour, DxfStyle style = DxfStyle::Polyline);

/// Reads LINE, ARC, CIRCLE, LWPOLYLINE and POLYLINE in the order of the file, of R12 or later. An
/// entity that ends where the one before ends is turned round; arcs have no sense of their own and
/// are turned to the nearer end. A circle becomes two halves. Texts, points, dimensions, viewports,
/// paper space and blocks are passed over. SPLINE and ELLIPSE become chords no further than
/// `options.flattening` from them.
/// @throws Failure (FailureKind::File) naming file, line and entity, of a curve without
/// `options.flattening`
///         as well.
ContourFile ParseDxf(std::string_view text, std::string const& path,
                     ReadOptions const& options = {});

}  // namespace Vorn::IO
