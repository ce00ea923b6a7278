#pragma once

#include "io/formats/Dxf.h"
#include "io/formats/DxfObjects.h"
#include "vorn/io/Pieces.h"

/// The tables that DXF 2000 asks for.
namespace Vorn::IO::Dxf {

/// The two blocks that every drawing has; entities of the contour belong to the first.
struct Spaces {
  Handle model = kNobody;
  Handle paper = kNobody;
};

/// Writes the section of the tables: a view of the whole extent, the layers of the style, and what
/// readers look for though the contour makes no use of it.
Spaces WriteTables(Extent const& extent, DxfStyle style, Objects* dxf);

}  // namespace Vorn::IO::Dxf
