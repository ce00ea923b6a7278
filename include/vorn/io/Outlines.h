#pragma once

#include <cstddef>
#include <vector>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Export.h"

namespace Vorn::IO {

/// How far apart the ends of two pieces may lie that are chained: 1e-6 of the size of the drawing,
/// so that files with six digits pass. Zero without pieces.
VORN_IO_EXPORT double ChainTolerance(std::vector<Piece> const& pieces);

/// The outlines in a file, in the order of their first pieces. Pieces are chained by their ends,
/// whatever their order and sense in the file; a piece is turned round where that is needed. An
/// outline whose ends meet is closed. A contour that says that it is closed, but is not made of
/// outlines that are, is one outline with its gaps.
VORN_IO_EXPORT std::vector<ContourFile> OutlinesOf(ContourFile const& contour);

/// The same as one contour with gaps between the outlines. One whose pieces are chained as far as
/// they can be stays as it is.
VORN_IO_EXPORT ContourFile Chained(ContourFile const& contour);

/// How many of the closed outlines each one lies in; 0 for open ones and for those outside of all.
/// Outlines must not cross.
VORN_IO_EXPORT std::vector<std::size_t> DepthsOf(std::vector<ContourFile> const& outlines);

}  // namespace Vorn::IO
