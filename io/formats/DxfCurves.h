#pragma once

#include <vector>

#include "io/formats/DxfEntities.h"
#include "io/pieces/Flattening.h"

/// Entities whose curves are no arcs of circles.
namespace Vorn::IO::Dxf {

/// The chords of an ELLIPSE, whole or in part.
/// @throws Failure (FailureKind::File) naming file, line and entity.
std::vector<Piece> EllipsePieces(Entity const& entity, Flattening* flattening);

/// The chords of a SPLINE of any degree, with weights or without. One told by its fit points alone
/// is refused: programs differ in what they draw then.
/// @throws Failure (FailureKind::File) naming file, line and entity.
std::vector<Piece> SplinePieces(Entity const& entity, Flattening* flattening);

}  // namespace Vorn::IO::Dxf
